#include "retarget/Picture.h"
#include "retarget/Program.h"

int main(int i_Count, char** i_ppArguments)
{
	return CommandLine::Run({i_ppArguments + 1, i_ppArguments + i_Count}, CommandLine::RenderPicture);
}
