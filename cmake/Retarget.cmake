# What every target of the tree shares.
include(${CMAKE_CURRENT_LIST_DIR}/Floors.cmake)
include(CMakePackageConfigHelpers)
include(GNUInstallDirs)

set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)
set(RETARGET_LIBRARY_DESTINATION ${CMAKE_INSTALL_LIBDIR}/RetargetSetup)
# What is installed is for who runs the programs, but for what says "development".
set(CMAKE_INSTALL_DEFAULT_COMPONENT_NAME programs)
# Installed programs and the module find the shared library beside the static ones, wherever the tree is moved to.
file(RELATIVE_PATH RETARGET_FROM_PROGRAMS /${CMAKE_INSTALL_BINDIR} /${RETARGET_LIBRARY_DESTINATION})
set(CMAKE_INSTALL_RPATH $ORIGIN $ORIGIN/${RETARGET_FROM_PROGRAMS})
# One form of code for the libraries, the module that is made of them, and the programs.
add_compile_options(-fPIC -Wall -Wextra -Wconversion -Wshadow -Werror)
if(CMAKE_CXX_COMPILER_ID MATCHES "Clang")
	# Whether a number has a sign is left out: an index that is an int and small by its loop is no fault. An assertion that
	# always fails says why, in a text that clang would take for a slip.
	add_compile_options(-Wno-sign-conversion -Wno-string-conversion)
endif()
if(WIN32)
	# Of the system's headers no macros by the names of functions, and the core of them only.
	add_compile_definitions(NOMINMAX WIN32_LEAN_AND_MEAN)
endif()
if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU" AND CMAKE_CXX_COMPILER_VERSION VERSION_LESS 13)
	# False alarms about string concatenation at -O3.
	add_compile_options(-Wno-restrict)
endif()
if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
	# It looks for what it can throw away from 512 MB on, not from 128: a twentieth of its time less.
	add_compile_options("SHELL:--param ggc-min-heapsize=524288")
