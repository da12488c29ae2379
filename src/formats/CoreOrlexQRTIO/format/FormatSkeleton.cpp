#include "CoreOrlexQRTIO/format/EnumTables.h"
#include "CoreOrlexQRTIO/format/FormatFunctions.h"
#include "CoreOrlexQRTIO/format/FormatTable.h"
#include "CoreOrlexQRTIO/format/JointElements.h"
#include "CoreOrlexQRTIO/read/AttributeReading.h"
#include "math/NumberText.h"

namespace CoreOrlexQRTIO
{
namespace
{

using UtilsRapidXml::INode;
using UtilsRapidXml::ReadAttribute;

/// All of a segment but its children, in a frame of its own: a chain of segments is walked by recursion.
/// @return true if the segment was appended.
[[gnu::noinline]] bool FormatSegmentItself(
    INode& io_rNode, VReading& io_rReading, std::uint32_t i_Parent, std::uint32_t i_Depth, bool i_bParentDropped)
{
	namespace Table = Format::Segment;
	const std::size_t errors = io_rNode.GetErrorCount();
	auto& rSegments = io_rReading.m_rSubject.m_Segments;
	VSegmentInHand inHand{rSegments.emplace_back(), io_rReading.m_rApplicationData.m_Segments.emplace_back(),
	    io_rReading.m_rExtras.m_Segments.emplace_back()};
	auto& [rSegment, rApplicationData, rExtras, rT] = inHand;
	rSegment.m_SegmentIndex = static_cast<std::uint32_t>(rSegments.size() - 1);
	rSegment.m_ParentSegmentIndex = i_Parent;
	rSegment.m_TreeDepth = i_Depth;

	std::string_view name;
	ReadAttribute(io_rNode, Table::c_Name, name);
	rSegment.m_Name = name;
	std::array<double, 3> position{};
	if (UtilsRapidXml::ReadList(io_rNode, Table::c_Position, 3, position.data()))
		std::ranges::transform(position, rSegment.m_PreTranslation.begin(), NumberText::PrintG17);
	std::uint8_t opacity = 255;
	ReadOpacity(io_rNode, Table::c_Opacity, opacity);
	ReadExpressions(io_rNode, Table::c_Orientation, rSegment.m_PreRotation);
	ReadExpressions(io_rNode, Table::c_Bounds, rSegment.m_Bounds);
	ReadAttribute(io_rNode, Table::c_Mass, rSegment.m_MassExpression);
	ReadExpressions(io_rNode, Table::c_MassCentre, rSegment.m_MassCentreExpressions);
	ReadExpressions(io_rNode, Table::c_Inertia, rSegment.m_RadiusOfGyrationExpressions);
	ReadColour(io_rNode, Table::c_Colour, rApplicationData.m_Colour);
	rApplicationData.m_Colour.m_Alpha = opacity;
	ReadAttribute(io_rNode, Table::c_Context, rApplicationData.m_Context);
	ReadHidden(io_rNode, Table::c_Hidden, rApplicationData.m_Visible);
	ReadAttribute(io_rNode, Table::c_DrawEndRatio, rApplicationData.m_DrawEndRatio);
	ReadAttribute(io_rNode, Table::c_DrawHeight, rApplicationData.m_DrawHeight);
	ReadAttribute(io_rNode, Table::c_DrawTwist, rApplicationData.m_DrawTwist);
	ReadAttribute(io_rNode, Table::c_DrawWidth, rApplicationData.m_DrawWidth);
	ReadAttribute(io_rNode, Table::c_Part, rApplicationData.m_Part);
	ReadAttribute(io_rNode, Table::c_Covariance, rExtras.m_Covariance);
	ReadAttribute(io_rNode, Table::c_Size, rExtras.m_Size);

	for (const VJointElement& rElement : c_JointElements)
		Declare(io_rNode, rElement.m_rElement);
	io_rNode.ProcessElements([&](INode& io_rJoint) { FormatJoint(io_rJoint, inHand); }, true);

	ReadAttribute(io_rNode, Table::c_DrawStyle, EnumTables::DrawStyle(), rApplicationData.m_DrawStyle);
	ReadAttribute(io_rNode, Table::c_DrawShading, EnumTables::DrawShading(), rApplicationData.m_DrawShading);

	if (i_bParentDropped || io_rNode.GetErrorCount() != errors)
	{
		rSegments.pop_back();
		io_rReading.m_rApplicationData.m_Segments.pop_back();
		io_rReading.m_rExtras.m_Segments.pop_back();
		return false;
	}
	rExtras.m_Name = rSegment.m_Name;
	io_rReading.m_SegmentsByName.emplace(name, rSegment.m_SegmentIndex);
	std::vector<double>& rConstraints = io_rReading.m_rSubject.m_TPoseConstraints;
	rConstraints.insert(rConstraints.end(), rT.begin(), rT.end());
	return true;
}

/// The children of a segment that is dropped are read for their errors and go with it.
void FormatSegment(
    INode& io_rNode, VReading& io_rReading, std::uint32_t i_Parent, std::uint32_t i_Depth, bool i_bParentDropped)
{
	const auto index = static_cast<std::uint32_t>(io_rReading.m_rSubject.m_Segments.size());
	const bool bDropped = !FormatSegmentItself(io_rNode, io_rReading, i_Parent, i_Depth, i_bParentDropped);
	Process(io_rNode, Format::Skeleton::c_Segment,
	    [&](INode& io_rChild) { FormatSegment(io_rChild, io_rReading, index, i_Depth + 1, bDropped); });
}

} // namespace

void FormatSkeleton(INode& io_rNode, VReading& io_rReading)
{
	Process(io_rNode, Format::Skeleton::c_Segment,
	    [&](INode& io_rSegment) { FormatSegment(io_rSegment, io_rReading, CoreOrlexTypes::c_NoParent, 0, false); });
	std::string name;
	ReadAttribute(io_rNode, Format::Skeleton::c_Name, name);
	ReadColour(io_rNode, Format::Skeleton::c_Colour, io_rReading.m_rApplicationData.m_Colour);
}

} // namespace CoreOrlexQRTIO
