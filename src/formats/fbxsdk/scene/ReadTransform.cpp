#include "fbxsdk/scene/ReadTransform.h"

#include "fbxsdk/document/Properties.h"

namespace
{

using namespace FbxFormat;

constexpr std::pair<std::string_view, Rotation::VVector3 VNodeTransform::*> c_Vectors[]{
    {"Lcl Translation", &VNodeTransform::m_Translation},
    {"Lcl Rotation", &VNodeTransform::m_Rotation},
    {"Lcl Scaling", &VNodeTransform::m_Scaling},
    {"RotationOffset", &VNodeTransform::m_RotationOffset},
    {"RotationPivot", &VNodeTransform::m_RotationPivot},
    {"ScalingOffset", &VNodeTransform::m_ScalingOffset},
    {"ScalingPivot", &VNodeTransform::m_ScalingPivot},
    {"PreRotation", &VNodeTransform::m_PreRotation},
    {"PostRotation", &VNodeTransform::m_PostRotation},
    {"GeometricTranslation", &VNodeTransform::m_GeometricTranslation},
    {"GeometricRotation", &VNodeTransform::m_GeometricRotation},
    {"GeometricScaling", &VNodeTransform::m_GeometricScaling},
};

/// A number that no enumerator has leaves the default; "spheric" order, 6, turns as XYZ does.
template <typename TEnum>
void ReadEnum(VValueCursor& io_rCursor, TEnum i_Last, TEnum& io_rValue)
{
	const std::int64_t number = io_rCursor.Next().AsInteger(std::int64_t(io_rValue));
	io_rValue = number >= 0 && number <= std::int64_t(i_Last) ? TEnum(number) : TEnum(0);
}

void ReadFlag(VValueCursor& io_rCursor, bool& io_rbValue)
{
	io_rbValue = io_rCursor.Next().AsInteger(io_rbValue) != 0;
}

} // namespace

void FbxFormat::ReadTransform(const VElementTree& i_rTree, VElementIndex i_Object, VNodeTransform& io_rTransform)
{
	VisitProperties(i_rTree, i_Object,
	    [&io_rTransform](std::string_view i_Name, VValueCursor& io_rCursor)
	    {
		    for (const auto& [name, pMember] : c_Vectors)
			    if (i_Name == name)
			    {
				    for (double& rComponent : io_rTransform.*pMember)
					    rComponent = io_rCursor.Next().AsReal(rComponent);
				    return;
			    }
		    if (i_Name == "RotationOrder")
			    ReadEnum(io_rCursor, ERotationOrder::ZYX, io_rTransform.m_Order);
		    else if (i_Name == "InheritType")
			    ReadEnum(io_rCursor, EInheritType::Rrs, io_rTransform.m_InheritType);
		    else if (i_Name == "RotationActive")
			    ReadFlag(io_rCursor, io_rTransform.m_bRotationActive);
		    else if (i_Name == "RotationSpaceForLimitOnly")
			    ReadFlag(io_rCursor, io_rTransform.m_bRotationSpaceForLimitOnly);
	    });
}
