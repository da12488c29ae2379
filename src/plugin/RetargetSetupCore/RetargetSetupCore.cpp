#include "RetargetSetupCore/RetargetSetupCore.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/IgnoredCommands.h"
#include "RetargetSetupCore/RootHeight.h"
#include "RetargetSetupCore/SessionSteps.h"
#include "RetargetSetupCore/StepNames.h"
#include "math/NumberText.h"

#include <algorithm>

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using NVX::CountedPointer;
using RetargetSetup::c_LogCategory;
using TesselPluginInterface::IFlowItem;

namespace
{

/// The scene tells the two subjects apart by their flow types.
const std::string c_SourceFlavour;
const std::string c_TargetFlavour = "ForSolving";

template <typename T>
bool CopyOut(const std::shared_ptr<const T>& i_rpValue, T& o_rValue)
{
	if (i_rpValue)
		o_rValue = *i_rpValue;
	return i_rpValue != nullptr;
}

} // namespace

VRetargetSetupCore::VRetargetSetupCore(std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
    CountedPointer<TesselPluginInterface::IFrameFactory> i_pFrameFactory,
    CountedPointer<TesselPluginInterface::IItemFactory> i_pItemFactory)
    : m_pDispatcher(std::move(i_pDispatcher)), m_pFrameFactory(std::move(i_pFrameFactory)),
      m_pItemFactory(std::move(i_pItemFactory))
{
	m_Target.m_pFile = NewFile();
}

VRetargetSetupCore::~VRetargetSetupCore() = default;

void VRetargetSetupCore::SetHostRules(std::shared_ptr<TesselPluginInterface::IHostRules> i_pRules)
{
	m_pHostRules = std::move(i_pRules);
}

TesselPluginInterface::VHostRules VRetargetSetupCore::HostRules() const
{
	return m_pHostRules ? m_pHostRules->Rules() : TesselPluginInterface::VHostRules();
}

bool VRetargetSetupCore::MayReplaceTarget(const char* i_pCommand, const char* i_pAction)
{
	// What a press of the button made, another press makes again.
	const bool bLoses = HasUnsavedChanges() && TargetDiffersFrom(m_Target.m_pFile->m_Made);
	if (!bLoses || !m_pHostRules || m_pHostRules->MayReplaceTargetSubject(i_pAction))
		return true;
	CommandIgnored(i_pCommand, RetargetSetup::Ignored::c_TargetKept);
	return false;
}

void VRetargetSetupCore::SetJointSymmetry(bool i_bJointSymmetry)
{
	if (i_bJointSymmetry == m_bJointSymmetry)
		return;
	m_bJointSymmetry = i_bJointSymmetry;
	JointSymmetryChanged();
}

void VRetargetSetupCore::SetTargetRootIndex(std::uint32_t i_RootIndex, bool i_bChosen)
{
	m_TargetRootIndex = i_RootIndex;
	m_bTargetRootChosen = i_bChosen;
}

void VRetargetSetupCore::SetTargetScale(double i_Scale)
{
	if (!RetargetSetup::IsUsableScale(i_Scale))
	{
		NVX_LOG(c_LogCategory, NVX::ELogWarning, "A scale must be a finite number above 0, not %1%: the old one stays",
		    i_Scale);
		return;
	}
	const std::shared_ptr<const VSubjectParametrised> pOld = TargetValues().m_pParametrised;
	const std::string dropped = pOld ? RetargetSetup::DroppedParameters(*pOld) : "";
	if (const std::string lost = dropped.empty() ? "" : RetargetSetup::LostParameters(*pOld); !lost.empty())
	{
		NVX_LOG(c_LogCategory, NVX::ELogWarning,
		    "The scale stays: another one takes the place of the dynamic parameters '%1%', which the target subject "
		    "needs",
		    lost);
		return;
	}
	if (!pOld)
	{
		m_Target.m_NextScale = i_Scale;
		return;
	}
	const VStep step(
	    *this, RetargetSetup::EditAs(RetargetSetup::Steps::c_Scale, "scale", NumberText::PrintShortest(i_Scale)));
	m_Target.m_NextScale = i_Scale;
	if (!dropped.empty())
		NVX_LOG(c_LogCategory, NVX::ELogWarning, "The new scale drops the dynamic parameters '%1%'", dropped);
	VSubjectParametrised subject = *pOld;
	const double factor = RootFactor(i_Scale) / RootFactor(RetargetSetup::GetGlobalScale(subject));
	RetargetSetup::SetGlobalScale(subject, i_Scale);
	if (factor != 1.0)
		RetargetSetup::ScaleRootHeight(subject, factor);
	if (!ScaleRootHeight())
		RetargetSetup::TellLowestSegment(subject);
	SetTargetSubjectParametrised(std::move(subject));
}

