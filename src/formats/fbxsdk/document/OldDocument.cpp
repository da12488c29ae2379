#include "fbxsdk/document/OldDocument.h"

#include "fbxsdk/Limits.h"
#include "fbxsdk/container/RecordWriter.h"
#include "fbxsdk/container/Values.h"

#include <algorithm>
#include <array>
#include <utility>

namespace
{

using namespace FbxFormat;

struct VChannel
{
	std::string_view m_Name;
	const char* m_pProperty;
	double m_Default;
};
constexpr VChannel c_Channels[]{{"T", "Lcl Translation", 0.0}, {"R", "Lcl Rotation", 0.0}, {"S", "Lcl Scaling", 1.0}};
constexpr std::string_view c_Axes[]{"X", "Y", "Z"};

constexpr std::pair<const char*, const char*> c_MaterialColours[]{{"Ambient", "AmbientColor"},
    {"Diffuse", "DiffuseColor"}, {"Specular", "SpecularColor"}, {"Emissive", "EmissiveColor"}};

class VOldDocument
{
public:
	explicit VOldDocument(const VElementTree& i_rTree) : m_rTree(i_rTree), m_Writer(i_rTree)
	{
		const std::size_t most = Limits::c_Objects;
		for (const VElementIndex child : m_rTree.Children(VElementTree::c_Root))
			if (m_rTree.Name(child) == "Model" && m_Models.size() <= most)
				m_Models.push_back(child);
		m_ByName = Names(m_Models);
		m_Posed = Names(PosedModels());
		m_LastId = std::int64_t(m_Models.size());
	}

	std::string Write()
	{
		std::vector<bool> isChild(m_Models.size());
		m_Writer.Open("Objects");
		for (std::size_t i = 0; i < m_Models.size(); ++i)
		{
			WriteModel(m_Models[i], IdOf(i));
			ForEachNamed(m_rTree.Find(m_Models[i], "Children"),
			    [&](std::size_t i_Child)
			    {
				    isChild[i_Child] = true;
				    m_Connections.emplace_back(IdOf(i_Child), IdOf(i));
			    });
		}
		m_Writer.Close();
		m_Writer.Open("Connections");
		for (std::size_t i = 0; i < m_Models.size(); ++i)
			if (!isChild[i])
				m_Writer.Add("Connect", {"OO", IdOf(i), std::int64_t(0)});
		for (const auto& [child, parent] : m_Connections)
			m_Writer.Add("Connect", {"OO", child, parent});
		m_Writer.Close();
		return m_Writer.Finish();
	}

private:
	using VNames = std::vector<std::pair<std::string_view, std::size_t>>;

	static std::int64_t IdOf(std::size_t i_Model) { return std::int64_t(i_Model) + 1; }

	std::string_view NameOf(VElementIndex i_Element) const { return ValueAt(m_rTree, i_Element, 0).m_Text; }

	/// The text of a child record; empty if it has none, or a number.
	std::string_view TextOf(VElementIndex i_Element, const char* i_pChild) const
	{
		const VElementIndex child = m_rTree.Find(i_Element, i_pChild);
		return child == c_NoElement ? std::string_view() : NameOf(child);
	}

	VNames Names(const std::vector<VElementIndex>& i_rModels) const
	{
		VNames names;
		for (std::size_t i = 0; i < i_rModels.size(); ++i)
			names.emplace_back(NameOf(i_rModels[i]), i);
		std::sort(names.begin(), names.end());
		return names;
	}

	static std::size_t Find(const VNames& i_rNames, std::string_view i_Name)
	{
		const auto found = std::lower_bound(i_rNames.begin(), i_rNames.end(), std::pair(i_Name, std::size_t(0)));
		return found != i_rNames.end() && found->first == i_Name ? found->second : std::string::npos;
	}

	/// Calls i_Visit(model) for each model that a value of the record names.
	template <typename TVisit>
	void ForEachNamed(VElementIndex i_Element, TVisit&& i_Visit) const
	{
		if (i_Element == c_NoElement)
			return;
		VValueCursor cursor(m_rTree, i_Element);
		for (VValue value = cursor.Next(); value.m_Kind != EValueKind::None; value = cursor.Next())
			if (const std::size_t model = Find(m_ByName, value.m_Text); model != std::string::npos)
				i_Visit(model);
	}

