#include "studio/window/ProposeDialog.h"

#include "TesselPluginInterface/ISelectionManager.h"
#include "studio/panel/RetargetPanel.h"
#include "studio/window/BesideView.h"
#include "studio/window/Columns.h"
#include "studio/window/Named.h"
#include "studio/window/PlainTexts.h"

#include <QAbstractItemView>
#include <QComboBox>
#include <QDialogButtonBox>
#include <QDir>
#include <QDoubleSpinBox>
#include <QEvent>
#include <QFileDialog>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QLocale>
#include <QPushButton>
#include <QScrollArea>
#include <QScrollBar>
#include <QSignalBlocker>
#include <QStyleOptionComboBox>
#include <QStylePainter>
#include <QTableWidget>
#include <QVBoxLayout>

#include <algorithm>
#include <functional>
#include <map>
#include <utility>
#include <vector>

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
	EPosition,
	ERotation,
	EReasons,
	EProposeColumnCount
};

/// Bits of a kind in its list.
constexpr int c_PositionKind = 1;
constexpr int c_RotationKind = 2;

/// Pairs that score less are not proposed.
constexpr double c_LeastScore = 0.5;
/// A pair that scores less than this wants a look.
constexpr double c_DoubtfulScore = 0.75;
constexpr double c_MostWeight = 1000.0;
constexpr int c_DetailLines = 3;

const char* NameOf(int i_Column)
{
	return i_Column == EPosition ? "position" : "rotation";
}

/// A widget of a cell knows its row by this.
constexpr const char* c_pRow = "row";

/// Of the findings above the table, which a preset of another body may have hundreds of.
constexpr int c_FindingLines = 7;
constexpr int c_WidestPopup = 640;

/// Names, those that are too long without their middle. It holds what comes near until somebody turns to it: of
/// hundreds of rows nobody looks at all lists.
class VTargetBox final : public QComboBox
{
public:
	/// The rest of its list.
	std::function<void()> m_Complete;

	void showPopup() override
	{
		Complete();
		view()->setTextElideMode(Qt::ElideMiddle);
		const int wanted = view()->sizeHintForColumn(0) + view()->verticalScrollBar()->sizeHint().width();
		view()->setMinimumWidth(std::min(wanted, c_WidestPopup));
		QComboBox::showPopup();
	}

protected:
	void focusInEvent(QFocusEvent* i_pEvent) override
	{
		Complete();
		QComboBox::focusInEvent(i_pEvent);
	}
	void paintEvent(QPaintEvent*) override
	{
		QStylePainter painter(this);
		QStyleOptionComboBox option;
		initStyleOption(&option);
		painter.drawComplexControl(QStyle::CC_ComboBox, option);
		const int room =
		    style()->subControlRect(QStyle::CC_ComboBox, &option, QStyle::SC_ComboBoxEditField, this).width();
		option.currentText = fontMetrics().elidedText(option.currentText, Qt::ElideMiddle, room - 4);
		painter.drawControl(QStyle::CE_ComboBoxLabel, option);
	}

private:
	void Complete()
	{
		if (const auto complete = std::exchange(m_Complete, {}))
			complete();
	}
};

} // namespace

