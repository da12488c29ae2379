#include "retarget/python/Arrays.h"
#include "retarget/python/Call.h"
#include "retarget/python/Files.h"
#include "retarget/python/Records.h"
#include "retarget/subject/RecordKinematics.h"

#include "ComputeSubjectFK/SegmentFKInterfaces.h"
#include "CoreOrlexTypesUtils/joints/PoseVector.h"

#include <pybind11/stl.h>

#include <algorithm>
#include <limits>
#include <mutex>
#include <span>
#include <thread>

namespace CommandLine::Python
{
namespace
{

namespace py = pybind11;
using VJoint = CoreOrlexTypes::VSubjectParametrised::VJoint;

/// Threads of Python that use one wait for each other, but for poses, which leave it as it is.
class VPythonKinematics
{
public:
	explicit VPythonKinematics(const VSubjectFile& i_rFile)
	    : m_Subject(i_rFile.m_Record.m_SubjectParametrised),
	      m_Kinematics(KinematicsOf(i_rFile.m_Record.m_SubjectParametrised.m_Name, i_rFile.m_Record))
	{
	}

	std::size_t NumberOfStates() const { return m_Kinematics.NumberOfStates(); }

	VNumbers Pose(std::vector<double> VJoint::*i_pStatistic) const
	{
		return ToArray(CoreOrlexTypesUtils::PoseVector(m_Subject, i_pStatistic));
	}

	/// Fills for each frame, a row of states, i_Count things of c_Size values: i_Fill(states, out, frames) with the
	/// lock of the interpreter given away.
	template <std::size_t c_Size, typename TFill>
	VNumbers ForFrames(const VNumbers& i_rStates, std::size_t i_Count, std::vector<py::ssize_t> i_Shape, TFill i_Fill)
	{
		const bool bOne = i_rStates.ndim() == 1;
		if (i_rStates.ndim() < 1 || i_rStates.ndim() > 2
		    || std::size_t(i_rStates.shape(i_rStates.ndim() - 1)) != NumberOfStates())
			throw py::value_error("states have a row of " + std::to_string(NumberOfStates())
			    + " numbers for each frame, or are one such row");
		const auto frames = bOne ? 1 : std::size_t(i_rStates.shape(0));
		if (!bOne)
			i_Shape.insert(i_Shape.begin(), py::ssize_t(frames));
		VNumbers result(i_Shape);
		const std::span states(i_rStates.data(), frames * NumberOfStates());
		const std::span out(result.mutable_data(), frames * i_Count * c_Size);
		Call([&] { i_Fill(states, out, frames); });
		return result;
	}

	VNumbers Poses(const VNumbers& i_rStates)
	{
		const std::size_t count = m_Subject.m_Segments.size();
		return ForFrames<16>(i_rStates, count, {py::ssize_t(count), 4, 4},
		    [&](std::span<const double> i_States, std::span<double> o_Out, std::size_t i_Frames)
		    {
			    // In parts, so that what is kept beside the result does not grow with it.
			    constexpr std::size_t c_Part = 1024;
			    std::vector<Rotation::VPose<double>> poses(std::min(i_Frames, c_Part) * count);
			    double* pOut = o_Out.data();
			    for (std::size_t first = 0; first < i_Frames; first += c_Part)
			    {
				    const std::size_t frames = std::min(c_Part, i_Frames - first);
				    const std::span part(poses.data(), frames * count);
				    m_Kinematics.UpdateMany(i_States.subspan(first * NumberOfStates()), part,
				        std::max(1u, std::thread::hardware_concurrency()));
				    for (const Rotation::VPose<double>& rPose : part)
					    WriteMatrix(rPose, pOut);
			    }
		    });
	}

	/// i_Fill(out) writes what a frame has, after an update to it.
	template <std::size_t c_Size, typename TFill>
	VNumbers ForEachFrame(
	    const VNumbers& i_rStates, std::size_t i_Count, std::vector<py::ssize_t> i_Shape, TFill i_Fill)
	{
		return ForFrames<c_Size>(i_rStates, i_Count, std::move(i_Shape),
		    [&](std::span<const double> i_States, std::span<double> o_Out, std::size_t i_Frames)
		    {
			    const std::lock_guard lock(m_Mutex);
			    for (std::size_t frame = 0; frame < i_Frames; ++frame)
			    {
				    m_Kinematics.Update(i_States.data() + frame * NumberOfStates());
				    i_Fill(o_Out.data() + frame * c_Size * i_Count);
			    }
		    });
	}

	VNumbers Markers(const VNumbers& i_rStates)
	{
		const std::size_t count = m_Subject.m_Markers.size();
		return ForEachFrame<3>(i_rStates, count, {py::ssize_t(count), 3},
		    [&](double* o_pOut)
		    {
			    m_Kinematics.ComputeMarkers(m_Positions, m_Valid);
			    Write(m_Positions, o_pOut);
		    });
	}

	VNumbers Rotations(const VNumbers& i_rStates)
	{
		const std::size_t count = m_Subject.m_Rotations.size();
		return ForEachFrame<9>(i_rStates, count, {py::ssize_t(count), 3, 3},
		    [&](double* o_pOut)
		    {
			    m_Kinematics.ComputeRotations(m_Orientations, m_Valid);
			    Write(m_Orientations, o_pOut);
		    });
	}

private:
	template <typename TValue>
	void Write(const std::vector<TValue>& i_rValues, double* o_pOut) const
	{
		for (std::size_t i = 0; i < i_rValues.size(); ++i)
			for (const double value : i_rValues[i])
				*o_pOut++ = m_Valid[i] ? value : std::numeric_limits<double>::quiet_NaN();
	}

	const CoreOrlexTypes::VSubjectParametrised m_Subject;
	std::mutex m_Mutex;
	CoreOrlexTypesUtils::VSubjectKinematics m_Kinematics;
	std::vector<Rotation::VVector3> m_Positions;
	std::vector<Rotation::VMatrix3> m_Orientations;
	std::vector<bool> m_Valid;
};

} // namespace

void DefineKinematics(py::module_& io_rModule)
{
	py::class_<VPythonKinematics, std::shared_ptr<VPythonKinematics>>(io_rModule, "Kinematics")
	    .def(py::init(
	        [](const py::tuple& i_rParts)
	        {
		        const VSubjectFile file = FileFrom(i_rParts);
		        std::shared_ptr<VPythonKinematics> pKinematics;
		        Call([&] { pKinematics = std::make_shared<VPythonKinematics>(file); });
		        return pKinematics;
	        }))
	    .def_property_readonly("number_of_states", &VPythonKinematics::NumberOfStates)
	    .def(
	        "bind_pose", [](const VPythonKinematics& i_rKinematics) { return i_rKinematics.Pose(&VJoint::m_BindPose); })
	    .def("mean_pose", [](const VPythonKinematics& i_rKinematics) { return i_rKinematics.Pose(&VJoint::m_Mean); })
	    .def("t_pose", [](const VPythonKinematics& i_rKinematics) { return i_rKinematics.Pose(&VJoint::m_TPoseMean); })
	    .def("poses", &VPythonKinematics::Poses)
	    .def("markers", &VPythonKinematics::Markers)
	    .def("rotations", &VPythonKinematics::Rotations);
}

} // namespace CommandLine::Python
