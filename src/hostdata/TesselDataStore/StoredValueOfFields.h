#pragma once

#include "TesselDataStore/BinaryWriter.h"
#include "TesselDataStore/SkipReaders.h"
#include "TesselDataStore/StoredValue.h"

#include "CoreOrlexTypes/Fields.h"

#include <type_traits>

/// The definitions behind StoredValue.h, for all types that CoreOrlexTypes/Fields.h can describe. Costly to compile:
/// for source files that instantiate them with RETARGET_STORED_VALUE.
namespace TesselDataStore::Detail
{

using NVX::IO::EType;

template <typename T>
concept CPod = std::is_arithmetic_v<T>;

template <CPod T>
constexpr EType PodType()
{
	if constexpr (std::is_same_v<T, bool>)
		return EType::EBool;
	else if constexpr (std::is_floating_point_v<T>)
		return sizeof(T) == 4 ? EType::EFloat32 : EType::EFloat64;
	else
	{
		// The types of each sign stand in the order of their size.
		constexpr int c_Step = std::bit_width(sizeof(T)) - 1;
		return EType(int(std::is_signed_v<T> ? EType::EInt8 : EType::EUInt8) + c_Step);
	}
}

template <CoreOrlexTypes::CEnumeration E>
constexpr EType EnumType()
{
	static_assert(sizeof(E) <= 4);
	return sizeof(E) == 1 ? EType::EEnum8 : sizeof(E) == 2 ? EType::EEnum16 : EType::EEnum32;
}

// Schemas

template <typename T>
struct VSchemaMaker;

template <CPod T>
struct VSchemaMaker<T>
{
	static NVX::IO::VSchemaPointer Make() { return NVX::IO::GetUniquePodSchema(PodType<T>()); }
};

template <>
struct VSchemaMaker<std::string>
{
	static NVX::IO::VSchemaPointer Make() { return NVX::IO::GetUniquePodSchema(EType::EString); }
};

template <CoreOrlexTypes::CEnumeration E>
struct VSchemaMaker<E>
{
	static NVX::IO::VSchemaPointer Make()
	{
		const auto& rEnumeration = CoreOrlexTypes::c_Enumeration<E>;
		NVX::IO::ISchema schema;
		schema.m_Type = EnumType<E>();
		schema.m_Name = rEnumeration.Name;
		schema.m_Doc = rEnumeration.Doc;
		for (const auto& rEnumerator : rEnumeration.Enumerators)
			schema.m_Children.push_back(
			    {std::string(rEnumerator.Name), std::string(rEnumerator.Doc), std::int64_t(rEnumerator.Value), {}});
		return GetUniqueSchema(schema);
	}
};

template <typename T, std::size_t c_Count>
struct VSchemaMaker<std::array<T, c_Count>>
{
	static NVX::IO::VSchemaPointer Make() { return NVX::IO::ArraySchema(SchemaOf<T>(), c_Count); }
};

template <typename T>
struct VSchemaMaker<std::vector<T>>
{
	static NVX::IO::VSchemaPointer Make() { return NVX::IO::ListSchema(SchemaOf<T>()); }
};

template <CoreOrlexTypes::CRecord T>
struct VSchemaMaker<T>
{
	static NVX::IO::VSchemaPointer Make()
	{
		NVX::IO::ISchema schema;
		schema.m_Type = EType::ENamedTuple;
		CoreOrlexTypes::ForEachField<T>(
		    [&]<typename TMember>(const CoreOrlexTypes::VField<T, TMember>& i_rField) {
			    schema.m_Children.push_back(
			        {std::string(i_rField.Key), std::string(i_rField.Doc), 0, SchemaOf<TMember>()});
		    });
		return GetUniqueSchema(schema);
	}
};

// Writing

class VValueWriter
{
public:
	explicit VValueWriter(std::string& io_rBytes) : m_Bytes(io_rBytes) {}

	void Write(bool i_bValue) { m_Bytes.Number(std::uint8_t(i_bValue)); }

	template <NVX::IO::CNumber T>
	void Write(T i_Value)
	{
		m_Bytes.Number(i_Value);
	}

	void Write(const std::string& i_rValue) { m_Bytes.Text(i_rValue); }

	template <CoreOrlexTypes::CEnumeration E>
	void Write(E i_Value)
	{
		m_Bytes.Number(std::underlying_type_t<E>(i_Value));
	}

	template <typename T, std::size_t c_Count>
	void Write(const std::array<T, c_Count>& i_rValue)
	{
		for (const T& rElement : i_rValue)
			Write(rElement);
	}

	template <typename T>
	void Write(const std::vector<T>& i_rValue)
	{
		m_Bytes.Count(i_rValue.size());
		for (const T& rElement : i_rValue)
			Write(rElement);
	}

