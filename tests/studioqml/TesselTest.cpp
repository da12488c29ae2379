#include "QmlPage.h"

#include <gtest/gtest.h>

#include <QStringListModel>

TEST(Tessel, RunsCommandsAndNamesFiles)
{
	VQmlPage page;
	QStringList commands;
	page.m_Services.m_RunCommand = [&commands](const QString& i_rCommand)
	{
		commands.append(i_rCommand);
		return i_rCommand == "Workspace3d:FrameSelected";
	};
	ASSERT_TRUE(page.Show(R"(
		property bool known: Tessel.execute("Workspace3d:FrameSelected")
		property bool unknown: Tessel.execute("Nothing")
		property string file: Tessel.fileName("file:///home/a%20b/c%23d.qrr")
		property string path: Tessel.localPath("file:///home/a%20b/c%23d.qrr")
		property string elsewhere: Tessel.localPath("https://example.org/x")
		property string folder: Tessel.folderUrl("/home/a b/c#d.qrr")
		property string nothing: Tessel.fileUrl(""))"));
	const QQuickItem* const pRoot = page.View().rootObject();
	EXPECT_TRUE(pRoot->property("known").toBool());
	EXPECT_FALSE(pRoot->property("unknown").toBool());
	EXPECT_EQ(commands, (QStringList{"Workspace3d:FrameSelected", "Nothing"}));
	EXPECT_EQ(pRoot->property("file").toString(), "c#d.qrr");
	EXPECT_EQ(pRoot->property("path").toString(), "/home/a b/c#d.qrr");
	EXPECT_EQ(pRoot->property("elsewhere").toString(), "");
	EXPECT_EQ(pRoot->property("folder").toString(), "file:///home/a b");
	EXPECT_EQ(pRoot->property("nothing").toString(), "");
}

TEST(TesselParameters, OneModelForAGroup)
{
	VQmlPage page;
	QStringList made;
	page.m_Services.m_MakeParameterGroupModel = [&made](const QString& i_rPath, const QString& i_rGroup)
	{
		made.append(i_rPath + "/" + i_rGroup);
		return std::make_unique<QStringListModel>();
	};
	ASSERT_TRUE(page.Show(R"(
		property var first: TesselParameters.ParameterGroupModel("RetargetSetup", "Subject")
		property var second: TesselParameters.ParameterGroupModel("RetargetSetup", "Target")
		property var again: TesselParameters.ParameterGroupModel("RetargetSetup", "Subject"))"));
	const QQuickItem* const pRoot = page.View().rootObject();
	EXPECT_EQ(made, (QStringList{"RetargetSetup/Subject", "RetargetSetup/Target"}));
	EXPECT_TRUE(pRoot->property("first").value<QObject*>());
	EXPECT_NE(pRoot->property("first").value<QObject*>(), pRoot->property("second").value<QObject*>());
	EXPECT_EQ(pRoot->property("first").value<QObject*>(), pRoot->property("again").value<QObject*>());
}

TEST(TesselParameters, NoServicesDoNothing)
{
	VQmlPage page;
	page.m_Services = {};
	ASSERT_TRUE(page.Show(R"(
		property bool known: Tessel.execute("Workspace3d:FrameSelected")
		property var model: TesselParameters.ParameterGroupModel("RetargetSetup", "Subject")
		Component.onCompleted: SelectionManager.clearPreselection()
		ParameterView { model: parent.model })"));
	EXPECT_FALSE(page.View().rootObject()->property("known").toBool());
}
