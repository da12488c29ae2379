#include "studio/panel/FileKind.h"

#include <QFileInfo>

#include <algorithm>
#include <array>

namespace StudioHost
{
namespace
{

struct VKind
{
	EFileKind m_Kind;
	const char* m_pName;
	QStringList m_Extensions;
};

const std::array<VKind, 4>& Kinds()
{
	static const std::array<VKind, 4> s_Kinds = {
	    {{EFileKind::ESource, "performer's skeleton", {"qrs"}}, {EFileKind::EFbx, "character's FBX file", {"fbx"}},
	        {EFileKind::ETarget, "retarget subject", {"qrr", "qrx"}}, {EFileKind::ETake, "performer's take", {"bvh"}}}};
	return s_Kinds;
}

const VKind* Find(EFileKind i_Kind)
{
	const auto found = std::ranges::find(Kinds(), i_Kind, &VKind::m_Kind);
	return found == Kinds().end() ? nullptr : &*found;
}

} // namespace

EFileKind KindOf(const QString& i_rPath)
{
	const QString extension = QFileInfo(i_rPath).suffix().toLower();
	for (const VKind& rKind : Kinds())
		if (rKind.m_Extensions.contains(extension))
			return rKind.m_Kind;
	return EFileKind::EOther;
}

QString KindName(EFileKind i_Kind)
{
	const VKind* const pKind = Find(i_Kind);
	return pKind ? pKind->m_pName : "";
}

QString Description(EFileKind i_Kind)
{
	const VKind* const pKind = Find(i_Kind);
	return pKind ? QStringLiteral("%1 (.%2)").arg(pKind->m_pName, pKind->m_Extensions.join(QStringLiteral(", ."))) : "";
}

QString DialogFilter(EFileKind i_Kind)
{
	QStringList patterns;
	for (const VKind& rKind : Kinds())
		if (rKind.m_Kind == i_Kind)
			for (const QString& rExtension : rKind.m_Extensions)
				patterns << "*." + rExtension << "*." + rExtension.toUpper();
	return QStringLiteral("%1 (%2)").arg(KindName(i_Kind), patterns.join(' '));
}

QString AllExtensions()
{
	QStringList extensions;
	for (const VKind& rKind : Kinds())
		for (const QString& rExtension : rKind.m_Extensions)
			extensions << '.' + rExtension;
	const QString last = extensions.takeLast();
	return QStringLiteral("%1 or %2").arg(extensions.join(QStringLiteral(", ")), last);
}

void SortByKind(QStringList& io_rPaths)
{
	std::stable_sort(io_rPaths.begin(), io_rPaths.end(),
	    [](const QString& i_rLeft, const QString& i_rRight) { return KindOf(i_rLeft) < KindOf(i_rRight); });
}

} // namespace StudioHost
