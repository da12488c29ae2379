#include "PicturesFixture.h"

#include "Flow2Graphics/FlowRenderForcePlates.h"
#include "Flow2Graphics/FlowRenderGeometry.h"
#include "Flow2Graphics/FlowRenderReconstructionVolume.h"
#include "Flow2Graphics/FlowRenderReconstructions.h"
#include "Flow2Graphics/RenderSubjectDynamics.h"
#include "Flow2Graphics/RenderSubjectMarkers.h"
#include "Flow2TypesUtils/ParameterSet.h"
#include "InMemoryHost/Flow.h"
#include "OrlexGraphics/frame/RenderOutlines.h"
#include "OrlexGraphics/manipulator/RenderManipulator.h"
#include "OrlexGraphics/manipulator/RenderVolumeManipulator.h"
#include "OrlexGraphics/stage/RenderAxis.h"
#include "OrlexGraphics/stage/RenderCameras.h"
#include "OrlexGraphics/stage/RenderFloorGrid.h"
#include "OrlexGraphics/stage/RenderReconstructionVolume.h"
#include "TestSubject.h"

namespace
{

using namespace Flow2Graphics;
using TestSubject::MakeFrame;

/// What stands on a stage without subjects.
class StagePictures : public VPicturesTest
{
protected:
	void SetUp() override
	{
		VPicturesTest::SetUp();
		Options().m_bFloorGrid = Options().m_bGlobalAxis = true;
	}

	template <typename T>
	void Show(const char* i_pFlowType, const T& i_rValue)
	{
		const NVX::CountedPointer<TesselPluginInterface::IFlowItem> pItem(new InMemoryHost::VFlowItem<T>(i_pFlowType));
		TesselPluginInterface::SetItemValue(pItem, std::make_shared<const T>(i_rValue));
		m_Items.push_back(pItem);
		m_pScene->SetFrame(MakeFrame(m_Items));
	}

	std::vector<NVX::CountedPointer<TesselPluginInterface::IFlowItem>> m_Items;
};

// Those of subjects are drawn in both dialects.
INSTANTIATE_TEST_SUITE_P(
    Dialects, StagePictures, testing::Values(GraphicsTest::EDialect::Desktop), GraphicsTest::DialectName);

template <typename T>
bool Is(const OrlexGraphics::IRenderType& i_rType)
{
	return dynamic_cast<const T*>(&i_rType) != nullptr;
}

const VView c_Above{{0, 0, 0}, 7000.0f, -65.0f, 30.0f};
const VView c_Below{{0, 0, 0}, 7000.0f, -115.0f, 30.0f};

} // namespace

TEST_P(StagePictures, OfTheFloor)
{
	const struct
	{
		const char* m_pName;
		bool m_bYUp;
		bool m_bTranslucent;
		VView m_View;
	} c_Rows[] = {
	    {"floor-above", false, true, c_Above},
	    {"floor-below", false, true, c_Below},
	    {"floor-above-y-up", true, true, c_Above},
	    {"floor-below-y-up", true, true, c_Below},
	    {"floor-above-opaque", false, false, c_Above},
	    {"floor-below-opaque", false, false, c_Below},
	    {"floor-front", false, true, {.m_Type = CoreGraphics::ECameraFront}},
	    {"floor-back", false, true, {.m_Type = CoreGraphics::ECameraBack}},
	    {"floor-left", false, true, {.m_Type = CoreGraphics::ECameraLeft}},
	    {"floor-right", false, true, {.m_Type = CoreGraphics::ECameraRight}},
	    {"floor-top", false, true, {.m_Type = CoreGraphics::ECameraTop}},
	    {"floor-bottom", false, true, {.m_Type = CoreGraphics::ECameraBottom}},
	    {"floor-top-y-up", true, true, {.m_Type = CoreGraphics::ECameraTop}},
	};
	for (const auto& rRow : c_Rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		m_pScene->SetYUp(rRow.m_bYUp);
		Options().m_bFloorGridIsTranslucent = rRow.m_bTranslucent;
		Options().m_FloorGridSize = rRow.m_View.m_Type == CoreGraphics::ECameraPerspective ? 6.0f : 2.0f;
		Compare(Draw(rRow.m_View), rRow.m_pName);
	}
}

