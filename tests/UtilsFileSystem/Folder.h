#pragma once

#include <boost/filesystem/operations.hpp>

#include <fstream>
#include <iterator>
#include <sstream>
#include <string>

/// A folder of its own for one test, removed with all that is in it.
class VTestFolder
{
public:
	VTestFolder()
	    : m_Path(
	        boost::filesystem::temp_directory_path() / boost::filesystem::unique_path("retarget-test-%%%%-%%%%-%%%%"))
	{
		create_directory(m_Path);
	}
	~VTestFolder()
	{
		boost::system::error_code error;
		remove_all(m_Path, error);
	}
	VTestFolder(const VTestFolder&) = delete;
	VTestFolder& operator=(const VTestFolder&) = delete;

	boost::filesystem::path operator/(const std::string& i_rName) const { return m_Path / i_rName; }
	const boost::filesystem::path& Path() const { return m_Path; }
	std::ptrdiff_t Count() const { return std::distance(boost::filesystem::directory_iterator(m_Path), {}); }

private:
	boost::filesystem::path m_Path;
};

inline void Put(const boost::filesystem::path& i_rPath, const std::string& i_rBytes)
{
	std::ofstream(i_rPath.c_str(), std::ios::binary) << i_rBytes;
}

inline std::string Get(const boost::filesystem::path& i_rPath)
{
	std::ostringstream bytes;
	bytes << std::ifstream(i_rPath.c_str(), std::ios::binary).rdbuf();
	return bytes.str();
}
