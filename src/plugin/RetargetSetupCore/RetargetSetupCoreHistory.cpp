// What VRetargetSetupCore keeps of what edits replace, and brings back.

#include "CoreOrlexQRTIO/Writer.h"
#include "DebugServices/GlobalLog.h"
#include "FileDigest/FileDigest.h"
#include "NVX/Status.h"
#include "RetargetSetupCore/FilePath.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/IgnoredCommands.h"
#include "RetargetSetupCore/RetargetSetupCore.h"
#include "SetupIO/CommandText.h"
#include "SetupIO/WriteSetup.h"
#include "TesselPluginInterface/IDispatcher.h"
#include "TesselPluginInterface/ISelectionManager.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/SaveFile.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <iterator>
#include <new>
#include <utility>

using RetargetSetup::c_LogCategory;
using RetargetSetup::VBeginning;
using RetargetSetup::VEdit;
using RetargetSetup::VSessionStep;
using RetargetSetup::VTargetFile;
using RetargetSetup::VTargetState;

VRetargetSetupCore::VStep::VStep(VRetargetSetupCore& io_rDocument, const VEdit& i_rEdit, bool i_bGathers)
    : m_rDocument(io_rDocument), m_Edit(i_rEdit), m_pAround(io_rDocument.m_pStep), m_bGathers(i_bGathers)
{
	if (!m_pAround && m_rDocument.m_History)
		Begin();
	if (m_pAround && m_pAround->m_bGathers)
	{
		auto& rCommands = m_pAround->m_Edit.m_Commands;
		rCommands.insert(rCommands.end(), m_Edit.m_Commands.begin(), m_Edit.m_Commands.end());
		m_pAround->m_bUnknown = m_pAround->m_bUnknown || m_Edit.m_Commands.empty();
	}
	// From where on nothing throws, and the end is sure to come.
	m_rDocument.m_pStep = this;
}

void VRetargetSetupCore::VStep::Begin()
{
	m_bGoesOn = m_rDocument.m_History->GoesOn(m_Edit);
	if (m_bGoesOn)
		return;
	m_rDocument.CloseSessionStep();
	m_Before = m_rDocument.m_Target;
	m_Before->m_Selection = m_rDocument.Selected();
	if (m_Edit.m_bNamesSource)
		m_Before->m_SourceName = m_rDocument.m_SourceName;
}

VRetargetSetupCore::VStep::~VStep()
{
	m_rDocument.m_pStep = m_pAround;
	if (m_bUnknown)
		m_Edit.m_Commands.clear();
	try
	{
		if (m_bGoesOn && m_rDocument.m_Target.m_pSteps)
			m_rDocument.m_Target.m_pSteps->m_Edits = m_Edit.m_Commands;
		if (!m_Before || HoldTheSame(*m_Before, m_rDocument.m_Target))
			return;
		m_rDocument.OpenSessionStep(m_Edit, *m_Before);
		const bool bFits = m_rDocument.m_History->Add(m_Edit, std::move(*m_Before), m_rDocument.m_Target);
		if (!bFits && !std::exchange(m_rDocument.m_bForgotTold, true))
			NVX_LOG(c_LogCategory, NVX::ELogInformation,
			    "The oldest edits can no longer be undone: what is kept for that has reached %1% MiB",
			    m_rDocument.m_History->MostBytes() >> 20);
	}
	catch (const std::bad_alloc&)
	{
		// Without this edit the way back would lead to what never was, and so would the steps.
		m_rDocument.m_History->Clear();
		m_rDocument.m_Target.m_pSteps.reset();
	}
}

void VRetargetSetupCore::RunStep(const VEdit& i_rEdit, const std::function<void()>& i_rEdits)
{
	const VStep step(*this, i_rEdit, true);
	i_rEdits();
	// What recipes know of the single ones they do not know of all.
	if (step.IsUnknown() && i_rEdit.m_Way == 0 && m_Target.m_pSteps)
		BeginSession({});
}

bool VRetargetSetupCore::StepsReadAgain(const boost::filesystem::path& i_rFile) const
{
	if (!m_Target.m_pSteps)
		return false;
	std::vector<std::string> changed;
	const SetupIO::VSetup recipe = RetargetSetup::RecipeOf(*m_Target.m_pSteps, changed);
	const std::string file = UtilsFileSystem::ToUtf8(i_rFile);
	return !changed.empty()
	    || std::ranges::any_of(recipe.m_Edits, [&](const SetupIO::VEdit& i_rEdit) { return i_rEdit.m_Value == file; });
}

void VRetargetSetupCore::BeginSession(RetargetSetup::VBeginning i_Beginning)
{
	m_Target.m_pSteps.reset();
	if (!m_History || !TargetValues().m_pParametrised)
		return;
	i_Beginning.m_bScaleRootHeight = ScaleRootHeight();
	i_Beginning.m_Values = TargetValues();
	i_Beginning.m_pExtras = m_Target.m_pExtras;
	m_Target.m_pSteps = std::make_shared<VSessionStep>();
	m_Target.m_pSteps->m_pBeginning = std::make_shared<const VBeginning>(std::move(i_Beginning));
	m_Target.m_pSteps->m_Source = m_SourceFile;
}