TEST_P(StagePictures, HaveTheUpAxisOfTheLastFrameThatHasOne)
{
	using Flow2TypesUtils::FlowUpAxisItem;
	const struct
	{
		std::optional<std::uint32_t> m_Axis;
		bool m_bYUp;
	} c_Rows[] = {{{}, false}, {1, true}, {{}, true}, {2, false}, {1, true}, {0, false}};
	for (const auto& rRow : c_Rows)
	{
		m_Items.clear();
		if (rRow.m_Axis)
			Show(FlowUpAxisItem::c_pName, FlowUpAxisItem{*rRow.m_Axis});
		else
			m_pScene->SetFrame(MakeFrame({}));
		Draw(c_Above);
		EXPECT_EQ(m_pScene->FrameYUp(), rRow.m_bYUp) << &rRow - c_Rows;
	}
}

TEST_P(StagePictures, OfVolumes)
{
	auto pSet = std::make_shared<Flow2Utils::VParameterSet>();
	const std::pair<const char*, float> c_Limits[] = {{"MinReconX", -2000.0f}, {"MinReconY", -2000.0f},
	    {"MinReconZ", 0.0f}, {"MaxReconX", 2000.0f}, {"MaxReconY", 2000.0f}, {"MaxReconZ", 2500.0f},
	    {"MinHotspotX", -800.0f}, {"MinHotspotY", -1000.0f}, {"MinHotspotZ", 0.0f}, {"MaxHotspotX", 800.0f},
	    {"MaxHotspotY", 1000.0f}, {"MaxHotspotZ", 1800.0f}};
	for (const auto& [pName, value] : c_Limits)
	{
		auto pParameter = std::make_unique<Flow2Utils::VParameterTyped<float>>(pName);
		pParameter->Set(value);
		pSet->Add(std::move(pParameter));
	}
	using Flow2TypesUtils::FlowParametersItem;
	Show(FlowParametersItem::c_pName, FlowParametersItem{pSet, VFlowRenderReconstructionVolume::c_pGroup, {}});
	const VView view{{0, 0, 1000}, 8500.0f, -70.0f, 30.0f};
	Compare(Draw(view), "volumes");
	ExpectThatAFrameIsAWalk();
	m_pSelection->PreSelection().Replace(
	    {m_pScene->RenderHotspotVolumeManipulator()->HandleItem({OrlexGraphics::EVolumeFace, 5})});
	m_pScene->SetYUp(true);
	Compare(Draw({{0, 1000, 0}, 8500.0f, -70.0f, 30.0f}), "volumes-y-up-hover");
	m_pScene->SetYUp(false);
	Options().m_bManipulator = false;
	Compare(Draw(view), "reconstruction-volume");
	Options().m_bReconstructionVolume = Options().m_bFloorGrid = Options().m_bGlobalAxis = false;
	const QImage nothing = Draw(view);
	EXPECT_EQ(nothing.pixel(160, 120), 0xff202020u);
}

TEST_P(StagePictures, OfPlatesPointsAndGeometry)
{
	OrlexGraphics::VForcePlate left, right;
	left.m_Transform.translate(-250, 0, 0);
	right.m_Transform.translate(250, 0, 0);
	right.m_Force = QVector3D(50, 20, 700);
	right.m_CentreOfPressure = QVector3D(40, -80, 0);
	Show("FlowDeviceSamples", VFlowRenderForcePlates::VValue{left, right});
	Show("FlowReconstructionSet",
	    VFlowRenderReconstructions::VValue{{-300, 0, 600}, {-100, 100, 900}, {-400, 50, 1100}});
	VGeometry geometry;
	geometry.m_Lines.push_back({{{-600, 600, 0}, {600, 600, 1000}}, {0.2f, 0.8f, 1.0f, 1.0f}});
	geometry.m_Points.push_back({{{-600, 600, 0}, {600, 600, 1000}}, {1.0f, 0.8f, 0.2f, 1.0f}, 7.0f});
	geometry.m_Lines2D.push_back({{{-0.2f, 0.0f}, {0.2f, 0.0f}}, {0.4f, 1.0f, 0.4f, 1.0f}, 0.785398f, {}});
	Show(VGeometry::c_pName, geometry);
	Options().m_ReconstructionScale = 6.0f;
	Compare(Draw({{0, 0, 450}, 2200.0f, -70.0f, 30.0f}), "plates-points-geometry");
	ExpectThatAFrameIsAWalk();
}

