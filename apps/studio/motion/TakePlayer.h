#pragma once

#include "NVX/CountedPointer.h"
#include "TesselPluginInterface/IFlowFrame.h"
#include "TesselPluginInterface/IItemFactory.h"
#include "studio/motion/TakeSolving.h"

#include <QElapsedTimer>
#include <QTimer>

namespace StudioHost
{

/// A take that is open, and the frame of it that the preview shows. It follows the document: each edit is solved anew.
/// Nothing of it reaches the document. User interface thread.
class VTakePlayer : public QObject
{
	Q_OBJECT

public:
	VTakePlayer(NVX::CountedPointer<TesselPluginInterface::IItemFactory> i_pItemFactory,
	    NVX::CountedPointer<TesselPluginInterface::IFrameFactory> i_pFrameFactory);

	/// Reads it in the background, and shows a frame of it. The take before stays until the new one is read, and if
	/// that cannot be read.
	void Open(const QString& i_rPath, std::size_t i_Frame = 0);
	bool IsReading() const { return !m_Reading.isEmpty(); }
	/// Empty if none is being read.
	const QString& Reading() const { return m_Reading; }
	void Close();
	/// From 0 to 1, of the file that is being read.
	double ReadPart() const { return m_ReadPart; }
	/// What goes on in the background ends: reading, or the sequence that is judged.
	void Cancel();

	/// Null without a take.
	const std::shared_ptr<const TakeIO::VTake>& Take() const { return m_pTake; }
	const QString& Path() const { return m_Path; }
	/// 0 without a take.
	std::size_t Frames() const { return m_pTake ? m_pTake->m_Frames : 0; }
	std::size_t Frame() const { return m_Frame; }
	std::size_t In() const { return m_In; }
	std::size_t Out() const { return m_Out; }
	bool IsPlaying() const { return m_Clock.isActive(); }
	/// The preview shows the take, not the bind poses.
	bool IsShown() const { return m_bShown; }
	bool Loops() const { return m_bLoops; }
	double Speed() const { return m_Speed; }

	void Play();
	void Pause();
	/// The bind poses come back.
	void Stop();
	/// Shows a frame, held within the take; playing goes on from there.
	void Seek(std::int64_t i_Frame);
	/// Pauses, and goes on by so many frames, held within the in and out points.
	void Step(int i_Frames);
	/// The point is moved to the present frame; the other one follows where it would be on the wrong side.
	void SetIn();
	void SetOut();
	void ResetRange();
	void SetLoops(bool i_bLoops) { m_bLoops = i_bLoops; }
	/// Times the take's own.
	void SetSpeed(double i_Speed);
	/// The character stands beside the take in its bind pose, too, in grey bones.
	void SetGhost(bool i_bShown);

	/// Of what the document has now; null until it is solved.
	std::shared_ptr<const VTakePicture> Picture() const { return m_bStale ? nullptr : m_pPicture; }
	/// Null until all frames are solved.
	const std::shared_ptr<const VJudgedTake>& Judged() const { return m_pJudged; }
	/// Of the sequence in the background, 0 if there is none.
	int Solved() const { return m_Solved; }
	bool IsJudging() const { return m_bJudging; }
	/// Empty if the take plays; otherwise why not.
	const QString& Trouble() const { return m_Trouble; }
	/// The document has no performer: the one that plays is made of the take.
	bool IsPerformerMade() const { return m_pTake && !m_pSource; }
	/// What the document has; null for nothing.
	const std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised>& Target() const { return m_pTarget; }
	const NVX::CountedPointer<TesselPluginInterface::IFlowFrame>& Document() const { return m_pDocument; }
	/// What was asked for is there, and nothing moves.
	bool AtRest() const;

	/// As TesselPluginInterface::IPreviewFrames.
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> Shown(
	    const NVX::CountedPointer<TesselPluginInterface::IFlowFrame>& i_rpDocument);

signals:
	/// Another take, none, or one that is being read; or why it does not play.
	void takeChanged();
	/// Playing, paused or stopped; in and out points.
	void stateChanged();
	/// Another frame is wanted.
	void frameChanged();
	/// Another picture is shown.
	void pictureChanged();
	/// The document's subjects, or how far they are solved.
	void solvedChanged();
	void opened(const QString& i_rPath);
	/// Why a file was not opened, or why the take cannot be played.
	void failed(const QString& i_rSentence);
	/// The answer of Shown would be another one.
	void shownChanged();

private:
	void TakeRead(const QString& i_rPath, std::shared_ptr<const TakeIO::VTake> i_pTake, const QString& i_rError);
	void TakePicture(std::shared_ptr<const VTakePicture> i_pPicture);
	void Solve();
	void Tick();
	void SetFrame(std::size_t i_Frame);
	void StartClock();
	template <typename T>
	NVX::CountedPointer<TesselPluginInterface::IFlowItem> Item(
	    const char* i_pFlowType, std::shared_ptr<const T> i_pValue) const;
	NVX::CountedPointer<TesselPluginInterface::IFlowItem> PoseItem(
	    const char* i_pFlowType, std::uint32_t i_SubjectId, std::vector<double> i_States) const;
	/// The states to draw the document's character with.
	std::vector<double> TargetStates() const;
	/// A frame that lacks a subject leaves it as it was: with this item of its class beside it, it goes.
	NVX::CountedPointer<TesselPluginInterface::IFlowItem> NoSubject(const char* i_pDataType) const;
	std::vector<NVX::CountedPointer<TesselPluginInterface::IFlowItem>> GhostItems() const;
	void AddGhost(TesselPluginInterface::IFlowFrame& io_rFrame);

	const NVX::CountedPointer<TesselPluginInterface::IItemFactory> m_pItemFactory;
	const NVX::CountedPointer<TesselPluginInterface::IFrameFactory> m_pFrameFactory;
	VTakeSolving m_Solving;

	QString m_Reading;
	double m_ReadPart = 0.0;
	/// The first frame that is shown of it.
	std::size_t m_ReadingFrame = 0;
	QString m_Path;
	QString m_Trouble;
	std::shared_ptr<const TakeIO::VTake> m_pTake;
	std::size_t m_Frame = 0;
	std::size_t m_In = 0;
	std::size_t m_Out = 0;
	bool m_bShown = false;
	bool m_bLoops = true;
	double m_Speed = 1.0;
	QTimer m_Clock;
	QElapsedTimer m_SinceStart;
	/// Where playing began.
	double m_StartFrame = 0.0;

	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> m_pDocument;
	std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> m_pSource;
	std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> m_pTarget;
	std::shared_ptr<const VTakePicture> m_pPicture;
	/// The performer of the pictures; the same item as long as it is the same performer.
	std::shared_ptr<const CoreOrlexTypes::VSubject> m_pShownSource;
	std::vector<NVX::CountedPointer<TesselPluginInterface::IFlowItem>> m_SourceItems;
	bool m_bGhost = false;
	/// The character that it is of; null for none.
	std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> m_pGhostOf;
	std::vector<NVX::CountedPointer<TesselPluginInterface::IFlowItem>> m_GhostItems;
	std::shared_ptr<const VJudgedTake> m_pJudged;
	int m_Solved = 0;
	bool m_bJudging = false;
	/// The picture is of what was solved before.
	bool m_bStale = false;
};

} // namespace StudioHost
