#pragma once

#include <QDialog>

#include <vector>

class QCheckBox;
class QLabel;
class QTableWidget;

namespace StudioHost
{

class VRetargetPanel;

/// Brings the character's bind pose to the performer's: the view shows it at once, and a table the angles before and
/// after. Cancelled it leaves all as it was. Beside the window: it closes when the target subject becomes another one.
class VAlignDialog : public QDialog
{
	Q_OBJECT

public:
	/// @param i_rPanel must outlive the dialog.
	VAlignDialog(VRetargetPanel& i_rPanel, QWidget* i_pParent);

	/// False if nothing could be aligned, which is told: the dialog is of no use then.
	bool Align();

	void done(int i_Result) override;

private:
	VRetargetPanel& m_rPanel;
	std::vector<QCheckBox*> m_Chains;
	QTableWidget* const m_pTable;
	QLabel* const m_pNote;
	/// What changes is of its own doing.
	bool m_bAtWork = false;
};

} // namespace StudioHost
