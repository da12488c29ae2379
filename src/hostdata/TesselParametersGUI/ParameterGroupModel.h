#pragma once

#include "NVX/Signal.h"
#include "TesselPluginInterface/IParameter.h"

#include <QAbstractListModel>

#include <memory>
#include <vector>

namespace TesselPluginInterface
{
class IParameterGroup;
class IParameterRegistry;
} // namespace TesselPluginInterface

namespace TesselParametersGUI
{

/// The parameters of a registered group, those of its children behind its own, as a list for generated controls.
/// It is empty until the group is registered and when the group has ended, and follows all changes of the parameters.
/// It owns no parameter.
class VParameterGroupModel : public QAbstractListModel
{
	Q_OBJECT

public:
	enum ERole
	{
		/// QString
		NameRole = Qt::UserRole + 1,
		DisplayRole,
		DescriptionRole,
		CategoryRole,
		/// bool, int, uint, double or QString; invalid for no value.
		ValueRole,
		ValueTextRole,
		HasValueRole,
		/// Empty for no default.
		DefaultTextRole,
		/// The enumerations of IParameter as int.
		PresentationHintRole,
		DataConversionHintRole,
		FileAccessRole,
		FileFilterRole,
		ValidatorRegExRole,
		/// bool
		HiddenRole,
		AdvancedRole,
		DynamicRole,
		/// As ValueRole; invalid for no limit.
		MinimumRole,
		MaximumRole,
		/// bool: only some values are permitted, even if there is none to choose now.
		EnumeratedRole,
		/// QStringList: the names as they are shown, and the texts of the values.
		EnumNamesRole,
		EnumTextsRole,
		/// -1 for a value that is not in the list.
		CurrentEnumIndexRole,
		/// "bool", "int", "double", "text" or "path".
		TypeRole
	};
	Q_ENUM(ERole)

	/// @param i_pDispatcher runs callbacks on the thread of this object.
	VParameterGroupModel(std::shared_ptr<TesselPluginInterface::IParameterRegistry> i_pRegistry,
	    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher, const QString& i_rPath,
	    const QString& i_rGroup, QObject* i_pParent = nullptr);
	~VParameterGroupModel() override;

	int rowCount(const QModelIndex& i_rParent = {}) const override;
	QVariant data(const QModelIndex& i_rIndex, int i_Role) const override;
	QHash<int, QByteArray> roleNames() const override;

	/// What a user typed.
	/// @return empty if it is taken, otherwise why it is refused; then nothing has changed.
	Q_INVOKABLE QString setValueText(int i_Row, const QString& i_rText);
	/// Takes the entry that stands at that place of the list as it was last told.
	Q_INVOKABLE bool setEnumIndex(int i_Row, int i_Index);
	Q_INVOKABLE void resetToDefault(int i_Row);

private:
	struct VRow
	{
		std::weak_ptr<TesselPluginInterface::IParameter> m_pParameter;
		/// By role.
		QHash<int, QVariant> m_Data;
		std::vector<TesselPluginInterface::VEnumEntry> m_Enumeration;
	};

	/// Builds the list again.
	void Fill();
	void AddRows(TesselPluginInterface::IParameterGroup& i_rGroup);
	void UpdateRow(std::size_t i_Row);
	static void Read(const TesselPluginInterface::IParameter& i_rParameter, VRow& o_rRow);
	/// Null outside the list, and if the parameter is gone.
	std::shared_ptr<TesselPluginInterface::IParameter> ParameterAt(int i_Row) const;
	void Disconnect();

	const std::shared_ptr<TesselPluginInterface::IParameterRegistry> m_pRegistry;
	const std::shared_ptr<TesselPluginInterface::IDispatcher> m_pDispatcher;
	const std::string m_Path;
	const std::string m_Group;
	std::vector<VRow> m_Rows;
	NVX::VConnection m_Registered;
	std::vector<NVX::VConnection> m_Connections;
};

} // namespace TesselParametersGUI
