#include "studio/window/ProposeDialog.h"

#include "TesselPluginInterface/ISelectionManager.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/window/Named.h"
#include "studio/window/PlainTexts.h"

#include <QComboBox>
#include <QDialogButtonBox>
#include <QDoubleSpinBox>
#include <QHeaderView>
#include <QLabel>
#include <QPushButton>
#include <QSignalBlocker>
#include <QTableWidget>
#include <QVBoxLayout>

#include <map>

namespace StudioHost
{
namespace
{

enum EColumn
{
	ESource,
	ETarget,
	EScore,
	EKind,
	EReasons,
	EColumnCount
};

/// Pairs that score less are not proposed.
constexpr double c_LeastScore = 0.5;

QString Number(double i_Value)
{
	return QString::number(i_Value, 'g', 3);
}

QString KindOf(const QVariantMap& i_rPair)
{
	QStringList kinds;
	for (const char* const pKind : {"position", "rotation"})
		if (const double weight = i_rPair[pKind].toDouble(); weight > 0.0)
			kinds << QStringLiteral("%1 %2").arg(QLatin1String(pKind), Number(weight));
	return kinds.join(QStringLiteral(", "));
}

} // namespace

VProposeDialog::VProposeDialog(
    VRetargetPanel& i_rPanel, TesselPluginInterface::ISelection& io_rSelection, QWidget* i_pParent)
    : QDialog(i_pParent), m_rPanel(i_rPanel), m_rSelection(io_rSelection), m_Before(io_rSelection.Items()),
      m_Sources(i_rPanel.SourceSegments()), m_Targets(i_rPanel.TargetSegments()),
      m_pTable(Named(new QTableWidget(0, EColumnCount), "Pairs", tr("Proposed pairs"))),
      m_pLeastScore(Named(new QDoubleSpinBox, "LeastScore", tr("Least score"))),
      m_pFindings(Named(new QLabel, "Findings", tr("How the two stand"))),
      m_pNote(Named(new QLabel, "PairsNote", tr("Note on the pairs")))
{
	Named(this, "ProposeTargets", tr("Propose targets"));
	setWindowTitle(tr("Propose Targets"));
	setAttribute(Qt::WA_DeleteOnClose);

	m_pTable->setHorizontalHeaderLabels(
	    {tr("Source"), tr("Target"), tr("Score"), tr("Targets, weights"), tr("Reasons")});
	m_pTable->setSelectionBehavior(QAbstractItemView::SelectRows);
	m_pTable->setSelectionMode(QAbstractItemView::SingleSelection);
	m_pTable->setEditTriggers(QAbstractItemView::NoEditTriggers);
	m_pTable->verticalHeader()->hide();
	m_pTable->horizontalHeader()->setStretchLastSection(true);
	m_pLeastScore->setRange(0.0, 1.0);
	m_pLeastScore->setSingleStep(0.05);
	m_pLeastScore->setValue(c_LeastScore);
	for (QLabel* const pLabel : {m_pFindings, m_pNote})
		pLabel->setWordWrap(true);

	auto* const pButtons = Named(new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel),
	    "ProposeButtons", tr("Take over or leave"));
	m_pAdd = Named(pButtons->button(QDialogButtonBox::Ok), "ProposeAdd", tr("Add the targets of the ticked rows"));
	Named(pButtons->button(QDialogButtonBox::Cancel), "ProposeCancel", tr("Cancel"));
	connect(pButtons, &QDialogButtonBox::accepted, this, &VProposeDialog::accept);
	connect(pButtons, &QDialogButtonBox::rejected, this, &VProposeDialog::reject);
	connect(m_pLeastScore, qOverload<double>(&QDoubleSpinBox::valueChanged), this, &VProposeDialog::Fill);
	connect(m_pTable, &QTableWidget::currentCellChanged, this, &VProposeDialog::SelectPair);
	connect(m_pTable, &QTableWidget::itemChanged, this, &VProposeDialog::UpdateNote);
	connect(&m_rPanel, &VRetargetPanel::segmentsChanged, this,
	    [this]
	    {
		    if (!IsOfTheirs())
			    reject();
	    });

