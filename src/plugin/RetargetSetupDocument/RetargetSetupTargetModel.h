#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"

#include <QAbstractTableModel>

#include <memory>

/// The targets of the document's target subject as a table, whose cells are reached by role.
class VRetargetSetupTargetModel : public QAbstractTableModel
{
	Q_OBJECT

public:
	enum ETargetModelRoles
	{
		SourceSegment = Qt::UserRole + 1,
		TargetSegment,
		TargetType,
		Weight,
		SelectionItem
	};
	Q_ENUM(ETargetModelRoles)

	explicit VRetargetSetupTargetModel(QObject* i_pParent = nullptr);

	/// Shares the subject, which must not be null. Keeps selection and scroll position of the views: nothing happens
	/// for an equal subject; otherwise rows go or come at the end and the ones before them change their data.
	void SetSubject(std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> i_pSubject);

	int rowCount(const QModelIndex& i_rParent = {}) const override;
	int columnCount(const QModelIndex& i_rParent = {}) const override;
	QVariant data(const QModelIndex& i_rIndex, int i_Role) const override;
	QHash<int, QByteArray> roleNames() const override;

private:
	std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> m_pSubject;
};
