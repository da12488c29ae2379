#include "Operator.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QFileDialog>
#include <QLineEdit>
#include <QQuickItem>
#include <QQuickWidget>
#include <QTest>
#include <QWindow>

namespace
{

QQuickItem* Find(QQuickItem* i_pItem, const QString& i_rName, bool i_bVisible)
{
	if (i_pItem->objectName() == i_rName && (!i_bVisible || i_pItem->isVisible()))
		return i_pItem;
	for (QQuickItem* const pChild : i_pItem->childItems())
		if (QQuickItem* const pFound = Find(pChild, i_rName, i_bVisible))
			return pFound;
	return nullptr;
}

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
	return QTest::qWaitFor(i_rCondition, 60000);
}

VOperator::VOperator(QWidget& i_rWindow, QQuickWidget& i_rPanel) : m_rWindow(i_rWindow), m_rPanel(i_rPanel) {}

QQuickItem* VOperator::Item(const QString& i_rName) const
{
	QQuickItem* const pTop = Top(m_rPanel.rootObject());
	QQuickItem* pItem = pTop ? Find(pTop, i_rName, true) : nullptr;
	if (!pItem && pTop)
		pItem = Find(pTop, i_rName, false);
	EXPECT_TRUE(pItem) << i_rName.toStdString();
	return pItem;
}

QVariant VOperator::Property(const QString& i_rName, const char* i_pProperty) const
{
	const QQuickItem* const pItem = Item(i_rName);
	return pItem ? pItem->property(i_pProperty) : QVariant();
}

void VOperator::Click(const QString& i_rName, Qt::KeyboardModifiers i_Modifiers)
{
	const QQuickItem* const pItem = Item(i_rName);
	ASSERT_TRUE(pItem && pItem->isEnabled() && pItem->isVisible()) << i_rName.toStdString();
	// Not while the layout still moves it.
	QPoint place(-1, -1);
	ASSERT_TRUE(Eventually(
	    [&]
	    {
		    const QPoint now = pItem->mapToScene({pItem->width() / 2, pItem->height() / 2}).toPoint();
		    QTest::qWait(0);
		    return std::exchange(place, now) == now;
	    }));
	ASSERT_TRUE(m_rPanel.rect().contains(place)) << i_rName.toStdString();
	const QPoint inWindow = m_rPanel.mapTo(&m_rWindow, place);
	QTest::mouseMove(m_rWindow.windowHandle(), inWindow);
	QTest::mouseClick(m_rWindow.windowHandle(), Qt::LeftButton, i_Modifiers, inWindow);
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

void VOperator::ClickRow(const QString& i_rList, int i_Row, Qt::KeyboardModifiers i_Modifiers)
{
	for (const char* const pView : {"View", "Rows"})
		if (QQuickItem* const pList = Find(Top(m_rPanel.rootObject()), i_rList + pView, true))
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

bool VOperator::DismissDialog()
{
	if (!Eventually([this] { return Dialog() != nullptr; }))
		return false;
	QTest::keyClick(Dialog()->windowHandle(), Qt::Key_Escape);
	return ComeBack();
}

bool VOperator::ComeBack()
{
	if (!Eventually([this] { return !Dialog(); }))
		return false;
	// Where no window manager does it.
	m_rWindow.activateWindow();
	return QTest::qWaitForWindowActive(&m_rWindow);
}
