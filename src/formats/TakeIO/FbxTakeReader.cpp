#include "TakeIO/FbxTakeReader.h"

#include "DebugServices/GlobalLog.h"
#include "TakeIO/Axes.h"
#include "TakeIO/FbxCurve.h"
#include "TakeIO/FbxJoints.h"
#include "TakeIO/FbxLayers.h"
#include "TakeIO/Limits.h"
#include "fbxsdk/container/FileKind.h"
#include "fbxsdk/container/Values.h"
#include "fbxsdk/document/Properties.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <map>

namespace
{

using namespace TakeIO;
using namespace FbxFormat;
using Rotation::VMatrix3;
using Rotation::VVector3;

/// Before it the motion of models stands in "Takes".
constexpr std::uint32_t c_FirstVersionWithStacks = 7000;

/// Of a small file less than c_Values: a stack may claim to last for years.
constexpr double c_ValuesOfAny = 2e6;
constexpr double c_ValuesPerByte = 16.0;

constexpr std::size_t c_FramesBetweenProgress = 64;

constexpr std::string_view c_Animated[]{"Lcl Translation", "Lcl Rotation", "Lcl Scaling"};
constexpr std::string_view c_Components[]{"d|X", "d|Y", "d|Z"};

/// Channels of the same, before version 7.
constexpr std::string_view c_Kinds = "TRS";
constexpr std::string_view c_Axes = "XYZ";

/// Of a name of one letter; npos if it is none of them.
std::size_t PlaceIn(std::string_view i_Letters, std::string_view i_Name)
{
	return i_Name.size() == 1 ? i_Letters.find(i_Name) : std::string_view::npos;
}

/// A coordinate: a curve, or what stands still.
struct VComponent
{
	double m_Value = 0.0;
	bool m_bGiven = false;
	std::optional<VFbxCurve> m_Curve;
	/// Where the curve's last value came from.
	std::size_t m_NextKey = 0;
};

/// Or a take of a file before version 7, which is no object.
struct VStack
{
	VObjectIndex m_Object = c_NoObject;
	VElementIndex m_Element = c_NoElement;
	std::string_view m_Name;
};

/// What a layer has of a node's place, rotation or scaling.
struct VLayerPart
{
	std::size_t m_Layer = 0;
	EFbxCoordinates m_Kind = EFbxCoordinates::Translation;
	std::array<VComponent, 3> m_Components;
};

struct VNode : VFbxJoint
{
	/// In the order of the layers.
	std::vector<VLayerPart> m_Parts;
	/// Whether its place may change: its own coordinates, or the scaling of what is above it.
	bool m_bMoves = false;
	bool m_bScales = false;
};

class VFbxTakeReader
{
public:
	VFbxTakeReader(std::string_view i_Bytes, const VTakeSettings& i_rSettings, VTake& o_rTake)
	    : m_Bytes(i_Bytes), m_rSettings(i_rSettings), m_rTake(o_rTake)
	{
	}

	bool Read()
	{
		m_rTake = {};
		if (!m_Records.Read(m_Bytes, m_Error))
			return false;
		m_Budget.m_BytesLeft = FbxFormat::Limits::DecodedBytes(m_Bytes.size());
		if (!ReadSettings() || !FindNodes())
			return false;
		const bool bTakes = m_Records.Kind().m_Version < c_FirstVersionWithStacks;
		return (bTakes ? ListTakes() : ListStacks()) && ChooseStack() && (bTakes ? ReadChannels() : ReadCurves())
		    && SpreadScaling() && FindSpan() && Sample();
	}

	std::string m_Error;

private:
	bool Fail(const std::string& i_rWhat)
	{
		m_Error = i_rWhat;
		return false;
	}

	const VObject& Object(VObjectIndex i_Object) const { return m_Records.Document().Objects()[i_Object]; }

	bool IsOf(VObjectIndex i_Object, std::string_view i_Kind) const
	{
		return i_Object < m_Records.Document().Objects().size() && Object(i_Object).m_Kind == i_Kind;
	}

	bool ReadSettings()
	{
		const VFbxSettings settings = ReadFbxSettings(m_Records.Document());
		if (!m_rSettings.m_Up && !settings.m_Up)
			return Fail("Its X axis points up, which is not read");
		m_rTake.m_FileUp = m_rSettings.m_Up ? *m_rSettings.m_Up : *settings.m_Up;
		m_rTake.m_FileUnit = m_rSettings.m_Unit.value_or(settings.m_Unit);
		m_rTake.m_Rate = m_rSettings.m_Rate.value_or(settings.m_Rate);
		return m_rTake.m_FileUnit > 0.0 || Fail("Its unit is none");
	}

