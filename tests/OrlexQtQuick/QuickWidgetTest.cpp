#include "OrlexQtQuick/QuickWidget.h"

#include "../LogRecorder.h"
#include "../QtApplication.h"
#include "TesselPluginInterface/IQuickEngine.h"

#include <QDateTime>
#include <QFile>
#include <QKeyEvent>
#include <QQmlEngine>
#include <QQuickItem>
#include <QQuickWindow>
#include <QSignalSpy>
#include <QTemporaryDir>
#include <gtest/gtest.h>

namespace
{

using OrlexQtQuick::VQuickWidget;

[[maybe_unused]] auto* const g_pApplication = testing::AddGlobalTestEnvironment(new VQtApplication);

class VEngine : public TesselPluginInterface::IQuickEngine
{
public:
	explicit VEngine(bool i_bDeveloper) : m_bDeveloper(i_bDeveloper) {}
	QQmlEngine& Engine() override { return m_Engine; }
	bool IsDeveloper() const override { return m_bDeveloper; }
	NVX::VSignal<>& ReloadSignal() override { return m_ReloadSignal; }

private:
	QQmlEngine m_Engine;
	NVX::VSignal<> m_ReloadSignal;
	const bool m_bDeveloper;
};

class QuickWidget : public testing::Test
{
protected:
	void Write(const char* i_pQml)
	{
		QFile file(m_Folder.filePath("Panel.qml"));
		ASSERT_TRUE(file.open(QIODevice::WriteOnly));
		file.write(i_pQml);
		file.flush();
		// Qt keeps what it compiled as long as a file's time is the same, which it may be for some milliseconds.
		file.setFileTime(QDateTime::fromSecsSinceEpoch(++m_Seconds), QFileDevice::FileModificationTime);
	}
	qint64 m_Seconds = 1000000000;

