#include "CoreOrlexTypesUtils/check/SubjectCheckRemedies.h"
#include "CoreOrlexTypesUtils/check/SubjectCheckRules.h"

#include "CoreOrlexTypes/Fields.h"
#include "CoreOrlexTypes/JointType.h"

namespace CoreOrlexTypesUtils::SubjectCheck
{
namespace
{

using CoreOrlexTypes::CovarianceSize;
using CoreOrlexTypes::StateSize;

/// The statistics of one joint, whose sizes its type prescribes.
class VStatistics
{
public:
	enum EPresence
	{
		EMandatory,
		EOptional
	};

	VStatistics(VSubjectParametrised::VJoint::EJointType i_Type, const VReport& i_rReport)
	    : m_Type(i_Type), m_rReport(i_rReport)
	{
	}

	void Vector(
	    const char* i_pField, const std::vector<double>& i_rValues, EPresence i_Presence, const char* i_pMessage)
	{
		Size(i_pField, i_rValues, StateSize(m_Type), i_Presence, i_pMessage);
	}

	/// @param i_pInvalid the message for a matrix of the right size that is no covariance.
	void Matrix(const char* i_pField, const std::vector<double>& i_rValues, EPresence i_Presence,
	    const char* i_pMessage, const char* i_pInvalid)
	{
		if (!Size(i_pField, i_rValues, CovarianceSize(m_Type), i_Presence, i_pMessage) || i_rValues.empty())
			return;
		const MatrixValidity::EFault fault = MatrixValidity::FaultAsDefinite(i_rValues, StateSize(m_Type));
		if (fault != MatrixValidity::EFault::ENone)
			m_bGood = m_rReport.Fail(i_pInvalid, MatrixRemedy(i_pField, fault, true));
	}

	/// Both or neither.
	void Pair(const char* i_pFirst, const std::vector<double>& i_rFirst, const char* i_pSecond,
	    const std::vector<double>& i_rSecond, const char* i_pMessage)
	{
		if (i_rFirst.empty() != i_rSecond.empty())
			m_bGood = m_rReport.Fail(
			    i_pMessage, std::string("Give both ") + i_pFirst + " and " + i_pSecond + ", or leave both empty.");
	}

	bool Good() const { return m_bGood; }

private:
	bool Size(const char* i_pField, const std::vector<double>& i_rValues, std::size_t i_Size, EPresence i_Presence,
	    const char* i_pMessage)
	{
		const bool bMayBeEmpty = i_Presence == EOptional;
		if (i_rValues.size() == i_Size || (bMayBeEmpty && i_rValues.empty()))
			return true;
		const std::string_view type = CoreOrlexTypes::EnumeratorName(m_Type);
		return m_bGood = m_rReport.Fail(i_pMessage,
		           SizeRemedy(i_pField, i_rValues.size(), i_Size, bMayBeEmpty,
		               type.empty() ? "a joint of unknown type" : "joint type " + std::string(type)));
	}

	VSubjectParametrised::VJoint::EJointType m_Type;
	const VReport& m_rReport;
	bool m_bGood = true;
};

} // namespace

bool CheckJoint(const VSubject::VJoint& i_rJoint, const VReport& i_rReport)
{
	VStatistics statistics(i_rJoint.m_JointType, i_rReport);
	statistics.Vector("Mean", i_rJoint.m_Mean, VStatistics::EMandatory, "Incorrent 'Mean' vector size.");
	statistics.Matrix("Covariance", i_rJoint.m_Covariance, VStatistics::EMandatory,
	    "Incorrect 'Covariance' vector size.", "Invalid joint covariance matrix");
	statistics.Vector("RangeCentringState", i_rJoint.m_RangeCentringState, VStatistics::EOptional,
	    "Incorrect 'RangeCenteringState' vector size.");
	statistics.Matrix("RangeMatrix", i_rJoint.m_RangeMatrix, VStatistics::EOptional, "Incorrect 'RangeMatrix' size.",
	    "Invalid joint range matrix");
	statistics.Pair("RangeCentringState", i_rJoint.m_RangeCentringState, "RangeMatrix", i_rJoint.m_RangeMatrix,
	    "Inconsistent range information.");
	return statistics.Good();
}

bool CheckJointTemplate(const VSubjectParametrised::VJoint& i_rJoint, const VReport& i_rReport)
{
	VStatistics statistics(i_rJoint.m_JointType, i_rReport);
	statistics.Vector(
	    "TemplateMean", i_rJoint.m_TemplateMean, VStatistics::EOptional, "Incorrect 'TemplateMean' vector size.");
	statistics.Matrix("TemplateCovariance", i_rJoint.m_TemplateCovariance, VStatistics::EOptional,
	    "Incorrect 'TemplateCovariance' size.", "Invalid joint template covariance matrix");
	statistics.Pair("TemplateMean", i_rJoint.m_TemplateMean, "TemplateCovariance", i_rJoint.m_TemplateCovariance,
	    "Inconsistent template stats information.");
	statistics.Vector("TemplateRangeCentringState", i_rJoint.m_TemplateRangeCentringState, VStatistics::EOptional,
	    "Incorrect 'TemplateRangeCentringState' vector size.");
	statistics.Matrix("TemplateRangeMatrix", i_rJoint.m_TemplateRangeMatrix, VStatistics::EOptional,
	    "Incorrect 'TemplateRangeMatrix' size.", "Invalid joint range matrix");
	statistics.Pair("TemplateRangeCentringState", i_rJoint.m_TemplateRangeCentringState, "TemplateRangeMatrix",
	    i_rJoint.m_TemplateRangeMatrix, "Inconsistent template range information.");
	statistics.Vector("BindPose", i_rJoint.m_BindPose, VStatistics::EOptional, "Incorrect 'BindPose' vector size.");
	return statistics.Good();
}

} // namespace CoreOrlexTypesUtils::SubjectCheck
