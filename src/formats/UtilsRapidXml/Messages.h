#pragma once

#include <boost/format.hpp>

#include <cstddef>
#include <locale>
#include <string>
#include <vector>

namespace UtilsRapidXml
{

/// The errors or the warnings of one document. All are counted; once they take c_MaximumMessageBytes together, further
/// ones are neither made nor kept.
class VMessages
{
public:
	void Add(const std::string& i_rText);

	/// A message with %1%-style placeholders. An argument that is a function is called for its text only if the
	/// message is kept.
	template <typename... VArguments>
	void Add(const char* i_pFormat, const VArguments&... i_rArguments)
	{
		if (IsFull())
			++m_Count;
		else
			// Numbers as they are, whatever the process' locale groups.
			Add((boost::format(i_pFormat, std::locale::classic()) % ... % Value(i_rArguments)).str());
	}

	std::size_t GetCount() const { return m_Count; }

	/// The messages so far, with a last one that tells how many more there were.
	std::vector<std::string> GetTexts() const;

private:
	bool IsFull() const;

	template <typename T>
	static decltype(auto) Value(const T& i_rArgument)
	{
		if constexpr (requires { i_rArgument(); })
			return i_rArgument();
		else
			return (i_rArgument);
	}

	std::vector<std::string> m_Texts;
	std::size_t m_Bytes = 0;
	std::size_t m_Count = 0;
};

} // namespace UtilsRapidXml
