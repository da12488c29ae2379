#include "studio/motion/MotionPanel.h"

#include "studio/motion/ResidualModel.h"
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
#include <QTableView>
#include <QToolButton>
#include <QVBoxLayout>

namespace StudioHost
{
namespace
{

constexpr double c_Speeds[] = {0.1, 0.25, 0.5, 1.0, 2.0, 4.0};
constexpr int c_Keys[] = {Qt::Key_Space, Qt::Key_Left, Qt::Key_Right};

} // namespace

VMotionPanel::VMotionPanel(
    NVX::CountedPointer<TesselPluginInterface::IItemFactory> i_pItemFactory, QAction& i_rOpen, QWidget* i_pParent)
    : QWidget(i_pParent), m_Player(std::move(i_pItemFactory)), m_pModel(new VResidualModel(m_Player, this)),
      m_pFile(Named(new QLabel, "TakeFile", tr("The take"))),
      m_pFrame(Named(new QLabel, "TakeFrame", tr("The frame that is shown"))),
      m_pProgress(Named(new QProgressBar, "TakeProgress", tr("How far the take is read or solved")))
{
	Named(this, "MotionPanel", tr("Motion"));
	auto* const pRow = new QHBoxLayout;
	const auto add = [&](const char* i_pName, const QString& i_rText, const QString& i_rToolTip, auto i_Run)
	{
		QToolButton* const pButton = AddButton(i_pName, i_rText, i_rToolTip);
		connect(pButton, &QToolButton::clicked, this, std::move(i_Run));
		pRow->addWidget(pButton);
		return pButton;
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
	auto* const pLoop = Named(new QCheckBox(tr("Loop")), "TakeLoop", tr("Begin again at the end"));
	pLoop->setChecked(m_Player.Loops());
	connect(pLoop, &QCheckBox::toggled, this, [this](bool i_bOn) { m_Player.SetLoops(i_bOn); });
	m_Controls << pLoop;
	pRow->addWidget(pLoop);
	auto* const pSpeed = Named(new QComboBox, "TakeSpeed", tr("Speed"));
	for (const double speed : c_Speeds)
		pSpeed->addItem(QStringLiteral("%1 x").arg(speed), speed);
	pSpeed->setCurrentIndex(pSpeed->findData(m_Player.Speed()));
	pSpeed->setToolTip(tr("How fast it plays; the motion stays what it is"));
	connect(pSpeed, qOverload<int>(&QComboBox::currentIndexChanged), this,
	    [this, pSpeed] { m_Player.SetSpeed(pSpeed->currentData().toDouble()); });
	m_Controls << pSpeed;
	pRow->addWidget(pSpeed);
	add("TakeIn", tr("In"), tr("Play from this frame on"), [this] { m_Player.SetIn(); });
	add("TakeOut", tr("Out"), tr("Play up to this frame"), [this] { m_Player.SetOut(); });
	add("TakeAll", tr("All"), tr("Play the whole take"), [this] { m_Player.ResetRange(); });
	m_pFrame->setMinimumWidth(m_pFrame->fontMetrics().horizontalAdvance(QStringLiteral("000000 / 000000  000.00 s")));
	pRow->addWidget(m_pFrame);
	m_pFile->setTextInteractionFlags(Qt::NoTextInteraction);
	m_pFile->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);
	pRow->addWidget(m_pFile, 1);
	m_pProgress->setMaximumWidth(140);
	pRow->addWidget(m_pProgress);
	m_pCancel = AddButton("TakeCancel", tr("Cancel"), tr("End what goes on in the background"));
	m_Controls.removeOne(m_pCancel);
	connect(m_pCancel, &QToolButton::clicked, this, [this] { m_Player.Cancel(); });
	pRow->addWidget(m_pCancel);
	m_pExport = add("TakeExport", tr("Export..."),
	    tr("Write the character's motion as BVH, from In to Out, once all is solved"), [this] { AskAndExport(); });
	m_Controls.removeOne(m_pExport);
	add("TakeClose", tr("Close"), tr("Close the take; the bind pose is shown again"), [this] { m_Player.Close(); });

	auto* const pTable = Named(new QTableView, "TakeTargets", tr("How far the targets are off"));
	pTable->setModel(m_pModel);
	pTable->setSelectionBehavior(QAbstractItemView::SelectRows);
	pTable->setEditTriggers(QAbstractItemView::NoEditTriggers);
	pTable->setShowGrid(false);
	pTable->setFocusPolicy(Qt::ClickFocus);
	pTable->verticalHeader()->hide();
	pTable->verticalHeader()->setDefaultSectionSize(pTable->fontMetrics().height() + 4);
	for (int i = 0; i < VResidualModel::EColumnCount; ++i)
		pTable->horizontalHeader()->setSectionResizeMode(
		    i, i < VResidualModel::ENow ? QHeaderView::Stretch : QHeaderView::ResizeToContents);
	connect(pTable, &QTableView::clicked, this, &VMotionPanel::ShowWorst);

	auto* const pLayout = new QVBoxLayout(this);
	pLayout->setContentsMargins(4, 4, 4, 4);
	pLayout->addLayout(pRow);
	pLayout->addWidget(new VTimeLine(m_Player));
	pLayout->addWidget(pTable, 1);

	for (const int key : c_Keys)
		connect(new QShortcut(QKeySequence(key), this, nullptr, nullptr, Qt::WidgetWithChildrenShortcut),
		    &QShortcut::activated, this, [this, key] { PressKey(key); });
	for (const auto signal : {&VTakePlayer::takeChanged, &VTakePlayer::stateChanged})
		connect(&m_Player, signal, this, &VMotionPanel::UpdateControls);
	for (const auto signal : {&VTakePlayer::takeChanged, &VTakePlayer::frameChanged, &VTakePlayer::stateChanged})
		connect(&m_Player, signal, this, &VMotionPanel::UpdateFrame);
	for (const auto signal : {&VTakePlayer::takeChanged, &VTakePlayer::solvedChanged})
		connect(&m_Player, signal, this, &VMotionPanel::UpdateProgress);
	UpdateControls();
	UpdateFrame();
	UpdateProgress();
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
	default: return false;
	}
}

