#include "retarget/python/Files.h"

#include "CommandLineText/ExitStatus.h"
#include "retarget/python/Call.h"
#include "retarget/python/Records.h"
#include "retarget/subject/Findings.h"

#include "CoreOrlexQRTIO/FieldsOfExtras.h"
#include "CoreOrlexQRTIO/FormatVersions.h"
#include "CoreOrlexQRTIO/Writer.h"
#include "FBXIO/FBXReader.h"
#include "SetupReview/compare/Comparison.h"

#include <pybind11/numpy.h>
#include <pybind11/stl.h>

namespace CommandLine::Python
{
namespace
{

namespace py = pybind11;

py::tuple Read(const std::string& i_rPath)
{
	VSubjectFile file;
	Call([&] { file = ReadSubjectFile(FilePath(i_rPath)); });
	return ToPython(std::move(file));
}

void Write(const py::tuple& i_rParts, const std::string& i_rPath, const std::optional<std::string>& i_rVersion)
{
	const VSubjectFile file = FileFrom(i_rParts);
	std::uint32_t version = CoreOrlexQRTIO::c_AutomaticVersion;
	if (i_rVersion)
	{
		const auto value = CoreOrlexQRTIO::VersionValueFromText(*i_rVersion);
		if (!value)
			throw py::value_error("the versions are " + CoreOrlexQRTIO::AllVersionTexts());
		version = *value;
	}
	Call(
	    [&]
	    {
		    const auto& [rSubject, rData] = file.m_Record;
		    WriteSubjectFile(FilePath(i_rPath), rSubject, rData, file.m_Extras, version);
	    });
}

/// (element, index, name, message, remedy, tolerated)
py::list Check(const py::tuple& i_rParts)
{
	const VSubjectFile file = FileFrom(i_rParts);
	VFindings findings;
	Call([&] { findings = FindingsOf(file.m_Record); });
	py::list list;
	for (const auto& rFinding : findings)
		list.append(py::make_tuple(KindOf(rFinding.m_Element), rFinding.m_Index, TextToPython(rFinding.m_Name),
		    TextToPython(rFinding.m_Message), TextToPython(rFinding.m_Remedy), rFinding.m_bTolerated));
	return list;
}

/// (id, element, name, field, before, after, millimetres, degrees, a sentence)
py::list Compare(const py::tuple& i_rBefore, const py::tuple& i_rAfter)
{
	const VSubjectFile before = FileFrom(i_rBefore);
	const VSubjectFile after = FileFrom(i_rAfter);
	std::vector<SetupReview::VSetupChange> changes;
	Call([&] { changes = SetupReview::CompareSetups(before, after); });
	py::list list;
	for (const SetupReview::VSetupChange& rChange : changes)
		list.append(py::make_tuple(rChange.m_Id, rChange.m_Element, TextToPython(rChange.m_Name), rChange.m_Field,
		    TextToPython(rChange.m_Before), TextToPython(rChange.m_After), rChange.m_Millimetres, rChange.m_Degrees,
		    TextToPython(SetupReview::ChangeLine(rChange))));
	return list;
}

/// (name, index of the parent or -1, world matrix)
py::list Bones(const std::string& i_rPath)
{
	FBXIO::VSkinSkeleton skeleton;
	Call(
	    [&]
	    {
		    FBXIO::FBXReader reader;
		    if (!reader.LoadFile(i_rPath) || !reader.IsComplete())
			    throw VCommandError(EBadInput, "\"" + i_rPath + "\" could not be read as FBX");
		    if (reader.HasSkeleton())
			    skeleton = *reader.GetSkeleton();
	    });
	py::list list;
	for (const FBXIO::VSkinBone& rBone : skeleton)
	{
		py::array_t<double> matrix({4, 4});
		std::copy_n(rBone.m_Global.data(), 16, matrix.mutable_data());
		list.append(py::make_tuple(TextToPython(rBone.m_Name), rBone.m_ParentIndex, matrix));
	}
	return list;
}

/// What Python can pickle: a record is the list of its fields, texts are bytes.
template <typename T>
py::object State(const T& i_rValue)
{
	if constexpr (CoreOrlexTypes::CRecord<T>)
	{
		py::list fields;
		CoreOrlexTypes::ForEachField<T>(
		    [&](const auto& i_rField) { fields.append(State(i_rValue.*i_rField.pMember)); });
		return fields;
	}
	else if constexpr (std::is_same_v<T, std::string>)
		return py::bytes(i_rValue);
	else if constexpr (requires { i_rValue.size(); })
	{
		py::list items;
		for (const auto& rItem : i_rValue)
			items.append(State(rItem));
		return items;
	}
	else
		return py::cast(i_rValue);
}

template <typename T>
T FromState(const py::handle& i_rState)
{
	T value{};
	if constexpr (CoreOrlexTypes::CRecord<T>)
	{
		const auto fields = i_rState.cast<py::list>();
		if (fields.size() != CoreOrlexTypes::c_FieldCount<T>)
			throw py::value_error("the file was pickled by another version");
		std::size_t index = 0;
		CoreOrlexTypes::ForEachField<T>(
		    [&](const auto& i_rField)
		    {
			    auto& rField = value.*i_rField.pMember;
			    rField = FromState<std::remove_reference_t<decltype(rField)>>(fields[index++]);
		    });
	}
	else if constexpr (!std::is_same_v<T, std::string> && requires { value.size(); })
		for (const py::handle& rItem : i_rState.cast<py::list>())
			value.push_back(FromState<typename T::value_type>(rItem));
	else
		value = i_rState.cast<T>();
	return value;
}

} // namespace

std::string FilePath(const std::string& i_rPath)
{
	return i_rPath == "-" ? "./-" : i_rPath;
}

py::tuple ToPython(VSubjectFile i_File)
{
	return py::make_tuple(ToPython(i_File.m_Record.m_SubjectParametrised),
	    ToPython(i_File.m_Record.m_SubjectApplicationData), py::cast(std::move(i_File.m_Extras)));
}

VSubjectFile FileFrom(const py::tuple& i_rParts)
{
	VSubjectFile file;
	file.m_Record = {SubjectFrom(i_rParts[0]), ApplicationDataFrom(i_rParts[1])};
	file.m_Extras = i_rParts[2].cast<CoreOrlexQRTIO::VSubjectQRTExtras>();
	const auto& [rSubject, rData] = file.m_Record;
	const auto require = [](std::size_t i_Subject, std::size_t i_Data, const std::string& i_rWhat)
	{
		if (i_Subject != i_Data)
			throw py::value_error("the subject has " + std::to_string(i_Subject) + " " + i_rWhat
			    + ", its application data " + std::to_string(i_Data));
	};
	require(rSubject.m_Segments.size(), rData.m_Segments.size(), "segments");
	require(rSubject.m_Markers.size(), rData.m_Markers.size(), "markers");
	require(rSubject.m_Targets.size(), rData.m_Targets.size(), "targets");
	return file;
}

void DefineFiles(py::module_& io_rModule)
{
	using VExtras = CoreOrlexQRTIO::VSubjectQRTExtras;
	py::class_<VExtras>(io_rModule, "Extras")
	    .def(py::init<>())
	    .def(py::pickle(&State<VExtras>, [](const py::object& i_rState) { return FromState<VExtras>(i_rState); }));
	io_rModule.def("read", &Read);
	io_rModule.def("write", &Write);
	io_rModule.def("check", &Check);
	io_rModule.def("compare", &Compare);
	io_rModule.def("bones", &Bones);
}

} // namespace CommandLine::Python
