#include "FBXIO/Picture.h"

#include <algorithm>
#include <cctype>
#include <cstdint>
#include <cstdlib>
#include <limits>

namespace
{

struct VHead
{
	std::int64_t m_Width = 0;
	std::int64_t m_Height = 0;
	int m_PointBytes = 4;
};

/// A number of the file; 0 beyond its end.
std::int64_t BigEndian(std::string_view i_Bytes, std::size_t i_At, std::size_t i_Count)
{
	std::int64_t number = 0;
	for (std::size_t i = 0; i < i_Count && i_At + i_Count <= i_Bytes.size(); ++i)
		number = number << 8 | std::uint8_t(i_Bytes[i_At + i]);
	return number;
}

std::int64_t LittleEndian(std::string_view i_Bytes, std::size_t i_At, std::size_t i_Count)
{
	std::int64_t number = 0;
	for (std::size_t i = i_Count; i > 0 && i_At + i_Count <= i_Bytes.size(); --i)
		number = number << 8 | std::uint8_t(i_Bytes[i_At + i - 1]);
	return number;
}

VHead HeadOfPng(std::string_view i_Bytes)
{
	if (i_Bytes.size() < 26 || i_Bytes.substr(12, 4) != "IHDR")
		return {};
	return {BigEndian(i_Bytes, 16, 4), BigEndian(i_Bytes, 20, 4), BigEndian(i_Bytes, 24, 1) > 8 ? 8 : 4};
}

/// The size stands in the frame, behind segments that tell their lengths.
VHead HeadOfJpeg(std::string_view i_Bytes)
{
	for (std::size_t at = 2; at + 4 <= i_Bytes.size() && i_Bytes[at] == '\xff';)
	{
		const auto kind = std::uint8_t(i_Bytes[at + 1]);
		const bool bFrame = kind >= 0xc0 && kind <= 0xcf && kind != 0xc4 && kind != 0xc8 && kind != 0xcc;
		if (bFrame)
			return {BigEndian(i_Bytes, at + 7, 2), BigEndian(i_Bytes, at + 5, 2)};
		// A byte that fills up.
		at += kind == 0xff ? 1 : 2 + std::size_t(BigEndian(i_Bytes, at + 2, 2));
	}
	return {};
}

VHead HeadOfBmp(std::string_view i_Bytes)
{
	constexpr std::int64_t c_OldHead = 12;
	if (LittleEndian(i_Bytes, 14, 4) == c_OldHead)
		return {LittleEndian(i_Bytes, 18, 2), LittleEndian(i_Bytes, 20, 2)};
	// A negative height tells that rows begin at the top.
	return {LittleEndian(i_Bytes, 18, 4), std::abs(std::int64_t(std::int32_t(LittleEndian(i_Bytes, 22, 4))))};
}

/// Two numbers as text, with blanks and comments before each.
VHead HeadOfPnm(std::string_view i_Bytes)
{
	std::size_t at = 2;
	const auto isAt = [&](auto&& i_Is) { return at < i_Bytes.size() && i_Is(std::uint8_t(i_Bytes[at])); };
	const auto next = [&]
	{
		while (isAt([](int i_Byte) { return std::isspace(i_Byte) || i_Byte == '#'; }))
			at = i_Bytes[at] == '#' ? std::min(i_Bytes.find('\n', at), i_Bytes.size()) : at + 1;
		std::int64_t number = 0;
		for (; isAt([](int i_Byte) { return std::isdigit(i_Byte); }); ++at)
			number = std::min<std::int64_t>(10 * number + (i_Bytes[at] - '0'), std::numeric_limits<int>::max());
		return number;
	};
	const std::int64_t width = next();
	return {width, next()};
}

VHead HeadOf(std::string_view i_Bytes)
{
	if (i_Bytes.starts_with("\x89PNG\r\n\x1a\n"))
		return HeadOfPng(i_Bytes);
	if (i_Bytes.starts_with("\xff\xd8"))
		return HeadOfJpeg(i_Bytes);
	if (i_Bytes.starts_with("GIF8"))
		return {LittleEndian(i_Bytes, 6, 2), LittleEndian(i_Bytes, 8, 2)};
	if (i_Bytes.starts_with("BM"))
		return HeadOfBmp(i_Bytes);
	if (i_Bytes.size() > 2 && i_Bytes[0] == 'P' && i_Bytes[1] >= '1' && i_Bytes[1] <= '6')
		return HeadOfPnm(i_Bytes);
	return {};
}

class VPictureHead final : public FBXIO::IPictureFile
{
public:
	explicit VPictureHead(std::string_view i_Bytes) : m_Head(HeadOf(i_Bytes)) {}

	bool ReadHead(int& o_rWidth, int& o_rHeight) override
	{
		const auto isSize = [](std::int64_t i_Size) { return i_Size > 0 && i_Size <= std::numeric_limits<int>::max(); };
		if (!isSize(m_Head.m_Width) || !isSize(m_Head.m_Height))
			return false;
		o_rWidth = int(m_Head.m_Width);
		o_rHeight = int(m_Head.m_Height);
		return true;
	}
	int PointBytes() override { return m_Head.m_PointBytes; }
	std::shared_ptr<FBXIO::VPicture> Read() override { return std::make_shared<FBXIO::VPicture>(); }

private:
	const VHead m_Head;
};

} // namespace

std::unique_ptr<FBXIO::IPictureFile> FBXIO::OpenPictureHead(std::string_view i_Bytes, const std::string& /*i_rFormat*/)
{
	return std::make_unique<VPictureHead>(i_Bytes);
}
