#pragma once

#include <QWidget>

class QComboBox;
class QTableView;

namespace StudioHost
{

class VLogFilter;
class VLogModel;

/// The log as a list with filters. Follows the newest message unless the user has scrolled away from it.
class VLogPanel : public QWidget
{
	Q_OBJECT

public:
	/// @param i_rModel must outlive the panel.
	explicit VLogPanel(VLogModel& i_rModel, QWidget* i_pParent = nullptr);

	/// The selected rows, or all that are shown if none is, one message a line as "level category: text".
	QString TextToCopy() const;

	/// Puts TextToCopy on the clipboard.
	void Copy() const;

	/// By how many pixels the panel is too low to show so many messages at once; below 0 if it is higher.
	int HeightMissingTo(int i_Messages) const;

signals:
	/// The operator looks at this message, as a whole.
	void messageClicked(const QString& i_rText);

private:
	void UpdateCategories();

	VLogModel& m_rModel;
	VLogFilter* m_pFilter;
	QTableView* m_pTable;
	QComboBox* m_pCategories;
	bool m_bFollow = true;
};

} // namespace StudioHost
