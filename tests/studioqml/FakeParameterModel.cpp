#include "FakeParameterModel.h"

#include "math/NumberText.h"

namespace
{

const char* const c_Roles[] = {"name", "display", "description", "category", "value", "valueText", "hasValue",
    "defaultText", "presentationHint", "fileAccess", "fileFilter", "hidden", "advanced", "minimum", "maximum",
    "enumerated", "enumNames", "enumTexts", "currentEnumIndex", "type"};

QVariant ValueOf(const VFakeParameter& i_rParameter, const QString& i_rText)
{
	if (i_rParameter.m_Type == "bool")
		return i_rText == "true";
	double number = 0;
	if (i_rParameter.m_Type != "text" && NumberText::ScanWholeReal(i_rText.toStdString(), number))
		return i_rParameter.m_Type == "int" ? QVariant(int(number)) : QVariant(number);
	return i_rText;
}

} // namespace

VFakeParameterModel::VFakeParameterModel(std::vector<VFakeParameter> i_Parameters)
    : m_Parameters(std::move(i_Parameters))
{
}

int VFakeParameterModel::rowCount(const QModelIndex& i_rParent) const
{
	return i_rParent.isValid() ? 0 : int(m_Parameters.size());
}

QHash<int, QByteArray> VFakeParameterModel::roleNames() const
{
	QHash<int, QByteArray> names;
	for (const char* pRole : c_Roles)
		names[Qt::UserRole + names.size()] = pRole;
	return names;
}

QVariant VFakeParameterModel::data(const QModelIndex& i_rIndex, int i_Role) const
{
	const VFakeParameter& rParameter = m_Parameters.at(std::size_t(i_rIndex.row()));
	const QByteArray role = roleNames().value(i_Role);
	const QString text = rParameter.m_Value.value_or(rParameter.m_Default);
	const auto number = [](const std::optional<double>& i_rNumber)
	{ return i_rNumber ? QVariant(*i_rNumber) : QVariant(); };
	const QHash<QByteArray, QVariant> values = {{"name", rParameter.m_Name}, {"display", rParameter.m_Name},
	    {"description", rParameter.m_Description}, {"category", rParameter.m_Category},
	    {"value", ValueOf(rParameter, text)}, {"valueText", text}, {"hasValue", !text.isEmpty()},
	    {"defaultText", rParameter.m_Default}, {"presentationHint", rParameter.m_PresentationHint},
	    {"fileAccess", rParameter.m_FileAccess}, {"fileFilter", rParameter.m_FileFilter},
	    {"hidden", rParameter.m_bHidden}, {"advanced", rParameter.m_bAdvanced},
	    {"minimum", number(rParameter.m_Minimum)}, {"maximum", number(rParameter.m_Maximum)},
	    {"enumerated", rParameter.m_bEnumerated || !rParameter.m_EnumNames.isEmpty()},
	    {"enumNames", rParameter.m_EnumNames}, {"enumTexts", rParameter.m_EnumNames},
	    {"currentEnumIndex", rParameter.m_EnumNames.indexOf(text)}, {"type", rParameter.m_Type}};
	return values.value(role);
}

QString VFakeParameterModel::setValueText(int i_Row, const QString& i_rText)
{
	VFakeParameter& rParameter = m_Parameters.at(std::size_t(i_Row));
	double number = 0;
	QString reason;
	if (rParameter.m_Type == "double" || rParameter.m_Type == "int")
	{
		if (!NumberText::ScanWholeReal(i_rText.toStdString(), number))
			reason = "\"" + i_rText + "\" is not a number";
		else if (rParameter.m_Minimum && number < *rParameter.m_Minimum)
			reason = "Value is less than permitted minimum";
		else if (rParameter.m_Maximum && number > *rParameter.m_Maximum)
			reason = "Value is greater than permitted maximum";
	}
	if (!reason.isEmpty())
	{
		++m_RefusedCount;
		return reason;
	}
	++m_TakenCount;
	rParameter.m_Value = i_rText;
	Tell(i_Row);
	return {};
}

bool VFakeParameterModel::setEnumIndex(int i_Row, int i_Index)
{
	VFakeParameter& rParameter = m_Parameters.at(std::size_t(i_Row));
	if (i_Index < 0 || i_Index >= rParameter.m_EnumNames.size())
		return false;
	++m_TakenCount;
	rParameter.m_Value = rParameter.m_EnumNames[i_Index];
	Tell(i_Row);
	return true;
}

void VFakeParameterModel::resetToDefault(int i_Row)
{
	VFakeParameter& rParameter = m_Parameters.at(std::size_t(i_Row));
	rParameter.m_Value.reset();
	if (!rParameter.m_Default.isEmpty())
		rParameter.m_Value = rParameter.m_Default;
	Tell(i_Row);
}

void VFakeParameterModel::Bring(const QString& i_rName, const QString& i_rText)
{
	Change(i_rName, [&i_rText](VFakeParameter& io_rParameter) { io_rParameter.m_Value = i_rText; });
}

void VFakeParameterModel::Change(const QString& i_rName, const std::function<void(VFakeParameter&)>& i_rChange)
{
	i_rChange(m_Parameters.at(std::size_t(RowOf(i_rName))));
	Tell(RowOf(i_rName));
}

QString VFakeParameterModel::Text(const QString& i_rName) const
{
	const VFakeParameter& rParameter = m_Parameters.at(std::size_t(RowOf(i_rName)));
	return rParameter.m_Value.value_or(rParameter.m_Default);
}

int VFakeParameterModel::RowOf(const QString& i_rName) const
{
	for (std::size_t row = 0; row < m_Parameters.size(); ++row)
		if (m_Parameters[row].m_Name == i_rName)
			return int(row);
	return -1;
}

void VFakeParameterModel::Tell(int i_Row)
{
	emit dataChanged(index(i_Row), index(i_Row));
}
