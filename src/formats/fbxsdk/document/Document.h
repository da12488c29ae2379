#pragma once

#include "fbxsdk/container/ElementTree.h"
#include "fbxsdk/document/Text.h"

#include <cstdint>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

namespace FbxFormat
{

/// Position of an object in its document.
using VObjectIndex = std::uint32_t;
inline constexpr VObjectIndex c_NoObject = 0xFFFFFFFFu;
/// The scene itself, to which the top nodes are connected.
inline constexpr VObjectIndex c_SceneObject = 0xFFFFFFFEu;

struct VObject
{
	VElementIndex m_Element = c_NoElement;
	/// The kind of record: "Model", "NodeAttribute", "Geometry", "Deformer" ...
	std::string_view m_Kind;
	/// The name without its class, as it stands in the file.
	std::string_view m_Name;
	/// "LimbNode", "Mesh", "Skin" ...
	std::string_view m_SubKind;
};

struct VConnection
{
	VObjectIndex m_Child = c_NoObject;
	VObjectIndex m_Parent = c_NoObject;
	/// The property of the parent that the child is connected to; empty for a connection of objects.
	std::string_view m_Property;
};

/// What the records of a file say: its objects and how they are connected. Objects are known by number since version
/// 7, by their full name before. No choice of keys makes looking one up slow: names stand in a sorted list, numbers in
/// a hash of this process alone.
/// The tree must outlive it.
class VDocument
{
public:
	explicit VDocument(const VElementTree& i_rTree);

	const VElementTree& Tree() const { return m_rTree; }
	const std::vector<VObject>& Objects() const { return m_Objects; }

	/// In the order of the file; those whose ends are both known.
	const std::vector<VConnection>& Connections() const { return m_Connections; }

	/// The record with the global settings' properties, or c_NoElement.
	VElementIndex GlobalSettings() const;

	/// The record with the default properties of that kind of object, or c_NoElement. Files before version 7 have none.
	VElementIndex Template(std::string_view i_Kind) const;

	/// Of the text form: its texts have escapes.
	bool HasEscapes() const { return m_bEscapes; }

	/// Texts of this document, for the world outside; told in the log category "FBXIO" where they are cut.
	std::string Decoded(std::string_view i_Text) const;

	/// What of the document is missing, empty if nothing is.
	const std::string& Error() const { return m_Error; }

	/// Whether it has more objects than are read.
	bool IsBeyondLimit() const { return m_bBeyondLimit; }

	/// How many objects were left out because nothing could name them.
	std::size_t Nameless() const { return m_Nameless; }

private:
	void ReadObjects();
	void ReadConnections();
	VObjectIndex FindObject(const struct VValue& i_rKey) const;

	const VElementTree& m_rTree;
	bool m_bEscapes = false;
	std::string m_Error;
	bool m_bBeyondLimit = false;
	std::size_t m_Nameless = 0;
	std::vector<VObject> m_Objects;
	std::vector<VConnection> m_Connections;
	struct VNumberHash
	{
		std::size_t operator()(std::int64_t i_Number) const;
	};
	std::unordered_map<std::int64_t, VObjectIndex, VNumberHash> m_ByNumber;
	std::vector<std::pair<std::string_view, VObjectIndex>> m_ByName;
};

} // namespace FbxFormat
