#include "retarget/picture/Picture.h"

#include "CommandLineText/Display.h"
#include "CommandLineText/Messages.h"
#include "retarget/subject/PosedByTake.h"
#include "retarget/subject/Session.h"
#include "retarget/text/Output.h"

#include "ComputeSubjectFK/ConstructionException.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "InMemoryHost/Flow.h"
#include "InMemoryHost/Selection.h"
#include "NVX/Status.h"
#include "OrlexGraphics/frame/FrameRenderer.h"
#include "OrlexGraphics/item/SceneOptionsMap.h"
#include "OrlexGraphics/skins/SkinCache.h"
#include "TesselPluginRetargetSetup/RetargetSetupScene.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/SaveFile.h"

#include <QBuffer>
#include <QGuiApplication>
#include <QImage>
#include <QOffscreenSurface>
#include <QOpenGLContext>
#include <QOpenGLFramebufferObject>
#include <QPainter>
#include <QQmlPropertyMap>

#include <algorithm>
#include <optional>

namespace CommandLine
{
namespace
{

static_assert(c_Views.size() == CoreGraphics::ECameraTypeCount);

std::uint32_t CameraType(const std::string& i_rView)
{
	return static_cast<std::uint32_t>(std::find(c_Views.begin(), c_Views.end(), i_rView) - c_Views.begin());
}

/// As the panel's view begins.
OrlexGraphics::VSceneOptions ViewOptions()
{
	OrlexGraphics::VSceneOptions options;
	QQmlPropertyMap map;
	OrlexGraphics::WriteOptionsToMap(options, map);
	const QVariantMap begin = VRetargetSetupScene::ViewOptions();
	for (auto it = begin.begin(); it != begin.end(); ++it)
		map.insert(it.key(), it.value());
	OrlexGraphics::ReadOptionsFromMap(map, options);
	return options;
}

/// With a context current.
QImage Draw(VSession& io_rSession, const VRenderSettings& i_rSettings)
{
	const QSize size(i_rSettings.m_Width, i_rSettings.m_Height);
	const auto pSkins = NVX::MakeShared<OrlexGraphics::VSkinCache>(io_rSession.Dispatcher());
	pSkins->SetMeshRules(FBXIO::c_FaithfulMeshes);
	if (!i_rSettings.m_Skins.empty())
		pSkins->SetFolders(OrlexGraphics::c_pSubjectSkins, {UtilsFileSystem::PathFromUtf8(i_rSettings.m_Skins)});
	const auto pScene =
	    NVX::MakeShared<VRetargetSetupScene>(std::make_shared<CoreGraphics::VShaderLibrary>(), io_rSession.Dispatcher(),
	        std::make_shared<InMemoryHost::VSelectionManager>(), pSkins, io_rSession.SharedDocument(),
	        NVX::CountedPointer<TesselPluginInterface::IItemFactory>(new InMemoryHost::VItemFactory), false);
	OrlexGraphics::VFrameRenderer renderer;
	renderer.Initialise();
	CoreGraphics::VCameraController& rCamera = renderer.m_Input.m_Camera;
	renderer.m_Input.m_Options = ViewOptions();
	rCamera.SetSize(size);
	rCamera.m_Type = CameraType(i_rSettings.m_View);

	QOpenGLFramebufferObject target(size, renderer.TargetFormat());
	if (!target.isValid())
		throw VCommandError(EBadOutput,
		    "The display's OpenGL cannot draw a picture of " + std::to_string(size.width()) + "x"
		        + std::to_string(size.height()) + " pixels: give a smaller --size");
	renderer.SetSize(size);
	renderer.SetScene(pScene);
	// What was posted shows the document's frame; what the frame update places is there with the next exchange.
	io_rSession.Settle();
	pScene->Synchronise();
	renderer.Update();
	pScene->Synchronise();
	rCamera.m_bYUp = pScene->YUp();
	rCamera.Fit(pScene->GetBounds(pScene->ItemsToFrame()), true);
	renderer.Render(target);
	renderer.Paint();
	return target.toImage();
}

/// The pictures of a take's frames, one beside the other. The session is of this picture alone: its subjects are
/// replaced by copies that stand as in the frame.
QImage DrawTake(VSession& io_rSession, const VRenderSettings& i_rSettings)
{
	const auto pTake = std::make_shared<const TakeIO::VTake>(ReadTakeFile(i_rSettings.m_Take, *i_rSettings.m_pTake));
	const auto source = io_rSession.Document().SourceValues();
	const auto target = io_rSession.Document().TargetValues();
	const VPosed posedSource(*source.m_pParametrised);
	const VPosed posedTarget(*target.m_pParametrised);
	std::string error;
	const auto pMotion = TakeSolve::VSourceMotion::Make(
	    posedSource.m_Subject, posedSource.m_BindPose, pTake, ReadPairs(*i_rSettings.m_pPairs), error);
	if (!pMotion)
		throw VCommandError(EWrongUsage, error);
	if (i_rSettings.m_Frames.back() >= pTake->m_Frames)
		throw VCommandError(EWrongUsage, "The take has the frames 0 to " + std::to_string(pTake->m_Frames - 1));
	std::optional<TakeSolve::VTakeSolve> made;
	try
	{
		made.emplace(posedTarget.m_Subject, posedTarget.m_BindPose, pMotion);
	}
	catch (const ComputeSubject::VConstructionException&)
	{
		throw VCommandError(
		    EBadInput, "\"" + i_rSettings.m_In + "\" has a joint without kinematics; retarget check tells which");
	}
	TakeSolve::VTakeSolve& rSolve = *made;
	const int count = int(i_rSettings.m_Frames.size());
	QImage strip;
	std::size_t next = 0;
	for (int i = 0; i < count; ++i)
	{
		// All frames up to it, as a solve of the take has them.
		for (; next < i_rSettings.m_Frames[std::size_t(i)]; ++next)
			rSolve.Solve(next);
		const std::vector<double>& rStates = rSolve.Solve(next++).m_States;
		io_rSession.Document().SetSourceSubject(
		    WithWorldPoses(*source.m_pParametrised, rSolve.SourcePoses()), *source.m_pApplicationData);
		io_rSession.Document().SetTargetSubjectParametrised(WithBindPose(*target.m_pParametrised, rStates));
		const QImage picture = Draw(io_rSession, i_rSettings);
		if (strip.isNull())
			strip = QImage(count * picture.width(), picture.height(), picture.format());
		QPainter(&strip).drawImage(i * picture.width(), 0, picture);
	}
	return strip;
}

void Save(const QImage& i_rPicture, const std::string& i_rPath)
{
	QByteArray bytes;
	QBuffer buffer(&bytes);
	std::string error = "The picture could not be made";
	const bool bMade = i_rPicture.save(&buffer, "PNG");
	const std::string_view content(bytes.constData(), std::size_t(bytes.size()));
	RequireNoErrors();
	if (bMade && i_rPath == "-")
		Print(content);
	else if (!bMade
	    || UtilsFileSystem::SaveFile(UtilsFileSystem::PathFromUtf8(i_rPath), content, error) != NVX::Status::c_Success)
		throw VCommandError(EBadOutput, error);
	PrintResult({{"output", i_rPath}, {"width", i_rPicture.width()}, {"height", i_rPicture.height()}}, "");
}

} // namespace

EExitStatus RenderPicture(const VRenderSettings& i_rSettings)
{
	VSession session;
	session.LoadTarget(i_rSettings.m_In);
	if (!i_rSettings.m_Source.empty())
		session.LoadSource(i_rSettings.m_Source);

	PrepareDisplay({c_pCategory, EBadOutput,
	    "There is no display to draw with: set DISPLAY to one that has OpenGL, or run the command with \"xvfb-run "
	    "-a\""});
	int count = 1;
	char name[] = "retarget";
	char* pArguments[] = {name, nullptr};
	const QGuiApplication application(count, pArguments);
	QOffscreenSurface surface;
	surface.create();
	QOpenGLContext context;
	if (!context.create() || !context.makeCurrent(&surface))
		throw VCommandError(EBadOutput,
		    "This display (" + QGuiApplication::platformName().toStdString()
		        + ") has no OpenGL to draw with: try LIBGL_ALWAYS_SOFTWARE=1, or run the command with \"xvfb-run -a\"");
	Save(i_rSettings.m_Take.empty() ? Draw(session, i_rSettings) : DrawTake(session, i_rSettings),
	    i_rSettings.m_Out.m_Path);
	return EFine;
}

} // namespace CommandLine
