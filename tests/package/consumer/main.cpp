#include "math/NumberText.h"

int main()
{
	return NumberText::PrintG17(0.5) == "0.5" ? 0 : 1;
}
