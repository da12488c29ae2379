#include "RetargetSetupDocument/RetargetSetupTargetModel.h"

#include "NVX/SelectionItemVariant.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupDocument/RoleNames.h"
#include "RetargetSetupDocument/ShownText.h"

#include <QtQml>

#include <algorithm>

using CoreOrlexTypes::VSubjectParametrised;
using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;

namespace
{

QVariant TextOrNothing(const std::string* i_pText)
{
	return i_pText ? QVariant(RetargetSetup::ShownText(*i_pText)) : QVariant();
}

} // namespace

VRetargetSetupTargetModel::VRetargetSetupTargetModel(QObject* i_pParent)
    : QAbstractTableModel(i_pParent), m_pSubject(std::make_shared<const VSubjectParametrised>())
{
	qRegisterMetaType<NVX::ISelectionItem>("NVX::ISelectionItem");
	static const int s_QmlType = qmlRegisterUncreatableType<VRetargetSetupTargetModel>(
	    "TesselPluginRetargetSetup", 1, 0, "RetargetSetupTargetModel", RetargetSetup::c_RolesOnlyReason);
	Q_UNUSED(s_QmlType)
}

void VRetargetSetupTargetModel::SetSubject(std::shared_ptr<const VSubjectParametrised> i_pSubject)
{
	if (i_pSubject == m_pSubject || *i_pSubject == *m_pSubject)
		return;
	const int oldCount = rowCount();
	const int newCount = int(i_pSubject->m_Targets.size());
	if (newCount < oldCount)
		beginRemoveRows({}, newCount, oldCount - 1);
	else if (newCount > oldCount)
		beginInsertRows({}, oldCount, newCount - 1);
	m_pSubject = std::move(i_pSubject);
	if (newCount < oldCount)
		endRemoveRows();
	else if (newCount > oldCount)
		endInsertRows();
	const int kept = std::min(oldCount, newCount);
	if (kept > 0)
		emit dataChanged(index(0, 0), index(kept - 1, 0));
}

int VRetargetSetupTargetModel::rowCount(const QModelIndex& i_rParent) const
{
	return i_rParent.isValid() ? 0 : int(m_pSubject->m_Targets.size());
}

int VRetargetSetupTargetModel::columnCount(const QModelIndex& i_rParent) const
{
	return i_rParent.isValid() ? 0 : 1;
}

QVariant VRetargetSetupTargetModel::data(const QModelIndex& i_rIndex, int i_Role) const
{
	if (i_rIndex.row() < 0 || i_rIndex.row() >= rowCount())
		return {};
	const VTarget& rTarget = m_pSubject->m_Targets[std::size_t(i_rIndex.row())];
	const bool bPosition = rTarget.m_Type == VTarget::ELocalPointToWorldPoint;
	const bool bRotation = rTarget.m_Type == VTarget::ELocalRotationToWorldRotation;
	switch (i_Role)
	{
	case SourceSegment:
		return bPosition || bRotation ? TextOrNothing(RetargetSetup::SourceName(*m_pSubject, rTarget)) : QVariant();
	case TargetSegment: return TextOrNothing(RetargetSetup::TargetSegmentName(*m_pSubject, rTarget));
	case TargetType:
		return bPosition || bRotation ? QVariant(QString::fromStdString(RetargetSetup::TargetKindName(rTarget.m_Type)))
		                              : QVariant();
	case Weight: return rTarget.m_Weight;
	case SelectionItem:
		return QVariant::fromValue(
		    NVX::ISelectionItem{NVX::ESelectionTarget, m_pSubject->m_SubjectId, std::uint32_t(i_rIndex.row()), {}});
	default: return {};
	}
}

QHash<int, QByteArray> VRetargetSetupTargetModel::roleNames() const
{
	return RetargetSetup::RoleNames(QMetaEnum::fromType<ETargetModelRoles>());
}

#include "moc_RetargetSetupTargetModel.cpp"
