#pragma once

#include <QImage>
#include <QMessageBox>
#include <QPointF>
#include <QString>
#include <QStringList>
#include <QVariant>
#include <QVector>

#include <functional>

class QQuickItem;
class QQuickWidget;
class QWidget;

/// Someone at the window, with a mouse and a keyboard: every event goes the way of the real ones, from the window on.
class VOperator
{
public:
	/// @param i_rWindow is shown and active.
	/// @param i_rPanel stands in it.
	VOperator(QWidget& i_rWindow, QQuickWidget& i_rPanel);

	/// Of the panel, by objectName, visible ones first; null with a test failure if there is none.
	QQuickItem* Item(const QString& i_rName) const;
	/// A visible item of the panel has this text.
	bool Shows(const QString& i_rName, const QString& i_rText) const;
	QVariant Property(const QString& i_rName, const char* i_pProperty) const;

	/// The mouse, in the middle of an item.
	void Click(const QString& i_rName, Qt::KeyboardModifiers i_Modifiers = Qt::NoModifier,
	    Qt::MouseButton i_Button = Qt::LeftButton);
	void Hover(const QString& i_rName);

	/// The mouse in the preview, at a place in its pixels.
	void Point(const QPointF& i_rPlace, Qt::KeyboardModifiers i_Modifiers = Qt::NoModifier);
	void ClickAt(const QPointF& i_rPlace, Qt::KeyboardModifiers i_Modifiers = Qt::NoModifier);
	void Press(Qt::MouseButton i_Button, const QPointF& i_rPlace, Qt::KeyboardModifiers i_Modifiers = Qt::NoModifier);
	void Release(Qt::MouseButton i_Button, const QPointF& i_rPlace, Qt::KeyboardModifiers i_Modifiers = Qt::NoModifier);
	/// Buttons go down one after the other, the mouse moves in steps, and they go up again.
	void Drag(const QVector<Qt::MouseButton>& i_rButtons, const QPoint& i_rFrom, const QPoint& i_rTo,
	    Qt::KeyboardModifiers i_Modifiers = Qt::NoModifier);
	/// Notches of the wheel, away from the user.
	void Wheel(int i_Notches);
	/// In a box of a dialog that keeps the keyboard until it is answered, as soon as it opens: picks the entry with
	/// this text, then the dialog's button.
	void ChooseInNextDialog(const char* i_pDialog, const char* i_pBox, const QString& i_rEntry, const char* i_pButton);
	/// In a question that keeps the keyboard until it is answered, as soon as it opens.
	void AnswerNextQuestion(const QString& i_rQuestion, QMessageBox::StandardButton i_Button);
	/// What stands on the screen around a place of the preview.
	QImage See(const QPointF& i_rPlace, int i_Reach) const;

	/// Until the panel has been laid out and drawn once more, and stands so on the screen.
	void WaitForDrawing() const;

	/// The keyboard, where the focus is.
	void Key(int i_Key, Qt::KeyboardModifiers i_Modifiers = Qt::NoModifier);
	void Type(const QString& i_rText);

	/// Clicks a field, and puts a text in the place of what is there; then nothing.
	void Replace(const QString& i_rName, const QString& i_rText);
	/// The same, and Enter.
	void Fill(const QString& i_rName, const QString& i_rText);
	/// Opens a box and picks the entry with this text.
	void Choose(const QString& i_rName, const QString& i_rEntry);
	/// Opens a menu of the window and clicks an action of it, both by objectName.
	/// @return the text that the action had there.
	QString ChooseInMenu(const char* i_pMenu, const char* i_pAction);
	/// Clicks on a row of a list or table by its number, after scrolling to it.
	void ClickRow(const QString& i_rList, int i_Row, Qt::KeyboardModifiers i_Modifiers = Qt::NoModifier);

	/// The same for one that keeps the program until it is answered, as soon as it opens.
	void AnswerNextDialog(const QString& i_rPath);
	/// In the file dialog that is open, or opens soon: types the path and presses Enter. A test failure if there is
	/// none.
	void AnswerDialog(const QString& i_rPath);

private:
	QWidget* Dialog() const;
	QPoint InWindow(const QPointF& i_rPlace) const;
	/// The dialog has closed, and the keyboard is the window's again.
	bool ComeBack();

	QWidget& m_rWindow;
	QQuickWidget& m_rPanel;
};

/// Runs events until the condition holds; false after some seconds.
bool Eventually(const std::function<bool()>& i_rCondition);

#define EXPECT_EVENTUALLY(condition) EXPECT_TRUE(Eventually([&] { return bool(condition); })) << #condition
