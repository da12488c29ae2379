#pragma once

#include "NVX/Signal.h"
#include "studio/motion/MotionExport.h"
#include "studio/motion/TakePlayer.h"

#include <QWidget>

#include <functional>

class QLabel;
class QProgressBar;
class QTableView;
class QToolButton;

namespace TesselPluginInterface
{
class IPluginContext;
class ISelection;
} // namespace TesselPluginInterface

namespace StudioHost
{

class VResidualModel;
class VResidualPlot;

/// The dock "Motion": plays a take, and tells how far the targets are off. Which targets are chosen is the host's
/// selection, as in the panel's own list.
class VMotionPanel : public QWidget
{
	Q_OBJECT

public:
	/// @param i_rContext must outlive this.
	VMotionPanel(TesselPluginInterface::IPluginContext& i_rContext, QAction& i_rOpen, QWidget* i_pParent = nullptr);
	~VMotionPanel() override;

	VTakePlayer& Player() { return m_Player; }
	const VMotionExport& Export() const { return m_Export; }

	/// In the dock, until something else goes well, and in the log.
	void Tell(const QString& i_rError);

	/// Asked for the character's FBX file, empty for none, when a motion is written with it.
	std::function<QString()> m_AskCharacter;

	/// A widget whose keys play and step, too, while the condition holds: space, left and right, home and end.
	/// @param i_rWidget must not outlive this.
	void TakeKeysOf(QWidget& i_rWidget, std::function<bool()> i_Condition);

signals:
	/// The performer that was made of the take is wanted as a file.
	void makePerformerAsked();

protected:
	bool eventFilter(QObject* i_pReceiver, QEvent* i_pEvent) override;

private:
	QToolButton* AddButton(const char* i_pName, const QString& i_rText, const QString& i_rToolTip);
	void MakeControls(QAction& i_rOpen);
	QWidget* MakeTable();
	void AskAndExport();
	/// The host's selection goes to the table and the plot, and what is chosen in the table to the host.
	void FollowSelection();
	void ChooseInTable();
	void ShowWorst(const QModelIndex& i_rIndex);
	void TogglePlay();
	/// @return false for a key that does nothing here.
	bool PressKey(int i_Key);
	void UpdateControls();
	void UpdateFrame();
	void UpdateProgress();

	VTakePlayer m_Player;
	VMotionExport m_Export;
	VResidualModel* const m_pModel;
	TesselPluginInterface::ISelection& m_rSelection;
	NVX::VConnection m_SelectionConnection;
	bool m_bFollowing = false;
	std::function<bool()> m_HasView;
	QToolButton* m_pPlay = nullptr;
	QToolButton* m_pStop = nullptr;
	QToolButton* m_pExport = nullptr;
	QToolButton* m_pMakePerformer = nullptr;
	QTableView* m_pTable = nullptr;
	VResidualPlot* m_pPlot = nullptr;
	/// Why something was not done; empty when all is well.
	QString m_Error;
	/// On only while there is a take.
	QList<QWidget*> m_Controls;
	QLabel* const m_pFile;
	QLabel* const m_pFrame;
	QProgressBar* const m_pProgress;
	QToolButton* m_pCancel = nullptr;
};

} // namespace StudioHost
