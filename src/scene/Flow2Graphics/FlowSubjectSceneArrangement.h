#pragma once

#include "Flow2Graphics/SubjectTypes.h"
#include "Flow2TypesUtils/ItemCache.h"
#include "Flow2TypesUtils/SceneItems.h"
#include "Flow2TypesUtils/TaggedCoreTypeExtractor.h"

#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <vector>

namespace CoreOrlexTypes
{
struct VSubjectParametrised;
}

namespace Flow2Graphics
{

/// Lays subjects out as a grid on the floor: a row for each group, in each row the subjects by name. Rows and subjects
/// stand 2000 mm apart; a row is centred on the origin, the first one passes through it.
class VFlowSubjectSceneArrangement
{
public:
	using VKey = Flow2TypesUtils::FlowSubjectSceneTransformItem::VKey;

	struct VPlaced
	{
		std::string m_Name;
		VKey m_Key;
		/// Millimetres; set by Arrange.
		std::array<double, 3> m_Translation{};

		bool operator==(const VPlaced&) const = default;
	};
	using VGroups = std::map<ESubjectClass, std::vector<VPlaced>>;

	VFlowSubjectSceneArrangement();

	/// Takes the subjects of a frame, each class being a group. With another pose index than before everything counts
	/// as changed.
	/// @return true if any item that it depends on is another one.
	bool Update(const TesselPluginInterface::IFlowFrame& i_rFrame, std::uint32_t i_PoseIndex);

	const VGroups& Groups() const { return m_Groups; }
	/// The places as an item of the flow carries them.
	Flow2TypesUtils::FlowSubjectSceneTransformItem SceneTransform() const;

	/// Null if a class has none.
	std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> Parametrised(const VSubjectTypes& i_rTypes) const;

	/// Sorts the groups and gives each subject its place.
	/// @return the extents, widened by 1000 mm on each side.
	static std::array<std::int32_t, 4> Arrange(VGroups& io_rGroups, bool i_bYUp);

private:
	Flow2TypesUtils::VTaggedCoreTypeExtractor m_Items;
	Flow2TypesUtils::VItemCacheTyped<Flow2TypesUtils::FlowUpAxisItem> m_UpAxis;
	std::uint32_t m_LastPoseIndex = 0;
	std::array<std::int32_t, 4> m_Extents{};
	VGroups m_Groups;
};

} // namespace Flow2Graphics
