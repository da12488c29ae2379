#include "OffscreenContext.h"

#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/SelectableProgram.h"
#include "CoreGraphics/Shader.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "CoreGraphics/ShaderProgram.h"
#include "DebugServices/GlobalLog.h"

#include <QFile>
#include <QOpenGLShader>
#include <QTemporaryDir>

#include <algorithm>
#include <regex>
#include <set>
#include <string>
#include <vector>

using namespace CoreGraphics;
using GraphicsTest::EDialect;

namespace
{

/// What is logged while it lives, errors alone unless told otherwise.
class VLog
{
public:
	std::vector<std::string> m_Messages;

private:
	std::shared_ptr<void> m_pSink = NVX::GlobalLog::AddSink(
	    [this](const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage)
	    {
		    if (i_rCategory.Name() == "CoreGraphics" && i_Level <= NVX::ELogError)
			    m_Messages.push_back(i_rMessage);
	    });
};

struct VPair
{
	const char* m_pVertex;
	const char* m_pFragment;
	bool m_bSelectable;
};

constexpr VPair c_Catalogue[] = {{"General2D", "UniformColour", false}, {"Simple3DPointSize", "UniformColour", false},
    {"Simple3DModelColour", "Colour", true}, {"ScreenSpaceAxis", "Colour", false}, {"FBXMesh", "FBXMaterial", false},
    {"Simple", "Outlines", false}, {"Simple", "AntiAlias", false}, {"Simple3DModelWireframe", "UniformColour", false},
    {"Simple3DModelWireframe", "Colour", false}, {"Camera", "Camera", true}, {"Centroid2D", "Centroid2D", false},
    {"Centroid2D", "Centroid2DSelection", false}, {"Centroid3D", "Colour", false}, {"Edge3D", "Colour", false},
    {"Greyscale3D", "Colour", false}, {"MaskSquare", "Mask", false}, {"MaskSquare", "MaskSelection", false},
    {"Greyscale2D", "Greyscale2D", false}, {"Greyscale2D", "Greyscale2DSelection", false},
    {"Frame", "UniformColour", false}, {"WandWave2D", "WandWave2D", false}, {"FullScreen", "Distort", false},
    {"FullScreen", "Copy", false}, {"FloorGrid", "FloorGrid", false}, {"FloorGrid", "FloorGridComputed", false},
    {"FloorGrid", "UniformColour", false}, {"ForcePlate", "ForcePlate", true}, {"ForcePlate", "SimpleLighting", true},
    {"Simple3D", "UniformColour", false}, {"Target", "Colour", true}, {"Segment", "Segment", true},
    {"Simple3DModelColour", "SimpleLighting", true}, {"NonUniformSphere", "Covariance", false},
    {"MissingMarker", "MissingMarker", false}, {"Stick", "Colour", true}, {"Sphere", "SimpleLighting", true},
    {"Point3D", "Colour", false}, {"FBXSkin", "FBXMaterial", true}, {"FBXSkin", "XRay", false},
    {"Placed", "SimpleLighting", false}, {"Placed", "Segment", false}, {"Placed", "Covariance", false},
    {"Placed", "MissingMarker", false}, {"Placed", "Colour", false},
    // Kept for other scenes: each with a partner that it suits.
    {"Billboard", "ActiveLabelHalo", false}, {"CameraRay", "ClipFloor", false},
    {"FBXColoredMesh", "CameraCoverageFurstum", false}, {"ColoredLine", "StippledLine", false},
    {"GreyscaleMaximised", "Greyscale2D", false}, {"Locator", "Colour", false}, {"MarkerTrailPoints", "Colour", false},
    {"SphereShadow", "Colour", false}, {"StickShadow", "Colour", false}, {"Simple3DModel", "UniformColour", false},
    {"Simple3DUniformColour", "Colour", false}, {"Simple3DVertexColour", "Colour", false},
    {"SimpleColour", "Colour", false}};

void Write(const QString& i_rPath, const char* i_pText)
{
	QFile file(i_rPath);
	ASSERT_TRUE(file.open(QIODevice::WriteOnly));
	file.write(i_pText);
}

/// A folder of shaders of the test's own.
struct VFolder
{
	VFolder()
	{
		EXPECT_TRUE(m_Folder.isValid());
		QDir(m_Folder.path()).mkdir("VertexShaders");
		QDir(m_Folder.path()).mkdir("FragmentShaders");
	}

	QString Path(const char* i_pName) const { return m_Folder.filePath(i_pName); }

	VShaderLibrary::VSettings Settings() const { return {true, {m_Folder.path().toStdString()}, {}}; }

	QTemporaryDir m_Folder;
};

class ShaderLibrary : public GraphicsTest::InBothDialects
{
};
INSTANTIATE_IN_BOTH_DIALECTS(ShaderLibrary);

} // namespace

