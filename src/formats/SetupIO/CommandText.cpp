#include "SetupIO/CommandText.h"

#include "SetupIO/SetupFields.h"

#include <algorithm>
#include <string_view>

namespace SetupIO
{
std::string ForShell(const std::string& i_rWord)
{
	static constexpr std::string_view c_Plain = "+,-./:=@_%";
	const bool bPlain = !i_rWord.empty()
	    && std::ranges::all_of(i_rWord,
	        [](char i_Byte)
	        {
		        return (i_Byte >= '0' && i_Byte <= '9') || (i_Byte >= 'A' && i_Byte <= 'Z')
		            || (i_Byte >= 'a' && i_Byte <= 'z') || c_Plain.find(i_Byte) != std::string_view::npos;
	        });
	if (bPlain)
		return i_rWord;
	std::string text = "'";
	for (const char byte : i_rWord)
		text += byte == '\'' ? "'\\''" : std::string(1, byte);
	return text + "'";
}

std::string CommandText(const VSetup& i_rRecipe)
{
	std::string text = "retarget " + (i_rRecipe.m_Fbx.empty() ? "edit " + ForShell(i_rRecipe.m_Subject) : "create");
	const auto add = [&](const std::string& i_rName, const std::string& i_rValue)
	{
		// A value that begins with a dash is no option.
		text += " \\\n  " + i_rName + (i_rValue.starts_with('-') ? "=" : " ") + ForShell(i_rValue);
	};
	const auto addText = [&](const char* i_pName, const std::string& i_rValue)
	{
		if (!i_rValue.empty())
			add("--" + std::string(i_pName), i_rValue);
	};
	addText("fbx", i_rRecipe.m_Fbx);
	addText("source", i_rRecipe.m_Source);
	addText(Fields::c_Root, i_rRecipe.m_Root);
	addText(Fields::c_RootHeight, i_rRecipe.m_RootHeight);
	for (const VEdit& rEdit : i_rRecipe.m_Edits)
		if (rEdit.m_Value)
			add("--" + rEdit.m_Name, *rEdit.m_Value);
		else
			text += " \\\n  --" + rEdit.m_Name;
	add("-o", i_rRecipe.m_Output);
	return text + "\n";
}

} // namespace SetupIO
