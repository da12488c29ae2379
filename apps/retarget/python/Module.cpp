#include "retarget/python/Call.h"
#include "retarget/python/Files.h"
#include "retarget/python/Records.h"
#include "retarget/python/Session.h"
#include "retarget/python/Takes.h"

/// What the package retarget_setup is made of. Its own classes give it names, types and documentation.
PYBIND11_MODULE(_core, io_rModule)
{
	using namespace CommandLine::Python;
	io_rModule.def("describe_records", &DescribeRecords);
	io_rModule.def("describe_enumerations", &DescribeEnumerations);
	io_rModule.def("register",
	    [](const pybind11::dict& i_rClasses, const pybind11::object& i_rError)
	    {
		    RegisterClasses(i_rClasses);
		    // Held by the package for as long as the interpreter lives.
		    RegisterError(i_rError.inc_ref().ptr());
	    });
	DefineFiles(io_rModule);
	DefineKinematics(io_rModule);
	DefineSession(io_rModule);
	DefineTakes(io_rModule);
	io_rModule.attr("version") = RETARGET_VERSION;
	BeginListening();
	// Threads that log must not come into an interpreter that ends.
	pybind11::module_::import("atexit").attr("register")(pybind11::cpp_function(&EndListening));
}
