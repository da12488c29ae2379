#pragma once

#include "CommandLineText/ExitStatus.h"

namespace CommandLine
{

/// What a program says and returns where it finds no display.
struct VWithoutDisplay
{
	/// Of the message.
	const char* m_pCategory;
	EExitStatus m_Status;
	const char* m_pSentence;
};

/// To be called before Qt opens the display. Qt's messages go to the log from here on, and a display that cannot be
/// opened, for which Qt would abort, ends the process as told. Throws VCommandError if none is named at all.
void PrepareDisplay(const VWithoutDisplay& i_rWithout);

} // namespace CommandLine
