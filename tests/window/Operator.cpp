#include "Operator.h"

#include "../FindItem.h"
#include "../WaitFor.h"

#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QApplication>
#include <QComboBox>
#include <QFileDialog>
#include <QLineEdit>
#include <QMenu>
#include <QMenuBar>
#include <QQuickItem>
#include <QQuickWidget>
#include <QQuickWindow>
#include <QScreen>
#include <QTabBar>
#include <QTabWidget>
#include <QTest>
#include <QTimer>
#include <QWheelEvent>
#include <QWindow>

namespace
{

/// The root's own root, where popups live, too.
QQuickItem* Top(QQuickItem* i_pItem)
{
	while (i_pItem && i_pItem->parentItem())
		i_pItem = i_pItem->parentItem();
	return i_pItem;
}

} // namespace

bool Eventually(const std::function<bool()>& i_rCondition)
{
	return WaitFor(i_rCondition, 60000);
}

VOperator::VOperator(QWidget& i_rWindow, QQuickWidget& i_rPanel) : m_rWindow(i_rWindow), m_rPanel(i_rPanel) {}

QQuickItem* VOperator::Item(const QString& i_rName) const
{
	QQuickItem* const pTop = Top(m_rPanel.rootObject());
	QQuickItem* pItem = pTop ? FindItem(pTop, i_rName, true) : nullptr;
	if (!pItem && pTop)
		pItem = FindItem(pTop, i_rName, false);
	EXPECT_TRUE(pItem) << i_rName.toStdString();
	return pItem;
}

bool VOperator::Shows(const QString& i_rName, const QString& i_rText) const
{
	const QQuickItem* const pItem = FindItem(Top(m_rPanel.rootObject()), i_rName, true);
	return pItem && pItem->property("text").toString() == i_rText;
}

QVariant VOperator::Property(const QString& i_rName, const char* i_pProperty) const
{
	const QQuickItem* const pItem = Item(i_rName);
	return pItem ? pItem->property(i_pProperty) : QVariant();
}

void VOperator::WaitForDrawing() const
{
	// What is queued comes before it.
	QCoreApplication::processEvents();
	bool bDrawn = false;
	const auto connection =
	    QObject::connect(m_rPanel.quickWindow(), &QQuickWindow::afterRendering, [&bDrawn] { bDrawn = true; });
	m_rPanel.quickWindow()->update();
	EXPECT_EVENTUALLY(bDrawn);
	QObject::disconnect(connection);
	// What is drawn is on the screen only when the window has been put together with it, else a little later.
	m_rPanel.repaint();
}

void VOperator::Click(const QString& i_rName, Qt::KeyboardModifiers i_Modifiers, Qt::MouseButton i_Button)
{
	QQuickItem* const pItem = Item(i_rName);
	ASSERT_TRUE(pItem && pItem->isEnabled() && pItem->isVisible()) << i_rName.toStdString();
	// As with the wheel.
	QMetaObject::invokeMethod(Item("leftView"), "reveal", Q_ARG(QVariant, QVariant::fromValue(pItem)));
	const auto middle = [&] { return pItem->mapToScene({pItem->width() / 2, pItem->height() / 2}).toPoint(); };
	// Not while the layout still moves it.
	QPoint place;
	ASSERT_TRUE(Eventually(
	    [&]
	    {
		    place = middle();
		    WaitForDrawing();
		    return middle() == place;
	    }));
	ASSERT_TRUE(m_rPanel.rect().contains(place)) << i_rName.toStdString();
	const QPoint inWindow = m_rPanel.mapTo(&m_rWindow, place);
	QTest::mouseMove(m_rWindow.windowHandle(), inWindow);
	QTest::mouseClick(m_rWindow.windowHandle(), i_Button, i_Modifiers, inWindow);
	QTest::qWait(0);
}