TEST_P(ShaderLibrary, LinksEveryPairOfTheCatalogue)
{
	VLog log;
	VShaderLibrary library;
	library.InitialiseGL();
	EXPECT_EQ(log.m_Messages, std::vector<std::string>());
	std::vector<std::string> vertices{}, fragments{"Selection"};
	for (const VPair& rPair : c_Catalogue)
	{
		SCOPED_TRACE(std::string(rPair.m_pVertex) + ", " + rPair.m_pFragment);
		const VSelectableProgram program = VSelectableProgram::Make(library, rPair.m_pVertex, rPair.m_pFragment);
		ASSERT_TRUE(program.Get(false));
		EXPECT_FALSE(program.Get(false)->IsEmpty());
		if (rPair.m_bSelectable)
		{
			EXPECT_FALSE(program.Get(true)->IsEmpty());
			EXPECT_NE(program.Get(true)->GetUniformLocation("u_SelectionId"), -1);
		}
		vertices.emplace_back(rPair.m_pVertex);
		fragments.emplace_back(rPair.m_pFragment);
	}
	EXPECT_EQ(log.m_Messages, std::vector<std::string>());

	// No shader is left out of the catalogue.
	for (auto* pNames : {&vertices, &fragments})
	{
		std::sort(pNames->begin(), pNames->end());
		pNames->erase(std::unique(pNames->begin(), pNames->end()), pNames->end());
	}
	EXPECT_EQ(library.GetVertexShaderNames(), vertices);
	EXPECT_EQ(library.GetFragmentShaderNames(), fragments);
}

TEST_P(ShaderLibrary, NoUniformIsInBothShadersOfAPair)
{
	// Their precisions differ in OpenGL ES, which some drivers refuse to link.
	const auto uniforms = [&](EShaderType i_Type, const char* i_pName)
	{
		const VShader shader(
		    i_Type, std::string(i_Type == EShaderVertex ? ":/Vertex" : ":/Fragment") + "Shaders/" + i_pName + ".glsl");
		const std::string text = shader.Get()->sourceCode().toStdString();
		EXPECT_EQ(text.find(GetParam() == EDialect::ES2 ? "#version 100\n" : "#version 120\n"), 0u) << text;
		const std::regex declaration("\\nuniform \\w+ (\\w+)");
		std::set<std::string> names;
		for (std::sregex_iterator i(text.begin(), text.end(), declaration), end; i != end; ++i)
			names.insert((*i)[1]);
		return names;
	};
	VShaderLibrary library;
	library.InitialiseGL();
	EXPECT_EQ(uniforms(EShaderVertex, "Sphere").size(), 3u);
	for (const VPair& rPair : c_Catalogue)
	{
		const std::set<std::string> fragment = uniforms(EShaderFragment, rPair.m_pFragment);
		for (const std::string& rName : uniforms(EShaderVertex, rPair.m_pVertex))
			EXPECT_FALSE(fragment.contains(rName)) << rPair.m_pVertex << ", " << rPair.m_pFragment << ": " << rName;
	}
}