	/// The records of models in the take that counts.
	std::vector<VElementIndex> PosedModels()
	{
		const VElementIndex takes = m_rTree.Find(VElementTree::c_Root, "Takes");
		const std::string_view current = TextOf(takes, "Current");
		VElementIndex counts = c_NoElement;
		for (const VElementIndex take : m_rTree.Children(takes))
			if (m_rTree.Name(take) == "Take" && (counts == c_NoElement || NameOf(take) == current))
				counts = take;
		for (const VElementIndex model : m_rTree.Children(counts))
			if (m_rTree.Name(model) == "Model")
				m_PosedModels.push_back(model);
		return m_PosedModels;
	}

	VElementIndex Channel(VElementIndex i_Of, std::string_view i_Name) const
	{
		for (const VElementIndex child : m_rTree.Children(i_Of))
			if (m_rTree.Name(child) == "Channel" && NameOf(child) == i_Name)
				return child;
		return c_NoElement;
	}

	void WriteModel(VElementIndex i_Model, std::int64_t i_Id)
	{
		const bool bMesh = m_rTree.Find(i_Model, "Vertices") != c_NoElement;
		std::string_view kind = TextOf(i_Model, "Type");
		if (kind.empty())
			kind = bMesh ? "Mesh" : TextOf(i_Model, "TypeFlags") == "Skeleton" ? "LimbNode" : "Null";
		m_Writer.Open("Model", {i_Id, NameOf(i_Model), kind});
		WritePose(i_Model);
		if (bMesh)
			WriteMesh(i_Model);
		m_Writer.Close();
		std::int64_t skin = 0;
		for (const VElementIndex child : m_rTree.Children(i_Model))
			if (m_rTree.Name(child) == "Material")
				WriteMaterial(child, i_Id);
			else if (m_rTree.Name(child) == "Texture")
				WriteTexture(child, i_Id);
			else if (m_rTree.Name(child) == "Link")
				WriteLink(child, i_Id, skin);
	}

	void WritePose(VElementIndex i_Model)
	{
		VElementIndex transform = Channel(i_Model, "Transform");
		if (const std::size_t posed = Find(m_Posed, NameOf(i_Model));
		    transform == c_NoElement && posed != std::string::npos)
			transform = Channel(m_PosedModels[posed], "Transform");
		m_Writer.Open("Properties60");
		for (const VChannel& rChannel : c_Channels)
			if (const VElementIndex channel = Channel(transform, rChannel.m_Name); channel != c_NoElement)
			{
				std::array<double, 3> values;
				for (int axis = 0; axis < 3; ++axis)
				{
					const VElementIndex number = m_rTree.Find(Channel(channel, c_Axes[axis]), "Default");
					values[axis] = number == c_NoElement ? rChannel.m_Default
					                                     : ValueAt(m_rTree, number, 0).AsReal(rChannel.m_Default);
				}
				m_Writer.Add("Property", {rChannel.m_pProperty, "", "", values[0], values[1], values[2]});
			}
		m_Writer.Close();
	}

	void WriteMesh(VElementIndex i_Model)
	{
		const VElementIndex points = m_rTree.Find(i_Model, "Vertices");
		m_Writer.Copy("Vertices", points);
		m_Writer.Copy("PolygonVertexIndex", m_rTree.Find(i_Model, "PolygonVertexIndex"));
		if (const VElementIndex normals = m_rTree.Find(i_Model, "Normals"); normals != c_NoElement)
		{
			const bool bByPoint = m_rTree[normals].m_ValueCount == m_rTree[points].m_ValueCount;
			OpenLayer("LayerElementNormal", bByPoint ? "ByVertice" : "ByPolygonVertex", "Direct");
			m_Writer.Copy("Normals", normals);
			m_Writer.Close();
		}
		if (const VElementIndex uvs = m_rTree.Find(i_Model, "GeometryUVInfo"); uvs != c_NoElement)
		{
			const VElementIndex index = m_rTree.Find(uvs, "TextureUVVerticeIndex");
			const std::string_view mapping = TextOf(uvs, "MappingInformationType");
			OpenLayer("LayerElementUV", mapping == "ByPolygon" ? "ByPolygonVertex" : mapping,
			    index == c_NoElement ? "Direct" : "IndexToDirect");
			m_Writer.Copy("UV", m_rTree.Find(uvs, "TextureUV"));
			m_Writer.Copy("UVIndex", index);
			m_Writer.Close();
		}
		if (const VElementIndex materials = m_rTree.Find(i_Model, "Materials"); materials != c_NoElement)
		{
			OpenLayer("LayerElementMaterial", TextOf(i_Model, "MaterialAssignation"), "IndexToDirect");
			m_Writer.Copy("Materials", materials);
			m_Writer.Close();
		}
	}

