// What VRetargetSetupCore keeps of what edits replace, and brings back.

#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/IgnoredCommands.h"
#include "RetargetSetupCore/RetargetSetupCore.h"
#include "TesselPluginInterface/IDispatcher.h"
#include "TesselPluginInterface/ISelectionManager.h"

#include <algorithm>
#include <iterator>
#include <new>
#include <utility>

using RetargetSetup::c_LogCategory;
using RetargetSetup::VEdit;
using RetargetSetup::VTargetFile;

VRetargetSetupCore::VStep::VStep(VRetargetSetupCore& io_rDocument, const VEdit& i_rEdit)
    : m_rDocument(io_rDocument), m_Edit(i_rEdit), m_bOutermost(!std::exchange(io_rDocument.m_bInStep, true))
{
	if (!m_bOutermost || !m_rDocument.m_History || m_rDocument.m_History->GoesOn(m_Edit))
		return;
	m_Before = m_rDocument.m_Target;
	m_Before->m_Selection = m_rDocument.Selected();
	if (m_Edit.m_bNamesSource)
		m_Before->m_SourceName = m_rDocument.m_SourceName;
}

VRetargetSetupCore::VStep::~VStep()
{
	if (m_bOutermost)
		m_rDocument.m_bInStep = false;
	if (!m_Before || HoldTheSame(*m_Before, m_rDocument.m_Target))
		return;
	try
	{
		const bool bFits = m_rDocument.m_History->Add(m_Edit, std::move(*m_Before), m_rDocument.m_Target);
		if (!bFits && !std::exchange(m_rDocument.m_bForgotTold, true))
			NVX_LOG(c_LogCategory, NVX::ELogInformation,
			    "The oldest edits can no longer be undone: what is kept for that has reached %1% MiB",
			    m_rDocument.m_History->MostBytes() >> 20);
	}
	catch (const std::bad_alloc&)
	{
		// Without this edit the way back would lead to what never was.
		m_rDocument.m_History->Clear();
	}
}

void VRetargetSetupCore::KeepHistory(
    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelection, std::size_t i_MostBytes)
{
	m_pSelection = std::move(i_pSelection);
	m_History.emplace(i_MostBytes);
}

void VRetargetSetupCore::EndStep()
{
	if (m_History)
		m_History->EndStep(m_Target);
}

std::string VRetargetSetupCore::StepName(bool i_bBack) const
{
	const char* const pName = m_History ? m_History->NextName(i_bBack) : nullptr;
	return pName ? pName : "";
}

void VRetargetSetupCore::Move(bool i_bBack)
{
	m_LeavingSignal.Fire();
	EndStep();
	if (StepName(i_bBack).empty())
		return CommandIgnored(i_bBack ? "Undo" : "Redo",
		    i_bBack ? RetargetSetup::Ignored::c_NothingToUndo : RetargetSetup::Ignored::c_NothingToRedo);
	const bool bScaledRootHeight = ScaleRootHeight();
	m_Target.m_Selection = Selected();
	if (m_History->Next(i_bBack).m_SourceName)
		m_Target.m_SourceName = m_SourceName;
	const char* const pName = m_History->Move(i_bBack, m_Target);
	std::vector<NVX::ISelectionItem> selection = std::exchange(m_Target.m_Selection, {});
	// Without a name there was no source, and the one that is shown now does no harm.
	if (const auto source = std::exchange(m_Target.m_SourceName, std::nullopt); source && !source->empty())
		m_SourceName = *source;
	NVX_LOG(c_LogCategory, NVX::ELogInformation, i_bBack ? "Undone: %1%" : "Done again: %1%", pName);
	Publish();
	if (ScaleRootHeight() != bScaledRootHeight)
		ScaleRootHeightChanged();
	TargetSubjectBroughtBack(m_Target.m_pFile->m_Path);
	UnsavedChangesChanged();
	SelectSoon(std::move(selection));
}

std::vector<NVX::ISelectionItem> VRetargetSetupCore::Selected() const
{
	std::vector<NVX::ISelectionItem> items;
	if (m_pSelection)
		std::ranges::copy_if(m_pSelection->Selection().Items(), std::back_inserter(items), RetargetSetup::IsOfDocument);
	return items;
}

void VRetargetSetupCore::SelectSoon(std::vector<NVX::ISelectionItem> i_Items) const
{
	if (!m_pSelection || !m_pDispatcher)
		return;
	// Behind those who hear of the change, and drop from the selection what is no longer there.
	m_pDispatcher->Post(
	    [pSelection = m_pSelection, items = std::move(i_Items)]() mutable
	    {
		    const auto& rNow = pSelection->Selection().Items();
		    std::ranges::copy_if(rNow, std::back_inserter(items),
		        [](const auto& i_rItem) { return !RetargetSetup::IsOfDocument(i_rItem); });
		    pSelection->Selection().Replace(items);
	    });
}

std::shared_ptr<VTargetFile> VRetargetSetupCore::NewFile()
{
	auto pFile = std::make_shared<VTargetFile>();
	std::erase_if(m_Files, [](const auto& i_rpFile) { return i_rpFile.expired(); });
	m_Files.push_back(pFile);
	return pFile;
}
