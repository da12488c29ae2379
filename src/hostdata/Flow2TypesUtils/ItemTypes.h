#pragma once

#include "Flow2TypesUtils/ItemCatalogue.h"

#include <cstddef>
#include <type_traits>
#include <utility>
#include <vector>

namespace CoreOrlexTypes
{
struct VReconstructionLabelSet;
struct VSubject;
struct VSubjectApplicationData;
struct VSubjectDynamicParameters;
struct VSubjectParametrised;
struct VSubjectSettings;
} // namespace CoreOrlexTypes

namespace Flow2TypesUtils
{

/// A value of a type that is not known here, as its bytes.
using VItemBytes = std::vector<std::byte>;

/// Calls a generic function with std::type_identity<T>, T being the type that items of this kind carry.
template <typename TFunction>
decltype(auto) VisitItemType(EItemValue i_Value, TFunction&& i_Function)
{
	switch (i_Value)
	{
	case EItemValue::ESubject: return i_Function(std::type_identity<CoreOrlexTypes::VSubject>());
	case EItemValue::ESubjectParametrised:
		return i_Function(std::type_identity<CoreOrlexTypes::VSubjectParametrised>());
	case EItemValue::ESubjectApplicationData:
		return i_Function(std::type_identity<CoreOrlexTypes::VSubjectApplicationData>());
	case EItemValue::ESubjectDynamicParameters:
		return i_Function(std::type_identity<CoreOrlexTypes::VSubjectDynamicParameters>());
	case EItemValue::ESubjectSettings: return i_Function(std::type_identity<CoreOrlexTypes::VSubjectSettings>());
	case EItemValue::EReconstructionLabelSet:
		return i_Function(std::type_identity<CoreOrlexTypes::VReconstructionLabelSet>());
	case EItemValue::EBytes: break;
	}
	return i_Function(std::type_identity<VItemBytes>());
}

} // namespace Flow2TypesUtils
