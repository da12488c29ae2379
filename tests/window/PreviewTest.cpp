// The preview by mouse: the camera, what it points at, and the manipulator, from two files to a saved pose. What is to
// be seen is computed by the arithmetic of Eye.h.

#include "Eye.h"
#include "WindowFixture.h"

#include "studio/host/Services.h"

#include <QFile>
#include <QRegularExpression>

namespace
{

constexpr double c_RingRadius = 50.0;

class Preview : public Window
{
protected:
	void SetUp() override
	{
		Window::SetUp();
		CreateTargetSubject();
		m_Source = ReadSkeleton(Run({"fk", File("performer.qrs")}));
		m_Created = CommandLine(m_Edits);
		m_Target = ReadSkeleton(Run({"fk", File("expected.qrr")}));
		m_Eye.m_Size = {
		    m_pOperator->Property("scene", "width").toDouble(), m_pOperator->Property("scene", "height").toDouble()};
		// Performer and character fill the view when they appear, and again where nothing is selected.
		std::vector<Eigen::Vector3d> places;
		for (const VSkeleton* const pSkeleton : {&m_Source, &m_Target})
			for (const auto& rSegment : *pSkeleton)
				places.push_back(rSegment.second.translation());
		m_Eye.Frame(places);
		PointAtBone("R_Radius", "R_Hand");
		m_pOperator->ClickRow("targetSegments", RowOf("targetSegments", "haunch"));
		Frame({m_Target.at("haunch").translation()});
		PointAtBone("haunch", "thighRight");
		m_pOperator->ClickAt(Nowhere());
		EXPECT_EVENTUALLY(Selected().isEmpty());
		Frame(places);
		PointAtBone("R_Radius", "R_Hand");

		// The stage, from a place that hangs on no radius of a joint.
		m_pOperator->ClickRow("targetSegments", RowOf("targetSegments", "haunch"));
		Frame({m_Target.at("haunch").translation()});
		const QPoint away(0, qRound((7000.0 - m_Eye.m_Distance) / 15.0));
		m_pOperator->Drag({Qt::RightButton}, QPoint(200, 10), QPoint(200, 10) + away);
		m_Eye.Dolly(away);
		m_pOperator->ClickAt(Nowhere());
		EXPECT_EVENTUALLY(Selected().isEmpty());
	}
	void Frame(const std::vector<Eigen::Vector3d>& i_rPlaces)
	{
		m_pOperator->Key(Qt::Key_F, Qt::ControlModifier);
		m_Eye.Frame(i_rPlaces);
	}

	QString ToolTip() const { return m_pOperator->Property("scene", "toolTipText").toString(); }

	/// Of a bone on the screen.
	QPointF Middle(const char* i_pName, const char* i_pEnd) const
	{
		const VSkeleton& rSkeleton = m_Source.count(i_pName) != 0 ? m_Source : m_Target;
		return m_Eye.Project(0.5 * (rSkeleton.at(i_pName).translation() + rSkeleton.at(i_pEnd).translation()));
	}

	/// Points at the middle of a bone, and sees its name.
	QPointF PointAtBone(const char* i_pName, const char* i_pEnd)
	{
		const QPointF place = Middle(i_pName, i_pEnd);
		m_pOperator->Point(Nowhere());
		EXPECT_EVENTUALLY(ToolTip().isEmpty()) << ToolTip().toStdString();
		m_pOperator->Point(place);
		const QString name = QString("Template : ") + i_pName;
		EXPECT_EVENTUALLY(ToolTip() == name) << ToolTip().toStdString() << " instead of " << i_pName;
		return place;
	}

