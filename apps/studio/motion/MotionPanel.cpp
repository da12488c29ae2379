#include "studio/motion/MotionPanel.h"

#include "DebugServices/GlobalLog.h"
#include "TesselPluginInterface/IPluginContext.h"
#include "TesselPluginInterface/ISelectionManager.h"
#include "studio/motion/ResidualModel.h"
#include "studio/motion/ResidualPlot.h"
#include "studio/motion/TimeLine.h"
#include "studio/window/Named.h"
#include "studio/window/PlainTexts.h"

#include <QAction>
#include <QCheckBox>
#include <QComboBox>
#include <QFileDialog>
#include <QFileInfo>
#include <QFontMetrics>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLabel>
#include <QProgressBar>
#include <QShortcut>
#include <QSplitter>
#include <QTableView>
#include <QToolButton>
#include <QVBoxLayout>

namespace StudioHost
{
namespace
{

/// Of the width.
constexpr int c_TableShare = 560;
constexpr int c_PlotShare = 440;
constexpr double c_Speeds[] = {0.1, 0.25, 0.5, 1.0, 2.0, 4.0};
constexpr int c_Keys[] = {Qt::Key_Space, Qt::Key_Left, Qt::Key_Right, Qt::Key_Home, Qt::Key_End};

} // namespace

VMotionPanel::VMotionPanel(TesselPluginInterface::IPluginContext& i_rContext, QAction& i_rOpen, QWidget* i_pParent)
    : QWidget(i_pParent), m_Player(i_rContext.GetItemFactory(), i_rContext.GetFrameFactory()),
      m_pModel(new VResidualModel(m_Player, this)), m_rSelection(i_rContext.GetSelectionManager()->Selection()),
      m_pFile(Named(new QLabel, "TakeFile", tr("The take"))),
      m_pFrame(Named(new QLabel, "TakeFrame", tr("The frame that is shown"))),
      m_pProgress(Named(new QProgressBar, "TakeProgress", tr("How far the take is read, solved or written")))
{
	Named(this, "MotionPanel", tr("Motion"));
	auto* const pLayout = new QVBoxLayout(this);
	pLayout->setContentsMargins(4, 4, 4, 4);
	MakeControls(i_rOpen);
	pLayout->addWidget(new VTimeLine(m_Player));
	m_pPlot = new VResidualPlot(m_Player, *m_pModel);
	auto* const pSplitter = Named(new QSplitter, "TakeNumbers", tr("How far the targets are off"));
	pSplitter->addWidget(MakeTable());
	pSplitter->addWidget(m_pPlot);
	pSplitter->setSizes({c_TableShare, c_PlotShare});
	pLayout->addWidget(pSplitter, 1);

	for (const int key : c_Keys)
		connect(new QShortcut(QKeySequence(key), this, nullptr, nullptr, Qt::WidgetWithChildrenShortcut),
		    &QShortcut::activated, this, [this, key] { PressKey(key); });
	for (const auto signal : {&VTakePlayer::takeChanged, &VTakePlayer::stateChanged, &VTakePlayer::solvedChanged})
		connect(&m_Player, signal, this, &VMotionPanel::UpdateControls);
	for (const auto signal : {&VTakePlayer::takeChanged, &VTakePlayer::frameChanged, &VTakePlayer::stateChanged})
		connect(&m_Player, signal, this, &VMotionPanel::UpdateFrame);
	for (const auto signal : {&VTakePlayer::takeChanged, &VTakePlayer::solvedChanged})
		connect(&m_Player, signal, this, &VMotionPanel::UpdateProgress);
	connect(&m_Player, &VTakePlayer::failed, this, &VMotionPanel::Tell);
	connect(&m_Export, &VMotionExport::progressed, this, &VMotionPanel::UpdateProgress);
	connect(&m_Export, &VMotionExport::done, this,
	    [this](const QString& i_rPath, const QString& i_rError)
	    {
		    UpdateProgress();
		    if (!i_rError.isEmpty())
			    Tell(tr("%1 is not written. %2").arg(QFileInfo(i_rPath).fileName(), i_rError));
		    else if (QFileInfo::exists(i_rPath))
			    NVX_LOG(
			        "Motion", NVX::ELogInformation, "The character's motion is written to %1%", i_rPath.toStdString());
	    });
	m_SelectionConnection = m_rSelection.ChangedSignal().Connect([this] { FollowSelection(); });
	UpdateControls();
	UpdateFrame();
	UpdateProgress();
}

VMotionPanel::~VMotionPanel()
{
	m_SelectionConnection.Disconnect();
}

void VMotionPanel::MakeControls(QAction& i_rOpen)
{
	auto* const pRow = new QHBoxLayout;
	qobject_cast<QVBoxLayout*>(layout())->addLayout(pRow);
	const auto add = [&](const char* i_pName, const QString& i_rText, const QString& i_rToolTip, auto i_Run)
	{
		QToolButton* const pButton = AddButton(i_pName, i_rText, i_rToolTip);
		connect(pButton, &QToolButton::clicked, this, std::move(i_Run));
		pRow->addWidget(pButton);
		return pButton;
	};
	const auto addSwitch = [&](const char* i_pName, const QString& i_rText, const QString& i_rToolTip)
	{
		auto* const pBox = Named(new QCheckBox(i_rText), i_pName, i_rToolTip);
		pBox->setToolTip(i_rToolTip);
		m_Controls << pBox;
		pRow->addWidget(pBox);
		return pBox;
	};
	auto* const pOpen = Named(new QToolButton, "TakeOpen", tr("Open a take"));
	pOpen->setDefaultAction(&i_rOpen);
	pOpen->setFocusPolicy(Qt::TabFocus);
	pRow->addWidget(pOpen);
	m_pPlay = add("TakePlay", tr("Pause"), tr("Space"), [this] { TogglePlay(); });
	// It stays where it is when its text changes.
	m_pPlay->setFixedWidth(m_pPlay->sizeHint().width());
	add("TakeStepBack", {}, tr("One frame back: Left"), [this] { m_Player.Step(-1); })->setArrowType(Qt::LeftArrow);
	add("TakeStep", {}, tr("One frame on: Right"), [this] { m_Player.Step(1); })->setArrowType(Qt::RightArrow);
	m_pStop = add("TakeStop", tr("Bind pose"), tr("Show the bind pose again, to edit it"), [this] { m_Player.Stop(); });
	connect(addSwitch("TakeGhost", tr("Ghost"), tr("The bind pose stands beside the motion, in grey bones")),
	    &QCheckBox::toggled, &m_Player, &VTakePlayer::SetGhost);
	auto* const pLoop = addSwitch("TakeLoop", tr("Loop"), tr("Begin again at the end"));
	pLoop->setChecked(m_Player.Loops());
	connect(pLoop, &QCheckBox::toggled, this, [this](bool i_bOn) { m_Player.SetLoops(i_bOn); });
	auto* const pSpeed = Named(new QComboBox, "TakeSpeed", tr("Speed"));
	for (const double speed : c_Speeds)
		pSpeed->addItem(QStringLiteral("%1 x").arg(speed), speed);
	pSpeed->setCurrentIndex(pSpeed->findData(m_Player.Speed()));
	pSpeed->setToolTip(tr("How fast it plays; the motion stays what it is"));
	connect(pSpeed, qOverload<int>(&QComboBox::currentIndexChanged), this,
	    [this, pSpeed] { m_Player.SetSpeed(pSpeed->currentData().toDouble()); });
	m_Controls << pSpeed;
	pRow->addWidget(pSpeed);
	add("TakeIn", tr("In"), tr("Play from this frame on; Home goes there"), [this] { m_Player.SetIn(); });
	add("TakeOut", tr("Out"), tr("Play up to this frame; End goes there"), [this] { m_Player.SetOut(); });
	add("TakeAll", tr("All"), tr("Play the whole take"), [this] { m_Player.ResetRange(); });
	m_pFrame->setMinimumWidth(m_pFrame->fontMetrics().horizontalAdvance(QStringLiteral("000000 / 000000  000.00 s")));
	pRow->addWidget(m_pFrame);
	m_pFile->setTextInteractionFlags(Qt::NoTextInteraction);
	m_pFile->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);
	pRow->addWidget(m_pFile, 1);
	m_pProgress->setMaximumWidth(140);
	pRow->addWidget(m_pProgress);
	m_pCancel = add("TakeCancel", tr("Cancel"), tr("End what goes on in the background"),
	    [this] { m_Export.IsRunning() ? m_Export.Cancel() : m_Player.Cancel(); });
	m_Controls.removeOne(m_pCancel);
	m_pMakePerformer = add("TakeMakePerformer", tr("Make Performer..."),
	    tr("No source skeleton is chosen, so that one made of the take plays: save it, and go on with it"),
	    [this] { emit makePerformerAsked(); });
	m_pExport = add("TakeExport", tr("Export..."),
	    tr("Write the character's motion as BVH, glTF or FBX, from In to Out, once all is solved"),
	    [this] { AskAndExport(); });
	m_Controls.removeOne(m_pExport);
	add("TakeClose", tr("Close"), tr("Close the take; the bind pose is shown again"), [this] { m_Player.Close(); });
}

