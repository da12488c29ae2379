#pragma once

#include "CoreOrlexTypes/Fields.h"

#include <bit>
#include <cmath>
#include <random>

/// Fills any described value with random content: odd bytes in texts, every kind of number, short lists.
class VRandomValue
{
public:
	explicit VRandomValue(unsigned i_Seed) : m_Generator(i_Seed) {}

	void Fill(bool& o_rValue) { o_rValue = m_Generator() % 2; }
	void Fill(std::uint8_t& o_rValue) { o_rValue = std::uint8_t(m_Generator()); }
	void Fill(std::uint32_t& o_rValue) { o_rValue = m_Generator() % 4 ? std::uint32_t(m_Generator()) : 0xFFFFFFFFu; }
	void Fill(double& o_rValue) { o_rValue = std::bit_cast<double>(m_Generator() << (m_Generator() % 3 ? 0 : 40)); }

	void Fill(std::string& o_rValue)
	{
		static constexpr std::string_view c_Bytes = "ab \"\\\n\r\t[]{},:tn\x01\x7F\xC3\xFF";
		o_rValue.resize(m_Generator() % 12);
		for (char& rByte : o_rValue)
			rByte = c_Bytes[m_Generator() % c_Bytes.size()];
	}

	template <CoreOrlexTypes::CEnumeration E>
	void Fill(E& o_rValue)
	{
		const auto& rEnumerators = CoreOrlexTypes::c_Enumeration<E>.Enumerators;
		o_rValue = rEnumerators[m_Generator() % rEnumerators.size()].Value;
	}

	template <typename T, std::size_t c_Count>
	void Fill(std::array<T, c_Count>& o_rValue)
	{
		for (T& rElement : o_rValue)
			Fill(rElement);
	}

	template <typename T>
	void Fill(std::vector<T>& o_rValue)
	{
		o_rValue.resize(1 + m_Generator() % 3);
		for (T& rElement : o_rValue)
			Fill(rElement);
	}

	template <CoreOrlexTypes::CRecord T>
	void Fill(T& o_rValue)
	{
		CoreOrlexTypes::ForEachField<T>([&](const auto& i_rField) { Fill(o_rValue.*i_rField.pMember); });
	}

private:
	std::mt19937_64 m_Generator;
};