void VMotionPanel::TogglePlay()
{
	m_Player.IsPlaying() ? m_Player.Pause() : m_Player.Play();
}

void VMotionPanel::AskAndExport()
{
	QFileDialog dialog(this, tr("Choose a file"), QFileInfo(m_Player.Path()).absolutePath(), tr("Takes (*.bvh)"));
	dialog.setAcceptMode(QFileDialog::AcceptSave);
	dialog.setDefaultSuffix(QStringLiteral("bvh"));
	if (dialog.exec() == QDialog::Accepted)
		m_Player.Export(dialog.selectedFiles().value(0));
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
	for (QWidget* const pControl : qAsConst(m_Controls))
		pControl->setEnabled(bTake);
	m_pPlay->setText(m_Player.IsPlaying() ? tr("Pause") : tr("Play"));
	m_pPlay->setAccessibleName(m_pPlay->text());
	m_pStop->setEnabled(bTake && m_Player.IsShown());
	QString text;
	if (m_Player.IsReading())
		text = tr("%1 is being read").arg(QFileInfo(m_Player.Reading()).fileName());
	else if (!bTake)
		text = tr("Open a take of the performer to see how the character follows");
	else if (!m_Player.Trouble().isEmpty())
		text = tr("%1: %2").arg(QFileInfo(m_Player.Path()).fileName(), m_Player.Trouble());
	else
		text = QFileInfo(m_Player.Path()).fileName();
	m_pFile->setText(text);
	m_pFile->setToolTip(PlainToolTip(m_Player.Path()));
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
	const bool bBusy = bReading || m_Player.IsJudging();
	m_pProgress->setVisible(bBusy);
	m_pExport->setEnabled(bool(m_Player.Judged()));
	m_pCancel->setVisible(bBusy);
	m_pProgress->setRange(0, bReading ? 0 : int(m_Player.Frames()));
	m_pProgress->setValue(m_Player.Solved());
	m_pProgress->setFormat(tr("solving %p%"));
}

} // namespace StudioHost
