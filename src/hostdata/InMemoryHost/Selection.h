#pragma once

#include "TesselPluginInterface/ISelectionManager.h"

namespace InMemoryHost
{

/// An item that an operation names twice counts once.
class VSelection : public TesselPluginInterface::ISelection
{
public:
	const std::vector<NVX::ISelectionItem>& Items() const override { return m_Items; }
	std::vector<NVX::ISelectionItem> ItemsOfKind(std::uint32_t i_Kind) const override;
	void Replace(const std::vector<NVX::ISelectionItem>& i_rItems) override;
	void Add(const std::vector<NVX::ISelectionItem>& i_rItems) override;
	void Remove(const std::vector<NVX::ISelectionItem>& i_rItems) override;
	void Toggle(const std::vector<NVX::ISelectionItem>& i_rItems) override;
	NVX::VSignal<>& ChangedSignal() override { return m_ChangedSignal; }

private:
	void Take(std::vector<NVX::ISelectionItem> i_Items);

	std::vector<NVX::ISelectionItem> m_Items;
	NVX::VSignal<> m_ChangedSignal;
};

class VSelectionManager : public TesselPluginInterface::ISelectionManager
{
public:
	VSelection& Selection() override { return m_Selection; }
	VSelection& PreSelection() override { return m_PreSelection; }

private:
	VSelection m_Selection;
	VSelection m_PreSelection;
};

} // namespace InMemoryHost