	bool FindNodes()
	{
		std::vector<VFbxJoint> joints;
		if (!ReadFbxJoints(m_Records.Document(), joints, m_Error))
			return false;
		m_NodeOf.assign(m_Records.Document().Objects().size(), -1);
		for (const VFbxJoint& rJoint : joints)
		{
			m_NodeOf[rJoint.m_Object] = std::int32_t(m_Nodes.size());
			m_Nodes.push_back({rJoint, {}});
		}
		return true;
	}

	bool ListStacks()
	{
		for (VObjectIndex object = 0; object < m_Records.Document().Objects().size(); ++object)
			if (IsOf(object, "AnimationStack"))
				m_Stacks.push_back({object, Object(object).m_Element, Object(object).m_Name});
		return true;
	}

	bool ListTakes()
	{
		const VElementTree& rTree = m_Records.Tree();
		for (const VElementIndex take : rTree.Children(rTree.Find(VElementTree::c_Root, "Takes")))
			if (rTree.Name(take) == "Take")
				m_Stacks.push_back({c_NoObject, take, ValueAt(rTree, take, 0).m_Text});
		return true;
	}

	bool ChooseStack()
	{
		std::string names;
		bool bFound = false;
		for (const VStack& rStack : m_Stacks)
		{
			const std::string name = m_Records.Document().Decoded(rStack.m_Name);
			names += (names.empty() ? "" : ", ") + name;
			if (bFound || m_rSettings.m_Stack.value_or(name) != name)
				continue;
			m_Stack = rStack;
			m_StackName = name;
			bFound = true;
		}
		if (!bFound)
			return Fail(m_Stacks.empty() ? "It holds no animation stack" : "It has no such stack. It has: " + names);
		if (m_Stacks.size() > 1 && !m_rSettings.m_Stack)
			NVX_LOG("TakeIO", NVX::ELogWarning, "Of its %1% stacks the first is read, \"%2%\". It has: %3%",
			    m_Stacks.size(), m_StackName, names);
		return true;
	}

	bool KeepKeys(const VFbxCurve& i_rCurve, bool i_bSound)
	{
		if (!i_bSound)
			return Fail("A curve of its stack \"" + m_StackName + "\" is damaged or too large");
		m_FirstKey = std::min(m_FirstKey, i_rCurve.FirstTime());
		m_LastKey = std::max(m_LastKey, i_rCurve.LastTime());
		return true;
	}

	/// Calls i_Visit(name, channel) for each channel right below one, or below a model.
	template <typename TVisit>
	bool ForEachChannel(VElementIndex i_Of, TVisit&& i_Visit) const
	{
		const VElementTree& rTree = m_Records.Tree();
		for (const VElementIndex channel : rTree.Children(i_Of))
			if (rTree.Name(channel) == "Channel" && !i_Visit(ValueAt(rTree, channel, 0).m_Text, channel))
				return false;
		return true;
	}

	/// What moves before version 7: models by name, and in them channels inside channels.
	bool ReadChannels()
	{
		const VElementTree& rTree = m_Records.Tree();
		std::map<std::string_view, VNode*> byName;
		for (VNode& rNode : m_Nodes)
			byName.try_emplace(Object(rNode.m_Object).m_Name, &rNode);
		for (const VElementIndex model : rTree.Children(m_Stack.m_Element))
		{
			const auto found = byName.find(SplitFullName(ValueAt(rTree, model, 0).m_Text).m_Name);
			if (rTree.Name(model) != "Model" || found == byName.end())
				continue;
			VNode& rNode = *found->second;
			const bool bRead = ForEachChannel(model,
			    [&](std::string_view i_Name, VElementIndex i_Transform)
			    {
				    return i_Name != "Transform"
				        || ForEachChannel(i_Transform,
				            [&](std::string_view i_Kind, VElementIndex i_Channel)
				            { return ReadChannel(rNode, PlaceIn(c_Kinds, i_Kind), i_Channel); });
			    });
			if (!bRead)
				return false;
		}
		return true;
	}

