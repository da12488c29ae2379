#pragma once

#include "NVX/Shared.h"

#include <QObject>

#include <array>
#include <cstdint>
#include <memory>

namespace TesselPluginInterface
{
class IDispatcher;
class ISelectionManager;
} // namespace TesselPluginInterface

/// The host's selection as the panel needs it: the one source segment, target segment and target of the document's
/// subjects that is selected, -1 for none and for several. Made by NVX::MakeShared; follows the selection through the
/// dispatcher from then on. User interface thread only.
class VRetargetSetupSelection : public QObject, public NVX::VShared
{
	Q_OBJECT
	Q_PROPERTY(int selectedSourceSegment READ SelectedSourceSegment WRITE SetSelectedSourceSegment NOTIFY Changed)
	Q_PROPERTY(int selectedTargetSegment READ SelectedTargetSegment WRITE SetSelectedTargetSegment NOTIFY Changed)
	Q_PROPERTY(int selectedTarget READ SelectedTarget WRITE SetSelectedTarget NOTIFY Changed)
	/// How many of each are selected: what an index of -1 means.
	Q_PROPERTY(int sourceSegmentCount READ SourceSegmentCount NOTIFY countsChanged)
	Q_PROPERTY(int targetSegmentCount READ TargetSegmentCount NOTIFY countsChanged)
	Q_PROPERTY(int targetCount READ TargetCount NOTIFY countsChanged)

public:
	VRetargetSetupSelection(std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
	    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelectionManager);

	std::int32_t SelectedSourceSegment() const { return m_Selected[0]; }
	std::int32_t SelectedTargetSegment() const { return m_Selected[1]; }
	std::int32_t SelectedTarget() const { return m_Selected[2]; }

	std::int32_t SourceSegmentCount() const { return m_Counts[0]; }
	std::int32_t TargetSegmentCount() const { return m_Counts[1]; }
	std::int32_t TargetCount() const { return m_Counts[2]; }

	/// These change what this object tells, and not the host's selection; its next change overrides them.
	void SetSelectedSourceSegment(std::int32_t i_Index) { Set(0, i_Index); }
	void SetSelectedTargetSegment(std::int32_t i_Index) { Set(1, i_Index); }
	void SetSelectedTarget(std::int32_t i_Index) { Set(2, i_Index); }

	/// Makes it the only target in the host's selection; segments stay as they are.
	Q_INVOKABLE void SelectTarget(int i_Index);

	/// Takes over the host's selection at once; otherwise it is heard of through the dispatcher.
	void Update();

signals:
	void Changed();
	void countsChanged();

protected:
	void OnShared() override;

private:
	void Set(std::size_t i_Which, std::int32_t i_Index);

	const std::shared_ptr<TesselPluginInterface::IDispatcher> m_pDispatcher;
	const std::shared_ptr<TesselPluginInterface::ISelectionManager> m_pSelectionManager;
	/// Source segment, target segment, target.
	std::array<std::int32_t, 3> m_Selected{-1, -1, -1};
	std::array<std::int32_t, 3> m_Counts{};
};
