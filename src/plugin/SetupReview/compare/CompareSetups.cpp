#include "SetupReview/compare/ChangeWords.h"
#include "SetupReview/compare/Comparison.h"
#include "SetupReview/compare/SetupElements.h"
#include "SetupReview/compare/SetupNames.h"
#include "SetupReview/compare/ValueText.h"

#include <algorithm>
#include <map>

namespace SetupReview
{
namespace
{

/// Of the extras, of which there is one for each element of the subject.
template <typename T>
bool HoldsMoreThanName(const T& i_rElement)
{
	bool bMore = false;
	const T byDefault{};
	CoreOrlexTypes::ForEachField<T>(
	    [&](const auto& i_rField)
	    {
		    if constexpr (requires { i_rElement.*i_rField.pMember == byDefault.*i_rField.pMember; })
			    bMore =
			        bMore || (i_rField.Key != "Name" && !(i_rElement.*i_rField.pMember == byDefault.*i_rField.pMember));
	    });
	return bMore;
}

class VComparison
{
public:
	VComparison(const VSetup& i_rBefore, const VSetup& i_rAfter)
	    : m_Expressions(i_rBefore, i_rAfter), m_Before(i_rBefore), m_After(i_rAfter)
	{
		const CoreOrlexTypes::VSubjectRecord& rBefore = i_rBefore.m_Record;
		const CoreOrlexTypes::VSubjectRecord& rAfter = i_rAfter.m_Record;
		CompareFields(rBefore.m_SubjectParametrised, rAfter.m_SubjectParametrised, {});
		CompareFields(rBefore.m_SubjectApplicationData, rAfter.m_SubjectApplicationData, {});
		CompareFields(i_rBefore.m_Extras, i_rAfter.m_Extras, {.m_Field = "Extras"});
	}

	std::vector<VSetupChange> m_Changes;

private:
	/// Where two values stand that belong together.
	struct VPlace
	{
		std::string m_Element = "subject";
		std::string m_Name{};
		std::string m_Field{};
		std::size_t m_Before = 0;
		std::size_t m_After = 0;
	};

	VSetupChange& Tell(const VPlace& i_rPlace, std::string i_Id, std::string i_Words)
	{
		VSetupChange& rChange = m_Changes.emplace_back();
		std::ranges::replace(i_Id, ' ', '-');
		rChange.m_Id = std::move(i_Id);
		rChange.m_Element = i_rPlace.m_Element;
		rChange.m_Name = i_rPlace.m_Name;
		rChange.m_Field = i_rPlace.m_Field;
		rChange.m_Words = std::move(i_Words);
		return rChange;
	}

	template <typename T>
	void CompareFields(const T& i_rBefore, const T& i_rAfter, const VPlace& i_rPlace)
	{
		CoreOrlexTypes::ForEachField<T>(
		    [&](const auto& i_rField)
		    {
			    using TMember = std::remove_cvref_t<decltype(i_rBefore.*i_rField.pMember)>;
			    const TMember& rBefore = i_rBefore.*i_rField.pMember;
			    const TMember& rAfter = i_rAfter.*i_rField.pMember;
			    VPlace place = i_rPlace;
			    (place.m_Field += place.m_Field.empty() ? "" : ".") += i_rField.Key;
			    if constexpr (c_bElements<TMember>)
				    CompareElements(rBefore, rAfter, place);
			    else if constexpr (c_bFields<TMember>)
				    CompareFields(rBefore, rAfter, place);
			    else
				    CompareValues(rBefore, rAfter, place);
		    });
	}

	template <typename T>
	void CompareValues(const T& i_rBefore, const T& i_rAfter, const VPlace& i_rPlace)
	{
		std::string before;
		std::string after;
		if (const auto reference = m_Before.Reference(i_rPlace.m_Element, i_rPlace.m_Field, i_rPlace.m_Before))
		{
			before = *reference;
			after = m_After.Reference(i_rPlace.m_Element, i_rPlace.m_Field, i_rPlace.m_After).value_or("");
			if (before == after)
				return;
		}
		else if (SameValue(i_rBefore, i_rAfter))
			return;
		else
		{
			before = ValueText(i_rBefore);
			after = ValueText(i_rAfter);
		}
		VSetupChange& rChange = Tell(i_rPlace, "field", i_rPlace.m_Field + " " + before + " -> " + after);
		rChange.m_Before = std::move(before);
		rChange.m_After = std::move(after);
		if (!PutInWords(m_Expressions, i_rPlace.m_Before, i_rPlace.m_After, rChange))
			m_Changes.pop_back();
	}

