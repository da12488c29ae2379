#include "studio/Options.h"
#include "CommandLineText/ExitStatus.h"

#include <gtest/gtest.h>

namespace
{

using StudioHost::ParseOptions;
using StudioHost::VOptions;

TEST(Options, WrongLines)
{
	const std::pair<std::vector<std::string>, const char*> rows[] = {
	    {{"--sorce", "a.qrs"}, "there is no option \"--sorce\"; did you mean \"--source\"?"},
	    {{"--fbx", "a.qrs"}, "\"a.qrs\" is no character's FBX file (.fbx)"},
	    {{"--source", "a.fbx"}, "\"a.fbx\" is no performer's skeleton (.qrs)"},
	    {{"--target", "a.fbx"}, "\"a.fbx\" is no retarget subject (.qrr, .qrx)"},
	    {{"a.txt"}, "\"a.txt\" is of no kind that can be opened: .qrs, .fbx, .qrr, .qrx or .bvh"},
	    {{"--size", "100"}, "--size: \"100\" is not WIDTHxHEIGHT with numbers from 1 to 8192"},
	    {{"--size", "0x100"}, "--size: \"0x100\""},
	    {{"--size", "100x9000"}, "--size: \"100x9000\""},
	    {{"--size", "100x100 "}, "--size: \"100x100 \""},
	    {{"--log", "FBXIO=loud"}, "\"FBXIO=loud\" is not CATEGORY=LEVEL"},
	    {{"--screenshot"}, "--screenshot"},
	    {{"--frame", "3"}, "--take"},
	    {{"--open", "recipe"}, "--open"},
	};
	for (const auto& [rArguments, pMessage] : rows)
	{
		std::string text;
		try
		{
			ParseOptions(rArguments, text);
			ADD_FAILURE() << pMessage;
		}
		catch (const CommandLine::VCommandError& rError)
		{
			EXPECT_EQ(rError.Status(), CommandLine::EWrongUsage);
			EXPECT_NE(std::string(rError.what()).find(pMessage), std::string::npos) << rError.what();
		}
	}
}

TEST(Options, HelpAndVersionAreText)
{
	std::string text;
	EXPECT_FALSE(ParseOptions({"--help"}, text));
	for (const char* pOption : {"--source", "--fbx", "--target", "--take", "--frame", "--open", "--screenshot",
	         "--size", "--module", "--settings", "--developer", "--version", "Exit status"})
		EXPECT_NE(text.find(pOption), std::string::npos) << pOption;
	EXPECT_FALSE(ParseOptions({"--version"}, text));
	EXPECT_EQ(text, "retarget-studio " RETARGET_VERSION "\n");
	EXPECT_FALSE(ParseOptions({"--manual"}, text));
	for (const char* pText : {".TH RETARGET\\-STUDIO 1 ", "\\-\\-screenshot OUT.png", ".B FILE", "Exit status"})
		EXPECT_NE(text.find(pText), std::string::npos) << pText;
	EXPECT_EQ(text.find("manual"), std::string::npos) << "a hidden option";
}

TEST(Options, FilesInTheOrderOfTheirKinds)
{
	std::string text;
	const auto options =
	    ParseOptions({"x.qrr", "--target", "a.qrr", "--fbx", "a.fbx", "--source", "a.qrs", "--module", "m.so",
	                     "--settings", "s.ini", "--screenshot", "o.png", "--developer", "-v", "-v"},
	        text);
	ASSERT_TRUE(options);
	EXPECT_EQ(options->m_Files, (QStringList{"a.qrs", "a.fbx", "a.qrr", "x.qrr"}));
	EXPECT_EQ(options->m_Module, "m.so");
	EXPECT_EQ(options->m_Settings, "s.ini");
	EXPECT_EQ(options->m_Screenshot, "o.png");
	EXPECT_EQ(options->m_Size, QSize(1280, 800));
	EXPECT_TRUE(options->m_bDeveloper);
	EXPECT_EQ(options->m_Messages.m_Verbose, 2);
	EXPECT_EQ(ParseOptions({"--size", "1920x1080"}, text)->m_Size, QSize(1920, 1080));
	EXPECT_FALSE(ParseOptions({}, text)->m_Size.isValid());
}

} // namespace
