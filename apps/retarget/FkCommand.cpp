#include "retarget/Commands.h"
#include "retarget/Elements.h"
#include "retarget/Output.h"
#include "retarget/SubjectFile.h"
#include "retarget/TargetKinematics.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "ComputeSubjectFK/TargetFKInterfaces.h"
#include "CoreOrlexTypesUtils/PoseVector.h"
#include "CoreOrlexTypesUtils/SubjectParametrisedConverter.h"
#include "CoreOrlexTypesUtils/UnusedObservations.h"
#include "DebugServices/GlobalLog.h"

#include <algorithm>

namespace CommandLine
{
namespace
{

using ComputeSubject::VComputeSubjectFK;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using CoreOrlexTypesUtils::VRenumbering;

struct VFkSettings
{
	std::string m_File;
	std::string m_Pose = "bind";
	std::string m_State;
};

/// Leaves out the targets without kinematics, which is told.
void DropUnusable(const ComputeSubject::VSegmentTree& i_rTree, const VSubjectApplicationData& i_rApplicationData,
    std::vector<VSubject::VTarget>& io_rTargets)
{
	std::vector<bool> keep(io_rTargets.size(), true);
	for (std::size_t i = 0; i < keep.size(); ++i)
	{
		keep[i] = TargetKinematics(io_rTargets[i], i_rTree) != nullptr;
		if (keep[i])
			continue;
		const auto& rNamed = i_rApplicationData.m_Targets;
		NVX_LOG(c_pCategory, NVX::ELogWarning,
		    "Target #%1% \"%2%\" does not fit its type, or has one without kinematics: it is left out", i,
		    i < rNamed.size() ? rNamed[i].m_Name : std::string());
	}
	CoreOrlexTypesUtils::VRenumbering(keep).Close(io_rTargets);
}

std::vector<double> State(const VFkSettings& i_rSettings, const VSubjectParametrised& i_rSubject, std::size_t i_Size)
{
	if (!i_rSettings.m_State.empty())
	{
		const std::vector<double> state = ParseList(i_rSettings.m_State, "--state");
		if (state.size() != i_Size)
			throw VCommandError(EWrongUsage,
			    "--state: the joints of \"" + i_rSettings.m_File + "\" take " + std::to_string(i_Size)
			        + " numbers, not " + std::to_string(state.size()));
		return state;
	}
	using VJoint = VSubjectParametrised::VJoint;
	const auto pStatistic = i_rSettings.m_Pose == "mean" ? &VJoint::m_Mean
	    : i_rSettings.m_Pose == "tpose"                  ? &VJoint::m_TPoseMean
	                                                     : &VJoint::m_BindPose;
	if (i_Size > 0
	    && std::all_of(i_rSubject.m_Segments.begin(), i_rSubject.m_Segments.end(),
	        [&](const auto& i_rSegment) { return (i_rSegment.m_Joint.*pStatistic).empty(); }))
		NVX_LOG(c_pCategory, NVX::ELogWarning, "\"%1%\" holds no %2% pose: zeros take its place", i_rSettings.m_File,
		    i_rSettings.m_Pose);
	return CoreOrlexTypesUtils::PoseVector(i_rSubject, pStatistic);
}

/// One entry for each of a subject's markers, or rotation observations.
/// @param i_rRenumbering to the indices of i_rValues, which holds only those that targets name.
template <typename TNamed, typename TValue>
VJson ObservationsToJson(const std::vector<TNamed>& i_rNamed, const VRenumbering& i_rRenumbering,
    const std::vector<TValue>& i_rValues, const std::vector<bool>& i_rValid, const char* i_pKey,
    const TValue& i_rWithout)
{
	VJson list = VJson::array();
	for (std::size_t i = 0; i < i_rNamed.size(); ++i)
	{
		std::uint32_t index = std::uint32_t(i);
		i_rRenumbering.Renumber(index);
		const bool bValid = index < i_rValues.size() && i_rValid[index];
		VJson item = VJson::object();
		item["name"] = i_rNamed[i].m_Name;
		item[i_pKey] = bValid ? i_rValues[index] : i_rWithout;
		item["valid"] = bValid;
		list.push_back(std::move(item));
	}
	return list;
}

EExitStatus ShowPoses(const VFkSettings& i_rSettings)
{
	const CoreOrlexTypes::VSubjectRecord record = ReadSubjectFile(i_rSettings.m_File).m_Record;
	const VSubjectParametrised& rParametrised = record.m_SubjectParametrised;
	VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(rParametrised, subject);
	const ComputeSubject::VSegmentTree tree = SegmentKinematics(subject);
	if (tree.size() != subject.m_Segments.size())
		throw VCommandError(EBadInput,
		    "\"" + i_rSettings.m_File + "\" has segments that make no tree, or more than one: they have no kinematics");
	DropUnusable(tree, record.m_SubjectApplicationData, subject.m_Targets);
	// Kinematics count the markers and observations that targets name, and take them as the first of their lists.
	const VRenumbering markers = CoreOrlexTypesUtils::NamedMarkers(subject);
	const VRenumbering rotations = CoreOrlexTypesUtils::NamedRotations(subject);
	for (VSubject::VTarget& rTarget : subject.m_Targets)
	{
		markers.Renumber(rTarget.m_MarkerIndices);
		rotations.Renumber(rTarget.m_RotationObservationIndices);
	}
	VComputeSubjectFK fk(subject);
	fk.Update(State(i_rSettings, rParametrised, fk.NumberOfStates()).data());

	VJson segments = VJson::array();
	for (std::size_t i = 0; i < subject.m_Segments.size(); ++i)
	{
		const Rotation::VPose<double> pose = fk.Segment(i).SegmentPose();
		VJson segment = VJson::object();
		segment["name"] = subject.m_Segments[i].m_Name;
		segment["rotation"] = pose.R;
		segment["translation"] = pose.t;
		segments.push_back(std::move(segment));
	}
	VJson result = VJson::object();
	result["segments"] = std::move(segments);
	std::vector<bool> valid;
	std::vector<Rotation::VVector3> positions;
	fk.ComputeMarkers(positions, valid);
	result["markers"] = ObservationsToJson(rParametrised.m_Markers, markers, positions, valid, "position", {});
	std::vector<Rotation::VMatrix3> orientations;
	fk.ComputeRotations(orientations, valid);
	result["rotations"] = ObservationsToJson(
	    rParametrised.m_Rotations, rotations, orientations, valid, "rotation", Rotation::c_Identity3);
	PrintJson(result);
	return EFine;
}

} // namespace

VCommand AddFkCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "fk",
	    "Show where the segments, markers and rotation observations of a skeleton or retarget file stand in the "
	    "world, as JSON: rotations row by row, translations in millimetres",
	    {"fk hero.qrr", "fk performer.qrs --pose tpose", "fk arm.qrs --state 0,0,0,0,0,1000,0.5"});
	const auto pSettings = std::make_shared<VFkSettings>();
	pApp->add_option("FILE", pSettings->m_File, "Skeleton file (.qrt, .qrk, .qrs, .qrr) or legacy text (.qrx)")
	    ->required();
	pApp->add_option("--pose", pSettings->m_Pose, "Which of the poses in the file (default: bind)")
	    ->option_text("bind|mean|tpose")
	    ->check(CLI::IsMember({"bind", "mean", "tpose"}));
	pApp->add_option("--state", pSettings->m_State,
	        "A pose of your own: the values of all joints in the order of the segments, radians and mm")
	    ->option_text("V,V,...");
	return {pApp, [pSettings] { return ShowPoses(*pSettings); }};
}

} // namespace CommandLine
