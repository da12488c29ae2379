#include "studio/window/ReviewDialog.h"

#include "TesselPluginInterface/ISelectionManager.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/window/BesideView.h"
#include "studio/window/Columns.h"
#include "studio/window/Named.h"
#include "studio/window/PlainTexts.h"

#include <QApplication>
#include <QClipboard>
#include <QDialogButtonBox>
#include <QHeaderView>
#include <QLabel>
#include <QPushButton>
#include <QScrollBar>
#include <QTreeWidget>
#include <QVBoxLayout>

#include <algorithm>

namespace StudioHost
{
namespace
{

QVariantMap RowOf(const QTreeWidgetItem* i_pItem)
{
	return i_pItem ? i_pItem->data(0, Qt::UserRole).toMap() : QVariantMap();
}

} // namespace

VReviewDialog::VReviewDialog(const VReview& i_rReview, VRetargetPanel& i_rPanel,
    TesselPluginInterface::ISelection& io_rSelection, QWidget* i_pParent)
    : QDialog(i_pParent), m_Review(i_rReview), m_rPanel(i_rPanel), m_rSelection(io_rSelection),
      m_pSummary(Named(new QLabel, "ReviewSummary", tr("In a sentence"))),
      m_pRows(Named(new QTreeWidget, "ReviewRows", i_rReview.m_Title)),
      m_pWhole(Named(new QLabel, "ReviewWhole", tr("The chosen row in full")))
{
	Named(this, i_rReview.m_pName, i_rReview.m_Title);
	setWindowTitle(i_rReview.m_Title);
	setAttribute(Qt::WA_DeleteOnClose);
	m_pSummary->setWordWrap(true);
	m_pRows->setHeaderLabels(i_rReview.m_Columns);
	m_pRows->setHeaderHidden(i_rReview.m_Columns.size() == 1);
	m_pRows->setRootIsDecorated(false);
	m_pRows->setAllColumnsShowFocus(true);
	m_pRows->setAlternatingRowColors(true);
	m_pRows->setWordWrap(true);
	m_pRows->header()->setStretchLastSection(false);
	m_pRows->header()->setSectionResizeMode(i_rReview.m_WideColumn, QHeaderView::Stretch);
	// Rows are as high as their sentences.
	connect(m_pRows->header(), &QHeaderView::sectionResized, m_pRows, &QTreeWidget::doItemsLayout);
	m_pRows->setItemDelegateForColumn(i_rReview.m_WideColumn, new VSentenceColumn(*m_pRows));
	if (i_rReview.m_WideColumn != 0)
		m_pRows->setItemDelegateForColumn(0, new VNameColumn(m_pRows));
	m_pWhole->setWordWrap(true);
	// A name that is longer than the window does not widen it.
	for (QLabel* const pLabel : {m_pSummary, m_pWhole})
	{
		QSizePolicy policy = pLabel->sizePolicy();
		policy.setHorizontalPolicy(QSizePolicy::Ignored);
		pLabel->setSizePolicy(policy);
	}
	m_pWhole->setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
	m_pRows->header()->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
	connect(m_pRows, &QTreeWidget::currentItemChanged, this, &VReviewDialog::ChooseRow);

	auto* const pButtons = Named(new QDialogButtonBox(QDialogButtonBox::Close), "ReviewButtons", tr("What to do"));
	const auto add = [&](const char* i_pName, const QString& i_rText, const auto& i_rPressed)
	{
		auto* const pButton =
		    Named(pButtons->addButton(i_rText, QDialogButtonBox::ActionRole), i_pName, QString(i_rText).remove('&'));
		pButton->setAutoDefault(false);
		connect(pButton, &QPushButton::clicked, this, i_rPressed);
		return pButton;
	};
	if (!i_rReview.m_Action.isEmpty())
		m_pAct = add("ReviewAct", i_rReview.m_Action, &VReviewDialog::Act);
	add("ReviewCopy", tr("C&opy"), &VReviewDialog::Copy)->setShortcut(QKeySequence::Copy);
	m_pAgain = add("ReviewAgain", tr("&Look Again"), &VReviewDialog::LookAgain);
	Named(pButtons->button(QDialogButtonBox::Close), "ReviewClose", tr("Close"));
	connect(pButtons, &QDialogButtonBox::rejected, this, &QDialog::reject);
	connect(&m_rPanel, &VRetargetPanel::stateChanged, this,
	    [this]
	    {
		    m_bEdited = true;
		    if (!m_bAwaiting)
			    m_pSummary->setText(tr("The target subject was edited or saved since: look again."));
	    });
	auto* const pLayout = new QVBoxLayout(this);
	pLayout->addWidget(m_pSummary);
	pLayout->addWidget(m_pRows, 1);
	pLayout->addWidget(m_pWhole);
	pLayout->addWidget(pButtons);
	resize(i_rReview.m_Columns.size() > 1 ? 860 : 620, 480);
	StandBesideView(*this);
}

bool VReviewDialog::Look()
{
	Await(true);
	QApplication::setOverrideCursor(Qt::WaitCursor);
	const bool bLooks = m_Review.m_Look(*this);
	QApplication::restoreOverrideCursor();
	// What was being typed counts, too.
	m_bEdited = false;
	if (!bLooks)
		Await(false);
	return bLooks;
}

void VReviewDialog::Await(bool i_bAwaiting)
{
	m_bAwaiting = i_bAwaiting;
	if (i_bAwaiting)
		m_pSummary->setText(tr("Being found out..."));
	m_pAgain->setEnabled(!i_bAwaiting);
	ChooseRow();
}

void VReviewDialog::Show(const QVariantMap& i_rReview)
{
	m_pSummary->setText(i_rReview["summary"].toString()
	    + (m_bAwaiting && m_bEdited ? ' ' + tr("The target subject was edited or saved meanwhile: look again.")
	                                : QString()));
	const int scrolled = m_pRows->verticalScrollBar()->value();
	m_pRows->clear();
	for (const QVariant& rRow : i_rReview["rows"].toList())
	{
		const QStringList cells = rRow.toMap()["cells"].toStringList();
		auto* const pItem = new QTreeWidgetItem(m_pRows, cells);
		pItem->setData(0, Qt::UserRole, rRow);
		for (int column = 0; column < cells.size(); ++column)
			pItem->setToolTip(column, PlainToolTip(cells[column]));
	}
	for (int column = 0; column < m_pRows->columnCount(); ++column)
	{
		if (column == m_Review.m_WideColumn)
			continue;
		m_pRows->resizeColumnToContents(column);
		m_pRows->setColumnWidth(column, std::min(m_pRows->columnWidth(column), c_WidestNames * 3 / 4));
	}
	m_pRows->verticalScrollBar()->setValue(scrolled);
	Await(false);
}

void VReviewDialog::LookAgain()
{
	if (!Look())
		m_pSummary->setText(tr("There is nothing to look at any more: the log tells why."));
}

void VReviewDialog::Act()
{
	m_Review.m_Act(RowOf(m_pRows->currentItem()));
	if (!m_Review.m_ActsOn.isEmpty())
		LookAgain();
}

void VReviewDialog::ChooseRow()
{
	const QVariantMap row = RowOf(m_pRows->currentItem());
	if (m_pAct)
		m_pAct->setEnabled(m_Review.m_ActsOn.isEmpty() || (!m_bAwaiting && row.contains(m_Review.m_ActsOn)));
	QStringList whole = row["cells"].toStringList();
	whole.removeAll({});
	m_pWhole->setText(whole.join(QStringLiteral(": ")));
	if (const auto items = m_rPanel.ItemsNamedIn(row["about"].toString()); !items.empty())
		m_rSelection.Replace(items);
}

void VReviewDialog::Copy()
{
	QString text;
	for (int row = 0; row < m_pRows->topLevelItemCount(); ++row)
		text += RowOf(m_pRows->topLevelItem(row))["cells"].toStringList().join('\t') + '\n';
	QApplication::clipboard()->setText(text.isEmpty() ? m_pSummary->text() : text);
}

} // namespace StudioHost

#include "moc_ReviewDialog.cpp"
