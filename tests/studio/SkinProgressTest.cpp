#include "studio/window/SkinProgress.h"

#include "../OrlexGraphics/HeldJobs.h"
#include "Host.h"
#include "OrlexGraphics/skins/SkinCache.h"
#include "studio/host/JobRunner.h"
#include "studio/host/QtDispatcher.h"

#include <QLabel>
#include <QProgressBar>
#include <QTest>
#include <QThread>

namespace
{

TEST(SkinProgress, NamesTheSkinsThatAreBeingRead)
{
	QTemporaryDir folder;
	for (const char* const pName : {"Hero", "Villain"})
		QFile::copy(RETARGET_SOURCE "/demo/character.fbx", folder.filePath(QString(pName) + ".fbx"));
	const auto pDispatcher = std::make_shared<StudioHost::VQtDispatcher>();
	const auto pJobs = std::make_shared<VHeldJobs>();
	const auto pCache = NVX::MakeShared<OrlexGraphics::VSkinCache>(pDispatcher, pJobs);
	auto pProgress = std::make_unique<StudioHost::VSkinProgress>(pCache, pDispatcher);
	pProgress->show();
	const auto& rText = *pProgress->findChild<QLabel*>("SkinProgressText");
	const auto& rBar = *pProgress->findChild<QProgressBar*>("SkinProgressBar");
	EXPECT_EQ(rText.text(), "");
	EXPECT_FALSE(rBar.isVisible());

	pCache->SetFolders("Subject", {folder.path().toStdString()});
	std::shared_ptr<CoreGraphics::VSkin> pSkin;
	pCache->GetSkin(pSkin, "Hero", "Subject");
	pCache->GetSkin(pSkin, "Villain", "Subject");
	RunEvents();
	EXPECT_EQ(rText.text(), "Loading skin Hero, Villain");
	EXPECT_TRUE(rBar.isVisible());
	pJobs->RunAll();
	RunEvents();
	EXPECT_EQ(rText.text(), "");
	EXPECT_FALSE(rBar.isVisible());
	pProgress.reset();
	pCache->LoadingSignal().Fire();
	RunEvents();
	pCache->Dispose();
}

TEST(JobRunner, RunsJobsBesideTheThreadOfTheWindow)
{
	const auto pDispatcher = std::make_shared<StudioHost::VQtDispatcher>();
	QThread* pJob = nullptr;
	QThread* pCompletion = nullptr;
	VMessages messages;
	StudioHost::VJobRunner runner;
	runner.Run([&] { pJob = QThread::currentThread(); }, [&] { pCompletion = QThread::currentThread(); }, pDispatcher);
	ASSERT_TRUE(QTest::qWaitFor([&] { return pCompletion != nullptr; }, 20000));
	EXPECT_NE(pJob, QThread::currentThread());
	EXPECT_EQ(pCompletion, QThread::currentThread());

	bool bCompleted = false;
	runner.Run([] { throw std::runtime_error("no disk"); }, [&] { bCompleted = true; }, pDispatcher);
	EXPECT_TRUE(QTest::qWaitFor([&] { return bCompleted; }, 20000)) << "whoever waits goes on";
	EXPECT_EQ(messages.Take(), "2 System: A job in the background failed: no disk");
}

} // namespace