endif()
# ./run and ./test compile the files of a target as one, as most of each is headers: 31 s in place of 59 s for the command
# line, which was four pieces; g++ then takes each file for a header.
set(CMAKE_UNITY_BUILD_BATCH_SIZE 0 CACHE STRING "How many files of a target are compiled as one; 0: all")
if(CMAKE_UNITY_BUILD AND CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
	add_compile_options(-Wno-subobject-linkage)
endif()

if(RETARGET_SANITIZE)
	string(APPEND CMAKE_CXX_FLAGS
		" -fsanitize=${RETARGET_SANITIZE} -fno-sanitize-recover=all -fno-omit-frame-pointer")
	# A sanitized program takes the default linker seconds.
	add_link_options(-fuse-ld=lld)
endif()
# A quarter of the time to compile is checks for undefined behaviour that find nothing of ours, or what AddressSanitizer
# finds as well: in others' headers, and, in code that computes nothing, before each access.
if(RETARGET_SANITIZE MATCHES "undefined")
	string(APPEND CMAKE_CXX_FLAGS " -fsanitize-ignorelist=${CMAKE_SOURCE_DIR}/tests/undefined.ignore")
endif()
if(RETARGET_SANITIZE MATCHES "address,undefined")
	set(RETARGET_SANITIZE_LESS -fno-sanitize=null,alignment,object-size)
endif()

# What ships stands harder against a file that finds a fault in it: an overrun ends the program before it is obeyed.
# docs/performance.md tells what that costs; the folders that compute without pause do not look at each index. For
# Windows the linker does what there is to do, unasked.
option(RETARGET_HARDENED "Harden what is built as Release" ON)
set(RETARGET_HARDENING "-U_FORTIFY_SOURCE -D_FORTIFY_SOURCE=3 -fstack-protector-strong -fstack-clash-protection")
if(CMAKE_SYSTEM_PROCESSOR MATCHES "x86_64|AMD64")
	string(APPEND RETARGET_HARDENING " -fcf-protection")
endif()
set(RETARGET_HOT_FOLDERS "^src/(base/(math|numerics)|kinematics)/?")
if(NOT CMAKE_BUILD_TYPE STREQUAL "Release" OR WIN32)
	set(RETARGET_HARDENED OFF)
endif()
if(RETARGET_HARDENED)
	add_link_options(-Wl,-z,relro,-z,now)
endif()

find_program(CCACHE ccache)
if(CCACHE AND NOT CMAKE_CXX_COMPILER_LAUNCHER)
	set(CMAKE_CXX_COMPILER_LAUNCHER ${CCACHE})
endif()

# retarget_library(NAME SOURCES ... [PUBLIC ...] [PRIVATE ...] [INTERNAL ...]): a static library that is included as
# "NAME/File.h".
function(retarget_library name)
	cmake_parse_arguments(PARSE_ARGV 1 arg "" "" "SOURCES;PUBLIC;PRIVATE;INTERNAL")
	add_library(${name} STATIC ${arg_SOURCES})
	cmake_path(GET CMAKE_CURRENT_SOURCE_DIR PARENT_PATH wing)
	target_include_directories(${name} PUBLIC $<BUILD_INTERFACE:${wing}>)
	target_link_libraries(${name} PUBLIC ${arg_PUBLIC} PRIVATE ${arg_PRIVATE})
	retarget_install(${name} ${CMAKE_CURRENT_SOURCE_DIR} ${arg_INTERNAL})
endfunction()

# retarget_qml(NAME FILE.qrc): the QML files of a resource file, compiled: a first start need not do it. Under the
# sanitizers, which look at nothing in them, they are as they are.
function(retarget_qml name file)
	if(RETARGET_SANITIZE)
		qt5_add_resources(sources ${file})
	else()
		find_package(Qt5QuickCompiler REQUIRED)
		qtquick_compiler_add_resources(sources ${file})
	endif()
	set_source_files_properties(${sources} PROPERTIES SKIP_AUTOMOC ON)
	target_sources(${name} PRIVATE ${sources})
endfunction()

# retarget_install(NAME FOLDER [INTERNAL...]): the library and the headers of a folder go into the installed package, but
# for the headers of these names, which are for the library alone; ALL are all.
function(retarget_install name folder)
	# Whoever links it compiles its headers.
	target_compile_features(${name} PUBLIC cxx_std_20)
	target_include_directories(${name} PUBLIC $<INSTALL_INTERFACE:${CMAKE_INSTALL_INCLUDEDIR}/RetargetSetup>)
	install(TARGETS ${name} EXPORT RetargetSetup
		ARCHIVE DESTINATION ${RETARGET_LIBRARY_DESTINATION} COMPONENT development
		LIBRARY DESTINATION ${RETARGET_LIBRARY_DESTINATION} NAMELINK_COMPONENT development
		RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})
	if(ARGN STREQUAL "ALL")
		return()
	endif()
	set_property(GLOBAL APPEND PROPERTY RETARGET_PUBLIC_FOLDERS ${folder})
	foreach(header IN LISTS ARGN)
		set_property(GLOBAL APPEND PROPERTY RETARGET_INTERNAL_HEADERS ${folder}/${header})
	endforeach()
	list(TRANSFORM ARGN REPLACE "(.+)" "PATTERN;\\1;EXCLUDE" OUTPUT_VARIABLE exclude)
	install(DIRECTORY ${folder} DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/RetargetSetup COMPONENT development
		FILES_MATCHING PATTERN "*.h" ${exclude})
endfunction()

# retarget_manual(PROGRAM ARGUMENTS...): installs the manual page that the program prints when it is run with these.
find_program(RETARGET_GZIP gzip REQUIRED)
function(retarget_manual program)
	# What a program leaves behind in memory is looked for by its tests.
	add_custom_command(OUTPUT ${program}.1.gz
		COMMAND ${CMAKE_COMMAND} -E env ASAN_OPTIONS=detect_leaks=0
			${CMAKE_CROSSCOMPILING_EMULATOR} $<TARGET_FILE:${program}> ${ARGN} > ${program}.1
		COMMAND ${RETARGET_GZIP} -9nf ${program}.1
		DEPENDS ${program} VERBATIM)
	add_custom_target(${program}_manual ALL DEPENDS ${program}.1.gz)
	install(FILES ${CMAKE_CURRENT_BINARY_DIR}/${program}.1.gz DESTINATION ${CMAKE_INSTALL_MANDIR}/man1)