VProposeDialog::VProposeDialog(VRetargetPanel& i_rPanel, TesselPluginInterface::ISelection& io_rSelection,
    const QString& i_rPresetFolder, QWidget* i_pParent)
    : QDialog(i_pParent), m_rPanel(i_rPanel), m_rSelection(io_rSelection), m_Before(io_rSelection.Items()),
      m_Sources(i_rPanel.SourceSegments()), m_Targets(i_rPanel.TargetSegments()), m_PresetFolder(i_rPresetFolder),
      m_pTable(Named(new QTableWidget(0, EProposeColumnCount), "Pairs", tr("Proposed pairs"))),
      m_pOrigin(Named(new QComboBox, "PairsOrigin", tr("Where the pairs come from"))),
      m_pLeastScore(Named(new QDoubleSpinBox, "LeastScore", tr("Least score"))),
      m_pFilter(Named(new QLineEdit, "PairsFilter", tr("Rows whose names have this"))),
      m_pFindings(Named(new QLabel, "Findings", tr("How the two stand"))),
      m_pFindingsArea(Named(new QScrollArea, "FindingsArea", tr("How the two stand"))),
      m_pDetails(Named(new QLabel, "PairDetails", tr("All that is told of the pair"))),
      m_pNote(Named(new QLabel, "PairsNote", tr("Note on the pairs")))
{
	Named(this, "ProposeTargets", tr("Propose targets"));
	setWindowTitle(tr("Propose Targets"));
	setAttribute(Qt::WA_DeleteOnClose);
	m_pTable->setHorizontalHeaderLabels(
	    {tr("Performer"), tr("Character"), tr("Score"), tr("Targets"), tr("Position"), tr("Rotation"), tr("Reasons")});
	for (const int column : {EPosition, ERotation})
		m_pTable->horizontalHeaderItem(column)->setToolTip(tr("Weight of the target of this kind"));
	m_pTable->setSelectionBehavior(QAbstractItemView::SelectRows);
	m_pTable->setSelectionMode(QAbstractItemView::SingleSelection);
	m_pTable->setEditTriggers(QAbstractItemView::NoEditTriggers);
	m_pTable->setTabKeyNavigation(false);
	m_pTable->setWordWrap(false);
	m_pTable->setItemDelegateForColumn(ESource, new VNameColumn(m_pTable));
	m_pTable->verticalHeader()->hide();
	m_pTable->horizontalHeader()->setStretchLastSection(true);
	m_pTable->horizontalHeader()->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
	m_pFilter->setPlaceholderText(tr("Filter"));
	m_pFilter->setClearButtonEnabled(true);
	m_pFilter->setMaximumWidth(c_WidestNames);
	m_pLeastScore->setLocale(QLocale::c());
	m_pLeastScore->setRange(0.0, 1.0);
	m_pLeastScore->setSingleStep(0.05);
	m_pLeastScore->setValue(c_LeastScore);
	for (QLabel* const pLabel : {m_pFindings, m_pDetails, m_pNote})
	{
		pLabel->setWordWrap(true);
		pLabel->setTextInteractionFlags(Qt::TextSelectableByMouse);
	}
	m_pFindingsArea->setFrameShape(QFrame::NoFrame);
	m_pFindingsArea->setWidgetResizable(true);
	m_pFindingsArea->setWidget(m_pFindings);
	m_pFindings->setAlignment(Qt::AlignLeft | Qt::AlignTop);
	m_pDetails->setAlignment(Qt::AlignLeft | Qt::AlignTop);
	m_pDetails->setMinimumHeight(c_DetailLines * fontMetrics().lineSpacing());
	ListPresets();

	auto* const pButtons = Named(new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel),
	    "ProposeButtons", tr("Take over or leave"));
	m_pAdd = Named(pButtons->button(QDialogButtonBox::Ok), "ProposeAdd", tr("Add the targets of the ticked rows"));
	Named(pButtons->button(QDialogButtonBox::Cancel), "ProposeCancel", tr("Cancel"));
	for (const auto& [pName, rText, bTicked] :
	    {std::tuple("TickAll", tr("&Tick All"), true), {"TickNone", tr("Tick &None"), false}})
	{
		auto* const pButton = Named(new QPushButton(rText), pName, QString(rText).remove('&'));
		pButton->setAutoDefault(false);
		pButtons->addButton(pButton, QDialogButtonBox::ResetRole);
		connect(pButton, &QPushButton::clicked, this, [this, bTicked = bTicked] { TickAll(bTicked); });
	}
	connect(pButtons, &QDialogButtonBox::accepted, this, &VProposeDialog::accept);
	connect(pButtons, &QDialogButtonBox::rejected, this, &VProposeDialog::reject);
	connect(m_pLeastScore, qOverload<double>(&QDoubleSpinBox::valueChanged), this, &VProposeDialog::Fill);
	connect(m_pFilter, &QLineEdit::textChanged, this, &VProposeDialog::Filter);
	connect(m_pOrigin, qOverload<int>(&QComboBox::activated), this, &VProposeDialog::ChooseOrigin);
	connect(m_pTable, &QTableWidget::currentCellChanged, this, &VProposeDialog::SelectPair);
	connect(m_pTable, &QTableWidget::itemChanged, this,
	    [this](QTableWidgetItem* i_pItem)
	    {
		    // A press on a tick alone leaves the row that was chosen.
		    if (i_pItem->column() == ESource)
			    m_pTable->setCurrentItem(i_pItem);
		    UpdateNote();
	    });
	connect(&m_rPanel, &VRetargetPanel::segmentsChanged, this,
	    [this]
	    {
		    if (!IsOfTheirs())
			    reject();
	    });

	auto* const pOrigin = new QHBoxLayout;
	const auto add = [&](const QString& i_rText, QWidget* i_pWidget)
	{
		auto* const pLabel = new QLabel(i_rText);
		pLabel->setBuddy(i_pWidget);
		pOrigin->addWidget(pLabel);
		pOrigin->addWidget(i_pWidget);
	};
	add(tr("&Pairs from"), m_pOrigin);
	add(tr("&Least score"), m_pLeastScore);
	add(tr("&Show"), m_pFilter);
	pOrigin->addWidget(m_pNote, 1);
	auto* const pLayout = new QVBoxLayout(this);
	pLayout->addLayout(pOrigin);
	pLayout->addWidget(m_pFindingsArea);
	pLayout->addWidget(m_pTable, 1);
	pLayout->addWidget(m_pDetails);
	pLayout->addWidget(pButtons);
	resize(1000, 620);
	StandBesideView(*this);
	Fill();
}

