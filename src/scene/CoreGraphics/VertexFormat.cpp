#include "CoreGraphics/VertexFormat.h"

#include <qopengl.h>

namespace CoreGraphics
{

const VVertexFormat& VVertexFormat::Format2D()
{
	static const VVertexFormat s_Format{{{EAttributePosition, 2, 0, GL_FLOAT, 0}}, 8};
	return s_Format;
}

const VVertexFormat& VVertexFormat::Format3D()
{
	static const VVertexFormat s_Format{{{EAttributePosition, 3, 0, GL_FLOAT, 0}}, 12};
	return s_Format;
}

const VVertexFormat& VVertexFormat::PositionColour()
{
	static const VVertexFormat s_Format{
	    {{EAttributePosition, 3, 0, GL_FLOAT, 0}, {EAttributeColour, 4, 1, GL_UNSIGNED_BYTE, 12}}, 16};
	return s_Format;
}

const VVertexFormat& VVertexFormat::PositionNormal()
{
	static const VVertexFormat s_Format{
	    {{EAttributePosition, 3, 0, GL_FLOAT, 0}, {EAttributeNormal, 3, 0, GL_FLOAT, 12}}, 24};
	return s_Format;
}

const VVertexFormat& VVertexFormat::Mesh()
{
	static const VVertexFormat s_Format{{{EAttributePosition, 3, 0, GL_FLOAT, 0},
	                                        {EAttributeNormal, 3, 0, GL_FLOAT, 12}, {EAttributeUV, 2, 0, GL_FLOAT, 24}},
	    32};
	return s_Format;
}

const VVertexFormat& VVertexFormat::Skin()
{
	static const VVertexFormat s_Format = []
	{
		VVertexFormat format = Mesh();
		format.m_Entries.push_back({EAttributeBoneIndices, 4, 0, GL_UNSIGNED_BYTE, 32});
		format.m_Entries.push_back({EAttributeBoneWeights, 4, 1, GL_UNSIGNED_BYTE, 36});
		format.m_Stride = 40;
		return format;
	}();
	return s_Format;
}

} // namespace CoreGraphics
