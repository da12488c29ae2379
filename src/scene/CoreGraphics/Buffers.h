#pragma once

#include "CoreGraphics/VertexFormat.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

namespace CoreGraphics
{

/// Plain records as they lie in memory.
template <typename T>
std::vector<std::uint8_t> BytesOf(const std::vector<T>& i_rRecords)
{
	const auto* pFirst = reinterpret_cast<const std::uint8_t*>(i_rRecords.data());
	return {pFirst, pFirst + i_rRecords.size() * sizeof(T)};
}

/// Bytes that live in an OpenGL buffer, too: uploaded when they are bound for the first time in a share group, so that
/// they can be made without OpenGL and outlive a context. They never change.
class VStaticBuffer
{
public:
	VStaticBuffer(VStaticBuffer&&) noexcept;
	VStaticBuffer& operator=(VStaticBuffer&&) noexcept;
	~VStaticBuffer();

	/// Needs the context to be current.
	void Bind();
	const std::vector<std::uint8_t>& Bytes() const { return m_Bytes; }

protected:
	/// @param i_Type QOpenGLBuffer::Type
	VStaticBuffer(std::uint32_t i_Type, std::vector<std::uint8_t> i_Bytes);

private:
	struct VObject;
	std::vector<std::uint8_t> m_Bytes;
	std::unique_ptr<VObject> m_pObject;
};

/// What a stream buffer holds.
enum EStream : std::uint32_t
{
	EStreamVertices,
	EStreamIndices
};

/// Vertices that are others in each frame, or their order.
class VStreamBuffer
{
public:
	explicit VStreamBuffer(EStream i_Stream = EStreamVertices);
	VStreamBuffer(VStreamBuffer&&) noexcept;
	VStreamBuffer& operator=(VStreamBuffer&&) noexcept;
	~VStreamBuffer();

	/// @return true if nothing is in it: at first, and in another share group. Needs the context to be current, as does
	/// the next one.
	bool Bind();
	/// Binds the buffer with these bytes in it.
	void Upload(const void* i_pBytes, std::size_t i_Size);

private:
	struct VObject;
	std::unique_ptr<VObject> m_pObject;
};

/// The vertices of a shape.
class VVertexBuffer : public VStaticBuffer
{
public:
	/// @param i_Bytes vertices of the format, one after the other, see BytesOf
	VVertexBuffer(VVertexFormat i_Format, std::vector<std::uint8_t> i_Bytes);

	const VVertexFormat& Format() const { return m_Format; }
	std::size_t Count() const { return m_Count; }

private:
	VVertexFormat m_Format;
	std::size_t m_Count;
};

/// The order of a shape's vertices.
class VIndexBuffer : public VStaticBuffer
{
public:
	explicit VIndexBuffer(const std::vector<std::uint16_t>& i_rIndices);
	/// @param i_IndexSize bytes of one index, 2 or 4
	VIndexBuffer(std::vector<std::uint8_t> i_Bytes, std::uint32_t i_IndexSize);

	std::size_t Count() const { return m_Count; }
	/// GL_UNSIGNED_SHORT or GL_UNSIGNED_INT.
	std::uint32_t Type() const { return m_Type; }

private:
	std::size_t m_Count;
	std::uint32_t m_Type;
};

} // namespace CoreGraphics
