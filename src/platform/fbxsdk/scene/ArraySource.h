#pragma once

#include "fbxsdk/container/Arrays.h"

#include <string>

namespace FbxFile
{

/// Where an array of a scene's object stands in the file: it is decoded when somebody asks for it. Tree and budget are
/// the scene's and live as long as its objects.
struct VArraySource
{
	const VElementTree* m_pTree = nullptr;
	VDecodeBudget* m_pBudget = nullptr;
	/// c_NoElement: the file has no such array.
	VElementIndex m_Element = c_NoElement;

	/// The child record of that name.
	VArraySource Child(std::string_view i_Name) const { return {m_pTree, m_pBudget, m_pTree->Find(m_Element, i_Name)}; }
};

/// All numbers of the array, straight into o_rNumbers; none if the file has no such array. T is double or std::int32_t.
/// @return false, with none, if they are damaged: told in the log category "FBXIO" with the owner's name.
template <typename T>
bool Decode(const VArraySource& i_rSource, const char* i_pOwner, std::vector<T>& o_rNumbers);

} // namespace FbxFile
