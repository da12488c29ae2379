#include "fbxsdk/container/FileKind.h"

#include "fbxsdk/Limits.h"
#include "fbxsdk/container/TextScan.h"

#include <charconv>
#include <cstring>

namespace
{

using namespace std::string_view_literals;

constexpr std::string_view c_Magic = "Kaydara FBX Binary  \0\x1a"sv;
/// What is left of it after a transfer as text.
constexpr std::string_view c_ReadableMagic = "Kaydara FBX Binary"sv;

/// "; FBX 7.4.0 project file", the first line of what most exporters write.
std::uint32_t VersionOfComment(std::string_view i_Line)
{
	std::uint32_t version = 0;
	std::uint32_t weight = 1000;
	for (const char byte : i_Line.substr(i_Line.find_first_of("0123456789")))
	{
		if (byte == '.')
			weight /= 10;
		else if (byte >= '0' && byte <= '9' && version < 1000000)
			version += weight * std::uint32_t(byte - '0');
		else
			break;
	}
	return version;
}

std::uint32_t VersionOfRecord(std::string_view i_Head)
{
	constexpr std::string_view key = "FBXVersion:";
	const std::size_t at = i_Head.find(key);
	if (at == std::string_view::npos)
		return 0;
	const char* p = i_Head.data() + at + key.size();
	const char* const pEnd = i_Head.data() + i_Head.size();
	p = FbxFormat::Text::SkipBlanks(p, pEnd);
	std::uint32_t version = 0;
	std::from_chars(p, pEnd, version);
	return version;
}

/// Binary files before version 6 have the number 3000 in front, and their own in a record.
std::uint32_t VersionOfBinary(std::string_view i_Head, std::uint32_t i_InFront)
{
	constexpr std::string_view record = "FBXVersionI";
	const std::size_t at = i_InFront < 6000 ? i_Head.find(record) : std::string_view::npos;
	if (at != std::string_view::npos && i_Head.size() >= at + record.size() + sizeof(i_InFront))
		std::memcpy(&i_InFront, i_Head.data() + at + record.size(), sizeof(i_InFront));
	return i_InFront;
}

} // namespace

FbxFormat::VFileKind FbxFormat::DetectFileKind(std::string_view i_Head)
{
	i_Head = i_Head.substr(0, Limits::c_TextHeaderBytes);
	if (i_Head.starts_with(c_Magic))
	{
		if (i_Head.size() < c_BinaryHeaderSize)
			return {EFileKind::DamagedBinary};
		std::uint32_t version = 0;
		std::memcpy(&version, i_Head.data() + 23, sizeof(version));
		if (i_Head[22] == 0)
			return {EFileKind::Binary, VersionOfBinary(i_Head, version)};
		return {EFileKind::BinaryBigEndian, __builtin_bswap32(version)};
	}

	if (i_Head.starts_with(c_ReadableMagic))
		return {EFileKind::DamagedBinary};

	const char* const pEnd = i_Head.data() + i_Head.size();
	const char* const pFirst = Text::SkipByteOrderMark(i_Head.data(), pEnd);
	const char* const pRecord = Text::SkipSpace(pFirst, pEnd);
	const std::string_view comment(pFirst, pRecord - pFirst);
	const bool bComment = comment.starts_with("; FBX ") && comment.size() > 6 && comment[6] >= '0' && comment[6] <= '9';
	const bool bRecord = std::string_view(pRecord, pEnd - pRecord).starts_with("FBXHeaderExtension:");
	if (!bComment && !bRecord)
		return {};
	const std::uint32_t version = VersionOfRecord(i_Head);
	return {EFileKind::Text, version == 0 && bComment ? VersionOfComment(comment) : version};
}
