#include "TakeIO/FbxJoints.h"

#include "TakeIO/Limits.h"
#include "fbxsdk/document/OldDocument.h"
#include "fbxsdk/document/Properties.h"
#include "fbxsdk/scene/ReadTransform.h"

namespace
{

using namespace FbxFormat;

/// Frames a second by the number of the time mode; 14 is the file's own.
constexpr double c_TimeModes[]{30.0, 120.0, 100.0, 60.0, 50.0, 48.0, 30.0, 30.0, 30000.0 / 1001.0, 30000.0 / 1001.0,
    25.0, 24.0, 1000.0, 24000.0 / 1001.0, 0.0, 96.0, 72.0, 60000.0 / 1001.0, 120000.0 / 1001.0};

bool IsModel(const VDocument& i_rDocument, VObjectIndex i_Object)
{
	return i_Object < i_rDocument.Objects().size() && i_rDocument.Objects()[i_Object].m_Kind == "Model";
}

bool IsBone(const VDocument& i_rDocument, VObjectIndex i_Object)
{
	const std::string_view kind = i_rDocument.Objects()[i_Object].m_SubKind;
	return IsModel(i_rDocument, i_Object) && (kind == "LimbNode" || kind == "Limb" || kind == "Root");
}

} // namespace

bool TakeIO::VFbxRecords::Read(std::string_view i_Bytes, std::string& o_rError)
{
	m_Kind = DetectFileKind(i_Bytes);
	if (m_Kind.m_Version < c_FirstVersionWithObjects || m_Kind.m_Version >= c_TooNewVersion)
	{
		o_rError = "It is no FBX file of version 6 or 7";
		return false;
	}
	bool bSound = m_Tree.Read(i_Bytes, m_Kind);
	o_rError = m_Tree.Error();
	if (bSound)
	{
		o_rError = m_pDocument.emplace(m_Tree).Error();
		bSound = o_rError.empty();
	}
	if (!bSound)
		o_rError = "The FBX file is damaged: " + o_rError;
	return bSound;
}

bool TakeIO::ReadFbxJoints(const VDocument& i_rDocument, std::vector<VFbxJoint>& o_rJoints, std::string& o_rError)
{
	const std::size_t count = i_rDocument.Objects().size();
	std::vector<VObjectIndex> parents(count, c_NoObject), stack, roots;
	std::vector<std::vector<VObjectIndex>> children(count);
	for (const VConnection& rConnection : i_rDocument.Connections())
	{
		const VObjectIndex child = rConnection.m_Child;
		if (!rConnection.m_Property.empty() || !IsModel(i_rDocument, child) || parents[child] != c_NoObject)
			continue;
		if (rConnection.m_Parent == c_SceneObject)
			roots.push_back(child);
		else if (IsModel(i_rDocument, rConnection.m_Parent))
			children[rConnection.m_Parent].push_back(child);
		else
			continue;
		parents[child] = rConnection.m_Parent;
	}
	std::vector<bool> kept(count);
	bool bBones = false;
	for (VObjectIndex object = 0; object < count; ++object)
		for (VObjectIndex above = IsBone(i_rDocument, object) ? object : c_NoObject; above < count && !kept[above];
		     above = parents[above])
			kept[above] = bBones = true;
	VNodeTransform defaults;
	ReadTransform(i_rDocument.Tree(), i_rDocument.Template("Model"), defaults);
	std::vector<std::int32_t> jointOf(count, -1);
	o_rJoints.clear();
	// Only what a chain leads to from the scene: what lies in a ring is not.
	for (stack.assign(roots.rbegin(), roots.rend()); !stack.empty();)
	{
		const VObjectIndex object = stack.back();
		stack.pop_back();
		if (bBones && !kept[object])
			continue;
		if (o_rJoints.size() == Limits::c_Joints)
		{
			o_rError = "It has more than " + std::to_string(Limits::c_Joints) + " joints";
			return false;
		}
		jointOf[object] = std::int32_t(o_rJoints.size());
		VFbxJoint& rJoint = o_rJoints.emplace_back();
		rJoint.m_Object = object;
		rJoint.m_Parent = parents[object] < count ? jointOf[parents[object]] : -1;
		rJoint.m_bBone = IsBone(i_rDocument, object);
		rJoint.m_Rest = defaults;
		ReadTransform(i_rDocument.Tree(), i_rDocument.Objects()[object].m_Element, rJoint.m_Rest);
		stack.insert(stack.end(), children[object].rbegin(), children[object].rend());
	}
	if (o_rJoints.empty())
		o_rError = "It has no joints";
	return !o_rJoints.empty();
}

TakeIO::VFbxSettings TakeIO::ReadFbxSettings(const VDocument& i_rDocument)
{
	VFbxSettings settings;
	std::int64_t up = 1, mode = 0;
	double factor = 1.0, custom = 0.0;
	VisitProperties(i_rDocument.Tree(), i_rDocument.GlobalSettings(),
	    [&](std::string_view i_Name, VValueCursor& io_rCursor)
	    {
		    if (i_Name == "UpAxis")
			    up = io_rCursor.Next().AsInteger(1);
		    else if (i_Name == "UnitScaleFactor")
			    factor = io_rCursor.Next().AsReal(1.0);
		    else if (i_Name == "TimeMode")
			    mode = io_rCursor.Next().AsInteger(0);
		    else if (i_Name == "CustomFrameRate")
			    custom = io_rCursor.Next().AsReal(0.0);
	    });
	if (up != 1)
		settings.m_Up = up == 2 ? std::optional(EUp::Z) : std::nullopt;
	const double unit = 10.0 * factor;
	settings.m_Unit = unit >= Limits::c_LeastUnit && unit <= Limits::c_GreatestUnit ? unit : 0.0;
	const double rate = mode >= 0 && mode < std::int64_t(std::size(c_TimeModes)) ? c_TimeModes[mode] : 0.0;
	const double known = rate > 0.0 ? rate : custom;
	if (known >= Limits::c_LeastRate && known <= Limits::c_GreatestRate)
		settings.m_Rate = known;
	return settings;
}
