#include <gtest/gtest.h>

#include <clocale>
#include <exception>
#include <locale>

#ifdef RETARGET_SANITIZED
extern "C" [[gnu::weak]] void __lsan_do_leak_check();
#endif

/// Tests run in the language of the environment, as code inside a window's process does: number text must not care.
int main(int i_Count, char** i_ppArguments)
{
	std::setlocale(LC_ALL, "");
	try
	{
		std::locale::global(std::locale(""));
	}
	catch (const std::exception&)
	{
		// The environment names a language that is not installed; the C library stays in "C" then, too.
	}
#ifdef LC_MESSAGES
	// What the system says of errors stays comparable.
	std::setlocale(LC_MESSAGES, "C");
#endif
	testing::InitGoogleTest(&i_Count, i_ppArguments);
	const int result = RUN_ALL_TESTS();
#ifdef RETARGET_SANITIZED
	// Left to the program's end, the leak checker, which stops all threads, can fall over one of Qt's or of the driver's
	// that is half gone by then.
	if (__lsan_do_leak_check)
		__lsan_do_leak_check();
#endif
	return result;
}
