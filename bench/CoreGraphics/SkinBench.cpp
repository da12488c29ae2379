#include "../../tests/Matrices.h"
#include "../Ratios.h"

#include "CoreGraphics/QtForm.h"
#include "CoreGraphics/RenderContext.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "CoreGraphics/Skin.h"
#include "CoreGraphics/SkinInstance.h"

#include <QGuiApplication>
#include <QOffscreenSurface>
#include <QOpenGLContext>
#include <QOpenGLFramebufferObject>

#include <cstdio>

// What a skin of 20,000 vertices costs each time that its subject moves, beside the products of matrices that this
// takes: one for each bone. The argument is the number of bones. Needs a display.

namespace
{

constexpr std::size_t c_Vertices = 20000;

struct VBench
{
	explicit VBench(std::size_t i_Bones)
	{
		auto pSkeleton = std::make_shared<FBXIO::VSkinSkeleton>(i_Bones);
		FBXIO::VSkin data;
		std::vector<std::string> names;
		for (std::size_t i = 0; i < i_Bones; ++i)
		{
			FBXIO::VSkinBone& rBone = (*pSkeleton)[i];
			rBone.m_Name = "bone" + std::to_string(i);
			rBone.m_ParentIndex = static_cast<std::int64_t>(i) - 1;
			Move(rBone.m_Local, 10, 20, 30);
			Turn(rBone.m_InverseBind, static_cast<float>(i), 1, 2, 3);
			Move(rBone.m_InverseBind, -10, -20, -30);
			m_Poses.emplace_back().rotate(static_cast<float>(3 * i), 3, 2, 1);
			m_Poses.back().translate(10, 20, 30);
			m_Binds.push_back(CoreGraphics::ToQt(rBone.m_InverseBind));
			names.push_back(rBone.m_Name);
		}
		data.m_pSkeleton = std::move(pSkeleton);
		FBXIO::VSkinMesh& rMesh = data.m_Meshes.emplace_back();
		rMesh.m_Vertices.resize(c_Vertices);
		for (std::size_t i = 0; i < c_Vertices; ++i)
		{
			rMesh.m_Vertices[i].m_BoneIndices[0] = static_cast<std::uint8_t>(i % i_Bones);
			rMesh.m_Vertices[i].m_BoneWeights[0] = 255;
		}
		m_Instance.Bind(std::make_shared<CoreGraphics::VSkin>(data, "bench"), names, std::vector<QVector3D>(i_Bones));
		m_Library.InitialiseGL();
		m_Context.Initialise();
		m_Context.ResetState();
		m_Context.BindFramebuffer(&m_Target);
		m_Context.UseProgram(m_Library.GetProgram("FBXSkin", "FBXMaterial"));
	}

	CoreGraphics::VShaderLibrary m_Library;
	CoreGraphics::VRenderContext m_Context;
	QOpenGLFramebufferObject m_Target{64, 64};
	CoreGraphics::VSkinInstance m_Instance;
	std::vector<QMatrix4x4> m_Poses;
	std::vector<QMatrix4x4> m_Binds;
};

void MatrixProducts(benchmark::State& io_rState)
{
	const VBench bench(static_cast<std::size_t>(io_rState.range(0)));
	std::vector<QMatrix4x4> products(bench.m_Poses.size());
	for (auto _ : io_rState)
	{
		for (std::size_t i = 0; i < products.size(); ++i)
			products[i] = bench.m_Poses[i] * bench.m_Binds[i];
		benchmark::DoNotOptimize(products.data());
		benchmark::ClobberMemory();
	}
}
BENCHMARK(MatrixProducts)->Arg(60)->Arg(250);

void PoseAndUpload(benchmark::State& io_rState)
{
	VBench bench(static_cast<std::size_t>(io_rState.range(0)));
	CoreGraphics::VUniform bones("u_BoneTransforms");
	for (auto _ : io_rState)
	{
		for (std::size_t i = 0; i < bench.m_Poses.size(); ++i)
			bench.m_Instance.SetHealth(i, 1.0f);
		bench.m_Instance.UpdatePose(bench.m_Poses);
		const auto matrices = bench.m_Instance.BoneMatrices();
		bench.m_Context.SetUniform(bones, matrices.front().data(), matrices.size());
	}
}
BENCHMARK(PoseAndUpload)->Arg(60)->Arg(250);

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	const QGuiApplication application(i_Count, i_ppArguments);
	QOffscreenSurface surface;
	surface.create();
	QOpenGLContext context;
	if (!context.create() || !context.makeCurrent(&surface))
	{
		std::puts("No OpenGL here, nothing is measured.");
		return 0;
	}
	return Ratios::Main(i_Count, i_ppArguments, {{"PoseAndUpload", "MatrixProducts", 2.0}});
}
