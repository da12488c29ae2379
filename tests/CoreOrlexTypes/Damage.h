#pragma once

#include "CoreOrlexTypes/Fields.h"

#include <limits>
#include <random>

/// Calls the visitor once for each number, text or enumeration inside a value, and for each list after its elements.
template <typename T, typename TVisitor>
void ForEachLeaf(T& io_rValue, TVisitor&& i_rVisitor)
{
	if constexpr (CoreOrlexTypes::CRecord<T>)
		CoreOrlexTypes::ForEachField<T>(
		    [&](const auto& i_rField) { ForEachLeaf(io_rValue.*i_rField.pMember, i_rVisitor); });
	else if constexpr (requires { io_rValue.begin(); } && !std::is_same_v<T, std::string>)
	{
		for (auto& rElement : io_rValue)
			ForEachLeaf(rElement, i_rVisitor);
		if constexpr (requires { io_rValue.pop_back(); })
			i_rVisitor(io_rValue);
	}
	else
		i_rVisitor(io_rValue);
}

/// Makes any part of a subject wrong: sizes, indices, types, numbers and expressions.
class VDamage
{
public:
	explicit VDamage(unsigned i_Seed) : m_Generator(i_Seed) {}

	/// Changes about as many leaves as given; numbers, which are the most, more seldom than others.
	template <typename T>
	void Change(T& io_rValue, std::size_t i_Count)
	{
		std::size_t leaves = 0;
		ForEachLeaf(io_rValue, [&](auto& io_rLeaf) { leaves += Share(io_rLeaf); });
		ForEachLeaf(io_rValue,
		    [&](auto& io_rLeaf)
		    {
			    if (Below(leaves) < i_Count * Share(io_rLeaf))
				    ChangeLeaf(io_rLeaf);
		    });
	}

	std::size_t Below(std::size_t i_Limit) { return m_Generator() % i_Limit; }

private:
	template <typename T>
	static std::size_t Share(const T&)
	{
		return std::is_same_v<T, double> ? 1 : 8;
	}

	void ChangeLeaf(double& o_rValue)
	{
		using VLimits = std::numeric_limits<double>;
		static constexpr double c_Numbers[] = {
		    0, 1, -1, 1e-13, 1e308, -1e308, 5e-324, VLimits::quiet_NaN(), VLimits::infinity()};
		o_rValue = c_Numbers[Below(std::size(c_Numbers))];
	}

	void ChangeLeaf(std::uint32_t& o_rValue) { o_rValue = std::uint32_t(Below(3) ? Below(8) : 0xFFFFFFFFu - Below(2)); }

	void ChangeLeaf(std::string& o_rValue)
	{
		static constexpr const char* c_Texts[] = {"0", "", "Arm", "a*b", "1/0", "(", "x", "Arm^2", "'", "%1% %s"};
		o_rValue = c_Texts[Below(std::size(c_Texts))];
	}

	template <typename T>
	void ChangeLeaf(T& io_rValue)
	{
		if constexpr (std::is_enum_v<T>)
			io_rValue = T(int(Below(13)) - 1);
		else if constexpr (requires { io_rValue.pop_back(); })
			io_rValue.resize(Below(4) ? io_rValue.size() + Below(3) - !io_rValue.empty() : Below(4));
		else
			io_rValue = T(Below(2));
	}

	std::mt19937 m_Generator;
};
