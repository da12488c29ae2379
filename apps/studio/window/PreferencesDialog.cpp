#include "studio/window/PreferencesDialog.h"

#include "TesselPluginInterface/PathTypes.h"
#include "UtilsFileSystem/InstalledProducts.h"
#include "UtilsFileSystem/Paths.h"
#include "studio/host/ApplicationObject.h"
#include "studio/host/Preferences.h"
#include "studio/window/Named.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDialogButtonBox>
#include <QFileDialog>
#include <QFileInfo>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTabWidget>
#include <QToolButton>
#include <QVBoxLayout>

#include <algorithm>

namespace StudioHost
{
namespace
{

/// What this panel works with: the first of EPathTypes, takes and presets.
constexpr std::size_t c_FoldersFirst = 6;

constexpr const char* c_pProducts[] = {"Orlex Rally", "Orlex Stage"};

/// In the order of EPathTypes.
const std::array<QString, TesselPluginInterface::EPathTypeCount>& FolderLabels()
{
	static const std::array<QString, TesselPluginInterface::EPathTypeCount> s_Labels = {
	    VPreferencesDialog::tr("Subjects (skeletons of performers)"),
	    VPreferencesDialog::tr("Templates of subject calibration"), VPreferencesDialog::tr("Skins (FBX characters)"),
	    VPreferencesDialog::tr("Retarget subjects"), VPreferencesDialog::tr("Remarkable actions"),
	    VPreferencesDialog::tr("Props"), VPreferencesDialog::tr("Clusters"), VPreferencesDialog::tr("Objects"),
	    VPreferencesDialog::tr("Templates of smart objects"), VPreferencesDialog::tr("Meshes of props"),
	    VPreferencesDialog::tr("Calibration objects")};
	return s_Labels;
}

} // namespace

VPreferencesDialog::VPreferencesDialog(VPreferences& i_rPreferences, QWidget* i_pParent)
    : QDialog(i_pParent), m_rPreferences(i_rPreferences)
{
	Named(this, "Preferences", tr("Preferences"));
	setWindowTitle(tr("Preferences"));

	std::vector<std::pair<std::string, QString>> folders, products;
	for (std::size_t i = 0; i < TesselPluginInterface::c_FolderKeys.size(); ++i)
	{
		if (folders.size() == c_FoldersFirst - 2)
		{
			folders.emplace_back(c_pTakesFolderKey, tr("Takes (recorded motion of performers)"));
			folders.emplace_back(c_pPresetsFolderKey, tr("Presets (pairs for several characters)"));
		}
		folders.emplace_back(TesselPluginInterface::c_FolderKeys[i], FolderLabels()[i]);
	}
	for (const char* pProduct : c_pProducts)
		products.emplace_back(UtilsFileSystem::ProductFolderKey(pProduct), QLatin1String(pProduct));

	auto* const pPages = Named(new QTabWidget, "PreferencesPages", tr("Pages of preferences"));
	pPages->addTab(
	    FolderPage("FoldersPage", tr("Panels offer the files of these folders and follow their changes."), folders),
	    tr("Folders"));
	pPages->addTab(FolderPage("ProductsPage",
	                   tr("Where these products are installed, if the system does not tell. Their skins and model "
	                      "templates are offered after the next start."),
	                   products),
	    tr("Products"));
	pPages->addTab(CharactersPage(), tr("Characters"));
	pPages->addTab(NavigationPage(), tr("Navigation"));

	auto* const pButtons =
	    Named(new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel | QDialogButtonBox::Apply),
	        "PreferencesButtons", tr("Take over or leave"));
	for (const auto& [button, pName] : {std::pair(QDialogButtonBox::Ok, "PreferencesOk"),
	         {QDialogButtonBox::Cancel, "PreferencesCancel"}, {QDialogButtonBox::Apply, "PreferencesApply"}})
		Named(pButtons->button(button), pName, pButtons->button(button)->text().remove('&'));
	connect(pButtons, &QDialogButtonBox::accepted, this, &VPreferencesDialog::accept);
	connect(pButtons, &QDialogButtonBox::rejected, this, &VPreferencesDialog::reject);
	connect(pButtons->button(QDialogButtonBox::Apply), &QPushButton::clicked, this, &VPreferencesDialog::Apply);

	auto* const pLayout = new QVBoxLayout(this);
	pLayout->addWidget(pPages);
	pLayout->addWidget(pButtons);
	resize(720, sizeHint().height());
}

QWidget* VPreferencesDialog::FolderPage(
    const char* i_pName, const QString& i_rIntroduction, const std::vector<std::pair<std::string, QString>>& i_rKeys)
{
	auto* const pPage = Named(new QWidget, i_pName, i_rIntroduction);
	auto* const pLayout = new QGridLayout(pPage);
	auto* const pIntroduction = new QLabel(i_rIntroduction);
	pIntroduction->setWordWrap(true);
	pLayout->addWidget(pIntroduction, 0, 0, 1, 4);
	const std::size_t count = std::min(i_rKeys.size(), c_FoldersFirst);
	for (std::size_t i = 0; i < count; ++i)
		AddFolderRow(*pLayout, i_rKeys[i].first, i_rKeys[i].second);
	if (count < i_rKeys.size())
	{
		auto* const pRest = Named(new QWidget, "MoreFolders", tr("Folders that are seldom set"));
		auto* const pRestLayout = new QGridLayout(pRest);
		pRestLayout->setContentsMargins(0, 0, 0, 0);
		pRestLayout->setColumnStretch(1, 1);
		for (std::size_t i = count; i < i_rKeys.size(); ++i)
			AddFolderRow(*pRestLayout, i_rKeys[i].first, i_rKeys[i].second);
		pRest->hide();
		auto* const pMore = Named(new QToolButton, "More", tr("More folders"));
		pMore->setText(tr("More"));
		pMore->setCheckable(true);
		pMore->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
		pMore->setArrowType(Qt::RightArrow);
		connect(pMore, &QToolButton::toggled, pRest,
		    [pMore, pRest](bool i_bShown)
		    {
			    pMore->setArrowType(i_bShown ? Qt::DownArrow : Qt::RightArrow);
			    pRest->setVisible(i_bShown);
		    });
		pLayout->addWidget(pMore, pLayout->rowCount(), 0);
		pLayout->addWidget(pRest, pLayout->rowCount(), 0, 1, 4);
	}
	pLayout->setRowStretch(pLayout->rowCount(), 1);
	pLayout->setColumnStretch(1, 1);
	return pPage;
}

