#include "CoreGraphics/Picture.h"

#include "../UtilsFileSystem/Folder.h"
#include "../UtilsFileSystem/Log.h"
#include "FBXIO/ImageCache.h"

#include <QBuffer>

#include <gtest/gtest.h>

namespace
{

std::string FileOf(const char* i_pFormat)
{
	QBuffer buffer;
	QImage image(3, 2, QImage::Format_RGB32);
	image.fill(Qt::red);
	EXPECT_TRUE(image.save(&buffer, i_pFormat));
	return buffer.data().toStdString();
}

class Pictures : public testing::Test
{
protected:
	std::shared_ptr<const FBXIO::VPicture> Read(
	    const std::string& i_rName, const std::string& i_rFile, FBXIO::VOpenPicture i_pOpen)
	{
		const boost::filesystem::path path = m_Folder / i_rName;
		Put(path, i_rFile);
		FBXIO::ImageCache cache;
		cache.SetOpener(i_pOpen);
		return cache.Get(path.string());
	}

	const VTestFolder m_Folder;
	VTestLog m_Failed{"Import"};
};

TEST_F(Pictures, AreReadWithTheSizeThatTheirHeadsTell)
{
	const std::string png = FileOf("PNG");
	const struct
	{
		std::string m_Name;
		std::string m_File;
		/// What is read alone, and what is decoded.
		bool m_bHead = true;
		bool m_bWhole = true;
	} rows[]{{"a.png", png}, {"b.JPG", FileOf("JPG")}, {"c.bmp", FileOf("BMP")}, {"d.ppm", FileOf("PPM")}, {"e", png},
	    {"cut.png", png.substr(0, 60), true, false}, {"short.png", png.substr(0, 20), false, false},
	    {"f.png", "no picture", false, false}, {"g.gif", "GIF89a\3\0\2", false, false},
	    {"h.ppm", "P6 # 9 9\n3\n2 255\n", true, false}, {"i.ppm", "P6 99999999999999999999 2 255\n", false, false},
	    {"j.svg", "<svg width='3' height='2' xmlns='http://www.w3.org/2000/svg'/>", false, false}};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_Name);
		const auto pHead = Read(rRow.m_Name, rRow.m_File, &FBXIO::OpenPictureHead);
		EXPECT_EQ(pHead && pHead->m_Width == 3 && pHead->m_Height == 2, rRow.m_bHead);
		EXPECT_EQ(m_Failed.Take().empty(), pHead != nullptr);
		const auto pWhole = std::dynamic_pointer_cast<const CoreGraphics::VDecodedPicture>(
		    Read(rRow.m_Name, rRow.m_File, &CoreGraphics::OpenPicture));
		ASSERT_EQ(pWhole != nullptr, rRow.m_bWhole);
		EXPECT_EQ(m_Failed.Take().empty(), pWhole != nullptr);
		if (!pWhole)
			continue;
		EXPECT_EQ(QSize(pWhole->m_Width, pWhole->m_Height), pWhole->m_Image.size());
		EXPECT_GT(qRed(pWhole->m_Image.pixel(2, 1)), 250);
	}
}

TEST_F(Pictures, NothingIsPrintedOfDamagedOnes)
{
	const std::string png = FileOf("PNG");
	testing::internal::CaptureStderr();
	for (std::size_t at = 0; at < png.size(); ++at)
	{
		std::string damaged = png;
		damaged[at] = char(damaged[at] ^ 0x55);
		for (const std::string& rFile : {damaged, png.substr(0, at)})
		{
			const bool bRead = Read("a.png", rFile, &CoreGraphics::OpenPicture) != nullptr;
			EXPECT_EQ(m_Failed.Take().empty(), bRead) << at;
		}
	}
	EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
}

} // namespace
