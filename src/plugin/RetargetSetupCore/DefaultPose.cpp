#include "RetargetSetupCore/DefaultPose.h"

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"

#include <boost/algorithm/string/case_conv.hpp>

#include <locale>

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;

namespace RetargetSetup
{

namespace
{

constexpr double c_QuarterTurn = 1.5707963267948966;

/// How far above the floor the root of a default pose stands, in mm.
constexpr double c_RootHeight = 1000.0;

/// The axis of its parent's frame along which the head lies: 2 or 1 if that coordinate is the greatest and above 0.
int HeadAxis(const VSubjectParametrised& i_rSubject)
{
	VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(i_rSubject, subject);
	for (const VSubject::VSegment& rSegment : subject.m_Segments)
	{
		if (boost::algorithm::to_lower_copy(rSegment.m_Name, std::locale::classic()) != "head")
			continue;
		const auto& [x, y, z] = rSegment.m_PreTranslation;
		if (z > y && z > x && z > 0.0)
			return 2;
		return y > x && y > 0.0 ? 1 : 0;
	}
	return 0;
}

} // namespace

void ApplyDefaultPose(VSubjectParametrised& io_rSubject)
{
	if (io_rSubject.m_Segments.empty())
		return;
	std::vector<double>& rRoot = io_rSubject.m_Segments.front().m_Joint.m_TPoseMean;
	rRoot.assign(6, 0.0);
	if (HeadAxis(io_rSubject) == 1)
		rRoot[0] = c_QuarterTurn;
	rRoot[5] = c_RootHeight;
	for (VSubjectParametrised::VSegment& rSegment : io_rSubject.m_Segments)
		if (rSegment.m_Joint.m_JointType == VSubjectParametrised::VJoint::EBall)
			rSegment.m_Joint.m_TPoseMean.assign(3, 0.0);
}

void AdoptTPoseAsBindPose(VSubjectParametrised& io_rSubject)
{
	for (VSubjectParametrised::VSegment& rSegment : io_rSubject.m_Segments)
	{
		rSegment.m_Joint.m_BindPose = std::move(rSegment.m_Joint.m_TPoseMean);
		rSegment.m_Joint.m_TPoseMean.clear();
		rSegment.m_Joint.m_TPoseCovariance.clear();
	}
}

bool LacksBindPose(const VSubjectParametrised& i_rSubject)
{
	return i_rSubject.m_Segments.empty() || i_rSubject.m_Segments.front().m_Joint.m_BindPose.empty();
}

} // namespace RetargetSetup
