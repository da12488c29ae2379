// What VRetargetSetupWidget does when a parameter, a preference, the document or the selection has changed. Handlers
// run through the dispatcher, some time after the change, and read what stands then. What was typed is for the target,
// the subject or the skeleton that was shown; if another one has taken its place since, it is dropped, which is told.

#include "DebugServices/GlobalLog.h"
#include "OrlexQtQuick/GuardedCallback.h"
#include "RetargetSetupCore/FilePath.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/StepNames.h"
#include "RetargetSetupCore/TargetConstruction.h"
#include "RetargetSetupDocument/RetargetSetup.h"
#include "RetargetSetupDocument/RetargetSetupSelection.h"
#include "TesselParameters/Parameter.h"
#include "TesselParametersGUI/ParameterFBX.h"
#include "TesselPluginInterface/IPreferenceFolders.h"
#include "TesselPluginInterface/PathTypes.h"
#include "TesselPluginRetargetSetup/BoneList.h"
#include "TesselPluginRetargetSetup/RetargetSetupWidget.h"
#include "UtilsFileSystem/Paths.h"
#include "math/VisibleText.h"

#include <algorithm>
#include <bit>
#include <utility>

using CoreOrlexTypes::VSubjectParametrised;
using OrlexQtQuick::Guarded;
using RetargetSetup::c_LogCategory;
using RetargetSetup::VShownTarget;
using TesselPluginInterface::c_FolderKeys;

namespace
{

bool IsSame(double i_A, double i_B)
{
	return std::bit_cast<std::uint64_t>(i_A) == std::bit_cast<std::uint64_t>(i_B);
}

bool IsSameText(const VShownTarget& i_rA, const VShownTarget& i_rB)
{
	return IsSame(i_rA.m_Weight, i_rB.m_Weight) && i_rA.m_State == i_rB.m_State;
}

} // namespace

void VRetargetSetupWidget::ConnectParameters()
{
	const auto connect = [this](const auto& i_rpParameter, void (VRetargetSetupWidget::*i_pHandler)())
	{ m_Connections.push_back(i_rpParameter->ConnectValue(Guarded(this, i_pHandler), m_pDispatcher)); };
	connect(m_Parameters.m_pSourceSkeleton, &VRetargetSetupWidget::OnSourceSkeletonChanged);
	connect(m_Parameters.m_pSourceSkin, &VRetargetSetupWidget::OnSourceSkeletonChanged);
	connect(m_Parameters.m_pTargetFBX, &VRetargetSetupWidget::OnTargetFBXChanged);
	connect(m_Parameters.m_pTargetRoot, &VRetargetSetupWidget::OnTargetRootChanged);
	connect(m_Parameters.m_pTargetScale, &VRetargetSetupWidget::OnTargetScaleChanged);
	connect(m_Parameters.m_pTargetWeight, &VRetargetSetupWidget::OnTargetParametersChanged);
	for (const auto& rpState : m_Parameters.m_pTargetState)
		connect(rpState, &VRetargetSetupWidget::OnTargetParametersChanged);
	m_Connections.push_back(m_pPreferenceFolders->ChangedSignal().Connect(
	    Guarded(this, &VRetargetSetupWidget::OnFolderPreferenceChanged), m_pDispatcher));
}

void VRetargetSetupWidget::ApplyStoredValues()
{
	OnSourceSkeletonChanged();
	OnTargetScaleChanged();
	// Reading the FBX file chooses its first bone.
	std::uint32_t root = 0;
	const bool bRootStored = m_Parameters.m_pTargetRoot->Get(root);
	OnTargetFBXChanged();
	const auto pSkeleton = m_pRetargetSetup->GetFBXSkeleton();
	if (bRootStored && pSkeleton && root < pSkeleton->size())
	{
		m_Parameters.m_pTargetRoot->Set(root);
		OnTargetRootChanged();
	}
}

void VRetargetSetupWidget::ApplyParameters()
{
	OnSourceSkeletonChanged();
	OnTargetFBXChanged();
	OnTargetRootChanged();
	ApplyEdits();
	m_pSelection->Update();
}

