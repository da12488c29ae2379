#pragma once

#include "numerics/fnl_symmetric_eigensystem.h"

/// Carries a mean and a covariance, row by row, through i_rFunction, which maps an array of t_In doubles to one of
/// t_Out: the images of 2 t_In + 1 sigma points, weighted (S. Julier, "The scaled unscented transformation", American
/// Control Conference 2002), with alpha 1e-3, beta 2 and kappa 1. A covariance with negative eigenvalues counts as the
/// one with zeros in their place.
///
/// The weights of the outer points are near 1e5 and that of the centre as far below 0, so that plain weighted sums
/// would lose six digits. The sums here run over the differences to the image of the mean, in which the centre has no
/// part; what is left of its weight in the covariance is beta - alpha^2.
template <std::size_t t_In, std::size_t t_Out, typename TFunction>
void UnscentedTransform(const TFunction& i_rFunction, const std::array<double, t_In>& i_rMean,
    const std::array<double, t_In * t_In>& i_rCovariance, std::array<double, t_Out>& o_rMean,
    std::array<double, t_Out * t_Out>& o_rCovariance)
{
	constexpr double c_Alpha = 1e-3;
	constexpr double c_Beta = 2.0;
	constexpr double c_Kappa = 1.0;
	constexpr double c_Spread = c_Alpha * c_Alpha * (t_In + c_Kappa);
	constexpr double c_Weight = 0.5 / c_Spread;

	const fnl_symmetric_eigensystem<t_In> eigen(i_rCovariance);
	const std::array<double, t_Out> centre = i_rFunction(i_rMean);
	std::array<double, t_Out> shift{};
	o_rCovariance.fill(0.0);
	for (std::size_t k = 0; k < t_In; ++k)
	{
		const double value = eigen.Values()[k];
		const double length = std::sqrt(c_Spread * (value < 0.0 ? 0.0 : value));
		for (const double side : {length, -length})
		{
			std::array<double, t_In> point = i_rMean;
			for (std::size_t i = 0; i < t_In; ++i)
				point[i] += side * eigen.Vectors()[k * t_In + i];
			std::array<double, t_Out> difference = i_rFunction(point);
			for (std::size_t i = 0; i < t_Out; ++i)
			{
				difference[i] -= centre[i];
				shift[i] += c_Weight * difference[i];
			}
			for (std::size_t i = 0; i < t_Out; ++i)
				for (std::size_t j = 0; j < t_Out; ++j)
					o_rCovariance[i * t_Out + j] += c_Weight * difference[i] * difference[j];
		}
	}
	for (std::size_t i = 0; i < t_Out; ++i)
	{
		o_rMean[i] = centre[i] + shift[i];
		for (std::size_t j = 0; j < t_Out; ++j)
			o_rCovariance[i * t_Out + j] += (c_Beta - c_Alpha * c_Alpha) * shift[i] * shift[j];
	}
}