bool VProposeDialog::IsOfTheirs() const
{
	return m_rPanel.SourceSegments() == m_Sources && m_rPanel.TargetSegments() == m_Targets;
}

void VProposeDialog::ListPresets()
{
	m_pOrigin->addItem(tr("What is proposed"));
	if (!m_PresetFolder.isEmpty())
		for (const QFileInfo& rFile :
		    QDir(m_PresetFolder).entryInfoList({QStringLiteral("*.json")}, QDir::Files, QDir::Name))
			m_pOrigin->addItem(ShownText(rFile.completeBaseName()), rFile.absoluteFilePath());
	m_pOrigin->addItem(tr("Another preset..."));
}

void VProposeDialog::ChooseOrigin()
{
	if (m_pOrigin->currentIndex() == m_pOrigin->count() - 1)
	{
		const QString file =
		    QFileDialog::getOpenFileName(this, tr("Choose a file"), m_PresetFolder, tr("Presets (*.json)"));
		if (!file.isEmpty())
			m_pOrigin->insertItem(m_pOrigin->count() - 1, ShownText(QFileInfo(file).completeBaseName()), file);
		m_pOrigin->setCurrentIndex(file.isEmpty() ? m_Origin : m_pOrigin->count() - 2);
	}
	m_Origin = m_pOrigin->currentIndex();
	Fill();
}

