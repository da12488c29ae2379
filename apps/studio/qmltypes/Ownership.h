#pragma once

#include <QObject>

namespace StudioHost
{

/// The singleton "Ownership" of "Orlex.Controls".
class VOwnership : public QObject
{
	Q_OBJECT

public:
	using QObject::QObject;

	/// The object is deleted with its owner. For those that Qt makes and forgets: the handles of a split view.
	Q_INVOKABLE static void giveTo(QObject* i_pObject, QObject* i_pOwner)
	{
		if (i_pObject && !i_pObject->parent())
			i_pObject->setParent(i_pOwner);
	}
};

} // namespace StudioHost
