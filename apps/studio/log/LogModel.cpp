#include "studio/log/LogModel.h"

#include "CommandLineText/Messages.h"
#include "DebugServices/GlobalLog.h"
#include "studio/window/PlainTexts.h"

#include <QColor>

#include <algorithm>
#include <cstddef>
#include <mutex>

namespace StudioHost
{
namespace
{

/// Among so many of the newest messages one is looked for that says the same.
constexpr std::ptrdiff_t c_Remembered = 100;

/// The end if there is none.
template <typename TEntries, typename TEntry>
auto FindLatest(TEntries& i_rEntries, const TEntry& i_rEntry)
{
	const auto first = i_rEntries.end() - std::min(c_Remembered, std::ptrdiff_t(i_rEntries.size()));
	return std::find_if(
	    first, i_rEntries.end(), [&i_rEntry](const TEntry& i_rOther) { return i_rOther.IsSame(i_rEntry); });
}

} // namespace

/// What was logged and has no row yet. The sink may still run on another thread while the model ends.
struct VLogModel::VInbox
{
	std::mutex m_Mutex;
	std::deque<VEntry> m_Entries;
	bool m_bPosted = false;
	/// Null when the model has ended. Only read on the model's thread.
	VLogModel* m_pModel = nullptr;
};

VLogModel::VLogModel(std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher, int i_MaximumRows)
    : m_MaximumRows(i_MaximumRows), m_pInbox(std::make_shared<VInbox>())
{
	m_pInbox->m_pModel = this;
	m_pSink = NVX::GlobalLog::AddSink(
	    [pInbox = m_pInbox, pDispatcher = std::move(i_pDispatcher), i_MaximumRows](
	        const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage)
	    {
		    {
			    const std::lock_guard lock(pInbox->m_Mutex);
			    pInbox->m_Entries.push_back(
			        {i_Level, QString::fromStdString(i_rCategory.Name()), QString::fromStdString(i_rMessage)});
			    if (pInbox->m_Entries.size() > std::size_t(i_MaximumRows))
				    pInbox->m_Entries.pop_front();
			    if (std::exchange(pInbox->m_bPosted, true))
				    return;
		    }
		    pDispatcher->Post(
		        [pInbox]
		        {
			        if (pInbox->m_pModel)
				        pInbox->m_pModel->TakeInbox();
		        });
	    });
}

VLogModel::~VLogModel()
{
	m_pSink.reset();
	m_pInbox->m_pModel = nullptr;
}

void VLogModel::TakeInbox()
{
	std::deque<VEntry> inbox;
	{
		const std::lock_guard lock(m_pInbox->m_Mutex);
		inbox.swap(m_pInbox->m_Entries);
		m_pInbox->m_bPosted = false;
	}
	if (inbox.empty())
		return;
	std::vector<VEntry> entries = Counted(std::move(inbox));
	// A few at a time go from the front, so that a full list does not move for every message.
	const int size = int(m_Entries.size() + entries.size());
	if (size > m_MaximumRows)
	{
		const int count = std::min(int(m_Entries.size()), size - m_MaximumRows + m_MaximumRows / 10);
		if (count > 0)
		{
			beginRemoveRows({}, 0, count - 1);
			m_Entries.erase(m_Entries.begin(), m_Entries.begin() + count);
			endRemoveRows();
		}
	}
	bool bNewCategory = false;
	for (const VEntry& rEntry : entries)
	{
		const auto at = std::lower_bound(m_Categories.begin(), m_Categories.end(), rEntry.m_Category);
		if (at != m_Categories.end() && *at == rEntry.m_Category)
			continue;
		m_Categories.insert(at, rEntry.m_Category);
		bNewCategory = true;
	}
	beginInsertRows({}, int(m_Entries.size()), int(m_Entries.size() + entries.size()) - 1);
	std::move(entries.begin(), entries.end(), std::back_inserter(m_Entries));
	endInsertRows();
	if (bNewCategory)
		emit categoriesChanged();
}

std::vector<VLogModel::VEntry> VLogModel::Counted(std::deque<VEntry> i_Entries)
{
	std::vector<VEntry> counted;
	counted.reserve(i_Entries.size());
	for (VEntry& rEntry : i_Entries)
	{
		if (const auto found = FindLatest(counted, rEntry); found != counted.end())
		{
			rEntry.m_Count += found->m_Count;
			counted.erase(found);
		}
		counted.push_back(std::move(rEntry));
	}
	for (VEntry& rEntry : counted)
	{
		const auto found = FindLatest(m_Entries, rEntry);
		if (found == m_Entries.end())
			continue;
		rEntry.m_Count += found->m_Count;
		const int row = int(found - m_Entries.begin());
		beginRemoveRows({}, row, row);
		m_Entries.erase(found);
		endRemoveRows();
	}
	return counted;
}

void VLogModel::Clear()
{
	TakeInbox();
	beginResetModel();
	m_Entries.clear();
	endResetModel();
}

int VLogModel::rowCount(const QModelIndex& i_rParent) const
{
	return i_rParent.isValid() ? 0 : int(m_Entries.size());
}

int VLogModel::columnCount(const QModelIndex& i_rParent) const
{
	return i_rParent.isValid() ? 0 : EColumnCount;
}

QVariant VLogModel::data(const QModelIndex& i_rIndex, int i_Role) const
{
	if (!i_rIndex.isValid())
		return {};
	const VEntry& rEntry = m_Entries[std::size_t(i_rIndex.row())];
	switch (i_Role)
	{
	case Qt::DisplayRole:
		switch (i_rIndex.column())
		{
		case ELevel: return QString::fromLatin1(CommandLine::LevelName(rEntry.m_Level));
		case ECategory: return rEntry.m_Category;
		default:
		{
			const QString text = QString::fromStdString(CommandLine::OneLine(rEntry.m_Text.toStdString()));
			return rEntry.m_Count == 1 ? text : tr("%1 (%2 times)").arg(text).arg(rEntry.m_Count);
		}
		}
	case Qt::ToolTipRole: return i_rIndex.column() == EText ? PlainToolTip(rEntry.m_Text) : QVariant();
	case Qt::ForegroundRole:
		if (rEntry.m_Level <= NVX::ELogError)
			return QColor(0xf0625a);
		return rEntry.m_Level <= NVX::ELogWarning ? QColor(0xe0ad4b) : QVariant();
	case ELevelRole: return rEntry.m_Level;
	case EWholeTextRole: return rEntry.m_Text;
	default: return {};
	}
}

QVariant VLogModel::headerData(int i_Section, Qt::Orientation i_Orientation, int i_Role) const
{
	if (i_Orientation != Qt::Horizontal || i_Role != Qt::DisplayRole)
		return {};
	switch (i_Section)
	{
	case ELevel: return tr("Level");
	case ECategory: return tr("Category");
	case EText: return tr("Text");
	default: return {};
	}
}

void VLogFilter::SetMaximumLevel(int i_Level)
{
	m_MaximumLevel = i_Level;
	invalidateFilter();
}

void VLogFilter::SetCategory(const QString& i_rCategory)
{
	m_Category = i_rCategory;
	invalidateFilter();
}

void VLogFilter::SetText(const QString& i_rText)
{
	m_Text = i_rText;
	invalidateFilter();
}

bool VLogFilter::filterAcceptsRow(int i_Row, const QModelIndex& i_rParent) const
{
	const auto text = [&](int i_Column) { return sourceModel()->index(i_Row, i_Column, i_rParent).data().toString(); };
	if (sourceModel()->index(i_Row, 0, i_rParent).data(VLogModel::ELevelRole).toInt() > m_MaximumLevel)
		return false;
	const QString category = text(VLogModel::ECategory);
	if (!m_Category.isEmpty() && category != m_Category)
		return false;
	return m_Text.isEmpty() || category.contains(m_Text, Qt::CaseInsensitive)
	    || text(VLogModel::ELevel).contains(m_Text, Qt::CaseInsensitive)
	    || text(VLogModel::EText).contains(m_Text, Qt::CaseInsensitive);
}

} // namespace StudioHost

#include "moc_LogModel.cpp"
