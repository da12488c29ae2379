#include "studio/qmltypes/Tessel.h"

#include "math/VisibleText.h"

#include <QFileInfo>

namespace StudioHost
{

VTessel::VTessel(VCommandRunner i_RunCommand, QObject* i_pParent)
    : QObject(i_pParent), m_RunCommand(std::move(i_RunCommand))
{
}

bool VTessel::execute(const QString& i_rCommand) const
{
	return m_RunCommand && m_RunCommand(i_rCommand);
}

QString VTessel::fileName(const QUrl& i_rUrl)
{
	return visible(i_rUrl.fileName());
}

QString VTessel::visible(const QString& i_rText)
{
	return QString::fromStdString(VisibleText::Of(i_rText.toStdString()));
}

QString VTessel::localPath(const QUrl& i_rUrl)
{
	return i_rUrl.toLocalFile();
}

QUrl VTessel::fileUrl(const QString& i_rPath)
{
	return i_rPath.isEmpty() ? QUrl() : QUrl::fromLocalFile(i_rPath);
}

QUrl VTessel::folderUrl(const QString& i_rPath)
{
	return i_rPath.isEmpty() ? QUrl() : QUrl::fromLocalFile(QFileInfo(i_rPath).path());
}

} // namespace StudioHost

#include "moc_Tessel.cpp"
