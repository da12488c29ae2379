#include "CoreGraphics/Buffers.h"

#include "DebugServices/Assert.h"

#include <QOpenGLBuffer>
#include <QOpenGLContext>
#include <QPointer>

namespace CoreGraphics
{

struct VStaticBuffer::VObject
{
	explicit VObject(std::uint32_t i_Type) : m_Buffer(static_cast<QOpenGLBuffer::Type>(i_Type)) {}

	QOpenGLBuffer m_Buffer;
	QPointer<QOpenGLContextGroup> m_pGroup;
};

VStaticBuffer::VStaticBuffer(std::uint32_t i_Type, std::vector<std::uint8_t> i_Bytes)
    : m_Bytes(std::move(i_Bytes)), m_pObject(std::make_unique<VObject>(i_Type))
{
}

VStaticBuffer::VStaticBuffer(VStaticBuffer&&) noexcept = default;
VStaticBuffer& VStaticBuffer::operator=(VStaticBuffer&&) noexcept = default;
VStaticBuffer::~VStaticBuffer() = default;

void VStaticBuffer::Bind()
{
	QOpenGLContextGroup* pGroup = QOpenGLContext::currentContext()->shareGroup();
	if (m_pObject->m_pGroup == pGroup)
	{
		m_pObject->m_Buffer.bind();
		return;
	}
	m_pObject = std::make_unique<VObject>(m_pObject->m_Buffer.type());
	m_pObject->m_Buffer.create();
	m_pObject->m_Buffer.bind();
	m_pObject->m_Buffer.setUsagePattern(QOpenGLBuffer::StaticDraw);
	m_pObject->m_Buffer.allocate(m_Bytes.data(), static_cast<int>(m_Bytes.size()));
	m_pObject->m_pGroup = pGroup;
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
