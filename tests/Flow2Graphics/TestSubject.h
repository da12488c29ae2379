#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectState.h"
#include "Flow2Graphics/SubjectTypes.h"
#include "Flow2TypesUtils/ItemCatalogue.h"
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

/// An item of a number.
template <typename T>
NVX::CountedPointer<TesselPluginInterface::IFlowItem> Item(std::uint32_t i_Tag, T i_Value)
{
	return Item(Flow2TypesUtils::FindItemType(i_Tag)->m_Name, std::move(i_Value));
}

/// The small subject as one of a class.
NVX::CountedPointer<TesselPluginInterface::IFlowFrame> MakeSubjectFrame(
    const Flow2Graphics::VSubjectTypes& i_rTypes = Flow2Graphics::VFlowSubjectForSolvingTypes::c_Types,
    const CoreOrlexTypes::VReconstructionLabelSet* i_pLabels = nullptr,
    const CoreOrlexTypes::VSubjectDynamicParameters& i_rPose = MakePose(),
    const CoreOrlexTypes::VSubjectApplicationData& i_rData = MakeData());

} // namespace TestSubject
