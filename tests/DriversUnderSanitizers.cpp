/// In place of the C library's: drivers stay loaded to the end, so that the leak checker still has their names.
extern "C" int dlclose(void*)
{
	return 0;
}

/// To find the variables that a thread has in a library loaded later, the sanitizer takes what stands in memory before
/// them for their place and size where their address ends in 0x010; with a driver's, it is anything, and the leak
/// checker dies of it. It does without.
extern "C" const char* __asan_default_options()
{
	return "intercept_tls_get_addr=0";
}
