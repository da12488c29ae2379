#include "studio/panel/RecentFiles.h"

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
	const QString path = QFileInfo(i_rPath).absoluteFilePath();
	QStringList files = m_Files;
	files.removeAll(path);
	files.prepend(path);
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
