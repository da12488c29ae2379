#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexQRTIO/format/Format.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"

#include <cstddef>
#include <functional>
#include <memory_resource>
#include <string_view>
#include <unordered_map>
#include <unordered_set>

namespace CoreOrlexQRTIO
{

/// Elements of one kind by name; the first of a name counts. The names are not copied.
using VIndexByName = std::pmr::unordered_map<std::string_view, std::uint32_t>;

/// What the format functions fill while they walk a document.
struct VReading
{
	CoreOrlexTypes::VSubjectParametrised& m_rSubject;
	CoreOrlexTypes::VSubjectApplicationData& m_rApplicationData;
	VSubjectQRTExtras& m_rExtras;
	/// Ids are hashes of names rather than counts.
	bool m_bHashedIds = false;
	/// 1.0 in a file that does not tell.
	Format::VVersion m_Version = Format::c_1_0;
	std::size_t m_ModelCount = 0;
	/// What is looked up while the document is read, and goes at once.
	std::pmr::monotonic_buffer_resource m_Memory{};
	VIndexByName m_SegmentsByName{&m_Memory};
	VIndexByName m_MarkersByName{&m_Memory};
	VIndexByName m_RotationsByName{&m_Memory};
	/// Filled when there are subspaces to read.
	VIndexByName m_JointsByName{&m_Memory};
	/// Of hashed ids only; counted ones do not collide.
	std::unordered_set<std::uint32_t> m_MarkerIds{};
	std::unordered_set<std::uint32_t> m_RotationIds{};
};

/// A segment while its element is read. The records stand at the end of their lists already, and go if there is an
/// error.
struct VSegmentInHand
{
	CoreOrlexTypes::VSubjectParametrised::VSegment& m_rSegment;
	CoreOrlexTypes::VSubjectApplicationData::VSegment& m_rApplicationData;
	VSubjectQRTExtras::VSegment& m_rExtras;
	/// The joint's share of the T-pose constraints.
	std::vector<double> m_T{};
};

/// The skeleton format, one function for each element. Run over a VReaderNode they read a file, over a VSchemaNode they
/// describe it. An element that added an error appends no record.

/// The node above the root element.
void FormatDocument(UtilsRapidXml::INode& io_rNode, VReading& io_rReading);
void FormatKinematicModel(UtilsRapidXml::INode& io_rNode, VReading& io_rReading);
void FormatParameters(UtilsRapidXml::INode& io_rNode, VReading& io_rReading);
void FormatSkeleton(UtilsRapidXml::INode& io_rNode, VReading& io_rReading);
/// One of the six joint elements.
void FormatJoint(UtilsRapidXml::INode& io_rNode, VSegmentInHand& io_rSegment);
void FormatMarkerSet(UtilsRapidXml::INode& io_rNode, VReading& io_rReading);
void FormatTargetSet(UtilsRapidXml::INode& io_rNode, VReading& io_rReading);
void FormatSkin(UtilsRapidXml::INode& io_rNode, VReading& io_rReading);
void FormatSubjectDynamicSubspace(UtilsRapidXml::INode& io_rNode, VReading& io_rReading);

inline void Declare(UtilsRapidXml::INode& io_rNode, const Format::VElement& i_rElement)
{
	io_rNode.DeclareElement(i_rElement.m_Name, i_rElement.m_Doc, i_rElement.m_MinimumCount, i_rElement.m_MaximumCount,
	    i_rElement.m_Minimum, i_rElement.m_Maximum);
}

/// Declares one child element and processes it.
template <typename TFunction>
void Process(UtilsRapidXml::INode& io_rNode, const Format::VElement& i_rElement, const TFunction& i_rFunction)
{
	Declare(io_rNode, i_rElement);
	io_rNode.ProcessElements(std::cref(i_rFunction));
}

} // namespace CoreOrlexQRTIO
