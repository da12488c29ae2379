#include "SetupIO/WriteSetup.h"

#include "SetupIO/SetupFields.h"

#include <nlohmann/json.hpp>

namespace SetupIO
{
namespace
{

using VJson = nlohmann::ordered_json;

std::string Scalar(const VJson& i_rValue)
{
	return i_rValue.dump(-1, ' ', false, VJson::error_handler_t::replace);
}

/// An object or a list of scalars in one line.
std::string Line(const VJson& i_rValue)
{
	if (!i_rValue.is_structured())
		return Scalar(i_rValue);
	std::string text;
	for (auto it = i_rValue.begin(); it != i_rValue.end(); ++it)
		text +=
		    (text.empty() ? "" : ", ") + (i_rValue.is_object() ? Scalar(it.key()) + ": " : std::string()) + Line(*it);
	return i_rValue.is_object() ? "{" + text + "}" : "[" + text + "]";
}

/// A list of structures with one of them on a line.
std::string Lines(const VJson& i_rList)
{
	std::string text;
	for (const VJson& rItem : i_rList)
		text += (text.empty() ? "\n\t\t" : ",\n\t\t") + Line(rItem);
	return "[" + text + "\n\t]";
}

/// Fields that are there: a text that is not empty, a flag that is set, a number that is given.
template <typename TFields, typename TOwner>
void Put(const TFields& i_rFields, const TOwner& i_rOwner, VJson& io_rJson)
{
	for (const auto& rField : i_rFields)
	{
		const auto& rValue = i_rOwner.*rField.m_pMember;
		if constexpr (requires { rValue.has_value(); })
		{
			if (rValue)
				io_rJson[rField.m_pName] = *rValue;
		}
		else if constexpr (requires { rValue.empty(); })
		{
			if (!rValue.empty())
				io_rJson[rField.m_pName] = rValue;
		}
		else if (rValue)
			io_rJson[rField.m_pName] = true;
	}
}

VJson ToJson(const VPair& i_rPair)
{
	VJson json = VJson::object();
	Put(Fields::c_PairTexts, i_rPair, json);
	Put(Fields::c_PairWeights, i_rPair, json);
	return json;
}

VJson ToJson(const VEdit& i_rEdit)
{
	VJson json = VJson::object();
	if (i_rEdit.m_Value)
		json[i_rEdit.m_Name] = *i_rEdit.m_Value;
	else
		json[i_rEdit.m_Name] = true;
	if (!i_rEdit.m_Comment.empty())
		json[Fields::c_Comment] = i_rEdit.m_Comment;
	return json;
}

template <typename T>
VJson ToJson(const std::vector<T>& i_rList)
{
	VJson list = VJson::array();
	for (const T& rItem : i_rList)
		list.push_back(ToJson(rItem));
	return list;
}

VJson ToJson(const VChecks& i_rChecks)
{
	VJson json = VJson::object();
	Put(Fields::c_CheckFlags, i_rChecks, json);
	Put(Fields::c_CheckCounts, i_rChecks, json);
	Put(Fields::c_CheckLimits, i_rChecks, json);
	if (!i_rChecks.m_Pose.empty())
		json[Fields::c_Pose] = i_rChecks.m_Pose;
	return json;
}

VJson Described(VJson i_Schema, const std::string& i_rHelp)
{
	i_Schema["description"] = i_rHelp;
	return i_Schema;
}

template <typename TFields>
void PutSchema(const TFields& i_rFields, const VJson& i_rType, VJson& io_rProperties)
{
	for (const auto& rField : i_rFields)
		io_rProperties[rField.m_pName] = Described(i_rType, rField.m_pHelp);
}

VJson ObjectSchema(const VJson& i_rProperties)
{
	return {{"type", "object"}, {"properties", i_rProperties}, {"additionalProperties", false}};
}

} // namespace

std::string WriteSetup(const VSetup& i_rSetup)
{
	VJson texts = VJson::object();
	Put(Fields::c_Texts, i_rSetup, texts);
	std::string text;
	const auto add = [&](const char* i_pName, const std::string& i_rValue)
	{ text += (text.empty() ? "{\n\t" : ",\n\t") + Scalar(i_pName) + ": " + i_rValue; };
	for (auto it = texts.begin(); it != texts.end(); ++it)
		add(it.key().c_str(), Scalar(*it));
	if (!i_rSetup.m_Pairs.empty())
		add(Fields::c_Pairs, Lines(ToJson(i_rSetup.m_Pairs)));
	if (!i_rSetup.m_Edits.empty())
		add(Fields::c_Edits, Lines(ToJson(i_rSetup.m_Edits)));
	if (i_rSetup.m_Checks)
		add(Fields::c_Checks, Line(ToJson(*i_rSetup.m_Checks)));
	return (text.empty() ? "{" : text) + "\n}\n";
}

std::string SchemaText(const std::vector<VEditForm>& i_rEdits)
{
	const VJson text{{"type", "string"}};
	const VJson weight{{"type", "number"}, {"minimum", 0}};
	VJson pair = VJson::object();
	PutSchema(Fields::c_PairTexts, text, pair);
	PutSchema(Fields::c_PairWeights, weight, pair);
	VJson pairs{{"type", "array"}, {"items", ObjectSchema(pair)}, {"description", Fields::c_PairsHelp}};
	pairs["items"]["required"] = {"source", "target"};

	VJson edit{{Fields::c_Comment, Described(text, Fields::c_CommentHelp)}};
	for (const VEditForm& rEdit : i_rEdits)
		edit[rEdit.m_Name] =
		    Described(rEdit.m_bValue ? VJson{{"type", {"string", "number"}}} : VJson{{"const", true}}, rEdit.m_Help);

	VJson checks{{Fields::c_Comment, Described(text, Fields::c_CommentHelp)}};
	PutSchema(Fields::c_CheckFlags, {{"type", "boolean"}}, checks);
	PutSchema(Fields::c_CheckCounts, {{"type", "integer"}, {"minimum", 0}}, checks);
	PutSchema(Fields::c_CheckLimits, weight, checks);
	checks[Fields::c_Pose] = Described(
	    {{"type", "array"}, {"items", {{"type", "string"}, {"enum", Fields::c_PoseIds}}}}, Fields::c_PoseHelp);

	VJson properties = VJson::object();
	PutSchema(Fields::c_Texts, text, properties);
	properties[Fields::c_Root]["type"] = {"string", "integer"};
	properties[Fields::c_RootHeight]["enum"] = {Fields::c_Keep, Fields::c_Scale};
	properties[Fields::c_Pairs] = pairs;
	properties[Fields::c_Edits] = {
	    {"type", "array"}, {"items", ObjectSchema(edit)}, {"description", Fields::c_EditsHelp}};
	properties[Fields::c_Edits]["items"]["maxProperties"] = 2;
	properties[Fields::c_Checks] = Described(ObjectSchema(checks), Fields::c_ChecksHelp);

	VJson schema{{"$schema", "https://json-schema.org/draft/2020-12/schema"},
	    {"title", "A set-up: a mapping, a preset, edits or a recipe"}};
	schema.update(ObjectSchema(properties));
	return schema.dump(1, '\t', false, VJson::error_handler_t::replace) + "\n";
}

} // namespace SetupIO
