#include "CoreGraphics/ResourceRoot.h"

#include "UtilsFileSystem/Paths.h"

#include <QDir>
#include <QFileInfo>

#include <boost/dll/runtime_symbol_info.hpp>

namespace CoreGraphics
{

namespace
{

QDir BinaryFolder()
{
	boost::dll::fs::error_code error;
	const boost::dll::fs::path binary = boost::dll::symbol_location(FindResourceRoot, error);
	if (error)
		return QDir::current();
	return QFileInfo(QString::fromStdString(UtilsFileSystem::ToUtf8(binary))).canonicalPath();
}

} // namespace

std::string FindResourceRoot()
{
	QDir folder = BinaryFolder();
	do
	{
		// RETARGET_MODULE_FOLDER is where the module lies below the root of an installation.
		for (const QString& rPlace : {folder.path(), folder.filePath(QStringLiteral(RETARGET_MODULE_FOLDER))})
		{
			// The folder's name is common; the file's is not.
			if (QDir(rPlace).exists(QStringLiteral("Geometry/tetra_stripe.fbx")))
				return rPlace.toStdString();
		}
	} while (folder.cdUp());
	return {};
}

} // namespace CoreGraphics
