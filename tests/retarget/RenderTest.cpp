#include "Rows.h"

#include "CoreGraphics/ShaderLibrary.h"
#include "InMemoryHost/Flow.h"
#include "InMemoryHost/Selection.h"
#include "OrlexGraphics/item/SceneFramebufferObject.h"
#include "OrlexGraphics/skins/SkinCache.h"
#include "TesselPluginRetargetSetup/RetargetSetupScene.h"
#include "retarget/picture/RenderCommand.h"
#include "retarget/subject/Session.h"

#include <QImage>
#include <QQuickWidget>
#include <QTest>

namespace
{

/// A folder with a retarget subject in it.
class VSubjectFolder : public VScratchFolder
{
public:
	VSubjectFolder()
	{
		const VRun run =
		    Run({"-q", "create", "--fbx", Data("fbx/own_ns_yup_cm_b7400.fbx"), "--source", c_Performer, "--position",
		        "Hips:Hips", "--symmetry", "--rotation", "LeftArm:LeftArm", "--update-targets", "-o", "x.qrr"});
		EXPECT_EQ(run.m_Status, 0) << run.m_Err;
	}
};

/// The preview as the panel has it, in a window of its own.
class VPreview
{
public:
	explicit VPreview(const std::string& i_rSubject)
	{
		m_Session.LoadTarget(i_rSubject);
		m_Session.LoadSource(c_Performer);
		const auto pSkins = NVX::MakeShared<OrlexGraphics::VSkinCache>(m_Session.Dispatcher());
		pSkins->SetMeshRules(FBXIO::c_FaithfulMeshes);
		pSkins->SetFolders(OrlexGraphics::c_pSubjectSkins, {Data("fbx")});
		m_pScene = NVX::MakeShared<VRetargetSetupScene>(std::make_shared<CoreGraphics::VShaderLibrary>(),
		    m_Session.Dispatcher(), m_pSelection, pSkins, m_Session.SharedDocument(),
		    NVX::CountedPointer<TesselPluginInterface::IItemFactory>(new InMemoryHost::VItemFactory), false);
		m_pItem = new OrlexGraphics::VSceneFramebufferObject;
		m_pItem->SetScene(m_pScene.get());
		const QVariantMap options = m_pScene->property("viewOptions").toMap();
		for (auto it = options.begin(); it != options.end(); ++it)
		{
			m_pItem->GetSceneOptions()->insert(it.key(), it.value());
			m_pItem->OnSceneOptionsMapChanged(it.key(), it.value());
		}
		m_Widget.setResizeMode(QQuickWidget::SizeRootObjectToView);
		m_Widget.setContent(QUrl(), nullptr, m_pItem);
		m_Widget.resize(320, 200);
		m_Widget.show();
	}

	/// With all segments of both subjects in the view, and none selected.
	QImage Draw(int i_CameraType)
	{
		m_pItem->SetCameraType(i_CameraType);
		std::vector<NVX::ISelectionItem> all;
		for (std::uint32_t i = 0; i < 100; ++i)
			for (const std::uint32_t kind : {NVX::ESelectionSourceSegment, NVX::ESelectionTargetSegment})
				all.push_back({kind, 0x0fffffff, i, {}});
		m_pSelection->Selection().Replace(all);
		Settle();
		m_pItem->SetFocusSelection(true);
		Settle();
		m_pSelection->Selection().Replace({});
		Settle();
		return m_Widget.grabFramebuffer();
	}

private:
	/// What a frame finds changed asks for another one.
	void Settle()
	{
		for (int i = 0; i < 4; ++i)
		{
			m_Session.Settle();
			QCoreApplication::processEvents();
			m_Widget.grabFramebuffer();
		}
	}

