#pragma once

#include <QObject>
#include <QProcess>
#include <QString>
#include <QTemporaryDir>

namespace StudioHost
{

class VRetargetPanel;

/// The page of a report of the target subject as it stands, written by the command line's program, which also draws its
/// pictures, while the window goes on. Where the page went, or why not, is told in the log; then this deletes itself.
class VReportRun : public QObject
{
	Q_OBJECT

public:
	/// Where the program stands, as seen from this one; empty if it does not.
	static QString Program();

	/// @param i_rTake the take that plays, empty for none.
	VReportRun(VRetargetPanel& i_rPanel, const QString& i_rTake, const QString& i_rOut, QWidget& i_rWindow);
	~VReportRun() override;

private:
	void Tell(bool i_bEnded);

	/// The file itself may not hold what stands now.
	const QTemporaryDir m_Folder;
	const QString m_Out;
	QProcess m_Process;
	bool m_bGivenUp = false;
};

} // namespace StudioHost
