#include "studio/window/RebindDialog.h"

#include "studio/panel/RetargetPanel.h"
#include "studio/window/BesideView.h"
#include "studio/window/Columns.h"
#include "studio/window/Named.h"
#include "studio/window/PlainTexts.h"

#include <QCheckBox>
#include <QDialogButtonBox>
#include <QHeaderView>
#include <QLabel>
#include <QPushButton>
#include <QTreeWidget>
#include <QVBoxLayout>

namespace StudioHost
{

VRebindDialog::VRebindDialog(
    VRetargetPanel& i_rPanel, bool i_bPerformer, const QVariantMap& i_rLook, QWidget* i_pParent)
    : QDialog(i_pParent), m_rPanel(i_rPanel), m_bPerformer(i_bPerformer),
      m_pMeasure(Named(new QCheckBox(tr("&Measure all offsets anew, in the poses that stand now")), "RebindMeasure",
          tr("Measure all offsets anew")))
{
	Named(this, "Rebind", tr("Re-bind"));
	setWindowTitle(i_bPerformer ? tr("Re-bind to the Performer") : tr("Re-bind to the FBX"));
	setAttribute(Qt::WA_DeleteOnClose);
	const QString refusal = i_rLook["refusal"].toString();
	const QStringList lost = i_rLook["lost"].toStringList();
	auto* const pText = Named(new QLabel, "RebindText", tr("What it is about"));
	pText->setWordWrap(true);
	pText->setText(!refusal.isEmpty() ? refusal
	        : m_bPerformer
	        ? tr(
	            "The performer has other segments than those that the targets follow. Re-bind the targets to this one?")
	        : tr("The FBX file has other bones than the target subject was made of. Take the target subject over to "
	             "it? Targets, joints and poses are kept where their segments are found again."));
	auto* const pTree = Named(new QTreeWidget, "RebindList", tr("What becomes of what"));
	pTree->setHeaderHidden(true);
	pTree->setWordWrap(true);
	pTree->setItemDelegate(new VSentenceColumn(*pTree));
	connect(pTree->header(), &QHeaderView::sectionResized, pTree, &QTreeWidget::doItemsLayout);
	pTree->setSelectionMode(QAbstractItemView::NoSelection);
	const auto add = [&](const QString& i_rTitle, const QStringList& i_rLines)
	{
		if (i_rLines.isEmpty())
			return;
		auto* const pGroup = new QTreeWidgetItem(pTree, {i_rTitle.arg(i_rLines.size())});
		for (const QString& rLine : i_rLines)
			(new QTreeWidgetItem(pGroup, {rLine}))->setToolTip(0, PlainToolTip(rLine));
		pGroup->setExpanded(true);
	};
	// The first is what there is to decide on.
	add(tr("Cannot be kept: %1"), lost);
	add(tr("Found under another name: %1"), i_rLook["renamed"].toStringList());
	add(tr("New: %1"), i_rLook["added"].toStringList());
	add(tr("Changed with it: %1"), i_rLook["changed"].toStringList());
	if (refusal.isEmpty())
		new QTreeWidgetItem(pTree, {tr("Found under their names: %1").arg(i_rLook["kept"].toInt())});
	pTree->setVisible(refusal.isEmpty());
	m_pMeasure->setVisible(refusal.isEmpty() && m_bPerformer);

	auto* const pButtons = Named(new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel), "RebindButtons",
	    tr("Do it or leave it"));
	auto* const pDo = Named(pButtons->button(QDialogButtonBox::Ok), "RebindDo", tr("Re-bind"));
	pDo->setText(lost.isEmpty() ? tr("&Re-bind") : tr("&Re-bind Without %1").arg(lost.size()));
	pDo->setVisible(refusal.isEmpty());
	Named(pButtons->button(QDialogButtonBox::Cancel), "RebindLeave", tr("Leave it as it is"))
	    ->setText(tr("&Leave It as It Is"));
	connect(pButtons, &QDialogButtonBox::accepted, this, &QDialog::accept);
	connect(pButtons, &QDialogButtonBox::rejected, this, &QDialog::reject);
	connect(&m_rPanel, &VRetargetPanel::segmentsChanged, this, &QDialog::reject);
	auto* const pLayout = new QVBoxLayout(this);
	pLayout->addWidget(pText);
	pLayout->addWidget(pTree, 1);
	pLayout->addWidget(m_pMeasure);
	pLayout->addWidget(pButtons);
	resize(520, 480);
	StandBesideView(*this);
}

void VRebindDialog::accept()
{
	disconnect(&m_rPanel, nullptr, this, nullptr);
	m_rPanel.Rebind(m_bPerformer, m_pMeasure->isChecked());
	QDialog::accept();
}

} // namespace StudioHost

#include "moc_RebindDialog.cpp"
