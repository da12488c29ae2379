#include "studio/Program.h"

int main(int i_Count, char** i_ppArguments)
{
	return StudioHost::Run(i_Count, i_ppArguments);
}