void VPreferencesDialog::AddFolderRow(QGridLayout& io_rLayout, const std::string& i_rKey, const QString& i_rLabel)
{
	const int row = io_rLayout.rowCount();
	auto* const pEdit = Named(new QLineEdit, i_rKey.c_str(), i_rLabel);
	pEdit->setPlaceholderText(tr("not set"));
	auto* const pWarning = Named(new QLabel, (i_rKey + "Warning").c_str(), tr("Note on %1").arg(i_rLabel));
	connect(pEdit, &QLineEdit::textChanged, pWarning,
	    [pWarning](const QString& i_rText)
	    {
		    pWarning->setText(i_rText.isEmpty() || QFileInfo(i_rText).isDir()
		            ? QString()
		            : QStringLiteral("<span style=\"color:#e0ad4b\">%1</span>").arg(tr("not there")));
	    });
	pEdit->setText(QString::fromStdString(UtilsFileSystem::ToUtf8(m_rPreferences.Folder(i_rKey))));
	auto* const pBrowse =
	    Named(new QToolButton, (i_rKey + "Browse").c_str(), tr("Choose the folder: %1").arg(i_rLabel));
	pBrowse->setText(QStringLiteral("..."));
	pBrowse->setToolTip(tr("Choose the folder"));
	connect(pBrowse, &QToolButton::clicked, this,
	    [this, pEdit, i_rLabel]
	    {
		    const QString folder = QFileDialog::getExistingDirectory(this, i_rLabel, pEdit->text());
		    if (!folder.isEmpty())
			    pEdit->setText(folder);
	    });
	auto* const pLabel = new QLabel(i_rLabel);
	pLabel->setBuddy(pEdit);
	io_rLayout.addWidget(pLabel, row, 0);
	io_rLayout.addWidget(pEdit, row, 1);
	io_rLayout.addWidget(pBrowse, row, 2);
	io_rLayout.addWidget(pWarning, row, 3);
	m_Folders.push_back({i_rKey, pEdit});
}

QWidget* VPreferencesDialog::CharactersPage()
{
	auto* const pPage = Named(new QWidget, "CharactersPage", tr("Characters"));
	auto* const pLayout = new QVBoxLayout(pPage);
	m_pPoseFromFile = Named(new QCheckBox(tr("\"Create Target Subject\" takes the pose from the FBX file")),
	    c_pPoseFromFileKey, tr("Take the pose from the FBX file"));
	m_pPoseFromFile->setToolTip(
	    tr("Otherwise many characters lie on their back until \"Take pose from FBX\" is pressed"));
	m_pPoseFromFile->setChecked(m_rPreferences.Number(c_pPoseFromFileKey, 1) != 0);
	pLayout->addWidget(m_pPoseFromFile);
	pLayout->addStretch();
	return pPage;
}

QWidget* VPreferencesDialog::NavigationPage()
{
	auto* const pPage = Named(new QWidget, "NavigationPage", tr("Navigation"));
	auto* const pLayout = new QGridLayout(pPage);
	m_pNavigationAlt =
	    Named(new QComboBox, TesselPluginInterface::c_NavigationAltKey, tr("The mouse moves the camera"));
	m_pNavigationAlt->addItem(tr("while Alt is not held"), 1);
	m_pNavigationAlt->addItem(tr("while Alt is held"), 0);
	m_pNavigationAlt->setCurrentIndex(
	    m_pNavigationAlt->findData(m_rPreferences.Number(TesselPluginInterface::c_NavigationAltKey, 1) ? 1 : 0));
	pLayout->addWidget(new QLabel(tr("The mouse moves the camera")), 0, 0);
	pLayout->addWidget(m_pNavigationAlt, 0, 1);
	pLayout->setRowStretch(1, 1);
	pLayout->setColumnStretch(2, 1);
	return pPage;
}

void VPreferencesDialog::Apply()
{
	for (const VFolderRow& rRow : m_Folders)
		m_rPreferences.SetFolder(
		    rRow.m_Key, UtilsFileSystem::PathFromUtf8(rRow.m_pEdit->text().trimmed().toStdString()));
	m_rPreferences.SetNumber(c_pPoseFromFileKey, m_pPoseFromFile->isChecked() ? 1 : 0);
	m_rPreferences.SetNumber(TesselPluginInterface::c_NavigationAltKey, m_pNavigationAlt->currentData().toInt());
}

void VPreferencesDialog::accept()
{
	Apply();
	QDialog::accept();
}

} // namespace StudioHost

#include "moc_PreferencesDialog.cpp"
