#include "Variant/Schema.h"

#include <gtest/gtest.h>

#include <functional>
#include <thread>

namespace
{

using namespace NVX::IO;

std::vector<std::string> Names(const ISchema& i_rEnumeration)
{
	std::vector<std::string> names;
	for (const VSchemaChild& rChild : i_rEnumeration.m_Children)
	{
		EXPECT_EQ(rChild.m_Value, std::int64_t(names.size()));
		names.push_back(rChild.m_Name);
	}
	return names;
}

TEST(Schema, DescribesItsOwnEnumerations)
{
	const ISchema& rTypes = *TypeEnumerationSchema();
	EXPECT_EQ(rTypes.m_Name, "Schema.EType");
	EXPECT_EQ(rTypes.m_Doc, "Supported types.");
	EXPECT_EQ(Names(rTypes),
	    (std::vector<std::string>{"Void", "Bool", "Int8", "Int16", "Int32", "Int64", "UInt8", "UInt16", "UInt32",
	        "UInt64", "Float32", "Float64", "String", "Array", "List", "Tuple", "NamedTuple", "Enum8", "Enum16",
	        "Enum32"}));
	EXPECT_EQ(TypeName(EType::EFloat64), "Float64");
	EXPECT_EQ(int(EType::EFloat64), 11);
	EXPECT_EQ(TypeName(EType::EEnum32), "Enum32");
	EXPECT_EQ(TypeName(EType(200)), "");

	const ISchema& rRoles = *RoleEnumerationSchema();
	EXPECT_EQ(rRoles.m_Name, "Schema.ERole");
	EXPECT_EQ(rRoles.m_Doc, "The role of the type represented by the schema.");
	EXPECT_EQ(Names(rRoles),
	    (std::vector<std::string>{
	        "Value", "Function", "Callback", "Input", "InputOutput", "Output", "Return", "Result"}));
	const char* const docs[] = {"An object or value", "A function specification", "A callback specification",
	    "An input parameter within a function", "An input and output parameter within a function",
	    "An output parameter within a function", "A return value from function",
	    "A return value from a function that is a result code (may be used by API generation)"};
	for (std::size_t index = 0; index < std::size(docs); ++index)
		EXPECT_EQ(rRoles.m_Children[index].m_Doc, docs[index]);
	EXPECT_EQ(int(ERole::EResult), 7);
}

TEST(Schema, PlainTypesAreSharedOnce)
{
	for (int type = 0; type <= int(EType::EString); ++type)
	{
		ISchema copy;
		copy.m_Type = EType(type);
		EXPECT_EQ(GetUniquePodSchema(EType(type)), GetUniqueSchema(copy)) << type;
	}
	EXPECT_EQ(GetUniquePodSchema(EType::EArray), nullptr);
	EXPECT_EQ(GetUniquePodSchema(EType(200)), nullptr);
}

/// A record of a text and a list of numbers.
ISchema Record()
{
	ISchema record;
	record.m_Type = EType::ENamedTuple;
	record.m_Name = "Record";
	record.m_Doc = "Doc";
	record.m_Children = {{"Text", "A text.", 0, GetUniquePodSchema(EType::EString)},
	    {"Numbers", "", 0, ListSchema(GetUniquePodSchema(EType::EFloat64))}};
	return record;
}

TEST(Schema, EqualOnesAreOneInstance)
{
	const VSchemaPointer pFirst = GetUniqueSchema(Record());
	EXPECT_EQ(GetUniqueSchema(Record()), pFirst);
	// Parts that somebody made alone are found, too.
	ISchema other = Record();
	other.m_Children[1].m_pSchema = std::make_shared<const ISchema>(*ListSchema(GetUniquePodSchema(EType::EFloat64)));
	EXPECT_EQ(other, *pFirst);
	EXPECT_EQ(GetUniqueSchema(other), pFirst);
}

TEST(Schema, EveryPartTellsSchemasApart)
{
	const struct
	{
		const char* m_pPart;
		std::function<void(ISchema&)> m_Change;
	} rows[] = {
	    {"type", [](ISchema& io_rSchema) { io_rSchema.m_Type = EType::ETuple; }},
	    {"role", [](ISchema& io_rSchema) { io_rSchema.m_Role = ERole::EInput; }},
	    {"count", [](ISchema& io_rSchema) { io_rSchema.m_Count = 1; }},
	    {"sub-schema", [](ISchema& io_rSchema) { io_rSchema.m_pSubSchema = GetUniquePodSchema(EType::EVoid); }},
	    {"name", [](ISchema& io_rSchema) { io_rSchema.m_Name += "s"; }},
	    {"doc", [](ISchema& io_rSchema) { io_rSchema.m_Doc = ""; }},
	    {"member's name", [](ISchema& io_rSchema) { io_rSchema.m_Children[0].m_Name = "text"; }},
	    {"member's doc", [](ISchema& io_rSchema) { io_rSchema.m_Children[1].m_Doc = "Any."; }},
	    {"enumerator's value", [](ISchema& io_rSchema) { io_rSchema.m_Children[0].m_Value = 1; }},
	    {"member's schema",
	        [](ISchema& io_rSchema)
	        { io_rSchema.m_Children[1].m_pSchema = ListSchema(GetUniquePodSchema(EType::EFloat32)); }},
	    {"member without schema", [](ISchema& io_rSchema) { io_rSchema.m_Children[0].m_pSchema.reset(); }},
	    {"one member more", [](ISchema& io_rSchema) { io_rSchema.m_Children.push_back(io_rSchema.m_Children.back()); }},
	    {"order", [](ISchema& io_rSchema) { std::swap(io_rSchema.m_Children[0], io_rSchema.m_Children[1]); }},
	};
	const VSchemaPointer pRecord = GetUniqueSchema(Record());
	for (const auto& rRow : rows)
	{
		ISchema changed = Record();
		rRow.m_Change(changed);
		EXPECT_FALSE(changed == *pRecord) << rRow.m_pPart;
		EXPECT_NE(GetUniqueSchema(changed), pRecord) << rRow.m_pPart;
	}
}

TEST(Schema, ThreadsFindTheSameInstance)
{
	std::vector<VSchemaPointer> found(4);
	std::vector<std::thread> threads;
	for (VSchemaPointer& rpFound : found)
		threads.emplace_back(
		    [&rpFound]
		    {
			    // Many that end at once, so that the table purges itself meanwhile.
			    for (std::uint32_t count = 0; count < 3000; ++count)
				    ArraySchema(GetUniquePodSchema(EType::EBool), count);
			    rpFound = GetUniqueSchema(Record());
		    });
	for (std::thread& rThread : threads)
		rThread.join();
	for (const VSchemaPointer& rpFound : found)
		EXPECT_EQ(rpFound, found.front());
}

} // namespace