QWidget* VMotionPanel::MakeTable()
{
	m_pTable = Named(new QTableView, "TakeTargets", tr("How far the targets are off"));
	m_pTable->setModel(m_pModel);
	m_pTable->setSelectionBehavior(QAbstractItemView::SelectRows);
	m_pTable->setEditTriggers(QAbstractItemView::NoEditTriggers);
	m_pTable->setShowGrid(false);
	m_pTable->setFocusPolicy(Qt::ClickFocus);
	m_pTable->setTextElideMode(Qt::ElideMiddle);
	m_pTable->verticalHeader()->hide();
	m_pTable->verticalHeader()->setDefaultSectionSize(m_pTable->fontMetrics().height() + 4);
	for (int i = 0; i < VResidualModel::EColumnCount; ++i)
		m_pTable->horizontalHeader()->setSectionResizeMode(
		    i, i < VResidualModel::ENow ? QHeaderView::Stretch : QHeaderView::Interactive);
	// Fixed, so that columns do not breathe while it plays.
	for (int i = VResidualModel::ENow; i < VResidualModel::EColumnCount; ++i)
		m_pTable->setColumnWidth(i, m_pTable->fontMetrics().horizontalAdvance(QStringLiteral("0000.0 mm")));
	connect(m_pTable, &QTableView::clicked, this, &VMotionPanel::ShowWorst);
	connect(m_pTable->selectionModel(), &QItemSelectionModel::selectionChanged, this, &VMotionPanel::ChooseInTable);
	connect(m_pModel, &QAbstractItemModel::modelReset, this, &VMotionPanel::FollowSelection);
	return m_pTable;
}

