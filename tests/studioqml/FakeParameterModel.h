#pragma once

#include <QAbstractListModel>

#include <functional>
#include <optional>
#include <vector>

/// One parameter, as the rows of a group model show it.
struct VFakeParameter
{
	QString m_Name = {};
	QString m_Type = "text";
	std::optional<QString> m_Value = {};
	QString m_Default = {};
	QString m_Category = {};
	QString m_Description = {};
	int m_PresentationHint = 0;
	int m_FileAccess = 0;
	QString m_FileFilter = {};
	bool m_bHidden = false;
	bool m_bAdvanced = false;
	std::optional<double> m_Minimum = {};
	std::optional<double> m_Maximum = {};
	/// Also where there is nothing to choose from.
	bool m_bEnumerated = false;
	QStringList m_EnumNames = {};
};

/// A group of parameters without a store behind it: takes and refuses texts as the store's model does, and counts.
class VFakeParameterModel : public QAbstractListModel
{
	Q_OBJECT

public:
	explicit VFakeParameterModel(std::vector<VFakeParameter> i_Parameters);

	int rowCount(const QModelIndex& i_rParent = {}) const override;
	QVariant data(const QModelIndex& i_rIndex, int i_Role) const override;
	QHash<int, QByteArray> roleNames() const override;

	Q_INVOKABLE QString setValueText(int i_Row, const QString& i_rText);
	Q_INVOKABLE bool setEnumIndex(int i_Row, int i_Index);
	Q_INVOKABLE void resetToDefault(int i_Row);

	/// As if it came from a file: no limit binds.
	void Bring(const QString& i_rName, const QString& i_rText);
	void Change(const QString& i_rName, const std::function<void(VFakeParameter&)>& i_rChange);
	/// What the parameter holds, its default if it holds nothing.
	QString Text(const QString& i_rName) const;

	int m_TakenCount = 0;
	int m_RefusedCount = 0;

private:
	int RowOf(const QString& i_rName) const;
	void Tell(int i_Row);

	std::vector<VFakeParameter> m_Parameters;
};