	/// Above the floor's horizon.
	QPointF Nowhere() const { return {m_Eye.m_Size.width() - 3.0, 3.0}; }
	/// Names of the segments, in the order in which they were selected.
	QStringList Selected() const
	{
		QStringList names;
		for (const NVX::ISelectionItem& rItem : m_pWindow->Context().GetSelectionManager()->Selection().Items())
			names << Names(rItem.m_Kind == NVX::ESelectionSourceSegment ? "sourceSegments" : "targetSegments")
			             .value(int(rItem.m_ElementIndex));
		return names;
	}
	bool Selected(const char* i_pList, const char* i_pSegment) const
	{
		return m_pOperator->Property(i_pList, "selectedIndex").toInt() == RowOf(i_pList, i_pSegment);
	}

	/// The move of the mouse that turns the view until it looks against an axis.
	QPoint TurnTo(const Eigen::Vector3d& i_rAxis) const
	{
		const double pitch = -std::acos(i_rAxis.z()) * 180.0 / M_PI;
		const double yaw = 90.0 - std::atan2(i_rAxis.y(), i_rAxis.x()) * 180.0 / M_PI - 180.0;
		return {qRound(std::remainder(yaw - m_Eye.m_Yaw, 360.0) / 0.2), qRound((pitch - m_Eye.m_Pitch) / 0.2)};
	}

	/// A place on the ring of the manipulator about one of its axes.
	QPointF OnRing(const Eigen::Isometry3d& i_rHandle, int i_Axis, double i_Angle) const
	{
		Eigen::Vector3d place = Eigen::Vector3d::Zero();
		place[(i_Axis + 1) % 3] = std::cos(i_Angle);
		place[(i_Axis + 2) % 3] = std::sin(i_Angle);
		return m_Eye.Project(i_rHandle * (c_RingRadius * m_Eye.PixelSize(i_rHandle.translation()) * place));
	}

	/// Drags a ring of the manipulator from one place on it to another and keeps the button down.
	/// @return the turn in the world that this stands for
	Eigen::Matrix3d DragRing(
	    const Eigen::Isometry3d& i_rHandle, int i_Axis, double i_From, double i_To, QPointF& o_rEnd)
	{
		const QPointF start = OnRing(i_rHandle, i_Axis, i_From).toPoint();
		m_pOperator->Point(start);
		EXPECT_EVENTUALLY(Sees(start, IsYellow));
		m_pOperator->Press(Qt::LeftButton, start);
		constexpr int c_Steps = 6;
		for (int i = 1; i <= c_Steps; ++i)
			m_pOperator->Point(o_rEnd = OnRing(i_rHandle, i_Axis, i_From + (i_To - i_From) * i / c_Steps).toPoint());

		const Eigen::Vector3d centre = i_rHandle.translation();
		const Eigen::Vector3d axis = i_rHandle.linear().col(i_Axis);
		// Counter-clockwise is right-handed about what points at the eye.
		const double sign = axis.dot(m_Eye.Ray(start)) < 0.0 ? 1.0 : -1.0;
		const double angle = sign * AngleOnScreen(m_Eye.Project(centre), start, o_rEnd);
		// A ring that faces the eye stays under the mouse; of one that is seen aslant the angle on the screen counts.
		const double facing = std::abs(axis.dot(m_Eye.Ray(m_Eye.Project(centre))));
		EXPECT_NEAR(angle, AngleInPlane(m_Eye, centre, axis, start, o_rEnd), 0.002 + 1.0 - facing * facing);
		return Exp(angle * axis);
	}

	static bool IsYellow(const QColor& i_rColour)
	{
		return i_rColour.red() > 120 && i_rColour.green() > 120 && i_rColour.blue() < 60;
	}
	static bool IsOrange(const QColor& i_rColour)
	{
		return i_rColour.red() > 150 && i_rColour.green() < 120 && i_rColour.blue() < 60;
	}
	static bool IsWhite(const QColor& i_rColour)
	{
		return i_rColour.red() > 220 && i_rColour.green() > 220 && i_rColour.blue() > 220;
	}
	static bool IsMagenta(const QColor& i_rColour)
	{
		return i_rColour.red() > 90 && i_rColour.green() < 60 && i_rColour.blue() > 90;
	}
	/// On the screen, some pixels beside a place.
	bool Sees(const QPointF& i_rPlace, bool (*i_pIsColour)(const QColor&), int i_Reach = 2) const
	{
		const QImage image = m_pOperator->See(i_rPlace, i_Reach);
		for (int y = 0; y < image.height(); ++y)
			for (int x = 0; x < image.width(); ++x)
				if (i_pIsColour(image.pixelColor(x, y)))
					return true;
		return false;
	}

