#include "../Require.h"
#include "../XmlTree.h"

#include "CoreOrlexQRTIO/Reader.h"
#include "CoreOrlexQRTIO/Writer.h"

using namespace CoreOrlexQRTIO;

namespace
{

struct VContent
{
	CoreOrlexTypes::VSubjectParametrised m_Subject;
	CoreOrlexTypes::VSubjectApplicationData m_ApplicationData;
	VSubjectQRTExtras m_Extras;
	std::vector<std::string> m_Errors;
	std::vector<std::string> m_Warnings;
};

bool Read(const std::string& i_rText, VContent& o_rContent)
{
	return VReader().ReadText(i_rText, "Template", 1, o_rContent.m_Subject, o_rContent.m_ApplicationData,
	    o_rContent.m_Extras, o_rContent.m_Errors, o_rContent.m_Warnings);
}

bool Write(const VContent& i_rContent, std::uint32_t i_Version, std::string& o_rText)
{
	std::vector<std::string> errors;
	std::vector<std::string> warnings;
	const bool bWritten = VWriter().WriteText(
	    i_rContent.m_Subject, i_rContent.m_ApplicationData, i_rContent.m_Extras, i_Version, o_rText, errors, warnings);
	Require(bWritten == errors.empty(), "a failed write has a reason");
	return bWritten;
}

} // namespace

extern "C" std::size_t LLVMFuzzerCustomMutator(
    std::uint8_t* io_pData, std::size_t i_Size, std::size_t i_MaximumSize, unsigned int i_Seed)
{
	return XmlTree::Mutate(io_pData, i_Size, i_MaximumSize, i_Seed);
}

/// What was read and written is read again, and is written the same from then on.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	VContent content;
	const bool bRead = Read(std::string(reinterpret_cast<const char*>(i_pData), i_Size), content);
	Require(bRead == content.m_Errors.empty(), "a failed read has a reason");
	std::string first;
	if (!bRead || !Write(content, c_AutomaticVersion, first))
		return 0;
	VContent again;
	Require(Read(first, again), "what is written can be read");
	std::string second;
	Require(Write(again, c_AutomaticVersion, second), "what was read can be written");
	VContent third;
	Require(Read(second, third), "what is written again can be read");
	Require(again.m_Subject == third.m_Subject, "the subject comes back equal");
	Require(again.m_ApplicationData == third.m_ApplicationData, "the application data come back equal");
	Require(again.m_Extras == third.m_Extras, "the extras come back equal");
	Require(first == second, "a second write is the same");
	return 0;
}
