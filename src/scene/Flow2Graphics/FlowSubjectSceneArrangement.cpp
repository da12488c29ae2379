#include "Flow2Graphics/FlowSubjectSceneArrangement.h"

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectState.h"

#include <algorithm>
#include <tuple>

namespace Flow2Graphics
{

namespace
{

constexpr double c_Spacing = 2000.0;
/// On the axis that is up.
constexpr double c_Height = 1000.0;
constexpr std::int32_t c_Border = 1000;

} // namespace

VFlowSubjectSceneArrangement::VFlowSubjectSceneArrangement() : m_UpAxis(Flow2TypesUtils::FlowUpAxisItem::c_pName)
{
	for (const VSubjectTypes& rTypes : c_SubjectTypes)
		for (const std::uint32_t tag : {rTypes.m_Subject, rTypes.m_Parametrised, rTypes.m_Settings})
			m_Items.Insert(tag);
	m_Extents = Arrange(m_Groups, false);
}

bool VFlowSubjectSceneArrangement::Update(const TesselPluginInterface::IFlowFrame& i_rFrame, std::uint32_t i_PoseIndex)
{
	if (i_PoseIndex != m_LastPoseIndex)
	{
		m_Items.Reset();
		m_LastPoseIndex = i_PoseIndex;
	}
	// Both have to look at the frame.
	const bool bAxisChanged = m_UpAxis.Update(i_rFrame);
	if (!m_Items.Update(i_rFrame) && !bAxisChanged)
		return false;

	m_Groups.clear();
	for (const VSubjectTypes& rTypes : c_SubjectTypes)
	{
		// The cache keeps a subject that the frame does not have any more.
		const auto pSubject = i_rFrame.Item(m_Items.Cache(rTypes.m_Subject)->FlowType())
		    ? m_Items.Get<CoreOrlexTypes::VSubject>(rTypes.m_Subject)
		    : nullptr;
		if (pSubject && IsOfClass(m_Items, rTypes, pSubject->m_SubjectId))
			m_Groups[rTypes.m_Class].push_back({pSubject->m_Name, {rTypes.m_Subject, pSubject->m_SubjectId}});
	}
	m_Extents = Arrange(m_Groups, m_UpAxis.Value() && m_UpAxis.Value()->m_Axis == Flow2TypesUtils::FlowUpAxisItem::c_Y);
	return true;
}

Flow2TypesUtils::FlowSubjectSceneTransformItem VFlowSubjectSceneArrangement::SceneTransform() const
{
	Flow2TypesUtils::FlowSubjectSceneTransformItem item;
	item.m_Extents = m_Extents;
	for (const auto& [group, rSubjects] : m_Groups)
		for (const VPlaced& rSubject : rSubjects)
			item.m_Translations[rSubject.m_Key] = rSubject.m_Translation;
	return item;
}

std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> VFlowSubjectSceneArrangement::Parametrised(
    const VSubjectTypes& i_rTypes) const
{
	return i_rTypes.m_Parametrised ? m_Items.Get<CoreOrlexTypes::VSubjectParametrised>(i_rTypes.m_Parametrised)
	                               : nullptr;
}

std::array<std::int32_t, 4> VFlowSubjectSceneArrangement::Arrange(VGroups& io_rGroups, bool i_bYUp)
{
	std::array<std::int32_t, 4> extents{};
	double row = 0.0;
	for (auto& [group, rSubjects] : io_rGroups)
	{
		if (rSubjects.empty())
			continue;
		std::sort(rSubjects.begin(), rSubjects.end(),
		    [](const VPlaced& i_rLeft, const VPlaced& i_rRight)
		    { return std::tie(i_rLeft.m_Name, i_rLeft.m_Key) < std::tie(i_rRight.m_Name, i_rRight.m_Key); });
		double x = -0.5 * c_Spacing * static_cast<double>(rSubjects.size() - 1);
		for (VPlaced& rSubject : rSubjects)
		{
			rSubject.m_Translation = i_bYUp ? std::array{x, c_Height, row} : std::array{x, row, c_Height};
			extents[0] = std::min(extents[0], static_cast<std::int32_t>(x));
			extents[1] = std::max(extents[1], static_cast<std::int32_t>(x));
			extents[3] = std::max(extents[3], static_cast<std::int32_t>(row));
			x += c_Spacing;
		}
		row += c_Spacing;
	}
	return {extents[0] - c_Border, extents[1] + c_Border, extents[2] - c_Border, extents[3] + c_Border};
}

} // namespace Flow2Graphics
