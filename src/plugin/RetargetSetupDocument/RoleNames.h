#pragma once

#include <QByteArray>
#include <QHash>
#include <QMetaEnum>

namespace RetargetSetup
{

/// The name by which QML knows a role, from its enumerator: without a trailing "Role", without the "E" before an upper
/// case letter, and with a small first letter.
QByteArray RoleName(QByteArray i_Key);

/// For an item model's roleNames.
QHash<int, QByteArray> RoleNames(const QMetaEnum& i_rRoles);

/// Why the models are known to QML although it cannot make them.
inline constexpr const char* c_RolesOnlyReason =
    "This type is only used to allow custom model role enums to be accessible from QML.";

} // namespace RetargetSetup
