// Skins at the window: characters of other people's programs on the subjects made of them, posed by mouse, and what the
// operator is told of a skin that is not there.

#include "../PictureTest.h"
#include "WindowFixture.h"

#include "OrlexGraphics/skins/SkinCache.h"
#include "TesselPluginInterface/ISelectionManager.h"
#include "studio/host/Services.h"
#include "studio/log/LogModel.h"

#include <QDir>
#include <QFile>
#include <QPainter>

#include <cmath>

namespace
{

/// Half of a side of what is shown of the preview, in pixels.
constexpr int c_Reach = 240;
constexpr int c_Width = 310;

class Skins : public Window
{
protected:
	/// The skin is there, and the frame that shows it, too.
	bool Wears(const char* i_pSkin)
	{
		std::shared_ptr<CoreGraphics::VSkin> pSkin;
		const auto pCache = m_pWindow->Gui().GetSkinCache();
		if (pCache->GetSkin(pSkin, i_pSkin, OrlexGraphics::c_pSubjectSkins) != OrlexGraphics::SkinStatus::c_Ready
		    || !pCache->Loading().empty())
			return false;
		m_pOperator->Hover("updateTargets");
		return true;
	}
	QPointF Middle() const
	{
		return 0.5
		    * QPointF(m_pOperator->Property("scene", "width").toDouble(),
		        m_pOperator->Property("scene", "height").toDouble());
	}
	QImage View() const
	{
		const QImage image = m_pOperator->See(Middle(), c_Reach);
		return image.copy((image.width() - c_Width) / 2, 0, c_Width, image.height());
	}
	/// What the mouse is on is looked for in one drawing, told in the next one and seen in the third.
	void WaitForPicking() const
	{
		for (int i = 0; i < 3; ++i)
			m_pOperator->WaitForDrawing();
	}
	/// When what was asked for has been drawn.
	QImage Settled() const
	{
		QImage seen;
		const auto same = [&]
		{
			WaitForPicking();
			const QImage now = View();
			return std::exchange(seen, now) == now;
		};
		EXPECT_EVENTUALLY(same());
		return seen;
	}
	QColor Colour(const QPointF& i_rPlace) const { return m_pOperator->See(i_rPlace, 0).pixelColor(0, 0); }
	/// Turns the segment that stands in the middle by whichever ring comes first.
	void DragARing(double i_Turn)
	{
		const auto place = [this](double i_Radius, double i_Angle)
		{ return Middle() + i_Radius * QPointF(std::cos(i_Angle), -std::sin(i_Angle)); };
		for (double angle = 0.3; angle < 6.0; angle += 0.4)
			for (double radius = 54.0; radius > 30.0; radius -= 1.0)
			{
				const QPointF start = place(radius, angle);
				// Skins are darker.
				if (const QColor colour = Colour(start); colour.saturation() < 150 || colour.value() < 250)
					continue;
				m_pOperator->Point(start);
				WaitForPicking();
				if (std::abs(Colour(start).hue() - 60) > 10)
					continue;
				m_pOperator->Press(Qt::LeftButton, start);
				for (int i = 1; i <= 6; ++i)
					m_pOperator->Point(place(radius, angle + i_Turn * i / 6.0));
				return m_pOperator->Release(Qt::LeftButton, place(radius, angle + i_Turn));
			}
		ADD_FAILURE() << "no ring";
	}
	/// The messages so far.
	QString Log() const
	{
		QString text;
		const QAbstractItemModel& rModel = m_pWindow->Log();
		for (int row = 0; row < rModel.rowCount(); ++row)
			text += rModel.index(row, StudioHost::VLogModel::EText).data().toString() + '\n';
		return text;
	}
};

TEST_F(Skins, OfThreeCharactersFollowADrag)
{
	const struct
	{
		const char* m_pFile;
		const char* m_pRoot;
		const char* m_pSegment;
		int m_Wheel;
	} c_Rows[] = {{"own_game_zup_m_b7400", "pelvis", "upperarm_l", -17},
	    {"kenney_medium_b7400", "Hips", "LeftArm", -27}, {"pab_arnaud_b7500", "Hips", "LeftArm", -17}};
	VOperator& rOperator = *m_pOperator;
	// What was dragged is not kept.
	m_pWindow->Context().Application().m_AskToReplace = [](const std::string&) { return true; };
	// Wide enough for arms beside the buttons.
	m_pWindow->resize(1280, 780);
	QImage sheet(3 * c_Width, 2 * (2 * c_Reach + 1), QImage::Format_RGB32);
	QPainter painter(&sheet);
	int column = 0;
	for (const auto& rRow : c_Rows)
	{
		SCOPED_TRACE(rRow.m_pFile);
		QFile::copy(QString(RETARGET_TEST_DATA "/fbx/%1.fbx").arg(rRow.m_pFile), File(rRow.m_pFile) + ".fbx");
		CommandLine({"create", "--fbx", File(rRow.m_pFile) + ".fbx", "--root", rRow.m_pRoot, "--match-file-pose"});
		ASSERT_TRUE(m_pWindow->Open(File("expected.qrr")));
		EXPECT_EVENTUALLY(Wears(rRow.m_pFile));
		rOperator.ClickRow("targetSegments", RowOf("targetSegments", rRow.m_pSegment));
		rOperator.Key(Qt::Key_F, Qt::ControlModifier);
		const QImage before = Settled();
		DragARing(0.7);
		EXPECT_NE(Settled(), before);

		rOperator.ClickRow("targetSegments", 0);
		rOperator.Key(Qt::Key_F, Qt::ControlModifier);
		rOperator.Wheel(rRow.m_Wheel);
		rOperator.ClickAt({3, Middle().y()});
		EXPECT_EVENTUALLY(m_pWindow->Context().GetSelectionManager()->Selection().Items().empty());
		for (int row = 0; row < 2; ++row)
		{
			painter.drawImage(c_Width * column, row * (2 * c_Reach + 1), Settled());
			rOperator.Click("filterTargetSkinXRay");
		}
		++column;
	}
	painter.end();
	EXPECT_TRUE(PictureTest::Matches(sheet, "characters"));
}

TEST_F(Skins, OfAFileFromElsewhereIsFoundBesideIt)
{
	QDir(m_Folder.path()).mkdir("elsewhere");
	QFile::copy(File("character.fbx"), File("elsewhere/stranger.fbx"));
	m_pOperator->Choose("SourceSkeleton", "performer");
	m_pWindow->Open(File("elsewhere/stranger.fbx"));
	EXPECT_EVENTUALLY(m_pOperator->Property("TargetRoot", "currentText").toString() == "haunch");
	m_pOperator->Click("createTargetSubject");
	EXPECT_EVENTUALLY(Wears("stranger"));
}

TEST_F(Skins, FollowTheirFileAndTellWhyTheyAreGone)
{
	CreateTargetSubject();
	EXPECT_EVENTUALLY(Wears("character"));
	const QImage worn = View();
	EXPECT_FALSE(Log().contains("skin")) << Log().toStdString();
	QFile file(File("character.fbx"));
	const QByteArray content = Content("character.fbx");
	ASSERT_TRUE(file.open(QIODevice::WriteOnly) && file.write("no skin") > 0);
	file.close();
	EXPECT_EVENTUALLY(
	    Log().contains("The skin character is not shown: " + File("character.fbx") + " could not be read"));
	EXPECT_EVENTUALLY(View() != worn);
	ASSERT_TRUE(file.remove());
	EXPECT_EVENTUALLY(Log().contains("The skin character is not shown: no file character.fbx in " + m_Folder.path()));
	ASSERT_TRUE(file.open(QIODevice::WriteOnly) && file.write(content) == content.size());
	file.close();
	EXPECT_EVENTUALLY(View() == worn);
}

} // namespace
