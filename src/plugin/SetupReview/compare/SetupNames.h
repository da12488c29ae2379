#pragma once

#include "SetupReview/compare/Comparison.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace SetupReview
{

/// What the elements of a set-up are called, each in a list by a name of its own: the second of a name gets "#2".
/// Targets are called by type, source and segment.
class VSetupNames
{
public:
	explicit VSetupNames(const VSetup& i_rSetup);

	/// Where the setup's elements stand, by the key of their list: "Segments", "Markers", "Rotations", "Targets".
	using VNames = std::vector<std::string>;
	VNames m_Segments;
	VNames m_Markers;
	VNames m_Rotations;
	VNames m_Targets;

	/// A field that refers to other elements, or tells the element's own place, as text by names; nothing for any other
	/// field.
	/// @param i_Element "segment", "target", ...
	std::optional<std::string> Reference(
	    std::string_view i_Element, std::string_view i_Field, std::size_t i_Index) const;

private:
	const VSetup& m_rSetup;
};

/// Of the subject's segments, markers or targets.
const std::vector<std::string>& NamesOf(const VSetupNames& i_rNames, std::string_view i_Element);
/// Whether the subject has such an element.
bool Stands(const VSetupNames& i_rNames, const std::string& i_rName, std::string_view i_Element);

/// The same names, told apart by their place among those that are the same.
std::vector<std::string> Distinct(std::vector<std::string> i_Names);

} // namespace SetupReview