void VOperator::Hover(const QString& i_rName)
{
	const QQuickItem* const pItem = Item(i_rName);
	ASSERT_TRUE(pItem);
	const QPointF middle(pItem->width() / 2, pItem->height() / 2);
	// Two moves: the first one may only enter the window.
	for (const QPointF& rStep : {QPointF(-1, 0), QPointF(0, 0)})
		QTest::mouseMove(
		    m_rWindow.windowHandle(), m_rPanel.mapTo(&m_rWindow, pItem->mapToScene(middle + rStep).toPoint()));
	QTest::qWait(0);
}

QPoint VOperator::InWindow(const QPointF& i_rPlace) const
{
	return m_rPanel.mapTo(&m_rWindow, Item("scene")->mapToScene(i_rPlace).toPoint());
}

void VOperator::Point(const QPointF& i_rPlace, Qt::KeyboardModifiers i_Modifiers)
{
	QTest::mouseEvent(QTest::MouseMove, m_rWindow.windowHandle(), Qt::NoButton, i_Modifiers, InWindow(i_rPlace));
	QTest::qWait(0);
}

void VOperator::Press(Qt::MouseButton i_Button, const QPointF& i_rPlace, Qt::KeyboardModifiers i_Modifiers)
{
	QTest::mousePress(m_rWindow.windowHandle(), i_Button, i_Modifiers, InWindow(i_rPlace));
	QTest::qWait(0);
}

void VOperator::Release(Qt::MouseButton i_Button, const QPointF& i_rPlace, Qt::KeyboardModifiers i_Modifiers)
{
	QTest::mouseRelease(m_rWindow.windowHandle(), i_Button, i_Modifiers, InWindow(i_rPlace));
	QTest::qWait(0);
}

void VOperator::ClickAt(const QPointF& i_rPlace, Qt::KeyboardModifiers i_Modifiers)
{
	Point(i_rPlace, i_Modifiers);
	Press(Qt::LeftButton, i_rPlace, i_Modifiers);
	Release(Qt::LeftButton, i_rPlace, i_Modifiers);
}

void VOperator::Drag(const QVector<Qt::MouseButton>& i_rButtons, const QPoint& i_rFrom, const QPoint& i_rTo,
    Qt::KeyboardModifiers i_Modifiers)
{
	constexpr int c_Steps = 5;
	Point(i_rFrom, i_Modifiers);
	for (const Qt::MouseButton button : i_rButtons)
		Press(button, i_rFrom, i_Modifiers);
	for (int i = 1; i <= c_Steps; ++i)
		Point(i_rFrom + (i_rTo - i_rFrom) * i / c_Steps, i_Modifiers);
	for (const Qt::MouseButton button : i_rButtons)
		Release(button, i_rTo, i_Modifiers);
}

void VOperator::Wheel(int i_Notches)
{
	const QPoint place =
	    InWindow({Property("scene", "width").toDouble() / 2, Property("scene", "height").toDouble() / 2});
	for (int i = 0; i < std::abs(i_Notches); ++i)
	{
		QWheelEvent event(place, m_rWindow.mapToGlobal(place), {}, {0, i_Notches > 0 ? 120 : -120}, Qt::NoButton,
		    Qt::NoModifier, Qt::NoScrollPhase, false);
		QCoreApplication::sendEvent(m_rWindow.windowHandle(), &event);
	}
	QTest::qWait(0);
}