void VRetargetSetupWidget::ApplyEdits()
{
	OnTargetScaleChanged();
	OnTargetParametersChanged();
}

void VRetargetSetupWidget::OnSourceSkeletonChanged()
{
	VChosenSource chosen{m_Parameters.m_pSourceSkeleton->GetValueText(), m_Parameters.m_pSourceSkin->GetValueText()};
	if (std::exchange(m_ChosenSource, chosen) == chosen)
		return;
	m_UnreadSource.clear();
	UpdateRemarks();
	if (!m_Parameters.m_pSourceSkeleton->HasValue())
		return;
	const boost::filesystem::path path = UtilsFileSystem::PathFromUtf8(chosen.m_Skeleton);
	const std::string& rShown = m_pRetargetSetup->GetShownSourceName();
	// A bare name is what a file of a target subject tells; where the process happens to run has nothing to do with it.
	if (!path.is_absolute())
	{
		NVX_LOG(c_LogCategory, NVX::ELogWarning, "Source '%1%' is in none of the folders, still showing %2%",
		    UtilsFileSystem::ToUtf8(path), rShown.empty() ? "none" : "'" + rShown + "'");
		return;
	}
	RetargetSetup::VPanelParameters::OfferFile(*m_Parameters.m_pSourceSkeleton, path);
	const VLoadedSource source{path, RetargetSetup::FileStem(UtilsFileSystem::PathFromUtf8(chosen.m_Skin))};
	// The document may have been told of another source since, by a target subject's file.
	if (m_LoadedSource == source && m_pRetargetSetup->GetSourceName() == rShown)
		return;
	const std::optional<VLoadedSource> before = m_LoadedSource;
	if (m_pRetargetSetup->LoadSourceSubject(source.m_Path, source.m_SkinName))
	{
		if (before && before->m_Path != source.m_Path && !source.m_SkinName.empty()
		    && before->m_SkinName == source.m_SkinName)
			NVX_LOG(c_LogCategory, NVX::ELogWarning,
			    "The skin '%1%' was chosen for source '%2%', and '%3%' wears it now", source.m_SkinName,
			    RetargetSetup::FileStem(before->m_Path), RetargetSetup::FileStem(source.m_Path));
		m_LoadedSource = source;
		if (before && before->m_Path != source.m_Path)
			emit m_pRetargetSetup->rebindCalledFor(true);
		return;
	}
	m_UnreadSource = UtilsFileSystem::ToUtf8(path.filename());
	NVX_LOG(c_LogCategory, NVX::ELogError,
	    "'%1%' cannot be read as a source skeleton, for the reason told before: still showing %2%",
	    UtilsFileSystem::ToUtf8(path), rShown.empty() ? "none" : "'" + rShown + "'");
	UpdateRemarks();
}

void VRetargetSetupWidget::OnTargetFBXChanged()
{
	const std::string text = m_Parameters.m_pTargetFBX->GetValueText();
	if (std::exchange(m_ChosenFBX, text) == text)
		return;
	m_UnreadFBX.clear();
	// What is chosen no more is followed no more.
	m_TargetFBXFile.Follow({});
	UpdateRemarks();
	if (!m_Parameters.m_pTargetFBX->HasValue())
		return;
	const boost::filesystem::path path = UtilsFileSystem::PathFromUtf8(text);
	if (!path.is_absolute())
	{
		NVX_LOG(c_LogCategory, NVX::ELogWarning, "Target FBX '%1%' is in none of the folders", text);
		return;
	}
	RetargetSetup::VPanelParameters::OfferFile(*m_Parameters.m_pTargetFBX, path);
	m_TargetFBXFile.Follow(QString::fromStdString(UtilsFileSystem::ToUtf8(path)));
	LookForSkinsBeside(path);
	if (!m_pRetargetSetup->LoadTargetFBX(path))
	{
		m_UnreadFBX = UtilsFileSystem::ToUtf8(path.filename());
		const bool bSkeleton = m_pRetargetSetup->GetFBXSkeleton() != nullptr;
		NVX_LOG(c_LogCategory, NVX::ELogError, "'%1%' gives no skeleton: %2%. %3%", text,
		    m_pRetargetSetup->GetTargetFBXError(),
		    bSkeleton ? "The one of '" + m_pRetargetSetup->GetTargetName() + "' stays" : "There is none now");
		if (!bSkeleton)
			m_Parameters.SetBones({});
		return UpdateRemarks();
	}
	std::uint32_t root = 0;
	if (m_AgreedRoot && m_Parameters.m_pTargetRoot->Get(root) && root != *m_AgreedRoot)
		NVX_LOG(c_LogCategory, NVX::ELogWarning,
		    "The target root that was chosen last is a bone of another FBX file: it is not taken over");
	m_Parameters.SetBones(RetargetSetup::BoneListForEnum(*m_pRetargetSetup->GetFBXSkeleton()));
	m_Parameters.m_pTargetRoot->Set(std::uint32_t(0));
	m_AgreedRoot = 0;
	m_pRetargetSetup->SetTargetRootIndex(0, false);
	UpdateRemarks();
}