	template <CoreOrlexTypes::CRecord T>
	void Write(const T& i_rValue)
	{
		CoreOrlexTypes::ForEachField<T>([&](const auto& i_rField) { Write(i_rValue.*i_rField.pMember); });
	}

private:
	NVX::IO::VBinaryWriter m_Bytes;
};

// Reading. Each of these readers is made for a stored schema that fits its type, and writes to a T.

using VReader = std::unique_ptr<NVX::IReader>;

/// Null if a value of the schema cannot be read as a T.
template <typename T>
VReader MakeReader(const NVX::IO::ISchema& i_rStored);

template <typename T>
struct VReadPod : NVX::IReader
{
	bool Read(NVX::IO::VBinaryReader& io_rBytes, void* o_pValue) const override
	{
		if constexpr (std::is_same_v<T, bool>)
			*static_cast<T*>(o_pValue) = io_rBytes.Number<std::uint8_t>() != 0;
		else
			*static_cast<T*>(o_pValue) = io_rBytes.Number<T>();
		return true;
	}
};

struct VReadText : NVX::IReader
{
	bool Read(NVX::IO::VBinaryReader& io_rBytes, void* o_pValue) const override
	{
		std::string_view text;
		if (!io_rBytes.Text(text))
			return false;
		static_cast<std::string*>(o_pValue)->assign(text);
		return true;
	}
};

template <typename E>
struct VReadEnumeration : NVX::IReader
{
	/// What each stored number stands for, by its name.
	std::vector<std::pair<std::int64_t, E>> m_Values;

	bool Read(NVX::IO::VBinaryReader& io_rBytes, void* o_pValue) const override
	{
		const std::int64_t number = io_rBytes.Number<std::underlying_type_t<E>>();
		const auto found = std::find_if(
		    m_Values.begin(), m_Values.end(), [number](const auto& i_rValue) { return i_rValue.first == number; });
		if (found == m_Values.end())
			return false;
		*static_cast<E*>(o_pValue) = found->second;
		return true;
	}
};

template <typename T, std::size_t c_Count>
struct VReadArray : NVX::IReader
{
	VReader m_pElement;

	bool Read(NVX::IO::VBinaryReader& io_rBytes, void* o_pValue) const override
	{
		for (T& rElement : *static_cast<std::array<T, c_Count>*>(o_pValue))
			if (!m_pElement->Read(io_rBytes, &rElement))
				return false;
		return true;
	}
};

template <typename T>
struct VReadList : NVX::IReader
{
	VReader m_pElement;
	std::uint64_t m_MinimumSize = 0;

	bool Read(NVX::IO::VBinaryReader& io_rBytes, void* o_pValue) const override
	{
		std::uint32_t count = 0;
		if (!io_rBytes.Count(m_MinimumSize, sizeof(T), count))
			return false;
		auto& rList = *static_cast<std::vector<T>*>(o_pValue);
		rList.clear();
		rList.resize(count);
		for (T& rElement : rList)
			if (!m_pElement->Read(io_rBytes, &rElement))
				return false;
		return true;
	}
};

template <typename T, typename TMember>
struct VReadMember : NVX::IReader
{
	VReader m_pReader;
	TMember T::*m_pMember;

	bool Read(NVX::IO::VBinaryReader& io_rBytes, void* o_pValue) const override
	{
		return m_pReader->Read(io_rBytes, &(static_cast<T*>(o_pValue)->*m_pMember));
	}
};

struct VReadRecord : NVX::IReader
{
	/// In the order of the stored members: those that fill a member, those that skip.
	std::vector<VReader> m_Steps;

