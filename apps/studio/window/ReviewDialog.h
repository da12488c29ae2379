#pragma once

#include <QDialog>
#include <QStringList>
#include <QVariant>

#include <functional>

class QLabel;
class QPushButton;
class QTreeWidget;

namespace TesselPluginInterface
{
class ISelection;
}

namespace StudioHost
{

class VRetargetPanel;
class VReviewDialog;

/// One thing that can be told of the target subject as a table.
struct VReview
{
	/// By which it is found.
	const char* m_pName = "";
	QString m_Title;
	QStringList m_Columns;
	/// Of the sentences, which takes the room that is left.
	int m_WideColumn = 0;
	/// Has the dialog show it, at once or later. False if there is nothing to tell.
	std::function<bool(VReviewDialog&)> m_Look;
	/// A button of its own; none without a text.
	QString m_Action = {};
	/// @param i_rRow the chosen one, as the document gives it.
	std::function<void(const QVariantMap& i_rRow)> m_Act = {};
	/// The button is for rows that have this, and then it is looked again; empty for a button that needs no row.
	QString m_ActsOn = {};
};

/// Shows it. What the chosen row is about is selected, so that lists and view show it. The table stays as it was while
/// the target subject changes, which is told, until it is looked again.
class VReviewDialog : public QDialog
{
	Q_OBJECT

public:
	/// @param i_rPanel and the selection must outlive the dialog.
	VReviewDialog(const VReview& i_rReview, VRetargetPanel& i_rPanel, TesselPluginInterface::ISelection& io_rSelection,
	    QWidget* i_pParent);

	/// False, with the table as it was, if there is nothing to tell.
	bool Look();
	/// @param i_rReview as the document gives it: "summary" and "rows".
	void Show(const QVariantMap& i_rReview);
	/// What it is to show is still being found out.
	bool IsAwaiting() const { return m_bAwaiting; }

private:
	void LookAgain();
	void Act();
	void Await(bool i_bAwaiting);
	void ChooseRow();
	/// All rows as lines of a table, cells by tabulators.
	void Copy();

	const VReview m_Review;
	VRetargetPanel& m_rPanel;
	TesselPluginInterface::ISelection& m_rSelection;
	QLabel* const m_pSummary;
	QTreeWidget* const m_pRows;
	QLabel* const m_pWhole;
	QPushButton* m_pAct = nullptr;
	QPushButton* m_pAgain = nullptr;
	bool m_bAwaiting = false;
	/// The target subject is another one than what was looked at.
	bool m_bEdited = false;
};

} // namespace StudioHost
