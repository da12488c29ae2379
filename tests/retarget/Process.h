#pragma once

#include "../UtilsFileSystem/Folder.h"

#include <map>
#include <vector>

/// What one run of the program left behind.
struct VRun
{
	int m_Status = -1;
	std::string m_Out;
	std::string m_Err;
};

/// A folder of its own for each test, in which the program runs.
class VScratchFolder : public VTestFolder
{
public:
	/// @param i_rInput the file on the program's standard input, through a pipe
	VRun Run(const std::vector<std::string>& i_rArguments, const std::string& i_rInput = "/dev/null") const;

	void Write(const std::string& i_rName, const std::string& i_rText) const { Put(*this / i_rName, i_rText); }
	std::string Read(const std::string& i_rName) const { return Get(*this / i_rName); }
	/// Names of all that lies in it, in order.
	std::vector<std::string> Names() const;
	/// The same with what each file holds.
	std::map<std::string, std::string> Snapshot() const;
};