void VOperator::ChooseInNextDialog(
    const char* i_pDialog, const char* i_pBox, const QString& i_rEntry, const char* i_pButton)
{
	auto* const pTimer = new QTimer(&m_rWindow);
	QObject::connect(pTimer, &QTimer::timeout, pTimer,
	    [=]
	    {
		    QWidget* const pDialog = QApplication::activeModalWidget();
		    if (!pDialog || !pDialog->windowHandle() || !pDialog->windowHandle()->isExposed())
			    return;
		    pTimer->deleteLater();
		    pTimer->stop();
		    ASSERT_EQ(pDialog->objectName(), i_pDialog);
		    const auto click = [=](const QWidget& i_rWidget, const QPoint& i_rPlace)
		    { QTest::mouseClick(pDialog->windowHandle(), Qt::LeftButton, {}, i_rWidget.mapTo(pDialog, i_rPlace)); };
		    auto* const pBox = pDialog->findChild<QComboBox*>(i_pBox);
		    const auto* const pPages = pDialog->findChild<QTabWidget*>();
		    for (int page = 0; !pBox->isVisible() && page < pPages->count(); ++page)
			    click(*pPages->tabBar(), pPages->tabBar()->tabRect(page).center());
		    click(*pBox, pBox->rect().center());
		    ASSERT_TRUE(Eventually([] { return QApplication::activePopupWidget() != nullptr; }));
		    for (const Qt::Key key : {Qt::Key_Home, Qt::Key_Down, Qt::Key_Return})
			    if (key != Qt::Key_Down || i_rEntry != pBox->itemText(0))
				    QTest::keyClick(QApplication::activePopupWidget()->windowHandle(), key);
		    EXPECT_EVENTUALLY(pBox->currentText() == i_rEntry);
		    const auto* const pButton = pDialog->findChild<QWidget*>(i_pButton);
		    click(*pButton, pButton->rect().center());
	    });
	pTimer->start(10);
}

void VOperator::AnswerNextQuestion(const QString& i_rQuestion, QMessageBox::StandardButton i_Button)
{
	auto* const pTimer = new QTimer(&m_rWindow);
	QObject::connect(pTimer, &QTimer::timeout, pTimer,
	    [=]
	    {
		    auto* const pBox = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
		    if (!pBox || !pBox->windowHandle() || !pBox->windowHandle()->isExposed())
			    return;
		    pTimer->deleteLater();
		    pTimer->stop();
		    EXPECT_EQ(pBox->text(), i_rQuestion);
		    const QWidget* const pButton = pBox->button(i_Button);
		    ASSERT_TRUE(pButton);
		    QTest::mouseClick(pBox->windowHandle(), Qt::LeftButton, {}, pButton->mapTo(pBox, pButton->rect().center()));
	    });
	pTimer->start(10);
}

QImage VOperator::See(const QPointF& i_rPlace, int i_Reach) const
{
	const QPoint corner = InWindow(i_rPlace) - QPoint(i_Reach, i_Reach);
	return m_rWindow.screen()
	    ->grabWindow(m_rWindow.winId(), corner.x(), corner.y(), 2 * i_Reach + 1, 2 * i_Reach + 1)
	    .toImage();
}

void VOperator::Key(int i_Key, Qt::KeyboardModifiers i_Modifiers)
{
	QTest::keyClick(m_rWindow.windowHandle(), Qt::Key(i_Key), i_Modifiers);
	QTest::qWait(0);
}

void VOperator::Type(const QString& i_rText)
{
	for (const QChar letter : i_rText)
		QTest::keyClick(m_rWindow.windowHandle(), letter.toLatin1());
	QTest::qWait(0);
}

void VOperator::Replace(const QString& i_rName, const QString& i_rText)
{
	Click(i_rName);
	Key(Qt::Key_A, Qt::ControlModifier);
	Type(i_rText);
}

void VOperator::Fill(const QString& i_rName, const QString& i_rText)
{
	Replace(i_rName, i_rText);
	Key(Qt::Key_Return);
}

void VOperator::Choose(const QString& i_rName, const QString& i_rEntry)
{
	const QStringList entries = Property(i_rName, "model").toStringList();
	const auto found = std::find_if(
	    entries.begin(), entries.end(), [&i_rEntry](const QString& i_rText) { return i_rText.trimmed() == i_rEntry; });
	ASSERT_TRUE(found != entries.end()) << i_rEntry.toStdString();
	Click(i_rName);
	if (Property(i_rName, "filterable").toBool())
		Type(i_rEntry);
	else
	{
		Key(Qt::Key_Home);
		for (auto place = entries.begin(); place != found; ++place)
			Key(Qt::Key_Down);
	}
	Key(Qt::Key_Return);
	EXPECT_EVENTUALLY(Property(i_rName, "currentText").toString() == i_rEntry);
}

