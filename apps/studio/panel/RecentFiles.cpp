#include "studio/panel/RecentFiles.h"

#include "studio/panel/FileKind.h"

#include <QFileInfo>

namespace StudioHost
{
namespace
{

const QString c_Key = QStringLiteral("RecentFiles");

} // namespace

VRecentFiles::VRecentFiles(QSettings& i_rSettings)
    : m_rSettings(i_rSettings), m_Files(i_rSettings.value(c_Key).toStringList().mid(0, c_Count))
{
	m_Files.removeAll({});
}

void VRecentFiles::Add(const QString& i_rPath)
{
	PutInFront(QFileInfo(i_rPath).absoluteFilePath());
}

void VRecentFiles::AddTake(const QString& i_rPath)
{
	PutInFront((KindOf(i_rPath) == EFileKind::ETake ? "" : c_pAsTake) + QFileInfo(i_rPath).absoluteFilePath());
}

void VRecentFiles::PutInFront(const QString& i_rFile)
{
	QStringList files = m_Files;
	files.removeAll(i_rFile);
	files.prepend(i_rFile);
	Set(files.mid(0, c_Count));
}

void VRecentFiles::Remove(const QString& i_rPath)
{
	QStringList files = m_Files;
	files.removeAll(i_rPath);
	Set(files);
}

void VRecentFiles::Clear()
{
	Set({});
}

void VRecentFiles::Set(QStringList i_Files)
{
	if (m_Files == i_Files)
		return;
	m_Files = std::move(i_Files);
	m_rSettings.setValue(c_Key, m_Files);
	emit changed();
}

} // namespace StudioHost

#include "moc_RecentFiles.cpp"
