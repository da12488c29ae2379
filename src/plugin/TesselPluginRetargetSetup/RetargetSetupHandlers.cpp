// What VRetargetSetupWidget does when a parameter, a preference, the document or the selection has changed. Handlers
// run through the dispatcher, some time after the change, and read what stands then.

#include "DebugServices/GlobalLog.h"
#include "OrlexQtQuick/GuardedCallback.h"
#include "RetargetSetupDocument/FilePath.h"
#include "RetargetSetupDocument/GlobalScale.h"
#include "RetargetSetupDocument/Identity.h"
#include "RetargetSetupDocument/RetargetSetup.h"
#include "RetargetSetupDocument/RetargetSetupSelection.h"
#include "TesselParameters/Parameter.h"
#include "TesselParametersGUI/ParameterFBX.h"
#include "TesselPluginInterface/IPreferenceFolders.h"
#include "TesselPluginInterface/PathTypes.h"
#include "TesselPluginRetargetSetup/BoneList.h"
#include "TesselPluginRetargetSetup/RetargetSetupWidget.h"
#include "UtilsFileSystem/Paths.h"

#include <bit>

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
	OnTargetScaleChanged();
	OnTargetParametersChanged();
}

void VRetargetSetupWidget::OnSourceSkeletonChanged()
{
	if (!m_Parameters.m_pSourceSkeleton->HasValue())
		return;
	const boost::filesystem::path path = UtilsFileSystem::PathFromUtf8(m_Parameters.m_pSourceSkeleton->GetValueText());
	const std::string& rShown = m_pRetargetSetup->GetShownSourceName();
	// A bare name is what a file of a target subject tells; where the process happens to run has nothing to do with it.
	if (!path.is_absolute())
	{
		NVX_LOG(c_LogCategory, NVX::ELogWarning, "Source '%1%' is in none of the folders, still showing %2%",
		    UtilsFileSystem::ToUtf8(path), rShown.empty() ? "none" : "'" + rShown + "'");
		return;
	}
	RetargetSetup::VPanelParameters::OfferFile(*m_Parameters.m_pSourceSkeleton, path);
	const VLoadedSource source{
	    path, RetargetSetup::FileStem(UtilsFileSystem::PathFromUtf8(m_Parameters.m_pSourceSkin->GetValueText()))};
	// The document may have been told of another source since, by a target subject's file.
	if (m_LoadedSource == source && m_pRetargetSetup->GetSourceName() == rShown)
		return;
	if (m_pRetargetSetup->LoadSourceSubject(source.m_Path, source.m_SkinName))
		m_LoadedSource = source;
}

void VRetargetSetupWidget::OnTargetFBXChanged()
{
	if (!m_Parameters.m_pTargetFBX->HasValue())
		return;
	const boost::filesystem::path path = UtilsFileSystem::PathFromUtf8(m_Parameters.m_pTargetFBX->GetValueText());
	if (!path.is_absolute())
	{
		NVX_LOG(c_LogCategory, NVX::ELogWarning, "Target FBX '%1%' is in none of the folders",
		    UtilsFileSystem::ToUtf8(path));
		return;
	}
	RetargetSetup::VPanelParameters::OfferFile(*m_Parameters.m_pTargetFBX, path);
	if (!m_pRetargetSetup->LoadTargetFBX(path))
		return;
	m_Parameters.SetBones(RetargetSetup::BoneListForEnum(*m_pRetargetSetup->GetFBXSkeleton()));
	m_Parameters.m_pTargetRoot->Set(std::uint32_t(0));
}

void VRetargetSetupWidget::OnTargetRootChanged()
{
	if (!m_Parameters.m_pTargetRoot->HasValue())
		return;
	std::uint32_t root = 0;
	m_Parameters.m_pTargetRoot->Get(root);
	m_pRetargetSetup->SetTargetRootIndex(root);
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
	m_AgreedScale = scale;
	// A subject that has this scale already keeps its dynamic parameters, of which there may be more.
	if (m_pRetargetSetup->TargetValues().m_pParametrised && IsSame(m_pRetargetSetup->GetTargetScale(), scale))
		m_pRetargetSetup->SetNextTargetScale(scale);
	else
		m_pRetargetSetup->SetTargetScale(scale);
}

void VRetargetSetupWidget::OnTargetParametersChanged()
{
	VShownTarget edited = m_Parameters.ReadTarget(m_ShownTarget.m_Index);
	const auto pSubject = m_pRetargetSetup->TargetValues().m_pParametrised;
	if (!pSubject || IsSameText(edited, m_ShownTarget))
		return;
	VSubjectParametrised subject = *pSubject;
	RetargetSetup::ApplyEdits(subject, m_ShownTarget, edited);
	edited.m_bStateHidden = m_ShownTarget.m_bStateHidden;
	m_ShownTarget = std::move(edited);
	// What was refused is shown as it is again by the change that follows.
	m_pRetargetSetup->SetTargetSubjectParametrised(std::move(subject));
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
	SyncScaleParameter();
	SyncSourceSkeletonParameter();
	OnSelectionChangedShowTarget();
}

void VRetargetSetupWidget::SyncScaleParameter()
{
	if (!m_pRetargetSetup->TargetValues().m_pParametrised)
		return;
	const double scale = m_pRetargetSetup->GetTargetScale();
	if (m_AgreedScale && IsSame(*m_AgreedScale, scale))
		return;
	m_AgreedScale = scale;
	m_pRetargetSetup->SetNextTargetScale(scale);
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
	const auto pSubject = m_pRetargetSetup->TargetValues().m_pParametrised;
	VShownTarget shown;
	if (pSubject)
		shown = RetargetSetup::ShowTarget(*pSubject, m_pSelection->SelectedTarget());
	if (shown.m_Index == -1)
	{
		m_ShownTarget.m_Index = -1;
		return;
	}
	m_ShownTarget = shown;
	m_Parameters.WriteTarget(shown);
}
