#pragma once

#include "studio/motion/TakePlayer.h"

#include <QWidget>

#include <functional>

class QLabel;
class QProgressBar;
class QTableView;
class QToolButton;

namespace StudioHost
{

class VResidualModel;

/// The dock "Motion": plays a take, and tells how far the targets are off.
class VMotionPanel : public QWidget
{
	Q_OBJECT

public:
	VMotionPanel(NVX::CountedPointer<TesselPluginInterface::IItemFactory> i_pItemFactory, QAction& i_rOpen,
	    QWidget* i_pParent = nullptr);

	VTakePlayer& Player() { return m_Player; }

	/// A widget whose keys play and step, too, while the condition holds: space, left and right.
	/// @param i_rWidget must not outlive this.
	void TakeKeysOf(QWidget& i_rWidget, std::function<bool()> i_Condition);

protected:
	bool eventFilter(QObject* i_pReceiver, QEvent* i_pEvent) override;

private:
	QToolButton* AddButton(const char* i_pName, const QString& i_rText, const QString& i_rToolTip);
	void AskAndExport();
	void ShowWorst(const QModelIndex& i_rIndex);
	void TogglePlay();
	/// @return false for a key that does nothing here.
	bool PressKey(int i_Key);
	void UpdateControls();
	void UpdateFrame();
	void UpdateProgress();

	VTakePlayer m_Player;
	VResidualModel* const m_pModel;
	std::function<bool()> m_HasView;
	QToolButton* m_pPlay = nullptr;
	QToolButton* m_pStop = nullptr;
	QToolButton* m_pExport = nullptr;
	/// On only while there is a take.
	QList<QWidget*> m_Controls;
	QLabel* const m_pFile;
	QLabel* const m_pFrame;
	QProgressBar* const m_pProgress;
	QToolButton* m_pCancel = nullptr;
};

} // namespace StudioHost
