#include "TakeIO/FbxTakeReader.h"

#include "DebugServices/GlobalLog.h"
#include "TakeIO/Axes.h"
#include "TakeIO/FbxCurve.h"
#include "TakeIO/FbxJoints.h"
#include "TakeIO/Limits.h"
#include "fbxsdk/container/FileKind.h"
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

/// The first version with animation stacks.
constexpr std::uint32_t c_FirstVersion = 7000;

/// Of a small file less than c_Values: a stack may claim to last for years.
constexpr double c_ValuesOfAny = 2e6;
constexpr double c_ValuesPerByte = 16.0;

constexpr std::string_view c_Animated[]{"Lcl Translation", "Lcl Rotation", "Lcl Scaling"};
constexpr std::string_view c_Components[]{"d|X", "d|Y", "d|Z"};

/// A coordinate: a curve, or what stands still.
struct VComponent
{
	double m_Value = 0.0;
	bool m_bGiven = false;
	std::optional<VFbxCurve> m_Curve;
};

struct VNode : VFbxJoint
{
	std::array<VComponent, 9> m_Components;
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
		const VFileKind kind = DetectFileKind(m_Bytes);
		if (kind.m_Version < c_FirstVersion || kind.m_Version >= c_TooNewVersion)
			return Fail("Takes are read from FBX files of version 7");
		if (!m_Records.Read(m_Bytes, m_Error))
			return false;
		m_Budget.m_BytesLeft = FbxFormat::Limits::DecodedBytes(m_Bytes.size());
		return ReadSettings() && FindNodes() && FindStack() && ReadCurves() && FindSpan() && Sample();
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

	bool FindStack()
	{
		for (VObjectIndex object = 0; object < m_Records.Document().Objects().size(); ++object)
			if (IsOf(object, "AnimationStack"))
			{
				const std::string name = m_Records.Document().Decoded(Object(object).m_Name);
				m_Names += (m_Names.empty() ? "" : ", ") + name;
				++m_Stacks;
				if (m_Stack == c_NoObject && m_rSettings.m_Stack.value_or(name) == name)
				{
					m_Stack = object;
					m_StackName = name;
				}
			}
		if (m_Stack == c_NoObject)
			return Fail(m_Stacks == 0 ? "It holds no animation stack" : "It has no such stack. It has: " + m_Names);
		if (m_Stacks > 1 && !m_rSettings.m_Stack)
			NVX_LOG("TakeIO", NVX::ELogWarning, "Of its %1% stacks the first is read, \"%2%\". It has: %3%", m_Stacks,
			    m_StackName, m_Names);
		return true;
	}

