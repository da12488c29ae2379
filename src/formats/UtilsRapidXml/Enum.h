#pragma once

#include <functional>
#include <map>
#include <string>
#include <string_view>
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

	VEnum& Add(T i_Value, const std::string& i_rText)
	{
		m_TextToValue.emplace(i_rText, i_Value);
		m_ValueToText.emplace(i_Value, i_rText);
		return *this;
	}

	bool ToValue(std::string_view i_Text, T& o_rValue) const
	{
		const auto it = m_TextToValue.find(i_Text);
		if (it == m_TextToValue.end())
			return false;
		o_rValue = it->second;
		return true;
	}

	/// Null if the value has no text. The text lives as long as the table.
	const std::string* FindText(T i_Value) const
	{
		const auto it = m_ValueToText.find(i_Value);
		return it == m_ValueToText.end() ? nullptr : &it->second;
	}

	const std::string& GetName() const override { return m_Name; }

	std::vector<std::string> GetTexts() const override
	{
		std::vector<std::string> texts;
		for (const auto& [rText, value] : m_TextToValue)
			texts.push_back(rText);
		return texts;
	}

private:
	std::string m_Name;
	std::map<std::string, T, std::less<>> m_TextToValue;
	std::map<T, std::string> m_ValueToText;
};

} // namespace UtilsRapidXml