	/// The directions in which a segment's joint turns when its pose is zero.
	Eigen::Matrix3d JointFrame(const char* i_pSegment) const
	{
		return m_Target.at(i_pSegment).linear() * Exp(Pose(m_Created, i_pSegment)).transpose();
	}

	/// A segment's bind pose in a file, number by number as it stands there.
	static QStringList Numbers(const QByteArray& i_rFile, const char* i_pSegment)
	{
		const QRegularExpression pattern(
		    QString("NAME=\"%1\"[^>]*>\\s*<Joint.*?BIND-POSE=\"([^\"]*)\"").arg(i_pSegment),
		    QRegularExpression::DotMatchesEverythingOption);
		return pattern.match(QString::fromUtf8(i_rFile)).captured(1).split(' ');
	}
	/// Three of them.
	static Eigen::Vector3d Pose(const QByteArray& i_rFile, const char* i_pSegment, int i_First = 0)
	{
		const QStringList numbers = Numbers(i_rFile, i_pSegment).mid(i_First);
		EXPECT_GE(numbers.size(), 3) << i_pSegment;
		return {numbers.value(0).toDouble(), numbers.value(1).toDouble(), numbers.value(2).toDouble()};
	}
	/// What gives a segment the pose that it has in a file.
	static QStringList PoseEdit(const QByteArray& i_rFile, const char* i_pSegment)
	{
		return {"--pose", i_pSegment + ("=" + Numbers(i_rFile, i_pSegment).join(','))};
	}
	QByteArray SaveAs(const char* i_pName)
	{
		m_pOperator->Click("saveAs");
		m_pOperator->AnswerDialog(File(i_pName));
		EXPECT_EVENTUALLY(QFile::exists(File(i_pName)));
		return Content(i_pName);
	}