void VMotionPanel::FollowSelection()
{
	QItemSelection rows;
	std::vector<int> targets;
	for (const NVX::ISelectionItem& rItem : m_rSelection.ItemsOfKind(NVX::ESelectionTarget))
		if (const int row = int(rItem.m_ElementIndex); row < m_pModel->rowCount())
		{
			rows.select(m_pModel->index(row, 0), m_pModel->index(row, VResidualModel::EColumnCount - 1));
			targets.push_back(row);
		}
	m_pPlot->Choose(targets);
	if (std::exchange(m_bFollowing, true))
		return;
	m_pTable->selectionModel()->select(rows, QItemSelectionModel::ClearAndSelect);
	if (!targets.empty())
		m_pTable->scrollTo(m_pModel->index(targets.front(), 0));
	m_bFollowing = false;
}

void VMotionPanel::ChooseInTable()
{
	if (m_bFollowing || !m_Player.Target())
		return;
	std::vector<NVX::ISelectionItem> items = m_rSelection.Items();
	std::erase_if(items, [](const NVX::ISelectionItem& i_rItem) { return i_rItem.m_Kind == NVX::ESelectionTarget; });
	for (const QModelIndex& rRow : m_pTable->selectionModel()->selectedRows())
		items.push_back({NVX::ESelectionTarget, m_Player.Target()->m_SubjectId, std::uint32_t(rRow.row()), {}});
	m_bFollowing = true;
	m_rSelection.Replace(items);
	m_bFollowing = false;
}

QToolButton* VMotionPanel::AddButton(const char* i_pName, const QString& i_rText, const QString& i_rToolTip)
{
	auto* const pButton = Named(new QToolButton, i_pName, i_rToolTip);
	pButton->setText(i_rText);
	pButton->setToolTip(i_rToolTip);
	pButton->setFocusPolicy(Qt::TabFocus);
	m_Controls << pButton;
	return pButton;
}

void VMotionPanel::TakeKeysOf(QWidget& i_rWidget, std::function<bool()> i_Condition)
{
	m_HasView = std::move(i_Condition);
	i_rWidget.installEventFilter(this);
}

bool VMotionPanel::eventFilter(QObject* /*i_pReceiver*/, QEvent* i_pEvent)
{
	if (i_pEvent->type() != QEvent::KeyPress)
		return false;
	const auto& rKey = static_cast<const QKeyEvent&>(*i_pEvent);
	return rKey.modifiers() == Qt::NoModifier && m_HasView && m_HasView() && PressKey(rKey.key());
}

bool VMotionPanel::PressKey(int i_Key)
{
	if (!m_Player.Take())
		return false;
	switch (i_Key)
	{
	case Qt::Key_Space: TogglePlay(); return true;
	case Qt::Key_Left: m_Player.Step(-1); return true;
	case Qt::Key_Right: m_Player.Step(1); return true;
	case Qt::Key_Home: m_Player.Seek(std::int64_t(m_Player.In())); return true;
	case Qt::Key_End: m_Player.Seek(std::int64_t(m_Player.Out())); return true;
	default: return false;
	}
}

void VMotionPanel::TogglePlay()
{
	m_Player.IsPlaying() ? m_Player.Pause() : m_Player.Play();
}

