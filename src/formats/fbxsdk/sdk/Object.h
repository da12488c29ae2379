#pragma once

#include <string>

namespace FbxFormat
{
class VSceneBuilder;
}

namespace fbxsdk
{

class FbxObject
{
public:
	virtual ~FbxObject() = default;
	FbxObject(const FbxObject&) = delete;
	FbxObject& operator=(const FbxObject&) = delete;

	/// With its namespace, in UTF-8.
	const char* GetName() const { return m_Name.c_str(); }

protected:
	explicit FbxObject(std::string i_Name) : m_Name(std::move(i_Name)) {}

private:
	friend class FbxFormat::VSceneBuilder;

	std::string m_Name;
};

/// Null if the object is not of that class.
template <typename T>
T* FbxCast(FbxObject* pObject)
{
	return dynamic_cast<T*>(pObject);
}

} // namespace fbxsdk
