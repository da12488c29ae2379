#include "RetargetSetupDocument/RetargetSetup.h"

#include "DebugServices/GlobalLog.h"
#include "NVX/Status.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/IgnoredCommands.h"
#include "RetargetSetupDocument/ShownText.h"
#include "UtilsFileSystem/Paths.h"

#include <QString>

VRetargetSetup::VRetargetSetup(std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
    NVX::CountedPointer<TesselPluginInterface::IFrameFactory> i_pFrameFactory,
    NVX::CountedPointer<TesselPluginInterface::IItemFactory> i_pItemFactory)
    : VRetargetSetupCore(std::move(i_pDispatcher), std::move(i_pFrameFactory), std::move(i_pItemFactory)),
      m_pSourceSegmentModel(
          std::make_shared<VRetargetSetupSegmentModel>(VRetargetSetupSegmentModel::EFlavour::ESource)),
      m_pTargetSegmentModel(
          std::make_shared<VRetargetSetupSegmentModel>(VRetargetSetupSegmentModel::EFlavour::ETarget)),
      m_pTargetModel(std::make_shared<VRetargetSetupTargetModel>())
{
}

VRetargetSetup::~VRetargetSetup() = default;

void VRetargetSetup::Published()
{
	if (auto pSource = SourceValues().m_pParametrised)
		m_pSourceSegmentModel->SetSubject(std::move(pSource));
	static const auto s_pNone = std::make_shared<const CoreOrlexTypes::VSubjectParametrised>();
	const auto pTarget = TargetValues().m_pParametrised;
	m_pTargetSegmentModel->SetSubject(pTarget ? pTarget : s_pNone);
	m_pTargetModel->SetSubject(pTarget ? pTarget : s_pNone);
}

void VRetargetSetup::CommandIgnored(const char* i_pCommand, const std::string& i_rReason)
{
	emit commandIgnored(i_pCommand, QString::fromStdString(VisibleText::OnOneLine(i_rReason)));
}

QString VRetargetSetup::PoseNote() const
{
	return RetargetSetup::ShownText(VRetargetSetupCore::PoseNote());
}

void VRetargetSetup::TargetSubjectBroughtBack(const boost::filesystem::path& i_rFile)
{
	emit targetSubjectBroughtBack(
	    i_rFile.empty() ? QUrl() : QUrl::fromLocalFile(QString::fromStdString(UtilsFileSystem::ToUtf8(i_rFile))));
}

boost::filesystem::path VRetargetSetup::LocalPath(const char* i_pCommand, const QUrl& i_rFileURL)
{
	// Empty for any other URL.
	boost::filesystem::path path = UtilsFileSystem::PathFromUtf8(i_rFileURL.toLocalFile().toStdString());
	if (path.empty())
		CommandIgnored(i_pCommand,
		    RetargetSetup::Ignored::Text(
		        RetargetSetup::Ignored::c_NotLocal, i_rFileURL.toDisplayString().toStdString()));
	return path;
}

void VRetargetSetup::LoadTargetSubjectURL(const QUrl& i_rFileURL)
{
	constexpr const char* c_Command = "LoadTargetSubjectURL";
	const boost::filesystem::path path = LocalPath(c_Command, i_rFileURL);
	if (!path.empty() && LoadTargetSubjectBy(c_Command, path))
		emit targetSubjectLoaded(i_rFileURL);
}

void VRetargetSetup::SaveTargetSubjectURL(const QUrl& i_rFileURL)
{
	constexpr const char* c_Command = "SaveTargetSubjectURL";
	const boost::filesystem::path path = LocalPath(c_Command, i_rFileURL);
	if (!path.empty() && SaveTargetSubjectBy(c_Command, path))
		emit targetSubjectSaved(i_rFileURL);
}

bool VRetargetSetup::SaveRecipeURL(const QUrl& i_rFileURL)
{
	const boost::filesystem::path path = LocalPath("SaveRecipe", i_rFileURL);
	return !path.empty() && SaveSessionRecipe(path);
}

bool VRetargetSetup::WriteCopyURL(const QUrl& i_rFileURL) const
{
	std::string reason;
	if (WriteCopy(UtilsFileSystem::PathFromUtf8(i_rFileURL.toLocalFile().toStdString()), reason))
		return true;
	NVX_LOG(RetargetSetup::c_LogCategory, NVX::ELogInformation, "No copy of the target subject: %1%", reason);
	return false;
}

bool VRetargetSetup::RestoreTargetSubjectURL(const QUrl& i_rCopyURL, const QUrl& i_rFileURL)
{
	constexpr const char* c_Command = "RestoreTargetSubjectURL";
	const boost::filesystem::path copy = LocalPath(c_Command, i_rCopyURL);
	if (copy.empty())
		return false;
	if (RestoreTargetSubject(copy, UtilsFileSystem::PathFromUtf8(i_rFileURL.toLocalFile().toStdString()))
	    != NVX::Status::c_Success)
	{
		CommandIgnored(
		    c_Command, RetargetSetup::Ignored::Text(RetargetSetup::Ignored::c_NotRead, UtilsFileSystem::ToUtf8(copy)));
		return false;
	}
	if (i_rFileURL.isEmpty())
		emit targetSubjectCreated();
	else
		emit targetSubjectLoaded(i_rFileURL);
	return true;
}

#include "moc_RetargetSetup.cpp"