void VRetargetSetupWidget::OnTargetFBXWritten()
{
	const std::string file = m_Parameters.m_pTargetFBX->GetValueText();
	const auto pBefore = m_pRetargetSetup->GetFBXSkeleton();
	if (!m_pRetargetSetup->LoadTargetFBX(UtilsFileSystem::PathFromUtf8(file)))
	{
		NVX_LOG(c_LogCategory, NVX::ELogWarning, "'%1%' has changed on disk, and no skeleton can be read from it now",
		    file);
		return;
	}
	const auto pNow = m_pRetargetSetup->GetFBXSkeleton();
	const std::string changes = pBefore ? RetargetSetup::BoneChanges(*pBefore, *pNow) : "all bones are new";
	NVX_LOG(c_LogCategory, changes.empty() ? NVX::ELogInformation : NVX::ELogWarning,
	    "'%1%' has changed on disk and was read again: %2%", file,
	    changes.empty() ? "its bones are as they were"
	                    : changes + ". The target subject stays as it was until it is created again or re-bound.");
	std::uint32_t root = 0;
	m_Parameters.m_pTargetRoot->Get(root);
	m_Parameters.SetBones(RetargetSetup::BoneListForEnum(*pNow));
	// The root stays the same bone, wherever it stands now.
	const auto found = pBefore && root < pBefore->size()
	    ? std::ranges::find(*pNow, (*pBefore)[root].m_Name, &FBXIO::VSkinBone::m_Name)
	    : pNow->end();
	m_Parameters.m_pTargetRoot->Set(found == pNow->end() ? std::uint32_t(0) : std::uint32_t(found - pNow->begin()));
	OnTargetRootChanged();
	const auto pData = m_pRetargetSetup->TargetValues().m_pApplicationData;
	if (!changes.empty() && pData && pData->m_Skin == m_pRetargetSetup->GetTargetName())
		emit m_pRetargetSetup->rebindCalledFor(false);
}

void VRetargetSetupWidget::OnTargetRootChanged()
{
	if (!m_Parameters.m_pTargetRoot->HasValue())
		return;
	std::uint32_t root = 0;
	m_Parameters.m_pTargetRoot->Get(root);
	if (m_AgreedRoot == root)
		return;
	m_AgreedRoot = root;
	m_pRetargetSetup->SetTargetRootIndex(root);
	UpdateRemarks();
}

void VRetargetSetupWidget::OnTargetScaleChanged()
{
	double scale = 0.0;
	if (!m_Parameters.m_pTargetScale->Get(scale) || (m_AgreedScale && IsSame(*m_AgreedScale, scale)))
		return;
	if (!RetargetSetup::IsUsableScale(scale))
	{
		// Tells why, and then what stands here must not stay.
		m_pRetargetSetup->SetTargetScale(scale);
		m_Parameters.m_pTargetScale->Set(m_AgreedScale.value_or(1.0));
		return;
	}
	if (m_AgreedScale && m_pRetargetSetup->TargetSubjectIdentity() != m_ScaledSubject)
	{
		NVX_LOG(c_LogCategory, NVX::ELogWarning,
		    "The scale %1% was typed for another target subject: it is not taken over", scale);
		return SyncScaleParameter();
	}
	m_AgreedScale = scale;
	// A subject that has this scale already keeps its dynamic parameters, of which there may be more.
	if (m_pRetargetSetup->TargetValues().m_pParametrised && IsSame(m_pRetargetSetup->GetTargetScale(), scale))
		m_pRetargetSetup->SetNextTargetScale(scale);
	else
		m_pRetargetSetup->SetTargetScale(scale);
	// What the document refused must not stay.
	if (m_pRetargetSetup->TargetValues().m_pParametrised)
		SyncScaleParameter();
}