	bool Read(NVX::IO::VBinaryReader& io_rBytes, void* o_pValue) const override
	{
		for (const VReader& rpStep : m_Steps)
			if (!rpStep->Read(io_rBytes, o_pValue))
				return false;
		return true;
	}
};

/// Null if the members are of different types.
template <CoreOrlexTypes::CRecord T>
VReader MakeMemberReader(const NVX::IO::VSchemaChild& i_rStored, bool& o_rbKnown)
{
	VReader pResult;
	o_rbKnown = false;
	CoreOrlexTypes::ForEachField<T>(
	    [&]<typename TMember>(const CoreOrlexTypes::VField<T, TMember>& i_rField)
	    {
		    if (o_rbKnown || i_rField.Key != i_rStored.m_Name)
			    return;
		    o_rbKnown = true;
		    VReader pReader = MakeReader<TMember>(*i_rStored.m_pSchema);
		    if (!pReader)
			    return;
		    auto pMember = std::make_unique<VReadMember<T, TMember>>();
		    pMember->m_pReader = std::move(pReader);
		    pMember->m_pMember = i_rField.pMember;
		    pResult = std::move(pMember);
	    });
	return pResult;
}

template <CoreOrlexTypes::CRecord T>
VReader MakeRecordReader(const NVX::IO::ISchema& i_rStored)
{
	auto pRecord = std::make_unique<VReadRecord>();
	NVX::IReaderCollapsable* pSkipBefore = nullptr;
	for (const NVX::IO::VSchemaChild& rChild : i_rStored.m_Children)
	{
		bool bKnown = false;
		VReader pMember = MakeMemberReader<T>(rChild, bKnown);
		if (bKnown)
		{
			if (!pMember)
				return {};
			pRecord->m_Steps.push_back(std::move(pMember));
			pSkipBefore = nullptr;
			continue;
		}
		NVX::IO::VSkipReader pSkip = NVX::IO::MakeSkipReader(*rChild.m_pSchema);
		if (pSkipBefore && pSkipBefore->Collapse(*pSkip))
			continue;
		pSkipBefore = pSkip.get();
		pRecord->m_Steps.push_back(std::move(pSkip));
	}
	return pRecord;
}

template <typename T>
struct VReaderMaker
{
	static VReader Make(const NVX::IO::ISchema& i_rStored)
	{
		if constexpr (CPod<T>)
			return i_rStored.m_Type == PodType<T>() ? std::make_unique<VReadPod<T>>() : VReader();
		else if constexpr (std::is_same_v<T, std::string>)
			return i_rStored.m_Type == EType::EString ? std::make_unique<VReadText>() : VReader();
		else if constexpr (CoreOrlexTypes::CEnumeration<T>)
		{
			if (i_rStored.m_Type != EnumType<T>())
				return {};
			auto pReader = std::make_unique<VReadEnumeration<T>>();
			for (const NVX::IO::VSchemaChild& rChild : i_rStored.m_Children)
				if (const auto value = CoreOrlexTypes::EnumeratorFromName<T>(rChild.m_Name))
					pReader->m_Values.emplace_back(rChild.m_Value, *value);
			return pReader;
		}
		else
			return i_rStored.m_Type == EType::ENamedTuple ? MakeRecordReader<T>(i_rStored) : VReader();
	}
};

template <typename T, std::size_t c_Count>
struct VReaderMaker<std::array<T, c_Count>>
{
	static VReader Make(const NVX::IO::ISchema& i_rStored)
	{
		if (i_rStored.m_Type != EType::EArray || i_rStored.m_Count != c_Count)
			return {};
		auto pReader = std::make_unique<VReadArray<T, c_Count>>();
		pReader->m_pElement = MakeReader<T>(*i_rStored.m_pSubSchema);
		return pReader->m_pElement ? std::move(pReader) : VReader();
	}
};

template <typename T>
struct VReaderMaker<std::vector<T>>
{
	static VReader Make(const NVX::IO::ISchema& i_rStored)
	{
		if (i_rStored.m_Type != EType::EList)
			return {};
		auto pReader = std::make_unique<VReadList<T>>();
		pReader->m_pElement = MakeReader<T>(*i_rStored.m_pSubSchema);
		pReader->m_MinimumSize = NVX::IO::MinimumSize(*i_rStored.m_pSubSchema);
		return pReader->m_pElement ? std::move(pReader) : VReader();
	}
};

template <typename T>
VReader MakeReader(const NVX::IO::ISchema& i_rStored)
{
	return VReaderMaker<T>::Make(i_rStored);
}

/// Reads all of the bytes.
template <typename T>
bool ReadWhole(const NVX::IReader& i_rReader, std::string_view i_Bytes, T& io_rValue)
{
	T value{};
	try
	{
		NVX::IO::VBinaryReader bytes(i_Bytes);
		if (!i_rReader.Read(bytes, &value) || bytes.BytesLeft() != 0)
			return false;
	}
	catch (const std::runtime_error&)
	{
		return false;
	}
	io_rValue = std::move(value);
	return true;
}

} // namespace TesselDataStore::Detail

template <typename T>
const NVX::IO::VSchemaPointer& TesselDataStore::SchemaOf()
{
	static const NVX::IO::VSchemaPointer s_pSchema = Detail::VSchemaMaker<T>::Make();
	return s_pSchema;
}

template <typename T>
NVX::IO::VVariant TesselDataStore::ToVariant(const T& i_rValue)
{
	NVX::IO::VVariant variant{SchemaOf<T>(), {}};
	Detail::VValueWriter(variant.m_Bytes).Write(i_rValue);
	return variant;
}

template <typename T>
bool TesselDataStore::FromVariant(const NVX::IO::VVariant& i_rVariant, T& io_rValue)
{
	if (!i_rVariant.m_pSchema)
		return false;
	const Detail::VReader pReader = Detail::MakeReader<T>(*i_rVariant.m_pSchema);
	return pReader && Detail::ReadWhole(*pReader, i_rVariant.m_Bytes, io_rValue);
}

#define RETARGET_STORED_VALUE(...)                                                                                     \
	template const NVX::IO::VSchemaPointer& TesselDataStore::SchemaOf<__VA_ARGS__>();                                  \
	template NVX::IO::VVariant TesselDataStore::ToVariant<__VA_ARGS__>(const __VA_ARGS__&);                            \
	template bool TesselDataStore::FromVariant<__VA_ARGS__>(const NVX::IO::VVariant&, __VA_ARGS__&);
