#include "DrawingFixture.h"

#include "CoreGraphics/ShapeBatch.h"

#include <QImage>

using namespace CoreGraphics;

namespace
{

struct VPlacedModel
{
	const VShape* m_pShape;
	QMatrix4x4 m_Matrix;
	QVector4D m_Colour;
};

class ShapeBatches : public GraphicsTest::VDrawingTest
{
protected:
	ShapeBatches() : VDrawingTest(QSize(64, 64)) {}

	void Begin(const char* i_pVertex)
	{
		VRenderState state;
		state.m_Cull = ECullBack;
		state.m_bDepthTest = true;
		m_Render.ClearBuffers(true, true);
		ASSERT_TRUE(m_Render.UseProgram(m_Library.GetProgram(i_pVertex, "SimpleLighting")));
		m_Render.ApplyState(state);
	}

	/// One by one, by the shader that places a model.
	QImage Alone(const std::vector<VPlacedModel>& i_rModels)
	{
		Begin("Simple3DModelColour");
		VUniform model("u_ModelTransform"), colour("u_ModelColour");
		for (const VPlacedModel& rModel : i_rModels)
		{
			VShape& rShape = const_cast<VShape&>(*rModel.m_pShape);
			m_Render.SetUniform(model, rModel.m_Matrix);
			m_Render.SetUniform(colour, rModel.m_Colour);
			m_Render.BindVertices(rShape.m_Vertices);
			m_Render.DrawElements(GL_TRIANGLES, rShape.m_Indices);
		}
		return m_pTarget->toImage();
	}

	QImage Together(VShapeBatch& io_rBatch, const std::vector<VPlacedModel>& i_rModels)
	{
		Begin("Placed");
		io_rBatch.Clear();
		for (const VPlacedModel& rModel : i_rModels)
			io_rBatch.Add(*rModel.m_pShape, rModel.m_Matrix, ColourBytes(rModel.m_Colour));
		io_rBatch.Draw(m_Render, GL_TRIANGLES);
		return m_pTarget->toImage();
	}
};
INSTANTIATE_IN_BOTH_DIALECTS(ShapeBatches);

} // namespace

TEST_P(ShapeBatches, AreDrawnAsTheirShapesAlone)
{
	const VShape box = MakeBox(false), cone = MakeCone(16, true), fine = MakeCylinder(10000, true);
	const auto place = [](float i_X, float i_Y, const QVector3D& i_rScale)
	{
		QMatrix4x4 matrix;
		matrix.translate(i_X, i_Y);
		matrix.rotate(40.0f, 3.0f, 2.0f, 1.0f);
		matrix.scale(i_rScale);
		return matrix;
	};
	const VPlacedModel red{&box, place(-0.5f, 0.5f, {0.5f, 0.2f, 0.4f}), {1, 0, 0, 1}};
	const VPlacedModel green{&cone, place(0.4f, 0.4f, {0.3f, 0.2f, 0.6f}), {0, 1, 0, 1}};
	const VPlacedModel moved{&cone, place(0.4f, -0.4f, {0.3f, 0.2f, 0.6f}), {0, 1, 0, 1}};
	const VPlacedModel blue{&fine, place(-0.4f, -0.4f, {0.3f, 0.3f, 0.2f}), {0, 0, 1, 1}};
	const struct
	{
		const char* m_pName;
		std::vector<VPlacedModel> m_Models;
	} c_Frames[] = {{"none", {}}, {"two", {red, green}}, {"as before", {red, green}}, {"the last moved", {red, moved}},
	    {"another first", {blue, red, moved}}, {"fewer", {blue}},
	    {"more vertices than short indices tell apart", {blue, blue, green, red}},
	    {"more at the end", {blue, blue, red, moved}}, {"none again", {}}, {"as at first", {red, green}}};
	VShapeBatch batch;
	for (const auto& rFrame : c_Frames)
		EXPECT_EQ(Together(batch, rFrame.m_Models), Alone(rFrame.m_Models)) << rFrame.m_pName;
}

TEST_P(ShapeBatches, AreSentAgainToAnotherContext)
{
	const VShape box = MakeBox(false);
	const VPlacedModel model{&box, {}, {1, 1, 1, 1}};
	VShapeBatch batch;
	const QImage before = Together(batch, {model});
	EXPECT_EQ(before, Alone({model}));
	{
		const GraphicsTest::VOffscreenContext other(GetParam());
		ASSERT_NO_FATAL_FAILURE(SetUp());
		EXPECT_EQ(Together(batch, {model}), before);
		m_pTarget.reset();
	}
	m_Context.MakeCurrent();
}
