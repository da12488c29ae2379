#include "RetargetSetupCore/SideOfName.h"

#include <string>

namespace RetargetSetup
{
namespace
{

bool IsUpper(char i_Byte)
{
	return i_Byte >= 'A' && i_Byte <= 'Z';
}

bool IsLower(char i_Byte)
{
	return i_Byte >= 'a' && i_Byte <= 'z';
}

/// Whether a word begins here that no other byte than a letter before it would tell: "leftArm", "LArm".
bool BeginsInCamelCase(std::string_view i_Name, std::size_t i_At)
{
	return i_At > 0 && IsUpper(i_Name[i_At])
	    && (!IsUpper(i_Name[i_At - 1]) || (i_At + 1 < i_Name.size() && IsLower(i_Name[i_At + 1])));
}

} // namespace

ESide SideOfName(std::string_view i_Name)
{
	i_Name.remove_prefix(i_Name.rfind(':') + 1);
	bool bLeft = false;
	bool bRight = false;
	std::string word;
	const auto endWord = [&]
	{
		bLeft |= word == "l" || word.starts_with("left");
		bRight |= word == "r" || word.starts_with("right");
		word.clear();
	};
	for (std::size_t i = 0; i < i_Name.size(); ++i)
	{
		const bool bLetter = IsUpper(i_Name[i]) || IsLower(i_Name[i]);
		if (!bLetter || BeginsInCamelCase(i_Name, i))
			endWord();
		if (bLetter)
			word += IsUpper(i_Name[i]) ? char(i_Name[i] - 'A' + 'a') : i_Name[i];
	}
	endWord();
	return bLeft == bRight ? ESide::None : bLeft ? ESide::Left : ESide::Right;
}

} // namespace RetargetSetup
