#pragma once

#include <boost/filesystem/operations.hpp>

#include <fstream>
#include <string>

namespace FbxTest
{

/// A file with those bytes that ends with its scope.
class VTestFile
{
public:
	explicit VTestFile(const std::string& i_rBytes)
	    : m_Path(
	        boost::filesystem::temp_directory_path() / boost::filesystem::unique_path("retarget-%%%%-%%%%-%%%%.fbx"))
	{
		std::ofstream(m_Path.c_str(), std::ios::binary) << i_rBytes;
	}
	~VTestFile()
	{
		boost::system::error_code error;
		boost::filesystem::remove(m_Path, error);
	}
	VTestFile(const VTestFile&) = delete;
	VTestFile& operator=(const VTestFile&) = delete;

	std::string Path() const { return m_Path.string(); }

private:
	boost::filesystem::path m_Path;
};

} // namespace FbxTest
