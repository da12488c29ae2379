#include "CoreGraphics/ResourceRoot.h"

#include <QDir>
#include <QFileInfo>

#include <dlfcn.h>

namespace CoreGraphics
{

namespace
{

QDir BinaryFolder()
{
	Dl_info info{};
	if (dladdr(reinterpret_cast<const void*>(&FindResourceRoot), &info) == 0 || !info.dli_fname)
		return QDir::current();
	return QFileInfo(QFile::decodeName(info.dli_fname)).canonicalPath();
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
