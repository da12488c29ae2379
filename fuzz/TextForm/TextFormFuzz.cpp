#include "../Require.h"

#include "CoreOrlexTypes/TextForm.h"

namespace
{

using namespace CoreOrlexTypes;

/// Whatever is read can be written, in both spellings, and reads back equal.
template <typename T>
void ReadAndWrite(std::string_view i_Text)
{
	T value;
	std::size_t read = 0;
	if (!ReadText(i_Text, value, &read))
		return;
	Require(read <= i_Text.size());
	for (const ETextSpelling spelling : {ETextSpelling::EKeyed, ETextSpelling::EPositional})
	{
		std::string text;
		Require(WriteText(value, text, spelling));
		T back;
		Require(ReadText(text, back, &read) && read == text.size());
		Require(back == value);
	}
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	const std::string_view text(reinterpret_cast<const char*>(i_pData), i_Size);
	VTextHeader header;
	std::size_t read = 0;
	if (ReadText(text, header, &read))
		ReadAndWrite<VSubjectRecord>(text.substr(read));
	ReadAndWrite<VSubjectParametrised>(text);
	ReadAndWrite<VSubject>(text);
	ReadAndWrite<VSubjectApplicationData>(text);
	return 0;
}
