#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"

#include <QAbstractTableModel>

#include <memory>

/// The segments of one of the document's two subjects as a list with one column.
class VRetargetSetupSegmentModel : public QAbstractTableModel
{
	Q_OBJECT

public:
	enum ESegmentModelRoles
	{
		Name = Qt::UserRole + 1,
		SelectionItem
	};
	Q_ENUM(ESegmentModelRoles)

	enum class EFlavour : bool
	{
		ESource,
		ETarget
	};

	/// The flavour decides the kind of the selection items.
	explicit VRetargetSetupSegmentModel(EFlavour i_Flavour, QObject* i_pParent = nullptr);

	/// Shares the subject, which must not be null. Always resets the list.
	void SetSubject(std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> i_pSubject);

	/// The segment can move against the one above it. False outside the list.
	Q_INVOKABLE bool HasJoint(int i_Row) const;

	int rowCount(const QModelIndex& i_rParent = {}) const override;
	int columnCount(const QModelIndex& i_rParent = {}) const override;
	QVariant data(const QModelIndex& i_rIndex, int i_Role) const override;
	QHash<int, QByteArray> roleNames() const override;

private:
	std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> m_pSubject;
	const EFlavour m_Flavour;
};