TEST_P(ShaderLibrary, ProgramsHaveTheUniformsThatTheirUsersSet)
{
	struct VRow
	{
		const char* m_pVertex;
		const char* m_pFragment;
		std::vector<const char*> m_Uniforms;
	};
	const VRow rows[] = {{"Target", "Colour", {"u_TargetPosAndSize", "u_ModelColour"}},
	    {"NonUniformSphere", "Covariance", {"u_ModelTransform", "u_ModelColour"}},
	    {"Simple3DModelColour", "SimpleLighting", {"u_ModelTransform", "u_ModelColour"}},
	    {"Simple3DModelColour", "Colour", {"u_ModelTransform", "u_ModelColour"}},
	    {"Segment", "Segment", {"u_ModelTransform", "u_SegmentColour"}},
	    {"Sphere", "SimpleLighting", {"u_ReconPosAndSize", "u_ModelColour"}},
	    {"MissingMarker", "MissingMarker", {"u_ReconPosAndSize", "u_ModelColour"}},
	    {"Simple3DModelWireframe", "Colour", {"u_ModelTransform"}},
	    {"Simple3DModelWireframe", "UniformColour", {"u_ModelTransform", "u_colour"}},
	    {"Stick", "Colour", {"u_ModelTransform", "u_StickColourA", "u_StickColourB"}},
	    {"FloorGrid", "FloorGrid", {"u_Extents", "u_GridSpacings", "t_Texture"}},
	    {"FloorGrid", "FloorGridComputed",
	        {"u_Extents", "u_GridSpacings", "u_LineWidth", "u_TilesAcross", "u_TilesUp", "u_InverseDepths"}},
	    {"FloorGrid", "UniformColour", {"u_Extents", "u_colour"}},
	    {"Simple", "Outlines", {"t_Selection", "u_PrimaryColour", "u_PreSelectColour"}},
	    {"Simple", "AntiAlias", {"t_Buffer"}}, {"Simple3DPointSize", "UniformColour", {"u_PointSize", "u_colour"}},
	    {"General2D", "UniformColour", {"u_Rotation", "u_RotationCentre", "u_colour"}},
	    {"ForcePlate", "ForcePlate", {"u_Force", "u_CentreOfPressure"}},
	    {"FBXSkin", "FBXMaterial",
	        {"u_BoneTransforms", "u_DiffuseColour", "t_DiffuseTexture", "u_DiffuseTextureEnabled", "u_HighlightMissing",
	            "u_SpecularColour", "u_EmissiveColour", "u_Shininess", "u_UserColourA", "u_UserColourB", "u_Alpha"}},
	    {"FBXSkin", "XRay",
	        {"u_BoneTransforms", "u_DiffuseColour", "t_DiffuseTexture", "u_DiffuseTextureEnabled",
	            "u_HighlightMissing"}},
	    {"FBXSkin", "Selection", {"u_BoneTransforms", "u_SelectionId"}},
	    {"FBXMesh", "FBXMaterial",
	        {"u_ModelTransform", "u_DiffuseColour", "t_DiffuseTexture", "u_DiffuseTextureEnabled", "u_SpecularColour",
	            "u_EmissiveColour", "u_Shininess", "u_Alpha"}}};
	VShaderLibrary library;
	library.InitialiseGL();
	for (const VRow& rRow : rows)
	{
		const auto pProgram = library.GetProgram(rRow.m_pVertex, rRow.m_pFragment);
		ASSERT_TRUE(pProgram);
		for (const char* pName : rRow.m_Uniforms)
			EXPECT_NE(pProgram->GetUniformLocation(pName), -1)
			    << rRow.m_pVertex << ", " << rRow.m_pFragment << ": " << pName;
	}
}

TEST_P(ShaderLibrary, UnknownNamesGiveNothingAndStoreNothing)
{
	VShaderLibrary library;
	library.InitialiseGL();
	EXPECT_FALSE(library.GetProgram("Sphere", "NoSuchShader"));
	EXPECT_FALSE(library.GetProgram("NoSuchShader", "Colour"));
	EXPECT_EQ(library.GetProgramCount(), 0u);
	EXPECT_EQ(library.GetProgram("Sphere", "Colour"), library.GetProgram("Sphere", "Colour"));
	EXPECT_EQ(library.GetProgramCount(), 1u);
	VRenderContext context;
	context.Initialise();
	EXPECT_FALSE(context.UseProgram(nullptr));
}

TEST_P(ShaderLibrary, AFailedLinkIsKeptAndDrawsNothing)
{
	VFolder folder;
	Write(folder.Path("VertexShaders/Bare.glsl"), "void main() { gl_Position = vec4(0.0); }\n");
	VLog log;
	VShaderLibrary library(folder.Settings());
	library.InitialiseGL();
	// The fragment shader reads what this vertex shader does not write.
	const auto pProgram = library.GetProgram("Bare", "SimpleLighting");
	ASSERT_TRUE(pProgram);
	EXPECT_TRUE(pProgram->IsEmpty());
	EXPECT_EQ(pProgram->AttributeLocation(EAttributePosition), -1);
	EXPECT_EQ(library.GetProgram("Bare", "SimpleLighting"), pProgram);
	EXPECT_EQ(log.m_Messages.size(), 1u);
	VRenderContext context;
	context.Initialise();
	EXPECT_FALSE(context.UseProgram(pProgram));
}

TEST_P(ShaderLibrary, TellsWhereAFileIsWrong)
{
	VFolder folder;
	Write(folder.Path("FragmentShaders/Wrong.glsl"), "void main()\n{\n	gl_FragColor = nonsense;\n}\n");
	Write(folder.Path("FragmentShaders/Note.txt"), "not a shader");
	VLog log;
	VShaderLibrary library(folder.Settings());
	library.InitialiseGL();
	ASSERT_EQ(log.m_Messages.size(), 1u);
	const std::string start =
	    "Shader Failed To Compile<" + folder.Path("FragmentShaders/Wrong.glsl").toStdString() + "> Log=<";
	EXPECT_EQ(log.m_Messages[0].substr(0, start.size()), start);
	// The third line of the file, whatever stands before it.
	EXPECT_NE(log.m_Messages[0].find("0:3("), std::string::npos) << log.m_Messages[0];
	EXPECT_EQ(log.m_Messages[0].find("1:"), std::string::npos);
	const std::vector<std::string> names = library.GetFragmentShaderNames();
	EXPECT_EQ(std::count(names.begin(), names.end(), "Note"), 0);
	// A shader that is empty makes an empty program, without a second message.
	EXPECT_TRUE(library.GetProgram("Sphere", "Wrong")->IsEmpty());
	EXPECT_EQ(log.m_Messages.size(), 1u);
}

