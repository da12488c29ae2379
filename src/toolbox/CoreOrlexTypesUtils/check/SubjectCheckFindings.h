#pragma once

#include "CoreOrlexTypesUtils/check/SubjectFinding.h"

#include <optional>
#include <set>
#include <string_view>
#include <tuple>
#include <utility>
#include <vector>

namespace CoreOrlexTypesUtils::SubjectCheck
{

/// Takes what the checks find, in their order, and decides how far they go.
class IFindings
{
public:
	virtual ~IFindings() = default;

	/// The message may be empty; the line that sums it up tells of it then.
	virtual void Found(VSubjectFinding i_Finding) = 0;
	/// A line that introduces findings or sums up those of an element.
	virtual void Line(const std::string& i_rText) = 0;
	/// Whether steps follow one that failed.
	virtual bool GoesOn() const = 0;

	/// Runs steps that return whether all is well.
	template <typename... TSteps>
	bool InTurn(TSteps&&... i_rSteps) const
	{
		bool bGood = true;
		((bGood = i_rSteps() && bGood, bGood || GoesOn()) && ...);
		return bGood;
	}

	/// The same with one step for each element of a list.
	template <typename TStep>
	bool ForEach(std::size_t i_Count, TStep&& i_rStep) const
	{
		bool bGood = true;
		for (std::size_t i = 0; i < i_Count && (bGood || GoesOn()); ++i)
			bGood = i_rStep(i) && bGood;
		return bGood;
	}
};

/// To the log. Ends at the first step that fails.
class VLoggedFindings final : public IFindings
{
public:
	void Found(VSubjectFinding i_Finding) override { Line(i_Finding.m_Message); }
	void Line(const std::string& i_rText) override;
	bool GoesOn() const override { return false; }
};

/// As a list without repetitions, in which a summing line stands only where there is no other message.
class VListedFindings final : public IFindings
{
public:
	void Found(VSubjectFinding i_Finding) override;
	void Line(const std::string& i_rText) override;
	bool GoesOn() const override { return true; }

	std::vector<VSubjectFinding> Take() { return std::move(m_List); }

private:
	using VKey = std::tuple<VSubjectFinding::EElement, std::size_t, std::string, std::string>;

	std::vector<VSubjectFinding> m_List;
	std::set<VKey> m_Known;
	/// A finding that waits for the line that tells of it.
	std::optional<std::size_t> m_Unsaid;
};

/// The findings of one element.
class VReport
{
public:
	/// The name must outlive the report.
	VReport(
	    IFindings& io_rFindings, VSubjectFinding::EElement i_Element, std::size_t i_Index, std::string_view i_Name = {})
	    : m_rFindings(io_rFindings), m_Element(i_Element), m_Index(i_Index), m_Name(i_Name)
	{
	}

	/// Always false, so that a check can end with it.
	bool Fail(std::string i_Message, std::string i_Remedy) const
	{
		m_rFindings.Found({m_Element, m_Index, std::string(m_Name), std::move(i_Message), std::move(i_Remedy), false});
		return false;
	}

	/// Tells, although the element passes: always true.
	bool Tolerate(std::string i_Message, std::string i_Remedy) const
	{
		m_rFindings.Found({m_Element, m_Index, std::string(m_Name), std::move(i_Message), std::move(i_Remedy), true});
		return true;
	}

	IFindings& Findings() const { return m_rFindings; }

private:
	IFindings& m_rFindings;
	VSubjectFinding::EElement m_Element;
	std::size_t m_Index;
	std::string_view m_Name;
};

} // namespace CoreOrlexTypesUtils::SubjectCheck
