#pragma once

#include <QQuickItem>

/// An item, or one below it, by its objectName; null if there is none.
inline QQuickItem* FindItem(QQuickItem* i_pItem, const QString& i_rObjectName, bool i_bVisible = false)
{
	if (i_pItem->objectName() == i_rObjectName && (!i_bVisible || i_pItem->isVisible()))
		return i_pItem;
	for (QQuickItem* const pChild : i_pItem->childItems())
		if (QQuickItem* const pFound = FindItem(pChild, i_rObjectName, i_bVisible))
			return pFound;
	return nullptr;
}