	auto* const pScore = new QHBoxLayout;
	auto* const pScoreLabel = new QLabel(tr("&Least score"));
	pScoreLabel->setBuddy(m_pLeastScore);
	pScore->addWidget(pScoreLabel);
	pScore->addWidget(m_pLeastScore);
	pScore->addWidget(m_pNote, 1);
	auto* const pLayout = new QVBoxLayout(this);
	pLayout->addWidget(m_pFindings);
	pLayout->addWidget(m_pTable, 1);
	pLayout->addLayout(pScore);
	pLayout->addWidget(pButtons);
	resize(900, 560);
	Fill();
}

bool VProposeDialog::IsOfTheirs() const
{
	return m_rPanel.SourceSegments() == m_Sources && m_rPanel.TargetSegments() == m_Targets;
}

void VProposeDialog::Fill()
{
	m_Proposal = m_rPanel.ProposeTargets(m_pLeastScore->value());
	m_pFindings->setText(m_Proposal["findings"].toStringList().join('\n'));
	m_pFindings->setVisible(!m_pFindings->text().isEmpty());
	{
		const QSignalBlocker blocker(m_pTable);
		m_pTable->setRowCount(0);
		for (const QVariant& rPair : m_Proposal["pairs"].toList())
			AddRow(rPair.toMap()["source"].toInt(), rPair.toMap()["target"].toInt(), {});
		for (const QVariant& rUnmapped : m_Proposal["unmapped"].toList())
			AddRow(rUnmapped.toMap()["source"].toInt(), -1, rUnmapped.toMap()["reason"].toString());
		for (const int column : {ESource, ETarget, EScore, EKind})
			m_pTable->resizeColumnToContents(column);
	}
	m_pTable->setCurrentCell(0, ESource);
	UpdateNote();
}

void VProposeDialog::AddRow(int i_Source, int i_Target, const QString& i_rReason)
{
	const int row = m_pTable->rowCount();
	m_pTable->insertRow(row);
	for (int column = 0; column < EColumnCount; ++column)
		m_pTable->setItem(row, column, new QTableWidgetItem);
	QTableWidgetItem& rSource = *m_pTable->item(row, ESource);
	rSource.setText(m_Sources.value(i_Source));
	rSource.setData(Qt::UserRole, i_Source);
	rSource.setFlags(Qt::ItemIsEnabled | Qt::ItemIsSelectable | Qt::ItemIsUserCheckable);
	const bool bTick = i_Target >= 0 && !PairOf(i_Source, i_Target)["present"].toBool();
	rSource.setCheckState(bTick ? Qt::Checked : Qt::Unchecked);

	auto* const pBox =
	    Named(new QComboBox, QStringLiteral("Target%1").arg(row).toUtf8(), tr("Target of %1").arg(rSource.text()));
	pBox->addItem(tr("(none)"), -1);
	// What comes near first.
	for (const char* const pList : {"pairs", "alternatives"})
		for (const QVariant& rPair : m_Proposal[pList].toList())
			if (const QVariantMap pair = rPair.toMap(); pair["source"].toInt() == i_Source)
				pBox->addItem(QStringLiteral("%1  (%2)")
				                  .arg(m_Targets.value(pair["target"].toInt()),
				                      QString::number(pair["score"].toDouble(), 'f', 2)),
				    pair["target"]);
	for (int target = 0; target < m_Targets.size(); ++target)
		if (pBox->findData(target) == -1)
			pBox->addItem(m_Targets[target], target);
	pBox->setCurrentIndex(pBox->findData(i_Target));
	connect(pBox, qOverload<int>(&QComboBox::activated), this,
	    [this, row]
	    {
		    m_pTable->item(row, ESource)
		        ->setCheckState(BoxOf(row)->currentData().toInt() >= 0 ? Qt::Checked : Qt::Unchecked);
		    ShowPair(row, {});
		    m_pTable->setCurrentCell(row, ETarget);
		    SelectPair();
		    UpdateNote();
	    });
	m_pTable->setCellWidget(row, ETarget, pBox);
	ShowPair(row, i_rReason);
}

