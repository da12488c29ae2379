#include "Variant/Schema.h"

#include <algorithm>
#include <array>
#include <functional>
#include <mutex>
#include <unordered_map>

namespace NVX::IO
{

namespace
{

void Combine(std::size_t& io_rHash, std::size_t i_Value)
{
	io_rHash ^= i_Value + 0x9e3779b97f4a7c15u + (io_rHash << 6) + (io_rHash >> 2);
}

/// Of a schema whose parts are unique: their addresses stand for them.
std::size_t Hash(const ISchema& i_rSchema)
{
	const std::hash<std::string> text;
	const std::hash<const void*> address;
	std::size_t hash = std::size_t(i_rSchema.m_Type) << 8 | std::size_t(i_rSchema.m_Role);
	Combine(hash, i_rSchema.m_Count);
	Combine(hash, address(i_rSchema.m_pSubSchema.get()));
	Combine(hash, text(i_rSchema.m_Name));
	Combine(hash, text(i_rSchema.m_Doc));
	for (const VSchemaChild& rChild : i_rSchema.m_Children)
	{
		Combine(hash, text(rChild.m_Name));
		Combine(hash, text(rChild.m_Doc));
		Combine(hash, std::size_t(rChild.m_Value));
		Combine(hash, address(rChild.m_pSchema.get()));
	}
	return hash;
}

/// All schemas that somebody holds, by their hash.
class VUniqueSchemas
{
public:
	VSchemaPointer Find(ISchema i_Schema)
	{
		const std::size_t hash = Hash(i_Schema);
		const std::lock_guard lock(m_Mutex);
		auto [at, end] = m_Schemas.equal_range(hash);
		while (at != end)
		{
			if (VSchemaPointer pFound = at->second.lock())
			{
				if (*pFound == i_Schema)
					return pFound;
				++at;
			}
			else
				at = m_Schemas.erase(at);
		}
		if (m_Schemas.size() >= m_PurgeSize)
		{
			std::erase_if(m_Schemas, [](const auto& i_rEntry) { return i_rEntry.second.expired(); });
			m_PurgeSize = std::max(c_FirstPurgeSize, 2 * m_Schemas.size());
		}
		auto pNew = std::make_shared<const ISchema>(std::move(i_Schema));
		m_Schemas.emplace(hash, pNew);
		return pNew;
	}

private:
	static constexpr std::size_t c_FirstPurgeSize = 1024;

