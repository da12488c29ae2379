#include <windows.h>

#include "UtilsFileSystem/Platform.h"

namespace UtilsFileSystem::Platform
{
namespace
{

class VRegistryKey : public IRegistryKey
{
public:
	/// Takes over the key. Closing one of the system's own roots does nothing.
	explicit VRegistryKey(HKEY i_Key) : m_Key(i_Key) {}
	~VRegistryKey() override { ::RegCloseKey(m_Key); }
	VRegistryKey(const VRegistryKey&) = delete;
	VRegistryKey& operator=(const VRegistryKey&) = delete;

	std::unique_ptr<IRegistryKey> Open(const char* i_pPath, std::uint32_t i_Access) const override
	{
		HKEY key = nullptr;
		if (::RegOpenKeyExA(m_Key, i_pPath, 0, i_Access, &key) != ERROR_SUCCESS)
			return nullptr;
		return std::make_unique<VRegistryKey>(key);
	}

	bool SubKeyName(std::uint32_t i_Index, std::span<char> o_Name, std::size_t& o_rSize) const override
	{
		DWORD size = DWORD(o_Name.size());
		if (::RegEnumKeyExA(m_Key, i_Index, o_Name.data(), &size, nullptr, nullptr, nullptr, nullptr) != ERROR_SUCCESS)
			return false;
		o_rSize = size;
		return true;
	}

	bool Text(const char* i_pName, std::span<char> o_Text, std::size_t& o_rSize) const override
	{
		DWORD type = 0;
		DWORD size = DWORD(o_Text.size());
		if (::RegQueryValueExA(m_Key, i_pName, nullptr, &type, reinterpret_cast<BYTE*>(o_Text.data()), &size)
		        != ERROR_SUCCESS
		    || (type != REG_SZ && type != REG_EXPAND_SZ))
			return false;
		o_rSize = size;
		return true;
	}

private:
	const HKEY m_Key;
};

} // namespace

std::unique_ptr<IRegistryKey> OpenLocalMachine()
{
	return std::make_unique<VRegistryKey>(HKEY_LOCAL_MACHINE);
}

} // namespace UtilsFileSystem::Platform
