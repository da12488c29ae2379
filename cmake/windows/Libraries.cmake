# What find_package finds for Windows: headers of Debian's packages, and the few compiled parts from their sources, which
# setup/windows-sources lays out in the build folder.
set(RETARGET_SOURCES ${CMAKE_BINARY_DIR}/sources)
set(RETARGET_PROVIDED Boost CLI11 Eigen3 GTest nlohmann_json)

macro(retarget_provide method package)
	if("${package}" IN_LIST RETARGET_PROVIDED)
		set(${package}_FOUND TRUE)
		retarget_provide_targets()
	endif()
endmacro()

# retarget_foreign(NAME FILE...): a library that is not ours, from its source.
function(retarget_foreign name)
	add_library(${name} STATIC EXCLUDE_FROM_ALL ${ARGN})
	set_target_properties(${name} PROPERTIES UNITY_BUILD OFF COMPILE_OPTIONS "")
	target_compile_options(${name} PRIVATE -w -O2)
endfunction()

macro(retarget_provide_targets)
	if(NOT TARGET Boost::headers)
		enable_language(C)
		foreach(headers Boost::headers CLI11::CLI11 Eigen3::Eigen nlohmann_json::nlohmann_json)
			add_library(${headers} INTERFACE IMPORTED GLOBAL)
			target_include_directories(${headers} SYSTEM INTERFACE ${RETARGET_SOURCES}/include)
		endforeach()
		target_include_directories(Eigen3::Eigen SYSTEM INTERFACE ${RETARGET_SOURCES}/include/eigen3)
		# Headers that no package names, as rapidxml's.
		include_directories(SYSTEM ${RETARGET_SOURCES}/include)
		# As wide as the system's calls are used: since Windows 7.
		add_compile_definitions(_WIN32_WINNT=0x0601 BOOST_ALL_NO_LIB)

		foreach(part filesystem regex)
			file(GLOB sources ${RETARGET_SOURCES}/boost/libs/${part}/src/*.cpp)
			retarget_foreign(boost_${part} ${sources})
			target_link_libraries(boost_${part} PUBLIC Boost::headers)
			add_library(Boost::${part} ALIAS boost_${part})
		endforeach()
		file(GLOB sources ${RETARGET_SOURCES}/libdeflate/lib/*.c ${RETARGET_SOURCES}/libdeflate/lib/x86/*.c)
		retarget_foreign(deflate ${sources})
		target_include_directories(deflate SYSTEM PUBLIC ${RETARGET_SOURCES}/libdeflate)
		set(nettle ${RETARGET_SOURCES}/include/nettle)
		retarget_foreign(nettle ${nettle}/sha256.c ${nettle}/sha256-compress.c ${nettle}/write-be32.c)
		retarget_foreign(gtest /usr/src/googletest/googletest/src/gtest-all.cc)
		target_include_directories(gtest SYSTEM PUBLIC /usr/src/googletest/googletest/include
			PRIVATE /usr/src/googletest/googletest)
		add_library(GTest::gtest ALIAS gtest)
	endif()
endmacro()

cmake_language(SET_DEPENDENCY_PROVIDER retarget_provide SUPPORTED_METHODS FIND_PACKAGE)