void VProposeDialog::Fill()
{
	const QString preset = m_pOrigin->currentData().toString();
	m_Proposal = preset.isEmpty() ? m_rPanel.ProposeTargets(m_pLeastScore->value())
	                              : m_rPanel.FitPreset(preset, m_pLeastScore->value());
	QStringList lines = m_Proposal["findings"].toStringList();
	if (const QString noBody = m_Proposal["noBody"].toString(); !noBody.isEmpty())
		lines.prepend(noBody);
	const QStringList misfits = m_Proposal["misfits"].toStringList();
	if (!misfits.isEmpty())
		lines << tr("%1 pairs of the preset do not fit:").arg(misfits.size()) << misfits;
	if (m_Proposal.isEmpty())
		lines << tr("This is no preset that could be read: the log tells why.");
	m_pFindings->setText(lines.join('\n'));
	m_pFindingsArea->setVisible(!lines.isEmpty());
	m_pFindingsArea->setMaximumHeight(std::min(int(lines.size()) * 2, c_FindingLines) * fontMetrics().lineSpacing()
	    + fontMetrics().lineSpacing() / 2);
	{
		const QSignalBlocker blocker(m_pTable);
		m_pTable->setRowCount(0);
		for (const QVariant& rPair : m_Proposal["pairs"].toList())
			AddRow(rPair.toMap()["source"].toInt(), rPair.toMap()["target"].toInt(), {});
		for (const QVariant& rUnmapped : m_Proposal["unmapped"].toList())
			AddRow(rUnmapped.toMap()["source"].toInt(), -1, rUnmapped.toMap()["reason"].toString());
		for (int column = ESource; column < EReasons; ++column)
			m_pTable->resizeColumnToContents(column);
		for (const int column : {ESource, ETarget})
			m_pTable->setColumnWidth(column, std::min(m_pTable->columnWidth(column), c_WidestNames));
	}
	Filter();
	m_pTable->setCurrentCell(0, ESource);
	UpdateNote();
}

void VProposeDialog::Filter()
{
	const QString wanted = m_pFilter->text().trimmed();
	for (int row = 0; row < m_pTable->rowCount(); ++row)
		m_pTable->setRowHidden(row,
		    !m_pTable->item(row, ESource)->text().contains(wanted, Qt::CaseInsensitive)
		        && !m_Targets.value(TargetOf(row)).contains(wanted, Qt::CaseInsensitive));
}

void VProposeDialog::AddRow(int i_Source, int i_Target, const QString& i_rReason)
{
	const int row = m_pTable->rowCount();
	m_pTable->insertRow(row);
	for (int column = 0; column < EProposeColumnCount; ++column)
	{
		auto* const pItem = new QTableWidgetItem;
		pItem->setFlags(Qt::ItemIsEnabled | Qt::ItemIsSelectable);
		m_pTable->setItem(row, column, pItem);
	}
	QTableWidgetItem& rSource = *m_pTable->item(row, ESource);
	rSource.setText(m_Sources.value(i_Source));
	rSource.setToolTip(PlainToolTip(rSource.text()));
	rSource.setData(Qt::UserRole, i_Source);
	rSource.setFlags(rSource.flags() | Qt::ItemIsUserCheckable);
	const bool bTick = i_Target >= 0 && !PairOf(i_Source, i_Target)["present"].toBool();
	rSource.setCheckState(bTick ? Qt::Checked : Qt::Unchecked);
	m_pTable->item(row, EScore)->setTextAlignment(Qt::AlignRight | Qt::AlignVCenter);

	const auto put = [&](int i_Column, auto* i_pWidget, const char* i_pName, const QString& i_rText)
	{
		Named(i_pWidget, (QLatin1String(i_pName) + QString::number(row)).toUtf8(), i_rText.arg(rSource.text()));
		i_pWidget->setProperty(c_pRow, row);
		i_pWidget->installEventFilter(this);
		m_pTable->setCellWidget(row, i_Column, i_pWidget);
	};
	auto* const pBox = new VTargetBox;
	pBox->addItem(tr("(none)"), -1);
	// What comes near first.
	for (const char* const pList : {"pairs", "alternatives"})
		for (const QVariant& rPair : m_Proposal[pList].toList())
			if (const QVariantMap pair = rPair.toMap();
			    pair["source"].toInt() == i_Source && pBox->findData(pair["target"]) == -1)
			{
				const QString name = m_Targets.value(pair["target"].toInt());
				pBox->addItem(pair.contains("score")
				        ? QStringLiteral("%1  (%2)").arg(name, QString::number(pair["score"].toDouble(), 'f', 2))
				        : name,
				    pair["target"]);
			}
	pBox->m_Complete = [this, pBox]
	{
		std::vector<bool> listed(std::size_t(m_Targets.size()));
		for (int i = 0; i < pBox->count(); ++i)
			if (const int target = pBox->itemData(i).toInt(); target >= 0)
				listed[std::size_t(target)] = true;
		for (int target = 0; target < m_Targets.size(); ++target)
			if (!listed[std::size_t(target)])
				pBox->addItem(m_Targets[target], target);
	};
	pBox->setCurrentIndex(pBox->findData(i_Target));
	connect(pBox, qOverload<int>(&QComboBox::activated), this,
	    [this, row]
	    {
		    m_pTable->item(row, ESource)->setCheckState(TargetOf(row) >= 0 ? Qt::Checked : Qt::Unchecked);
		    ShowPair(row, {});
		    m_pTable->setCurrentCell(row, ETarget);
		    SelectPair();
		    UpdateNote();
	    });
	put(ETarget, pBox, "Target", tr("Target of %1"));

	auto* const pKind = new QComboBox;
	pKind->addItem(tr("position"), c_PositionKind);
	pKind->addItem(tr("rotation"), c_RotationKind);
	pKind->addItem(tr("both"), c_PositionKind | c_RotationKind);
	connect(pKind, qOverload<int>(&QComboBox::activated), this,
	    [this, row]
	    {
		    ShowKinds(row);
		    UpdateNote();
	    });
	put(EKind, pKind, "Kind", tr("Kinds of targets of %1"));
	for (const int column : {EPosition, ERotation})
	{
		auto* const pWeight = new QDoubleSpinBox;
		pWeight->setLocale(QLocale::c());
		pWeight->setRange(0.0, c_MostWeight);
		pWeight->setSingleStep(0.1);
		pWeight->setFrame(false);
		// 0 is no target of the kind.
		pWeight->setSpecialValueText(QStringLiteral("-"));
		// What was shown in fewer digits is what it was.
		connect(pWeight, qOverload<double>(&QDoubleSpinBox::valueChanged), this,
		    [this, row, column](double i_Value)
		    {
			    m_pTable->item(row, column)->setData(Qt::UserRole, i_Value);
			    UpdateNote();
		    });
		put(column, pWeight, column == EPosition ? "Position" : "Rotation",
		    column == EPosition ? tr("Weight of the position of %1") : tr("Weight of the rotation of %1"));
	}
	ShowPair(row, i_rReason);
}