QVariantMap VProposeDialog::PairOf(int i_Source, int i_Target) const
{
	for (const char* const pList : {"pairs", "alternatives"})
		for (const QVariant& rPair : m_Proposal[pList].toList())
			if (const QVariantMap pair = rPair.toMap();
			    pair["source"].toInt() == i_Source && pair["target"].toInt() == i_Target)
				return pair;
	return {{"source", i_Source}, {"target", i_Target}, {"rotation", 1.0}, {"reasons", tr("chosen by hand")}};
}

QComboBox* VProposeDialog::BoxOf(int i_Row) const
{
	return static_cast<QComboBox*>(m_pTable->cellWidget(i_Row, ETarget));
}

int VProposeDialog::SourceOf(int i_Row) const
{
	return m_pTable->item(i_Row, ESource)->data(Qt::UserRole).toInt();
}

bool VProposeDialog::IsTicked(int i_Row) const
{
	return m_pTable->item(i_Row, ESource)->checkState() == Qt::Checked && BoxOf(i_Row)->currentData().toInt() >= 0;
}

void VProposeDialog::ShowPair(int i_Row, const QString& i_rReason)
{
	const int target = BoxOf(i_Row)->currentData().toInt();
	const QVariantMap pair = target >= 0 ? PairOf(SourceOf(i_Row), target) : QVariantMap{{"reasons", i_rReason}};
	const QVariant score = pair["score"];
	m_pTable->item(i_Row, EScore)->setText(score.isValid() ? QString::number(score.toDouble(), 'f', 2) : QString());
	m_pTable->item(i_Row, EKind)->setText(KindOf(pair));
	const QString reasons =
	    (pair["present"].toBool() ? tr("its targets are there already; ") : QString()) + pair["reasons"].toString();
	m_pTable->item(i_Row, EReasons)->setText(reasons);
	m_pTable->item(i_Row, EReasons)->setToolTip(PlainToolTip(reasons));
}

void VProposeDialog::SelectPair()
{
	const int row = m_pTable->currentRow();
	if (row >= 0 && BoxOf(row))
		m_rSelection.Replace(m_rPanel.SegmentItems(SourceOf(row), BoxOf(row)->currentData().toInt()));
}

void VProposeDialog::UpdateNote()
{
	std::map<int, int> uses;
	for (int row = 0; row < m_pTable->rowCount(); ++row)
		if (IsTicked(row))
			++uses[BoxOf(row)->currentData().toInt()];
	QStringList twice;
	for (const auto& [target, count] : uses)
		if (count > 1)
			twice << m_Targets.value(target);
	m_pNote->setText(m_pTable->rowCount() == 0 ? tr("Nothing can be proposed: the log tells why.")
	        : twice.isEmpty()
	        ? tr("Without a pair: %1 of the performer's segments").arg(m_pTable->rowCount() - int(uses.size()))
	        : tr("In several ticked rows: %1").arg(twice.join(QStringLiteral(", "))));
	const int count = TickedTargets().size();
	m_pAdd->setText(tr("&Add %1 Targets").arg(count));
	m_pAdd->setEnabled(count > 0);
}

QVariantList VProposeDialog::TickedTargets() const
{
	QVariantList targets;
	for (int row = 0; row < m_pTable->rowCount(); ++row)
	{
		if (!IsTicked(row))
			continue;
		const QVariantMap pair = PairOf(SourceOf(row), BoxOf(row)->currentData().toInt());
		for (const char* const pKind : {"position", "rotation"})
			if (const QVariant weight = pair[pKind]; weight.toDouble() > 0.0)
				targets << QVariantMap{{"source", pair["source"]}, {"target", pair["target"]},
				    {"position", QLatin1String(pKind) == QLatin1String("position")}, {"weight", weight}};
	}
	return targets;
}

void VProposeDialog::accept()
{
	const QVariantList targets = TickedTargets();
	// First what was selected, which an undo brings back, too.
	QDialog::accept();
	m_rPanel.AddTargets(targets);
}

void VProposeDialog::done(int i_Result)
{
	// Nothing of one character is selected in the next.
	if (IsOfTheirs())
		m_rSelection.Replace(m_Before);
	QDialog::done(i_Result);
}

} // namespace StudioHost
