#include "FileDigest/FileDigest.h"

#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/Paths.h"

#include <nettle/sha2.h>

#include <array>
#include <cstdio>
#include <vector>

namespace FileDigest
{
namespace
{

std::string Finished(sha256_ctx& io_rContext)
{
	std::array<std::uint8_t, SHA256_DIGEST_SIZE> digest{};
	sha256_digest(&io_rContext, digest.size(), digest.data());
	constexpr const char* c_Digits = "0123456789abcdef";
	std::string text;
	for (const std::uint8_t byte : digest)
		text += {c_Digits[byte >> 4], c_Digits[byte & 15]};
	return text;
}

} // namespace

std::string Sha256OfBytes(std::string_view i_Bytes)
{
	sha256_ctx context;
	sha256_init(&context);
	sha256_update(&context, i_Bytes.size(), reinterpret_cast<const std::uint8_t*>(i_Bytes.data()));
	return Finished(context);
}

std::optional<std::string> Sha256(const boost::filesystem::path& i_rPath, std::string& o_rError)
{
	const UtilsFileSystem::VFile pFile = UtilsFileSystem::OpenFile(i_rPath, "rb");
	sha256_ctx context;
	sha256_init(&context);
	std::vector<std::uint8_t> block(1u << 16);
	while (pFile)
	{
		const std::size_t read = std::fread(block.data(), 1, block.size(), pFile.get());
		sha256_update(&context, read, block.data());
		if (read < block.size())
			break;
	}
	if (!pFile || std::ferror(pFile.get()) != 0)
	{
		o_rError = "\"" + UtilsFileSystem::ToUtf8(i_rPath) + "\" cannot be read";
		return std::nullopt;
	}
	return Finished(context);
}

} // namespace FileDigest
