#pragma once

#include "CoreOrlexQRTIO/format/Format.h"
#include "CoreOrlexQRTIO/write/WritePreparation.h"
#include "UtilsRapidXml/WriterNode.h"

/// The sections of a skeleton file, in the order in which they are written.
namespace CoreOrlexQRTIO
{

void WriteParameters(UtilsRapidXml::VWriterNode& io_rNode, VWriting& io_rWriting);
void WriteSkeleton(UtilsRapidXml::VWriterNode& io_rNode, VWriting& io_rWriting);
void WriteMarkerSet(UtilsRapidXml::VWriterNode& io_rNode, VWriting& io_rWriting);
void WriteTargetSet(UtilsRapidXml::VWriterNode& io_rNode, VWriting& io_rWriting);
void WriteSkin(UtilsRapidXml::VWriterNode& io_rNode, VWriting& io_rWriting);
/// Nothing if there is none.
void WriteSubspaces(UtilsRapidXml::VWriterNode& io_rNode, VWriting& io_rWriting);

/// The name of a segment or a marker, for a reference to it; an index without one adds an error and gives null. A name
/// that stands for an earlier element too adds a warning, since that one is what a reader finds.
const std::string* NameOfSegment(UtilsRapidXml::VWriterNode& io_rNode, VWriting& io_rWriting, std::uint32_t i_Index);
const std::string* NameOfMarker(UtilsRapidXml::VWriterNode& io_rNode, VWriting& io_rWriting, std::uint32_t i_Index);

/// The colour of an element that a reader gives the default one if it finds none, as with black of opacity 0, which is
/// counted.
void WriteColourOrCount(UtilsRapidXml::VWriterNode& io_rNode, VWriting& io_rWriting,
    const Format::VAttribute& i_rAttribute, const CoreOrlexTypes::VColour& i_rColour);

/// The record at an index, or a default one if the application data is shorter than the subject.
template <typename T>
const T& RecordOrDefault(const std::vector<T>& i_rRecords, std::size_t i_Index)
{
	static const T s_Default;
	return i_Index < i_rRecords.size() ? i_rRecords[i_Index] : s_Default;
}

} // namespace CoreOrlexQRTIO
