#pragma once

#include <cstdint>

namespace FileSystemWatcher
{

enum EFileChange : std::uint32_t
{
	EAdded = 1,
	ERemoved = 2,
	EModified = 3,
	ERenamedOld = 4,
	ERenamedNew = 5
};

} // namespace FileSystemWatcher