TEST_P(ShaderLibrary, FilesOfADeveloperComeFirstAndAreReloadedInPlace)
{
	VFolder folder;
	const QString path = folder.Path("FragmentShaders/UniformColour.glsl");
	Write(path, "uniform vec4 u_Mine;\nvoid main() { gl_FragColor = u_Mine; }\n");
	VShaderLibrary library(folder.Settings());
	library.InitialiseGL();
	const auto pProgram = library.GetProgram("Simple", "UniformColour");
	VUniform mine("u_Mine"), other("u_Other");
	EXPECT_NE(mine.LocationIn(*pProgram), -1);
	EXPECT_EQ(other.LocationIn(*pProgram), -1);

	Write(path, "uniform vec4 u_Other;\nvoid main() { gl_FragColor = u_Other; }\n");
	library.Reload();
	EXPECT_EQ(library.GetProgram("Simple", "UniformColour"), pProgram);
	EXPECT_EQ(mine.LocationIn(*pProgram), -1);
	EXPECT_NE(other.LocationIn(*pProgram), -1);

	VLog log;
	Write(path, "void main() { gl_FragColor = vec4(Mine()); }\n");
	library.Reload();
	EXPECT_TRUE(pProgram->IsEmpty());
	QDir(folder.Path("")).mkdir("Shared");
	Write(folder.Path("Shared/Fragment.glsl"), "float Mine()\n{\n	return 1.0;\n}\n");
	library.Reload();
	EXPECT_FALSE(pProgram->IsEmpty()) << "what is shared is the developer's too";
	Write(folder.Path("Shared/Fragment.glsl"), "float Mine()\n{\n	return wrong;\n}\n");
	library.Reload();
	ASSERT_EQ(log.m_Messages.size(), 2u);
	EXPECT_NE(log.m_Messages[1].find("1:3("), std::string::npos) << "and told as another file: " << log.m_Messages[1];

	QFile::remove(path);
	library.Reload();
	EXPECT_TRUE(pProgram->IsEmpty());
	EXPECT_EQ(log.m_Messages.back(), "Failed to open " + path.toStdString());
}

TEST_P(ShaderLibrary, IsMadeAgainInAContextThatSharesNothing)
{
	VShaderLibrary library;
	library.InitialiseGL();
	const auto pProgram = library.GetProgram("Sphere", "SimpleLighting");
	const std::uint64_t link = pProgram->LinkNumber();
	{
		GraphicsTest::VOffscreenContext sharing(GetParam(), &m_Context.Context());
		library.InitialiseGL();
		EXPECT_EQ(pProgram->LinkNumber(), link);
	}
	{
		GraphicsTest::VOffscreenContext other(GetParam());
		library.InitialiseGL();
		EXPECT_NE(pProgram->LinkNumber(), link);
		EXPECT_FALSE(pProgram->IsEmpty());
		VRenderContext context;
		context.Initialise();
		EXPECT_TRUE(context.UseProgram(pProgram));
		EXPECT_EQ(other.GL().glGetError(), static_cast<GLenum>(GL_NO_ERROR));
	}
	m_Context.MakeCurrent();
}

TEST_P(ShaderLibrary, HeaderNamesTheLanguage)
{
	VShader shader(EShaderFragment, ":/FragmentShaders/Colour.glsl");
	ASSERT_FALSE(shader.IsEmpty());
	const bool bES = GetParam() == EDialect::ES2;
	const std::string source = shader.Get()->sourceCode().toStdString();
	EXPECT_EQ(VShader::Header(bES, "shared\n"),
	    std::string(bES ? "#version 100\n" : "#version 120\n") + "#ifdef GL_ES\nprecision mediump float;\n#endif\n"
	        + (bES ? "#line 1 1\nshared\n#line 1 0\n" : "#line 0 1\nshared\n#line 0 0\n"));
	EXPECT_NE(source.find(bES ? "#version 100" : "#version 120"), std::string::npos);
}

TEST(ShaderLibraryWithoutOpenGL, CanBeMade)
{
	VShaderLibrary library;
	EXPECT_EQ(library.GetVertexShaderNames(), std::vector<std::string>());
	EXPECT_FALSE(library.GetProgram("Sphere", "SimpleLighting"));
	EXPECT_NE(library.GetResourceRoot(), "");
}
