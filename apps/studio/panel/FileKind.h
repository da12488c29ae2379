#pragma once

#include <QString>
#include <QStringList>

namespace StudioHost
{

/// The kinds of files that can be opened, in the order in which several are.
enum class EFileKind
{
	ESource,
	EFbx,
	ETarget,
	ETake,
	EOther
};

/// By the file's extension, in any case.
EFileKind KindOf(const QString& i_rPath);

/// "performer's skeleton"; empty for no kind.
QString KindName(EFileKind i_Kind);

/// "performer's skeleton (.qrs)".
QString Description(EFileKind i_Kind);

/// The filter of a file dialog.
QString DialogFilter(EFileKind i_Kind);

/// ".qrs, .fbx, .qrr, .qrx or .bvh".
QString AllExtensions();

/// Orders files by kind; those of one kind stay in order.
void SortByKind(QStringList& io_rPaths);

} // namespace StudioHost
