#include "MotionIO/PrintMotion.h"

// In the place of the printing where the SDK stands in the place of our own records.
std::optional<MotionIO::EMotionForm> MotionIO::MotionFormOf(std::string_view)
{
	return std::nullopt;
}

MotionIO::EPrinted MotionIO::PrintMotion(const TakeIO::VTake&, EMotionForm, const VCharacterFile*,
    const VMotionSettings&, std::string&, std::string& o_rError)
{
	o_rError = "Motion is not printed";
	return EPrinted::Refused;
}
