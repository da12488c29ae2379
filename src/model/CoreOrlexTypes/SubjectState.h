#pragma once

#include <array>
#include <cstdint>
#include <vector>

namespace CoreOrlexTypes
{

/// The pose of a subject at one moment.
struct VSubjectDynamicParameters
{
	std::uint32_t m_SubjectId = 0;
	/// The joints' values in segment order, of each as many as its type has degrees of freedom: millimetres and
	/// radians, as forward kinematics takes them.
	std::vector<double> m_State;

	bool operator==(const VSubjectDynamicParameters&) const = default;
};

/// What the operator has set for a subject as a whole.
struct VSubjectSettings
{
	std::uint32_t m_SubjectId = 0;
	/// A thing that performers carry, not a performer.
	bool m_Prop = false;

	bool operator==(const VSubjectSettings&) const = default;
};

/// Which markers of subjects were recognised among the points of one moment.
struct VReconstructionLabelSet
{
	struct VLabel
	{
		std::uint32_t m_SubjectId = 0;
		/// Index into the subject's markers.
		std::uint32_t m_MarkerIndex = 0;
		/// Millimetres, in the world.
		std::array<double, 3> m_Position{};

		bool operator==(const VLabel&) const = default;
	};

	std::vector<VLabel> m_Labels;

	bool operator==(const VReconstructionLabelSet&) const = default;
};

} // namespace CoreOrlexTypes
