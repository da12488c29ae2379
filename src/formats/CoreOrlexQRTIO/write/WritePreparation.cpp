#include "CoreOrlexQRTIO/write/WritePreparation.h"

#include "CoreOrlexQRTIO/Limits.h"
#include "CoreOrlexQRTIO/format/Format.h"
#include "CoreOrlexQRTIO/values/Evaluation.h"
#include "CoreOrlexQRTIO/values/ExpressionList.h"
#include "CoreOrlexTypes/JointType.h"
#include "math/NumberText.h"

#include <boost/format.hpp>

#include <algorithm>
#include <locale>
#include <set>

namespace CoreOrlexQRTIO
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using VTexts = std::vector<std::string>;
using VJoint = VSubjectParametrised::VJoint;

/// Children and roots, if every segment can be reached from a root within the depth that a file holds.
bool PrepareTree(VWriting& io_rWriting, VTexts& io_rErrors)
{
	const auto& rSegments = io_rWriting.m_rSubject.m_Segments;
	for (std::uint32_t i = 0; i < rSegments.size(); ++i)
	{
		const std::uint32_t parent = rSegments[i].m_ParentSegmentIndex;
		if (parent == CoreOrlexTypes::c_NoParent)
			io_rWriting.m_Roots.push_back(i);
		else if (parent < rSegments.size())
			io_rWriting.m_Segments[parent].m_Children.push_back(i);
	}
	// Level by level, each behind the one before.
	std::vector<std::uint32_t> reached = io_rWriting.m_Roots;
	std::size_t depth = 0;
	for (std::size_t at = 0; at < reached.size(); ++depth)
		for (const std::size_t levelEnd = reached.size(); at < levelEnd; ++at)
		{
			const std::vector<std::uint32_t>& rChildren = io_rWriting.m_Segments[reached[at]].m_Children;
			reached.insert(reached.end(), rChildren.begin(), rChildren.end());
		}
	if (reached.size() != rSegments.size())
		io_rErrors.push_back(
		    (boost::format(
		         "%1% segments cannot be reached from a root: their parents are missing or go round in a ring.",
		         std::locale::classic())
		        % (rSegments.size() - reached.size()))
		        .str());
	else if (depth > c_MaximumSegmentDepth)
		io_rErrors.push_back((boost::format("A chain of %1% segments is longer than a file can hold, which is %2%.",
		                          std::locale::classic())
		    % depth % c_MaximumSegmentDepth)
		                         .str());
	else
		return true;
	return false;
}

bool Evaluate(VWriting& io_rWriting, std::span<const std::string> i_Expressions, Rotation::VVector3& o_rValues,
    VTexts& io_rErrors)
{
	std::string error;
	bool bFine = true;
	for (std::size_t i = 0; i < 3; ++i)
		if (!io_rWriting.m_rParser.Evaluate(i_Expressions[i], o_rValues[i], error))
		{
			io_rErrors.push_back(error);
			bFine = false;
		}
	return bFine;
}

VTexts Printed(const Rotation::VVector3& i_rVector)
{
	VTexts texts(3);
	std::ranges::transform(i_rVector, texts.begin(), NumberText::PrintG17);
	return texts;
}

/// What files up to 3.1 hold of the segment's pose in the joint's frame: as it was read, if that still yields what the
/// segment holds.
void PreparePost(
    VWriting& io_rWriting, const VSubjectParametrised::VSegment& i_rSegment, VPreparedSegment& io_rPrepared)
{
	const std::optional<VJointPose> post = PostPose(io_rWriting.m_rParser, io_rPrepared.Extras().m_Joint);
	const VJointPose held{i_rSegment.m_InversePostRotation, i_rSegment.m_InversePostTranslation};
	if (post && Inverse(*post) == held)
		return;
	const VJointPose computed = Inverse(held);
	io_rPrepared.m_pComputedExtras = std::make_unique<VSubjectQRTExtras::VSegment>(io_rPrepared.Extras());
	io_rPrepared.m_pExtras = io_rPrepared.m_pComputedExtras.get();
	VSubjectQRTExtras::VJoint& rExtras = io_rPrepared.m_pComputedExtras->m_Joint;
	rExtras.m_PostOrientation = Printed(computed.m_Rotation);
	rExtras.m_PostPosition = Printed(computed.m_Translation);
	rExtras.m_TemplatePostOrientation.assign(computed.m_Rotation.begin(), computed.m_Rotation.end());
	rExtras.m_TemplatePostPosition.assign(computed.m_Translation.begin(), computed.m_Translation.end());
}

