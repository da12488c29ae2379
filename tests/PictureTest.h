#pragma once

#include <gtest/gtest.h>

#include <string>

class QImage;

/// Pictures that tests draw, beside those in tests/data/pictures. RETARGET_REMAKE_PICTURES=1 in the environment stores
/// what is drawn instead: then look at the pictures before they are committed.
namespace PictureTest
{

/// How much a picture may differ, in steps of a byte.
struct VTolerance
{
	/// Of one channel of one pixel, from the nearest colour within a pixel's distance: edges may fall to either side.
	int m_Largest = 40;
	/// Of all channels of all pixels, each from its own.
	double m_Mean = 1.0;
};

/// What was drawn and does not match lies in the working folder afterwards, as NAME.drawn.png.
testing::AssertionResult Matches(
    const QImage& i_rDrawn, const std::string& i_rName, const VTolerance& i_rTolerance = {});

} // namespace PictureTest
