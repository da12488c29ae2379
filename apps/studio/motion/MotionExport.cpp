#include "studio/motion/MotionExport.h"

#include "MotionIO/PrintMotion.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "TakeIO/Limits.h"
#include "TakeSolve/SolvedMotion.h"
#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/SaveFile.h"
#include "studio/motion/TakeSolving.h"

#include <QFileInfo>

#include <new>

namespace StudioHost
{
namespace
{

constexpr double c_WritingSteps = 200.0;

std::optional<MotionIO::EMotionForm> FormOf(const QString& i_rPath)
{
	return MotionIO::MotionFormOf(("." + QFileInfo(i_rPath).suffix().toLower()).toStdString());
}

bool AreSameFile(const QString& i_rLeft, const QString& i_rRight)
{
	const QString left = QFileInfo(i_rLeft).canonicalFilePath();
	return !left.isEmpty() && left == QFileInfo(i_rRight).canonicalFilePath();
}

TakeIO::VTake MotionOf(const VMotionExportTask& i_rTask)
{
	const TakeSolve::VSolvedTake& rSolved = i_rTask.m_pJudged->m_Solved;
	TakeSolve::VSolvedTake part;
	part.m_Frames = i_rTask.m_Last + 1 - i_rTask.m_First;
	part.m_NumberOfStates = rSolved.m_NumberOfStates;
	const auto first = rSolved.m_States.begin() + std::ptrdiff_t(i_rTask.m_First * part.m_NumberOfStates);
	part.m_States.assign(first, first + std::ptrdiff_t(part.m_Frames * part.m_NumberOfStates));
	const TakeSolve::VPosedSubject& rTarget = *i_rTask.m_pJudged->m_pTarget;
	return TakeSolve::MotionOf(rTarget.m_Subject, rTarget.m_BindPose, part, i_rTask.m_pJudged->m_Of.m_pTake->m_Rate);
}

} // namespace

VMotionExport::~VMotionExport()
{
	m_bCancelled = true;
}

QString VMotionExport::Begin(VMotionExportTask i_Task)
{
	const auto form = FormOf(i_Task.m_Path);
	if (!form)
		return tr("A motion is written as .bvh, .glb or .fbx");
	if (*form != MotionIO::EMotionForm::Bvh && i_Task.m_Character.isEmpty())
		return tr("That form holds the character, too. Choose its FBX file in the panel first");
	for (const QString& rInput : {i_Task.m_Character, i_Task.m_TakePath})
		if (AreSameFile(i_Task.m_Path, rInput))
			return tr("It is what the motion is made of, and is not replaced. Choose another name");
	if (m_bRunning)
		return tr("A motion is still being written. Cancel it, or wait");
	m_bCancelled = false;
	m_bRunning = true;
	m_Part = 0.0;
	m_Thread = std::jthread(
	    [this, task = std::move(i_Task)]
	    {
		    QString error;
		    try
		    {
			    error = Write(task);
		    }
		    catch (const std::bad_alloc&)
		    {
			    error = tr("There is not enough memory for it");
		    }
		    QMetaObject::invokeMethod(
		        this,
		        [this, path = task.m_Path, error]
		        {
			        m_bRunning = false;
			        emit done(path, error);
		        },
		        Qt::QueuedConnection);
	    });
	emit progressed();
	return {};
}

void VMotionExport::Cancel()
{
	m_bCancelled = true;
}

QString VMotionExport::Write(const VMotionExportTask& i_rTask)
{
	std::string error, bytes;
	const auto failed = [&error](const QString& i_rWhat)
	{ return error.empty() ? i_rWhat : QStringLiteral("%1. %2").arg(i_rWhat, QString::fromStdString(error)); };
	MotionIO::VCharacterFile character{i_rTask.m_Character.toStdString(), {}};
	const auto form = *FormOf(i_rTask.m_Path);
	const bool bCharacter = form != MotionIO::EMotionForm::Bvh;
	if (bCharacter
	    && UtilsFileSystem::ReadWholeFile(
	           UtilsFileSystem::PathFromUtf8(character.m_Path), TakeIO::Limits::c_FileBytes, character.m_Bytes, error)
	        != 0)
		return failed(tr("%1 could not be read").arg(i_rTask.m_Character));
	MotionIO::VMotionSettings settings;
	settings.m_Name = QFileInfo(i_rTask.m_TakePath).completeBaseName().toStdString();
	settings.m_Scale = RetargetSetup::GetGlobalScale(*i_rTask.m_pJudged->m_Of.m_pTarget);
	settings.m_Progress = [this, told = 0.0](double i_Part) mutable
	{
		if (i_Part - told >= 1.0 / c_WritingSteps)
			QMetaObject::invokeMethod(
			    this,
			    [this, part = told = i_Part]
			    {
				    m_Part = part;
				    emit progressed();
			    },
			    Qt::QueuedConnection);
		return !m_bCancelled;
	};
	switch (MotionIO::PrintMotion(MotionOf(i_rTask), form, bCharacter ? &character : nullptr, settings, bytes, error))
	{
	case MotionIO::EPrinted::Done: break;
	case MotionIO::EPrinted::Cancelled: return {};
	case MotionIO::EPrinted::CharacterUnreadable:
		return failed(tr("%1 could not be read as a character").arg(i_rTask.m_Character));
	case MotionIO::EPrinted::Refused: return failed(tr("The motion cannot be written in that form"));
	}
	if (m_bCancelled
	    || UtilsFileSystem::SaveFile(UtilsFileSystem::PathFromUtf8(i_rTask.m_Path.toStdString()), bytes, error) == 0)
		return {};
	return QString::fromStdString(error);
}

} // namespace StudioHost

#include "moc_MotionExport.cpp"
