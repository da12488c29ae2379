#include "retarget/python/Session.h"

#include "retarget/python/Arrays.h"
#include "retarget/python/Call.h"
#include "retarget/python/Files.h"
#include "retarget/python/Records.h"
#include "retarget/python/Takes.h"
#include "retarget/subject/Aligning.h"
#include "retarget/subject/Making.h"
#include "retarget/subject/Mapping.h"
#include "retarget/subject/PlayedTake.h"
#include "retarget/subject/Session.h"
#include "retarget/subject/TargetLines.h"

#include <pybind11/stl.h>

#include <mutex>

namespace CommandLine::Python
{
namespace
{

namespace py = pybind11;

/// Name and value of options of "create" and "edit", without dashes; nothing for one that takes none.
using VEditPairs = std::vector<std::pair<std::string, std::optional<std::string>>>;

/// Threads of Python that use one session wait for each other.
class VPythonSession
{
public:
	VPythonSession(const VMaking& i_rMaking, const VEditPairs& i_rEdits) : m_bOfFbx(!i_rMaking.m_Fbx.empty())
	{
		MakeSubject(m_Session, i_rMaking, ToEdits(i_rEdits));
	}

	void Edit(const VEditPairs& i_rEdits)
	{
		const VEdits edits = ToEdits(i_rEdits);
		const std::lock_guard lock(m_Mutex);
		Apply(edits);
	}

	/// Edits whose choice of what an alignment reaches ends with them.
	void Align(const VEditPairs& i_rEdits)
	{
		struct VKept
		{
			~VKept() { m_rSession.m_Alignment = std::move(m_Choice); }
			VSession& m_rSession;
			RetargetSetup::VAlignmentChoice m_Choice = m_rSession.m_Alignment;
		};
		const VEdits edits = ToEdits(i_rEdits);
		const std::lock_guard lock(m_Mutex);
		const VKept kept{m_Session};
		Apply(edits);
	}

	VSubjectFile Target()
	{
		const std::lock_guard lock(m_Mutex);
		const auto values = m_Session.Document().TargetValues();
		return {{*values.m_pParametrised, *values.m_pApplicationData}, m_Session.Document().GetTargetExtras()};
	}

	/// Empty without one.
	VSubjectFile Source()
	{
		const std::lock_guard lock(m_Mutex);
		const auto values = m_Session.Document().SourceValues();
		VSubjectFile file;
		if (values.m_pParametrised)
			file.m_Record = {*values.m_pParametrised, *values.m_pApplicationData};
		return file;
	}

	void Replace(const VSubjectFile& i_rFile)
	{
		const std::lock_guard lock(m_Mutex);
		m_Session.Document().SetTargetSubject(
		    i_rFile.m_Record.m_SubjectParametrised, i_rFile.m_Record.m_SubjectApplicationData, i_rFile.m_Extras);
		m_Session.Settle();
	}

	void Save(const std::string& i_rPath)
	{
		const std::lock_guard lock(m_Mutex);
		m_Session.Save(i_rPath);
	}

	/// As "targets --json" tells them.
	std::string Targets()
	{
		const std::lock_guard lock(m_Mutex);
		const bool bResiduals = m_Session.Document().SourceValues().m_pParametrised != nullptr;
		return JsonText(LinesToJson(TargetLines(m_Session, bResiduals), bResiduals));
	}

	/// As "map --json" tells it.
	std::string Propose()
	{
		const std::lock_guard lock(m_Mutex);
		return JsonText(MappedToJson(ProposeForSubject(m_Session)));
	}

	std::unique_ptr<const VPlayedTake> Solve(const VPythonTake& i_rTake, std::optional<std::size_t> i_First,
	    std::optional<std::size_t> i_Last, const TakeSolve::VSourceSettings& i_rSettings)
	{
		const std::lock_guard lock(m_Mutex);
		VTakeToPlay what;
		if (const auto pSubject = m_Session.Document().TargetValues().m_pParametrised)
			what.m_Subject = pSubject->m_Name;
		what.m_Take = i_rTake.m_Path;
		what.m_FirstFrame = i_First;
		what.m_LastFrame = i_Last;
		return PlayTake(m_Session, what, i_rTake.m_pTake, i_rSettings);
	}

	void WriteMotion(const VPlayedTake& i_rPlayed, const VMotionOutput& i_rOutput)
	{
		const std::lock_guard lock(m_Mutex);
		WriteSolvedMotion(m_Session, i_rPlayed, i_rOutput);
	}

	/// What edits have told.
	std::string Report()
	{
		const std::lock_guard lock(m_Mutex);
		return JsonText(m_Session.m_ReportJson);
	}

private:
	void Apply(const VEdits& i_rEdits)
	{
		// Of edits that failed before.
		m_Session.m_WithoutPartner.clear();
		ApplyEdits(m_Session, i_rEdits);
		ReportPose(m_Session);
	}

	VEdits ToEdits(const VEditPairs& i_rEdits) const
	{
		SetupIO::VSetup setup;
		for (const auto& [rName, rValue] : i_rEdits)
			setup.m_Edits.push_back({rName, rValue, {}, {setup.m_Edits.size() + 1}});
		return EditsOf(setup, "edit", m_bOfFbx);
	}