bool VProposeDialog::eventFilter(QObject* i_pWatched, QEvent* i_pEvent)
{
	const QVariant row = i_pWatched->property(c_pRow);
	// The wheel is for the table: what it would change in passing is not seen.
	if (row.isValid() && i_pEvent->type() == QEvent::Wheel)
	{
		i_pEvent->ignore();
		return true;
	}
	if (row.isValid() && i_pEvent->type() == QEvent::FocusIn)
		m_pTable->setCurrentCell(row.toInt(), ESource);
	return QDialog::eventFilter(i_pWatched, i_pEvent);
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

int VProposeDialog::TargetOf(int i_Row) const
{
	return BoxOf(i_Row)->currentData().toInt();
}

bool VProposeDialog::IsTicked(int i_Row) const
{
	return m_pTable->item(i_Row, ESource)->checkState() == Qt::Checked && TargetOf(i_Row) >= 0;
}

double VProposeDialog::WeightOf(int i_Row, int i_Column) const
{
	const int kind = static_cast<QComboBox*>(m_pTable->cellWidget(i_Row, EKind))->currentData().toInt();
	const bool bOfKind = kind & (i_Column == EPosition ? c_PositionKind : c_RotationKind);
	return bOfKind ? m_pTable->item(i_Row, i_Column)->data(Qt::UserRole).toDouble() : 0.0;
}

void VProposeDialog::ShowPair(int i_Row, const QString& i_rReason)
{
	const int target = TargetOf(i_Row);
	BoxOf(i_Row)->setToolTip(PlainToolTip(m_Targets.value(target)));
	const QVariantMap pair = target >= 0 ? PairOf(SourceOf(i_Row), target) : QVariantMap{{"reasons", i_rReason}};
	const QVariant score = pair["score"];
	QTableWidgetItem& rScore = *m_pTable->item(i_Row, EScore);
	rScore.setText(score.isValid() ? QString::number(score.toDouble(), 'f', 2) : QString());
	rScore.setForeground(score.isValid() && score.toDouble() < c_DoubtfulScore ? QColor(0xE0, 0xAD, 0x4B)
	                                                                           : palette().color(QPalette::Text));
	int kind = 0;
	for (const int column : {EPosition, ERotation})
	{
		const double weight = pair[NameOf(column)].toDouble();
		if (weight > 0.0)
			kind |= column == EPosition ? c_PositionKind : c_RotationKind;
		m_pTable->item(i_Row, column)->setData(Qt::UserRole, weight > 0.0 ? weight : 1.0);
	}
	auto& rKind = *static_cast<QComboBox*>(m_pTable->cellWidget(i_Row, EKind));
	rKind.setCurrentIndex(rKind.findData(kind));
	rKind.setEnabled(target >= 0);
	ShowKinds(i_Row);
	const QString reasons =
	    (pair["present"].toBool() ? tr("its targets are there already; ") : QString()) + pair["reasons"].toString();
	m_pTable->item(i_Row, EReasons)->setText(reasons);
	m_pTable->item(i_Row, EReasons)->setToolTip(PlainToolTip(reasons));
}

void VProposeDialog::ShowKinds(int i_Row)
{
	for (const int column : {EPosition, ERotation})
	{
		auto& rWeight = *static_cast<QDoubleSpinBox*>(m_pTable->cellWidget(i_Row, column));
		const QSignalBlocker blocker(&rWeight);
		const double weight = WeightOf(i_Row, column);
		rWeight.setValue(weight);
		rWeight.setEnabled(weight > 0.0);
	}
}

void VProposeDialog::TickAll(bool i_bTicked)
{
	{
		const QSignalBlocker blocker(m_pTable);
		for (int row = 0; row < m_pTable->rowCount(); ++row)
			if (!m_pTable->isRowHidden(row))
				m_pTable->item(row, ESource)
				    ->setCheckState(i_bTicked && TargetOf(row) >= 0 ? Qt::Checked : Qt::Unchecked);
	}
	m_pTable->viewport()->update();
	UpdateNote();
}

void VProposeDialog::SelectPair()
{
	const int row = m_pTable->currentRow();
	if (row >= 0 && BoxOf(row))
		m_rSelection.Replace(m_rPanel.SegmentItems(SourceOf(row), TargetOf(row)));
	ShowDetails();
}

void VProposeDialog::ShowDetails()
{
	const int row = m_pTable->currentRow();
	if (row < 0 || !BoxOf(row))
		return m_pDetails->clear();
	const int target = TargetOf(row);
	const QString score = m_pTable->item(row, EScore)->text();
	QString text = target >= 0 ? tr("%1 and %2").arg(m_Sources.value(SourceOf(row)), m_Targets.value(target))
	                           : tr("%1 without a pair").arg(m_Sources.value(SourceOf(row)));
	if (!score.isEmpty())
		text += tr(", score %1").arg(score);
	m_pDetails->setText(text + QStringLiteral(": ") + m_pTable->item(row, EReasons)->text());
}

void VProposeDialog::UpdateNote()
{
	std::map<int, int> uses;
	for (int row = 0; row < m_pTable->rowCount(); ++row)
		if (IsTicked(row))
			++uses[TargetOf(row)];
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
	ShowDetails();
}

QVariantList VProposeDialog::TickedTargets() const
{
	QVariantList targets;
	for (int row = 0; row < m_pTable->rowCount(); ++row)
		for (const int column : {EPosition, ERotation})
			if (const double weight = WeightOf(row, column); IsTicked(row) && weight > 0.0)
				targets << QVariantMap{{"source", SourceOf(row)}, {"target", TargetOf(row)},
				    {"position", column == EPosition}, {"weight", weight}};
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

#include "moc_ProposeDialog.cpp"
