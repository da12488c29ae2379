#include "retarget/Program.h"
#include "retarget/picture/Picture.h"

int main(int i_Count, char** i_ppArguments)
{
	return CommandLine::Run({i_ppArguments + 1, i_ppArguments + i_Count}, {CommandLine::RenderPicture, {}});
}
