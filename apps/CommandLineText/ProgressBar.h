#pragma once

#include <string>

namespace CommandLine
{

/// From here on bars are shown: by a program of its own, that is, and not by what another one loads.
void AllowProgress();

/// On a terminal a line with a bar, on standard error, that goes when this does; nothing elsewhere. One at a time.
class VProgressBar
{
public:
	/// @param i_Doing stands before it: "Reading".
	explicit VProgressBar(std::string i_Doing);
	~VProgressBar();
	VProgressBar(const VProgressBar&) = delete;
	VProgressBar& operator=(const VProgressBar&) = delete;

	/// @param i_Part from 0 to 1.
	void Show(double i_Part);

private:
	const std::string m_Doing;
	const bool m_bTerminal;
	int m_Shown = -1;
};

/// Before something else is written to the terminal: a bar that stands there goes, until it is shown again.
void ClearProgress();

/// Before the process ends by a signal, of whose handler it may be called: a bar that stands there keeps its line.
void LeaveProgress();

} // namespace CommandLine
