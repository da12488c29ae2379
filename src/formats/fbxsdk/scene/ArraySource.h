#pragma once

#include "fbxsdk/container/Arrays.h"

#include <span>
#include <string>
#include <variant>

namespace FbxFormat
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

/// An array that is to be decoded straight to where it stays.
struct VDecodeJob
{
	VArraySource m_Source;
	/// For messages.
	const char* m_pOwner = "";
	std::variant<VArrayNumbers<double>*, VArrayNumbers<std::int32_t>*> m_pNumbers;
	/// False, with no numbers, if the array is damaged or beyond the budget. One that the file does not have is sound.
	bool m_bSound = true;
};

/// Decodes them all, on two threads where that pays. What is not sound is told in the log category "FBXIO" with its
/// owner. Results and messages are as if it were done in their order.
void Decode(std::span<VDecodeJob> io_Jobs);

inline bool Decode(VDecodeJob i_Job)
{
	Decode(std::span(&i_Job, 1));
	return i_Job.m_bSound;
}

} // namespace FbxFormat
