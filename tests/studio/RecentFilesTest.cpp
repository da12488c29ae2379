#include "Host.h"

#include "studio/panel/FileKind.h"
#include "studio/panel/RecentFiles.h"

namespace
{

using StudioHost::EFileKind;
using StudioHost::VRecentFiles;

TEST(FileKinds, ByExtensionInAnyCase)
{
	const std::pair<const char*, EFileKind> rows[] = {{"a.qrs", EFileKind::ESource}, {"/b/A.FBX", EFileKind::EFbx},
	    {"a.qrr", EFileKind::ETarget}, {"a.b.QRX", EFileKind::ETarget}, {"a.qrt", EFileKind::EOther},
	    {"qrs", EFileKind::EOther}, {"a.fbx/", EFileKind::EOther}, {"", EFileKind::EOther}};
	for (const auto& [pPath, kind] : rows)
		EXPECT_EQ(StudioHost::KindOf(pPath), kind) << pPath;
	QStringList files{"2.qrr", "x.txt", "b.fbx", "1.qrr", "a.qrs"};
	StudioHost::SortByKind(files);
	EXPECT_EQ(files, (QStringList{"a.qrs", "b.fbx", "2.qrr", "1.qrr", "x.txt"}));
}

TEST(RecentFiles, TheLastTenNewestFirst)
{
	VScratchSettings scratch;
	int changes = 0;
	{
		VRecentFiles files(scratch.m_Settings);
		QObject::connect(&files, &VRecentFiles::changed, [&] { ++changes; });
		for (int i = 0; i < 12; ++i)
			files.Add(QString("/f/%1.qrr").arg(i));
		files.Add("/f/5.qrr");
		files.Add("/f/5.qrr");
		files.Remove("/f/8.qrr");
	}
	EXPECT_EQ(changes, 14);
	VRecentFiles again(scratch.m_Settings);
	EXPECT_EQ(again.Files(),
	    (QStringList{"/f/5.qrr", "/f/11.qrr", "/f/10.qrr", "/f/9.qrr", "/f/7.qrr", "/f/6.qrr", "/f/4.qrr", "/f/3.qrr",
	        "/f/2.qrr"}));
	again.AddTake("/f/run.fbx");
	again.AddTake("/f/run.bvh");
	EXPECT_EQ(again.Files().mid(0, 2), (QStringList{"/f/run.bvh", "take:/f/run.fbx"}));
	again.Clear();
	EXPECT_TRUE(VRecentFiles(scratch.m_Settings).Files().isEmpty());
}

} // namespace
