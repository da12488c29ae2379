#include "fbxsdk/scene/MaterialReader.h"

#include "fbxsdk/document/Properties.h"

#include <algorithm>

namespace
{

using namespace FbxFormat;
using namespace fbxsdk;

using VColor = FbxPropertyT<FbxDouble3>;
using VNumber = FbxPropertyT<FbxDouble>;

template <typename TClass, typename TProperty>
struct VEntry
{
	std::string_view m_Name;
	/// The name that other exporters write; empty if there is none.
	std::string_view m_OtherName;
	TProperty TClass::*m_pMember;
};

constexpr VEntry<FbxSurfaceLambert, VColor> c_LambertColors[]{
    {"EmissiveColor", "Emissive", &FbxSurfaceLambert::Emissive},
    {"AmbientColor", "Ambient", &FbxSurfaceLambert::Ambient},
    {"DiffuseColor", "Diffuse", &FbxSurfaceLambert::Diffuse},
    {"TransparentColor", "Transparent", &FbxSurfaceLambert::TransparentColor},
};
constexpr VEntry<FbxSurfaceLambert, VNumber> c_LambertNumbers[]{
    {"EmissiveFactor", {}, &FbxSurfaceLambert::EmissiveFactor},
    {"AmbientFactor", {}, &FbxSurfaceLambert::AmbientFactor},
    {"DiffuseFactor", {}, &FbxSurfaceLambert::DiffuseFactor},
    {"TransparencyFactor", {}, &FbxSurfaceLambert::TransparencyFactor},
};
constexpr VEntry<FbxSurfacePhong, VColor> c_PhongColors[]{
    {"SpecularColor", "Specular", &FbxSurfacePhong::Specular},
    {"ReflectionColor", "Reflection", &FbxSurfacePhong::Reflection},
};
constexpr VEntry<FbxSurfacePhong, VNumber> c_PhongNumbers[]{
    {"SpecularFactor", {}, &FbxSurfacePhong::SpecularFactor},
    {"ShininessExponent", "Shininess", &FbxSurfacePhong::Shininess},
    {"ReflectionFactor", "Reflectivity", &FbxSurfacePhong::ReflectionFactor},
};

/// The color of a material that is neither, and its texture, the best first: without what stands before the last "|",
/// which tells the exporter and the group, without underscores, in small letters.
constexpr std::string_view c_BaseColors[]{"basecolor", "diffusecolor", "diffuse"};
constexpr std::string_view c_BaseColorTextures[]{
    "basecolormap", "basecolortexture", "basecolor", "texcolormap", "diffusecolor", "diffuse"};

template <std::size_t t_Count>
std::size_t PlaceOf(const std::string_view (&i_rNames)[t_Count], std::string_view i_Property)
{
	i_Property.remove_prefix(i_Property.rfind('|') + 1);
	std::string plain;
	for (const char character : i_Property.substr(0, 64))
		if (character != '_')
			plain += character >= 'A' && character <= 'Z' ? char(character + 32) : character;
	return std::size_t(std::find(std::begin(i_rNames), std::end(i_rNames), plain) - std::begin(i_rNames));
}

/// Calls i_Visit(entry, material of the entry's class) for each property that the material has.
template <typename TVisit>
void ForEachProperty(FbxSurfaceLambert& io_rMaterial, TVisit&& i_Visit)
{
	for (const auto& rEntry : c_LambertColors)
		i_Visit(rEntry, io_rMaterial);
	for (const auto& rEntry : c_LambertNumbers)
		i_Visit(rEntry, io_rMaterial);
	if (auto* const pPhong = FbxCast<FbxSurfacePhong>(&io_rMaterial))
	{
		for (const auto& rEntry : c_PhongColors)
			i_Visit(rEntry, *pPhong);
		for (const auto& rEntry : c_PhongNumbers)
			i_Visit(rEntry, *pPhong);
	}
}

void ReadNext(VValueCursor& io_rCursor, FbxDouble3& io_rValue)
{
	for (double& rComponent : io_rValue.mData)
		rComponent = io_rCursor.Next().AsReal(rComponent);
}

void ReadNext(VValueCursor& io_rCursor, FbxDouble& io_rValue)
{
	io_rValue = io_rCursor.Next().AsReal(io_rValue);
}

bool EqualInAnyCase(std::string_view i_Text, std::string_view i_Lower)
{
	return std::equal(i_Text.begin(), i_Text.end(), i_Lower.begin(), i_Lower.end(),
	    [](char i_A, char i_B) { return (i_A >= 'A' && i_A <= 'Z' ? char(i_A + 32) : i_A) == i_B; });
}

} // namespace

FbxFormat::VMaterialReader::VMaterialReader(const VDocument& i_rDocument)
    : m_rDocument(i_rDocument), m_Template(i_rDocument.Template("Material")),
      m_pDefaults(new FbxSurfacePhong(std::string()))
{
	ReadValues(m_Template, *m_pDefaults);
	VisitProperties(i_rDocument.Tree(), m_Template,
	    [this](std::string_view i_Name, const VValueCursor&)
	    {
		    ForEachProperty(*m_pDefaults,
		        [&](const auto& i_rEntry, const auto&)
		        {
			        if (i_Name == i_rEntry.m_Name)
				        m_InTemplate.insert(i_rEntry.m_Name);
		        });
	    });
}

