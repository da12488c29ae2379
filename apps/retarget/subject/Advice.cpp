#include "retarget/subject/Advice.h"

#include "CommandLineText/ExitStatus.h"
#include "retarget/text/InputFile.h"

namespace CommandLine
{

SetupReview::VAdvice AdviceOn(VSession& io_rSession, const std::string& i_rFbx)
{
	auto advice = SetupReview::AdviceOn(io_rSession.Document().SourceValues(), io_rSession.Document().TargetValues(),
	    i_rFbx.empty() ? "" : InputPath(i_rFbx));
	if (!advice)
		throw VCommandError(EBadInput, "\"" + i_rFbx + "\" could not be read whole as FBX");
	return *std::move(advice);
}

} // namespace CommandLine
