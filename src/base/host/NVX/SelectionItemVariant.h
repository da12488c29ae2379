#pragma once

#include "NVX/ISelectionItem.h"

#include <QMetaType>

/// For those who hand selection items to QML.
Q_DECLARE_METATYPE(NVX::ISelectionItem)
