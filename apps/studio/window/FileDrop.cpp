#include "studio/window/FileDrop.h"

#include "studio/panel/FileKind.h"

#include <QApplication>
#include <QDropEvent>
#include <QMimeData>
#include <QTimer>
#include <QUrl>
#include <QWidget>

#include <algorithm>
#include <utility>

namespace StudioHost
{
namespace
{

QStringList LocalFiles(const QMimeData& i_rData)
{
	QStringList files;
	for (const QUrl& rUrl : i_rData.urls())
		if (rUrl.isLocalFile())
			files << rUrl.toLocalFile();
	SortByKind(files);
	return files;
}

bool IsAnyOpened(const QStringList& i_rFiles)
{
	return std::ranges::any_of(i_rFiles, [](const QString& i_rFile) { return KindOf(i_rFile) != EFileKind::EOther; });
}

} // namespace

VFileDrop::VFileDrop(QWidget& i_rWindow, const QWidget& i_rOwn, std::function<void(const QStringList&)> i_Mark,
    std::function<void(const QString&, bool)> i_Open)
    : QObject(&i_rWindow), m_rWindow(i_rWindow), m_rOwn(i_rOwn), m_Mark(std::move(i_Mark)), m_Open(std::move(i_Open))
{
	// A panel would say yes to every drag and drop it, a field would take the path as text: the drag is taken before
	// either hears of it.
	QCoreApplication::instance()->installEventFilter(this);
}

bool VFileDrop::IsPart(const QWidget& i_rWidget) const
{
	const QWidget* const pTop = i_rWidget.window();
	return pTop == &m_rWindow || (pTop->windowType() == Qt::Tool && pTop->parentWidget() == &m_rWindow);
}

bool VFileDrop::eventFilter(QObject* i_pReceiver, QEvent* io_pEvent)
{
	const QEvent::Type type = io_pEvent->type();
	if (type != QEvent::DragEnter && type != QEvent::DragMove && type != QEvent::DragLeave && type != QEvent::Drop)
		return false;
	auto* const pWidget = qobject_cast<QWidget*>(i_pReceiver);
	if (!pWidget || !IsPart(*pWidget) || QApplication::activeModalWidget())
		return false;
	if (type == QEvent::DragLeave)
	{
		if (m_bOver)
			m_Mark({});
		return std::exchange(m_bOver, false);
	}
	auto& rDrop = static_cast<QDropEvent&>(*io_pEvent);
	const QStringList files = LocalFiles(*rDrop.mimeData());
	if (!IsAnyOpened(files))
		return false;
	// The files stay where they are, whatever the other side offers.
	rDrop.setDropAction(Qt::CopyAction);
	rDrop.accept();
	if (type == QEvent::DragMove)
		return true;
	m_bOver = type == QEvent::DragEnter;
	const bool bOwn = pWidget == &m_rOwn || m_rOwn.isAncestorOf(pWidget);
	m_Mark(m_bOver && !bOwn ? files : QStringList());
	if (!m_bOver)
		QTimer::singleShot(0, this,
		    [this, files, bOwn]
		    {
			    for (const QString& rFile : files)
				    m_Open(rFile, bOwn);
		    });
	return true;
}

} // namespace StudioHost
