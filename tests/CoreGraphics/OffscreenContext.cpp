#include "OffscreenContext.h"

#include <QSurfaceFormat>

namespace GraphicsTest
{

VOffscreenContext::VOffscreenContext(EDialect i_Dialect, QOpenGLContext* i_pShare)
{
	QSurfaceFormat format;
	format.setRenderableType(i_Dialect == EDialect::ES2 ? QSurfaceFormat::OpenGLES : QSurfaceFormat::OpenGL);
	format.setVersion(2, i_Dialect == EDialect::ES2 ? 0 : 1);
	format.setDepthBufferSize(24);
	m_Surface.setFormat(format);
	m_Surface.create();
	m_Context.setFormat(format);
	m_Context.setShareContext(i_pShare);
	EXPECT_TRUE(m_Context.create());
	EXPECT_TRUE(m_Context.makeCurrent(&m_Surface));
	EXPECT_EQ(m_Context.isOpenGLES(), i_Dialect == EDialect::ES2);
}

VOffscreenContext::~VOffscreenContext()
{
	m_Context.doneCurrent();
}

std::string DialectName(const testing::TestParamInfo<EDialect>& i_rInfo)
{
	return i_rInfo.param == EDialect::ES2 ? "ES2" : "Desktop";
}

} // namespace GraphicsTest
