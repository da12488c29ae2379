#include "SetupIO/ReadSetup.h"

#include "SetupIO/SetupFields.h"
#include "SetupIO/TextNode.h"

#include <algorithm>
#include <cmath>
#include <iterator>

namespace SetupIO
{
namespace
{

/// The first fault ends the reading.
struct VRefused
{
	VFault m_Fault;
};

[[noreturn]] void Refuse(const VTextNode& i_rNode, const std::string& i_rReason)
{
	throw VRefused{{i_rNode.m_Line, i_rReason}};
}

std::string Quoted(std::string_view i_Text)
{
	return "\"" + std::string(i_Text) + "\"";
}

void Require(const VTextNode& i_rNode, VTextNode::EKind i_Kind, const char* i_pWhat)
{
	if (i_rNode.m_Kind != i_Kind)
		Refuse(i_rNode, (i_rNode.m_Name.empty() ? "this" : Quoted(i_rNode.m_Name)) + " is to be " + i_pWhat);
}

const std::string& Text(const VTextNode& i_rNode)
{
	Require(i_rNode, VTextNode::EText, "a text in quotes");
	return i_rNode.m_Text;
}

double NotNegative(const VTextNode& i_rNode)
{
	Require(i_rNode, VTextNode::ENumber, "a number");
	if (i_rNode.m_Number < 0.0)
		Refuse(i_rNode, Quoted(i_rNode.m_Name) + " cannot be " + i_rNode.m_Text + ": it is 0 or more");
	return i_rNode.m_Number;
}

bool True(const VTextNode& i_rNode)
{
	Require(i_rNode, VTextNode::EBoolean, "true or false");
	return i_rNode.m_bTrue;
}

void Take(const VTextNode& i_rNode, std::string& o_rValue)
{
	o_rValue = Text(i_rNode);
}

void Take(const VTextNode& i_rNode, bool& o_rbValue)
{
	o_rbValue = True(i_rNode);
}

void Take(const VTextNode& i_rNode, std::optional<double>& o_rValue)
{
	o_rValue = NotNegative(i_rNode);
}

void Take(const VTextNode& i_rNode, std::optional<std::size_t>& o_rValue)
{
	constexpr double c_Most = 1e9;
	const double number = NotNegative(i_rNode);
	if (number != std::floor(number) || number > c_Most)
		Refuse(i_rNode, Quoted(i_rNode.m_Name) + " is to be a count, not " + i_rNode.m_Text);
	o_rValue = std::size_t(number);
}

/// Whether one of the fields has the node's name; then it takes it.
template <typename TFields, typename TOwner>
bool TakeField(const TFields& i_rFields, const VTextNode& i_rNode, TOwner& io_rOwner, std::string& io_rKnown)
{
	for (const auto& rField : i_rFields)
	{
		if (i_rNode.m_Name == rField.m_pName)
		{
			Take(i_rNode, io_rOwner.*rField.m_pMember);
			return true;
		}
		io_rKnown += (io_rKnown.empty() ? "" : ", ") + std::string(rField.m_pName);
	}
	return false;
}

[[noreturn]] void RefuseField(const VTextNode& i_rNode, const std::string& i_rKnown)
{
	Refuse(i_rNode, "there is no field " + Quoted(i_rNode.m_Name) + "; there are " + i_rKnown);
}

VPair ReadPair(const VTextNode& i_rNode)
{
	Require(i_rNode, VTextNode::EObject, "a pair: {\"source\": \"...\", \"target\": \"...\"}");
	VPair pair;
	pair.m_Line = {i_rNode.m_Line};
	for (const VTextNode& rField : i_rNode.m_Items)
	{
		std::string known;
		if (!TakeField(Fields::c_PairTexts, rField, pair, known)
		    && !TakeField(Fields::c_PairWeights, rField, pair, known))
			RefuseField(rField, known);
	}
	if (pair.m_Source.empty() || pair.m_Target.empty())
		Refuse(i_rNode,
		    std::string("a pair has no ") + (pair.m_Source.empty() ? "\"source\"" : "\"target\"")
		        + ", which names one of the two");
	return pair;
}

VEdit ReadEdit(const VTextNode& i_rNode)
{
	Require(i_rNode, VTextNode::EObject, "an edit: {\"position\": \"Hips:pelvis\"}");
	VEdit edit;
	edit.m_Line = {i_rNode.m_Line};
	for (const VTextNode& rField : i_rNode.m_Items)
	{
		if (rField.m_Name == Fields::c_Comment)
		{
			edit.m_Comment = Text(rField);
			continue;
		}
		if (!edit.m_Name.empty())
			Refuse(rField,
			    "an edit has one name beside its comment, and this one has " + Quoted(edit.m_Name) + " and "
			        + Quoted(rField.m_Name));
		edit.m_Name = rField.m_Name;
		edit.m_Line = {rField.m_Line};
		if (rField.m_Kind == VTextNode::EText || rField.m_Kind == VTextNode::ENumber)
			edit.m_Value = rField.m_Text;
		else if (rField.m_Kind != VTextNode::EBoolean || !rField.m_bTrue)
			Refuse(rField, Quoted(rField.m_Name) + " is to be a text, a number, or true for an edit without a value");
	}
	if (edit.m_Name.empty())
		Refuse(i_rNode, "an edit has no name");
	return edit;
}

const std::string& PoseId(const VTextNode& i_rNode)
{
	const std::string& rId = Text(i_rNode);
	if (std::ranges::find(Fields::c_PoseIds, rId) != std::end(Fields::c_PoseIds))
		return rId;
	std::string known;
	for (const char* const pId : Fields::c_PoseIds)
		known += (known.empty() ? "" : ", ") + std::string(pId);
	Refuse(i_rNode, "nothing of the pose is called " + Quoted(rId) + "; there are " + known);
}

VChecks ReadChecks(const VTextNode& i_rNode)
{
	Require(i_rNode, VTextNode::EObject, "an object, as {\"sound\": true}");
	VChecks checks;
	for (const VTextNode& rField : i_rNode.m_Items)
	{
		std::string known = std::string(Fields::c_Comment) + ", " + Fields::c_Pose;
		if (rField.m_Name == Fields::c_Comment)
			Text(rField);
		else if (rField.m_Name == Fields::c_Pose)
		{
			Require(rField, VTextNode::EList, "a list of texts");
			for (const VTextNode& rItem : rField.m_Items)
				checks.m_Pose.push_back(PoseId(rItem));
		}
		else if (!TakeField(Fields::c_CheckFlags, rField, checks, known)
		    && !TakeField(Fields::c_CheckCounts, rField, checks, known)
		    && !TakeField(Fields::c_CheckLimits, rField, checks, known))
			RefuseField(rField, known);
	}
	return checks;
}

template <typename T>
void ReadList(const VTextNode& i_rNode, T (*i_pRead)(const VTextNode&), std::vector<T>& o_rList)
{
	Require(i_rNode, VTextNode::EList, "a list in brackets");
	for (const VTextNode& rItem : i_rNode.m_Items)
		o_rList.push_back(i_pRead(rItem));
}

void ReadField(const VTextNode& i_rNode, VSetup& io_rSetup)
{
	std::string known = std::string(Fields::c_Pairs) + ", " + Fields::c_Edits + ", " + Fields::c_Checks;
	if (i_rNode.m_Name == Fields::c_Pairs)
		ReadList(i_rNode, ReadPair, io_rSetup.m_Pairs);
	else if (i_rNode.m_Name == Fields::c_Edits)
		ReadList(i_rNode, ReadEdit, io_rSetup.m_Edits);
	else if (i_rNode.m_Name == Fields::c_Checks)
		io_rSetup.m_Checks = ReadChecks(i_rNode);
	else if (i_rNode.m_Name == Fields::c_Root && i_rNode.m_Kind == VTextNode::ENumber)
	{
		std::optional<std::size_t> index;
		Take(i_rNode, index);
		io_rSetup.m_Root = "#" + std::to_string(*index);
	}
	else if (!TakeField(Fields::c_Texts, i_rNode, io_rSetup, known))
		RefuseField(i_rNode, known);
	if (i_rNode.m_Name == Fields::c_RootHeight && io_rSetup.m_RootHeight != Fields::c_Keep
	    && io_rSetup.m_RootHeight != Fields::c_Scale)
		Refuse(i_rNode, "\"root-height\" is to be \"keep\" or \"scale\"");
	io_rSetup.m_Fields.m_Value.emplace_back(i_rNode.m_Name, i_rNode.m_Line);
}

} // namespace

bool ReadSetup(std::string_view i_Text, VSetup& o_rSetup, VFault& o_rFault)
{
	o_rSetup = {};
	VTextNode root;
	if (!ParseText(i_Text, root, o_rFault))
		return false;
	try
	{
		Require(root, VTextNode::EObject, "an object in braces: {\"pairs\": [...]}");
		for (const VTextNode& rField : root.m_Items)
			ReadField(rField, o_rSetup);
		return true;
	}
	catch (const VRefused& rRefused)
	{
		o_rSetup = {};
		o_rFault = rRefused.m_Fault;
		return false;
	}
}

bool HasOnly(
    const VSetup& i_rSetup, std::initializer_list<std::string_view> i_Fields, const char* i_pUse, VFault& o_rFault)
{
	const auto& rFields = i_rSetup.m_Fields.m_Value;
	for (const auto& [rName, line] : rFields)
		if (rName != Fields::c_Comment && std::ranges::find(i_Fields, rName) == i_Fields.end())
		{
			o_rFault = {line, Quoted(rName) + " does not belong into " + i_pUse};
			return false;
		}
	if (i_Fields.size() == 1 && *i_Fields.begin() == Fields::c_Pairs && i_rSetup.m_Pairs.empty())
	{
		const auto field = std::ranges::find(rFields, Fields::c_Pairs, &std::pair<std::string, std::size_t>::first);
		o_rFault = {
		    field == rFields.end() ? 1 : field->second, std::string(i_pUse) + " needs pairs, and there are none"};
		return false;
	}
	return true;
}

} // namespace SetupIO
