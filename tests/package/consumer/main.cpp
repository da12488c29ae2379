#include "DebugServices/GlobalLog.h"
#include "math/NumberText.h"

int main()
{
	return NumberText::PrintG17(0.5) == "0.5" && NVX::GlobalLog::Category("Consumer").Name() == "Consumer" ? 0 : 1;
}