endfunction()

# retarget_screen(VARIABLE NAME SIZE): the command by which the test of this name gets a screen of its own.
function(retarget_screen variable name size)
	find_program(RETARGET_XVFB_RUN xvfb-run REQUIRED)
	# Each test begins to look for a free display at a number of its own: two that look at once take the same one.
	string(MD5 hash "${CMAKE_BINARY_DIR}/${name}")
	string(SUBSTRING ${hash} 0 4 hash)
	math(EXPR display "100 + 0x${hash} % 30000")
	set(${variable} ${RETARGET_XVFB_RUN} -a -n ${display} -s "-screen 0 ${size}x24" PARENT_SCOPE)
endfunction()

# retarget_test(NAME [DISPLAY] [OPTIMISED] SOURCES ... LIBRARIES ...): a GoogleTest program; RETARGET_TEST_DATA is the
# folder tests/data, RETARGET_SOURCE the root of the tree, and RETARGET_SANITIZED is there under sanitizers. With DISPLAY
# it runs on a screen of its own, drawn in software. OPTIMISED is for tests that compute much themselves.
function(retarget_test name)
	cmake_parse_arguments(PARSE_ARGV 1 arg "DISPLAY;OPTIMISED" "" "SOURCES;LIBRARIES")
	add_executable(test_${name} ${arg_SOURCES})
	target_link_libraries(test_${name} PRIVATE ${arg_LIBRARIES} TestMain)
	target_compile_definitions(test_${name} PRIVATE RETARGET_TEST_DATA="${CMAKE_SOURCE_DIR}/tests/data"
		RETARGET_SOURCE="${CMAKE_SOURCE_DIR}")
	target_compile_options(test_${name} PRIVATE ${RETARGET_TEST_OPTIONS})
	if(arg_OPTIMISED)
		# At -O1 g++ takes members of a variant for uninitialised.
		target_compile_options(test_${name} PRIVATE -O1 $<$<CXX_COMPILER_ID:GNU>:-Wno-maybe-uninitialized>)
	else()
		target_precompile_headers(test_${name} REUSE_FROM TestMain)
	endif()
	set(threads "")
	if(RETARGET_SANITIZE MATCHES "thread")
		# The driver draws without threads of its own, which ThreadSanitizer does not know to wait for each other. What is
		# seen of Qt's own threads is told apart from what is ours by setup/checks/races.
		string(CONCAT threads "LP_NUM_THREADS=0;TSAN_OPTIONS=suppressions=${CMAKE_SOURCE_DIR}/tests/threads.supp"
			" exitcode=0 log_path=${CMAKE_BINARY_DIR}/races/${name}")
	endif()
	if(NOT arg_DISPLAY)
		add_test(NAME ${name} COMMAND test_${name})
		set_tests_properties(${name} PROPERTIES ENVIRONMENT "${threads}")
		return()
	endif()
	if(RETARGET_SANITIZE)
		target_sources(test_${name} PRIVATE ${CMAKE_SOURCE_DIR}/tests/DriversUnderSanitizers.cpp)
	endif()
	retarget_screen(screen ${name} 1920x1200)
	add_test(NAME ${name} COMMAND ${screen} $<TARGET_FILE:test_${name}>)
	# XCB copies texts that do not end in a zero, with their length: the strict checks take that for an overflow. Without
	# a word about the session's bus Qt would try to start one, in a thread that may be in the midst of it at the end.
	set_tests_properties(${name} PROPERTIES ENVIRONMENT
		"QT_QPA_PLATFORM=xcb;LIBGL_ALWAYS_SOFTWARE=1;DBUS_SESSION_BUS_ADDRESS=disabled:;ASAN_OPTIONS=detect_leaks=1;${threads}")
endfunction()

# retarget_long_test(NAME SECONDS): begins before shorter ones, so that it does not run alone at the end.
function(retarget_long_test name seconds)
	set_tests_properties(${name} PROPERTIES COST ${seconds})
endfunction()

