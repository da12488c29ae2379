#include "SetupReview/compare/Comparison.h"
#include "SetupReview/compare/SetupElements.h"
#include "SetupReview/compare/SetupNames.h"
#include "SetupReview/compare/ValueText.h"

namespace SetupReview
{
namespace
{

class VDescription
{
public:
	explicit VDescription(const VSetup& i_rSetup) : m_Names(i_rSetup)
	{
		Describe(i_rSetup.m_Record.m_SubjectParametrised, "subject", "", "subject", 0);
		Describe(i_rSetup.m_Record.m_SubjectApplicationData, "subject", "", "subject", 0);
		Describe(i_rSetup.m_Extras, "subject", "Extras.", "subject", 0);
	}

	std::string m_Text;

private:
	/// @param i_rHead begins each line.
	template <typename T>
	void Describe(const T& i_rValue, const std::string& i_rHead, const std::string& i_rPrefix,
	    std::string_view i_Element, std::size_t i_Index)
	{
		const T byDefault{};
		CoreOrlexTypes::ForEachField<T>(
		    [&](const auto& i_rField)
		    {
			    using TMember = std::remove_cvref_t<decltype(i_rValue.*i_rField.pMember)>;
			    const TMember& rMember = i_rValue.*i_rField.pMember;
			    const std::string field = i_rPrefix + std::string(i_rField.Key);
			    if constexpr (c_bElements<TMember>)
			    {
				    using TElement = typename TMember::value_type;
				    const std::vector<std::string> names = ElementNames(m_Names, rMember);
				    const bool bNested = i_Element != "subject";
				    for (std::size_t i = 0; i < names.size(); ++i)
				    {
					    const std::string head =
					        bNested ? i_rHead : std::string(ElementName<TElement>()) + " \"" + names[i] + "\"";
					    if (!bNested && !c_bBesideSubject<TElement>)
						    Line(head);
					    Describe(rMember[i], head, bNested ? field + "[" + names[i] + "]." : i_rPrefix,
					        bNested ? i_Element : ElementName<TElement>(), i);
				    }
			    }
			    else if constexpr (c_bFields<TMember>)
				    Describe(rMember, i_rHead, field + ".", i_Element, i_Index);
			    else if (const auto reference = m_Names.Reference(i_Element, field, i_Index))
			    {
				    if (*reference != "its place" && *reference != "its depth" && *reference != "by rule"
				        && !reference->empty())
					    Line(i_rHead + " " + field + ": " + *reference);
			    }
			    else if (!SameValue(rMember, byDefault.*i_rField.pMember)
			        && !(i_rField.Key == "Name" && i_rHead.ends_with(" " + ValueText(rMember))))
				    Line(i_rHead + " " + field + ": " + ValueText(rMember));
		    });
	}

	/// Names may hold anything: each fact is one line all the same.
	void Line(const std::string& i_rText)
	{
		for (const char byte : i_rText)
			m_Text += static_cast<unsigned char>(byte) < 0x20 || byte == 0x7F ? ' ' : byte;
		m_Text += '\n';
	}

	const VSetupNames m_Names;
};

} // namespace

std::string DescribeSetup(const VSetup& i_rSetup)
{
	return VDescription(i_rSetup).m_Text;
}

} // namespace SetupReview
