#pragma once

#include "NVX/ISelectionItem.h"

#include <cstdint>

namespace RetargetSetup
{

/// The fixed identity of both subjects of the document: selection items address them by it.
inline constexpr const char* c_SubjectName = "Template";
inline constexpr std::uint32_t c_SubjectId = 0x0FFFFFFFu;

/// A segment or a target of one of its subjects.
inline bool IsOfDocument(const NVX::ISelectionItem& i_rItem)
{
	return i_rItem.m_SubjectId == c_SubjectId
	    && (i_rItem.m_Kind == NVX::ESelectionSourceSegment || i_rItem.m_Kind == NVX::ESelectionTargetSegment
	        || i_rItem.m_Kind == NVX::ESelectionTarget);
}

/// The log category of the document and its functions.
inline constexpr const char* c_LogCategory = "RetargetSetup";

} // namespace RetargetSetup
