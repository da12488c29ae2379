# Debian packages by "cpack": retarget-setup, the component "programs"; retarget-setup-dev, "development"; and, where it is
# built, python3-retarget-setup, "python".
include(${CMAKE_CURRENT_LIST_DIR}/Floors.cmake)
set(RETARGET_MAINTAINER "Retarget Setup <retarget-setup@packages.invalid>" CACHE STRING
	"Who answers for the packages: a name and an address, as Debian writes them")
set(release 1)

# What every Debian package brings: licence, changes, and which complaints of lintian are meant to stay.
set(folder ${PROJECT_BINARY_DIR}/debian)
string(TIMESTAMP date "%a, %d %b %Y %H:%M:%S +0000" UTC)
file(CONFIGURE OUTPUT debian/changelog.Debian @ONLY CONTENT "retarget-setup (@PROJECT_VERSION@-@release@) bookworm; \
urgency=medium\n\n  * The changes are told in changelog.gz.\n\n -- @RETARGET_MAINTAINER@  @date@\n")
configure_file(${PROJECT_SOURCE_DIR}/CHANGELOG.md ${folder}/changelog COPYONLY)
foreach(file changelog changelog.Debian)
	execute_process(COMMAND ${RETARGET_GZIP} -9nc ${folder}/${file} OUTPUT_FILE ${folder}/${file}.gz
		COMMAND_ERROR_IS_FATAL ANY)
endforeach()
set(components programs development)
set(package_programs retarget-setup)
set(package_development retarget-setup-dev)
if(TARGET retarget_setup_core)
	list(APPEND components python)
	set(package_python python3-retarget-setup)
endif()
foreach(component IN LISTS components)
	set(package ${package_${component}})
	install(FILES ${PROJECT_SOURCE_DIR}/cmake/debian/copyright ${folder}/changelog.gz ${folder}/changelog.Debian.gz
		DESTINATION ${CMAKE_INSTALL_DATADIR}/doc/${package} COMPONENT ${component})
	configure_file(${PROJECT_SOURCE_DIR}/cmake/debian/lintian-overrides ${folder}/${package}.lintian-overrides @ONLY)
	install(FILES ${folder}/${package}.lintian-overrides DESTINATION ${CMAKE_INSTALL_DATADIR}/lintian/overrides
		RENAME ${package} COMPONENT ${component})
endforeach()
install(DIRECTORY ${PROJECT_SOURCE_DIR}/demo DESTINATION ${CMAKE_INSTALL_DATADIR}/doc/retarget-setup/examples
	COMPONENT programs FILES_MATCHING REGEX "\\.(bvh|fbx|json|qrs)$")
install(DIRECTORY ${PROJECT_SOURCE_DIR}/examples/batch DESTINATION ${CMAKE_INSTALL_DATADIR}/doc/retarget-setup/examples
	COMPONENT programs PATTERN make_example.py EXCLUDE PATTERN __pycache__ EXCLUDE)

# What is loaded at run time is not seen by dpkg-shlibdeps: LAPACK, and the toolkit's QML modules.
set(loaded liblapacke)
set(window)
set(headers libboost-filesystem-dev libboost-regex-dev libboost-system-dev libdeflate-dev nettle-dev)
if(RETARGET_QT)
	file(STRINGS ${PROJECT_SOURCE_DIR}/setup/packages modules REGEX "^build .*qml-module-")
	string(REGEX MATCHALL "qml-module-[a-z0-9-]+" modules "${modules}")
	list(APPEND loaded ${modules})
	list(APPEND headers libpng-dev qtbase5-dev qtdeclarative5-dev)
	set(CPACK_DEBIAN_PROGRAMS_PACKAGE_SUGGESTS "snakemake, xvfb, xauth")
	set(window ",\nthe studio in a window with a preview")
endif()
list(JOIN loaded ", " CPACK_DEBIAN_PROGRAMS_PACKAGE_DEPENDS)
list(JOIN headers ", " headers)

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME retarget-setup)
set(CPACK_PACKAGE_CONTACT "${RETARGET_MAINTAINER}")
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE
	WORLD_READ WORLD_EXECUTE)
set(CPACK_STRIP_FILES ON)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_COMPONENTS_ALL ${components})
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_COMPRESSION_TYPE xz)
set(CPACK_DEBIAN_PACKAGE_RELEASE ${release})
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_DEBIAN_PROGRAMS_PACKAGE_NAME ${package_programs})
set(CPACK_DEBIAN_PROGRAMS_PACKAGE_SECTION graphics)
set(CPACK_DEBIAN_PROGRAMS_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${PROJECT_BINARY_DIR}/src/base/host)
set(CPACK_DEBIAN_PROGRAMS_DESCRIPTION "ties a performer's skeleton to a character's for motion capture
From the performer's skeleton file and the character's FBX it builds a
retarget subject, which tells a real-time solver which segment of the
performer drives which segment of the character. The command line does so
in scripts and batches${window}.")
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_NAME ${package_development})
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_SECTION libdevel)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_DEPENDS "retarget-setup (= ${PROJECT_VERSION}-${release}), ${headers}")
set(CPACK_DEBIAN_DEVELOPMENT_DESCRIPTION "libraries and headers of Retarget Setup
Static libraries with their headers: retarget subjects, skeleton and FBX
files, forward kinematics, and what is done with them. A CMake package and
pkg-config files stand beside them.")
if(TARGET retarget_setup_core)
	# The module is made for this Python alone.
	execute_process(COMMAND ${Python_EXECUTABLE} -c "import sys; print(sys.version_info.minor)" OUTPUT_VARIABLE minor
		OUTPUT_STRIP_TRAILING_WHITESPACE COMMAND_ERROR_IS_FATAL ANY)
	math(EXPR next "${minor} + 1")
	set(CPACK_DEBIAN_PYTHON_PACKAGE_NAME ${package_python})
	set(CPACK_DEBIAN_PYTHON_PACKAGE_SECTION python)
	set(CPACK_DEBIAN_PYTHON_PACKAGE_SHLIBDEPS ON)
	set(CPACK_DEBIAN_PYTHON_PACKAGE_DEPENDS "retarget-setup (= ${PROJECT_VERSION}-${release}), python3-numpy, \
python3 (>= 3.${minor}~), python3 (<< 3.${next}~)")
	set(CPACK_DEBIAN_PYTHON_DESCRIPTION "retarget subjects from Python
The work of the command line as a Python package: sessions that make and
edit retarget subjects, files as objects, kinematics on numpy arrays.")
endif()
include(CPack)
