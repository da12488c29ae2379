#pragma once

#include "fbxsdk/document/Document.h"
#include "fbxsdk/sdk/Material.h"

#include <initializer_list>
#include <memory>
#include <set>

namespace FbxFormat
{

/// Makes materials and textures of their records. Of a material's value the first of these counts that the file has:
/// the property under the SDK's name, the template's value, the property under the name that other exporters write, the
/// default. Those other names are also those of what the SDK writes for old readers: a color times its factor.
class VMaterialReader
{
public:
	explicit VMaterialReader(const VDocument& i_rDocument);

	std::unique_ptr<fbxsdk::FbxSurfaceMaterial> ReadMaterial(const VObject& i_rObject) const;
	std::unique_ptr<fbxsdk::FbxFileTexture> ReadTexture(const VObject& i_rObject) const;
	std::unique_ptr<fbxsdk::FbxVideo> ReadVideo(const VObject& i_rObject, const VArraySource& i_rContent) const;

	/// Makes the texture a source of the property of that name, if the material has it.
	static void Connect(
	    fbxsdk::FbxFileTexture& i_rTexture, fbxsdk::FbxSurfaceMaterial& io_rMaterial, std::string_view i_Property);

private:
	std::string_view ShadingModel(const VObject& i_rObject) const;
	/// The text of the child record of the first of these names that there is.
	std::string Text(const VObject& i_rObject, std::initializer_list<std::string_view> i_Names) const;
	void ReadBaseColor(VElementIndex i_Properties, fbxsdk::FbxSurfaceMaterial& io_rMaterial) const;
	void ReadValues(VElementIndex i_Properties, fbxsdk::FbxSurfaceLambert& io_rMaterial) const;

	const VDocument& m_rDocument;
	VElementIndex m_Template;
	/// With the template's values, which are read once: they may be as many as the materials.
	std::unique_ptr<fbxsdk::FbxSurfacePhong> m_pDefaults;
	/// The SDK's names of what the template has.
	std::set<std::string_view> m_InTemplate;
};

} // namespace FbxFormat
