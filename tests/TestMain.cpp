#include <gtest/gtest.h>

#include <clocale>
#include <exception>
#include <locale>

#ifdef RETARGET_SANITIZED
/// Where LOCPATH is set, the C library loses the list of folders that it made of it; whether the leak checker sees that
/// depends on what happens to stand in memory.
extern "C" const char* __lsan_default_suppressions()
{
	return "leak:argz_add_sep\n";
}
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
	return RUN_ALL_TESTS();
}