	template <typename T>
	void CompareElements(const std::vector<T>& i_rBefore, const std::vector<T>& i_rAfter, const VPlace& i_rPlace)
	{
		constexpr const char* c_pElement = ElementName<T>();
		constexpr bool c_bBeside = c_bBesideSubject<T>;
		const std::vector<std::string> before = ElementNames(m_Before, i_rBefore);
		const std::vector<std::string> after = ElementNames(m_After, i_rAfter);
		std::map<std::string_view, std::size_t> places;
		for (std::size_t i = 0; i < after.size(); ++i)
			places.emplace(after[i], i);
		const bool bNested = !i_rPlace.m_Name.empty();
		const auto placeOf = [&](const std::string& i_rName)
		{
			VPlace place = i_rPlace;
			place.m_Element = bNested ? i_rPlace.m_Element : c_pElement;
			place.m_Name = bNested ? i_rPlace.m_Name : i_rName;
			place.m_Field = bNested                      ? i_rPlace.m_Field + "[" + i_rName + "]"
			    : i_rPlace.m_Field.starts_with("Extras") ? "Extras"
			                                             : "";
			return place;
		};
		const auto tellWhole = [&](const T& i_rElement, const std::string& i_rName, const char* i_pWhat)
		{
			// What is drawn of an element, and an extra that holds nothing, come and go with the element.
			const bool bExtra = i_rPlace.m_Field.starts_with("Extras");
			if (c_bBeside ? Stands(m_Before, i_rName, c_pElement) != Stands(m_After, i_rName, c_pElement)
			              : bExtra && !HoldsMoreThanName(i_rElement))
				return;
			const std::string begin = c_bBeside ? "what is drawn of it was "
			    : bExtra                        ? "what only the file holds of it was "
			                                    : "";
			Tell(placeOf(i_rName), std::string(c_pElement) + "-" + i_pWhat, begin + i_pWhat);
		};
		std::vector<bool> found(after.size());
		std::size_t last = 0;
		bool bOrder = true;
		for (std::size_t i = 0; i < before.size(); ++i)
		{
			const auto match = places.find(before[i]);
			if (match == places.end() || found[match->second])
			{
				tellWhole(i_rBefore[i], before[i], "removed");
				continue;
			}
			found[match->second] = true;
			bOrder = bOrder && match->second >= last;
			last = match->second;
			VPlace place = placeOf(before[i]);
			place.m_Before = i;
			place.m_After = match->second;
			CompareFields(i_rBefore[i], i_rAfter[match->second], place);
		}
		for (std::size_t i = 0; i < after.size(); ++i)
			if (!found[i])
				tellWhole(i_rAfter[i], after[i], "added");
		if (!bOrder && !c_bBeside)
			Tell({.m_Field = i_rPlace.m_Field}, "order",
			    "the " + std::string(c_pElement) + "s stand in another order"
			        + (bNested ? " in " + i_rPlace.m_Name : ""));
	}

	const VExpressions m_Expressions;
	const VSetupNames m_Before;
	const VSetupNames m_After;
};

} // namespace

std::vector<VSetupChange> CompareSetups(const VSetup& i_rBefore, const VSetup& i_rAfter)
{
	return VComparison(i_rBefore, i_rAfter).m_Changes;
}

std::string ChangeLine(const VSetupChange& i_rChange)
{
	return i_rChange.m_Element + (i_rChange.m_Name.empty() ? "" : " \"" + i_rChange.m_Name + "\"") + ": "
	    + i_rChange.m_Words;
}

} // namespace SetupReview
