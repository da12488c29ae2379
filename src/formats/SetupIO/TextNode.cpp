#include "SetupIO/TextNode.h"

#include "SetupIO/Limits.h"
#include "math/NumberText.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <iterator>
#include <utility>

namespace SetupIO
{
namespace
{

/// What the parser has taken so far.
struct VProgress
{
	std::size_t m_Line = 1;
	char m_Last = '\0';
};

/// Gives the parser the text and counts its lines.
class VCounting
{
public:
	using iterator_category = std::input_iterator_tag;
	using value_type = char;
	using difference_type = std::ptrdiff_t;
	using pointer = const char*;
	using reference = const char&;

	VCounting(const char* i_pAt, VProgress& io_rProgress) : m_pAt(i_pAt), m_pProgress(&io_rProgress) {}
	reference operator*() const { return *m_pAt; }
	VCounting& operator++()
	{
		m_pProgress->m_Last = *m_pAt++;
		m_pProgress->m_Line += m_pProgress->m_Last == '\n';
		return *this;
	}
	bool operator==(const VCounting& i_rOther) const { return m_pAt == i_rOther.m_pAt; }

private:
	const char* m_pAt;
	VProgress* m_pProgress;
};

/// Builds the tree; false from any function ends the parse.
class VBuilder : public nlohmann::json_sax<nlohmann::json>
{
public:
	VBuilder(const VProgress& i_rProgress, VTextNode& o_rRoot, VFault& o_rFault)
	    : m_rProgress(i_rProgress), m_rRoot(o_rRoot), m_rFault(o_rFault)
	{
	}

	bool null() override { return Add(VTextNode::ENull); }
	bool boolean(bool i_bTrue) override { return Add(VTextNode::EBoolean, {}, 0.0, i_bTrue); }
	bool number_integer(number_integer_t i_Value) override
	{
		return Add(VTextNode::ENumber, std::to_string(i_Value), double(i_Value));
	}
	bool number_unsigned(number_unsigned_t i_Value) override
	{
		return Add(VTextNode::ENumber, std::to_string(i_Value), double(i_Value));
	}
	/// The text that comes along has the decimal point of the process's language.
	bool number_float(number_float_t i_Value, const string_t& /*i_rText*/) override
	{
		return Add(VTextNode::ENumber, NumberText::PrintShortest(i_Value), i_Value);
	}
	bool string(string_t& i_rText) override { return Add(VTextNode::EText, std::move(i_rText)); }
	bool binary(binary_t&) override { return false; }
	bool start_object(std::size_t) override { return Open(VTextNode::EObject); }
	bool start_array(std::size_t) override { return Open(VTextNode::EList); }
	bool key(string_t& i_rName) override
	{
		m_Name = std::move(i_rName);
		if (m_Open.back()->m_Items.size() == Limits::c_Members)
			return Refuse("an object has more than " + std::to_string(Limits::c_Members) + " members");
		for (const VTextNode& rItem : m_Open.back()->m_Items)
			if (rItem.m_Name == m_Name)
				return Refuse("\"" + m_Name + "\" stands there twice, first in line " + std::to_string(rItem.m_Line));
		return true;
	}
	bool end_object() override { return Close(); }
	bool end_array() override { return Close(); }
	bool parse_error(std::size_t, const std::string&, const nlohmann::detail::exception& i_rException) override
	{
		// Its own texts begin with a number in brackets and the place.
		const std::string text = i_rException.what();
		const std::size_t detail = text.rfind(" - ");
		// The only other thing that it refuses.
		return Refuse(detail == std::string::npos ? "a number is larger than any that can be held"
		                                          : "this is no JSON: " + text.substr(detail + 3));
	}

private:
	bool Refuse(std::string i_Reason)
	{
		m_rFault = {m_rProgress.m_Line, std::move(i_Reason)};
		return false;
	}

	/// False if there are too many, which is then the fault.
	bool Add(VTextNode::EKind i_Kind, std::string i_Text = {}, double i_Number = 0.0, bool i_bTrue = false)
	{
		if (++m_Count > Limits::c_Values)
			return Refuse("there are more than " + std::to_string(Limits::c_Values) + " values");
		m_pLast = m_Open.empty() ? &m_rRoot : &m_Open.back()->m_Items.emplace_back();
		// The parser knows that a number ends by what stands behind it.
		const bool bBehind = i_Kind == VTextNode::ENumber && m_rProgress.m_Last == '\n';
		*m_pLast = {
		    i_Kind, m_rProgress.m_Line - bBehind, std::exchange(m_Name, {}), std::move(i_Text), i_Number, i_bTrue, {}};
		return true;
	}

	bool Open(VTextNode::EKind i_Kind)
	{
		if (m_Open.size() == Limits::c_Depth)
			return Refuse("it is nested more than " + std::to_string(Limits::c_Depth) + " deep");
		if (!Add(i_Kind))
			return false;
		// What is open stays where it is: only the last one of all grows.
		m_Open.push_back(m_pLast);
		return true;
	}

	bool Close()
	{
		m_Open.pop_back();
		return true;
	}

	const VProgress& m_rProgress;
	VTextNode& m_rRoot;
	VFault& m_rFault;
	std::vector<VTextNode*> m_Open;
	VTextNode* m_pLast = nullptr;
	/// Of the member whose value comes next.
	std::string m_Name;
	std::size_t m_Count = 0;
};

} // namespace

bool ParseText(std::string_view i_Text, VTextNode& o_rNode, VFault& o_rFault)
{
	o_rNode = {};
	o_rFault = {};
	if (i_Text.size() > Limits::c_FileBytes)
	{
		o_rFault.m_Reason = "it is larger than " + std::to_string(Limits::c_FileBytes) + " bytes";
		return false;
	}
	VProgress progress;
	VBuilder builder(progress, o_rNode, o_rFault);
	const bool bParsed = nlohmann::json::sax_parse(
	    VCounting(i_Text.data(), progress), VCounting(i_Text.data() + i_Text.size(), progress), &builder);
	if (!bParsed)
		o_rNode = {};
	return bParsed;
}

} // namespace SetupIO