void VRetargetSetupWidget::OnTargetParametersChanged()
{
	const VShownTarget edited = m_Parameters.ReadTarget(m_ShownTarget.m_Index);
	const auto pSubject = m_pRetargetSetup->TargetValues().m_pParametrised;
	if (!pSubject || IsSameText(edited, m_ShownTarget))
		return;
	VShownTarget shown = m_ShownTarget;
	m_ShownTarget.m_Weight = edited.m_Weight;
	m_ShownTarget.m_State = edited.m_State;
	if (shown.m_Index != -1)
	{
		// Others may have been removed before it.
		shown.m_Index = m_ShownTarget.m_Index = m_pRetargetSetup->TargetOfIdentity(m_ShownIdentity);
		if (shown.m_Index == -1)
		{
			NVX_LOG(c_LogCategory, NVX::ELogWarning,
			    "What was typed last was for target '%1%', which is gone: it is dropped", m_ShownName);
			return OnSelectionChangedShowTarget();
		}
	}
	const char* const pName = shown.m_State == edited.m_State ? RetargetSetup::Steps::c_Weight
	    : IsSame(shown.m_Weight, edited.m_Weight)             ? RetargetSetup::Steps::c_State
	                                                          : RetargetSetup::Steps::c_TargetFields;
	VSubjectParametrised subject = *pSubject;
	RetargetSetup::ApplyEdits(subject, shown, edited);
	// What was refused is shown as it is again by the change that follows. The way of a slider is one step.
	m_pRetargetSetup->SetTargetSubjectParametrised(std::move(subject), {pName, m_ShownIdentity});
}

void VRetargetSetupWidget::OnFolderPreferenceChanged(const std::string& i_rKey)
{
	m_Parameters.OnFolderPreferenceChanged(i_rKey, *m_pPreferenceFolders);
	if (i_rKey == c_FolderKeys[TesselPluginInterface::EPathSkins])
		UpdateSkinFolders();
	else if (i_rKey == c_FolderKeys[TesselPluginInterface::EPathRetargets])
		UpdateRetargetsFolder();
}

void VRetargetSetupWidget::OnSetupChanged()
{
	OnTargetScaleChanged();
	SyncScaleParameter();
	// One that was chosen since would be lost to the document's.
	OnSourceSkeletonChanged();
	SyncSourceSkeletonParameter();
	OnSelectionChangedShowTarget();
	UpdateRemarks();
}

