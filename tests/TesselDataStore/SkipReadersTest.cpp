#include "TesselDataStore/SkipReaders.h"

#include "TesselDataStore/BinaryWriter.h"

#include <gtest/gtest.h>

namespace
{

using namespace NVX::IO;

VSchemaPointer Pod(EType i_Type)
{
	return GetUniquePodSchema(i_Type);
}

VSchemaPointer Tuple(const std::vector<VSchemaPointer>& i_rMembers)
{
	ISchema schema;
	schema.m_Type = EType::ETuple;
	for (const VSchemaPointer& rpMember : i_rMembers)
		schema.m_Children.push_back({"", "", 0, rpMember});
	return GetUniqueSchema(schema);
}

/// The class of a reader, and its fixed size.
std::string Kind(const NVX::IReaderCollapsable& i_rReader)
{
	if (i_rReader.FixedSize())
		return "bytes " + std::to_string(*i_rReader.FixedSize());
	if (dynamic_cast<const VReaderSkipBytesNoCollapse*>(&i_rReader))
		return "alone";
	if (dynamic_cast<const VReaderSkipArray*>(&i_rReader))
		return "array";
	if (dynamic_cast<const VReaderSkipContiguousVector*>(&i_rReader))
		return "vector";
	if (dynamic_cast<const VReaderSkipContainer*>(&i_rReader))
		return "container";
	return dynamic_cast<const VReaderSkipTuple*>(&i_rReader) ? "tuple" : "";
}

const VSchemaPointer c_pText = Pod(EType::EString);
const VSchemaPointer c_pReal = Pod(EType::EFloat64);
const VSchemaPointer c_pFlag = Pod(EType::EBool);

/// Two texts of 3 bytes and of none, a count of 2 before them.
const std::string c_TwoTexts{"\2\0\0\0\3\0\0\0abc\0\0\0\0", 15};

TEST(SkipReaders, StepOverAnyValue)
{
	const std::string eights(64, '\7');
	const std::string texts = c_TwoTexts.substr(4);
	const std::string three{"\3\0\0\0", 4};
	const struct
	{
		const char* m_pName;
		VSchemaPointer m_pSchema;
		const char* m_pKind;
		std::string m_Bytes;
	} rows[] = {
	    {"nothing", Pod(EType::EVoid), "bytes 0", ""},
	    {"flag", c_pFlag, "bytes 1", "1"},
	    {"16 bits", Pod(EType::EInt16), "bytes 2", "12"},
	    {"32 bits", Pod(EType::EFloat32), "bytes 4", "1234"},
	    {"64 bits", c_pReal, "bytes 8", eights.substr(0, 8)},
	    {"text", c_pText, "vector", texts.substr(0, 7)},
	    {"empty text", c_pText, "vector", texts.substr(7)},
	    {"array of numbers", ArraySchema(c_pReal, 3), "bytes 24", eights.substr(0, 24)},
	    {"array of arrays", ArraySchema(ArraySchema(c_pFlag, 3), 2), "bytes 6", eights.substr(0, 6)},
	    {"array of texts", ArraySchema(c_pText, 2), "array", texts},
	    {"no texts", ArraySchema(c_pText, 0), "bytes 0", ""},
	    {"list of numbers", ListSchema(c_pReal), "vector", three + eights.substr(0, 24)},
	    {"list of nothing", ListSchema(ArraySchema(c_pText, 0)), "vector", "\xFF\xFF\xFF\xFF"},
	    {"list of texts", ListSchema(c_pText), "container", c_TwoTexts},
	    {"collapsed members", Tuple({c_pReal, c_pFlag, ArraySchema(c_pReal, 2)}), "bytes 25", eights.substr(0, 25)},
	    {"no members", Tuple({}), "bytes 0", ""},
	    {"members with a text", Tuple({c_pReal, c_pFlag, c_pText, c_pFlag}), "tuple",
	        eights.substr(0, 9) + texts.substr(0, 7) + '1'},
	    {"list of tuples", ListSchema(Tuple({c_pReal, c_pFlag})), "vector", three + eights.substr(0, 27)},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		const VSkipReader pReader = MakeSkipReader(*rRow.m_pSchema);
		EXPECT_EQ(Kind(*pReader), rRow.m_pKind);
		const std::string bytes = rRow.m_Bytes + "more";
		VBinaryReader reader(bytes);
		EXPECT_TRUE(pReader->Read(reader, nullptr));
		EXPECT_EQ(reader.Position(), rRow.m_Bytes.size());
		for (std::size_t size = 0; size < rRow.m_Bytes.size(); ++size)
		{
			VBinaryReader cut(std::string_view(rRow.m_Bytes).substr(0, size));
			EXPECT_THROW(pReader->Read(cut, nullptr), std::runtime_error) << size;
		}
		EXPECT_LE(MinimumSize(*rRow.m_pSchema), rRow.m_Bytes.size());
	}
}

TEST(SkipReaders, CollapseOnlyWithNeighboursOfFixedSize)
{
	VReaderSkipBytes reader(3);
	EXPECT_TRUE(reader.Collapse(VReaderSkipBytes(5)));
	EXPECT_FALSE(reader.Collapse(VReaderSkipBytesNoCollapse(5)));
	EXPECT_FALSE(reader.Collapse(VReaderSkipContiguousVector(1)));
	EXPECT_EQ(reader.FixedSize(), 8u);
	EXPECT_FALSE(VReaderSkipBytesNoCollapse(3).Collapse(reader));
	EXPECT_FALSE(VReaderSkipContiguousVector(1).Collapse(reader));

	EXPECT_EQ(Kind(*MakeSkipReader(*c_pReal, ECollapse::ENo)), "alone");
	EXPECT_EQ(Kind(*MakeSkipReader(*Tuple({c_pReal, c_pFlag}), ECollapse::ENo)), "tuple");
	EXPECT_EQ(Kind(*MakeSkipReader(*ArraySchema(c_pReal, 2), ECollapse::ENo)), "alone");
}

TEST(SkipReaders, SizesBeyondAllBoundsEndTheData)
{
	VSchemaPointer pHuge = c_pReal;
	for (int level = 0; level < 4; ++level)
		pHuge = ArraySchema(pHuge, 0xFFFFFFFFu);
	EXPECT_EQ(MinimumSize(*pHuge), UINT64_MAX);
	const std::string count{"\2\0\0\0", 4};
	for (const VSchemaPointer& rpSchema : {pHuge, ListSchema(pHuge), Tuple({pHuge, pHuge})})
	{
		VBinaryReader reader(count);
		EXPECT_THROW(MakeSkipReader(*rpSchema)->Read(reader, nullptr), std::runtime_error);
		EXPECT_EQ(reader.BytesLeft(), 0u);
		EXPECT_THROW(reader.Take(1), std::runtime_error);
	}
}

TEST(BinaryReader, TellsTheEnd)
{
	VBinaryReader reader("123");
	try
	{
		reader.Number<std::uint32_t>();
		FAIL();
	}
	catch (const std::runtime_error& rError)
	{
		EXPECT_STREQ(rError.what(), "Unexpected end of binary data");
	}
	const std::string bytes{"\4\0\0\0abc", 7};
	VBinaryReader texts(bytes);
	std::string_view text = "kept";
	EXPECT_FALSE(texts.Text(text));
	EXPECT_EQ(text, "kept");
	EXPECT_EQ(texts.Position(), 4u);
}

} // namespace