	/// The curves of the first layer, and no others, are inflated.
	bool ReadCurves()
	{
		VObjectIndex layer = c_NoObject;
		std::size_t layers = 0;
		for (const VConnection& rConnection : m_Records.Document().Connections())
			if (rConnection.m_Parent == m_Stack && IsOf(rConnection.m_Child, "AnimationLayer"))
				layer = layers++ == 0 ? rConnection.m_Child : layer;
		if (layers > 1)
			NVX_LOG("TakeIO", NVX::ELogWarning, "Layers of the stack \"%1%\" that are left out: %2%", m_StackName,
			    layers - 1);
		std::vector<bool> inLayer(m_Records.Document().Objects().size());
		for (const VConnection& rConnection : m_Records.Document().Connections())
			if (layer != c_NoObject && rConnection.m_Parent == layer && IsOf(rConnection.m_Child, "AnimationCurveNode"))
				inLayer[rConnection.m_Child] = true;
		// The first coordinate of the three that a curve node moves.
		std::vector<std::vector<VComponent*>> moved(m_Records.Document().Objects().size());
		for (const VConnection& rConnection : m_Records.Document().Connections())
		{
			const auto* const pProperty = std::ranges::find(c_Animated, rConnection.m_Property);
			if (pProperty == std::end(c_Animated) || !IsOf(rConnection.m_Parent, "Model")
			    || rConnection.m_Child >= inLayer.size() || !inLayer[rConnection.m_Child]
			    || m_NodeOf[rConnection.m_Parent] < 0)
				continue;
			VNode& rNode = m_Nodes[std::size_t(m_NodeOf[rConnection.m_Parent])];
			const auto kind = std::size_t(pProperty - c_Animated);
			VComponent* const pFirst = &rNode.m_Components[3 * kind];
			moved[rConnection.m_Child].push_back(pFirst);
			rNode.m_bMoves = true;
			rNode.m_bScales = rNode.m_bScales || kind == 2;
			VisitProperties(m_Records.Tree(), Object(rConnection.m_Child).m_Element,
			    [pFirst](std::string_view i_Name, VValueCursor& io_rCursor)
			    {
				    const auto* const pFound = std::ranges::find(c_Components, i_Name);
				    if (pFound == std::end(c_Components))
					    return;
				    VComponent& rComponent = pFirst[pFound - c_Components];
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
			for (VComponent* const pFirst : moved[rConnection.m_Parent])
			{
				std::optional<VFbxCurve>& rCurve = pFirst[pComponent - c_Components].m_Curve;
				if (!rCurve.emplace().Read(m_Records.Tree(), Object(rConnection.m_Child).m_Element, m_Budget))
					return Fail("A curve of its stack \"" + m_StackName + "\" is damaged or too large");
				m_FirstKey = std::min(m_FirstKey, rCurve->FirstTime());
				m_LastKey = std::max(m_LastKey, rCurve->LastTime());
			}
		}
		for (VNode& rNode : m_Nodes)
			if (rNode.m_Parent >= 0 && m_Nodes[std::size_t(rNode.m_Parent)].m_bScales)
				rNode.m_bMoves = rNode.m_bScales = true;
		return m_LastKey >= m_FirstKey || Fail("Nothing moves in its stack \"" + m_StackName + '"');
	}

	/// The stack's own span, or else that of its keys.
	bool FindSpan()
	{
		double start = 0.0, stop = 0.0;
		VisitProperties(m_Records.Tree(), Object(m_Stack).m_Element,
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
		const double most =
		    std::min(double(TakeIO::Limits::c_Values), c_ValuesOfAny + c_ValuesPerByte * double(m_Bytes.size()));
		if (!(m_Frames * moving * double(std::size(c_AllChannels)) <= most))
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
		for (double frame = 0.0; frame < m_Frames && bFinite; ++frame)
		{
			bFinite = ComputePoses(m_Start + frame * c_FbxSecond / m_rTake.m_Rate);
			AddFrame(m_rTake, m_Poses);
		}
		return bFinite || Fail("Its joints are beyond any stage");
	}

	/// At rest without a time. False if a joint is nowhere.
	bool ComputePoses(std::optional<double> i_Time)
	{
		for (std::size_t i = 0; i < m_Nodes.size(); ++i)
		{
			const VNode& rNode = m_Nodes[i];
			VNodeTransform transform = rNode.m_Rest;
			VVector3* const coordinates[]{&transform.m_Translation, &transform.m_Rotation, &transform.m_Scaling};
			for (std::size_t k = 0; k < rNode.m_Components.size() && i_Time; ++k)
			{
				const VComponent& rComponent = rNode.m_Components[k];
				double& rValue = (*coordinates[k / 3])[k % 3];
				rValue = rComponent.m_Curve ? rComponent.m_Curve->At(*i_Time)
				    : rComponent.m_bGiven   ? rComponent.m_Value
				                            : rValue;
			}
			const VGlobalTransform parent =
			    rNode.m_Parent < 0 ? VGlobalTransform() : m_Globals[std::size_t(rNode.m_Parent)];
			m_Globals[i] = GlobalTransform(parent, LocalTransform(transform), transform.m_InheritType);
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
		for (int row = 0; row < 3; ++row)
			for (int column = 0; column < 3; ++column)
			{
				const VAxis to = AxisFromFile(up, row);
				const VAxis from = AxisFromFile(up, column);
				o_rPose.R[std::size_t(3 * to.m_Axis + from.m_Axis)] =
				    to.m_Sign * from.m_Sign * i_rGlobal.m_Rotation[std::size_t(3 * row + column)];
			}
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
	VObjectIndex m_Stack = c_NoObject;
	std::string m_StackName;
	std::string m_Names;
	std::size_t m_Stacks = 0;
	double m_FirstKey = std::numeric_limits<double>::infinity();
	double m_LastKey = -std::numeric_limits<double>::infinity();
	double m_Start = 0.0;
	double m_Frames = 0.0;
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
