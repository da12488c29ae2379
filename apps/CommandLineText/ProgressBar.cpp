#include "CommandLineText/ProgressBar.h"

#include "CommandLineText/Messages.h"
#include "CommandLineText/System.h"

#include <algorithm>
#include <atomic>
#include <cstdio>
#include <string_view>
#include <unistd.h>
#include <utility>

namespace CommandLine
{
namespace
{

constexpr int c_Width = 40;

std::atomic<bool> s_bAllowed{false};
/// Whether the terminal's line is a bar's.
std::atomic<bool> s_bShown{false};

void EndLine(std::string_view i_How)
{
	if (s_bShown.exchange(false))
		WriteAtOnce(STDERR_FILENO, i_How);
}

} // namespace

void AllowProgress()
{
	s_bAllowed = true;
}

VProgressBar::VProgressBar(std::string i_Doing)
    : m_Doing(std::move(i_Doing)), m_bTerminal(s_bAllowed && HasColours(STDERR_FILENO))
{
}

VProgressBar::~VProgressBar()
{
	ClearProgress();
}

void VProgressBar::Show(double i_Part)
{
	const int percent = std::clamp(int(100.0 * i_Part), 0, 100);
	if (!m_bTerminal || (percent == m_Shown && s_bShown))
		return;
	m_Shown = percent;
	std::string bar(std::size_t(percent * c_Width / 100), '#');
	bar.resize(c_Width, '.');
	s_bShown = true;
	std::fprintf(stderr, "\r%s %s %3d %%", m_Doing.c_str(), bar.c_str(), percent);
}

void ClearProgress()
{
	EndLine("\r\x1b[K");
}

void LeaveProgress()
{
	EndLine("\n");
}

} // namespace CommandLine
