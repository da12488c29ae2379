#pragma once

#include "Variant/Schema.h"

namespace NVX::IO
{

/// A value of any type: its bytes, and the schema that tells how to read them.
struct VVariant
{
	/// Null for no value at all.
	VSchemaPointer m_pSchema;
	/// Little-endian, without padding. Numbers, booleans and enumerations in the size of their type; a text or list as
	/// a 32-bit count and that many bytes or elements; arrays and tuples as what they hold, one behind the other.
	std::string m_Bytes;

	bool IsEmpty() const { return !m_pSchema || m_pSchema->m_Type == EType::EVoid; }

	friend bool operator==(const VVariant& i_rLeft, const VVariant& i_rRight)
	{
		return i_rLeft.m_Bytes == i_rRight.m_Bytes && SameSchema(i_rLeft.m_pSchema, i_rRight.m_pSchema);
	}
};

} // namespace NVX::IO
