#pragma once

#include "fbxsdk/scene/VideoContent.h"
#include "fbxsdk/sdk/AffineMatrix.h"
#include "fbxsdk/sdk/Property.h"

#include <memory>

namespace FbxFormat
{
class VSceneBuilder;
}

namespace fbxsdk
{

/// A material of whichever shading model; those that are known are of the classes below.
class FbxSurfaceMaterial : public FbxObject
{
public:
	/// Of one that is of none of these classes, under the names that exporters give it, with its textures as sources;
	/// white if they alone are there. Null if the file names none. The SDK finds such a property by its name alone.
	const FbxPropertyT<FbxDouble3>* GetBaseColor() const { return m_pBaseColor.get(); }

protected:
	friend class FbxFormat::VMaterialReader;
	using FbxObject::FbxObject;

private:
	std::unique_ptr<FbxPropertyT<FbxDouble3>> m_pBaseColor;
};

/// Values start as the SDK has them for a file that does not tell.
class FbxSurfaceLambert : public FbxSurfaceMaterial
{
public:
	FbxPropertyT<FbxDouble3> Emissive{FbxDouble3(0.0, 0.0, 0.0)};
	FbxPropertyT<FbxDouble> EmissiveFactor{1.0};
	FbxPropertyT<FbxDouble3> Ambient{FbxDouble3(0.2, 0.2, 0.2)};
	FbxPropertyT<FbxDouble> AmbientFactor{1.0};
	FbxPropertyT<FbxDouble3> Diffuse{FbxDouble3(0.8, 0.8, 0.8)};
	FbxPropertyT<FbxDouble> DiffuseFactor{1.0};
	FbxPropertyT<FbxDouble3> TransparentColor{FbxDouble3(0.0, 0.0, 0.0)};
	FbxPropertyT<FbxDouble> TransparencyFactor{0.0};

protected:
	friend class FbxFormat::VMaterialReader;
	using FbxSurfaceMaterial::FbxSurfaceMaterial;
};

class FbxSurfacePhong : public FbxSurfaceLambert
{
public:
	FbxPropertyT<FbxDouble3> Specular{FbxDouble3(0.2, 0.2, 0.2)};
	FbxPropertyT<FbxDouble> SpecularFactor{1.0};
	FbxPropertyT<FbxDouble> Shininess{20.0};
	FbxPropertyT<FbxDouble3> Reflection{FbxDouble3(0.0, 0.0, 0.0)};
	FbxPropertyT<FbxDouble> ReflectionFactor{1.0};

private:
	friend class FbxFormat::VMaterialReader;
	using FbxSurfaceLambert::FbxSurfaceLambert;
};

class FbxVideo : public FbxObject
{
public:
	/// As the file has it, in UTF-8; may be empty.
	const char* GetFileName() const { return m_FileName.c_str(); }

private:
	friend class FbxFileTexture;
	friend class FbxFormat::VMaterialReader;
	friend class FbxFormat::VSceneBuilder;

	FbxVideo(std::string i_Name, std::string i_FileName, const FbxFormat::VArraySource& i_rContent)
	    : FbxObject(std::move(i_Name)), m_FileName(std::move(i_FileName)), m_Content(i_rContent),
	      m_bContent(FbxFormat::HasContent(i_rContent))
	{
	}

	std::string m_FileName;
	FbxFormat::VArraySource m_Content;
	bool m_bContent;
};

class FbxFileTexture : public FbxObject
{
public:
	/// As the file has them, in UTF-8: either may be empty, and either kind of separator may stand in them.
	const char* GetFileName() const { return m_FileName.c_str(); }
	const char* GetRelativeFileName() const { return m_RelativeFileName.c_str(); }

	/// The file of the video that the texture shows, read anew at each call; empty if the FBX file does not hold it.
	/// The SDK writes such a file beside the FBX file instead, and gives it as the file name.
	std::string GetEmbeddedContent() const
	{
		return m_pVideo ? FbxFormat::ReadContent(m_pVideo->m_Content) : std::string();
	}

private:
	friend class FbxFormat::VMaterialReader;
	friend class FbxFormat::VSceneBuilder;

	FbxFileTexture(std::string i_Name, std::string i_FileName, std::string i_RelativeFileName)
	    : FbxObject(std::move(i_Name)), m_FileName(std::move(i_FileName)),
	      m_RelativeFileName(std::move(i_RelativeFileName))
	{
	}

	std::string m_FileName;
	std::string m_RelativeFileName;
	const FbxVideo* m_pVideo = nullptr;
};

} // namespace fbxsdk