void VRetargetSetupCore::SetNextTargetScale(double i_Scale)
{
	if (RetargetSetup::IsUsableScale(i_Scale))
		m_Target.m_NextScale = i_Scale;
}

double VRetargetSetupCore::GetTargetScale() const
{
	const std::shared_ptr<const VSubjectParametrised> pSubject = TargetValues().m_pParametrised;
	return pSubject ? RetargetSetup::GetGlobalScale(*pSubject) : 1.0;
}

bool VRetargetSetupCore::GetSourceTemplate(VSubject& o_rSubject) const
{
	return CopyOut(SourceValues().m_pSubject, o_rSubject);
}

bool VRetargetSetupCore::GetSourceSubject(VSubjectParametrised& o_rSubject) const
{
	return CopyOut(SourceValues().m_pParametrised, o_rSubject);
}

bool VRetargetSetupCore::GetTargetTemplate(VSubject& o_rSubject) const
{
	return CopyOut(TargetValues().m_pSubject, o_rSubject);
}

bool VRetargetSetupCore::GetTargetSubject(VSubjectParametrised& o_rSubject) const
{
	return CopyOut(TargetValues().m_pParametrised, o_rSubject);
}

bool VRetargetSetupCore::GetTargetSubjectAndData(
    VSubjectParametrised& o_rSubject, VSubjectApplicationData& o_rApplicationData) const
{
	const VSubjectValues values = TargetValues();
	return values.m_pApplicationData && CopyOut(values.m_pParametrised, o_rSubject)
	    && CopyOut(values.m_pApplicationData, o_rApplicationData);
}

void VRetargetSetupCore::SetSourceSubject(
    VSubjectParametrised i_Parametrised, VSubjectApplicationData i_ApplicationData)
{
	if (Replace(m_SourceItems, std::make_shared<const VSubjectParametrised>(std::move(i_Parametrised)),
	        std::make_shared<const VSubjectApplicationData>(std::move(i_ApplicationData))))
		m_SourceFile = {};
}

bool VRetargetSetupCore::SetTargetSubject(VSubjectParametrised i_Parametrised,
    VSubjectApplicationData i_ApplicationData, CoreOrlexQRTIO::VSubjectQRTExtras i_Extras,
    const RetargetSetup::VEdit& i_rEdit)
{
	const VStep step(*this, i_rEdit);
	if (!ReplaceTargetItems(std::move(i_Parametrised),
	        std::make_shared<const VSubjectApplicationData>(std::move(i_ApplicationData)), NewIdentities()))
		return false;
	TakeExtras(std::move(i_Extras));
	m_Target.m_AtRest = TargetValues();
	if (i_rEdit.m_Commands.empty())
		BeginSession({});
	return true;
}

void VRetargetSetupCore::TakeExtras(CoreOrlexQRTIO::VSubjectQRTExtras i_Extras)
{
	// Most edits leave them as they are.
	if (!(i_Extras == GetTargetExtras()))
		m_Target.m_pExtras = std::make_shared<const CoreOrlexQRTIO::VSubjectQRTExtras>(std::move(i_Extras));
}

void VRetargetSetupCore::SetTargetSubjectParametrised(
    VSubjectParametrised i_Parametrised, const RetargetSetup::VEdit& i_rEdit)
{
	const VStep step(*this, i_rEdit);
	VIdentities identities = m_Target.m_Identities;
	if (i_Parametrised.m_Targets.size() != identities.m_Targets.size())
		identities.m_Targets.clear();
	ReplaceTargetItems(std::move(i_Parametrised), nullptr, std::move(identities));
}

bool VRetargetSetupCore::ReplaceTarget(const char* i_pCommand, VSubjectParametrised i_Parametrised,
    std::shared_ptr<const VSubjectApplicationData> i_pApplicationData, VIdentities i_Identities)
{
	const bool bReplaced =
	    ReplaceTargetItems(std::move(i_Parametrised), std::move(i_pApplicationData), std::move(i_Identities));
	if (!bReplaced)
		CommandIgnored(i_pCommand, RetargetSetup::Ignored::c_HostRefused);
	return bReplaced;
}

