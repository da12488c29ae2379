#pragma once

#include "CoreOrlexTypes/SubjectRecord.h"

#include <pybind11/pybind11.h>

/// The values of a subject as Python objects, made from the description of their fields. The Python classes are made
/// from the same description when the package is imported: what a field is called and means stands nowhere else.
namespace CommandLine::Python
{

/// Each record as (name, fields) with parents behind their parts; a field is (name, type, what it means, whether the
/// type is a record's, default value). A default of a record or list of records is None.
pybind11::list DescribeRecords();

/// Each enumeration as (name, what it means, names of its values).
pybind11::list DescribeEnumerations();

/// Takes the classes of all that was described, by name.
void RegisterClasses(const pybind11::dict& i_rClasses);

pybind11::object ToPython(const CoreOrlexTypes::VSubjectParametrised& i_rSubject);
pybind11::object ToPython(const CoreOrlexTypes::VSubjectApplicationData& i_rData);

/// Throw TypeError or ValueError for an object that is not of this form, with the field that is wrong as
/// "segments[3].joint.mean".
CoreOrlexTypes::VSubjectParametrised SubjectFrom(const pybind11::handle& i_rObject);
CoreOrlexTypes::VSubjectApplicationData ApplicationDataFrom(const pybind11::handle& i_rObject);

/// A text of a file, which may hold bytes that are no UTF-8: those come back as they were.
pybind11::str TextToPython(std::string_view i_Text);
/// "PreRotation" as "pre_rotation".
std::string SnakeCase(std::string_view i_Key);

} // namespace CommandLine::Python