/// The axes as they were read, if they still yield the orientation that the joint holds.
void PrepareAxes(const VJoint& i_rJoint, VPreparedSegment& io_rPrepared)
{
	if (AxesSize(i_rJoint.m_JointType) == 0)
		return;
	Rotation::VVector3 orientation{};
	const std::vector<double>& rRead = io_rPrepared.Extras().m_Joint.m_Axis;
	if (JointOrientation(i_rJoint.m_JointType, rRead, io_rPrepared.m_PrePose, orientation) == EAxesResult::Fine
	    && orientation == i_rJoint.m_JointOrientation)
		io_rPrepared.m_Axes = rRead;
	else
		io_rPrepared.m_Axes =
		    AxesOfOrientation(i_rJoint.m_JointOrientation, i_rJoint.m_JointType == VJoint::EHardySpicer);
}

/// Shares the T-pose constraints out: to the joints that had a share in the file, or to all.
void PrepareT(VWriting& io_rWriting)
{
	const std::vector<double>& rConstraints = io_rWriting.m_rSubject.m_TPoseConstraints;
	const auto& rSegments = io_rWriting.m_rSubject.m_Segments;
	std::size_t sizeOfAll = 0;
	std::size_t sizeAsRead = 0;
	for (std::size_t i = 0; i < rSegments.size(); ++i)
	{
		const std::size_t size = CoreOrlexTypes::StateSize(rSegments[i].m_Joint.m_JointType);
		sizeOfAll += size;
		if (io_rWriting.m_Segments[i].Extras().m_Joint.m_bHasT)
			sizeAsRead += size;
	}
	const bool bAsRead = rConstraints.size() == sizeAsRead;
	if (!bAsRead && rConstraints.size() != sizeOfAll)
	{
		if (!rConstraints.empty())
			io_rWriting.m_Warnings.push_back((
			    boost::format("The %1% T-pose constraints do not fit the %2% degrees of freedom of the joints: none is "
			                  "written.",
			        std::locale::classic())
			    % rConstraints.size() % sizeOfAll)
			                                     .str());
		return;
	}
	std::span<const double> rest = rConstraints;
	for (std::size_t i = 0; i < rSegments.size(); ++i)
		if (!bAsRead || io_rWriting.m_Segments[i].Extras().m_Joint.m_bHasT)
		{
			const std::size_t size = CoreOrlexTypes::StateSize(rSegments[i].m_Joint.m_JointType);
			io_rWriting.m_Segments[i].m_T = rest.first(size);
			rest = rest.subspan(size);
		}
}

/// Names lose blanks at their ends in a file, where two must not become one.
/// @param o_rFirst For each element the first one of its name.
bool CheckNames(VWriting& io_rWriting, const auto& i_rElements, const char* i_pKind,
    std::vector<std::uint32_t>& o_rFirst, VTexts& io_rErrors)
{
	const std::size_t errors = io_rErrors.size();
	std::unordered_map<std::string_view, std::uint32_t> firstOf;
	firstOf.reserve(i_rElements.size());
	o_rFirst.reserve(i_rElements.size());
	for (const auto& rElement : i_rElements)
	{
		const std::string_view name = rElement.m_Name;
		const std::string_view written = Trimmed(name);
		const auto [it, bFirst] = firstOf.emplace(written, static_cast<std::uint32_t>(o_rFirst.size()));
		o_rFirst.push_back(it->second);
		const std::string_view first = i_rElements[it->second].m_Name;
		if (first != name)
			io_rErrors.push_back((boost::format("%1% '%2%' and %1% '%3%' would have one name in a file, which holds no "
			                                    "blanks at the ends of a name: rename one of them.")
			    % i_pKind % first % name)
			                         .str());
		else if (bFirst && written.size() != name.size())
			io_rWriting.m_Warnings.push_back(
			    (boost::format("%1% '%2%' is written as '%3%': a file holds no blanks at the ends of a name.") % i_pKind
			        % name % written)
			        .str());
	}
	return io_rErrors.size() == errors;
}

} // namespace

