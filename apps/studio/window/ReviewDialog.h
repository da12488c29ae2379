#pragma once

#include <QDialog>
#include <QStringList>
#include <QVariant>

#include <functional>

class QLabel;
class QTreeWidget;

namespace TesselPluginInterface
{
class ISelection;
}

namespace StudioHost
{

class VRetargetPanel;

/// One thing that can be told of the target subject as a table.
struct VReview
{
	/// By which it is found.
	const char* m_pName = "";
	QString m_Title;
	QStringList m_Columns;
	/// As the document gives it: "summary" and "rows", empty if there is nothing to tell.
	std::function<QVariantMap()> m_Look;
	/// A button of its own; none without a text.
	QString m_Action = {};
	std::function<void()> m_Act = {};
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

private:
	void LookAgain();
	void ChooseRow();
	/// All rows as lines of a table, cells by tabulators.
	void Copy();

	const VReview m_Review;
	VRetargetPanel& m_rPanel;
	TesselPluginInterface::ISelection& m_rSelection;
	QLabel* const m_pSummary;
	QTreeWidget* const m_pRows;
	QLabel* const m_pWhole;
};

} // namespace StudioHost