	QTemporaryDir m_Folder;
	std::shared_ptr<VEngine> m_pDeveloper = std::make_shared<VEngine>(true);
};

TEST_F(QuickWidget, IsFoundUnderItsNames)
{
	VQuickWidget widget(m_pDeveloper);
	for (const char* const pName :
	    {"OrlexQtQuick::VQuickWidget", "NVX::IQuickWidget", "com.Orlex.IQuickWidget", "QQuickWidget"})
		EXPECT_TRUE(widget.qt_metacast(pName)) << pName;
	EXPECT_FALSE(widget.qt_metacast("ISomethingElse"));
	EXPECT_EQ(qobject_cast<NVX::IQuickWidget*>(static_cast<QObject*>(&widget))->Widget(), &widget);
	EXPECT_EQ(widget.focusPolicy(), Qt::StrongFocus);
	EXPECT_TRUE(widget.testAttribute(Qt::WidgetAttribute(4)) && widget.testAttribute(Qt::WidgetAttribute(128)));
}

TEST_F(QuickWidget, LoadsFromTheSourcesOnlyForADeveloper)
{
	Write("import QtQuick 2.15\nItem { property int seen: given; property bool own: contextQuickWidget !== null }");
	VQuickWidget developer(m_pDeveloper);
	int loads = 0;
	developer.LoadedSignal().Connect([&loads] { ++loads; });
	developer.setContextProperty("given", QVariant(7));
	developer.Load(m_Folder.path(), "./sub/../Panel.qml");
	EXPECT_EQ(developer.objectName(), "Panel.qml");
	EXPECT_TRUE(developer.source().isLocalFile());
	ASSERT_TRUE(developer.rootObject());
	EXPECT_EQ(developer.rootObject()->property("seen").toInt(), 7);
	EXPECT_TRUE(developer.rootObject()->property("own").toBool());
	EXPECT_EQ(loads, 1);
	developer.setContextProperties({{"given", 8}});
	EXPECT_EQ(developer.contextProperty("given").toInt(), 8);
	EXPECT_EQ(developer.rootObject()->property("seen").toInt(), 8);

	const auto pUser = std::make_shared<VEngine>(false);
	VQuickWidget user(pUser);
	VLogRecorder log(NVX::ELogError);
	user.Load(m_Folder.path(), "Panel.qml");
	EXPECT_EQ(user.source(), QUrl("qrc:/Panel.qml"));
	EXPECT_FALSE(user.rootObject());
	const std::string told = log.Take();
	EXPECT_EQ(told.find("2 QuickWidget: "), 0u) << "a file that is nowhere is told";
	EXPECT_EQ(told.find("\n2 "), std::string::npos) << "once: " << told;
}

TEST_F(QuickWidget, SettingAPropertyAgainIsTakenAnew)
{
	Write("import QtQuick 2.15\nItem { property var counter: ({ n: 0 })\n"
	      "property bool seen: { counter.n += 1; return flag }\nfunction count() { return counter.n } }");
	VQuickWidget widget(m_pDeveloper);
	widget.setContextProperty("flag", QVariant(true));
	widget.Load(m_Folder.path(), "Panel.qml");
	const auto count = [&widget]
	{
		QVariant result;
		QMetaObject::invokeMethod(widget.rootObject(), "count", Q_RETURN_ARG(QVariant, result));
		return result.toInt();
	};
	const int before = count();
	widget.setContextProperty("flag", QVariant(true));
	EXPECT_EQ(count(), before + 1) << "what acts on a property being set acts each time";
}

TEST_F(QuickWidget, ReloadsWhatHasChangedOnDisk)
{
	Write("import QtQuick 2.15\nItem { property int version: 1 }");
	auto pWidget = std::make_unique<VQuickWidget>(m_pDeveloper);
	const auto version = [&pWidget] { return pWidget->rootObject()->property("version").toInt(); };
	pWidget->Load(m_Folder.path(), "Panel.qml");
	EXPECT_EQ(version(), 1);

	Write("import QtQuick 2.15\nItem { property int version: 2 }");
	QKeyEvent f5(QEvent::KeyPress, 0x1000034, Qt::NoModifier);
	QCoreApplication::sendEvent(pWidget.get(), &f5);
	EXPECT_EQ(version(), 2);

	Write("import QtQuick 2.15\nItem { property int version: 3 }");
	m_pDeveloper->ReloadSignal().Fire();
	EXPECT_EQ(version(), 3);

	pWidget.reset();
	m_pDeveloper->ReloadSignal().Fire();
	EXPECT_EQ(m_pDeveloper->ReloadSignal().Count(), 0u) << "nothing is called behind the widget's end";
}

TEST_F(QuickWidget, PersistentPropertiesTellOfChangesOnly)
{
	VQuickWidget widget(m_pDeveloper);
	QSignalSpy changes(&widget.PersistentProperties(), &QQmlPropertyMap::valueChanged);
	widget.SetPersistentProperty("Split", 0.4);
	widget.SetPersistentProperty("Split", 0.4);
	ASSERT_EQ(changes.size(), 1);
	EXPECT_EQ(changes[0][0].toString(), "Split");
	EXPECT_EQ(changes[0][1].toDouble(), 0.4);
}

TEST_F(QuickWidget, DropsTheSceneGraphForTheTimeOfAWindowChangeOnly)
{
	class VScreenWidget : public VQuickWidget
	{
	public:
		using VQuickWidget::VQuickWidget;
		int m_WindowChanges = 0;

	protected:
		bool event(QEvent* i_pEvent) override
		{
			m_WindowChanges += i_pEvent->type() == QEvent::Type(215);
			return VQuickWidget::event(i_pEvent);
		}
	};
	VScreenWidget widget(m_pDeveloper);
	for (const bool bPersistent : {true, false})
	{
		widget.quickWindow()->setPersistentSceneGraph(bPersistent);
		QEvent screenChange(QEvent::Type(216));
		QCoreApplication::sendEvent(&widget, &screenChange);
		EXPECT_EQ(widget.quickWindow()->isPersistentSceneGraph(), bPersistent);
	}
	EXPECT_EQ(widget.m_WindowChanges, 2) << "a new screen is a new window too";
}

} // namespace