std::string_view FbxFormat::VMaterialReader::ShadingModel(const VObject& i_rObject) const
{
	const VElementTree& rTree = m_rDocument.Tree();
	std::string_view model;
	if (const VElementIndex record = rTree.Find(i_rObject.m_Element, "ShadingModel"); record != c_NoElement)
		model = ValueAt(rTree, record, 0).m_Text;
	if (model.empty())
		VisitProperties(rTree, i_rObject.m_Element,
		    [&model](std::string_view i_Name, VValueCursor& io_rCursor)
		    {
			    if (i_Name == "ShadingModel")
				    model = io_rCursor.Next().m_Text;
		    });
	if (model.empty() && m_Template != c_NoElement)
		model = ValueAt(rTree, m_Template, 0).m_Text == "FbxSurfaceLambert" ? "lambert" : "phong";
	return model;
}

std::unique_ptr<fbxsdk::FbxSurfaceMaterial> FbxFormat::VMaterialReader::ReadMaterial(const VObject& i_rObject) const
{
	const std::string_view model = ShadingModel(i_rObject);
	std::string name = m_rDocument.Decoded(i_rObject.m_Name);
	std::unique_ptr<FbxSurfaceLambert> pMaterial;
	if (EqualInAnyCase(model, "phong"))
		pMaterial.reset(new FbxSurfacePhong(std::move(name)));
	else if (EqualInAnyCase(model, "lambert"))
		pMaterial.reset(new FbxSurfaceLambert(std::move(name)));
	else
	{
		std::unique_ptr<FbxSurfaceMaterial> pOther(new FbxSurfaceMaterial(std::move(name)));
		ReadBaseColor(i_rObject.m_Element, *pOther);
		return pOther;
	}
	ForEachProperty(*pMaterial,
	    [this](const auto& i_rEntry, auto& io_rOf)
	    { (io_rOf.*i_rEntry.m_pMember).m_Value = (*m_pDefaults.*i_rEntry.m_pMember).m_Value; });
	ReadValues(i_rObject.m_Element, *pMaterial);
	return pMaterial;
}

void FbxFormat::VMaterialReader::ReadBaseColor(
    VElementIndex i_Properties, fbxsdk::FbxSurfaceMaterial& io_rMaterial) const
{
	std::size_t best = std::size(c_BaseColors);
	VisitProperties(m_rDocument.Tree(), i_Properties,
	    [&](std::string_view i_Name, VValueCursor& io_rCursor)
	    {
		    const std::size_t place = PlaceOf(c_BaseColors, i_Name);
		    if (place >= best)
			    return;
		    best = place;
		    FbxDouble3 color(1.0, 1.0, 1.0);
		    ReadNext(io_rCursor, color);
		    io_rMaterial.m_pBaseColor = std::make_unique<VColor>(color);
	    });
}

void FbxFormat::VMaterialReader::ReadValues(VElementIndex i_Properties, FbxSurfaceLambert& io_rMaterial) const
{
	// The other names first, so that the SDK's name wins wherever it stands.
	for (const bool bOtherName : {true, false})
		VisitProperties(m_rDocument.Tree(), i_Properties,
		    [&io_rMaterial, bOtherName, this](std::string_view i_Name, VValueCursor& io_rCursor)
		    {
			    ForEachProperty(io_rMaterial,
			        [&](const auto& i_rEntry, auto& io_rOf)
			        {
				        if (i_Name == (bOtherName ? i_rEntry.m_OtherName : i_rEntry.m_Name) && !i_Name.empty()
				            && !(bOtherName && m_InTemplate.contains(i_rEntry.m_Name)))
					        ReadNext(io_rCursor, (io_rOf.*i_rEntry.m_pMember).m_Value);
			        });
		    });
}

std::string FbxFormat::VMaterialReader::Text(
    const VObject& i_rObject, std::initializer_list<std::string_view> i_Names) const
{
	const VElementTree& rTree = m_rDocument.Tree();
	for (const std::string_view name : i_Names)
		if (const VElementIndex record = rTree.Find(i_rObject.m_Element, name); record != c_NoElement)
			return m_rDocument.Decoded(ValueAt(rTree, record, 0).m_Text);
	return {};
}

std::unique_ptr<fbxsdk::FbxFileTexture> FbxFormat::VMaterialReader::ReadTexture(const VObject& i_rObject) const
{
	return std::unique_ptr<FbxFileTexture>(new FbxFileTexture(
	    m_rDocument.Decoded(i_rObject.m_Name), Text(i_rObject, {"FileName"}), Text(i_rObject, {"RelativeFilename"})));
}

std::unique_ptr<fbxsdk::FbxVideo> FbxFormat::VMaterialReader::ReadVideo(
    const VObject& i_rObject, const VArraySource& i_rContent) const
{
	return std::unique_ptr<FbxVideo>(
	    new FbxVideo(m_rDocument.Decoded(i_rObject.m_Name), Text(i_rObject, {"Filename", "FileName"}), i_rContent));
}

void FbxFormat::VMaterialReader::Connect(
    FbxFileTexture& i_rTexture, FbxSurfaceMaterial& io_rMaterial, std::string_view i_Property)
{
	auto* const pMaterial = FbxCast<FbxSurfaceLambert>(&io_rMaterial);
	if (!pMaterial)
	{
		if (PlaceOf(c_BaseColorTextures, i_Property) == std::size(c_BaseColorTextures))
			return;
		// It takes the place of the color.
		if (!io_rMaterial.m_pBaseColor || io_rMaterial.m_pBaseColor->m_Sources.empty())
			io_rMaterial.m_pBaseColor = std::make_unique<VColor>(FbxDouble3(1.0, 1.0, 1.0));
		io_rMaterial.m_pBaseColor->m_Sources.push_back(&i_rTexture);
		return;
	}
	ForEachProperty(*pMaterial,
	    [&](const auto& i_rEntry, auto& io_rOf)
	    {
		    if (i_Property == i_rEntry.m_Name || (!i_Property.empty() && i_Property == i_rEntry.m_OtherName))
			    (io_rOf.*i_rEntry.m_pMember).m_Sources.push_back(&i_rTexture);
	    });
}