QString VOperator::ChooseInMenu(const char* i_pMenu, const char* i_pAction)
{
	auto* const pMenu = m_rWindow.findChild<QMenu*>(i_pMenu);
	auto* const pAction = m_rWindow.findChild<QAction*>(i_pAction);
	auto* const pBar = pMenu ? qobject_cast<QMenuBar*>(pMenu->parentWidget()) : nullptr;
	EXPECT_TRUE(pBar && pAction) << i_pMenu << " " << i_pAction;
	if (!pBar || !pAction)
		return {};
	QTest::mouseClick(m_rWindow.windowHandle(), Qt::LeftButton, {},
	    pBar->mapTo(&m_rWindow, pBar->actionGeometry(pMenu->menuAction()).center()));
	EXPECT_EVENTUALLY(pMenu->windowHandle() && pMenu->windowHandle()->isExposed());
	const QString text = pAction->text();
	QTest::mouseClick(pMenu->windowHandle(), Qt::LeftButton, {}, pMenu->actionGeometry(pAction).center());
	EXPECT_EVENTUALLY(!pMenu->isVisible());
	return text;
}

void VOperator::ClickRow(const QString& i_rList, int i_Row, Qt::KeyboardModifiers i_Modifiers)
{
	for (const char* const pView : {"View", "Rows"})
		if (QQuickItem* const pList = FindItem(Top(m_rPanel.rootObject()), i_rList + pView, true))
			QMetaObject::invokeMethod(pList, "positionViewAtIndex", Q_ARG(int, i_Row), Q_ARG(int, 0 /* beginning */));
	QTest::qWait(0);
	Click(i_rList + "Row" + QString::number(i_Row), i_Modifiers);
}

QWidget* VOperator::Dialog() const
{
	for (QWidget* const pWidget : QApplication::topLevelWidgets())
		if (pWidget->isVisible() && qobject_cast<QFileDialog*>(pWidget))
			return pWidget;
	return nullptr;
}

void VOperator::AnswerNextDialog(const QString& i_rPath)
{
	auto* const pTimer = new QTimer(&m_rWindow);
	QObject::connect(pTimer, &QTimer::timeout, pTimer,
	    [this, pTimer, i_rPath]
	    {
		    if (!Dialog())
			    return;
		    pTimer->deleteLater();
		    pTimer->stop();
		    AnswerDialog(i_rPath);
	    });
	pTimer->start(10);
}

void VOperator::AnswerDialog(const QString& i_rPath)
{
	ASSERT_TRUE(Eventually([this] { return Dialog() != nullptr; })) << "no file dialog";
	QWidget* const pDialog = Dialog();
	auto* const pName = pDialog->findChild<QLineEdit*>("fileNameEdit");
	ASSERT_TRUE(pName);
	ASSERT_TRUE(Eventually([&] { return pDialog->windowHandle() && pDialog->windowHandle()->isExposed(); }));
	QTest::mouseClick(pDialog->windowHandle(), Qt::LeftButton, {}, pName->mapTo(pDialog, pName->rect().center()));
	QTest::keyClick(pDialog->windowHandle(), Qt::Key_A, Qt::ControlModifier);
	for (const QChar letter : i_rPath)
		QTest::keyClick(pDialog->windowHandle(), letter.toLatin1());
	QTest::keyClick(pDialog->windowHandle(), Qt::Key_Return);
	EXPECT_TRUE(ComeBack());
}

bool VOperator::ComeBack()
{
	if (!Eventually([] { return !QApplication::activeModalWidget(); }))
		return false;
	// Where no window manager does it.
	m_rWindow.activateWindow();
	return QTest::qWaitForWindowActive(&m_rWindow);
}
