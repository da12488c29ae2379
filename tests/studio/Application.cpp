#include "../QtApplication.h"
#include "studio/window/DarkStyle.h"

namespace
{

// Runs of the program have OpenGL.
[[maybe_unused]] auto* const g_pApplication =
    testing::AddGlobalTestEnvironment(new VQtApplication(DrawWithoutOpenGL, StudioHost::ApplyDarkStyle));

} // namespace
