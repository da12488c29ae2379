#include "RetargetSetupDocument/RoleNames.h"

#include <QChar>

namespace RetargetSetup
{

QByteArray RoleName(QByteArray i_Key)
{
	if (i_Key.endsWith("Role"))
		i_Key.chop(4);
	if (i_Key.size() > 2 && i_Key[0] == 'E' && QChar::isUpper(uint(uchar(i_Key[1]))))
		i_Key.remove(0, 1);
	return i_Key.left(1).toLower() + i_Key.mid(1);
}

QHash<int, QByteArray> RoleNames(const QMetaEnum& i_rRoles)
{
	QHash<int, QByteArray> names;
	for (int i = 0; i < i_rRoles.keyCount(); ++i)
		names.insert(i_rRoles.value(i), RoleName(i_rRoles.key(i)));
	return names;
}

} // namespace RetargetSetup
