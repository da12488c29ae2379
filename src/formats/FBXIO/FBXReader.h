#pragma once

#include "FBXIO/SkinSkeleton.h"

#include <memory>
#include <string>

namespace FBXIO
{

/// Imports one FBX file and holds its scene for as long as the reader lives. Findings go to the log category "FBXIO".
/// Belongs to one thread at a time.
class FBXReader
{
public:
	FBXReader();
	~FBXReader();
	FBXReader(const FBXReader&) = delete;
	FBXReader& operator=(const FBXReader&) = delete;

	/// The whole of the import; called once per reader. A file of which only a part could be read still gives true.
	bool LoadFile(const std::string& i_rPath);

	/// False if the import broke off: what was read until then is there.
	bool IsComplete() const;

	bool HasSkeleton() const;

	/// 0 for X, 1 for Y, 2 for Z.
	int GetUpAxis() const;

	/// File units to millimetres.
	float GetUnitScale() const;

	/// The full skeleton; empty pointer if the file has none.
	std::shared_ptr<const VSkinSkeleton> GetSkeleton() const;

private:
	class VImpl;
	std::unique_ptr<VImpl> m_pImpl;
};

} // namespace FBXIO
