#pragma once

#include "CoreGraphics/SelectionId.h"
#include "NVX/ISelectionItem.h"

#include <QMatrix4x4>
#include <QVector4D>

#include <cstddef>
#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

namespace OrlexGraphics
{

struct VPickFrustum;

struct VSelectionItemHash
{
	std::size_t operator()(const NVX::ISelectionItem& i_rItem) const;
};

/// Where the items of a frame are. Filled by a frame update, then only read, by both threads.
struct VItemPlaces
{
	/// Centre and radius.
	std::unordered_map<NVX::ISelectionItem, QVector4D, VSelectionItemHash> m_Bounds;
	std::unordered_map<NVX::ISelectionItem, QMatrix4x4, VSelectionItemHash> m_Matrices;
};

/// Gives the items of a frame the ids under which they are drawn for picking, and remembers where they are. Render
/// thread, but for SetSelection. Ids change from frame to frame: a selection is kept as items, never as ids.
class VSelectionRegistry
{
public:
	VSelectionRegistry();

	/// What the next Reset takes as selected and preselected. While the user interface thread waits.
	void SetSelection(
	    const std::vector<NVX::ISelectionItem>& i_rSelected, const std::vector<NVX::ISelectionItem>& i_rPreselected);

	/// A new frame: no items, no places, the next id is 1 again.
	void Reset();

	/// The item's first id; the same each time within a frame. Its ids are consecutive; more than the first are for
	/// items with children. 0 if there are no more ids, then the item cannot be picked.
	std::uint32_t Allocate(const NVX::ISelectionItem& i_rItem, std::uint32_t i_Count = 1);
	/// @param i_rName what the tool tip says
	std::uint32_t Allocate(const NVX::ISelectionItem& i_rItem, const std::string& i_rName);
	/// Allocates, and adds the flags.
	CoreGraphics::VSelectionId GetId(const NVX::ISelectionItem& i_rItem);

	/// The item that has this id, flags or not; of an item with children the one that the id is of, whose number is the
	/// element index. False for an id that nothing has.
	bool ResolveId(std::uint32_t i_Id, NVX::ISelectionItem& o_rItem) const;
	/// Empty if the item was given none.
	const std::string& GetName(std::uint32_t i_Id) const;

	/// @param i_rBound what a view that is to show the item has to show. A pick elsewhere does not draw the item,
	/// unless it has a pick bound.
	void SetItemBound(const NVX::ISelectionItem& i_rItem, const QVector4D& i_rBound);
	/// @param i_rBound encloses all that is drawn under the item's id, where that reaches beyond the item's bound.
	void SetPickBound(const NVX::ISelectionItem& i_rItem, const QVector4D& i_rBound)
	{
		m_PickBounds[i_rItem] = i_rBound;
	}
	void SetItemMatrix(const NVX::ISelectionItem& i_rItem, const QMatrix4x4& i_rMatrix);
	/// Null if the item has none in this frame.
	const QVector4D* GetItemBound(const NVX::ISelectionItem& i_rItem) const;
	const QMatrix4x4* GetItemMatrix(const NVX::ISelectionItem& i_rItem) const;
	/// Those of this frame. They do not change any more once the frame update has ended.
	std::shared_ptr<const VItemPlaces> GetPlaces() const { return m_pPlaces; }

	/// Whether something with this id is left out of what is drawn in a mode of VRenderContext: what is excluded when
	/// picking, what is neither selected nor preselected in the id frame.
	bool IsHidden(const CoreGraphics::VSelectionId& i_rId, std::uint32_t i_Mode) const;
	void ClearExcluded() { m_Excluded.assign(m_NextId, false); }
	void Exclude(std::uint32_t i_Id);

	/// Leaves out what lies outside of a pick rectangle, too.
	void ExcludeOutside(const VPickFrustum& i_rFrustum);

	/// Whether something that is drawn in the id frame is selected or preselected.
	bool HasFlagged() const { return !m_FlaggedIds.empty(); }
	/// What encloses all of that. False if something has no bound.
	bool GetFlaggedBounds(std::vector<QVector4D>& o_rBounds) const;

private:
	/// Null if the item has none.
	const QVector4D* FindPickBound(const NVX::ISelectionItem& i_rItem) const;

	std::map<std::uint32_t, NVX::ISelectionItem> m_Items;
	std::unordered_map<NVX::ISelectionItem, std::uint32_t, VSelectionItemHash> m_Ids;
	std::unordered_map<std::uint32_t, std::string> m_Names;
	std::shared_ptr<VItemPlaces> m_pPlaces;
	/// By item, of the selection that the frame was made with.
	std::unordered_map<NVX::ISelectionItem, std::uint32_t, VSelectionItemHash> m_Flags;
	std::vector<NVX::ISelectionItem> m_Selected;
	std::vector<NVX::ISelectionItem> m_Preselected;
	/// By id.
	std::vector<bool> m_Excluded;
	std::unordered_map<NVX::ISelectionItem, QVector4D, VSelectionItemHash> m_PickBounds;
	/// The bounds by id, once a pick has asked for them.
	std::vector<std::pair<std::uint32_t, QVector4D>> m_BoundsById;
	std::vector<std::uint32_t> m_FlaggedIds;
	std::uint32_t m_NextId = 1;
};

} // namespace OrlexGraphics