	/// @param i_Kind place, rotation or scaling
	bool ReadChannel(VNode& io_rNode, std::size_t i_Kind, VElementIndex i_Channel)
	{
		if (i_Kind == std::string_view::npos)
			return true;
		const VElementTree& rTree = m_Records.Tree();
		VLayerPart& rPart = io_rNode.m_Parts.emplace_back();
		rPart.m_Kind = EFbxCoordinates(i_Kind);
		return ForEachChannel(i_Channel,
		    [&](std::string_view i_Axis, VElementIndex i_Component)
		    {
			    const std::size_t axis = PlaceIn(c_Axes, i_Axis);
			    if (axis == std::string_view::npos)
				    return true;
			    VComponent& rComponent = rPart.m_Components[axis];
			    if (const VElementIndex value = rTree.Find(i_Component, "Default"); value != c_NoElement)
			    {
				    rComponent.m_Value = ValueAt(rTree, value, 0).AsReal();
				    rComponent.m_bGiven = std::abs(rComponent.m_Value) <= TakeIO::Limits::c_Largest;
				    io_rNode.m_bMoves = true;
			    }
			    const VElementIndex keys = rTree.Find(i_Component, "Key");
			    if (keys == c_NoElement)
				    return true;
			    VFbxCurve& rCurve = rComponent.m_Curve.emplace();
			    if (!KeepKeys(rCurve, rCurve.ReadKeys(rTree, keys, m_Budget)))
				    return false;
			    io_rNode.m_bMoves = true;
			    io_rNode.m_bScales = io_rNode.m_bScales
			        || (rPart.m_Kind == EFbxCoordinates::Scaling && rCurve.LastTime() > rCurve.FirstTime());
			    return true;
		    });
	}

	/// The curves of the layers that count, and no others, are inflated.
	bool ReadCurves()
	{
		m_Layers = ReadFbxLayers(m_Records.Document(), m_Stack.m_Object, m_StackName);
		constexpr std::int32_t c_NoLayer = -1;
		const std::size_t objects = m_Records.Document().Objects().size();
		std::vector<std::int32_t> layerAt(objects, c_NoLayer), layerOf(objects, c_NoLayer);
		for (std::size_t i = 0; i < m_Layers.size(); ++i)
			layerAt[m_Layers[i].m_Object] = std::int32_t(i);
		for (const VConnection& rConnection : m_Records.Document().Connections())
			if (rConnection.m_Parent < objects && layerAt[rConnection.m_Parent] != c_NoLayer
			    && IsOf(rConnection.m_Child, "AnimationCurveNode"))
				layerOf[rConnection.m_Child] = layerAt[rConnection.m_Parent];
		// What a curve node moves: a node and its part.
		std::vector<std::vector<std::pair<VNode*, std::size_t>>> moved(objects);
		for (const VConnection& rConnection : m_Records.Document().Connections())
		{
			const auto* const pProperty = std::ranges::find(c_Animated, rConnection.m_Property);
			if (pProperty == std::end(c_Animated) || !IsOf(rConnection.m_Parent, "Model")
			    || rConnection.m_Child >= objects || layerOf[rConnection.m_Child] == c_NoLayer
			    || m_NodeOf[rConnection.m_Parent] < 0)
				continue;
			VNode& rNode = m_Nodes[std::size_t(m_NodeOf[rConnection.m_Parent])];
			moved[rConnection.m_Child].emplace_back(&rNode, rNode.m_Parts.size());
			VLayerPart& rPart = rNode.m_Parts.emplace_back();
			rPart.m_Layer = std::size_t(layerOf[rConnection.m_Child]);
			rPart.m_Kind = EFbxCoordinates(pProperty - c_Animated);
			rNode.m_bMoves = true;
			rNode.m_bScales = rNode.m_bScales || rPart.m_Kind == EFbxCoordinates::Scaling;
			VisitProperties(m_Records.Tree(), Object(rConnection.m_Child).m_Element,
			    [&rPart](std::string_view i_Name, VValueCursor& io_rCursor)
			    {
				    const auto* const pFound = std::ranges::find(c_Components, i_Name);
				    if (pFound == std::end(c_Components))
					    return;
				    VComponent& rComponent = rPart.m_Components[std::size_t(pFound - c_Components)];
				    rComponent.m_Value = io_rCursor.Next().AsReal();
				    rComponent.m_bGiven = std::abs(rComponent.m_Value) <= TakeIO::Limits::c_Largest;
			    });
		}
		for (const VConnection& rConnection : m_Records.Document().Connections())
		{
			const auto* const pComponent = std::ranges::find(c_Components, rConnection.m_Property);
			if (pComponent == std::end(c_Components) || rConnection.m_Parent >= moved.size()
			    || !IsOf(rConnection.m_Child, "AnimationCurve"))
				continue;
			for (const auto& [pNode, part] : moved[rConnection.m_Parent])
			{
				std::optional<VFbxCurve>& rCurve =
				    pNode->m_Parts[part].m_Components[std::size_t(pComponent - c_Components)].m_Curve;
				const bool bSound =
				    rCurve.emplace().Read(m_Records.Tree(), Object(rConnection.m_Child).m_Element, m_Budget);
				if (!KeepKeys(*rCurve, bSound))
					return false;
			}
		}
		for (VNode& rNode : m_Nodes)
			std::ranges::stable_sort(rNode.m_Parts, {}, &VLayerPart::m_Layer);
		return true;
	}

