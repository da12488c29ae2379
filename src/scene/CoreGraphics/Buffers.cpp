#include "CoreGraphics/Buffers.h"

#include "DebugServices/Assert.h"

#include <QOpenGLBuffer>
#include <QOpenGLContext>
#include <QPointer>

namespace CoreGraphics
{

namespace
{

/// A buffer of the share group that it was last bound in.
class VGroupBuffer
{
public:
	explicit VGroupBuffer(QOpenGLBuffer::Type i_Type) : m_Buffer(i_Type) {}

	/// @return true if it is new in the group, and has no content yet
	bool Bind(QOpenGLBuffer::UsagePattern i_Usage)
	{
		QOpenGLContextGroup* const pGroup = QOpenGLContext::currentContext()->shareGroup();
		if (m_pGroup == pGroup)
		{
			m_Buffer.bind();
			return false;
		}
		m_Buffer = QOpenGLBuffer(m_Buffer.type());
		m_Buffer.create();
		m_Buffer.bind();
		m_Buffer.setUsagePattern(i_Usage);
		m_pGroup = pGroup;
		return true;
	}

	void Fill(const void* i_pBytes, std::size_t i_Size) { m_Buffer.allocate(i_pBytes, static_cast<int>(i_Size)); }

private:
	QOpenGLBuffer m_Buffer;
	QPointer<QOpenGLContextGroup> m_pGroup;
};

} // namespace

struct VStaticBuffer::VObject : VGroupBuffer
{
	using VGroupBuffer::VGroupBuffer;
};

struct VStreamBuffer::VObject : VGroupBuffer
{
	using VGroupBuffer::VGroupBuffer;
};

VStaticBuffer::VStaticBuffer(std::uint32_t i_Type, std::vector<std::uint8_t> i_Bytes)
    : m_Bytes(std::move(i_Bytes)), m_pObject(std::make_unique<VObject>(static_cast<QOpenGLBuffer::Type>(i_Type)))
{
}

VStaticBuffer::VStaticBuffer(VStaticBuffer&&) noexcept = default;
VStaticBuffer& VStaticBuffer::operator=(VStaticBuffer&&) noexcept = default;
VStaticBuffer::~VStaticBuffer() = default;

void VStaticBuffer::Bind()
{
	if (m_pObject->Bind(QOpenGLBuffer::StaticDraw))
		m_pObject->Fill(m_Bytes.data(), m_Bytes.size());
}

VStreamBuffer::VStreamBuffer(EStream i_Stream)
    : m_pObject(std::make_unique<VObject>(
        i_Stream == EStreamVertices ? QOpenGLBuffer::VertexBuffer : QOpenGLBuffer::IndexBuffer))
{
}

VStreamBuffer::VStreamBuffer(VStreamBuffer&&) noexcept = default;
VStreamBuffer& VStreamBuffer::operator=(VStreamBuffer&&) noexcept = default;
VStreamBuffer::~VStreamBuffer() = default;

bool VStreamBuffer::Bind()
{
	return m_pObject->Bind(QOpenGLBuffer::StreamDraw);
}

void VStreamBuffer::Upload(const void* i_pBytes, std::size_t i_Size)
{
	Bind();
	m_pObject->Fill(i_pBytes, i_Size);
}

VVertexBuffer::VVertexBuffer(VVertexFormat i_Format, std::vector<std::uint8_t> i_Bytes)
    : VStaticBuffer(QOpenGLBuffer::VertexBuffer, std::move(i_Bytes)), m_Format(std::move(i_Format)),
      m_Count(Bytes().size() / m_Format.m_Stride)
{
	NVX_ASSERT(m_Count * m_Format.m_Stride == Bytes().size());
}

VIndexBuffer::VIndexBuffer(const std::vector<std::uint16_t>& i_rIndices)
    : VIndexBuffer(BytesOf(i_rIndices), sizeof(std::uint16_t))
{
}

VIndexBuffer::VIndexBuffer(std::vector<std::uint8_t> i_Bytes, std::uint32_t i_IndexSize)
    : VStaticBuffer(QOpenGLBuffer::IndexBuffer, std::move(i_Bytes)), m_Count(Bytes().size() / i_IndexSize),
      m_Type(i_IndexSize == sizeof(std::uint16_t) ? GL_UNSIGNED_SHORT : GL_UNSIGNED_INT)
{
	NVX_ASSERT(i_IndexSize == sizeof(std::uint16_t) || i_IndexSize == sizeof(std::uint32_t));
}

} // namespace CoreGraphics
