#pragma once

#include <QStyledItemDelegate>
#include <QTreeView>

namespace StudioHost
{

/// For columns of names: those that are too long lose their middle, since names of one chain differ at their end.
class VNameColumn : public QStyledItemDelegate
{
public:
	using QStyledItemDelegate::QStyledItemDelegate;

protected:
	void initStyleOption(QStyleOptionViewItem* o_pOption, const QModelIndex& i_rIndex) const override
	{
		QStyledItemDelegate::initStyleOption(o_pOption, i_rIndex);
		o_pOption->textElideMode = Qt::ElideMiddle;
		o_pOption->features &= ~QStyleOptionViewItem::WrapText;
	}
};

/// For a column of sentences, in as many lines as they take: trees alone make every row a line high.
class VSentenceColumn : public QStyledItemDelegate
{
public:
	explicit VSentenceColumn(QTreeView& i_rTree) : QStyledItemDelegate(&i_rTree), m_rTree(i_rTree) {}

	QSize sizeHint(const QStyleOptionViewItem& i_rOption, const QModelIndex& i_rIndex) const override
	{
		QStyleOptionViewItem option = i_rOption;
		option.features |= QStyleOptionViewItem::WrapText;
		option.rect = {0, 0, m_rTree.columnWidth(i_rIndex.column()), QWIDGETSIZE_MAX};
		return QStyledItemDelegate::sizeHint(option, i_rIndex);
	}

private:
	QTreeView& m_rTree;
};

/// Pixels; no column of names is wider by itself.
constexpr int c_WidestNames = 220;

} // namespace StudioHost