# retarget_docs(): the target "docs", pages of the headers that are installed, in the build folder's docs/.
function(retarget_docs)
	find_program(RETARGET_DOXYGEN doxygen)
	if(NOT RETARGET_DOXYGEN)
		add_custom_target(docs COMMAND ${CMAKE_COMMAND} -E echo "The pages need Debian's package doxygen; then cmake again"
			COMMAND ${CMAKE_COMMAND} -E false)
		return()
	endif()
	get_property(folders GLOBAL PROPERTY RETARGET_PUBLIC_FOLDERS)
	get_property(internal GLOBAL PROPERTY RETARGET_INTERNAL_HEADERS)
	list(JOIN folders "\" \\\n\"" folders)
	list(JOIN internal "\" \\\n\"" internal)
	configure_file(${PROJECT_SOURCE_DIR}/cmake/Doxyfile.in ${PROJECT_BINARY_DIR}/Doxyfile @ONLY)
	add_custom_target(docs COMMAND ${RETARGET_DOXYGEN} ${PROJECT_BINARY_DIR}/Doxyfile
		COMMAND ${CMAKE_COMMAND} -E echo "The pages begin at ${PROJECT_BINARY_DIR}/docs/index.html" VERBATIM)
endfunction()

# retarget_pkg_config(NAME DESCRIPTION FLAGS REQUIRES LIBRARIES): a pkg-config file.
function(retarget_pkg_config name description flags requires libraries)
	file(RELATIVE_PATH to_prefix /x/${CMAKE_INSTALL_LIBDIR}/pkgconfig /x)
	configure_file(${PROJECT_SOURCE_DIR}/cmake/retarget-setup.pc.in ${PROJECT_BINARY_DIR}/${name}.pc @ONLY)
	install(FILES ${PROJECT_BINARY_DIR}/${name}.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig COMPONENT development)
endfunction()

# retarget_package(): the CMake package config of all that was installed, so that find_package(RetargetSetup) gives
# RetargetSetup::<Library>, and the same for pkg-config: "retarget-setup", and "retarget-setup-qt" for what needs Qt.
function(retarget_package)
	set(folder ${CMAKE_INSTALL_LIBDIR}/cmake/RetargetSetup)
	install(EXPORT RetargetSetup FILE RetargetSetupTargets.cmake NAMESPACE RetargetSetup:: DESTINATION ${folder}
		COMPONENT development)
	write_basic_package_version_file(${PROJECT_BINARY_DIR}/RetargetSetupConfigVersion.cmake COMPATIBILITY SameMinorVersion)
	configure_file(${PROJECT_SOURCE_DIR}/cmake/RetargetSetupConfig.cmake ${PROJECT_BINARY_DIR}/RetargetSetupConfig.cmake
		@ONLY)
	install(FILES ${PROJECT_BINARY_DIR}/RetargetSetupConfigVersion.cmake ${PROJECT_BINARY_DIR}/RetargetSetupConfig.cmake
		DESTINATION ${folder} COMPONENT development)

	foreach(folder IN LISTS RETARGET_LIBRARY_FOLDERS)
		cmake_path(GET folder FILENAME library)
		if(library STREQUAL "host")
			set(library RetargetSetupHost)
		elseif(library STREQUAL "TesselPluginRetargetSetup")
			set(library RetargetSetupPanel)
		endif()
		if(folder IN_LIST RETARGET_QT_LIBRARY_FOLDERS)
			string(PREPEND qt_libraries "-l${library} ")
		else()
			string(PREPEND libraries "-l${library} ")
		endif()
	endforeach()
	set(system "-lboost_regex -lboost_filesystem -ldl -pthread")
	retarget_pkg_config(retarget-setup "Subjects, skeleton and FBX files, kinematics" "-I\${includedir} -std=c++20"
		"libdeflate nettle" "-L\${libdir} -Wl,-rpath,\${libdir} ${libraries}${system}")
	if(RETARGET_QT)
		retarget_pkg_config(retarget-setup-qt "The preview and the panel of retarget subjects" "" 
			"retarget-setup libpng Qt5Widgets Qt5QuickWidgets Qt5Quick Qt5Qml Qt5Gui Qt5Core" "${qt_libraries}")
	endif()
endfunction()
