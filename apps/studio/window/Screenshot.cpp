#include "studio/window/Screenshot.h"

#include "DebugServices/GlobalLog.h"
#include "NVX/Status.h"
#include "OrlexGraphics/skins/SkinCache.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/SaveFile.h"
#include "studio/host/QtDispatcher.h"
#include "studio/host/Services.h"
#include "studio/motion/TakePlayer.h"
#include "studio/window/ReviewDialog.h"
#include "studio/window/StudioWindow.h"

#include <QApplication>
#include <QBuffer>
#include <QDialog>
#include <QPainter>
#include <QPixmap>
#include <QQuickWidget>
#include <QQuickWindow>

#include <algorithm>

namespace StudioHost
{
namespace
{

/// What a drawing finds changed asks for one more, and what the preview reads back shows with the one behind that.
constexpr int c_DrawnAtRest = 4;

} // namespace

VScreenshot::VScreenshot(VStudioWindow& i_rWindow, QQuickWidget& i_rPanel, QString i_Path)
    : m_rWindow(i_rWindow), m_rPanel(i_rPanel), m_Path(std::move(i_Path))
{
	// Queued: the signal comes from within the drawing.
	connect(m_rPanel.quickWindow(), &QQuickWindow::afterRendering, this, &VScreenshot::OnDrawn, Qt::QueuedConnection);
	m_rPanel.quickWindow()->update();
}

void VScreenshot::OnDrawn()
{
	if (m_bDone)
		return;
	m_DrawnAtRest = AtRest() ? m_DrawnAtRest + 1 : 0;
	if (m_DrawnAtRest < c_DrawnAtRest)
	{
		m_rPanel.quickWindow()->update();
		return;
	}
	m_bDone = true;
	emit done(Save());
}

bool VScreenshot::AtRest() const
{
	const auto dialogs = m_rWindow.findChildren<VReviewDialog*>();
	return std::ranges::none_of(dialogs, &VReviewDialog::IsAwaiting) && m_rWindow.Dispatcher().PendingCount() == 0
	    && m_rWindow.Gui().GetSkinCache()->Loading().empty() && m_rWindow.Motion().AtRest();
}

QPixmap VScreenshot::Picture() const
{
	QPixmap picture = m_rWindow.grab();
	QPainter painter(&picture);
	// Dialogs are windows of their own.
	for (QWidget* const pWidget : QApplication::topLevelWidgets())
	{
		if (!pWidget->isVisible() || !qobject_cast<QDialog*>(pWidget))
			continue;
		const QRect place(pWidget->geometry().topLeft() - m_rWindow.geometry().topLeft(), pWidget->size());
		painter.drawPixmap(place.topLeft(), pWidget->grab());
		painter.setPen(pWidget->palette().color(QPalette::Mid));
		painter.drawRect(place.adjusted(-1, -1, 0, 0));
	}
	return picture;
}

bool VScreenshot::Save() const
{
	QByteArray bytes;
	QBuffer buffer(&bytes);
	std::string error = "The picture could not be made";
	if (Picture().save(&buffer, "PNG")
	    && UtilsFileSystem::SaveFile(UtilsFileSystem::PathFromUtf8(m_Path.toStdString()),
	           {bytes.constData(), std::size_t(bytes.size())}, error)
	        == NVX::Status::c_Success)
		return true;
	NVX_LOG("System", NVX::ELogError, "%1%", error);
	return false;
}

} // namespace StudioHost

#include "moc_Screenshot.cpp"
