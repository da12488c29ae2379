#pragma once

#include "NVX/ISelectionItem.h"

#include <QDialog>
#include <QVariant>

#include <set>
#include <vector>

class QCheckBox;
class QLabel;
class QTableWidget;

namespace TesselPluginInterface
{
class ISelection;
}

namespace StudioHost
{

class VRetargetPanel;

/// Brings the character's bind pose to the performer's: the view shows it at once, and a table the angles before and
/// after. Chains and single joints may be left as they are. The pair of the row is selected, so that the view shows it;
/// what was selected comes back. Cancelled it leaves all as it was. Beside the window: it closes when the target
/// subject becomes another one.
class VAlignDialog : public QDialog
{
	Q_OBJECT

public:
	/// @param i_rPanel and the selection must outlive the dialog.
	VAlignDialog(VRetargetPanel& i_rPanel, TesselPluginInterface::ISelection& io_rSelection, QWidget* i_pParent);

	/// False if nothing could be aligned, which is told: the dialog is of no use then.
	bool Align();

	void done(int i_Result) override;

private:
	void ShowScale(const QVariantMap& i_rAligned);
	void ShowJoint(int i_Row, const QVariantMap& i_rJoint);
	void LockTicked();
	void SelectPair();

	VRetargetPanel& m_rPanel;
	TesselPluginInterface::ISelection& m_rSelection;
	const std::vector<NVX::ISelectionItem> m_Before;
	const QStringList m_Sources;
	const QStringList m_Targets;
	std::vector<QCheckBox*> m_Chains;
	/// Ticked where there is something to scale, and it is wanted.
	QCheckBox* const m_pFitScale;
	bool m_bFitScale = true;
	QCheckBox* m_pFeet = nullptr;
	/// Segments of the character that keep their joints.
	std::set<int> m_Locked;
	QTableWidget* const m_pTable;
	QLabel* const m_pNote;
	/// What changes is of its own doing.
	bool m_bAtWork = false;
};

} // namespace StudioHost