void VRetargetSetupCore::OpenSessionStep(const VEdit& i_rEdit, const VTargetState& i_rBefore)
{
	// What begins anew has told so itself.
	if (!i_rBefore.m_pSteps || m_Target.m_pSteps != i_rBefore.m_pSteps)
		return;
	m_Target.m_pSteps = std::make_shared<VSessionStep>();
	m_Target.m_pSteps->m_pBefore = i_rBefore.m_pSteps;
	m_Target.m_pSteps->m_Edits = i_rEdit.m_Commands;
	m_Target.m_pSteps->m_Source = m_SourceFile;
	m_Target.m_pSteps->m_Start = RetargetSetup::ValuesOf(i_rBefore.m_Items);
	// The rest of a way may bring it back to where it began.
	if (i_rEdit.m_Way == 0)
		CloseSessionStep();
}

void VRetargetSetupCore::CloseSessionStep()
{
	const auto pStep = m_Target.m_pSteps;
	if (!pStep || !pStep->m_Start.m_pParametrised)
		return;
	const VSubjectValues start = std::exchange(pStep->m_Start, {});
	if (!pStep->m_Edits.empty())
		return;
	const auto pSource = SourceValues().m_pParametrised;
	if (auto edits = RetargetSetup::EditsBetween(start, TargetValues(), pSource.get()))
		pStep->m_Edits = std::move(*edits);
	else
		BeginSession({});
	if (pStep->m_Edits.empty() && m_Target.m_pSteps == pStep)
		m_Target.m_pSteps = pStep->m_pBefore;
}

std::optional<SetupIO::VSetup> VRetargetSetupCore::SessionRecipe(const char* i_pCommand)
{
	EndStep();
	if (!m_Target.m_pSteps)
	{
		CommandIgnored(i_pCommand, RetargetSetup::Ignored::c_NoTarget);
		return std::nullopt;
	}
	std::vector<std::string> changed;
	SetupIO::VSetup recipe = RetargetSetup::RecipeOf(*m_Target.m_pSteps, changed);
	for (const std::string& rSentence : changed)
		NVX_LOG(c_LogCategory, NVX::ELogWarning, "%1%", rSentence);
	recipe.m_Output = UtilsFileSystem::ToUtf8(m_Target.m_pFile->m_Path);
	return recipe;
}

std::string VRetargetSetupCore::SessionCommands()
{
	std::optional<SetupIO::VSetup> recipe = SessionRecipe("CopyCommands");
	if (!recipe)
		return {};
	if (recipe->m_Fbx.empty() && recipe->m_Subject.empty())
	{
		CommandIgnored("CopyCommands", RetargetSetup::Ignored::c_BeginningGone);
		return {};
	}
	if (recipe->m_Output.empty())
		recipe->m_Output = m_TargetName.empty() ? "out.qrr" : m_TargetName + ".qrr";
	return SetupIO::CommandText(*recipe);
}

bool VRetargetSetupCore::SaveSessionRecipe(const boost::filesystem::path& i_rPath)
{
	constexpr const char* c_Command = "SaveRecipe";
	std::optional<SetupIO::VSetup> recipe = SessionRecipe(c_Command);
	if (!recipe)
		return false;
	std::string reason;
	const auto fail = [&]
	{
		CommandIgnored(c_Command,
		    RetargetSetup::Ignored::Text(RetargetSetup::Ignored::c_NotSaved, UtilsFileSystem::ToUtf8(i_rPath), reason));
		return false;
	};
	const boost::filesystem::path folder = i_rPath.parent_path();
	const std::string stem = RetargetSetup::FileStem(i_rPath);
	// What it writes must not be what it reads.
	if (recipe->m_Fbx.empty() && (recipe->m_Subject.empty() || recipe->m_Subject == recipe->m_Output))
	{
		const VBeginning& rBeginning = RetargetSetup::BeginningOf(*m_Target.m_pSteps);
		std::string text;
		std::vector<std::string> errors;
		std::vector<std::string> warnings;
		const bool bText = CoreOrlexQRTIO::VWriter().WriteText(*rBeginning.m_Values.m_pParametrised,
		    *rBeginning.m_Values.m_pApplicationData, *rBeginning.m_pExtras, CoreOrlexQRTIO::c_AutomaticVersion, text,
		    errors, warnings);
		if (!bText)
			reason = errors.empty() ? std::string() : errors.front();
		// Another file of the name stays.
		boost::filesystem::path beginning = folder / (stem + "-begin.qrr");
		boost::system::error_code error;
		for (int number = 2; boost::filesystem::exists(beginning, error)
		     && RetargetSetup::DigestOf(beginning) != FileDigest::Sha256OfBytes(text);
		     ++number)
			beginning = folder / (stem + "-begin-" + std::to_string(number) + ".qrr");
		if (!bText || UtilsFileSystem::SaveFile(beginning, text, reason) != NVX::Status::c_Success)
			return fail();
		recipe->m_Subject = UtilsFileSystem::ToUtf8(beginning);
		NVX_LOG(c_LogCategory, NVX::ELogInformation, "What the steps begin with is written to '%1%', beside the recipe",
		    recipe->m_Subject);
	}
	if (recipe->m_Output.empty())
		recipe->m_Output = UtilsFileSystem::ToUtf8(folder / (stem + ".qrr"));
	RetargetSetup::MakeRelative(*recipe, folder);
	return UtilsFileSystem::SaveFile(i_rPath, SetupIO::WriteSetup(*recipe), reason) == NVX::Status::c_Success || fail();
}

void VRetargetSetupCore::KeepHistory(
    std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelection, std::size_t i_MostBytes)
{
	m_pSelection = std::move(i_pSelection);
	m_History.emplace(i_MostBytes);
}

void VRetargetSetupCore::EndStep()
{
	CloseSessionStep();
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
