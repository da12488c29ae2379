#pragma once

#include "fbxsdk/document/Document.h"
#include "fbxsdk/scene/Affine.h"

#include <vector>

namespace TakeIO
{

/// A layer of an animation stack: what it does to the values of those before it.
struct VFbxLayer
{
	FbxFormat::VObjectIndex m_Object = FbxFormat::c_NoObject;
	/// From 0 to 1.
	double m_Weight = 1.0;
	/// Else it adds.
	bool m_bOverrides = false;
	/// Coordinates without a curve stay as they are.
	bool m_bPassesThrough = false;
	/// Angles, not rotations.
	bool m_bByChannel = false;
	/// Scalings add instead of multiplying.
	bool m_bAddsScaling = false;
};

/// The layers of a stack that count, in their order: those that are solo where any is, else those that are not mute.
/// The first of the stack, the base, overrides wholly what is at rest, whatever it says. Told are those that do not
/// count, and weights that change over time, which are read as they stand.
std::vector<VFbxLayer> ReadFbxLayers(
    const FbxFormat::VDocument& i_rDocument, FbxFormat::VObjectIndex i_Stack, const std::string& i_rStackName);

/// What a property is.
enum class EFbxCoordinates
{
	Translation,
	Rotation,
	Scaling
};

/// Brings the values of a layer to those of the layers before it. Rotations, in degrees, combine as rotations, the
/// layer's within the others', unless it goes by channel.
/// @param i_Order in which the node's rotations turn.
void ApplyLayer(const VFbxLayer& i_rLayer, EFbxCoordinates i_Kind, const Rotation::VVector3& i_rValues,
    FbxFormat::ERotationOrder i_Order, Rotation::VVector3& io_rValues);

} // namespace TakeIO
