# find_package(RetargetSetup): targets RetargetSetup::<Library>, included as "Library/File.h".
include(CMakeFindDependencyMacro)
find_dependency(Threads)
find_dependency(Boost COMPONENTS filesystem regex system)
# Whether the libraries that draw and show were built.
if(@RETARGET_QT@)
	find_dependency(Qt5 COMPONENTS Core Gui Qml Quick QuickWidgets Widgets)
	find_dependency(PNG)
endif()
include(${CMAKE_CURRENT_LIST_DIR}/RetargetSetupTargets.cmake)
