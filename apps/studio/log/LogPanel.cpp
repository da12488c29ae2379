#include "studio/log/LogPanel.h"

#include "DebugServices/GlobalLog.h"
#include "studio/log/LogModel.h"
#include "studio/window/Named.h"

#include <QAction>
#include <QApplication>
#include <QClipboard>
#include <QComboBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLineEdit>
#include <QPushButton>
#include <QScrollBar>
#include <QTableView>
#include <QVBoxLayout>

namespace StudioHost
{

VLogPanel::VLogPanel(VLogModel& i_rModel, QWidget* i_pParent)
    : QWidget(i_pParent), m_rModel(i_rModel), m_pFilter(new VLogFilter(this)),
      m_pTable(Named(new QTableView, "LogTable", tr("Messages"))),
      m_pCategories(Named(new QComboBox, "LogCategory", tr("Category of messages")))
{
	Named(this, "LogPanel", tr("Log"));
	m_pFilter->setSourceModel(&m_rModel);

	auto* const pLevel = Named(new QComboBox, "LogLevel", tr("Level of messages"));
	pLevel->addItem(tr("Errors"), NVX::ELogError);
	pLevel->addItem(tr("Warnings and errors"), NVX::ELogWarning);
	pLevel->addItem(tr("Information"), NVX::ELogInformation);
	pLevel->addItem(tr("Everything"), NVX::ELogDetail);
	connect(pLevel, qOverload<int>(&QComboBox::currentIndexChanged), this,
	    [this, pLevel] { m_pFilter->SetMaximumLevel(pLevel->currentData().toInt()); });
	pLevel->setCurrentIndex(pLevel->findData(NVX::ELogWarning));

	m_pCategories->setSizeAdjustPolicy(QComboBox::AdjustToContents);
	connect(m_pCategories, qOverload<int>(&QComboBox::currentIndexChanged), this,
	    [this](int i_Index) { m_pFilter->SetCategory(i_Index <= 0 ? QString() : m_pCategories->currentText()); });
	connect(&m_rModel, &VLogModel::categoriesChanged, this, &VLogPanel::UpdateCategories);
	UpdateCategories();

	auto* const pText = Named(new QLineEdit, "LogFilter", tr("Text that messages must hold"));
	pText->setPlaceholderText(tr("Filter"));
	// Its icon is looked for in all themes, which an empty field can do without.
	connect(pText, &QLineEdit::textChanged, pText, [pText] { pText->setClearButtonEnabled(true); });
	connect(pText, &QLineEdit::textChanged, m_pFilter, &VLogFilter::SetText);

	auto* const pCopy = Named(new QPushButton(tr("Copy")), "LogCopy", tr("Copy messages"));
	pCopy->setToolTip(tr("Copy the selected messages, or all that are shown"));
	connect(pCopy, &QPushButton::clicked, this, &VLogPanel::Copy);
	auto* const pClear = Named(new QPushButton(tr("Clear")), "LogClear", tr("Clear the list of messages"));
	connect(pClear, &QPushButton::clicked, &m_rModel, &VLogModel::Clear);

	m_pTable->setModel(m_pFilter);
	m_pTable->setSelectionBehavior(QAbstractItemView::SelectRows);
	m_pTable->setEditTriggers(QAbstractItemView::NoEditTriggers);
	m_pTable->setShowGrid(false);
	m_pTable->setWordWrap(false);
	m_pTable->setVerticalScrollMode(QAbstractItemView::ScrollPerPixel);
	m_pTable->verticalHeader()->hide();
	m_pTable->verticalHeader()->setDefaultSectionSize(fontMetrics().height() + 6);
	m_pTable->horizontalHeader()->setStretchLastSection(true);
	m_pTable->horizontalHeader()->setHighlightSections(false);
	m_pTable->horizontalHeader()->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
	m_pTable->horizontalHeader()->resizeSection(VLogModel::ELevel, 90);
	m_pTable->horizontalHeader()->resizeSection(VLogModel::ECategory, 150);
	connect(m_pTable, &QTableView::clicked, this,
	    [this](const QModelIndex& i_rIndex)
	    { emit messageClicked(i_rIndex.data(VLogModel::EWholeTextRole).toString()); });
	auto* const pCopyAction = new QAction(tr("Copy"), m_pTable);
	pCopyAction->setShortcut(QKeySequence::Copy);
	pCopyAction->setShortcutContext(Qt::WidgetShortcut);
	connect(pCopyAction, &QAction::triggered, this, &VLogPanel::Copy);
	m_pTable->addAction(pCopyAction);
	m_pTable->setContextMenuPolicy(Qt::ActionsContextMenu);

	const QScrollBar* const pScroll = m_pTable->verticalScrollBar();
	connect(pScroll, &QScrollBar::valueChanged, this,
	    [this, pScroll](int i_Value) { m_bFollow = i_Value >= pScroll->maximum(); });
	connect(pScroll, &QScrollBar::rangeChanged, this,
	    [this]
	    {
		    if (m_bFollow)
			    m_pTable->scrollToBottom();
	    });

	auto* const pBar = new QHBoxLayout;
	pBar->addWidget(pLevel);
	pBar->addWidget(m_pCategories);
	pBar->addWidget(pText, 1);
	pBar->addWidget(pCopy);
	pBar->addWidget(pClear);
	auto* const pLayout = new QVBoxLayout(this);
	pLayout->setContentsMargins(4, 4, 4, 4);
	pLayout->addLayout(pBar);
	pLayout->addWidget(m_pTable, 1);
}

QString VLogPanel::TextToCopy() const
{
	const QItemSelectionModel& rSelection = *m_pTable->selectionModel();
	QString text;
	for (int row = 0; row < m_pFilter->rowCount(); ++row)
	{
		const auto column = [&](int i_Column) { return m_pFilter->index(row, i_Column).data().toString(); };
		if (!rSelection.hasSelection() || rSelection.isRowSelected(row, {}))
			text +=
			    column(VLogModel::ELevel) + ' ' + column(VLogModel::ECategory) + ": " + column(VLogModel::EText) + '\n';
	}
	return text;
}

void VLogPanel::Copy() const
{
	QApplication::clipboard()->setText(TextToCopy());
}

int VLogPanel::HeightMissingTo(int i_Messages) const
{
	return i_Messages * m_pTable->verticalHeader()->defaultSectionSize() - m_pTable->viewport()->height();
}

void VLogPanel::UpdateCategories()
{
	const QString chosen = m_pCategories->currentIndex() > 0 ? m_pCategories->currentText() : QString();
	const QSignalBlocker blocker(m_pCategories);
	m_pCategories->clear();
	m_pCategories->addItem(tr("All categories"));
	m_pCategories->addItems(m_rModel.Categories());
	m_pCategories->setCurrentIndex(chosen.isEmpty() ? 0 : m_pCategories->findText(chosen));
}

} // namespace StudioHost

#include "moc_LogPanel.cpp"
