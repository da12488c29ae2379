# Fails if a program needs Qt, a display or LAPACK to start.
file(GET_RUNTIME_DEPENDENCIES EXECUTABLES ${program} RESOLVED_DEPENDENCIES_VAR needed
	UNRESOLVED_DEPENDENCIES_VAR missing)
set(libraries ${needed} ${missing})
if(NOT libraries MATCHES "RetargetSetupHost")
	message(FATAL_ERROR "The libraries of ${program} were not found: the check itself is broken.")
endif()
list(FILTER libraries INCLUDE REGEX "/?lib(Qt|GL|EGL|X11|xcb|lapack|openblas|blas)[^/]*$")
if(libraries)
	message(FATAL_ERROR "${program} needs ${libraries}")
endif()
