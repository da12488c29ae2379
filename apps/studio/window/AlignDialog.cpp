#include "studio/window/AlignDialog.h"

#include "TesselPluginInterface/ISelectionManager.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/window/BesideView.h"
#include "studio/window/Columns.h"
#include "studio/window/Named.h"
#include "studio/window/PlainTexts.h"

#include <QCheckBox>
#include <QDialogButtonBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLocale>
#include <QPushButton>
#include <QSignalBlocker>
#include <QTableWidget>
#include <QVBoxLayout>

#include <algorithm>
#include <utility>

namespace StudioHost
{
namespace
{

enum EAlignColumn
{
	EAlignLock,
	EAlignTarget,
	EAlignSource,
	EAlignBefore,
	EAlignAfter,
	EAlignNote,
	EAlignColumnCount
};

/// Angles that show the same number are the same.
constexpr double c_SameDegrees = 0.05;

QString Degrees(double i_Value)
{
	return QStringLiteral("%1°").arg(i_Value, 0, 'f', 1);
}

} // namespace

VAlignDialog::VAlignDialog(
    VRetargetPanel& i_rPanel, TesselPluginInterface::ISelection& io_rSelection, QWidget* i_pParent)
    : QDialog(i_pParent), m_rPanel(i_rPanel), m_rSelection(io_rSelection), m_Before(io_rSelection.Items()),
      m_Sources(i_rPanel.SourceSegments()), m_Targets(i_rPanel.TargetSegments()),
      m_pFitScale(Named(new QCheckBox, "AlignFitScale", tr("Scale to the performer"))),
      m_pTable(Named(new QTableWidget(0, EAlignColumnCount), "AlignedJoints", tr("Angles before and after"))),
      m_pNote(Named(new QLabel, "AlignNote", tr("What was done")))
{
	Named(this, "AlignToSource", tr("Align to source"));
	setWindowTitle(tr("Align to Source"));
	setAttribute(Qt::WA_DeleteOnClose);
	m_pTable->setHorizontalHeaderLabels(
	    {tr("Lock"), tr("Character"), tr("Performer"), tr("Before"), tr("After"), tr("Note")});
	m_pTable->horizontalHeaderItem(EAlignLock)->setToolTip(tr("The joint of a ticked row stays as it is"));
	m_pTable->setEditTriggers(QAbstractItemView::NoEditTriggers);
	m_pTable->setSelectionBehavior(QAbstractItemView::SelectRows);
	m_pTable->setSelectionMode(QAbstractItemView::SingleSelection);
	m_pTable->setTabKeyNavigation(false);
	m_pTable->setWordWrap(false);
	for (const int column : {EAlignTarget, EAlignSource})
		m_pTable->setItemDelegateForColumn(column, new VNameColumn(m_pTable));
	m_pTable->verticalHeader()->hide();
	m_pTable->horizontalHeader()->setStretchLastSection(true);
	m_pTable->horizontalHeader()->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
	m_pNote->setWordWrap(true);
	// The rows are made anew, which must not happen to one that is just telling of its change.
	connect(m_pTable, &QTableWidget::itemChanged, this, &VAlignDialog::LockTicked, Qt::QueuedConnection);
	connect(m_pTable, &QTableWidget::currentCellChanged, this, &VAlignDialog::SelectPair);

	auto* const pChains = new QHBoxLayout;
	pChains->addWidget(new QLabel(tr("What is aligned:")));
	// In the order of the document's command.
	for (const auto& [pName, rText] : {std::pair("AlignSpine", tr("&Spine")), {"AlignArms", tr("&Arms")},
	         {"AlignLegs", tr("&Legs")}, {"AlignOthers", tr("&Others")}})
	{
		auto* const pBox = Named(new QCheckBox(rText), pName, QString(rText).remove('&'));
		pBox->setChecked(true);
		connect(pBox, &QCheckBox::toggled, this, &VAlignDialog::Align);
		pChains->addWidget(pBox);
		m_Chains.push_back(pBox);
	}
	pChains->addStretch();
	m_pFeet = Named(new QCheckBox(tr("&Feet with the shins")), "AlignFeet", tr("Feet with the shins"));
	m_pFeet->setToolTip(tr("Feet lean as the shins do, for a performer whose soles do: else they keep their tilt"));
	connect(m_pFeet, &QCheckBox::toggled, this, &VAlignDialog::Align);
	pChains->addWidget(m_pFeet);
	connect(m_pFitScale, &QCheckBox::clicked, this,
	    [this](bool i_bWanted)
	    {
		    m_bFitScale = i_bWanted;
		    Align();
	    });
	auto* const pButtons = Named(
	    new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel), "AlignButtons", tr("Keep or leave"));
	Named(pButtons->button(QDialogButtonBox::Ok), "AlignKeep", tr("Keep this pose"))->setText(tr("&Keep This Pose"));
	Named(pButtons->button(QDialogButtonBox::Cancel), "AlignCancel", tr("Cancel"));
	connect(pButtons, &QDialogButtonBox::accepted, this, &QDialog::accept);
	connect(pButtons, &QDialogButtonBox::rejected, this, &QDialog::reject);
	// Another edit keeps what it was made on; Undo takes it back.
	connect(&m_rPanel, &VRetargetPanel::stateChanged, this,
	    [this]
	    {
		    if (!m_bAtWork && !m_rPanel.IsAligning())
			    close();
	    });
	auto* const pLayout = new QVBoxLayout(this);
	pLayout->addLayout(pChains);
	pLayout->addWidget(m_pFitScale);
	pLayout->addWidget(m_pTable, 1);
	pLayout->addWidget(m_pNote);
	pLayout->addWidget(pButtons);
	resize(540, 620);
	StandBesideView(*this);
}

