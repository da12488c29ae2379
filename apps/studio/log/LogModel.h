#pragma once

#include "NVX/Signal.h"

#include <QAbstractTableModel>
#include <QSortFilterProxyModel>
#include <QStringList>

#include <deque>
#include <memory>
#include <vector>

namespace StudioHost
{

/// The messages of the log as rows, the newest last; one that came a short while before is counted and not repeated.
/// Messages come from any thread; rows appear on the thread of the dispatcher, in the order in which they were logged
/// last.
class VLogModel : public QAbstractTableModel
{
	Q_OBJECT

public:
	enum EColumn
	{
		ELevel,
		ECategory,
		EText,
		EColumnCount
	};
	enum ERole
	{
		/// NVX::ELogLevel.
		ELevelRole = Qt::UserRole,
		/// The text with the line ends that it came with.
		EWholeTextRole
	};

	/// @param i_MaximumRows the oldest rows go when there are more.
	VLogModel(std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher, int i_MaximumRows = 5000);
	~VLogModel() override;

	int rowCount(const QModelIndex& i_rParent = {}) const override;
	int columnCount(const QModelIndex& i_rParent = {}) const override;
	QVariant data(const QModelIndex& i_rIndex, int i_Role = Qt::DisplayRole) const override;
	QVariant headerData(int i_Section, Qt::Orientation i_Orientation, int i_Role = Qt::DisplayRole) const override;

	void Clear();

	/// Every category that a message has had so far, sorted.
	const QStringList& Categories() const { return m_Categories; }

signals:
	void categoriesChanged();

private:
	struct VEntry
	{
		int m_Level;
		QString m_Category;
		QString m_Text;
		int m_Count = 1;

		bool IsSame(const VEntry& i_rOther) const
		{
			return m_Level == i_rOther.m_Level && m_Text == i_rOther.m_Text && m_Category == i_rOther.m_Category;
		}
	};
	struct VInbox;

	void TakeInbox();
	/// Those that came before are taken out of their places and counted.
	std::vector<VEntry> Counted(std::deque<VEntry> i_Entries);

	const int m_MaximumRows;
	std::deque<VEntry> m_Entries;
	QStringList m_Categories;
	const std::shared_ptr<VInbox> m_pInbox;
	std::shared_ptr<void> m_pSink;
};

/// The rows of a log up to a level, of one category or all, that hold a text in any column.
class VLogFilter : public QSortFilterProxyModel
{
	Q_OBJECT

public:
	explicit VLogFilter(QObject* i_pParent = nullptr) : QSortFilterProxyModel(i_pParent) {}

	void SetMaximumLevel(int i_Level);
	/// Empty for all.
	void SetCategory(const QString& i_rCategory);
	/// Upper and lower case are the same.
	void SetText(const QString& i_rText);

protected:
	bool filterAcceptsRow(int i_Row, const QModelIndex& i_rParent) const override;

private:
	int m_MaximumLevel = 6;
	QString m_Category;
	QString m_Text;
};

} // namespace StudioHost
