#pragma once

#include "fbxsdk/container/ElementTree.h"
#include "fbxsdk/container/Values.h"

namespace FbxFormat
{

/// Calls i_Visit(name, cursor at the first value) for each property of an object, of a template or of the global
/// settings, in the order of the file. Nothing for c_NoElement.
template <typename TVisit>
void VisitProperties(const VElementTree& i_rTree, VElementIndex i_Object, TVisit&& i_Visit)
{
	for (const VElementIndex list : i_rTree.Children(i_Object))
	{
		const std::string_view listName = i_rTree.Name(list);
		if (listName != "Properties70" && listName != "Properties60")
			continue;
		for (const VElementIndex property : i_rTree.Children(list))
		{
			VValueCursor cursor(i_rTree, property);
			const std::string_view name = cursor.Next().m_Text;
			// Before the values stand type and flags; between the two, since version 7, a label.
			cursor.Skip(i_rTree.Name(property) == "P" ? 3 : 2);
			i_Visit(name, cursor);
		}
	}
}

} // namespace FbxFormat