bool VAlignDialog::Align()
{
	QVariantList chains;
	for (const QCheckBox* const pBox : m_Chains)
		chains << pBox->isChecked();
	QVariantList locked;
	for (const int segment : m_Locked)
		locked << segment;
	m_bAtWork = true;
	const QVariantMap aligned = m_rPanel.AlignToSource(chains, locked, m_bFitScale, m_pFeet->isChecked());
	m_bAtWork = false;
	const QVariantList joints = aligned["joints"].toList();
	{
		const QSignalBlocker blocker(m_pTable);
		m_pTable->setRowCount(joints.size());
		for (int row = 0; row < joints.size(); ++row)
			ShowJoint(row, joints[row].toMap());
	}
	for (int column = 0; column < EAlignNote; ++column)
		m_pTable->resizeColumnToContents(column);
	for (const int column : {EAlignTarget, EAlignSource})
		m_pTable->setColumnWidth(column, std::min(m_pTable->columnWidth(column), c_WidestNames / 2));
	ShowScale(aligned);
	QStringList notes{tr("Angles between the directions of segments. Turned by %1 as a whole, moved by %2 mm along the "
	                     "floor, lifted by %3 mm.")
	                      .arg(Degrees(aligned["turn"].toDouble()))
	                      .arg(aligned["move"].toDouble(), 0, 'f', 1)
	                      .arg(aligned["lift"].toDouble(), 0, 'f', 1)};
	for (const QVariant& rRefused : aligned["refused"].toList())
		notes << rRefused.toString();
	m_pNote->setText(notes.join('\n'));
	return !aligned.isEmpty();
}

void VAlignDialog::ShowScale(const QVariantMap& i_rAligned)
{
	const double scale = i_rAligned["scale"].toDouble();
	const QString heights = i_rAligned["heights"].toString();
	const bool bToFit = !i_rAligned.isEmpty() && scale != 1.0;
	m_pFitScale->setEnabled(bToFit);
	m_pFitScale->setChecked(bToFit && m_bFitScale);
	m_pFitScale->setText(bToFit ? tr("S&cale the character by %1, so that its hips stand as high as the performer's")
	                                  .arg(QLocale::c().toString(scale, 'g', 4))
	        : heights.isEmpty() ? tr("Nothing to s&cale by: no hips are paired")
	                            : tr("Nothing to s&cale: the hips stand as high as the performer's"));
	m_pFitScale->setToolTip(PlainToolTip(heights));
}

