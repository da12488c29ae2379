#pragma once

#include <algorithm>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace UtilsRapidXml
{

/// A named text-to-value table.
class IEnum
{
public:
	virtual ~IEnum() = default;
	/// The type name, such as "TYPE_DRAW-STYLE".
	virtual const std::string& GetName() const = 0;
	/// All texts in ascending order.
	virtual std::vector<std::string> GetTexts() const = 0;
};

template <typename T>
class VEnum final : public IEnum
{
public:
	explicit VEnum(std::string i_Name) : m_Name(std::move(i_Name)) {}

	VEnum& Add(T i_Value, std::string i_Text)
	{
		m_Entries.emplace_back(i_Value, std::move(i_Text));
		return *this;
	}

	bool ToValue(std::string_view i_Text, T& o_rValue) const
	{
		for (const auto& [value, rText] : m_Entries)
			if (rText == i_Text)
			{
				o_rValue = value;
				return true;
			}
		return false;
	}

	/// Null if the value has no text. The text lives as long as the table.
	const std::string* FindText(T i_Value) const
	{
		for (const auto& [value, rText] : m_Entries)
			if (value == i_Value)
				return &rText;
		return nullptr;
	}

	const std::string& GetName() const override { return m_Name; }

	std::vector<std::string> GetTexts() const override
	{
		std::vector<std::string> texts;
		for (const auto& [value, rText] : m_Entries)
			texts.push_back(rText);
		std::sort(texts.begin(), texts.end());
		return texts;
	}

private:
	std::string m_Name;
	/// A handful, fewer than a tree would be worth.
	std::vector<std::pair<T, std::string>> m_Entries;
};

} // namespace UtilsRapidXml
