#pragma once

#include "TakeIO/Take.h"
#include "fbxsdk/container/FileKind.h"
#include "fbxsdk/document/Document.h"
#include "fbxsdk/scene/NodeTransform.h"

#include <optional>

namespace TakeIO
{

/// All records of an FBX file, whose bytes must outlive them. They stay where they are.
class VFbxRecords
{
public:
	VFbxRecords() = default;
	VFbxRecords(const VFbxRecords&) = delete;
	VFbxRecords& operator=(const VFbxRecords&) = delete;

	/// @return false, with the reason, if the file is of another version than 6 or 7, or damaged.
	bool Read(std::string_view i_Bytes, std::string& o_rError);

	const FbxFormat::VFileKind& Kind() const { return m_Kind; }
	const FbxFormat::VElementTree& Tree() const { return m_Tree; }
	const FbxFormat::VDocument& Document() const { return *m_pDocument; }

private:
	FbxFormat::VFileKind m_Kind;
	FbxFormat::VElementTree m_Tree;
	std::optional<FbxFormat::VDocument> m_pDocument;
};

/// A node of an FBX file that a take has a joint of.
struct VFbxJoint
{
	FbxFormat::VObjectIndex m_Object = FbxFormat::c_NoObject;
	/// It stands before this one; -1 at the top.
	std::int32_t m_Parent = -1;
	bool m_bBone = false;
	/// As the file has it without a motion.
	FbxFormat::VNodeTransform m_Rest;
};

/// The bones with all above them, or all models where there are none; parents before children.
/// @return false, with the reason, if there are none or too many.
bool ReadFbxJoints(const FbxFormat::VDocument& i_rDocument, std::vector<VFbxJoint>& o_rJoints, std::string& o_rError);

struct VFbxSettings
{
	/// Nothing where the X axis points up.
	std::optional<EUp> m_Up = EUp::Y;
	/// Millimetres.
	double m_Unit = 10.0;
	/// Frames a second.
	double m_Rate = 30.0;
};

/// What no take can have is left at these defaults, but for a unit that is none: that is 0.
VFbxSettings ReadFbxSettings(const FbxFormat::VDocument& i_rDocument);

} // namespace TakeIO
