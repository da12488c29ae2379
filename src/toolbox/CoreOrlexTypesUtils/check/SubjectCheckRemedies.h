#pragma once

#include "numerics/MatrixValidity.h"

#include <string>

/// How to mend what several rules find, in one line.
namespace CoreOrlexTypesUtils::SubjectCheck
{

/// "3 values", "1 value", "no values".
std::string Count(std::size_t i_Count, const std::string& i_rSingular, const std::string& i_rPlural);

/// @param i_rField what has the wrong size, as the text form of subjects calls it.
/// @param i_rWhy what asks for the size, as "joint type Ball".
std::string SizeRemedy(const std::string& i_rField, std::size_t i_Actual, std::size_t i_Expected, bool i_bMayBeEmpty,
    const std::string& i_rWhy);

/// @param i_rField the matrix, or where it stands.
/// @param i_bDefinite whether eigenvalues must be above 0.
std::string MatrixRemedy(const std::string& i_rField, MatrixValidity::EFault i_Fault, bool i_bDefinite);

} // namespace CoreOrlexTypesUtils::SubjectCheck