	CommandLine::VSession m_Session;
	const std::shared_ptr<InMemoryHost::VSelectionManager> m_pSelection =
	    std::make_shared<InMemoryHost::VSelectionManager>();
	std::shared_ptr<VRetargetSetupScene> m_pScene;
	QQuickWidget m_Widget;
	/// The widget owns it.
	OrlexGraphics::VSceneFramebufferObject* m_pItem = nullptr;
};

TEST(Render, DrawsWhatThePreviewShows)
{
	const VSubjectFolder folder;
	VPreview preview((folder / "x.qrr").string());
	QImage before;
	for (std::size_t i = 0; i < CommandLine::c_Views.size(); ++i)
	{
		const std::string view = CommandLine::c_Views[i];
		SCOPED_TRACE(view);
		const VRun run = folder.Run({"-q", "render", "x.qrr", "--source", c_Performer, "--skins", Data("fbx"), "--view",
		    view, "--size", "320x200", "-o", view + ".png"});
		EXPECT_EQ(run.m_Status, 0) << run.m_Err;
		const QImage drawn = QImage(QString::fromStdString((folder / (view + ".png")).string()));
		EXPECT_EQ(drawn.convertToFormat(QImage::Format_RGB32),
		    preview.Draw(static_cast<int>(i)).convertToFormat(QImage::Format_RGB32));
		EXPECT_NE(drawn, before);
		before = drawn;
	}
	EXPECT_EQ(folder.Names().size(), CommandLine::c_Views.size() + 1);
	const std::vector<std::string> bottom{
	    "-q", "render", "x.qrr", "--source", c_Performer, "--view", "bottom", "--size", "320x200", "-o", "-"};
	std::vector<std::string> skinned = bottom;
	skinned.insert(skinned.end(), {"--skins", Data("fbx")});
	EXPECT_EQ(folder.Run(skinned).m_Out, folder.Read("bottom.png"));
	const std::string bones = folder.Run(bottom).m_Out;
	EXPECT_NE(bones, folder.Read("bottom.png")) << "bones alone";
	std::vector<std::string> piped = bottom;
	piped[2] = "-";
	EXPECT_EQ(folder.Run(piped, "x.qrr").m_Out, bones);
	EXPECT_EQ(folder.Run({"-q", "create", "--fbx", Data("fbx/heaps_biped_zup_a7100.fbx"), "-o", "y.qrr"}).m_Status, 0);
	const VRun shared = folder.Run({"render", "y.qrr", "--skins", Data("fbx"), "--size", "64x64", "-o", "-"});
	EXPECT_EQ(shared.m_Err.find("other control points"), std::string::npos) << shared.m_Err;
}

TEST(Render, PicturesOfAReport)
{
	const VSubjectFolder folder;
	const auto pictures = [&](std::vector<std::string> i_Options)
	{
		i_Options.insert(i_Options.begin(), {"-q", "report", "x.qrr", "--source", c_Performer, "-o", "-"});
		const std::string page = folder.Run(i_Options).m_Out;
		const std::string begin = "src=\"data:image/png;base64,iVBORw0KGgo";
		int count = 0;
		for (std::size_t at = page.find(begin); at != std::string::npos; at = page.find(begin, at + 1))
			++count;
		EXPECT_EQ(folder.Run(i_Options).m_Out, page);
		return count;
	};
	EXPECT_EQ(pictures({}), 2);
	EXPECT_EQ(pictures({"--fbx", c_Fbx}), 4);
	EXPECT_EQ(pictures({"--no-pictures"}), 0);
}

TEST(Render, TellsWhatItLacks)
{
	const VSubjectFolder folder;
	folder.Write(boost::filesystem::path(c_Fbx).filename().string(), Get(c_Fbx).substr(0, 5000));
	const std::string noDisplay = "error retarget: There is no display to draw with: set DISPLAY";
	const struct
	{
		const char* m_pDisplay;
		const char* m_pPlatform;
		VRow m_Row;
	} rows[] = {
	    {"", "", {"no display", {"-q", "render", "x.qrr", "-o", "x.png"}, 4, "", noDisplay}},
	    {":32123", "xcb", {"no such display", {"-q", "render", "x.qrr", "-o", "x.png"}, 4, "", noDisplay}},
	    {"", "offscreen",
	        {"no OpenGL", {"-q", "render", "x.qrr", "-o", "x.png"}, 4, "", "(offscreen) has no OpenGL to draw with"}},
	    {"", "",
	        {"files come first", {"render", "nowhere.qrr", "-o", "x.png"}, 3, "", "\"nowhere.qrr\" could not be read"}},
	    {nullptr, nullptr,
	        {"no such skin", {"render", "x.qrr", "--skins", ".", "-o", "x.png"}, 3, "",
	            "error retarget: Nothing is written after an error"}},
	    {nullptr, nullptr, {"no such folder", {"-q", "render", "x.qrr", "-o", "no/x.png"}, 4, "", "error retarget: "}},
	};
	for (const auto& rRow : rows)
	{
		const QByteArray display = qgetenv("DISPLAY"), platform = qgetenv("QT_QPA_PLATFORM");
		const QByteArray sanitizer = qgetenv("ASAN_OPTIONS");
		if (rRow.m_pDisplay)
			qputenv("DISPLAY", rRow.m_pDisplay);
		if (rRow.m_pPlatform)
			qputenv("QT_QPA_PLATFORM", rRow.m_pPlatform);
		// This platform leaves its screen to the end of the process, and is known only by its whole stack.
		if (qgetenv("QT_QPA_PLATFORM") == "offscreen")
			qputenv("ASAN_OPTIONS", sanitizer + ":fast_unwind_on_malloc=0");
		RunRows({rRow.m_Row}, folder);
		qputenv("DISPLAY", display);
		qputenv("QT_QPA_PLATFORM", platform);
		qputenv("ASAN_OPTIONS", sanitizer);
	}
}

} // namespace

/// The frames of a take stand beside each other, each with what moved since the one before.
TEST(Render, DrawsAStripOfATake)
{
	const VSubjectFolder folder;
	const VRun run = folder.Run({"-q", "render", "x.qrr", "--source", c_Performer, "--take",
	    Data("motion/chest_yxz_120fps.bvh"), "--frames", "0:60:30", "--size", "120x100", "-o", "strip.png"});
	ASSERT_EQ(run.m_Status, 0) << run.m_Err;
	const QImage strip = QImage::fromData(QByteArray::fromStdString(folder.Read("strip.png")));
	ASSERT_EQ(strip.size(), QSize(360, 100));
	const QImage first = strip.copy(0, 0, 120, 100);
	EXPECT_NE(first, strip.copy(120, 0, 120, 100));
	EXPECT_NE(first, strip.copy(240, 0, 120, 100));
	const VRun one = folder.Run({"-q", "render", "x.qrr", "--source", c_Performer, "--take",
	    Data("motion/chest_yxz_120fps.bvh"), "--frame", "0", "--size", "120x100", "-o", "one.png"});
	EXPECT_EQ(one.m_Status, 0) << one.m_Err;
	EXPECT_EQ(QImage::fromData(QByteArray::fromStdString(folder.Read("one.png"))), first);
	EXPECT_EQ(folder
	              .Run({"-q", "render", "x.qrr", "--source", c_Performer, "--take", Data("motion/chest_yxz_120fps.bvh"),
	                  "--frame", "61", "-o", "no.png"})
	              .m_Status,
	    2);
}