bool VRetargetSetupCore::ReplaceTargetItems(VSubjectParametrised i_Parametrised,
    std::shared_ptr<const VSubjectApplicationData> i_pApplicationData, VIdentities i_Identities)
{
	while (i_Identities.m_Targets.size() < i_Parametrised.m_Targets.size())
		i_Identities.m_Targets.push_back(++m_LastIdentity);
	// The change signal fires within, and whoever hears it may ask.
	std::swap(m_Target.m_Identities, i_Identities);
	if (Replace(m_Target.m_Items, std::make_shared<const VSubjectParametrised>(std::move(i_Parametrised)),
	        std::move(i_pApplicationData)))
	{
		UnsavedChangesChanged();
		return true;
	}
	std::swap(m_Target.m_Identities, i_Identities);
	return false;
}

std::uint64_t VRetargetSetupCore::TargetIdentity(std::int32_t i_TargetIndex) const
{
	const std::vector<std::uint64_t>& rTargets = m_Target.m_Identities.m_Targets;
	return std::uint32_t(i_TargetIndex) < rTargets.size() ? rTargets[std::size_t(i_TargetIndex)] : 0;
}

std::int32_t VRetargetSetupCore::TargetOfIdentity(std::uint64_t i_Identity) const
{
	const std::vector<std::uint64_t>& rTargets = m_Target.m_Identities.m_Targets;
	const auto found = std::find(rTargets.begin(), rTargets.end(), i_Identity);
	return found == rTargets.end() ? -1 : std::int32_t(found - rTargets.begin());
}

template <typename T>
CountedPointer<IFlowItem> VRetargetSetupCore::MakeItem(
    const VSubjectItems& i_rItems, const char* i_pFlowType, std::shared_ptr<const T> i_pValue)
{
	const std::string flowType = i_pFlowType + (&i_rItems == &m_SourceItems ? c_SourceFlavour : c_TargetFlavour);
	CountedPointer<IFlowItem> pItem = m_pItemFactory->CreateItem(flowType);
	if (TesselPluginInterface::SetItemValue<T>(pItem, std::move(i_pValue)))
		return pItem;
	NVX_LOG(c_LogCategory, NVX::ELogError, "The host makes no item of type '%1%': the change is dropped", flowType);
	return {};
}

bool VRetargetSetupCore::Replace(VSubjectItems& io_rItems, std::shared_ptr<const VSubjectParametrised> i_pParametrised,
    std::shared_ptr<const VSubjectApplicationData> i_pApplicationData)
{
	auto pSubject = std::make_shared<VSubject>();
	// A subject that converts in part is still shown and edited; the converter has told what is wrong with it.
	namespace Converter = CoreOrlexTypesUtils::SubjectParametrisedConverter;
	const VSubjectValues before = RetargetSetup::ValuesOf(io_rItems);
	if (before.m_pParametrised && before.m_pSubject)
		Converter::ConvertEditedSubject(*i_pParametrised, *before.m_pParametrised, *before.m_pSubject, *pSubject);
	else
		Converter::ConvertSubject(*i_pParametrised, *pSubject);

	VSubjectItems items = io_rItems;
	items.m_pSubject = MakeItem<VSubject>(io_rItems, "FlowSubject", std::move(pSubject));
	items.m_pParametrised = MakeItem(io_rItems, "FlowSubjectParametrised", std::move(i_pParametrised));
	if (i_pApplicationData)
	{
		items.m_pApplicationData = MakeItem(io_rItems, "FlowSubjectApplicationData", std::move(i_pApplicationData));
		if (!items.m_pApplicationData)
			return false;
	}
	if (!items.m_pSubject || !items.m_pParametrised)
		return false;
	std::swap(io_rItems, items);
	Publish();
	return true;
}

void VRetargetSetupCore::Publish()
{
	m_pFrame = m_pFrameFactory->CreateFrame();
	if (m_pFrame)
	{
		for (const VSubjectItems* const pItems : {&m_SourceItems, &m_Target.m_Items})
		{
			m_pFrame->AddItem(pItems->m_pSubject);
			m_pFrame->AddItem(pItems->m_pApplicationData);
			m_pFrame->AddItem(pItems->m_pParametrised);
		}
	}
	else
		NVX_LOG(c_LogCategory, NVX::ELogError, "The host makes no frame: the preview cannot follow");

	Published();
	UpdatePoseNote();
	m_ChangedSignal.Fire();
}