	std::mutex m_Mutex;
	std::unordered_multimap<std::size_t, std::weak_ptr<const ISchema>> m_Schemas;
	std::size_t m_PurgeSize = c_FirstPurgeSize;
};

/// Never destroyed: statics elsewhere hold schemas while the process ends.
VUniqueSchemas& UniqueSchemas()
{
	static VUniqueSchemas* const s_pSchemas = new VUniqueSchemas;
	return *s_pSchemas;
}

struct VNameAndDoc
{
	const char* m_pName;
	const char* m_pDoc = "";
};

VSchemaPointer CountedEnumeration(
    const char* i_pName, const char* i_pDoc, std::initializer_list<VNameAndDoc> i_Enumerators)
{
	ISchema schema;
	schema.m_Type = EType::EEnum8;
	schema.m_Name = i_pName;
	schema.m_Doc = i_pDoc;
	for (const VNameAndDoc& rEnumerator : i_Enumerators)
		schema.m_Children.push_back(
		    {rEnumerator.m_pName, rEnumerator.m_pDoc, std::int64_t(schema.m_Children.size()), {}});
	return GetUniqueSchema(schema);
}

} // namespace

bool operator==(const VSchemaChild& i_rLeft, const VSchemaChild& i_rRight)
{
	return i_rLeft.m_Name == i_rRight.m_Name && i_rLeft.m_Doc == i_rRight.m_Doc && i_rLeft.m_Value == i_rRight.m_Value
	    && SameSchema(i_rLeft.m_pSchema, i_rRight.m_pSchema);
}

bool operator==(const ISchema& i_rLeft, const ISchema& i_rRight)
{
	return i_rLeft.m_Type == i_rRight.m_Type && i_rLeft.m_Role == i_rRight.m_Role && i_rLeft.m_Count == i_rRight.m_Count
	    && SameSchema(i_rLeft.m_pSubSchema, i_rRight.m_pSubSchema) && i_rLeft.m_Name == i_rRight.m_Name
	    && i_rLeft.m_Doc == i_rRight.m_Doc && i_rLeft.m_Children == i_rRight.m_Children;
}

bool SameSchema(const VSchemaPointer& i_rpLeft, const VSchemaPointer& i_rpRight)
{
	return i_rpLeft == i_rpRight || (i_rpLeft && i_rpRight && *i_rpLeft == *i_rpRight);
}

const VSchemaPointer& GetUniquePodSchema(EType i_Type)
{
	static const auto* const s_pSchemas = []
	{
		auto* const pSchemas = new std::array<VSchemaPointer, std::size_t(EType::EString) + 2>;
		for (std::size_t index = 0; index + 1 < pSchemas->size(); ++index)
		{
			ISchema schema;
			schema.m_Type = EType(index);
			(*pSchemas)[index] = GetUniqueSchema(schema);
		}
		return pSchemas;
	}();
	return (*s_pSchemas)[std::min(std::size_t(i_Type), s_pSchemas->size() - 1)];
}

VSchemaPointer GetUniqueSchema(const ISchema& i_rSchema)
{
	ISchema schema = i_rSchema;
	if (schema.m_pSubSchema)
		schema.m_pSubSchema = GetUniqueSchema(*schema.m_pSubSchema);
	for (VSchemaChild& rChild : schema.m_Children)
		if (rChild.m_pSchema)
			rChild.m_pSchema = GetUniqueSchema(*rChild.m_pSchema);
	return UniqueSchemas().Find(std::move(schema));
}

std::size_t SizeOf(EType i_Type)
{
	switch (i_Type)
	{
	case EType::EBool:
	case EType::EInt8:
	case EType::EUInt8:
	case EType::EEnum8: return 1;
	case EType::EInt16:
	case EType::EUInt16:
	case EType::EEnum16: return 2;
	case EType::EInt32:
	case EType::EUInt32:
	case EType::EFloat32:
	case EType::EEnum32: return 4;
	case EType::EInt64:
	case EType::EUInt64:
	case EType::EFloat64: return 8;
	default: return 0;
	}
}

VSchemaPointer ListSchema(VSchemaPointer i_pElement)
{
	ISchema schema;
	schema.m_Type = EType::EList;
	schema.m_pSubSchema = std::move(i_pElement);
	return GetUniqueSchema(schema);
}

VSchemaPointer ArraySchema(VSchemaPointer i_pElement, std::uint32_t i_Count)
{
	ISchema schema;
	schema.m_Type = EType::EArray;
	schema.m_Count = i_Count;
	schema.m_pSubSchema = std::move(i_pElement);
	return GetUniqueSchema(schema);
}

const VSchemaPointer& TypeEnumerationSchema()
{
	static const VSchemaPointer s_pSchema = CountedEnumeration("Schema.EType", "Supported types.",
	    {{"Void"}, {"Bool"}, {"Int8"}, {"Int16"}, {"Int32"}, {"Int64"}, {"UInt8"}, {"UInt16"}, {"UInt32"}, {"UInt64"},
	        {"Float32"}, {"Float64"}, {"String"}, {"Array"}, {"List"}, {"Tuple"}, {"NamedTuple"}, {"Enum8"}, {"Enum16"},
	        {"Enum32"}});
	return s_pSchema;
}

const VSchemaPointer& RoleEnumerationSchema()
{
	static const VSchemaPointer s_pSchema =
	    CountedEnumeration("Schema.ERole", "The role of the type represented by the schema.",
	        {{"Value", "An object or value"}, {"Function", "A function specification"},
	            {"Callback", "A callback specification"}, {"Input", "An input parameter within a function"},
	            {"InputOutput", "An input and output parameter within a function"},
	            {"Output", "An output parameter within a function"}, {"Return", "A return value from function"},
	            {"Result", "A return value from a function that is a result code (may be used by API generation)"}});
	return s_pSchema;
}

std::string_view TypeName(EType i_Type)
{
	const std::vector<VSchemaChild>& rTypes = TypeEnumerationSchema()->m_Children;
	return std::size_t(i_Type) < rTypes.size() ? std::string_view(rTypes[std::size_t(i_Type)].m_Name)
	                                           : std::string_view();
}

} // namespace NVX::IO
