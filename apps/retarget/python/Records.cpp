#include "retarget/python/Records.h"

#include "CoreOrlexTypes/Fields.h"

#include <array>
#include <limits>
#include <set>
#include <string>
#include <type_traits>
#include <vector>

namespace CommandLine::Python
{
namespace
{

namespace py = pybind11;
using namespace CoreOrlexTypes;

/// Lives until the process ends: the interpreter may be gone by then.
py::dict& Classes()
{
	static auto* const s_pClasses = new py::dict;
	return *s_pClasses;
}

template <typename T>
inline constexpr const char* c_RecordName = nullptr;
template <>
inline constexpr const char* c_RecordName<VColour> = "Colour";
template <>
inline constexpr const char* c_RecordName<VSubjectParametrised> = "Subject";
template <>
inline constexpr const char* c_RecordName<VSubjectParametrised::VStaticParameter> = "StaticParameter";
template <>
inline constexpr const char* c_RecordName<VSubjectParametrised::VDynamicParameter> = "DynamicParameter";
template <>
inline constexpr const char* c_RecordName<VSubjectParametrised::VSegment> = "Segment";
template <>
inline constexpr const char* c_RecordName<VSubjectParametrised::VJoint> = "Joint";
template <>
inline constexpr const char* c_RecordName<VSubjectParametrised::VMarker> = "Marker";
template <>
inline constexpr const char* c_RecordName<VSubjectParametrised::VRotation> = "Rotation";
template <>
inline constexpr const char* c_RecordName<VSubjectParametrised::VTarget> = "Target";
template <>
inline constexpr const char* c_RecordName<VSubjectApplicationData> = "ApplicationData";
template <>
inline constexpr const char* c_RecordName<VSubjectApplicationData::VSegment> = "SegmentDrawing";
template <>
inline constexpr const char* c_RecordName<VSubjectApplicationData::VJoint> = "JointLabels";
template <>
inline constexpr const char* c_RecordName<VSubjectApplicationData::VMarker> = "MarkerDrawing";
template <>
inline constexpr const char* c_RecordName<VSubjectApplicationData::VStick> = "Stick";
template <>
inline constexpr const char* c_RecordName<VSubjectApplicationData::VTarget> = "TargetDrawing";

/// "SubjectParametrised.Joint.EJointType" as "JointType", "SubjectApplicationData.Segment.EDrawStyle" as
/// "SegmentDrawStyle".
std::string EnumerationName(std::string_view i_Qualified)
{
	const std::size_t last = i_Qualified.rfind('.');
	const std::size_t before = i_Qualified.rfind('.', last - 1);
	const std::string_view element = i_Qualified.substr(before + 1, last - before - 1);
	const std::string_view name = i_Qualified.substr(last + 2);
	return std::string(name.starts_with(element) ? "" : element) + std::string(name);
}

template <typename T>
struct VItemOf
{
	using Type = void;
};
template <typename T>
struct VItemOf<std::vector<T>>
{
	using Type = T;
	/// Any number of items.
	static constexpr std::size_t c_Size = 0;
};
template <typename T, std::size_t N>
struct VItemOf<std::array<T, N>>
{
	using Type = T;
	static constexpr std::size_t c_Size = N;
};
template <typename T>
inline constexpr bool c_bList = !std::is_same_v<typename VItemOf<T>::Type, void>;

template <typename T>
std::string TypeName()
{
	if constexpr (CRecord<T>)
		return c_RecordName<T>;
	else if constexpr (CEnumeration<T>)
		return EnumerationName(c_Enumeration<T>.Name);
	else if constexpr (c_bList<T>)
		return "list[" + TypeName<typename VItemOf<T>::Type>() + "]";
	else if constexpr (std::is_same_v<T, bool>)
		return "bool";
	else if constexpr (std::is_same_v<T, std::string>)
		return "str";
	else if constexpr (std::is_integral_v<T>)
		return "int";
	else
		return "float";
}

template <typename T>
py::object ToObject(const T& i_rValue)
{
	if constexpr (CRecord<T>)
	{
		const py::object type = Classes()[c_RecordName<T>];
		py::object object = type.attr("__new__")(type);
		ForEachField<T>([&](const auto& i_rField)
		    { object.attr(SnakeCase(i_rField.Key).c_str()) = ToObject(i_rValue.*i_rField.pMember); });
		return object;
	}
	else if constexpr (CEnumeration<T>)
	{
		const std::string_view name = EnumeratorName(i_rValue);
		if (name.empty())
			throw py::value_error("a " + TypeName<T>() + " of " + std::to_string(int(i_rValue)) + " has no name");
		return Classes()[TypeName<T>().c_str()](TextToPython(name));
	}
	else if constexpr (c_bList<T>)
	{
		py::list list;
		for (const auto& rItem : i_rValue)
			list.append(ToObject(rItem));
		return list;
	}
	else if constexpr (std::is_same_v<T, std::string>)
	{
		return TextToPython(i_rValue);
	}
	else
	{
		return py::cast(i_rValue);
	}
}

/// Before it is known in which field the object stands.
struct VMisfit
{
	std::string m_Path;
	std::string m_Reason;
	bool m_bType = true;
};

template <typename T>
void FromObject(const py::handle& i_rObject, T& o_rValue);

template <typename TList>
void ListFromObject(const py::handle& i_rObject, TList& o_rList)
{
	constexpr std::size_t c_Size = VItemOf<TList>::c_Size;
	if (!py::isinstance<py::sequence>(i_rObject) && !py::hasattr(i_rObject, "__array__"))
		throw VMisfit{"", "is no " + TypeName<TList>()};
	if (py::isinstance<py::str>(i_rObject) || py::isinstance<py::bytes>(i_rObject))
		throw VMisfit{"", "is a text, and a " + TypeName<TList>() + " is wanted"};
	// A copy, so that nothing that runs meanwhile shortens it.
	const py::list items(py::reinterpret_borrow<py::object>(i_rObject));
	if constexpr (c_Size == 0)
		o_rList.resize(items.size());
	else if (items.size() != c_Size)
		throw VMisfit{
		    "", "has " + std::to_string(items.size()) + " items, not " + std::to_string(c_Size), /*m_bType*/ false};
	for (std::size_t i = 0; i < items.size(); ++i)
	{
		try
		{
			FromObject(items[i], o_rList[i]);
		}
		catch (VMisfit& rMisfit)
		{
			rMisfit.m_Path = "[" + std::to_string(i) + "]" + rMisfit.m_Path;
			throw;
		}
	}
}

template <typename T>
void RecordFromObject(const py::handle& i_rObject, T& o_rValue)
{
	if (!py::isinstance(i_rObject, Classes()[c_RecordName<T>]))
		throw VMisfit{"", "is no " + TypeName<T>()};
	ForEachField<T>(
	    [&](const auto& i_rField)
	    {
		    const std::string name = SnakeCase(i_rField.Key);
		    try
		    {
			    FromObject(i_rObject.attr(name.c_str()), o_rValue.*i_rField.pMember);
		    }
		    catch (VMisfit& rMisfit)
		    {
			    rMisfit.m_Path = "." + name + rMisfit.m_Path;
			    throw;
		    }
	    });
}

template <typename T>
void NumberFromObject(const py::handle& i_rObject, T& o_rValue)
{
	// What is no number of Python's, as numpy's, becomes one.
	const auto convert = std::is_integral_v<T> ? PyNumber_Index : PyNumber_Float;
	const auto number =
	    py::reinterpret_steal<py::object>(PyNumber_Check(i_rObject.ptr()) ? convert(i_rObject.ptr()) : nullptr);
	if (!number)
	{
		PyErr_Clear();
		throw VMisfit{"", "is no " + TypeName<T>()};
	}
	if constexpr (std::is_integral_v<T>)
	{
		const long long value = PyLong_AsLongLong(number.ptr());
		if (PyErr_Occurred() || value < 0 || std::uint64_t(value) > std::numeric_limits<T>::max())
		{
			PyErr_Clear();
			throw VMisfit{"", "is not from 0 to " + std::to_string(std::numeric_limits<T>::max()), /*m_bType*/ false};
		}
		o_rValue = T(value);
	}
	else
	{
		o_rValue = PyFloat_AsDouble(number.ptr());
	}
}

std::string TextFrom(const py::handle& i_rObject)
{
	const auto bytes =
	    py::reinterpret_steal<py::object>(PyUnicode_AsEncodedString(i_rObject.ptr(), "utf-8", "surrogateescape"));
	if (!bytes)
	{
		PyErr_Clear();
		throw VMisfit{"", "holds characters that are none", /*m_bType*/ false};
	}
	return std::string(PyBytes_AsString(bytes.ptr()), std::size_t(PyBytes_Size(bytes.ptr())));
}

template <typename T>
void FromObject(const py::handle& i_rObject, T& o_rValue)
{
	if constexpr (CRecord<T>)
	{
		RecordFromObject(i_rObject, o_rValue);
	}
	else if constexpr (c_bList<T>)
	{
		ListFromObject(i_rObject, o_rValue);
	}
	else if constexpr (std::is_same_v<T, bool>)
	{
		if (!py::isinstance<py::bool_>(i_rObject))
			throw VMisfit{"", "is no bool"};
		o_rValue = i_rObject.ptr() == Py_True;
	}
	else if constexpr (CEnumeration<T> || std::is_same_v<T, std::string>)
	{
		if (!py::isinstance<py::str>(i_rObject))
			throw VMisfit{"", "is no " + TypeName<T>()};
		const std::string text = TextFrom(i_rObject);
		if constexpr (CEnumeration<T>)
		{
			const auto value = EnumeratorFromName<T>(text);
			if (!value)
				throw VMisfit{"", "is no " + TypeName<T>(), /*m_bType*/ false};
			o_rValue = *value;
		}
		else
		{
			o_rValue = text;
		}
	}
	else
	{
		NumberFromObject(i_rObject, o_rValue);
	}
}

template <typename T>
T ValueFrom(const py::handle& i_rObject)
{
	T value;
	try
	{
		FromObject(i_rObject, value);
	}
	catch (const VMisfit& rMisfit)
	{
		const std::string words =
		    (rMisfit.m_Path.empty() ? "what is given" : rMisfit.m_Path.substr(1)) + " " + rMisfit.m_Reason;
		if (rMisfit.m_bType)
			throw py::type_error(words);
		throw py::value_error(words);
	}
	return value;
}

/// Visits each record and enumeration once, what stands in a record before it.
template <typename T, typename TVisitor>
void Describe(TVisitor& io_rVisitor)
{
	if constexpr (c_bList<T>)
		Describe<typename VItemOf<T>::Type>(io_rVisitor);
	else if constexpr (CRecord<T> || CEnumeration<T>)
		io_rVisitor.template Visit<T>();
}

struct VSeen
{
	bool IsNew(const std::string& i_rName) { return m_Names.insert(i_rName).second; }
	std::set<std::string> m_Names;
};

struct VRecords : VSeen
{
	template <typename T>
	void Visit()
	{
		if constexpr (CRecord<T>)
		{
			if (!IsNew(c_RecordName<T>))
				return;
			const T value{};
			py::list fields;
			ForEachField<T>(
			    [&](const auto& i_rField)
			    {
				    using VMember = std::remove_cvref_t<decltype(value.*i_rField.pMember)>;
				    Describe<VMember>(*this);
				    fields.append(py::make_tuple(SnakeCase(i_rField.Key), TypeName<VMember>(),
				        std::string(i_rField.Doc), CRecord<VMember>, Default(value.*i_rField.pMember)));
			    });
			m_List.append(py::make_tuple(c_RecordName<T>, fields));
		}
	}

