# Installs the build into a folder of its own, builds the consumer against it, and runs it.
set(prefix ${build}/package-test)
set(consumer ${CMAKE_CURRENT_LIST_DIR}/consumer)
file(REMOVE_RECURSE ${prefix})
# The desktop's entry names the kinds of files that are declared beside it.
function(check_kinds)
	file(STRINGS ${prefix}/share/applications/retarget-studio.desktop kinds REGEX "^MimeType=")
	file(READ ${prefix}/share/mime/packages/retarget-setup.xml declared)
	string(REGEX MATCHALL "[a-z]+/[-a-z+]+" kinds "${kinds}")
	foreach(kind IN LISTS kinds ITEMS application/x-retarget-subject+xml)
		string(FIND "${declared}" "mime-type type=\"${kind}\"" at)
		if(at LESS 0)
			message(FATAL_ERROR "${kind} is declared nowhere")
		endif()
	endforeach()
endfunction()

# What a header of the package includes of ours is in it, too, and what is for a library alone is not.
function(check_headers)
	set(folder ${prefix}/include/RetargetSetup)
	file(GLOB_RECURSE headers ${folder}/*.h)
	list(LENGTH headers count)
	if(count LESS 100)
		message(FATAL_ERROR "${count} headers are installed")
	endif()
	foreach(header IN LISTS headers)
		file(STRINGS ${header} includes REGEX "^#include \"")
		foreach(include IN LISTS includes)
			string(REGEX REPLACE ".*\"(.*)\".*" "\\1" include "${include}")
			if(NOT EXISTS ${folder}/${include})
				message(FATAL_ERROR "${header} includes ${include}, which is not installed")
			endif()
		endforeach()
	endforeach()
	string(REPLACE "|" ";" internal "${internal}")
	foreach(header IN LISTS internal)
		string(REGEX REPLACE ".*/src/[a-z]+/" "" header "${header}")
		file(GLOB installed ${folder}/${header})
		if(installed)
			message(FATAL_ERROR "${header} is for its library alone, and is installed")
		endif()
	endforeach()
endfunction()

# What is installed is placed anywhere, its tables are bound and read-only before it begins, its stack and copies guarded.
function(check_hardened)
	file(GLOB_RECURSE module ${prefix}/*/TesselPluginRetargetSetup.so)
	foreach(program IN ITEMS ${prefix}/bin/retarget ${prefix}/bin/retarget-studio ${module})
		execute_process(COMMAND readelf -hdlW --dyn-syms ${program} OUTPUT_VARIABLE elf COMMAND_ERROR_IS_FATAL ANY)
		foreach(sign IN ITEMS "Type: +DYN" " NOW" GNU_RELRO __stack_chk_fail "__[a-z]+_chk@")
			if(NOT elf MATCHES "${sign}")
				message(FATAL_ERROR "${program} is not hardened: it has no \"${sign}\"")
			endif()
		endforeach()
	endforeach()
endfunction()

foreach(command IN ITEMS
	"${CMAKE_COMMAND};--install;${build};--prefix;${prefix}"
	"${CMAKE_COMMAND};-G;Ninja;-S;${consumer};-B;${prefix}/consumer;-DCMAKE_PREFIX_PATH=${prefix};-DCMAKE_CXX_COMPILER=${compiler}"
	"${CMAKE_COMMAND};--build;${prefix}/consumer"
	"${prefix}/consumer/consumer;${CMAKE_CURRENT_LIST_DIR}/../../demo/character.fbx"
	"sh;-c;exec ${compiler} ${consumer}/main.cpp -o ${prefix}/by-pkg-config $(PKG_CONFIG_PATH=${prefix}/lib/pkgconfig pkg-config --cflags --libs retarget-setup)"
	"${prefix}/by-pkg-config;${CMAKE_CURRENT_LIST_DIR}/../../demo/character.fbx"
	"${prefix}/bin/retarget;--version"
	"${prefix}/bin/retarget-studio;--version")
	execute_process(COMMAND ${command} RESULT_VARIABLE result OUTPUT_VARIABLE output ERROR_VARIABLE output)
	if(NOT result EQUAL 0)
		message(FATAL_ERROR "${command}:\n${output}")
	endif()
endforeach()
check_headers()
check_kinds()
if(hardened)
	check_hardened()
endif()
