#pragma once

#include <QDialog>

class QCheckBox;
class QComboBox;
class QGridLayout;
class QLineEdit;

namespace StudioHost
{

class VPreferences;

/// The preferences: a row for each kind of folder, one for each product whose folder the system cannot tell, how
/// characters are made, and what the Alt key does. Taken over by "OK" and "Apply".
class VPreferencesDialog : public QDialog
{
	Q_OBJECT

public:
	/// @param i_rPreferences must outlive the dialog.
	explicit VPreferencesDialog(VPreferences& i_rPreferences, QWidget* i_pParent = nullptr);

	void Apply();
	void accept() override;

private:
	struct VFolderRow
	{
		std::string m_Key;
		QLineEdit* m_pEdit;
	};

	QWidget* FolderPage(const char* i_pName, const QString& i_rIntroduction,
	    const std::vector<std::pair<std::string, QString>>& i_rKeys);
	void AddFolderRow(QGridLayout& io_rLayout, const std::string& i_rKey, const QString& i_rLabel);
	QWidget* CharactersPage();
	QWidget* NavigationPage();

	VPreferences& m_rPreferences;
	std::vector<VFolderRow> m_Folders;
	QCheckBox* m_pPoseFromFile = nullptr;
	QComboBox* m_pNavigationAlt = nullptr;
};

} // namespace StudioHost