	template <typename T>
	static py::object Default(const T& i_rValue)
	{
		if constexpr (CRecord<T>)
			return py::none();
		else if constexpr (CEnumeration<T>)
			return TextToPython(EnumeratorName(i_rValue));
		else if constexpr (c_bList<T>)
			return i_rValue.empty() ? py::list() : ToObject(i_rValue);
		else
			return ToObject(i_rValue);
	}

	py::list m_List;
};

struct VEnumerations : VSeen
{
	template <typename T>
	void Visit()
	{
		if constexpr (CRecord<T>)
		{
			ForEachField<T>([&](const auto& i_rField)
			    { Describe<std::remove_cvref_t<decltype(std::declval<T>().*i_rField.pMember)>>(*this); });
		}
		else if (IsNew(TypeName<T>()))
		{
			py::list names;
			for (const auto& rEnumerator : c_Enumeration<T>.Enumerators)
				names.append(TextToPython(rEnumerator.Name));
			m_List.append(py::make_tuple(TypeName<T>(), TextToPython(c_Enumeration<T>.Doc), names));
		}
	}

	py::list m_List;
};

template <typename TVisitor>
py::list Described()
{
	TVisitor visitor;
	Describe<VSubjectParametrised>(visitor);
	Describe<VSubjectApplicationData>(visitor);
	return visitor.m_List;
}

} // namespace

std::string SnakeCase(std::string_view i_Key)
{
	const auto isUpper = [&](std::size_t i_At)
	{ return i_At < i_Key.size() && i_Key[i_At] >= 'A' && i_Key[i_At] <= 'Z'; };
	std::string snake;
	for (std::size_t i = 0; i < i_Key.size(); ++i)
	{
		const bool bLastOfKey = i + 1 == i_Key.size();
		if (isUpper(i) && i > 0 && (!isUpper(i - 1) || (!bLastOfKey && !isUpper(i + 1))))
			snake += '_';
		snake += isUpper(i) ? char(i_Key[i] - 'A' + 'a') : i_Key[i];
	}
	return snake;
}

py::str TextToPython(std::string_view i_Text)
{
	return py::reinterpret_steal<py::str>(
	    PyUnicode_DecodeUTF8(i_Text.data(), Py_ssize_t(i_Text.size()), "surrogateescape"));
}

py::list DescribeRecords()
{
	return Described<VRecords>();
}

py::list DescribeEnumerations()
{
	return Described<VEnumerations>();
}

void RegisterClasses(const py::dict& i_rClasses)
{
	Classes() = i_rClasses;
}

py::object ToPython(const VSubjectParametrised& i_rSubject)
{
	return ToObject(i_rSubject);
}

py::object ToPython(const VSubjectApplicationData& i_rData)
{
	return ToObject(i_rData);
}

VSubjectParametrised SubjectFrom(const py::handle& i_rObject)
{
	return ValueFrom<VSubjectParametrised>(i_rObject);
}

VSubjectApplicationData ApplicationDataFrom(const py::handle& i_rObject)
{
	return ValueFrom<VSubjectApplicationData>(i_rObject);
}

} // namespace CommandLine::Python
