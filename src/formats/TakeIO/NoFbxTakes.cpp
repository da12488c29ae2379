#include "TakeIO/FbxTakeReader.h"

// In the place of the reader where the SDK stands in the place of our own records.
bool TakeIO::IsFbx(std::string_view)
{
	return false;
}

bool TakeIO::ReadFbxTake(std::string_view, const VTakeSettings&, VTake&, std::string& o_rError)
{
	o_rError = "Takes of FBX files are not read";
	return false;
}
