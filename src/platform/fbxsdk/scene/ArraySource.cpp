#include "fbxsdk/scene/ArraySource.h"

#include "DebugServices/GlobalLog.h"

template <typename T>
bool FbxFile::Decode(const VArraySource& i_rSource, const char* i_pOwner, std::vector<T>& o_rNumbers)
{
	o_rNumbers.clear();
	if (i_rSource.m_Element == c_NoElement)
		return true;
	if (ReadArray(*i_rSource.m_pTree, i_rSource.m_Element, *i_rSource.m_pBudget, o_rNumbers))
		return true;
	NVX_LOG("FBXIO", NVX::ELogWarning, "Array %1% of %2% left out because it is damaged or too large",
	    i_rSource.m_pTree->Name(i_rSource.m_Element), i_pOwner);
	return false;
}

template bool FbxFile::Decode(const VArraySource&, const char*, std::vector<double>&);
template bool FbxFile::Decode(const VArraySource&, const char*, std::vector<std::int32_t>&);
