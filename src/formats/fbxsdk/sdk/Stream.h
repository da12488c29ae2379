#pragma once

#include <cstddef>

namespace fbxsdk
{

using FbxInt64 = long long;
using FbxUInt64 = unsigned long long;

class FbxFile
{
public:
	enum ESeekPos
	{
		eBegin,
		eCurrent,
		eEnd
	};
};

/// What an importer reads in the place of a file on disk. The caller derives from it.
class FbxStream
{
public:
	enum EState
	{
		eClosed,
		eOpen,
		eEmpty
	};

	virtual ~FbxStream() = default;
	virtual EState GetState() = 0;

	/// Gets what the importer was given beside the stream.
	virtual bool Open(void* pStreamData) = 0;
	virtual bool Close() = 0;
	virtual bool Flush() = 0;

	/// Bytes that were written, or read from the position on.
	virtual std::size_t Write(const void* pData, FbxUInt64 pSize) = 0;
	virtual std::size_t Read(void* pData, FbxUInt64 pSize) const = 0;

	/// One of the registry's formats; -1 for the writer of a stream that is only read.
	virtual int GetReaderID() const = 0;
	virtual int GetWriterID() const = 0;

	virtual void Seek(const FbxInt64& pOffset, const FbxFile::ESeekPos& pSeekPos) = 0;
	virtual FbxInt64 GetPosition() const = 0;
	virtual void SetPosition(FbxInt64 pPosition) = 0;

	/// 0 for none.
	virtual int GetError() const = 0;
	virtual void ClearError() = 0;
};

} // namespace fbxsdk
