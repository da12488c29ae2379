#include "PictureTest.h"

#include <QImage>
#include <QString>

#include <algorithm>
#include <cstdlib>

namespace PictureTest
{

namespace
{

int Difference(QRgb i_A, QRgb i_B)
{
	return std::max(
	    {std::abs(qRed(i_A) - qRed(i_B)), std::abs(qGreen(i_A) - qGreen(i_B)), std::abs(qBlue(i_A) - qBlue(i_B))});
}

/// Of each pixel of one picture from what the other one has there or beside it.
int LargestDifference(const QImage& i_rA, const QImage& i_rB)
{
	int largest = 0;
	for (int y = 0; y < i_rA.height(); ++y)
	{
		for (int x = 0; x < i_rA.width(); ++x)
		{
			int least = Difference(i_rA.pixel(x, y), i_rB.pixel(x, y));
			for (int j = std::max(y - 1, 0); least > largest && j <= std::min(y + 1, i_rA.height() - 1); ++j)
			{
				for (int i = std::max(x - 1, 0); i <= std::min(x + 1, i_rA.width() - 1); ++i)
					least = std::min(least, Difference(i_rA.pixel(x, y), i_rB.pixel(i, j)));
			}
			largest = std::max(largest, least);
		}
	}
	return largest;
}

double MeanDifference(const QImage& i_rA, const QImage& i_rB)
{
	double sum = 0.0;
	for (int y = 0; y < i_rA.height(); ++y)
	{
		for (int x = 0; x < i_rA.width(); ++x)
		{
			const QRgb a = i_rA.pixel(x, y), b = i_rB.pixel(x, y);
			sum += std::abs(qRed(a) - qRed(b)) + std::abs(qGreen(a) - qGreen(b)) + std::abs(qBlue(a) - qBlue(b));
		}
	}
	return sum / (3.0 * i_rA.width() * i_rA.height());
}

} // namespace

testing::AssertionResult Matches(const QImage& i_rDrawn, const std::string& i_rName, const VTolerance& i_rTolerance)
{
	const QImage drawn = i_rDrawn.convertToFormat(QImage::Format_RGB32);
	const QString file = QStringLiteral(RETARGET_TEST_DATA "/pictures/") + QString::fromStdString(i_rName + ".png");
	if (std::getenv("RETARGET_REMAKE_PICTURES"))
		return drawn.save(file) ? testing::AssertionSuccess()
		                        : testing::AssertionFailure() << "cannot write " << file.toStdString();
	const QImage stored = QImage(file).convertToFormat(QImage::Format_RGB32);
	if (drawn == stored)
		return testing::AssertionSuccess();
	testing::AssertionResult failure = testing::AssertionFailure() << i_rName << ": ";
	if (stored.isNull())
		return failure << "cannot read " << file.toStdString();
	if (stored.size() != drawn.size())
		return failure << "is " << drawn.width() << " by " << drawn.height() << " pixels";
	// A pixel that is there and should not be, and one that should be there and is not.
	const int largest = std::max(LargestDifference(drawn, stored), LargestDifference(stored, drawn));
	const double mean = MeanDifference(drawn, stored);
	if (largest <= i_rTolerance.m_Largest && mean <= i_rTolerance.m_Mean)
		return testing::AssertionSuccess();
	drawn.save(QString::fromStdString(i_rName + ".drawn.png"));
	return failure << "differs by " << largest << " at most, by " << mean << " in the mean";
}

} // namespace PictureTest