	VEye m_Eye;
	VSkeleton m_Source, m_Target;
	QStringList m_Edits{
	    "create", "--fbx", File("character.fbx"), "--source", File("performer.qrs"), "--match-file-pose"};
	QByteArray m_Created;
};

TEST_F(Preview, TheMainRoad)
{
	VOperator& rOperator = *m_pOperator;
	PointAtBone("R_Radius", "R_Hand");
	const auto drag = [&](const QVector<Qt::MouseButton>& i_rButtons, const QPoint& i_rMove)
	{ rOperator.Drag(i_rButtons, QPoint(300, 400), QPoint(300, 400) + i_rMove); };
	drag({Qt::LeftButton}, {-120, 30});
	m_Eye.Orbit({-120, 30});
	PointAtBone("R_Radius", "R_Hand");
	drag({Qt::LeftButton, Qt::RightButton}, {40, 90});
	m_Eye.Pan({40, 90});
	PointAtBone("R_Radius", "R_Hand");
	drag({Qt::RightButton}, {0, -150});
	m_Eye.Dolly({0, -150});
	PointAtBone("R_Radius", "R_Hand");
	rOperator.Wheel(2);
	m_Eye.m_Distance *= 0.9 * 0.9;

	rOperator.ClickAt(PointAtBone("R_Radius", "R_Hand"));
	EXPECT_EVENTUALLY(Selected("sourceSegments", "R_Radius"));
	rOperator.ClickAt(PointAtBone("foreArmRight", "palmRight"), Qt::ShiftModifier);
	EXPECT_EVENTUALLY(Selected("targetSegments", "foreArmRight"));
	EXPECT_TRUE(Selected("sourceSegments", "R_Radius"));
	EXPECT_EVENTUALLY(rOperator.Property("addPositionTarget", "enabled").toBool());
	rOperator.Click("addPositionTarget");
	EXPECT_EVENTUALLY(Targets() == 1);
	rOperator.Key(Qt::Key_R, Qt::AltModifier);
	EXPECT_EVENTUALLY(Targets() == 2);
	m_Edits += {"--position", "R_Radius:foreArmRight", "--rotation", "R_Radius:foreArmRight"};

	PointAtBone("R_Radius", "R_Hand");
	EXPECT_EVENTUALLY(rOperator.Shows(
	    "sceneToolTip", "performer : R_Radius\nPosition target of foreArmRight\nRotation target of foreArmRight"));

	// The shoulder in the middle, and the ring about its third axis as a circle.
	rOperator.ClickAt(PointAtBone("upperArmLeft", "foreArmLeft"));
	EXPECT_EVENTUALLY(Selected("targetSegments", "upperArmLeft"));
	EXPECT_EVENTUALLY(!Selected("sourceSegments", "R_Radius")) << "replaced";
	rOperator.Key(Qt::Key_F, Qt::ControlModifier);
	Eigen::Isometry3d arm = m_Target.at("upperArmLeft");
	m_Eye.Frame({arm.translation()});
	PointAtBone("upperArmLeft", "foreArmLeft");
	const QPoint turn = TurnTo(arm.linear().col(2));
	drag({Qt::LeftButton}, turn);
	m_Eye.Orbit(turn);
	drag({Qt::RightButton}, {0, 120});
	m_Eye.Dolly({0, 120});

	const Eigen::Matrix3d frame = JointFrame("upperArmLeft"), otherFrame = JointFrame("upperArmRight");
	Eigen::Isometry3d otherArm = m_Target.at("upperArmRight");
	const Eigen::Vector3d elbow = (arm.inverse() * m_Target.at("foreArmLeft")).translation();
	const Eigen::Vector3d otherElbow = (otherArm.inverse() * m_Target.at("foreArmRight")).translation();
	const Eigen::Vector3d normal = (arm.translation() - otherArm.translation()).normalized();
	const Eigen::Matrix3d mirror = Eigen::Matrix3d::Identity() - 2.0 * normal * normal.transpose();
	QPointF end;
	for (const int axis : {2, 1})
	{
		SCOPED_TRACE(axis);
		arm.linear() = DragRing(arm, axis, 0.4, -0.5, end) * arm.linear();
		otherArm.linear() = mirror * arm.linear() * frame.transpose() * mirror * otherFrame;
		// With the button still down.
		EXPECT_EVENTUALLY(Sees(m_Eye.Project(arm * elbow), IsMagenta));
		EXPECT_EVENTUALLY(Sees(m_Eye.Project(otherArm * otherElbow), IsMagenta));
		rOperator.Release(Qt::LeftButton, end);
		EXPECT_TRUE(Selected("targetSegments", "upperArmLeft"));
		drag({Qt::LeftButton}, {90, 140});
		m_Eye.Orbit({90, 140});
	}

	rOperator.Click("updateTargets");
	const QByteArray saved = SaveAs("posed.qrr");
	const Eigen::Vector3d pose = Pose(saved, "upperArmLeft");
	const Eigen::Vector3d otherPose = Pose(saved, "upperArmRight");
	EXPECT_LT((pose - Log(frame.transpose() * arm.linear())).norm(), 1e-6) << pose;
	EXPECT_LT((otherPose - Log(otherFrame.transpose() * otherArm.linear())).norm(), 1e-6) << otherPose;
	m_Edits += PoseEdit(saved, "upperArmLeft") + PoseEdit(saved, "upperArmRight") + QStringList("--update-targets");
	EXPECT_TRUE(CommandLine(m_Edits) == saved);

	m_Target = ReadSkeleton(Run({"fk", File("posed.qrr")}));
	PointAtBone("foreArmRight", "palmRight");
	PointAtBone("foreArmLeft", "palmLeft");
}

TEST_F(Preview, PicksWhatTheMouseIsOn)
{
	m_pOperator->ClickAt(PointAtBone("upperArmLeft", "foreArmLeft"));
	EXPECT_EVENTUALLY(Selected("targetSegments", "upperArmLeft"));
	for (const int axis : {0, 1})
	{
		const QPointF place = OnRing(m_Target.at("upperArmLeft"), axis, 0.7);
		m_pOperator->Point(place);
		EXPECT_EVENTUALLY(Sees(place, IsYellow)) << axis;
	}

	// The menu is for what is pointed at.
	const QPointF shin = PointAtBone("shinRight", "hockRight");
	m_pOperator->Press(Qt::RightButton, shin);
	m_pOperator->Release(Qt::RightButton, shin);
	EXPECT_EVENTUALLY(m_pOperator->Shows("menuSelectpartner", "Select partner"));
	EXPECT_TRUE(Selected("targetSegments", "shinRight"));
	m_pOperator->Click("menuSelectpartner");
	EXPECT_EVENTUALLY(Selected("targetSegments", "shinLeft"));
}

TEST_F(Preview, FixedViewsTellWhichSideTheyShow)
{
	const struct
	{
		const char* m_pView;
		const char* m_pSide;
	} rows[] = {{"Front", "back"}, {"Back", "front"}, {"Left", "right side"}, {"Right", "left side"}, {"Top", ""},
	    {"Perspective", ""}};
	for (const auto& rRow : rows)
	{
		m_pOperator->Choose("cameraType", rRow.m_pView);
		const QString told = m_pOperator->Property("sideSeen", "text").toString();
		EXPECT_EQ(told.toStdString(), *rRow.m_pSide ? std::string("The character's ") + rRow.m_pSide : "");
		const QPointF middle(0.5 * m_Eye.m_Size.width(), 0.5 * m_Eye.m_Size.height());
		m_pOperator->WaitForDrawing();
		const QImage before = m_pOperator->See(middle, 200);
		m_pOperator->Wheel(3);
		EXPECT_EVENTUALLY(m_pOperator->See(middle, 200) != before) << "the wheel goes nearer";
	}
}

TEST_F(Preview, TheRootMovesAlongAnArrow)
{
	m_pOperator->ClickRow("targetSegments", RowOf("targetSegments", "haunch"));
	EXPECT_EVENTUALLY(Selected("targetSegments", "haunch"));
	const Eigen::Vector3d root = m_Target.at("haunch").translation();
	const Eigen::Vector3d axis = m_Target.at("haunch").linear().col(0);
	const QPoint from = m_Eye.Project(root + 60.0 * m_Eye.PixelSize(root) * axis).toPoint();
	const QPoint to = from + QPoint(50, 30);
	m_pOperator->Point(from);
	EXPECT_EVENTUALLY(Sees(from, IsYellow));
	// One that Escape ends, whatever the mouse does after it.
	const bool bUnsaved = m_pOperator->Property("unsavedMark", "visible").toBool();
	m_pOperator->Press(Qt::LeftButton, from);
	m_pOperator->Point(from + QPoint(20, 0));
	m_pOperator->Point(to);
	m_pOperator->Key(Qt::Key_Escape);
	m_pOperator->Point(from + QPoint(0, 40));
	m_pOperator->Release(Qt::LeftButton, from + QPoint(0, 40));
	EXPECT_TRUE(Selected("targetSegments", "haunch"));
	EXPECT_EQ(m_pOperator->Property("unsavedMark", "visible").toBool(), bUnsaved);
	EXPECT_TRUE(SaveAs("as before.qrr") == m_Created);
	// One that is undone before it ends, and done again.
	m_pOperator->Point(from);
	EXPECT_EVENTUALLY(Sees(from, IsYellow));
	m_pOperator->Press(Qt::LeftButton, from);
	m_pOperator->Point(from + QPoint(20, 0));
	m_pOperator->Point(to);
	m_pOperator->Key(Qt::Key_Z, Qt::ControlModifier);
	m_pOperator->Point(from + QPoint(0, 40));
	m_pOperator->Release(Qt::LeftButton, from + QPoint(0, 40));
	EXPECT_TRUE(SaveAs("as before too.qrr") == m_Created);
	m_pOperator->Key(Qt::Key_Z, Qt::ControlModifier | Qt::ShiftModifier);

	// How far along the arrow the mouse is: where it comes nearest to it.
	const auto along = [&](const QPointF& i_rMouse)
	{
		Eigen::Matrix<double, 3, 2> lines;
		lines << axis, -m_Eye.Ray(i_rMouse);
		return (lines.transpose() * lines).inverse().row(0).dot(lines.transpose() * (m_Eye.Place() - root));
	};
	const QByteArray saved = SaveAs("moved.qrr");
	const Eigen::Vector3d moved = Pose(saved, "haunch", 3) - Pose(m_Created, "haunch", 3);
	EXPECT_GT(moved.norm(), 100.0);
	EXPECT_LT((moved - (along(to) - along(from)) * axis).norm(), 0.05) << moved;
	EXPECT_LT((Pose(saved, "haunch") - Pose(m_Created, "haunch")).norm(), 1e-6);
	EXPECT_TRUE(CommandLine(m_Edits + PoseEdit(saved, "haunch")) == saved);
}

TEST_F(Preview, SelectsLikeTheLists)
{
	VOperator& rOperator = *m_pOperator;
	rOperator.Wheel(10);
	m_Eye.m_Distance *= std::pow(0.9, 10);
	// Its handles would stand before the bones beside the selected one.
	rOperator.Click("showManipulator");
	using VBone = std::pair<const char*, const char*>;
	const VBone left{"L_Radius", "L_Hand"}, right{"R_Radius", "R_Hand"}, target{"foreArmRight", "palmRight"}, nothing{};
	struct VRow
	{
		const char* m_pName;
		VBone m_Bone;
		Qt::KeyboardModifiers m_Modifiers;
		QStringList m_Selected;
	};
	const VRow rows[] = {
	    {"a click selects", right, Qt::NoModifier, {"R_Radius"}},
	    {"and replaces", left, Qt::NoModifier, {"L_Radius"}},
	    {"all kinds", target, Qt::NoModifier, {"foreArmRight"}},
	    {"Shift adds", right, Qt::ShiftModifier, {"foreArmRight", "R_Radius"}},
	    {"once", right, Qt::ShiftModifier, {"foreArmRight", "R_Radius"}},
	    {"Ctrl adds", left, Qt::ControlModifier, {"foreArmRight", "R_Radius", "L_Radius"}},
	    {"Ctrl takes away", right, Qt::ControlModifier, {"foreArmRight", "L_Radius"}},
	    {"both take away", left, Qt::ControlModifier | Qt::ShiftModifier, {"foreArmRight"}},
	    {"nothing is added", nothing, Qt::ShiftModifier, {"foreArmRight"}},
	    {"nothing is left", nothing, Qt::NoModifier, {}},
	    {"Alt selects, too", right, Qt::AltModifier, {"R_Radius"}},
	};
	for (const VRow& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		rOperator.ClickAt(
		    rRow.m_Bone.first ? PointAtBone(rRow.m_Bone.first, rRow.m_Bone.second) : Nowhere(), rRow.m_Modifiers);
		for (int i = 0; i < 3 && Selected() == rRow.m_Selected; ++i)
			rOperator.WaitForDrawing();
		EXPECT_EVENTUALLY(Selected() == rRow.m_Selected) << Selected().join(' ').toStdString();
	}

	// What is pointed at in a list shines in the view, and the other way round.
	const QPointF place = PointAtBone(target.first, target.second);
	EXPECT_EVENTUALLY(rOperator.Shows("sceneToolTip", "character : foreArmRight"));
	rOperator.Press(Qt::LeftButton, place);
	rOperator.Point(place + QPointF(20.0, 0.0));
	EXPECT_EQ(ToolTip(), "") << "the camera moves";
	rOperator.Point(place);
	rOperator.Release(Qt::LeftButton, place);
	EXPECT_EVENTUALLY(!ToolTip().isEmpty());
	const QString row = "targetSegmentsRow" + QString::number(RowOf("targetSegments", target.first));
	const QVariant marked = rOperator.Property(row, "color");
	rOperator.Point(Nowhere());
	EXPECT_EVENTUALLY(rOperator.Property(row, "color") != marked);
	EXPECT_EVENTUALLY(!Sees(place, IsWhite, 12));
	rOperator.Hover(row);
	EXPECT_EVENTUALLY(rOperator.Property(row, "color") == marked);
	EXPECT_EVENTUALLY(Sees(place, IsWhite, 12));

	// Rectangles, with the one preference and the other.
	const QRect shins = QRectF(Middle("R_Tibia", "R_Foot"), Middle("shinRight", "hockRight"))
	                        .normalized()
	                        .adjusted(-8, -8, 8, 8)
	                        .toRect();
	for (const Qt::KeyboardModifiers modifiers : {Qt::KeyboardModifiers(Qt::AltModifier), Qt::KeyboardModifiers()})
	{
		rOperator.Press(Qt::LeftButton, shins.topLeft(), modifiers);
		rOperator.Point(shins.center(), modifiers);
		rOperator.Point(shins.bottomRight(), modifiers);
		EXPECT_EVENTUALLY(ToolTip() == "Template : R_Tibia<br>Template : shinRight") << ToolTip().toStdString();
		EXPECT_EVENTUALLY(rOperator.Shows("sceneToolTip", "character : shinRight\nperformer : R_Tibia"));
		EXPECT_EVENTUALLY(Sees(shins.topLeft(), IsOrange));
		// Behind the preferences, where there is no window manager, no window has the keyboard.
		if (modifiers)
		{
			const QStringList before = Selected();
			rOperator.Key(Qt::Key_Escape);
			EXPECT_EVENTUALLY(!Sees(shins.topLeft(), IsOrange));
			rOperator.Release(Qt::LeftButton, shins.bottomRight(), modifiers);
			EXPECT_EQ(Selected(), before);
			rOperator.Press(Qt::LeftButton, shins.topLeft(), modifiers);
			rOperator.Point(shins.bottomRight(), modifiers);
		}
		EXPECT_EVENTUALLY(Sees(shins.topLeft(), IsOrange));
		rOperator.Release(Qt::LeftButton, shins.bottomRight(), modifiers);
		EXPECT_EVENTUALLY(
		    Selected() == QStringList({"R_Tibia", "shinRight"}) || Selected() == QStringList({"shinRight", "R_Tibia"}))
		    << Selected().join(' ').toStdString();

		// A drag that moves the camera selects nothing.
		rOperator.Drag(
		    {Qt::LeftButton}, Nowhere().toPoint(), Nowhere().toPoint() - QPoint(40, -20), modifiers ^ Qt::AltModifier);
		m_Eye.Orbit({-40, 20});
		PointAtBone(target.first, target.second);
		rOperator.Drag(
		    {Qt::LeftButton}, Nowhere().toPoint(), Nowhere().toPoint() - QPoint(-40, 20), modifiers ^ Qt::AltModifier);
		m_Eye.Orbit({40, -20});
		EXPECT_EQ(Selected().size(), 2);
		if (!modifiers)
			break;
		rOperator.ChooseInNextDialog("Preferences", "NavigationAlt", "while Alt is held", "PreferencesOk");
		rOperator.Key(Qt::Key_Comma, Qt::ControlModifier);
	}
}

} // namespace
