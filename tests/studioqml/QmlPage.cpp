#include "QmlPage.h"

#include "../FindItem.h"
#include "../QtApplication.h"
#include "../WaitFor.h"

#include <QQmlContext>
#include <QTest>

namespace
{

[[maybe_unused]] auto* const g_pApplication = testing::AddGlobalTestEnvironment(new VQtApplication(DrawWithoutOpenGL));

} // namespace

bool Eventually(const std::function<bool()>& i_rCondition)
{
	return WaitFor(i_rCondition, 5000);
}

VQmlPage::VQmlPage()
    : m_pSelection(std::make_shared<InMemoryHost::VSelectionManager>()), m_pView(std::make_unique<QQuickView>())
{
	m_Services.m_pSelectionManager = m_pSelection;
}

VQmlPage::~VQmlPage() = default;

void VQmlPage::SetContext(const QString& i_rName, QObject* i_pObject)
{
	m_pView->rootContext()->setContextProperty(i_rName, i_pObject);
}

bool VQmlPage::Show(const QString& i_rQml)
{
	StudioHost::RegisterQmlModules(*m_pView->engine(), m_Services);
	QObject::connect(m_pView->engine(), &QQmlEngine::warnings, m_pView.get(),
	    [](const QList<QQmlError>& i_rErrors)
	    {
		    for (const QQmlError& rError : i_rErrors)
			    ADD_FAILURE() << rError.toString().toStdString();
	    });
	QQmlComponent component(m_pView->engine());
	component.setData(("import QtQuick 2.15\nimport Orlex.Controls 1.0\nimport Orlex.Selection 1.0\n"
	                   "import Orlex.Tessel.Parameters 1.0\nimport Orlex.Theme 1.0\nimport TesselQML 1.0\n"
	                   "Rectangle { id: page; width: 500; height: 400; color: Theme.window\n"
	                      + i_rQml + "\n}")
	                      .toUtf8(),
	    QUrl("qrc:/Page.qml"));
	QObject* const pRoot = component.create(m_pView->rootContext());
	if (!pRoot)
	{
		ADD_FAILURE() << component.errorString().toStdString();
		return false;
	}
	m_pView->setContent(QUrl("qrc:/Page.qml"), nullptr, pRoot);
	m_pView->show();
	m_pView->requestActivate();
	const bool bActive = QTest::qWaitForWindowActive(m_pView.get());
	EXPECT_TRUE(bActive);
	return bActive;
}

bool VQmlPage::Has(const QString& i_rObjectName) const
{
	return FindItem(m_pView->contentItem(), i_rObjectName, true);
}

QQuickItem* VQmlPage::Item(const QString& i_rObjectName) const
{
	QQuickItem* pItem = FindItem(m_pView->contentItem(), i_rObjectName, true);
	if (!pItem)
		pItem = FindItem(m_pView->contentItem(), i_rObjectName, false);
	EXPECT_TRUE(pItem) << i_rObjectName.toStdString();
	return pItem;
}

QVariant VQmlPage::Property(const QString& i_rObjectName, const char* i_pProperty) const
{
	const QQuickItem* const pItem = Item(i_rObjectName);
	return pItem ? pItem->property(i_pProperty) : QVariant();
}

QPoint VQmlPage::Centre(const QString& i_rObjectName) const
{
	const QQuickItem* const pItem = Item(i_rObjectName);
	return pItem ? pItem->mapToScene({pItem->width() / 2, pItem->height() / 2}).toPoint() : QPoint();
}

void VQmlPage::Press(const QString& i_rObjectName, Qt::KeyboardModifiers i_Modifiers)
{
	QTest::mousePress(m_pView.get(), Qt::LeftButton, i_Modifiers, Centre(i_rObjectName));
}

void VQmlPage::Click(const QString& i_rObjectName, Qt::KeyboardModifiers i_Modifiers)
{
	QTest::mouseClick(m_pView.get(), Qt::LeftButton, i_Modifiers, Centre(i_rObjectName));
}

void VQmlPage::Hover(const QString& i_rObjectName)
{
	// A move within the item, as a mouse makes many.
	QTest::mouseMove(m_pView.get(), Centre(i_rObjectName) - QPoint(1, 0));
	QTest::mouseMove(m_pView.get(), Centre(i_rObjectName));
	QCoreApplication::processEvents();
}

void VQmlPage::Key(int i_Key, Qt::KeyboardModifiers i_Modifiers)
{
	QTest::keyClick(m_pView.get(), Qt::Key(i_Key), i_Modifiers);
}

void VQmlPage::Type(const QString& i_rText)
{
	for (const QChar character : i_rText)
		QTest::keyClick(m_pView.get(), character.toLatin1());
}

QString VQmlPage::FocusName() const
{
	const QQuickItem* const pItem = m_pView->activeFocusItem();
	return pItem ? pItem->objectName() : QString();
}
