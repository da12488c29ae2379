# Installs the build into a folder of its own, builds the consumer against it, and runs it.
set(prefix ${build}/package-test)
file(REMOVE_RECURSE ${prefix})
foreach(command IN ITEMS
	"${CMAKE_COMMAND};--install;${build};--prefix;${prefix}"
	"${CMAKE_COMMAND};-G;Ninja;-S;${CMAKE_CURRENT_LIST_DIR}/consumer;-B;${prefix}/consumer;-DCMAKE_PREFIX_PATH=${prefix};-DCMAKE_CXX_COMPILER=${compiler}"
	"${CMAKE_COMMAND};--build;${prefix}/consumer"
	"${prefix}/consumer/consumer;${CMAKE_CURRENT_LIST_DIR}/../../demo/character.fbx"
	"${prefix}/bin/retarget;--version"
	"${prefix}/bin/retarget-studio;--version")
	execute_process(COMMAND ${command} RESULT_VARIABLE result OUTPUT_VARIABLE output ERROR_VARIABLE output)
	if(NOT result EQUAL 0)
		message(FATAL_ERROR "${command}:\n${output}")
	endif()
endforeach()
