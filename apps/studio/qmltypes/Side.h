#pragma once

#include "SetupProposal/Side.h"

#include <QObject>
#include <QString>

namespace StudioHost
{

/// The singleton "Side" of "Orlex.Controls".
class VSide : public QObject
{
	Q_OBJECT

public:
	using QObject::QObject;

	/// "L", "R" or empty: the side that a name tells.
	Q_INVOKABLE static QString of(const QString& i_rName)
	{
		switch (SetupProposal::SideOfName(i_rName.toStdString()))
		{
		case SetupProposal::ESide::Left: return QStringLiteral("L");
		case SetupProposal::ESide::Right: return QStringLiteral("R");
		default: return {};
		}
	}
};

} // namespace StudioHost
