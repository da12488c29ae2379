#include "RetargetSetupDocument/RetargetSetupSegmentModel.h"

#include "NVX/SelectionItemVariant.h"
#include "RetargetSetupDocument/RoleNames.h"
#include "RetargetSetupDocument/ShownText.h"

#include <QtQml>

using CoreOrlexTypes::VSubjectParametrised;

VRetargetSetupSegmentModel::VRetargetSetupSegmentModel(EFlavour i_Flavour, QObject* i_pParent)
    : QAbstractTableModel(i_pParent), m_pSubject(std::make_shared<const VSubjectParametrised>()), m_Flavour(i_Flavour)
{
	qRegisterMetaType<NVX::ISelectionItem>("NVX::ISelectionItem");
	static const int s_QmlType = qmlRegisterUncreatableType<VRetargetSetupSegmentModel>(
	    "TesselPluginRetargetSetup", 1, 0, "RetargetSetupSegmentModel", RetargetSetup::c_RolesOnlyReason);
	Q_UNUSED(s_QmlType)
}

void VRetargetSetupSegmentModel::SetSubject(std::shared_ptr<const VSubjectParametrised> i_pSubject)
{
	beginResetModel();
	m_pSubject = std::move(i_pSubject);
	endResetModel();
}

bool VRetargetSetupSegmentModel::HasJoint(int i_Row) const
{
	return i_Row >= 0 && i_Row < rowCount()
	    && m_pSubject->m_Segments[std::size_t(i_Row)].m_Joint.m_JointType != VSubjectParametrised::VJoint::EDummy;
}

int VRetargetSetupSegmentModel::rowCount(const QModelIndex& i_rParent) const
{
	return i_rParent.isValid() ? 0 : int(m_pSubject->m_Segments.size());
}

int VRetargetSetupSegmentModel::columnCount(const QModelIndex& i_rParent) const
{
	return i_rParent.isValid() ? 0 : 1;
}

QVariant VRetargetSetupSegmentModel::data(const QModelIndex& i_rIndex, int i_Role) const
{
	if (i_rIndex.row() < 0 || i_rIndex.row() >= rowCount())
		return {};
	switch (i_Role)
	{
	case Name: return RetargetSetup::ShownText(m_pSubject->m_Segments[std::size_t(i_rIndex.row())].m_Name);
	case SelectionItem:
		return QVariant::fromValue(NVX::ISelectionItem{
		    m_Flavour == EFlavour::ETarget ? NVX::ESelectionTargetSegment : NVX::ESelectionSourceSegment,
		    m_pSubject->m_SubjectId, std::uint32_t(i_rIndex.row()), {}});
	default: return {};
	}
}

QHash<int, QByteArray> VRetargetSetupSegmentModel::roleNames() const
{
	return RetargetSetup::RoleNames(QMetaEnum::fromType<ESegmentModelRoles>());
}

#include "moc_RetargetSetupSegmentModel.cpp"
