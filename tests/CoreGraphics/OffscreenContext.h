#pragma once

#include <QOffscreenSurface>
#include <QOpenGLContext>
#include <QOpenGLFunctions>

#include <gtest/gtest.h>

#include <string>

namespace GraphicsTest
{

enum class EDialect
{
	Desktop,
	ES2
};

/// An OpenGL 2.1 or OpenGL ES 2.0 context that is current on a surface of its own for as long as it lives. Without a
/// display, or without OpenGL, the test fails.
class VOffscreenContext
{
public:
	explicit VOffscreenContext(EDialect i_Dialect, QOpenGLContext* i_pShare = nullptr);
	~VOffscreenContext();

	bool IsValid() const { return m_Context.isValid(); }
	void MakeCurrent() { m_Context.makeCurrent(&m_Surface); }
	QOpenGLContext& Context() { return m_Context; }
	QOpenGLFunctions& GL() { return *m_Context.functions(); }

private:
	QOffscreenSurface m_Surface;
	QOpenGLContext m_Context;
};

/// A test in both dialects.
class InBothDialects : public testing::TestWithParam<EDialect>
{
protected:
	void SetUp() override { ASSERT_TRUE(m_Context.IsValid()); }
	/// Whatever a test did, OpenGL did not complain.
	void TearDown() override { EXPECT_EQ(m_Context.GL().glGetError(), static_cast<GLenum>(GL_NO_ERROR)); }

	VOffscreenContext m_Context{GetParam()};
};

std::string DialectName(const testing::TestParamInfo<EDialect>& i_rInfo);

} // namespace GraphicsTest

#define INSTANTIATE_IN_BOTH_DIALECTS(i_Suite)                                                                          \
	INSTANTIATE_TEST_SUITE_P(Dialects, i_Suite,                                                                        \
	    testing::Values(GraphicsTest::EDialect::Desktop, GraphicsTest::EDialect::ES2), GraphicsTest::DialectName)
