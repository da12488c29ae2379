#include "fbxsdk/sdk/Layer.h"

#include "fbxsdk/container/Values.h"

namespace
{

using namespace fbxsdk;

template <typename TEnum, std::size_t c_Count>
TEnum ReadMode(const FbxFormat::VArraySource& i_rRecord, const char* i_pName,
    const std::pair<std::string_view, TEnum> (&i_rModes)[c_Count])
{
	if (const FbxFormat::VElementIndex element = i_rRecord.Child(i_pName).m_Element; element != FbxFormat::c_NoElement)
		for (const auto& [name, mode] : i_rModes)
			if (FbxFormat::ValueAt(*i_rRecord.m_pTree, element, 0).m_Text == name)
				return mode;
	return TEnum();
}

constexpr std::pair<std::string_view, FbxLayerElement::EMappingMode> c_MappingModes[]{
    {"ByVertice", FbxLayerElement::eByControlPoint}, {"ByVertex", FbxLayerElement::eByControlPoint},
    {"ByControlPoint", FbxLayerElement::eByControlPoint}, {"ByPolygonVertex", FbxLayerElement::eByPolygonVertex},
    {"ByPolygon", FbxLayerElement::eByPolygon}, {"ByEdge", FbxLayerElement::eByEdge},
    {"AllSame", FbxLayerElement::eAllSame}};
constexpr std::pair<std::string_view, FbxLayerElement::EReferenceMode> c_ReferenceModes[]{
    {"Index", FbxLayerElement::eIndex}, {"IndexToDirect", FbxLayerElement::eIndexToDirect}};

} // namespace

fbxsdk::FbxLayerElement::FbxLayerElement(const FbxFormat::VArraySource& i_rRecord)
    : m_MappingMode(ReadMode(i_rRecord, "MappingInformationType", c_MappingModes)),
      m_ReferenceMode(ReadMode(i_rRecord, "ReferenceInformationType", c_ReferenceModes))
{
}
