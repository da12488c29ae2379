#include "studio/panel/WorkKeeper.h"

#include "DebugServices/GlobalLog.h"
#include "studio/panel/RetargetPanel.h"

#include <QFileInfo>
#include <QWidget>

#include <utility>

namespace StudioHost
{
namespace
{

/// From the first change on; what comes in between is kept with it.
constexpr int c_Milliseconds = 10'000;

} // namespace

VWorkKeeper::VWorkKeeper(VRetargetPanel& i_rPanel, const QString& i_rFolder) : m_rPanel(i_rPanel), m_Folder(i_rFolder)
{
	m_Timer.setSingleShot(true);
	m_Timer.setInterval(c_Milliseconds);
	connect(&m_Timer, &QTimer::timeout, this, &VWorkKeeper::Keep);
	connect(&m_rPanel, &VRetargetPanel::stateChanged, this, &VWorkKeeper::OnChanged);
}

void VWorkKeeper::OnChanged()
{
	if (!m_rPanel.HasUnsavedChanges())
	{
		m_Timer.stop();
		m_Folder.Drop();
	}
	else if (!m_Timer.isActive())
		m_Timer.start();
}

void VWorkKeeper::Keep()
{
	m_Timer.stop();
	const QString copy = m_Folder.NextCopy();
	VUnsavedWork work = m_rPanel.Work();
	const bool bKept = !copy.isEmpty() && m_rPanel.WriteCopy(copy) && m_Folder.Keep(std::move(work));
	// Each change would tell it again.
	if (!bKept && !std::exchange(m_bFailed, true))
		NVX_LOG("System", NVX::ELogWarning,
		    "Work that is not saved cannot be kept for the case of a crash: %1% cannot be written. Save often",
		    copy.isEmpty() ? m_Folder.Folder().toStdString() : copy.toStdString());
	m_bFailed = !bKept;
}

bool VWorkKeeper::Restore(const VUnsavedWork& i_rWork)
{
	for (const QString& rFile : {i_rWork.m_Source, i_rWork.m_Fbx})
		if (!rFile.isEmpty() && QFileInfo(rFile).isFile())
			m_rPanel.Open(rFile);
	if (!m_rPanel.Restore(i_rWork))
		return false;
	// Its own copy before the other one goes.
	Keep();
	if (!m_bFailed)
		VUnsavedWorkFolder::Discard(i_rWork);
	return true;
}

} // namespace StudioHost

#include "moc_WorkKeeper.cpp"
