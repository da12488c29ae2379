#include <QApplication>
#include <gtest/gtest.h>

#include <memory>

namespace
{

/// The one application of the process. It ends before the process's own objects do, as OpenGL's contexts have to.
class VApplication : public testing::Environment
{
public:
	void SetUp() override
	{
		QCoreApplication::setAttribute(Qt::AA_ShareOpenGLContexts);
		m_pApplication = std::make_unique<QApplication>(m_Count, m_pArguments);
	}
	void TearDown() override { m_pApplication.reset(); }

private:
	char m_Program[5] = "test";
	char* m_pArguments[2] = {m_Program, nullptr};
	int m_Count = 1;
	std::unique_ptr<QApplication> m_pApplication;
};

[[maybe_unused]] auto* const s_pEnvironment = testing::AddGlobalTestEnvironment(new VApplication);

} // namespace
