#include "UtilsFileSystem/InstalledProducts.h"

#include "TesselPluginInterface/IPreferenceFolders.h"
#include "UtilsFileSystem/Platform.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <limits>
#include <optional>
#include <string_view>

namespace UtilsFileSystem
{

namespace
{

constexpr const char* c_InstalledPrograms = "SOFTWARE\\Microsoft\\Windows\\CurrentVersion\\Uninstall";

using VBuffer = std::array<char, 1024>;
using VVersion = std::array<std::uint32_t, 3>;

/// In the buffer, up to its first zero.
std::optional<std::string_view> ReadText(const IRegistryKey& i_rKey, const char* i_pName, VBuffer& o_rBuffer)
{
	std::size_t size = 0;
	if (!i_rKey.Text(i_pName, o_rBuffer, size))
		return std::nullopt;
	const std::string_view text(o_rBuffer.data(), std::min(size, o_rBuffer.size()));
	return text.substr(0, text.find('\0'));
}

/// The digits at the start of a text, as the largest number if they are too many; 0 without any.
std::uint32_t ToUnsigned(std::string_view i_Text)
{
	i_Text.remove_prefix(std::min(i_Text.find_first_not_of(' '), i_Text.size()));
	std::uint32_t number = 0;
	const auto result = std::from_chars(i_Text.data(), i_Text.data() + i_Text.size(), number);
	return result.ec == std::errc::result_out_of_range ? std::numeric_limits<std::uint32_t>::max() : number;
}

VVersion ParseVersion(std::string_view i_Text)
{
	VVersion version{};
	for (std::uint32_t& rNumber : version)
	{
		const std::size_t dot = i_Text.find('.');
		rNumber = ToUnsigned(i_Text.substr(0, dot));
		i_Text = dot == std::string_view::npos ? std::string_view() : i_Text.substr(dot + 1);
	}
	return version;
}

/// @param i_rPrograms a key with one sub-key for each program.
boost::filesystem::path NewestFolder(
    const IRegistryKey& i_rPrograms, std::uint32_t i_Access, const std::string& i_rProductName)
{
	boost::filesystem::path folder;
	VVersion newest{};
	VBuffer buffer;
	std::size_t size = 0;
	for (std::uint32_t i = 0; i_rPrograms.SubKeyName(i, buffer, size); ++i)
	{
		const auto pProgram = i_rPrograms.Open(buffer.data(), i_Access);
		if (!pProgram)
			continue;
		if (const auto name = ReadText(*pProgram, "DisplayName", buffer); !name || !name->starts_with(i_rProductName))
			continue;
		const auto location = ReadText(*pProgram, "InstallLocation", buffer);
		// Many programs have the entry and leave it empty.
		if (!location || location->empty())
			continue;
		const boost::filesystem::path found(location->begin(), location->end());
		const VVersion version = ParseVersion(ReadText(*pProgram, "DisplayVersion", buffer).value_or(""));
		// Of equal versions the first one stays.
		if (folder.empty() || version > newest)
		{
			folder = found;
			newest = version;
		}
	}
	return folder;
}

} // namespace

boost::filesystem::path FindInstallLocation(const IRegistryKey& i_rLocalMachine, const std::string& i_rProductName)
{
	// A program that is just being updated is missing from the list for a moment, hence a second look.
	for (int look = 0; look < 2; ++look)
		for (const std::uint32_t access : {c_Read64BitView, c_Read32BitView})
			if (const auto pPrograms = i_rLocalMachine.Open(c_InstalledPrograms, access))
				if (auto folder = NewestFolder(*pPrograms, access, i_rProductName); !folder.empty())
					return folder;
	return {};
}

boost::filesystem::path FindInstallLocation(const std::string& i_rProductName)
{
	const std::unique_ptr<IRegistryKey> pLocalMachine = Platform::OpenLocalMachine();
	return pLocalMachine ? FindInstallLocation(*pLocalMachine, i_rProductName) : boost::filesystem::path();
}

boost::filesystem::path FindInstallLocation(
    const std::string& i_rProductName, const TesselPluginInterface::IPreferenceFolders& i_rPreferences)
{
	boost::filesystem::path folder = FindInstallLocation(i_rProductName);
	return folder.empty() ? i_rPreferences.Folder(ProductFolderKey(i_rProductName)) : folder;
}

std::string ProductFolderKey(const std::string& i_rProductName)
{
	std::string key = "ProductFolder" + i_rProductName;
	std::erase(key, ' ');
	return key;
}

} // namespace UtilsFileSystem
