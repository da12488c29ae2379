#pragma once

#include "CoreOrlexQRTIO/FieldsOfExtras.h"
#include "SetupReview/compare/SetupNames.h"

#include <algorithm>
#include <string>
#include <string_view>
#include <type_traits>
#include <vector>

namespace SetupReview
{

using CoreOrlexTypes::VSubjectApplicationData;

/// Elements of the application data, which run parallel to those of the subject and have no names.
template <typename T>
inline constexpr bool c_bBesideSubject =
    std::is_same_v<T,
        VSubjectApplicationData::
            VSegment> || std::is_same_v<T, VSubjectApplicationData::VMarker> || std::is_same_v<T, VSubjectApplicationData::VTarget>;

/// What an element of a list is called in the operator's words.
template <typename T>
constexpr const char* ElementName()
{
	using VSubject = CoreOrlexTypes::VSubjectParametrised;
	using VExtras = CoreOrlexQRTIO::VSubjectQRTExtras;
	constexpr auto c_Is = []<typename... TOther>(std::type_identity<TOther>...)
	{ return (std::is_same_v<T, TOther> || ...); };
	if (c_Is(std::type_identity<VSubject::VSegment>(), std::type_identity<VSubjectApplicationData::VSegment>(),
	        std::type_identity<VExtras::VSegment>()))
		return "segment";
	if (c_Is(std::type_identity<VSubject::VTarget>(), std::type_identity<VSubjectApplicationData::VTarget>()))
		return "target";
	if (c_Is(std::type_identity<VSubject::VMarker>(), std::type_identity<VSubjectApplicationData::VMarker>(),
	        std::type_identity<VExtras::VMarker>()))
		return "marker";
	if (c_Is(std::type_identity<VSubject::VRotation>()))
		return "rotation observation";
	if (c_Is(std::type_identity<VSubject::VStaticParameter>()))
		return "static parameter";
	if (c_Is(std::type_identity<VSubject::VDynamicParameter>()))
		return "dynamic parameter";
	if (c_Is(std::type_identity<VSubjectApplicationData::VStick>()))
		return "stick";
	// The extras know a target by its name in the file.
	if (c_Is(std::type_identity<VExtras::VTarget>()))
		return "named target";
	return "dynamic subspace";
}

/// A name for each element, by which those of two set-ups belong together.
template <typename T>
std::vector<std::string> ElementNames(const VSetupNames& i_rNames, const std::vector<T>& i_rElements)
{
	std::vector<std::string> names;
	if constexpr (std::is_same_v<T, CoreOrlexTypes::VSubjectParametrised::VTarget>)
		return i_rNames.m_Targets;
	else if constexpr (std::is_same_v<T, VSubjectApplicationData::VStick>)
		for (std::size_t i = 0; i < i_rElements.size(); ++i)
			names.push_back(i_rNames.Reference("stick", "MarkerIndexA", i).value_or("") + " - "
			    + i_rNames.Reference("stick", "MarkerIndexB", i).value_or(""));
	else if constexpr (c_bBesideSubject<T>)
	{
		names = NamesOf(i_rNames, ElementName<T>());
		for (std::size_t i = names.size(); i < i_rElements.size(); ++i)
			names.push_back("#" + std::to_string(i));
		names.resize(i_rElements.size());
		return names;
	}
	else
		for (const T& rElement : i_rElements)
			names.push_back(rElement.m_Name);
	return Distinct(std::move(names));
}

} // namespace SetupReview
