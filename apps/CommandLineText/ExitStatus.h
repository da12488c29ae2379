#pragma once

#include <stdexcept>
#include <string>

namespace CommandLine
{

/// What the program returns to the shell.
enum EExitStatus : int
{
	EFine = 0,
	EFindings = 1,
	EWrongUsage = 2,
	EBadInput = 3,
	EBadOutput = 4
};

/// Ends the command: the message is told and the program returns the status. Nothing has been written then.
class VCommandError : public std::runtime_error
{
public:
	VCommandError(EExitStatus i_Status, const std::string& i_rMessage)
	    : std::runtime_error(i_rMessage), m_Status(i_Status)
	{
	}
	EExitStatus Status() const { return m_Status; }

private:
	EExitStatus m_Status;
};

} // namespace CommandLine
