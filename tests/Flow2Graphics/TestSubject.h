#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectState.h"
#include "InMemoryHost/Flow.h"

#include <memory>
#include <vector>

/// A small subject whose every number can be told by hand: a root that turns about Z, a spine of 100 mm, a limb of
/// 300 mm that bears a point target and a rigid body, a hidden tip of 50 mm, and a segment without length.
namespace TestSubject
{

inline constexpr std::uint32_t c_Id = 77;

enum ESegment : std::uint32_t
{
	ERoot,
	ESpine,
	ELimb,
	ETip,
	EShort,
	ESegmentCount
};

enum ETarget : std::uint32_t
{
	EPoint,
	ERotation,
	EBody,
	ETargetCount
};

CoreOrlexTypes::VSubject Make();
/// Shorter than the subject: the segment without length has none.
CoreOrlexTypes::VSubjectApplicationData MakeData();
/// A quarter turn about Z at (10, 20, 30).
CoreOrlexTypes::VSubjectDynamicParameters MakePose();

/// An item of any flow type.
template <typename T>
NVX::CountedPointer<TesselPluginInterface::IFlowItem> Item(const std::string& i_rFlowType, T i_Value)
{
	InMemoryHost::VItemFactory factory;
	const auto pItem = factory.CreateItem(i_rFlowType);
	if (!TesselPluginInterface::SetItemValue(pItem, std::make_shared<const T>(std::move(i_Value))))
		return nullptr;
	return pItem;
}

NVX::CountedPointer<TesselPluginInterface::IFlowFrame> MakeFrame(
    const std::vector<NVX::CountedPointer<TesselPluginInterface::IFlowItem>>& i_rItems);

} // namespace TestSubject