	/// What scales moves what is below it.
	bool SpreadScaling()
	{
		for (VNode& rNode : m_Nodes)
			if (rNode.m_Parent >= 0 && m_Nodes[std::size_t(rNode.m_Parent)].m_bScales)
				rNode.m_bMoves = rNode.m_bScales = true;
		return m_LastKey >= m_FirstKey || Fail("Nothing moves in its stack \"" + m_StackName + '"');
	}

	/// The stack's own span, or else that of its keys.
	bool FindSpan()
	{
		double start = 0.0, stop = 0.0;
		const VElementTree& rTree = m_Records.Tree();
		if (const VElementIndex span = rTree.Find(m_Stack.m_Element, "LocalTime"); span != c_NoElement)
		{
			start = ValueAt(rTree, span, 0).AsReal();
			stop = ValueAt(rTree, span, 1).AsReal();
		}
		VisitProperties(rTree, m_Stack.m_Element,
		    [&](std::string_view i_Name, VValueCursor& io_rCursor)
		    {
			    if (i_Name == "LocalStart")
				    start = io_rCursor.Next().AsReal();
			    else if (i_Name == "LocalStop")
				    stop = io_rCursor.Next().AsReal();
		    });
		m_Start = stop > start ? start : m_FirstKey;
		const double seconds = ((stop > start ? stop : m_LastKey) - m_Start) / c_FbxSecond;
		m_Frames = std::floor(seconds * m_rTake.m_Rate + 1e-6) + 1.0;
		const auto moving = double(std::ranges::count(m_Nodes, true, &VNode::m_bMoves));
		std::size_t parts = 0;
		for (const VNode& rNode : m_Nodes)
			parts += rNode.m_Parts.size();
		// All layers are evaluated in each frame; a node has three parts in one.
		const double work = std::max(moving, double(parts) / 3.0) * double(std::size(c_AllChannels));
		const double most =
		    std::min(double(TakeIO::Limits::c_Values), c_ValuesOfAny + c_ValuesPerByte * double(m_Bytes.size()));
		if (!(m_Frames * work <= most))
			return Fail("Its stack \"" + m_StackName + "\" lasts longer than such a file is read");
		return true;
	}

	bool Sample()
	{
		for (const VNode& rNode : m_Nodes)
		{
			VJoint& rJoint = m_rTake.m_Joints.emplace_back();
			rJoint.m_Name = m_Records.Document().Decoded(Object(rNode.m_Object).m_Name);
			rJoint.m_Parent = rNode.m_Parent;
			if (rNode.m_bMoves)
				AddChannels(m_rTake, m_rTake.m_Joints.size() - 1, true);
		}
		m_Globals.resize(m_Nodes.size());
		m_Poses.resize(m_Nodes.size());
		bool bFinite = ComputePoses({});
		SetWorldRest(m_rTake, m_Poses);
		m_rTake.m_Values.reserve(std::size_t(m_Frames) * m_rTake.m_Channels);
		for (std::size_t index = 0; double(index) < m_Frames && bFinite; ++index)
		{
			const auto frame = double(index);
			bFinite = ComputePoses(m_Start + frame * c_FbxSecond / m_rTake.m_Rate);
			AddFrame(m_rTake, m_Poses);
			if (m_rTake.m_Frames % c_FramesBetweenProgress == 0 && m_rSettings.m_Progress
			    && !m_rSettings.m_Progress(frame / m_Frames))
				return Fail("The reading was ended");
		}
		return bFinite || Fail("Its joints are beyond any stage");
	}

