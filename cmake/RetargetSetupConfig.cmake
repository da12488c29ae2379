# find_package(RetargetSetup): targets RetargetSetup::<Library>, included as "Library/File.h".
include(CMakeFindDependencyMacro)
find_dependency(Boost COMPONENTS filesystem regex thread system)
find_dependency(Qt5 COMPONENTS Core Gui Qml Quick QuickWidgets Widgets)
find_dependency(PNG)
include(${CMAKE_CURRENT_LIST_DIR}/RetargetSetupTargets.cmake)
