#pragma once

#include <string>

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
	std::string m_Name;
};

} // namespace fbxsdk