TEST_P(StagePictures, OfTextWhereItStands)
{
	VGeometry geometry;
	geometry.m_Texts = {{QStringLiteral("HHHH"), QVector3D(0, 0, 0), {1, 0, 0, 1}, false},
	    {QStringLiteral("HHHH"), QVector3D(-0.9f, 0.8f, 0), {0, 1, 0, 1}, true}};
	Show(VGeometry::c_pName, geometry);
	Options().m_bFloorGrid = Options().m_bGlobalAxis = false;
	Draw({{0, 0, 0}, 2000.0f, -70.0f, 30.0f});
	m_pTarget->bind();
	m_Renderer.Paint();
	const QImage image = m_pTarget->toImage();
	const auto extent = [&](int (*i_pChannel)(QRgb))
	{
		QRect bounds;
		for (int y = 0; y < image.height(); ++y)
			for (int x = 0; x < image.width(); ++x)
				if (i_pChannel(image.pixel(x, y)) > 0x80)
					bounds |= QRect(x, y, 1, 1);
		return bounds;
	};
	// From the point to the right, above it.
	EXPECT_NEAR(extent(qRed).left(), 160, 3);
	EXPECT_NEAR(extent(qRed).bottom(), 119, 2);
	EXPECT_NEAR(extent(qGreen).left(), 16, 3);
	EXPECT_NEAR(extent(qGreen).bottom(), 23, 2);
	EXPECT_GT(extent(qGreen).width(), 15);
}

TEST_P(StagePictures, AreDrawnInTheirOrder)
{
	using namespace OrlexGraphics;
	bool (*const c_Order[])(const IRenderType&) = {Is<VRenderFloorGrid>, Is<VRenderForcePlates>,
	    Is<VRenderReconstructions>, Is<VRenderSubjectMarkers>, Is<VRenderSubjectMarkers>, Is<VRenderSubjectDynamics>,
	    Is<VRenderCameras>, Is<VFlowRenderGeometry>, Is<VRenderManipulator>, Is<VRenderVolumeManipulator>,
	    Is<VRenderVolumeManipulator>, Is<VRenderReconstructionVolume>, Is<VRenderAxis>};
	auto next = m_pScene->RenderList().begin();
	for (const auto& pIs : c_Order)
	{
		next = std::find_if(next, m_pScene->RenderList().end(),
		    [&](const std::shared_ptr<IRenderType>& i_rpType) { return pIs(*i_rpType); });
		ASSERT_NE(next, m_pScene->RenderList().end()) << &pIs - c_Order;
		++next;
	}
	EXPECT_EQ(next, m_pScene->RenderList().end()) << "the axes are last";
	EXPECT_EQ(m_pScene->PostList().size(), 1u);
	EXPECT_TRUE(Is<VRenderOutlines>(*m_pScene->PostList().front()));

	struct VRow
	{
		const char* m_pName;
		std::shared_ptr<IManipulator> m_pManipulator;
		QVector3D m_Colour;
		VVolume m_Volume;
	};
	const VRow rows[] = {{"ReconstructionVolume", m_pScene->ReconstructionVolumeManipulator(), {0.7f, 0.7f, 0.7f},
	                         {{-10000, -10000, -100}, {10000, 10000, 3000}}},
	    {"HotspotVolume", m_pScene->HotspotVolumeManipulator(), {1.0f, 0.2f, 0.2f},
	        {{-5000, -5000, -100}, {5000, 5000, 3000}}}};
	for (const VRow& rRow : rows)
	{
		const auto* const pVolume = dynamic_cast<const VRenderVolumeManipulator*>(rRow.m_pManipulator.get());
		ASSERT_TRUE(pVolume);
		EXPECT_EQ(pVolume->Name(), rRow.m_pName);
		EXPECT_EQ(pVolume->Colour(), rRow.m_Colour);
		EXPECT_EQ(pVolume->Volume(), rRow.m_Volume);
		EXPECT_FALSE(pVolume->IsVisible());
	}
	// A second view of the scene, and nothing twice.
	const std::size_t count = m_pScene->RenderList().size();
	m_pScene->InitialiseGL();
	EXPECT_EQ(m_pScene->RenderList().size(), count);
}
