#include "CoreOrlexTypesUtils/check/SubjectCheckRemedies.h"

namespace CoreOrlexTypesUtils::SubjectCheck
{

std::string Count(std::size_t i_Count, const std::string& i_rSingular, const std::string& i_rPlural)
{
	if (i_Count == 0)
		return "no " + i_rPlural;
	return std::to_string(i_Count) + " " + (i_Count == 1 ? i_rSingular : i_rPlural);
}

std::string SizeRemedy(const std::string& i_rField, std::size_t i_Actual, std::size_t i_Expected, bool i_bMayBeEmpty,
    const std::string& i_rWhy)
{
	const std::string expected = Count(i_Expected, "value", "values");
	return "Give " + i_rField + " " + expected + (i_bMayBeEmpty && i_Expected != 0 ? " or none" : "") + ", as " + i_rWhy
	    + " asks for; it has " + std::to_string(i_Actual) + ".";
}

std::string MatrixRemedy(const std::string& i_rField, MatrixValidity::EFault i_Fault, bool i_bDefinite)
{
	using MatrixValidity::EFault;
	switch (i_Fault)
	{
	case EFault::ENotFinite: return "Replace the entries of " + i_rField + " that are no finite numbers.";
	case EFault::ENotSymmetric: return "Make " + i_rField + " symmetric: each entry equal to its mirror, to 1e-12.";
	case EFault::EEigenvalue:
		return "Give " + i_rField + (i_bDefinite ? " eigenvalues above 0" : " no negative eigenvalue")
		    + ", or set all its entries to 0.";
	case EFault::ENone: break;
	}
	return {};
}

} // namespace CoreOrlexTypesUtils::SubjectCheck
