#pragma once

#include "ComputeSubjectFK/Targets.h"

#include <type_traits>

namespace ComputeSubject
{

/// Owns a target of class T, and offers it through each interface that T has.
template <typename T, typename TDescription>
class VTargetFK final : public ITargetFK
{
public:
	VTargetFK(const TDescription& i_rTarget, const VSegmentTree& i_rSegments)
	    : VTargetFK(std::make_shared<T>(i_rTarget, i_rSegments))
	{
	}

	std::shared_ptr<ITargetFK> Clone(const VSegmentTree& i_rSegments) const override
	{
		auto pTarget = std::make_shared<T>(*m_pTarget);
		pTarget->Bind(i_rSegments);
		return std::shared_ptr<ITargetFK>(new VTargetFK(std::move(pTarget)));
	}

private:
	explicit VTargetFK(std::shared_ptr<T> i_pTarget) : m_pTarget(std::move(i_pTarget))
	{
		Offer(m_pTargetFK);
		Offer(m_pSingleMarker);
		Offer(m_pSingleRotationObservation);
		Offer(m_pMarkerGroup);
		Offer(m_pFromLocalPoint);
		Offer(m_pFromLocalLine);
		Offer(m_pFromLocalPlane);
		Offer(m_pFromLocalRotation);
		Offer(m_pFromPointGroup);
	}

	template <typename TInterface>
	void Offer(std::shared_ptr<TInterface>& o_rpInterface)
	{
		if constexpr (std::is_base_of_v<TInterface, T>)
			o_rpInterface = m_pTarget;
	}

	std::shared_ptr<T> m_pTarget;
};

template <typename TDescription>
class ITargetFKFactory
{
public:
	virtual ~ITargetFKFactory() = default;

	/// Throws VConstructionException if the target does not fit the factory's class.
	virtual std::shared_ptr<ITargetFK> Create(const TDescription& i_rTarget, const VSegmentTree& i_rSegments) const = 0;
};

template <typename T>
class VTargetFKFactory final : public ITargetFKFactory<CoreOrlexTypes::VSubject::VTarget>
{
public:
	std::shared_ptr<ITargetFK> Create(
	    const CoreOrlexTypes::VSubject::VTarget& i_rTarget, const VSegmentTree& i_rSegments) const override
	{
		return std::make_shared<VTargetFK<T, CoreOrlexTypes::VSubject::VTarget>>(i_rTarget, i_rSegments);
	}
};

/// Null for a type that has no class. The Gaussian types share the class of the plain ones.
const ITargetFKFactory<CoreOrlexTypes::VSubject::VTarget>* TargetFKFactory(
    CoreOrlexTypes::VSubject::VTarget::ETargetType i_Type);

} // namespace ComputeSubject