	/// At rest without a time. False if a joint is nowhere.
	bool ComputePoses(std::optional<double> i_Time)
	{
		for (std::size_t i = 0; i < m_Nodes.size(); ++i)
		{
			VNode& rNode = m_Nodes[i];
			VNodeTransform transform = rNode.m_Rest;
			VVector3* const coordinates[]{&transform.m_Translation, &transform.m_Rotation, &transform.m_Scaling};
			const ERotationOrder order = transform.HasRotationSpace() ? transform.m_Order : ERotationOrder::XYZ;
			for (std::size_t k = 0; k < rNode.m_Parts.size() && i_Time; ++k)
			{
				VLayerPart& rPart = rNode.m_Parts[k];
				const VFbxLayer& rLayer = m_Layers[rPart.m_Layer];
				VVector3& rBefore = *coordinates[std::size_t(rPart.m_Kind)];
				// What a layer does not tell of is as it was, or adds nothing.
				VVector3 values = rBefore;
				if (!rLayer.m_bOverrides)
					values.fill(rPart.m_Kind == EFbxCoordinates::Scaling && !rLayer.m_bAddsScaling ? 1.0 : 0.0);
				for (std::size_t axis = 0; axis < values.size(); ++axis)
				{
					VComponent& rComponent = rPart.m_Components[axis];
					if (rComponent.m_Curve)
						values[axis] = rComponent.m_Curve->At(*i_Time, rComponent.m_NextKey);
					else if (rComponent.m_bGiven && !rLayer.m_bPassesThrough)
						values[axis] = rComponent.m_Value;
				}
				ApplyLayer(rLayer, rPart.m_Kind, values, order, rBefore);
			}
			const VGlobalTransform& rParent = rNode.m_Parent < 0 ? m_Scene : m_Globals[std::size_t(rNode.m_Parent)];
			m_Globals[i] = GlobalTransform(rParent, LocalTransform(transform), transform.m_InheritType);
			if (!Place(m_Globals[i], m_Poses[i]))
				return false;
		}
		return true;
	}

	/// In our axes and millimetres, without scaling.
	bool Place(const VGlobalTransform& i_rGlobal, VJointPose& o_rPose) const
	{
		const EUp up = m_rTake.m_FileUp;
		o_rPose.t = MapVector(AxisFromFile, up, m_rTake.m_FileUnit, i_rGlobal.m_Map.t);
		const VAxis axes[]{AxisFromFile(up, 0), AxisFromFile(up, 1), AxisFromFile(up, 2)};
		const double* pNumber = i_rGlobal.m_Rotation.data();
		for (const VAxis& rTo : axes)
			for (const VAxis& rFrom : axes)
				o_rPose.R[std::size_t(3 * rTo.m_Axis + rFrom.m_Axis)] = rTo.m_Sign * rFrom.m_Sign * *pNumber++;
		const auto isSound = [](double i_Number) { return std::abs(i_Number) <= 1e15; };
		return std::ranges::all_of(o_rPose.t, isSound) && std::ranges::all_of(o_rPose.R, isSound);
	}

	const std::string_view m_Bytes;
	const VTakeSettings& m_rSettings;
	VTake& m_rTake;
	VFbxRecords m_Records;
	VDecodeBudget m_Budget;
	std::vector<VNode> m_Nodes;
	/// By object; -1 of what is no joint.
	std::vector<std::int32_t> m_NodeOf;
	std::vector<VStack> m_Stacks;
	VStack m_Stack;
	/// A take before version 7 is like a base.
	std::vector<VFbxLayer> m_Layers{{c_NoObject, 1.0, true}};
	std::string m_StackName;
	double m_FirstKey = std::numeric_limits<double>::infinity();
	double m_LastKey = -std::numeric_limits<double>::infinity();
	double m_Start = 0.0;
	double m_Frames = 0.0;
	/// What the first nodes stand in.
	const VGlobalTransform m_Scene;
	std::vector<VGlobalTransform> m_Globals;
	/// To the world.
	std::vector<VJointPose> m_Poses;
};

} // namespace

bool TakeIO::IsFbx(std::string_view i_Bytes)
{
	return DetectFileKind(i_Bytes).m_Kind != EFileKind::None;
}

bool TakeIO::ReadFbxTake(
    std::string_view i_Bytes, const VTakeSettings& i_rSettings, VTake& o_rTake, std::string& o_rError)
{
	VFbxTakeReader reader(i_Bytes, i_rSettings, o_rTake);
	const bool bRead = reader.Read();
	o_rError = std::move(reader.m_Error);
	return bRead;
}
