#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace CoreOrlexTypes
{

/// Red, green, blue, alpha, each 0 to 255.
struct VColour
{
	std::uint8_t m_Red = 93;
	std::uint8_t m_Green = 93;
	std::uint8_t m_Blue = 93;
	std::uint8_t m_Alpha = 255;

	bool operator==(const VColour&) const = default;
};

inline constexpr VColour c_ColourZero{0, 0, 0, 0};

/// From the 32-bit pattern with red in the low byte and alpha in the high byte.
constexpr VColour ColourFromPattern(std::uint32_t i_Pattern)
{
	return {static_cast<std::uint8_t>(i_Pattern), static_cast<std::uint8_t>(i_Pattern >> 8),
	    static_cast<std::uint8_t>(i_Pattern >> 16), static_cast<std::uint8_t>(i_Pattern >> 24)};
}

/// What the user interface needs to draw a subject. Element lists run parallel to those of the subject.
struct VSubjectApplicationData
{
	struct VMarker
	{
		VColour m_Colour;
	};

	struct VJoint
	{
		enum EEulerOrder : std::int32_t
		{
			EXYZ,
			EXZY,
			EYXZ,
			EYZX,
			EZXY,
			EZYX,
			ENone
		};

		EEulerOrder m_EulerOrder = ENone;
		std::string m_Labels;
		std::string m_Signs;
	};

	struct VSegment
	{
		enum EDrawShading : std::int32_t
		{
			EDrawShadingWireFrameUnlit,
			EDrawShadingWireFrameLit,
			EDrawShadingShadedFlat,
			EDrawShadingShadedSmooth
		};

		enum EDrawStyle : std::int32_t
		{
			EDrawStyleTetrahedron,
			EDrawStyleTetraStripe,
			EDrawStyleBox,
			EDrawStyleCarton,
			EDrawStyleHead,
			EDrawStyleSpine,
			EDrawStyleCylinder,
			EDrawStyleBodyPart
		};

		VColour m_Colour;
		std::string m_Context;
		double m_DrawEndRatio = 1.0;
		double m_DrawHeight = 0.5;
		EDrawShading m_DrawShading = EDrawShadingShadedSmooth;
		EDrawStyle m_DrawStyle = EDrawStyleBox;
		double m_DrawTwist = 0.0;
		double m_DrawWidth = 0.5;
		std::string m_Part;
		bool m_Visible = true;
		VJoint m_Joint;
	};

	struct VStick
	{
		std::uint32_t m_MarkerIndexA = 0;
		VColour m_ColourA = c_ColourZero;
		std::uint32_t m_MarkerIndexB = 0;
		VColour m_ColourB = c_ColourZero;
	};

	struct VTarget
	{
		enum EDrawStyle : std::int32_t
		{
			EDrawStyleNone,
			EDrawStyleError,
			EDrawStyleBoneLines
		};

		VColour m_Colour;
		EDrawStyle m_DrawStyle = EDrawStyleNone;
		bool m_FillGaps = false;
		std::string m_Name;
		bool m_Visible = true;
	};

	std::uint32_t m_SubjectId = 0;
	VColour m_Colour;
	std::vector<VMarker> m_Markers;
	std::vector<VSegment> m_Segments;
	std::vector<VStick> m_Sticks;
	std::vector<VTarget> m_Targets;
	std::string m_Skin;
	VColour m_SkinColourA = c_ColourZero;
	VColour m_SkinColourB = c_ColourZero;
	std::string m_RetargetSourceTemplate;
	std::string m_RetargetSourceSubject;
};

/// Exact, field by field.
bool operator==(const VSubjectApplicationData& i_rLeft, const VSubjectApplicationData& i_rRight);

} // namespace CoreOrlexTypes
