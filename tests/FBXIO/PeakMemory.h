#pragma once

#include <malloc.h>

#include <fstream>
#include <string>

namespace FbxTest
{

/// From the start of the program on, what is freed goes back at once: else it would be in use before, and again.
inline const bool c_bFreesAtOnce = mallopt(M_MMAP_THRESHOLD, 65536) == 1 && mallopt(M_TRIM_THRESHOLD, 65536) == 1;

/// The most memory that the process has had since this was made, above what it had then.
class VPeakMemory
{
public:
	VPeakMemory()
	{
		malloc_trim(0);
		// Makes the high-water mark what is in use now.
		std::ofstream("/proc/self/clear_refs") << '5';
		m_Before = Mark();
	}

	double Megabytes() const { return (Mark() - m_Before) * 1024.0 / 1e6; }

	/// In KiB; 0 if the system does not tell.
	static double Mark()
	{
		std::ifstream status("/proc/self/status");
		for (std::string word; status >> word;)
			if (double mark = 0.0; word == "VmHWM:" && status >> mark)
				return mark;
		return 0.0;
	}

private:
	double m_Before = 0.0;
};

} // namespace FbxTest