bool Prepare(VWriting& io_rWriting, VTexts& io_rErrors)
{
	const VSubjectParametrised& rSubject = io_rWriting.m_rSubject;
	if (!io_rWriting.m_rParser.Initialise(rSubject, io_rErrors))
		return false;
	io_rWriting.m_Segments.resize(rSubject.m_Segments.size());
	if (!PrepareTree(io_rWriting, io_rErrors))
		return false;
	bool bFine = CheckNames(io_rWriting, rSubject.m_Segments, "Segment", io_rWriting.m_FirstSegments, io_rErrors);
	bFine &= CheckNames(io_rWriting, rSubject.m_Markers, "Marker", io_rWriting.m_FirstMarkers, io_rErrors);
	std::vector<std::uint32_t> firstObservations;
	bFine &= CheckNames(io_rWriting, rSubject.m_Rotations, "Rotation observation", firstObservations, io_rErrors);
	VRecordsByName<VSubjectQRTExtras::VSegment> extras(io_rWriting.m_rExtras.m_Segments);
	static const VSubjectQRTExtras::VSegment s_NothingRead;
	for (std::size_t i = 0; i < rSubject.m_Segments.size(); ++i)
	{
		const VSubjectParametrised::VSegment& rSegment = rSubject.m_Segments[i];
		VPreparedSegment& rPrepared = io_rWriting.m_Segments[i];
		const VSubjectQRTExtras::VSegment* const pRead = extras.Find(i, rSegment.m_Name);
		rPrepared.m_pExtras = pRead ? pRead : &s_NothingRead;
		bFine &= Evaluate(io_rWriting, rSegment.m_PreRotation, rPrepared.m_PrePose.m_Rotation, io_rErrors);
		bFine &= Evaluate(io_rWriting, rSegment.m_PreTranslation, rPrepared.m_PrePose.m_Translation, io_rErrors);
		if (io_rWriting.m_Version < Format::c_3_2)
			PreparePost(io_rWriting, rSegment, rPrepared);
		PrepareAxes(rSegment.m_Joint, rPrepared);
	}
	PrepareT(io_rWriting);
	return bFine;
}

std::vector<std::string> WritableExpressions(VWriting& io_rWriting, std::span<const std::string> i_Expressions)
{
	VTexts texts(i_Expressions.begin(), i_Expressions.end());
	const auto& rStatic = io_rWriting.m_rSubject.m_StaticParameters;
	if (!io_rWriting.m_Version.IsSet() || io_rWriting.m_Version >= Format::c_2_0 || rStatic.empty())
		return texts;
	const auto usesStatic = [&](const std::string& i_rText)
	{
		std::set<std::string> names;
		std::string error;
		return io_rWriting.m_rParser.EvaluateChecked(i_rText, names, error)
		    && std::ranges::any_of(rStatic,
		        [&](const VSubjectParametrised::VStaticParameter& i_rParameter)
		        { return names.contains(i_rParameter.m_Name); });
	};
	double value = 0.0;
	std::string error;
	for (std::string& rText : texts)
		if (!NumberText::ScanWholeReal(rText, value) && usesStatic(rText)
		    && io_rWriting.m_rParser.Evaluate(rText, value, error))
			rText = NumberText::PrintG17(value);
	return texts;
}

} // namespace CoreOrlexQRTIO