void VAlignDialog::ShowJoint(int i_Row, const QVariantMap& i_rJoint)
{
	const int target = i_rJoint["target"].toInt();
	const int source = i_rJoint["source"].toInt();
	const double before = i_rJoint["before"].toDouble();
	const double after = i_rJoint["after"].toDouble();
	const QString note = i_rJoint["note"].toString();
	const QString texts[] = {
	    {}, m_Targets.value(target), m_Sources.value(source), Degrees(before), Degrees(after), note};
	for (int column = 0; column < EAlignColumnCount; ++column)
	{
		auto* const pItem = new QTableWidgetItem(texts[column]);
		pItem->setFlags(Qt::ItemIsEnabled | Qt::ItemIsSelectable);
		if (column == EAlignBefore || column == EAlignAfter)
			pItem->setTextAlignment(Qt::AlignRight | Qt::AlignVCenter);
		m_pTable->setItem(i_Row, column, pItem);
	}
	QTableWidgetItem& rLock = *m_pTable->item(i_Row, EAlignLock);
	rLock.setFlags(rLock.flags() | Qt::ItemIsUserCheckable);
	rLock.setCheckState(m_Locked.contains(target) ? Qt::Checked : Qt::Unchecked);
	rLock.setData(Qt::UserRole, target);
	m_pTable->item(i_Row, EAlignSource)->setData(Qt::UserRole, source);
	for (const int column : {EAlignTarget, EAlignSource, EAlignNote})
		m_pTable->item(i_Row, column)->setToolTip(PlainToolTip(texts[column]));
	// What is not better is what is to be looked at.
	if (after > before + c_SameDegrees)
		m_pTable->item(i_Row, EAlignAfter)->setForeground(QColor(0xE0, 0xAD, 0x4B));
	else if (after < before - c_SameDegrees)
		m_pTable->item(i_Row, EAlignAfter)->setForeground(QColor(0x7F, 0xC8, 0x7F));
}

void VAlignDialog::LockTicked()
{
	bool bChanged = false;
	for (int row = 0; row < m_pTable->rowCount(); ++row)
	{
		const QTableWidgetItem& rLock = *m_pTable->item(row, EAlignLock);
		const int segment = rLock.data(Qt::UserRole).toInt();
		const bool bLocked = rLock.checkState() == Qt::Checked;
		if (bLocked == m_Locked.contains(segment))
			continue;
		bLocked ? void(m_Locked.insert(segment)) : void(m_Locked.erase(segment));
		bChanged = true;
		// A press on a tick alone leaves the row that was chosen.
		m_pTable->setCurrentCell(row, EAlignTarget);
	}
	if (bChanged)
		Align();
}

void VAlignDialog::SelectPair()
{
	if (const int row = m_pTable->currentRow(); row >= 0)
		m_rSelection.Replace(m_rPanel.SegmentItems(m_pTable->item(row, EAlignSource)->data(Qt::UserRole).toInt(),
		    m_pTable->item(row, EAlignLock)->data(Qt::UserRole).toInt()));
}

void VAlignDialog::done(int i_Result)
{
	m_bAtWork = true;
	m_rPanel.EndAlignment(i_Result == Accepted);
	// Nothing of one character is selected in the next.
	if (m_rPanel.SourceSegments() == m_Sources && m_rPanel.TargetSegments() == m_Targets)
		m_rSelection.Replace(m_Before);
	QDialog::done(i_Result);
}

} // namespace StudioHost

#include "moc_AlignDialog.cpp"
