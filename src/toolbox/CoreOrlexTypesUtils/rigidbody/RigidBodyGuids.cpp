#include "CoreOrlexTypesUtils/rigidbody/RigidBodyGuids.h"

#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"
#include "CoreOrlexTypesUtils/rigidbody/RigidBodyRefusal.h"
#include "CoreOrlexTypesUtils/scale/ScalingRules.h"

#include <boost/uuid/random_generator.hpp>
#include <boost/uuid/uuid_io.hpp>

#include <algorithm>
#include <cctype>

namespace CoreOrlexTypesUtils::RigidBodyUtils
{

namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using VParameter = VSubjectParametrised::VStaticParameter;

/// 8-4-4-4-12 hexadecimal digits.
bool IsGuid(const std::string& i_rName)
{
	static constexpr std::string_view c_Form = "xxxxxxxx-xxxx-xxxx-xxxx-xxxxxxxxxxxx";
	return std::equal(i_rName.begin(), i_rName.end(), c_Form.begin(), c_Form.end(),
	    [](char i_Byte, char i_Form)
	    { return i_Form == '-' ? i_Byte == '-' : std::isxdigit(static_cast<unsigned char>(i_Byte)) != 0; });
}

std::string Quoted(const std::string& i_rName)
{
	return std::string("'").append(i_rName).append("'");
}

VParameter::EQuantity QuantityOf(VSubjectParametrised::VTarget::ETargetType i_Type, std::size_t i_Component)
{
	using VTarget = VSubjectParametrised::VTarget;
	if (IsLength(i_Type, i_Component))
		return VParameter::EQuantityLength;
	return i_Type == VTarget::ERigidBody || i_Type == VTarget::ELocalRotationToWorldRotation
	    ? VParameter::EQuantityAngle
	    : VParameter::EQuantityScalar;
}

/// Null if there is none.
const VParameter* Find(const VSubjectParametrised& i_rSubject, const std::string& i_rName)
{
	const auto& rList = i_rSubject.m_StaticParameters;
	const auto found = std::find_if(
	    rList.begin(), rList.end(), [&](const VParameter& i_rParameter) { return i_rParameter.m_Name == i_rName; });
	return found == rList.end() ? nullptr : &*found;
}

} // namespace

bool AddGuids(VSubjectParametrised& io_rSubject)
{
	NVX_LOG("RigidBodyUtils", NVX::ELogInformation, "Adding GUIDs to subject parameters for rigid body: %1%",
	    io_rSubject.m_Name);
	VDynamicExpressionParserSimple parser;
	std::vector<std::string> errors;
	if (!parser.Initialise(io_rSubject, errors))
	{
		Refuse("Error parsing subject static parameter expressions");
		for (const std::string& rError : errors)
			Refuse("%1%", rError);
		return false;
	}

	VSubjectParametrised result = io_rSubject;
	boost::uuids::random_generator makeGuid;
	for (VSubjectParametrised::VTarget& rTarget : result.m_Targets)
		for (std::size_t i = 0; i < rTarget.m_StateExpressions.size(); ++i)
		{
			std::string& rText = rTarget.m_StateExpressions[i];
			double value = 0.0;
			std::string error;
			std::set<std::string> names;
			if (!parser.Evaluate(rText, value, error) || !parser.EvaluateChecked(rText, names, error))
				return Refuse("Could not evaluate state expressions in target");
			const VParameter* pUsed = nullptr;
			for (const std::string& rName : names)
				if (!(pUsed = Find(io_rSubject, rName)))
					return Refuse("Missing parameter %1%", rName);
			if (names.size() > 1)
				return Refuse("Multiple parameters in target not handled.");
			VParameter parameter;
			parameter.m_Quantity = QuantityOf(rTarget.m_Type, i);
			if (pUsed)
			{
				if (IsGuid(pUsed->m_Name) && rText == Quoted(pUsed->m_Name))
					continue;
				parameter.m_Advanced = pUsed->m_Advanced;
				parameter.m_Visible = pUsed->m_Visible;
				parameter.m_ReadOnly = pUsed->m_ReadOnly;
				parameter.m_Required = pUsed->m_Required;
			}
			parameter.m_Name = boost::uuids::to_string(makeGuid());
			parameter.m_DefaultExpression = NumberText::PrintG17(value);
			rText = Quoted(parameter.m_Name);
			result.m_StaticParameters.push_back(std::move(parameter));
		}
	io_rSubject = std::move(result);
	NVX_LOG("RigidBodyUtils", NVX::ELogInformation, "Added GUIDs to subject parameters for rigid body: %1%",
	    io_rSubject.m_Name);
	return true;
}

} // namespace CoreOrlexTypesUtils::RigidBodyUtils
