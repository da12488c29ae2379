#pragma once

#include "InMemoryHost/Selection.h"
#include "NVX/SelectionItemVariant.h"
#include "studio/qmltypes/QmlModules.h"

#include <QQmlEngine>
#include <QQuickItem>
#include <QQuickView>

#include <memory>

/// A window that shows a piece of QML on the host's modules, and the mouse and keys for it.
class VQmlPage
{
public:
	VQmlPage();
	~VQmlPage();

	/// What stands in a root item of 500x400. Context objects are set by name before.
	void SetContext(const QString& i_rName, QObject* i_pObject);
	/// False, with the errors as test failures, if the QML does not load or the window does not get active.
	bool Show(const QString& i_rQml);

	/// By objectName, among visible items first; null with a test failure if there is none.
	QQuickItem* Item(const QString& i_rObjectName) const;
	bool Has(const QString& i_rObjectName) const;
	QVariant Property(const QString& i_rObjectName, const char* i_pProperty) const;

	QPoint Centre(const QString& i_rObjectName) const;
	void Press(const QString& i_rObjectName, Qt::KeyboardModifiers i_Modifiers = Qt::NoModifier);
	void Click(const QString& i_rObjectName, Qt::KeyboardModifiers i_Modifiers = Qt::NoModifier);
	void Hover(const QString& i_rObjectName);
	void Key(int i_Key, Qt::KeyboardModifiers i_Modifiers = Qt::NoModifier);
	void Type(const QString& i_rText);
	QString FocusName() const;

	InMemoryHost::VSelectionManager& Selection() { return *m_pSelection; }
	QQuickView& View() { return *m_pView; }
	/// What a test wants of the services, before Show.
	StudioHost::VQmlServices m_Services;

private:
	const std::shared_ptr<InMemoryHost::VSelectionManager> m_pSelection;
	std::unique_ptr<QQuickView> m_pView;
};

/// Runs events until the condition holds; false after five seconds.
bool Eventually(const std::function<bool()>& i_rCondition);

#define EXPECT_EVENTUALLY(condition) EXPECT_TRUE(Eventually([&] { return bool(condition); })) << #condition
