#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/Elements.h"
#include "retarget/subject/RecordKinematics.h"
#include "retarget/subject/SubjectFile.h"
#include "retarget/text/Output.h"

#include "ComputeSubjectFK/SegmentFKInterfaces.h"
#include "CoreOrlexTypesUtils/joints/PoseVector.h"
#include "DebugServices/GlobalLog.h"

#include <algorithm>

namespace CommandLine
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using CoreOrlexTypes::VSubjectRecord;

struct VFkSettings
{
	std::string m_File;
	std::string m_Pose = "bind";
	std::string m_State;
};

std::vector<double> State(const VFkSettings& i_rSettings, const VSubjectParametrised& i_rSubject, std::size_t i_Size)
{
	if (!i_rSettings.m_State.empty())
	{
		std::vector<double> state = ParseList(i_rSettings.m_State, "--state");
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
template <typename TNamed, typename TValue>
VJson ObservationsToJson(const std::vector<TNamed>& i_rNamed, const std::vector<TValue>& i_rValues,
    const std::vector<bool>& i_rValid, const char* i_pKey)
{
	VJson list = VJson::array();
	for (std::size_t i = 0; i < i_rNamed.size(); ++i)
	{
		VJson item = VJson::object();
		item["name"] = i_rNamed[i].m_Name;
		item[i_pKey] = i_rValues[i];
		item["valid"] = bool(i_rValid[i]);
		list.push_back(std::move(item));
	}
	return list;
}

EExitStatus ShowPoses(const VFkSettings& i_rSettings)
{
	const VSubjectRecord record = ReadSubjectFile(i_rSettings.m_File).m_Record;
	const VSubjectParametrised& rParametrised = record.m_SubjectParametrised;
	CoreOrlexTypesUtils::VSubjectKinematics kinematics = KinematicsOf(i_rSettings.m_File, record);
	kinematics.Update(State(i_rSettings, rParametrised, kinematics.NumberOfStates()).data());

	VJson segments = VJson::array();
	for (std::size_t i = 0; i < rParametrised.m_Segments.size(); ++i)
	{
		const Rotation::VPose<double> pose = kinematics.Segment(i).SegmentPose();
		VJson segment = VJson::object();
		segment["name"] = rParametrised.m_Segments[i].m_Name;
		segment["rotation"] = pose.R;
		segment["translation"] = pose.t;
		segments.push_back(std::move(segment));
	}
	VJson result = VJson::object();
	result["segments"] = std::move(segments);
	std::vector<bool> valid;
	std::vector<Rotation::VVector3> positions;
	kinematics.ComputeMarkers(positions, valid);
	result["markers"] = ObservationsToJson(rParametrised.m_Markers, positions, valid, "position");
	std::vector<Rotation::VMatrix3> orientations;
	kinematics.ComputeRotations(orientations, valid);
	result["rotations"] = ObservationsToJson(rParametrised.m_Rotations, orientations, valid, "rotation");
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
	pApp->add_option("FILE", pSettings->m_File, c_pSkeletonFileHelp)->required();
	pApp->add_option("--pose", pSettings->m_Pose, "Which of the poses in the file (default: bind)")
	    ->option_text("bind|mean|tpose")
	    ->check(OneOf({"bind", "mean", "tpose"}));
	pApp->add_option("--state", pSettings->m_State,
	        "A pose of your own: the values of all joints in the order of the segments, radians and mm")
	    ->option_text("V,V,...");
	return {pApp, [pSettings] { return ShowPoses(*pSettings); }};
}

} // namespace CommandLine
