#include "QueryCount.h"

#include <QOpenGLContext>

#include <string_view>

VQueryCount::VQueryCount() : QOpenGLFunctions(QOpenGLContext::currentContext())
{
	s_Count = 0;
	const auto isQuery = [](std::string_view i_Name) { return i_Name.starts_with("Get") || i_Name == "IsEnabled"; };
#define RETARGET_REPLACE(result, name, arguments)                                                                      \
	if (isQuery(#name))                                                                                                \
		Replace<__COUNTER__>(d_ptr->f.name);
	QT_OPENGL_FUNCTIONS(RETARGET_REPLACE)
#undef RETARGET_REPLACE
}

VQueryCount::~VQueryCount()
{
	for (const std::function<void()>& rRestore : m_Restore)
		rRestore();
}
