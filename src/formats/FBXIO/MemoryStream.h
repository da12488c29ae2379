#pragma once

#include <fbxsdk.h>

#include <algorithm>
#include <cstring>
#include <string_view>

namespace FBXIO
{

/// Bytes of the caller as a file that is read; they must outlive it.
class VMemoryStream final : public FbxStream
{
public:
	VMemoryStream(std::string_view i_Bytes, int i_ReaderID) : m_Bytes(i_Bytes), m_ReaderID(i_ReaderID) {}

	EState GetState() override { return m_bOpen ? eOpen : eClosed; }
	bool Open(void* /*pStreamData*/) override
	{
		m_Position = 0;
		return m_bOpen = true;
	}
	bool Close() override
	{
		m_bOpen = false;
		return true;
	}
	bool Flush() override { return true; }
	std::size_t Write(const void* /*pData*/, FbxUInt64 /*pSize*/) override { return 0; }
	std::size_t Read(void* pData, FbxUInt64 pSize) const override
	{
		const std::size_t size = std::min<FbxUInt64>(pSize, m_Bytes.size() - m_Position);
		std::memcpy(pData, m_Bytes.data() + m_Position, size);
		m_Position += size;
		return size;
	}
	int GetReaderID() const override { return m_ReaderID; }
	int GetWriterID() const override { return -1; }
	void Seek(const FbxInt64& pOffset, const FbxFile::ESeekPos& pSeekPos) override
	{
		const std::size_t from = pSeekPos == FbxFile::eBegin ? 0
		    : pSeekPos == FbxFile::eEnd                      ? m_Bytes.size()
		                                                     : m_Position;
		SetPosition(FbxInt64(from) + pOffset);
	}
	FbxInt64 GetPosition() const override { return FbxInt64(m_Position); }
	void SetPosition(FbxInt64 pPosition) override
	{
		m_Position = std::size_t(std::clamp<FbxInt64>(pPosition, 0, FbxInt64(m_Bytes.size())));
	}
	int GetError() const override { return 0; }
	void ClearError() override {}

private:
	std::string_view m_Bytes;
	int m_ReaderID;
	bool m_bOpen = false;
	mutable std::size_t m_Position = 0;
};

} // namespace FBXIO
