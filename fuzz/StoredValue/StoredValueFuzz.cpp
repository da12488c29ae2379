#include "../Require.h"

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectRecord.h"
#include "TesselDataStore/SkipReaders.h"
#include "TesselDataStore/StoredValue.h"
#include "TesselDataStore/ValueText.h"

namespace
{

using namespace NVX::IO;

/// Takes a byte from the front of the input; 0 at its end.
std::uint8_t Take(std::string_view& io_rInput)
{
	const std::uint8_t byte = io_rInput.empty() ? 0 : std::uint8_t(io_rInput.front());
	io_rInput.remove_prefix(io_rInput.empty() ? 0 : 1);
	return byte;
}

/// Any schema, of the members' names of the subject types and of others.
VSchemaPointer TakeSchema(std::string_view& io_rInput, int i_Depth)
{
	static constexpr const char* c_Names[] = {"Name", "Segments", "Markers", "Targets", "Joint", "Mean", "State", "x"};
	ISchema schema;
	schema.m_Type = EType(Take(io_rInput) % 20);
	const bool bDeep = i_Depth == 0 && schema.m_Type >= EType::EArray && schema.m_Type <= EType::ENamedTuple;
	if (bDeep)
		schema.m_Type = EType::EFloat64;
	if (schema.m_Type == EType::EArray)
	{
		schema.m_Count = Take(io_rInput);
		if (schema.m_Count > 250)
			schema.m_Count = ~0u;
	}
	if (schema.m_Type == EType::EArray || schema.m_Type == EType::EList)
		schema.m_pSubSchema = TakeSchema(io_rInput, i_Depth - 1);
	if (schema.m_Type == EType::ETuple || schema.m_Type == EType::ENamedTuple)
		for (int count = Take(io_rInput) % 5; count > 0; --count)
		{
			const char* const pName = c_Names[Take(io_rInput) % std::size(c_Names)];
			schema.m_Children.push_back({pName, "", 0, TakeSchema(io_rInput, i_Depth - 1)});
		}
	return GetUniqueSchema(schema);
}

bool Skips(const VVariant& i_rValue)
{
	try
	{
		VBinaryReader bytes(i_rValue.m_Bytes);
		return MakeSkipReader(*i_rValue.m_pSchema)->Read(bytes, nullptr) && bytes.BytesLeft() == 0;
	}
	catch (const std::runtime_error&)
	{
		return false;
	}
}

/// What is read can be stepped over, and comes back equal when it is written.
template <typename T>
void ReadAndWrite(const VVariant& i_rStored)
{
	T value;
	if (!TesselDataStore::FromVariant(i_rStored, value))
		return;
	Require(Skips(i_rStored));
	T back;
	Require(TesselDataStore::FromVariant(TesselDataStore::ToVariant(value), back));
	Require(back == value);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	std::string_view input(reinterpret_cast<const char*>(i_pData), i_Size);
	const bool bOwnSchema = Take(input) % 2;
	VVariant stored;
	stored.m_pSchema = bOwnSchema ? TakeSchema(input, 4) : TesselDataStore::SchemaOf<CoreOrlexTypes::VSubjectRecord>();
	stored.m_Bytes = input;
	(void)Skips(stored);
	// A longer one only takes longer.
	constexpr std::size_t c_MostText = 2000;
	(void)TesselDataStore::ValueText(stored, c_MostText);
	ReadAndWrite<CoreOrlexTypes::VSubjectRecord>(stored);
	ReadAndWrite<CoreOrlexTypes::VSubjectParametrised>(stored);
	ReadAndWrite<CoreOrlexTypes::VSubject>(stored);
	ReadAndWrite<CoreOrlexTypes::VSubjectApplicationData>(stored);
	return 0;
}
