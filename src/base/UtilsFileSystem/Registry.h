#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>

namespace UtilsFileSystem
{

/// Access to read a key as programs of one width see it.
inline constexpr std::uint32_t c_Read64BitView = 131353;
inline constexpr std::uint32_t c_Read32BitView = 131609;

/// An open key of the registry of Windows, as far as we read it; closed by its destructor. All texts are in the
/// system's narrow code page.
class IRegistryKey
{
public:
	virtual ~IRegistryKey() = default;

	/// @param i_pPath below this key, with back-slashes.
	/// @return null if it is not there or may not be read.
	virtual std::unique_ptr<IRegistryKey> Open(const char* i_pPath, std::uint32_t i_Access) const = 0;

	/// The name of a sub-key and a zero.
	/// @param o_rSize without the zero.
	/// @return false from the last sub-key on, and for a name that does not fit.
	virtual bool SubKeyName(std::uint32_t i_Index, std::span<char> o_Name, std::size_t& o_rSize) const = 0;

	/// A text as it is stored, with none, one or several zeros at its end.
	/// @return false if there is no text of this name, or if it does not fit.
	virtual bool Text(const char* i_pName, std::span<char> o_Text, std::size_t& o_rSize) const = 0;
};

} // namespace UtilsFileSystem