	std::mutex m_Mutex;
	VSession m_Session;
	const bool m_bOfFbx;
};

py::object FromJson(const std::string& i_rText)
{
	return py::module_::import("json").attr("loads")(TextToPython(i_rText));
}

/// (first frame, rate, states, residuals, iterations, converged, what "solve --json" prints)
py::tuple Solved(VPythonSession& io_rSession, const VPythonTake& i_rTake, std::optional<std::size_t> i_First,
    std::optional<std::size_t> i_Last, const VJointNames& i_rJoints, std::optional<std::size_t> i_RestFrame,
    const std::optional<std::string>& i_rOutput, const std::optional<std::string>& i_rFbx)
{
	VMotionOutput output;
	if (i_rOutput)
	{
		output.m_Path = FilePath(*i_rOutput);
		output.m_bForce = true;
		output.m_Character = i_rFbx ? FilePath(*i_rFbx) : "";
		output.m_Name = StemOf(i_rTake.m_Path);
	}
	std::unique_ptr<const VPlayedTake> pPlayed;
	std::string json;
	Call(
	    [&]
	    {
		    if (i_rOutput)
			    CheckMotionOutput(output, {i_rTake.m_Path, output.m_Character});
		    pPlayed = io_rSession.Solve(i_rTake, i_First, i_Last, ToSettings(i_rJoints, i_RestFrame));
		    json = JsonText(SolveToJson(pPlayed->Result()));
	    });
	// A picture that is missing is missed, and no reason to have nothing.
	if (i_rOutput)
		Call([&] { io_rSession.WriteMotion(*pPlayed, output); }, true);
	const TakeSolve::VSolvedTake& rSolved = pPlayed->m_Solved;
	const auto frames = py::ssize_t(rSolved.m_Frames);
	return py::make_tuple(rSolved.m_First, i_rTake.m_pTake->m_Rate,
	    ToArray(rSolved.m_States).reshape({frames, py::ssize_t(rSolved.m_NumberOfStates)}),
	    ToArray(rSolved.m_Residuals).reshape({frames, py::ssize_t(rSolved.m_NumberOfTargets)}),
	    py::array_t<std::uint32_t>(frames, rSolved.m_Iterations.data()),
	    py::array_t<std::uint8_t>(frames, rSolved.m_Converged.data()).attr("astype")("bool"), FromJson(json));
}

std::shared_ptr<VPythonSession> Make(const std::optional<std::string>& i_rFbx,
    const std::optional<std::string>& i_rSubject, const std::optional<std::string>& i_rSource,
    const std::optional<std::string>& i_rRoot, bool i_bScaleRootHeight, const VEditPairs& i_rEdits)
{
	const auto path = [](const std::optional<std::string>& i_rPath) { return i_rPath ? FilePath(*i_rPath) : ""; };
	const VMaking making{
	    path(i_rFbx), path(i_rSubject), path(i_rSource), i_rRoot, i_bScaleRootHeight ? c_pScaleRootHeight : "keep"};
	std::shared_ptr<VPythonSession> pSession;
	Call([&] { pSession = std::make_shared<VPythonSession>(making, i_rEdits); });
	return pSession;
}

py::list EditKinds()
{
	py::list kinds;
	for (const SetupIO::VEditForm& rForm : EditForms())
		kinds.append(py::make_tuple(rForm.m_Name, rForm.m_bValue, rForm.m_Help));
	return kinds;
}

} // namespace

void DefineSession(py::module_& io_rModule)
{
	io_rModule.def("make", &Make);
	io_rModule.def("edit_kinds", &EditKinds);
	py::class_<VPythonSession, std::shared_ptr<VPythonSession>>(io_rModule, "Session")
	    .def("edit",
	        [](VPythonSession& io_rSession, const VEditPairs& i_rEdits) { Call([&] { io_rSession.Edit(i_rEdits); }); })
	    .def("align",
	        [](VPythonSession& io_rSession, const VEditPairs& i_rEdits) { Call([&] { io_rSession.Align(i_rEdits); }); })
	    .def("target",
	        [](VPythonSession& io_rSession)
	        {
		        VSubjectFile file;
		        Call([&] { file = io_rSession.Target(); });
		        return ToPython(std::move(file));
	        })
	    .def("source",
	        [](VPythonSession& io_rSession) -> py::object
	        {
		        VSubjectFile file;
		        Call([&] { file = io_rSession.Source(); });
		        if (file.m_Record.m_SubjectParametrised.m_Segments.empty())
			        return py::none();
		        return ToPython(std::move(file));
	        })
	    .def("replace",
	        [](VPythonSession& io_rSession, const py::tuple& i_rParts)
	        {
		        const VSubjectFile file = FileFrom(i_rParts);
		        Call([&] { io_rSession.Replace(file); });
	        })
	    .def("save",
	        [](VPythonSession& io_rSession, const std::string& i_rPath)
	        { Call([&] { io_rSession.Save(FilePath(i_rPath)); }); })
	    .def("targets",
	        [](VPythonSession& io_rSession)
	        {
		        std::string json;
		        Call([&] { json = io_rSession.Targets(); });
		        return FromJson(json);
	        })
	    .def("propose",
	        [](VPythonSession& io_rSession)
	        {
		        std::string json;
		        Call([&] { json = io_rSession.Propose(); });
		        return FromJson(json);
	        })
	    .def("solve", &Solved)
	    .def("report",
	        [](VPythonSession& io_rSession)
	        {
		        std::string json;
		        Call([&] { json = io_rSession.Report(); });
		        return FromJson(json);
	        });
}

} // namespace CommandLine::Python
