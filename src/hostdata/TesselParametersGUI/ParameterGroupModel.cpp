#include "TesselParametersGUI/ParameterGroupModel.h"

#include "TesselDataStore/StoredValue.h"
#include "TesselPluginInterface/IParameterGroup.h"
#include "TesselPluginInterface/IParameterRegistry.h"
#include "math/VisibleText.h"

#include <QPointer>
#include <QStringList>

#include <algorithm>

namespace TesselParametersGUI
{

using NVX::IO::EType;
using NVX::IO::VVariant;
using TesselPluginInterface::EValueKind;
using TesselPluginInterface::IParameter;
using TesselPluginInterface::IParameterGroup;
using TesselPluginInterface::VEnumEntry;

namespace
{

template <typename T>
QVariant ToQVariant(const VVariant& i_rValue)
{
	T value{};
	return TesselDataStore::FromVariant(i_rValue, value) ? QVariant::fromValue(value) : QVariant();
}

QVariant ToQVariant(const VVariant& i_rValue)
{
	if (i_rValue.IsEmpty())
		return {};
	switch (i_rValue.m_pSchema->m_Type)
	{
	case EType::EBool: return ToQVariant<bool>(i_rValue);
	case EType::EInt32: return ToQVariant<std::int32_t>(i_rValue);
	case EType::EUInt32: return ToQVariant<std::uint32_t>(i_rValue);
	case EType::EFloat64: return ToQVariant<double>(i_rValue);
	case EType::EString:
	{
		std::string text;
		return TesselDataStore::FromVariant(i_rValue, text) ? QVariant(QString::fromStdString(text)) : QVariant();
	}
	default: return {};
	}
}

QString TypeText(EValueKind i_Kind)
{
	switch (i_Kind)
	{
	case EValueKind::EBool: return "bool";
	case EValueKind::EInteger: return "int";
	case EValueKind::EReal: return "double";
	case EValueKind::EPath: return "path";
	case EValueKind::EText: break;
	}
	return "text";
}

} // namespace

VParameterGroupModel::VParameterGroupModel(std::shared_ptr<TesselPluginInterface::IParameterRegistry> i_pRegistry,
    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher, const QString& i_rPath, const QString& i_rGroup,
    QObject* i_pParent)
    : QAbstractListModel(i_pParent), m_pRegistry(std::move(i_pRegistry)), m_pDispatcher(std::move(i_pDispatcher)),
      m_Path(i_rPath.toStdString()), m_Group(i_rGroup.toStdString())
{
	m_Registered = m_pRegistry->RegisteredSignal().Connect(
	    [this](const std::string& i_rRegisteredPath, const std::string& i_rRegisteredGroup)
	    {
		    if (i_rRegisteredPath == m_Path && i_rRegisteredGroup == m_Group)
			    Fill();
	    });
	Fill();
}

VParameterGroupModel::~VParameterGroupModel()
{
	m_Registered.Disconnect();
	Disconnect();
}

int VParameterGroupModel::rowCount(const QModelIndex& i_rParent) const
{
	return i_rParent.isValid() ? 0 : int(m_Rows.size());
}

QVariant VParameterGroupModel::data(const QModelIndex& i_rIndex, int i_Role) const
{
	if (!checkIndex(i_rIndex, CheckIndexOption::IndexIsValid | CheckIndexOption::ParentIsInvalid))
		return {};
	return m_Rows[std::size_t(i_rIndex.row())].m_Data.value(i_Role == Qt::DisplayRole ? int(DisplayRole) : i_Role);
}

QHash<int, QByteArray> VParameterGroupModel::roleNames() const
{
	return {{NameRole, "name"}, {DisplayRole, "display"}, {DescriptionRole, "description"}, {CategoryRole, "category"},
	    {ValueRole, "value"}, {ValueTextRole, "valueText"}, {HasValueRole, "hasValue"},
	    {DefaultTextRole, "defaultText"}, {PresentationHintRole, "presentationHint"},
	    {DataConversionHintRole, "dataConversionHint"}, {FileAccessRole, "fileAccess"}, {FileFilterRole, "fileFilter"},
	    {ValidatorRegExRole, "validatorRegEx"}, {HiddenRole, "hidden"}, {AdvancedRole, "advanced"},
	    {DynamicRole, "dynamic"}, {MinimumRole, "minimum"}, {MaximumRole, "maximum"}, {EnumeratedRole, "enumerated"},
	    {EnumNamesRole, "enumNames"}, {EnumTextsRole, "enumTexts"}, {CurrentEnumIndexRole, "currentEnumIndex"},
	    {TypeRole, "type"}};
}

QString VParameterGroupModel::setValueText(int i_Row, const QString& i_rText)
{
	const std::shared_ptr<IParameter> pParameter = ParameterAt(i_Row);
	return pParameter ? QString::fromStdString(pParameter->SetValueText(i_rText.toStdString()))
	                  : QString("There is no such parameter any more");
}

bool VParameterGroupModel::setEnumIndex(int i_Row, int i_Index)
{
	const std::shared_ptr<IParameter> pParameter = ParameterAt(i_Row);
	if (!pParameter)
		return false;
	const std::vector<VEnumEntry>& rEntries = m_Rows[std::size_t(i_Row)].m_Enumeration;
	return i_Index >= 0 && std::size_t(i_Index) < rEntries.size()
	    && pParameter->SetValue(rEntries[std::size_t(i_Index)].m_Value);
}

void VParameterGroupModel::resetToDefault(int i_Row)
{
	if (const std::shared_ptr<IParameter> pParameter = ParameterAt(i_Row))
		pParameter->ResetToDefault();
}

void VParameterGroupModel::Fill()
{
	Disconnect();
	beginResetModel();
	m_Rows.clear();
	if (const std::shared_ptr<IParameterGroup> pGroup = m_pRegistry->Find(m_Path, m_Group))
		AddRows(*pGroup);
	endResetModel();
}

void VParameterGroupModel::AddRows(IParameterGroup& i_rGroup)
{
	const QPointer<VParameterGroupModel> pThis(this);
	const auto fillAgain = [pThis]
	{
		if (pThis)
			pThis->Fill();
	};
	m_Connections.push_back(i_rGroup.ChangedSignal().Connect(fillAgain));
	// The registry still finds the group while it ends.
	m_Connections.push_back(i_rGroup.EndingSignal().Connect(
	    [this]
	    {
		    Disconnect();
		    beginResetModel();
		    m_Rows.clear();
		    endResetModel();
	    }));
	for (const std::shared_ptr<IParameter>& rpParameter : i_rGroup.GetParameters())
	{
		const std::size_t row = m_Rows.size();
		const auto update = [pThis, row]
		{
			if (pThis)
				pThis->UpdateRow(row);
		};
		m_Connections.push_back(rpParameter->ConnectValue(update, m_pDispatcher));
		m_Connections.push_back(rpParameter->ConnectAttributes(update, m_pDispatcher));
		m_Rows.push_back({rpParameter, {}, {}});
		Read(*rpParameter, m_Rows.back());
	}
	for (const std::shared_ptr<IParameterGroup>& rpChild : i_rGroup.GetChildren())
		AddRows(*rpChild);
}

void VParameterGroupModel::UpdateRow(std::size_t i_Row)
{
	const std::shared_ptr<IParameter> pParameter = ParameterAt(int(i_Row));
	if (!pParameter)
		return;
	VRow& rRow = m_Rows[i_Row];
	const QHash<int, QVariant> before = rRow.m_Data;
	Read(*pParameter, rRow);
	QVector<int> changed;
	for (auto at = rRow.m_Data.cbegin(); at != rRow.m_Data.cend(); ++at)
		if (before.value(at.key()) != at.value())
			changed.push_back(at.key());
	if (changed.contains(DisplayRole))
		changed.push_back(Qt::DisplayRole);
	if (!changed.isEmpty())
		emit dataChanged(index(int(i_Row)), index(int(i_Row)), changed);
}

void VParameterGroupModel::Read(const IParameter& i_rParameter, VRow& o_rRow)
{
	const auto text = [](const std::string& i_rText) { return QString::fromStdString(i_rText); };
	const VVariant value = i_rParameter.GetValue();
	const std::uint32_t flags = i_rParameter.GetFlags();
	o_rRow.m_Enumeration = i_rParameter.GetEnumeration();
	QStringList names;
	QStringList texts;
	for (const VEnumEntry& rEntry : o_rRow.m_Enumeration)
	{
		names.push_back(text(VisibleText::Of(rEntry.m_Name)));
		texts.push_back(text(i_rParameter.ToText(rEntry.m_Value)));
	}
	const auto current = std::find_if(o_rRow.m_Enumeration.begin(), o_rRow.m_Enumeration.end(),
	    [&value](const VEnumEntry& i_rEntry) { return i_rEntry.m_Value == value; });

	o_rRow.m_Data = {{NameRole, text(i_rParameter.GetName())}, {DisplayRole, text(i_rParameter.GetDisplay())},
	    {DescriptionRole, text(i_rParameter.GetDescription())}, {CategoryRole, text(i_rParameter.GetCategory())},
	    {ValueRole, ToQVariant(value)}, {ValueTextRole, text(i_rParameter.ToText(value))},
	    {HasValueRole, i_rParameter.HasValue()},
	    {DefaultTextRole, text(i_rParameter.ToText(i_rParameter.GetDefault()))},
	    {PresentationHintRole, int(i_rParameter.GetPresentationHint())},
	    {DataConversionHintRole, int(i_rParameter.GetDataConversionHint())},
	    {FileAccessRole, int(i_rParameter.GetFileAccess())}, {FileFilterRole, text(i_rParameter.GetFileFilter())},
	    {ValidatorRegExRole, text(i_rParameter.GetValidatorRegEx())}, {HiddenRole, (flags & IParameter::EHidden) != 0},
	    {AdvancedRole, (flags & IParameter::EAdvanced) != 0}, {DynamicRole, (flags & IParameter::EDynamic) != 0},
	    {MinimumRole, ToQVariant(i_rParameter.GetMinimum())}, {MaximumRole, ToQVariant(i_rParameter.GetMaximum())},
	    {EnumeratedRole, i_rParameter.HasEnumeration()}, {EnumNamesRole, names}, {EnumTextsRole, texts},
	    {CurrentEnumIndexRole,
	        current == o_rRow.m_Enumeration.end() ? -1 : int(current - o_rRow.m_Enumeration.begin())},
	    {TypeRole, TypeText(i_rParameter.GetValueKind())}};
}

std::shared_ptr<IParameter> VParameterGroupModel::ParameterAt(int i_Row) const
{
	return i_Row >= 0 && std::size_t(i_Row) < m_Rows.size() ? m_Rows[std::size_t(i_Row)].m_pParameter.lock() : nullptr;
}

void VParameterGroupModel::Disconnect()
{
	for (NVX::VConnection& rConnection : m_Connections)
		rConnection.Disconnect();
	m_Connections.clear();
}

} // namespace TesselParametersGUI

#include "moc_ParameterGroupModel.cpp"
