// What VRetargetSetup tells of its target subject, as tables that a host shows.

#include "RetargetSetupDocument/RetargetSetup.h"
#include "SetupReview/compare/CompareDocument.h"

#include <QStringList>

namespace
{

QVariantMap Row(const QStringList& i_rCells, const QString& i_rAbout)
{
	return {{"cells", i_rCells}, {"about", i_rAbout}};
}

} // namespace

QVariantMap VRetargetSetup::CompareWith(const QUrl& i_rFileURL)
{
	constexpr const char* c_Command = "CompareWith";
	const boost::filesystem::path path = LocalPath(c_Command, i_rFileURL);
	if (path.empty())
		return {};
	std::string reason;
	const auto changes = SetupReview::ChangesSince(*this, path, reason);
	if (!changes)
	{
		CommandIgnored(c_Command, reason);
		return {};
	}
	QVariantList rows;
	for (const SetupReview::VSetupChange& rChange : *changes)
	{
		const QString line = QString::fromStdString(SetupReview::ChangeLine(rChange));
		rows << Row({line}, line);
	}
	return {{"summary",
	            rows.isEmpty() ? QStringLiteral("Nothing differs.")
	                           : QString("From the file to what is here now, %1 differ:").arg(rows.size())},
	    {"rows", rows}};
}
