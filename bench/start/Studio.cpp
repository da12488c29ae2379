// The program retarget-studio up to its first picture.
#include "FirstPicture.h"
#include "studio/Program.h"

int main(int i_Count, char** i_ppArguments)
{
	TellFirstPicture();
	return StudioHost::Run(i_Count, i_ppArguments);
}
