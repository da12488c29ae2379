#include "TakeIO/FbxLayers.h"

#include "DebugServices/GlobalLog.h"
#include "fbxsdk/document/Properties.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace
{

using namespace FbxFormat;
using namespace TakeIO;
using Rotation::VMatrix3;
using Rotation::VVector3;

/// As the format counts them; 0 adds.
enum EBlendMode : std::int64_t
{
	EOverride = 1,
	EOverridePassthrough = 2
};

struct VListedLayer : VFbxLayer
{
	bool m_bMute = false;
	bool m_bSolo = false;
};

void ReadProperties(const VDocument& i_rDocument, VElementIndex i_Element, VListedLayer& io_rLayer)
{
	VisitProperties(i_rDocument.Tree(), i_Element,
	    [&](std::string_view i_Name, VValueCursor& io_rCursor)
	    {
		    if (i_Name == "Weight")
		    {
			    const double weight = io_rCursor.Next().AsReal(100.0) / 100.0;
			    io_rLayer.m_Weight = std::isfinite(weight) ? std::clamp(weight, 0.0, 1.0) : 1.0;
		    }
		    else if (i_Name == "Mute")
			    io_rLayer.m_bMute = io_rCursor.Next().AsInteger(0) != 0;
		    else if (i_Name == "Solo")
			    io_rLayer.m_bSolo = io_rCursor.Next().AsInteger(0) != 0;
		    else if (i_Name == "BlendMode")
		    {
			    const std::int64_t mode = io_rCursor.Next().AsInteger(0);
			    io_rLayer.m_bPassesThrough = mode == EOverridePassthrough;
			    io_rLayer.m_bOverrides = mode == EOverride || io_rLayer.m_bPassesThrough;
		    }
		    else if (i_Name == "RotationAccumulationMode")
			    io_rLayer.m_bByChannel = io_rCursor.Next().AsInteger(0) == 1;
		    else if (i_Name == "ScaleAccumulationMode")
			    io_rLayer.m_bAddsScaling = io_rCursor.Next().AsInteger(0) == 1;
	    });
}

/// A part of the turn from no rotation to one.
VMatrix3 PartOf(const VMatrix3& i_rRotation, double i_Part)
{
	VVector3 turn = Rotation::AngleAxisFromRotationMatrix(i_rRotation);
	for (double& rValue : turn)
		rValue *= i_Part;
	return Rotation::RotationMatrixFromAngleAxis(turn);
}

/// Degrees about x, y and z.
VVector3 AnglesOf(const VMatrix3& i_rRotation, ERotationOrder i_Order)
{
	constexpr int c_Axes[6][3] = {{0, 1, 2}, {0, 2, 1}, {1, 2, 0}, {1, 0, 2}, {2, 0, 1}, {2, 1, 0}};
	const int(&rAxes)[3] = c_Axes[int(i_Order)];
	// Which turns first here stands last there.
	VVector3 angles;
	Rotation::EulerFromRotationMatrix(
	    i_rRotation, Rotation::EEulerOrder(16 * rAxes[2] + 4 * rAxes[1] + rAxes[0]), angles);
	VVector3 degrees{};
	for (std::size_t i = 0; i < 3; ++i)
		degrees[std::size_t(rAxes[2 - i])] = angles[i] * 180.0 / std::numbers::pi;
	return degrees;
}

} // namespace

std::vector<VFbxLayer> TakeIO::ReadFbxLayers(
    const VDocument& i_rDocument, VObjectIndex i_Stack, const std::string& i_rStackName)
{
	const std::size_t count = i_rDocument.Objects().size();
	const auto isOf = [&](VObjectIndex i_Object, std::string_view i_Kind)
	{ return i_Object < count && i_rDocument.Objects()[i_Object].m_Kind == i_Kind; };
	std::vector<VListedLayer> layers;
	for (const VConnection& rConnection : i_rDocument.Connections())
		if (rConnection.m_Parent == i_Stack && isOf(rConnection.m_Child, "AnimationLayer"))
		{
			VListedLayer& rLayer = layers.emplace_back();
			rLayer.m_Object = rConnection.m_Child;
			ReadProperties(i_rDocument, i_rDocument.Template("AnimationLayer"), rLayer);
			ReadProperties(i_rDocument, i_rDocument.Objects()[rConnection.m_Child].m_Element, rLayer);
		}
	const bool bSolo = std::ranges::any_of(layers, &VListedLayer::m_bSolo);
	std::vector<VFbxLayer> counting;
	for (std::size_t i = 0; i < layers.size(); ++i)
	{
		if (i == 0)
		{
			layers[i].m_bOverrides = true;
			layers[i].m_bPassesThrough = false;
			layers[i].m_Weight = 1.0;
		}
		if (bSolo ? layers[i].m_bSolo : !layers[i].m_bMute)
			counting.push_back(layers[i]);
	}
	if (counting.size() < layers.size())
		NVX_LOG("TakeIO", NVX::ELogWarning,
		    "Layers of the stack \"%1%\" that are mute, or beside one that is solo: %2%", i_rStackName,
		    layers.size() - counting.size());
	for (const VConnection& rConnection : i_rDocument.Connections())
		if (rConnection.m_Property == "Weight" && isOf(rConnection.m_Child, "AnimationCurveNode")
		    && std::ranges::count(counting, rConnection.m_Parent, &VFbxLayer::m_Object) > 0)
			NVX_LOG("TakeIO", NVX::ELogWarning,
			    "The weight of the layer \"%1%\" changes over time, and counts as it stands in the file",
			    i_rDocument.Decoded(i_rDocument.Objects()[rConnection.m_Parent].m_Name));
	return counting;
}

void TakeIO::ApplyLayer(const VFbxLayer& i_rLayer, EFbxCoordinates i_Kind, const VVector3& i_rValues,
    ERotationOrder i_Order, VVector3& io_rValues)
{
	const double weight = i_rLayer.m_Weight;
	if (i_rLayer.m_bOverrides && weight == 1.0)
		io_rValues = i_rValues;
	else if (i_Kind == EFbxCoordinates::Rotation && !i_rLayer.m_bByChannel)
	{
		const VMatrix3 before = EulerRotation(io_rValues, i_Order);
		VMatrix3 turn = EulerRotation(i_rValues, i_Order);
		if (i_rLayer.m_bOverrides)
			turn = Rotation::Product(Rotation::Transposed(before), turn);
		io_rValues = AnglesOf(Rotation::Product(before, PartOf(turn, weight)), i_Order);
	}
	else
		for (std::size_t i = 0; i < 3; ++i)
			if (i_rLayer.m_bOverrides)
				io_rValues[i] += weight * (i_rValues[i] - io_rValues[i]);
			else if (i_Kind == EFbxCoordinates::Scaling && !i_rLayer.m_bAddsScaling)
				io_rValues[i] *= 1.0 + weight * (i_rValues[i] - 1.0);
			else
				io_rValues[i] += weight * i_rValues[i];
}