void VRetargetSetupWidget::UpdateRemarks()
{
	QStringList remarks;
	const auto text = [](const std::string& i_rText)
	{ return QString::fromStdString(VisibleText::OnOneLine(i_rText)); };
	if (!m_UnreadSource.empty())
	{
		const QString shown = text(m_pRetargetSetup->GetShownSourceName());
		remarks << tr("%1 cannot be read: %2")
		               .arg(text(m_UnreadSource),
		                   shown.isEmpty() ? tr("there is no source yet.") : tr("the source is still %1.").arg(shown));
	}
	const QString made = text(m_pRetargetSetup->GetTargetName());
	if (!m_UnreadFBX.empty())
		remarks << tr("%1 gives no skeleton: %2. %3")
		               .arg(text(m_UnreadFBX), text(m_pRetargetSetup->GetTargetFBXError()),
		                   m_pRetargetSetup->GetFBXSkeleton()
		                       ? tr("Root and \"Create Target Subject\" are still those of %1.").arg(made)
		                       : tr("There is nothing to create a target subject from."));
	const auto pData = m_pRetargetSetup->TargetValues().m_pApplicationData;
	if (m_UnreadFBX.empty() && pData && m_pRetargetSetup->GetFBXSkeleton() && text(pData->m_Skin) != made)
		remarks << tr(
		    "The target subject is of %1. FBX and root above are of %2, for the next \"Create Target Subject\".")
		               .arg(pData->m_Skin.empty() ? tr("an unknown character") : text(pData->m_Skin), made);
	// Of one character, but begun at another bone.
	const auto pSkeleton = m_pRetargetSetup->GetFBXSkeleton();
	const auto pSubject = m_pRetargetSetup->TargetValues().m_pParametrised;
	if (remarks.isEmpty() && pData && pSubject && !pSubject->m_Segments.empty() && pSkeleton && m_AgreedRoot
	    && *m_AgreedRoot < pSkeleton->size())
	{
		const std::string& rBegins = pSubject->m_Segments.front().m_Name;
		const std::string root(RetargetSetup::StripNamespace((*pSkeleton)[*m_AgreedRoot].m_Name));
		if (rBegins != root)
			remarks << tr(
			    "The target subject begins at %1. The root above, %2, is for the next \"Create Target Subject\".")
			               .arg(text(rBegins), text(root));
	}
	const QString joined = remarks.join('\n');
	if (std::exchange(m_Remarks, joined) != joined)
		emit remarksChanged();
}

void VRetargetSetupWidget::SyncScaleParameter()
{
	const bool bSubject = m_pRetargetSetup->TargetValues().m_pParametrised != nullptr;
	m_ScaledSubject = m_pRetargetSetup->TargetSubjectIdentity();
	double shown = 0.0;
	const bool bShown = m_Parameters.m_pTargetScale->Get(shown);
	if (!bSubject && !bShown)
		return;
	// Without a subject the one that the next is made with, which may have come back with what was undone.
	const double scale = bSubject ? m_pRetargetSetup->GetTargetScale() : m_pRetargetSetup->GetNextTargetScale();
	if (!m_AgreedScale || !IsSame(*m_AgreedScale, scale))
	{
		m_AgreedScale = scale;
		m_pRetargetSetup->SetNextTargetScale(scale);
	}
	if (!bShown || !IsSame(shown, scale))
		m_Parameters.m_pTargetScale->Set(scale);
}

void VRetargetSetupWidget::SyncSourceSkeletonParameter()
{
	TesselParametersGUI::VParameterEnumFolderWatcher& rParameter = *m_Parameters.m_pSourceSkeleton;
	const std::string& rName = m_pRetargetSetup->GetSourceName();
	if (rName.empty())
	{
		rParameter.ClearValue();
		return;
	}
	// Of two files with this name the one that is chosen is as good as the one that is listed.
	const boost::filesystem::path chosen = UtilsFileSystem::PathFromUtf8(rParameter.GetValueText());
	if (chosen.is_absolute() && RetargetSetup::FileStem(chosen) == rName)
		return;
	for (const TesselPluginInterface::VEnumEntry& rEntry : rParameter.GetEnumeration())
		if (rEntry.m_Name == rName)
		{
			rParameter.SetValue(rEntry.m_Value);
			return;
		}
	rParameter.Set(rName);
}

void VRetargetSetupWidget::OnSelectionChangedShowTarget()
{
	// What is shown next must not take the place of what was typed and has not been heard of.
	OnTargetParametersChanged();
	const VRetargetSetup::VSubjectValues target = m_pRetargetSetup->TargetValues();
	VShownTarget shown;
	if (target.m_pParametrised)
		shown = RetargetSetup::ShowTarget(*target.m_pParametrised, m_pSelection->SelectedTarget());
	m_ShownIdentity = m_pRetargetSetup->TargetIdentity(shown.m_Index);
	if (shown.m_Index == -1)
	{
		m_ShownTarget.m_Index = -1;
		return;
	}
	const auto& rNames = target.m_pApplicationData->m_Targets;
	m_ShownName = std::size_t(shown.m_Index) < rNames.size() ? rNames[std::size_t(shown.m_Index)].m_Name : "";
	m_ShownTarget = shown;
	m_Parameters.WriteTarget(shown);
}
