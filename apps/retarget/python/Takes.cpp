#include "retarget/python/Takes.h"

#include "CommandLineText/ExitStatus.h"
#include "retarget/python/Arrays.h"
#include "retarget/python/Call.h"
#include "retarget/python/Files.h"
#include "retarget/python/Records.h"
#include "retarget/subject/TakeFile.h"

#include "DebugServices/GlobalLog.h"
#include "TakeIO/Limits.h"
#include "TakeSolve/Performer.h"
#include "TakeSolve/PosedSubject.h"

#include <pybind11/stl.h>

namespace CommandLine::Python
{
namespace
{

namespace py = pybind11;

std::shared_ptr<VPythonTake> MakeTake(const std::string& i_rPath, const std::optional<std::string>& i_rStack,
    const std::optional<std::string>& i_rUp, std::optional<double> i_Unit, std::optional<double> i_Rate)
{
	const auto require = [](bool i_bFine, const char* i_pWhat)
	{
		if (!i_bFine)
			throw py::value_error(i_pWhat);
	};
	using namespace TakeIO::Limits;
	require(!i_rUp || *i_rUp == "y" || *i_rUp == "z", "up is \"y\" or \"z\"");
	require(!i_Unit || (*i_Unit >= c_LeastUnit && *i_Unit <= c_GreatestUnit), "unit is no unit in millimetres");
	require(!i_Rate || (*i_Rate >= c_LeastRate && *i_Rate <= c_GreatestRate), "rate is no number of frames a second");
	TakeIO::VTakeSettings settings;
	if (i_rUp)
		settings.m_Up = *i_rUp == "y" ? TakeIO::EUp::Y : TakeIO::EUp::Z;
	settings.m_Unit = i_Unit;
	settings.m_Rate = i_Rate;
	settings.m_Stack = i_rStack;
	auto pTake = std::make_shared<VPythonTake>(VPythonTake{FilePath(i_rPath), nullptr});
	Call([&] { pTake->m_pTake = std::make_shared<const TakeIO::VTake>(ReadTakeFile(pTake->m_Path, settings)); });
	return pTake;
}

py::list Joints(const VPythonTake& i_rTake)
{
	py::list list;
	for (const TakeIO::VJoint& rJoint : i_rTake.m_pTake->m_Joints)
		list.append(py::make_tuple(TextToPython(rJoint.m_Name), rJoint.m_Parent));
	return list;
}

/// World matrices of so many things in frames from the first to the last; the function poses them in a frame.
template <typename TPose>
VNumbers PosesOfFrames(const TakeIO::VTake& i_rTake, std::size_t i_First, std::optional<std::size_t> i_Last,
    std::size_t i_Count, TPose i_Pose)
{
	const std::size_t last = i_Last.value_or(i_rTake.m_Frames - 1);
	if (i_First > last || last >= i_rTake.m_Frames)
		throw py::value_error("the take has the frames 0 to " + std::to_string(i_rTake.m_Frames - 1));
	VNumbers result({py::ssize_t(last - i_First + 1), py::ssize_t(i_Count), py::ssize_t(4), py::ssize_t(4)});
	double* pOut = result.mutable_data();
	Call(
	    [&]
	    {
		    std::vector<Rotation::VPose<double>> poses;
		    for (std::size_t frame = i_First; frame <= last; ++frame)
		    {
			    i_Pose(frame, poses);
			    for (const Rotation::VPose<double>& rPose : poses)
				    WriteMatrix(rPose, pOut);
		    }
	    });
	return result;
}

VNumbers JointPoses(const VPythonTake& i_rTake, std::size_t i_First, std::optional<std::size_t> i_Last)
{
	const TakeIO::VTake& rTake = *i_rTake.m_pTake;
	return PosesOfFrames(rTake, i_First, i_Last, rTake.m_Joints.size(),
	    [&rTake](std::size_t i_Frame, std::vector<Rotation::VPose<double>>& o_rPoses)
	    { TakeIO::WorldPoses(rTake, i_Frame, o_rPoses); });
}

VNumbers Poses(const VPythonTake& i_rTake, const py::tuple& i_rParts, std::size_t i_First,
    std::optional<std::size_t> i_Last, const VJointNames& i_rJoints, std::optional<std::size_t> i_RestFrame)
{
	const VSubjectFile file = FileFrom(i_rParts);
	std::shared_ptr<const TakeSolve::VSourceMotion> pMotion;
	Call(
	    [&]
	    {
		    const TakeSolve::VPosedSubject posed(file.m_Record.m_SubjectParametrised);
		    std::string error;
		    pMotion = TakeSolve::VSourceMotion::Make(
		        posed.m_Subject, posed.m_BindPose, i_rTake.m_pTake, ToSettings(i_rJoints, i_RestFrame), error);
		    if (!pMotion)
			    throw VCommandError(EWrongUsage, error);
		    for (const TakeSolve::VFinding& rFinding : pMotion->Findings())
			    NVX_LOG("retarget", NVX::ELogWarning, "%1%", rFinding.m_Message);
	    });
	return PosesOfFrames(*i_rTake.m_pTake, i_First, i_Last, pMotion->SegmentNames().size(),
	    [pMotion, joints = std::vector<Rotation::VPose<double>>()](std::size_t i_Frame,
	        std::vector<Rotation::VPose<double>>& o_rPoses) mutable { pMotion->Poses(i_Frame, joints, o_rPoses); });
}

py::tuple Performer(const VPythonTake& i_rTake)
{
	VSubjectFile file;
	Call(
	    [&]
	    {
		    std::vector<TakeSolve::VFinding> findings;
		    file.m_Record = TakeSolve::MakePerformer(
		        *i_rTake.m_pTake, TakeSolve::StandingPose(*i_rTake.m_pTake), StemOf(i_rTake.m_Path), findings);
		    for (const TakeSolve::VFinding& rFinding : findings)
			    NVX_LOG("retarget", NVX::ELogWarning, "%1%", rFinding.m_Message);
	    });
	return ToPython(std::move(file));
}

} // namespace

TakeSolve::VSourceSettings ToSettings(const VJointNames& i_rJoints, std::optional<std::size_t> i_RestFrame)
{
	TakeSolve::VSourceSettings settings;
	for (const auto& [rJoint, rSegment] : i_rJoints)
		settings.m_Joints.push_back({rJoint, rSegment});
	settings.m_RestFrame = i_RestFrame;
	return settings;
}

void DefineTakes(py::module_& io_rModule)
{
	py::class_<VPythonTake, std::shared_ptr<VPythonTake>>(io_rModule, "Take")
	    .def(py::init(&MakeTake))
	    .def_property_readonly("number_of_frames", [](const VPythonTake& i_rTake) { return i_rTake.m_pTake->m_Frames; })
	    .def_property_readonly("rate", [](const VPythonTake& i_rTake) { return i_rTake.m_pTake->m_Rate; })
	    .def("joints", &Joints)
	    .def("joint_poses", &JointPoses)
	    .def("poses", &Poses)
	    .def("performer", &Performer);
}

} // namespace CommandLine::Python
