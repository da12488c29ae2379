#pragma once

#include "studio/host/UnsavedWork.h"

#include <QObject>
#include <QTimer>

namespace StudioHost
{

class VRetargetPanel;

/// Keeps what is unsaved in a panel, so that a crash loses some seconds of work at most: some time after a change, and
/// never again before the next one. What is saved or given up is no longer kept, nor is anything after a clean end.
class VWorkKeeper : public QObject
{
	Q_OBJECT

public:
	/// @param i_rPanel must outlive this.
	VWorkKeeper(VRetargetPanel& i_rPanel, const QString& i_rFolder);

	/// What programs that did not end cleanly have left, latest first.
	std::vector<VUnsavedWork> Left() const { return m_Folder.Left(); }

	/// Opens what was left as unsaved work of its file, with its performer and character. What cannot be read stays
	/// where it is, and why is told.
	bool Restore(const VUnsavedWork& i_rWork);

	/// At once.
	void Keep();

private:
	void OnChanged();

	VRetargetPanel& m_rPanel;
	VUnsavedWorkFolder m_Folder;
	QTimer m_Timer;
	bool m_bFailed = false;
};

} // namespace StudioHost
