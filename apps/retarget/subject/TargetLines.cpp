#include "retarget/subject/TargetLines.h"

#include "retarget/text/Table.h"

#include "CoreOrlexTypes/Fields.h"
#include "RetargetSetupCore/RetargetTargets.h"

#include <numbers>

namespace CommandLine
{
namespace
{

VJson ResidualToJson(const VResidual& i_rResidual)
{
	if (i_rResidual.m_Distance)
		return *i_rResidual.m_Distance;
	return i_rResidual.m_Angle ? VJson(AsDegrees(*i_rResidual.m_Angle)) : VJson();
}

} // namespace

double AsDegrees(double i_Radians)
{
	return i_Radians * 180.0 / std::numbers::pi;
}

std::string ResidualText(const VResidual& i_rResidual)
{
	if (i_rResidual.m_Distance)
		return Fixed(*i_rResidual.m_Distance, 3) + " mm";
	if (i_rResidual.m_Angle)
		return Fixed(AsDegrees(*i_rResidual.m_Angle), 3) + " deg";
	return "-";
}

std::vector<VTargetLine> TargetLines(VSession& io_rSession, bool i_bResiduals)
{
	const VRetargetSetupCore::VSubjectValues target = io_rSession.Document().TargetValues();
	const auto& rSubject = *target.m_pParametrised;
	std::vector<VTargetLine> lines(rSubject.m_Targets.size());
	std::vector<VTargetResidual> residuals(lines.size());
	if (i_bResiduals)
		residuals = Residuals(io_rSession.Document().SourceValues(), target);
	for (std::size_t i = 0; i < lines.size(); ++i)
	{
		const auto& rTarget = rSubject.m_Targets[i];
		VTargetLine& rLine = lines[i];
		if (i < target.m_pApplicationData->m_Targets.size())
			rLine.m_Name = target.m_pApplicationData->m_Targets[i].m_Name;
		rLine.m_Type = CoreOrlexTypes::EnumeratorName(rTarget.m_Type);
		rLine.m_Kind = RetargetSetup::TargetKindName(rTarget.m_Type);
		for (const std::string& rName : FollowedNames(rSubject, rTarget))
			rLine.m_Source += (rLine.m_Source.empty() ? "" : ", ") + rName;
		if (const std::string* pName = RetargetSetup::TargetSegmentName(rSubject, rTarget))
			rLine.m_Target = *pName;
		rLine.m_Weight = rTarget.m_Weight;
		rLine.m_State = rTarget.m_StateExpressions;
		rLine.m_Residual = residuals[i];
	}
	return lines;
}

VJson LinesToJson(const std::vector<VTargetLine>& i_rLines, bool i_bResiduals)
{
	VJson list = VJson::array();
	for (const VTargetLine& rLine : i_rLines)
	{
		VJson item = VJson::object();
		item["index"] = list.size();
		item["name"] = rLine.m_Name;
		item["type"] = rLine.m_Type;
		item["source"] = rLine.m_Source;
		item["target"] = rLine.m_Target;
		item["weight"] = rLine.m_Weight;
		item["state"] = rLine.m_State;
		if (i_bResiduals)
		{
			const VResidual& rOffset = rLine.m_Residual.m_Offset;
			item["distance"] = ResidualToJson({rOffset.m_Distance, {}});
			item["angle"] = ResidualToJson({{}, rOffset.m_Angle});
			item["targetResidual"] = ResidualToJson(rLine.m_Residual.m_Target);
		}
		list.push_back(std::move(item));
	}
	return list;
}

} // namespace CommandLine
