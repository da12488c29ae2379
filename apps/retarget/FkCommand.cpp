#include "retarget/Commands.h"
#include "retarget/Elements.h"
#include "retarget/Output.h"
#include "retarget/SubjectFile.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypesUtils/PoseVector.h"
#include "CoreOrlexTypesUtils/SubjectParametrisedConverter.h"
#include "DebugServices/GlobalLog.h"

#include <algorithm>

namespace CommandLine
{
namespace
{

using ComputeSubject::VComputeSubjectFK;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

struct VFkSettings
{
	std::string m_File;
	std::string m_Pose = "bind";
	std::string m_State;
};

/// Targets that fit no class are left out, and their markers with them.
std::unique_ptr<VComputeSubjectFK> Kinematics(VSubject i_Subject, const std::string& i_rPath)
{
	std::unique_ptr<VComputeSubjectFK> pFK;
	try
	{
		pFK = std::make_unique<VComputeSubjectFK>(i_Subject);
	}
	catch (const ComputeSubject::VConstructionException&)
	{
		NVX_LOG(c_pCategory, NVX::ELogWarning, "A target does not fit its type: no markers are computed");
		i_Subject.m_Targets.clear();
		pFK = std::make_unique<VComputeSubjectFK>(i_Subject);
	}
	if (pFK->NumberOfSegments() != i_Subject.m_Segments.size())
		throw VCommandError(
		    EBadInput, "\"" + i_rPath + "\" has segments that make no tree, or more than one: they have no kinematics");
	return pFK;
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

VJson MarkersToJson(const VSubject& i_rSubject, const VComputeSubjectFK& i_rFK)
{
	std::vector<Rotation::VVector3> positions;
	i_rFK.ComputeMarkers(positions);
	std::vector<double> weights(i_rSubject.m_Markers.size());
	for (const VSubject::VTarget& rTarget : i_rSubject.m_Targets)
		for (const std::uint32_t marker : rTarget.m_MarkerIndices)
			if (marker < weights.size() && i_rFK.NumberOfTargets() > 0)
				weights[marker] += rTarget.m_Weight;
	VJson markers = VJson::array();
	for (std::size_t i = 0; i < weights.size(); ++i)
	{
		const bool bValid = i < positions.size() && weights[i] > 0.0;
		VJson marker = VJson::object();
		marker["name"] = i_rSubject.m_Markers[i].m_Name;
		marker["position"] = bValid ? positions[i] : Rotation::VVector3{};
		marker["valid"] = bValid;
		markers.push_back(std::move(marker));
	}
	return markers;
}

EExitStatus ShowPoses(const VFkSettings& i_rSettings)
{
	const VSubjectParametrised parametrised = ReadSubjectFile(i_rSettings.m_File).m_Record.m_SubjectParametrised;
	VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(parametrised, subject);
	const auto pFK = Kinematics(subject, i_rSettings.m_File);
	const std::vector<double> state = State(i_rSettings, parametrised, pFK->NumberOfStates());
	pFK->Update(state.data());

	VJson segments = VJson::array();
	for (std::size_t i = 0; i < subject.m_Segments.size(); ++i)
	{
		const Rotation::VPose<double> pose = pFK->Segment(i).SegmentPose();
		VJson segment = VJson::object();
		segment["name"] = subject.m_Segments[i].m_Name;
		segment["rotation"] = pose.R;
		segment["translation"] = pose.t;
		segments.push_back(std::move(segment));
	}
	VJson result = VJson::object();
	result["segments"] = std::move(segments);
	result["markers"] = MarkersToJson(subject, *pFK);
	PrintJson(result);
	return EFine;
}

} // namespace

VCommand AddFkCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "fk",
	    "Show where the segments and markers of a skeleton or retarget file stand in the world as JSON: rotations row "
	    "by "
	    "row, translations in millimetres",
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
