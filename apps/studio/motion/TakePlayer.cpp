#include "studio/motion/TakePlayer.h"

#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectState.h"
#include "DebugServices/GlobalLog.h"

#include <QFileInfo>

#include <algorithm>
#include <cmath>

using TesselPluginInterface::IFlowFrame;
using TesselPluginInterface::IFlowItem;
using TesselPluginInterface::ItemValue;

namespace StudioHost
{
namespace
{

constexpr const char* c_pMotionCategory = "Motion";
/// Milliseconds; screens show no more pictures.
constexpr int c_Tick = 16;
/// What is seen through.
constexpr CoreOrlexTypes::VColour c_GhostColour{150, 160, 170, 110};

/// The states of one pose the other.
bool HaveSameJoints(
    const CoreOrlexTypes::VSubjectParametrised& i_rLeft, const CoreOrlexTypes::VSubjectParametrised& i_rRight)
{
	const auto same = [](const auto& i_rOne, const auto& i_rOther)
	{
		return i_rOne.m_Name == i_rOther.m_Name && i_rOne.m_ParentSegmentIndex == i_rOther.m_ParentSegmentIndex
		    && i_rOne.m_Joint.m_JointType == i_rOther.m_Joint.m_JointType;
	};
	return std::ranges::equal(i_rLeft.m_Segments, i_rRight.m_Segments, same);
}

} // namespace

VTakePlayer::VTakePlayer(NVX::CountedPointer<TesselPluginInterface::IItemFactory> i_pItemFactory,
    NVX::CountedPointer<TesselPluginInterface::IFrameFactory> i_pFrameFactory)
    : m_pItemFactory(std::move(i_pItemFactory)), m_pFrameFactory(std::move(i_pFrameFactory))
{
	m_Clock.setTimerType(Qt::PreciseTimer);
	m_Clock.setInterval(c_Tick);
	connect(&m_Clock, &QTimer::timeout, this, &VTakePlayer::Tick);
	connect(&m_Solving, &VTakeSolving::read, this, &VTakePlayer::TakeRead);
	connect(&m_Solving, &VTakeSolving::pictured, this, &VTakePlayer::TakePicture);
	connect(&m_Solving, &VTakeSolving::prepared, this,
	    [this](const QStringList& i_rFindings, const QString& i_rError)
	    {
		    for (const QString& rFinding : i_rFindings)
			    NVX_LOG(c_pMotionCategory, NVX::ELogWarning, "%1%", rFinding.toStdString());
		    if (!i_rError.isEmpty())
		    {
			    m_bJudging = false;
			    m_Trouble = i_rError;
			    Stop();
			    emit takeChanged();
			    emit failed(tr("The take cannot be played: %1").arg(i_rError));
		    }
	    });
	connect(&m_Solving, &VTakeSolving::readOn, this,
	    [this](double i_Part)
	    {
		    m_ReadPart = i_Part;
		    emit solvedChanged();
	    });
	connect(&m_Solving, &VTakeSolving::progressed, this,
	    [this](int i_Solved)
	    {
		    m_Solved = i_Solved;
		    emit solvedChanged();
	    });
	connect(&m_Solving, &VTakeSolving::judged, this,
	    [this](std::shared_ptr<const VJudgedTake> i_pJudged)
	    {
		    m_pJudged = std::move(i_pJudged);
		    m_Solved = int(Frames());
		    m_bJudging = false;
		    emit solvedChanged();
	    });
}

void VTakePlayer::Open(const QString& i_rPath, std::size_t i_Frame)
{
	m_ReadingFrame = i_Frame;
	m_Reading = QFileInfo(i_rPath).absoluteFilePath();
	m_ReadPart = 0.0;
	m_Solving.Read(m_Reading);
	emit takeChanged();
}

void VTakePlayer::TakeRead(
    const QString& i_rPath, std::shared_ptr<const TakeIO::VTake> i_pTake, const QString& i_rError)
{
	m_Reading.clear();
	if (!i_pTake)
		emit failed(tr("%1 is not opened as a take: %2").arg(i_rPath, i_rError));
	else
	{
		m_pTake = std::move(i_pTake);
		m_Path = i_rPath;
		m_Clock.stop();
		m_In = 0;
		m_Out = m_pTake->m_Frames - 1;
		m_Frame = std::min(m_ReadingFrame, m_Out);
		// He sees at once what he opened.
		m_bShown = true;
	}
	// The reading ended the sequence.
	Solve();
	emit takeChanged();
	emit stateChanged();
	emit frameChanged();
	if (m_pTake && m_Path == i_rPath)
		emit opened(i_rPath);
}

void VTakePlayer::Close()
{
	m_Solving.CancelReading();
	m_Reading.clear();
	m_pTake.reset();
	m_Path.clear();
	m_Frame = m_In = m_Out = 0;
	Stop();
	Solve();
	emit takeChanged();
	emit frameChanged();
}

void VTakePlayer::Cancel()
{
	if (IsReading())
	{
		m_Solving.CancelReading();
		m_Reading.clear();
		Solve();
		emit takeChanged();
		return;
	}
	m_Solving.CancelSequence();
	m_bJudging = false;
	emit solvedChanged();
}

void VTakePlayer::Solve()
{
	m_pJudged.reset();
	m_Solved = 0;
	m_Trouble.clear();
	m_bStale = true;
	m_bJudging = m_pTake && m_pTarget && !m_pTarget->m_Targets.empty();
	if (!m_pTake)
		m_pPicture.reset();
	m_Solving.Solve({m_pTake, m_pTake ? m_pSource : nullptr, m_pTake ? m_pTarget : nullptr});
	if (m_pTake)
		m_Solving.Show(m_Frame);
	emit solvedChanged();
	if (m_bShown)
		emit shownChanged();
}

void VTakePlayer::TakePicture(std::shared_ptr<const VTakePicture> i_pPicture)
{
	m_pPicture = std::move(i_pPicture);
	m_bStale = false;
	if (m_pShownSource != m_pPicture->m_pSource)
	{
		m_pShownSource = m_pPicture->m_pSource;
		m_SourceItems = {Item("FlowSubject", m_pShownSource)};
		if (m_pPicture->m_pSourceData)
			m_SourceItems.push_back(Item("FlowSubjectApplicationData", m_pPicture->m_pSourceData));
	}
	emit pictureChanged();
	if (m_bShown)
		emit shownChanged();
}

bool VTakePlayer::AtRest() const
{
	return !IsReading() && !IsPlaying() && !m_bJudging
	    && (!m_bShown || !m_pTake || !m_Trouble.isEmpty() || (Picture() && Picture()->m_Frame == m_Frame));
}

template <typename T>
NVX::CountedPointer<IFlowItem> VTakePlayer::Item(const char* i_pFlowType, std::shared_ptr<const T> i_pValue) const
{
	NVX::CountedPointer<IFlowItem> pItem = m_pItemFactory->CreateItem(i_pFlowType);
	TesselPluginInterface::SetItemValue(pItem, std::move(i_pValue));
	return pItem;
}

NVX::CountedPointer<IFlowItem> VTakePlayer::PoseItem(
    const char* i_pFlowType, std::uint32_t i_SubjectId, std::vector<double> i_States) const
{
	using CoreOrlexTypes::VSubjectDynamicParameters;
	return Item(i_pFlowType,
	    std::make_shared<const VSubjectDynamicParameters>(VSubjectDynamicParameters{i_SubjectId, std::move(i_States)}));
}

NVX::CountedPointer<IFlowFrame> VTakePlayer::Shown(const NVX::CountedPointer<IFlowFrame>& i_rpDocument)
{
	using CoreOrlexTypes::VSubjectParametrised;
	m_pDocument = i_rpDocument;
	const auto subject = [&](const char* i_pFlowType)
	{
		auto pSubject = i_rpDocument ? ItemValue<VSubjectParametrised>(i_rpDocument->Item(i_pFlowType)) : nullptr;
		return pSubject && !pSubject->m_Segments.empty() ? pSubject : nullptr;
	};
	auto pSource = subject("FlowSubjectParametrised");
	auto pTarget = subject("FlowSubjectParametrisedForSolving");
	if (pSource != m_pSource || pTarget != m_pTarget)
	{
		m_pSource = std::move(pSource);
		m_pTarget = std::move(pTarget);
		if (m_pTake)
			Solve();
	}
	NVX::CountedPointer<IFlowFrame> pFrame = i_rpDocument ? i_rpDocument->Copy() : m_pFrameFactory->CreateFrame();
	// Never a performer who is gone.
	if (!m_bShown || !m_pTake || !m_pPicture || m_pPicture->m_Of.m_pSource != m_pSource)
	{
		if (i_rpDocument)
			return {};
		pFrame->AddItem(NoSubject("FlowSubjectApplicationData"));
		return pFrame;
	}
	for (const auto& rpItem : m_SourceItems)
		pFrame->AddItem(rpItem);
	pFrame->AddItem(PoseItem("FlowSubjectDynamicParameters", m_pShownSource->m_SubjectId, m_pPicture->m_SourceStates));
	if (m_pTarget)
		pFrame->AddItem(PoseItem("FlowSubjectDynamicParametersForSolving", m_pTarget->m_SubjectId, TargetStates()));
	AddGhost(*pFrame);
	return pFrame;
}

std::vector<double> VTakePlayer::TargetStates() const
{
	// Until the edit is solved it is seen in the pose before, where that is one of its joints.
	const auto& rpSolved = m_pPicture->m_Of.m_pTarget;
	return rpSolved == m_pTarget || (rpSolved && HaveSameJoints(*rpSolved, *m_pTarget))
	    ? m_pPicture->m_TargetStates
	    : TakeSolve::VPosedSubject(*m_pTarget).m_BindPose;
}

NVX::CountedPointer<IFlowItem> VTakePlayer::NoSubject(const char* i_pDataType) const
{
	using CoreOrlexTypes::VSubjectApplicationData;
	return Item(i_pDataType, std::make_shared<const VSubjectApplicationData>());
}

std::vector<NVX::CountedPointer<IFlowItem>> VTakePlayer::GhostItems() const
{
	constexpr const char* c_pData = "FlowSubjectApplicationDataForRetargeting";
	if (!m_pGhostOf)
		return {NoSubject(c_pData)};
	TakeSolve::VPosedSubject posed(*m_pGhostOf);
	CoreOrlexTypes::VSubject& rSubject = posed.m_Subject;
	rSubject.m_Name = tr("Bind pose").toStdString();
	rSubject.m_Targets.clear();
	rSubject.m_Markers.clear();
	CoreOrlexTypes::VSubjectApplicationData look;
	look.m_Segments.resize(rSubject.m_Segments.size());
	for (auto& rSegment : look.m_Segments)
		rSegment.m_Colour = c_GhostColour;
	return {PoseItem("FlowSubjectDynamicParametersForRetargeting", rSubject.m_SubjectId, std::move(posed.m_BindPose)),
	    Item("FlowSubjectForRetargeting", std::make_shared<const CoreOrlexTypes::VSubject>(std::move(rSubject))),
	    Item(c_pData, std::make_shared<const CoreOrlexTypes::VSubjectApplicationData>(std::move(look)))};
}

void VTakePlayer::AddGhost(IFlowFrame& io_rFrame)
{
	const auto pOf = m_bGhost ? m_pTarget : nullptr;
	if (std::exchange(m_pGhostOf, pOf) != pOf)
		m_GhostItems = GhostItems();
	for (const auto& rpItem : m_GhostItems)
		io_rFrame.AddItem(rpItem);
}

void VTakePlayer::SetGhost(bool i_bShown)
{
	m_bGhost = i_bShown;
	if (m_bShown)
		emit shownChanged();
}

void VTakePlayer::Play()
{
	if (!m_pTake || !m_Trouble.isEmpty())
		return;
	m_bShown = true;
	if (m_Frame < m_In || m_Frame >= m_Out)
		SetFrame(m_In);
	StartClock();
	emit stateChanged();
	emit shownChanged();
}

void VTakePlayer::StartClock()
{
	m_StartFrame = double(m_Frame);
	m_SinceStart.start();
	m_Clock.start();
}

void VTakePlayer::Pause()
{
	m_Clock.stop();
	emit stateChanged();
}

void VTakePlayer::Stop()
{
	m_Clock.stop();
	m_bShown = false;
	emit stateChanged();
	emit shownChanged();
}

void VTakePlayer::Seek(std::int64_t i_Frame)
{
	if (!m_pTake || !m_Trouble.isEmpty())
		return;
	SetFrame(std::size_t(std::clamp<std::int64_t>(i_Frame, 0, std::int64_t(Frames()) - 1)));
	if (IsPlaying())
		StartClock();
	if (std::exchange(m_bShown, true))
		return;
	emit stateChanged();
	emit shownChanged();
}

void VTakePlayer::Step(int i_Frames)
{
	if (IsPlaying())
		Pause();
	Seek(std::clamp(std::int64_t(m_Frame) + i_Frames, std::int64_t(m_In), std::int64_t(m_Out)));
}

void VTakePlayer::SetIn()
{
	m_In = m_Frame;
	m_Out = std::max(m_In, m_Out);
	emit stateChanged();
}

void VTakePlayer::SetOut()
{
	m_Out = m_Frame;
	m_In = std::min(m_In, m_Out);
	emit stateChanged();
}

void VTakePlayer::ResetRange()
{
	m_In = 0;
	m_Out = Frames() - (m_pTake ? 1 : 0);
	emit stateChanged();
}

void VTakePlayer::SetSpeed(double i_Speed)
{
	m_Speed = i_Speed;
	if (IsPlaying())
		StartClock();
}

void VTakePlayer::Tick()
{
	const double passed = m_Speed * m_pTake->m_Rate * double(m_SinceStart.nsecsElapsed()) * 1e-9;
	double frame = m_StartFrame + passed;
	const double last = double(m_Out) + 1.0;
	if (frame >= last && !m_bLoops)
	{
		SetFrame(m_Out);
		return Pause();
	}
	if (frame >= last)
		frame = double(m_In) + std::fmod(frame - last, last - double(m_In));
	SetFrame(std::size_t(frame));
}

void VTakePlayer::SetFrame(std::size_t i_Frame)
{
	if (i_Frame == m_Frame && Picture() && Picture()->m_Frame == i_Frame)
		return;
	m_Frame = i_Frame;
	m_Solving.Show(m_Frame);
	emit frameChanged();
}

} // namespace StudioHost

#include "moc_TakePlayer.cpp"
