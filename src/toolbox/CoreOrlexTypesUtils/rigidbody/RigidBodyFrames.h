#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"

#include "numerics/MatrixValidity.h"
#include "numerics/Rotation.h"

/// How what a rigid body holds changes when it is given in another frame.
namespace CoreOrlexTypesUtils
{

inline bool EvaluateSubject(const CoreOrlexTypes::VSubject& i_rSubject, CoreOrlexTypes::VSubject& o_rEvaluated)
{
	o_rEvaluated = i_rSubject;
	return true;
}

inline bool EvaluateSubject(
    const CoreOrlexTypes::VSubjectParametrised& i_rSubject, CoreOrlexTypes::VSubject& o_rEvaluated)
{
	return SubjectParametrisedConverter::ConvertSubject(i_rSubject, o_rEvaluated);
}

/// R C R', symmetric to the last bit and without the negative eigenvalues of rounding.
inline Rotation::VMatrix3 TurnedCovariance(const Rotation::VMatrix3& i_rR, const Rotation::VMatrix3& i_rCovariance)
{
	if (i_rR == Rotation::c_Identity3)
		return i_rCovariance;
	Rotation::VMatrix3 turned = Rotation::Product(i_rR, Rotation::Product(i_rCovariance, Rotation::Transposed(i_rR)));
	MatrixValidity::TakeOffRounding<3>(turned);
	return turned;
}

/// Turns the view normals of a target.
inline void TurnNormals(const Rotation::VMatrix3& i_rR, std::vector<Rotation::VVector3>& io_rNormals)
{
	if (i_rR != Rotation::c_Identity3)
		for (Rotation::VVector3& rNormal : io_rNormals)
			rNormal = Rotation::Product(i_rR, rNormal);
}

} // namespace CoreOrlexTypesUtils
