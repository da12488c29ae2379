#pragma once

#include "CoreOrlexQRTIO/format/Format.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "UtilsRapidXml/WriterNode.h"

#include <span>
#include <string>
#include <string_view>

/// Values as attributes. What the version being written does not have is left out; a value that the format cannot hold
/// adds an error.
namespace CoreOrlexQRTIO
{

/// "Could not stringify %1% node's %2% attribute value."
void AddNotStringified(UtilsRapidXml::VWriterNode& io_rNode, const Format::VAttribute& i_rAttribute);

/// True if the version being written has the attribute, or the element.
bool IsInVersion(const UtilsRapidXml::VWriterNode& i_rNode, const Format::VAttribute& i_rAttribute);
bool IsInVersion(const UtilsRapidXml::VWriterNode& i_rNode, const Format::VElement& i_rElement);

/// As it stands, without looking at the value.
void WriteRaw(UtilsRapidXml::VWriterNode& io_rNode, const Format::VAttribute& i_rAttribute, std::string_view i_Text);

/// Without blanks and tabs at both ends; not at all if nothing is left and the attribute is not required.
void WriteText(UtilsRapidXml::VWriterNode& io_rNode, const Format::VAttribute& i_rAttribute, std::string_view i_Text);

void WriteReal(UtilsRapidXml::VWriterNode& io_rNode, const Format::VAttribute& i_rAttribute, double i_Value);

/// Not at all if the value is at the mark for "not set".
void WriteRealIfSet(UtilsRapidXml::VWriterNode& io_rNode, const Format::VAttribute& i_rAttribute, double i_Value);

/// Not at all if the list is empty and the attribute is not required.
void WriteReals(
    UtilsRapidXml::VWriterNode& io_rNode, const Format::VAttribute& i_rAttribute, std::span<const double> i_Values);

/// The same with "*" for values that are not set.
void WriteRealsWithPlaceholders(
    UtilsRapidXml::VWriterNode& io_rNode, const Format::VAttribute& i_rAttribute, std::span<const double> i_Values);

void WriteBool(UtilsRapidXml::VWriterNode& io_rNode, const Format::VAttribute& i_rAttribute, bool i_bValue);

/// Red, green and blue, if any of the four components is not zero.
void WriteColour(UtilsRapidXml::VWriterNode& io_rNode, const Format::VAttribute& i_rAttribute,
    const CoreOrlexTypes::VColour& i_rColour);

/// Not at all if all are empty and the attribute is not required. An expression that could not be cut from the others
/// again is an error.
void WriteExpressions(UtilsRapidXml::VWriterNode& io_rNode, const Format::VAttribute& i_rAttribute,
    std::span<const std::string> i_Expressions);

template <typename T>
void WriteEnum(UtilsRapidXml::VWriterNode& io_rNode, const Format::VAttribute& i_rAttribute,
    const UtilsRapidXml::VEnum<T>& i_rEnum, T i_Value)
{
	if (!IsInVersion(io_rNode, i_rAttribute))
		return;
	if (const std::string* const pText = i_rEnum.FindText(i_Value))
		WriteRaw(io_rNode, i_rAttribute, *pText);
	else
		AddNotStringified(io_rNode, i_rAttribute);
}

template <typename TFunction>
void WriteElement(
    UtilsRapidXml::VWriterNode& io_rNode, const Format::VElement& i_rElement, const TFunction& i_rFunction)
{
	io_rNode.WriteElement(i_rElement.m_Name, i_rFunction, i_rElement.m_Minimum, i_rElement.m_Maximum);
}

} // namespace CoreOrlexQRTIO
