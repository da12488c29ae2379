#include "UtilsFileSystem/Platform.h"

std::unique_ptr<UtilsFileSystem::IRegistryKey> UtilsFileSystem::Platform::OpenLocalMachine()
{
	return nullptr;
}