void VMotionPanel::AskAndExport()
{
	const QFileInfo take(m_Player.Path());
	// No name that is there is offered, and never the take's.
	QFileDialog dialog(this, tr("Choose a file"), take.absolutePath());
	const std::pair<QString, QString> forms[] = {{tr("BVH: joints alone (*.bvh)"), QStringLiteral("bvh")},
	    {tr("glTF binary: with the character's skin (*.glb)"), QStringLiteral("glb")},
	    {tr("FBX: the character's file with one more animation stack (*.fbx)"), QStringLiteral("fbx")}};
	QStringList filters;
	for (const auto& [rFilter, rSuffix] : forms)
		filters << rFilter;
	dialog.setAcceptMode(QFileDialog::AcceptSave);
	dialog.setNameFilters(filters);
	const auto chooseForm = [&](const QString& i_rFilter)
	{
		for (const auto& [rFilter, rSuffix] : forms)
			if (rFilter == i_rFilter)
				dialog.setDefaultSuffix(rSuffix);
	};
	connect(&dialog, &QFileDialog::filterSelected, this, chooseForm);
	chooseForm(filters.front());
	if (dialog.exec() != QDialog::Accepted)
		return;
	const QString path = dialog.selectedFiles().value(0);
	// What was edited meanwhile is to be solved first.
	const QString why = !m_Player.Judged() ? tr("The take is still being solved. Export it once all is solved")
	                                       : m_Export.Begin({m_Player.Judged(), m_Player.In(), m_Player.Out(), path,
	                                           m_AskCharacter ? m_AskCharacter() : QString(), m_Player.Path()});
	if (!why.isEmpty())
		return Tell(tr("%1 is not written. %2").arg(QFileInfo(path).fileName(), why));
	m_Error.clear();
	UpdateControls();
}

void VMotionPanel::Tell(const QString& i_rError)
{
	NVX_LOG("Motion", NVX::ELogError, "%1%", i_rError.toStdString());
	m_Error = i_rError;
	UpdateControls();
}

void VMotionPanel::ShowWorst(const QModelIndex& i_rIndex)
{
	if (i_rIndex.column() != VResidualModel::EMax && i_rIndex.column() != VResidualModel::EMaxFrame)
		return;
	if (const auto frame = m_pModel->WorstFrame(i_rIndex.row()))
	{
		m_Player.Pause();
		m_Player.Seek(std::int64_t(*frame));
	}
}

void VMotionPanel::UpdateControls()
{
	const bool bTake = bool(m_Player.Take());
	if (m_Player.IsReading() || m_Player.IsPlaying())
		m_Error.clear();
	for (QWidget* const pControl : qAsConst(m_Controls))
		pControl->setEnabled(bTake);
	m_pPlay->setText(m_Player.IsPlaying() ? tr("Pause") : tr("Play"));
	m_pPlay->setAccessibleName(m_pPlay->text());
	m_pStop->setEnabled(bTake && m_Player.IsShown());
	m_pMakePerformer->setVisible(m_Player.IsPerformerMade());
	const QString name = QFileInfo(m_Player.Path()).fileName();
	QString text;
	if (m_Player.IsReading())
		text = tr("%1 is being read").arg(QFileInfo(m_Player.Reading()).fileName());
	else if (!m_Error.isEmpty())
		text = m_Error;
	else if (!bTake)
		text = tr("Open a take of the performer to see how the character follows");
	else if (!m_Player.Trouble().isEmpty())
		text = tr("%1: %2").arg(name, m_Player.Trouble());
	else if (m_Player.Target() && m_Player.Target()->m_Targets.empty())
		text = tr("%1: the character has no targets yet, and does not follow").arg(name);
	else
		text = name;
	m_pFile->setText(ShownText(text));
	m_pFile->setToolTip(PlainToolTip(text == name ? m_Player.Path() : text));
}

void VMotionPanel::UpdateFrame()
{
	m_pFrame->setText(m_Player.Take() ? tr("%1 / %2  %3 s")
	                                        .arg(m_Player.Frame())
	                                        .arg(m_Player.Frames() - 1)
	                                        .arg(double(m_Player.Frame()) / m_Player.Take()->m_Rate, 0, 'f', 2)
	                                  : QString());
}

void VMotionPanel::UpdateProgress()
{
	const bool bReading = m_Player.IsReading();
	const bool bWriting = m_Export.IsRunning();
	const bool bBusy = bReading || bWriting || m_Player.IsJudging();
	m_pProgress->setVisible(bBusy);
	m_pExport->setEnabled(m_Player.Judged() && !bWriting);
	m_pCancel->setVisible(bBusy);
	const double part = bWriting ? m_Export.Part()
	    : bReading               ? m_Player.ReadPart()
	                             : double(m_Player.Solved()) / double(std::max<std::size_t>(1, m_Player.Frames()));
	m_pProgress->setRange(0, 100);
	m_pProgress->setValue(int(100.0 * part));
	m_pProgress->setFormat(bWriting ? tr("writing %p%") : bReading ? tr("reading %p%") : tr("solving %p%"));
}

} // namespace StudioHost

#include "moc_MotionPanel.cpp"
