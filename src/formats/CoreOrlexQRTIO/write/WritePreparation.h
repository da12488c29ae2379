#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexQRTIO/values/JointGeometry.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "UtilsRapidXml/Version.h"

#include <memory>
#include <span>
#include <string>
#include <unordered_map>
#include <vector>

namespace CoreOrlexTypesUtils
{
class VDynamicExpressionParserSimple;
}

namespace CoreOrlexQRTIO
{

/// Finds the record that was read with an element: the one at the element's place if it still has the element's name,
/// else the first of that name.
template <typename T>
class VRecordsByName
{
public:
	explicit VRecordsByName(const std::vector<T>& i_rRecords) : m_rRecords(i_rRecords) {}

	/// Null if there is none.
	const T* Find(std::size_t i_Index, const std::string& i_rName)
	{
		if (i_Index < m_rRecords.size() && m_rRecords[i_Index].m_Name == i_rName)
			return &m_rRecords[i_Index];
		if (m_ByName.empty())
			for (const T& rRecord : m_rRecords)
				m_ByName.emplace(rRecord.m_Name, &rRecord);
		const auto it = m_ByName.find(i_rName);
		return it == m_ByName.end() ? nullptr : it->second;
	}

private:
	const std::vector<T>& m_rRecords;
	std::unordered_map<std::string, const T*> m_ByName;
};

/// A segment with what has to be computed before it can be written.
struct VPreparedSegment
{
	const VSubjectQRTExtras::VSegment& Extras() const { return *m_pExtras; }

	/// What was read with the segment, or what the version being written needs instead, which is held here.
	const VSubjectQRTExtras::VSegment* m_pExtras = nullptr;
	std::unique_ptr<VSubjectQRTExtras::VSegment> m_pComputedExtras;
	std::vector<std::uint32_t> m_Children;
	VJointPose m_PrePose;
	/// The joint's share of the T-pose constraints.
	std::span<const double> m_T;
	/// One axis, a pair, or none.
	std::vector<double> m_Axes;
};

/// A subject on its way into a file.
struct VWriting
{
	const CoreOrlexTypes::VSubjectParametrised& m_rSubject;
	const CoreOrlexTypes::VSubjectApplicationData& m_rApplicationData;
	const VSubjectQRTExtras& m_rExtras;
	CoreOrlexTypesUtils::VDynamicExpressionParserSimple& m_rParser;
	/// Unset: everything is written.
	UtilsRapidXml::VVersion m_Version;
	std::vector<std::string> m_Warnings{};
	std::size_t m_CountOfLostColours = 0;
	std::vector<VPreparedSegment> m_Segments{};
	/// For each element the first one of its name, which is what a reference to it finds.
	std::vector<std::uint32_t> m_FirstSegments{};
	std::vector<std::uint32_t> m_FirstMarkers{};
	std::vector<std::uint32_t> m_Roots{};
};

/// Evaluates expressions and finds what belongs to each segment.
/// @return false, with errors added, if the subject's segments cannot be written so that they could be read again.
bool Prepare(VWriting& io_rWriting, std::vector<std::string>& io_rErrors);

/// The expressions as the version being written can hold them: numbers for those that use static parameters which it
/// does not have.
std::vector<std::string> WritableExpressions(VWriting& io_rWriting, std::span<const std::string> i_Expressions);

} // namespace CoreOrlexQRTIO
