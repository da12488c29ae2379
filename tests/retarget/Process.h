#pragma once

#include <filesystem>
#include <string>
#include <vector>

/// What one run of the program left behind.
struct VRun
{
	int m_Status = -1;
	std::string m_Out;
	std::string m_Err;
};

/// Runs the program in a folder, with nothing on its standard input.
VRun RunRetarget(const std::vector<std::string>& i_rArguments, const std::filesystem::path& i_rFolder);

/// A folder of its own for each test, removed with it.
class VScratchFolder
{
public:
	VScratchFolder();
	~VScratchFolder();
	VScratchFolder(const VScratchFolder&) = delete;
	VScratchFolder& operator=(const VScratchFolder&) = delete;

	const std::filesystem::path& Path() const { return m_Path; }
	std::filesystem::path operator/(const std::string& i_rName) const { return m_Path / i_rName; }
	void Write(const std::string& i_rName, const std::string& i_rText) const;
	std::string Read(const std::string& i_rName) const;
	/// Names of all that lies in it, in order.
	std::vector<std::string> Names() const;

private:
	std::filesystem::path m_Path;
};