	void OpenLayer(std::string_view i_Name, std::string_view i_Mapping, std::string_view i_Reference)
	{
		m_Writer.Open(i_Name, {std::int64_t(0)});
		m_Writer.Add("MappingInformationType", {i_Mapping});
		m_Writer.Add("ReferenceInformationType", {i_Reference});
	}

	/// An object of its own, connected to another one.
	std::int64_t OpenPart(
	    std::string_view i_Kind, std::string_view i_Name, std::string_view i_SubKind, std::int64_t i_Parent)
	{
		m_Writer.Open(i_Kind, {++m_LastId, i_Name, i_SubKind});
		m_Connections.emplace_back(m_LastId, i_Parent);
		return m_LastId;
	}

	void WriteMaterial(VElementIndex i_Material, std::int64_t i_Model)
	{
		OpenPart("Material", NameOf(i_Material), "", i_Model);
		const std::string_view shading = TextOf(i_Material, "ShadingModel");
		m_Writer.Add("ShadingModel", {shading.empty() ? "phong" : shading});
		m_Writer.Open("Properties60");
		const auto number = [&](const char* i_pName, int i_Place, double i_Default)
		{
			const VElementIndex record = m_rTree.Find(i_Material, i_pName);
			return record == c_NoElement ? i_Default : ValueAt(m_rTree, record, i_Place).AsReal(i_Default);
		};
		const auto addColour = [&](const char* i_pProperty, double i_Red, double i_Green, double i_Blue) {
			m_Writer.Add("Property", {i_pProperty, "", "", i_Red, i_Green, i_Blue});
		};
		for (const auto& [pName, pProperty] : c_MaterialColours)
			if (m_rTree.Find(i_Material, pName) != c_NoElement)
				addColour(pProperty, number(pName, 0, 0.0), number(pName, 1, 0.0), number(pName, 2, 0.0));
		if (m_rTree.Find(i_Material, "Shininess") != c_NoElement)
			m_Writer.Add("Property", {"ShininessExponent", "", "", number("Shininess", 0, 0.0)});
		if (const double clear = 1.0 - number("Alpha", 0, 1.0); clear > 0.0)
		{
			addColour("TransparentColor", clear, clear, clear);
			m_Writer.Add("Property", {"TransparencyFactor", "", "", 1.0});
		}
		m_Writer.Close();
		m_Writer.Close();
	}

	void WriteTexture(VElementIndex i_Texture, std::int64_t i_Model)
	{
		OpenPart("Texture", NameOf(i_Texture), "", i_Model);
		m_Writer.Copy("FileName", m_rTree.Find(i_Texture, "FileName"));
		m_Writer.Copy("RelativeFilename", m_rTree.Find(i_Texture, "RelativeFilename"));
		m_Writer.Close();
	}

	/// @param io_rSkin of the model's links, 0 before the first.
	void WriteLink(VElementIndex i_Link, std::int64_t i_Model, std::int64_t& io_rSkin)
	{
		if (io_rSkin == 0)
		{
			io_rSkin = OpenPart("Deformer", "", "Skin", i_Model);
			m_Writer.Close();
		}
		const std::int64_t cluster = OpenPart("Deformer", NameOf(i_Link), "Cluster", io_rSkin);
		for (const char* pArray : {"Indexes", "Weights", "Transform", "TransformLink"})
			m_Writer.Copy(pArray, m_rTree.Find(i_Link, pArray));
		m_Writer.Close();
		if (const std::size_t bone = Find(m_ByName, NameOf(i_Link)); bone != std::string::npos)
			m_Connections.emplace_back(IdOf(bone), cluster);
	}

	const VElementTree& m_rTree;
	VRecordWriter m_Writer;
	std::vector<VElementIndex> m_Models;
	std::vector<VElementIndex> m_PosedModels;
	/// Sorted, with the place in the lists above.
	VNames m_ByName;
	VNames m_Posed;
	std::vector<std::pair<std::int64_t, std::int64_t>> m_Connections;
	std::int64_t m_LastId = 0;
};

} // namespace

std::string FbxFormat::WithObjects(const VElementTree& i_rTree)
{
	return VOldDocument(i_rTree).Write();
}
