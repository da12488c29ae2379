#include "RetargetSetupCore/TargetState.h"

#include "CoreOrlexTypes/Fields.h"

#include <array>
#include <type_traits>

namespace RetargetSetup
{
namespace
{

using CoreOrlexQRTIO::VSubjectQRTExtras;

template <typename T>
bool ValuesDiffer(const std::shared_ptr<const T>& i_rpA, const std::shared_ptr<const T>& i_rpB)
{
	return i_rpA != i_rpB && (!i_rpA || !i_rpB || !(*i_rpA == *i_rpB));
}

/// What a value holds beyond itself, in bytes.
struct VHeldBytes
{
	std::size_t operator()(const std::string& i_rText) const
	{
		// A short one stands in itself.
		return i_rText.capacity() > std::string().capacity() ? i_rText.capacity() + 1 : 0;
	}

	template <typename T>
	std::size_t operator()(const std::vector<T>& i_rValues) const
	{
		return i_rValues.capacity() * sizeof(T) + OfAll(i_rValues);
	}

	template <typename T, std::size_t c_Count>
	std::size_t operator()(const std::array<T, c_Count>& i_rValues) const
	{
		return OfAll(i_rValues);
	}

	std::size_t operator()(const VSubjectQRTExtras::VPrincipalComponent& i_rComponent) const
	{
		return (*this)(i_rComponent.m_JointParams);
	}

	std::size_t operator()(const VSubjectQRTExtras::VDynamicSubspace& i_rSubspace) const
	{
		return (*this)(i_rSubspace.m_JointNames) + (*this)(i_rSubspace.m_JointParamsMean)
		    + (*this)(i_rSubspace.m_Components);
	}

	std::size_t operator()(const VSubjectQRTExtras& i_rExtras) const
	{
		// Of segments, markers and targets the few texts are left out.
		return (*this)(i_rExtras.m_Segments) + (*this)(i_rExtras.m_Markers) + (*this)(i_rExtras.m_Targets)
		    + (*this)(i_rExtras.m_DynamicSubspaces);
	}

	template <typename T>
	std::size_t operator()(const T& i_rValue) const
	{
		std::size_t bytes = 0;
		if constexpr (CoreOrlexTypes::CRecord<T>)
			CoreOrlexTypes::ForEachField<T>(
			    [&](const auto& i_rField) { bytes += (*this)(i_rValue.*i_rField.pMember); });
		return bytes;
	}

private:
	template <typename TValues>
	std::size_t OfAll(const TValues& i_rValues) const
	{
		std::size_t bytes = 0;
		if constexpr (!std::is_arithmetic_v<typename TValues::value_type>)
			for (const auto& rValue : i_rValues)
				bytes += (*this)(rValue);
		return bytes;
	}
};

constexpr VHeldBytes c_HeldBytes;

template <typename T>
std::size_t BytesBesideValue(const std::shared_ptr<const T>& i_rpValue, const std::shared_ptr<const T>& i_rpOther)
{
	return i_rpValue && i_rpValue != i_rpOther ? sizeof(T) + c_HeldBytes(*i_rpValue) : 0;
}

} // namespace

VSubjectValues ValuesOf(const VSubjectItems& i_rItems)
{
	using TesselPluginInterface::ItemValue;
	return {ItemValue<CoreOrlexTypes::VSubject>(i_rItems.m_pSubject),
	    ItemValue<CoreOrlexTypes::VSubjectApplicationData>(i_rItems.m_pApplicationData),
	    ItemValue<CoreOrlexTypes::VSubjectParametrised>(i_rItems.m_pParametrised)};
}

bool Differ(const VSubjectValues& i_rA, const VSubjectValues& i_rB)
{
	return ValuesDiffer(i_rA.m_pParametrised, i_rB.m_pParametrised)
	    || ValuesDiffer(i_rA.m_pApplicationData, i_rB.m_pApplicationData);
}

bool HoldTheSame(const VTargetState& i_rA, const VTargetState& i_rB)
{
	return i_rA.m_pFile == i_rB.m_pFile && i_rA.m_NextScale == i_rB.m_NextScale
	    && i_rA.m_bScaleRootHeight == i_rB.m_bScaleRootHeight && !Differ(ValuesOf(i_rA.m_Items), ValuesOf(i_rB.m_Items))
	    && !ValuesDiffer(i_rA.m_pExtras, i_rB.m_pExtras);
}

std::size_t BytesBeside(const VTargetState& i_rState, const VTargetState& i_rOther)
{
	const VSubjectValues values = ValuesOf(i_rState.m_Items);
	const VSubjectValues others = ValuesOf(i_rOther.m_Items);
	return sizeof(VTargetState) + c_HeldBytes(i_rState.m_Identities.m_Targets) + c_HeldBytes(i_rState.m_Selection)
	    + BytesBesideValue(values.m_pParametrised, others.m_pParametrised)
	    + BytesBesideValue(values.m_pSubject, others.m_pSubject)
	    + BytesBesideValue(values.m_pApplicationData, others.m_pApplicationData)
	    + BytesBesideValue(i_rState.m_pExtras, i_rOther.m_pExtras);
}

} // namespace RetargetSetup
