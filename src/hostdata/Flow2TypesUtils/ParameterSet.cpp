#include "Flow2TypesUtils/ParameterSet.h"

#include "Flow2TypesUtils/FlowParametersItem.h"

using Flow2TypesUtils::FlowParametersItem;

namespace Flow2Utils
{

namespace
{

bool IsSameItem(const FlowParametersItem& i_rLeft, const FlowParametersItem& i_rRight)
{
	return &i_rLeft == &i_rRight
	    || (i_rLeft.m_Identity == i_rRight.m_Identity && i_rLeft.m_Revision == i_rRight.m_Revision);
}

} // namespace

VParameterSet::VParameterSet() = default;
VParameterSet::~VParameterSet() = default;

bool VParameterSet::Add(std::unique_ptr<VParameter> i_pParameter)
{
	if (!i_pParameter || Find(i_pParameter->Name()))
		return false;
	const std::string& rName = i_pParameter->Name();
	m_Parameters.emplace(rName, std::move(i_pParameter));
	++m_ChangeCounter;
	return true;
}

const VParameter* VParameterSet::Find(const std::string& i_rName) const
{
	const auto found = m_Parameters.find(i_rName);
	return found == m_Parameters.end() ? nullptr : found->second.get();
}

VParameter* VParameterSet::FindMutable(const std::string& i_rName)
{
	const auto found = m_Parameters.find(i_rName);
	return found == m_Parameters.end() ? nullptr : found->second.get();
}

void VParameterSet::TellChange(const VParameter& i_rParameter, std::uint64_t i_CounterBefore)
{
	if (i_rParameter.ChangeCounter() == i_CounterBefore)
		return;
	++m_ChangeCounter;
	m_ChangedSignal.Fire(i_rParameter.Name());
}

std::uint32_t VParameterSet::SetParameter(
    const std::string& i_rName, const std::string& i_rText, std::uint32_t i_Flags, std::string* io_pMessage)
{
	return Change(
	    i_rName, [&i_rText](VParameter& io_rParameter) { return io_rParameter.SetText(i_rText); }, i_Flags,
	    io_pMessage);
}

std::uint32_t VParameterSet::Change(const std::string& i_rName, const std::function<bool(VParameter&)>& i_rSet,
    std::uint32_t i_Flags, std::string* io_pMessage)
{
	const auto fail = [&](std::uint32_t i_Status, const char* i_pWhat)
	{
		if ((i_Flags & EReport) && io_pMessage)
			*io_pMessage += i_pWhat + i_rName + "\n";
		return i_Status;
	};
	VParameter* const pParameter = FindMutable(i_rName);
	if (!pParameter)
		return fail(NVX::Status::c_UnknownName, "Unknown parameter ");
	const std::uint64_t before = pParameter->ChangeCounter();
	if (!i_rSet(*pParameter))
		return fail(NVX::Status::c_ParseFailure, "Could not parse parameter ");
	TellChange(*pParameter, before);
	return NVX::Status::c_Success;
}

void VParameterSet::Reset()
{
	for (const auto& [name, pParameter] : m_Parameters)
	{
		const std::uint64_t before = pParameter->ChangeCounter();
		pParameter->Reset();
		TellChange(*pParameter, before);
	}
}

bool VParameterSet::IsValid(std::string& o_rMessage) const
{
	o_rMessage.clear();
	std::string message;
	for (const auto& [name, pParameter] : m_Parameters)
		if (!pParameter->IsValid(message))
			o_rMessage.append("Parameter ").append(name).append(": ").append(message).append("\n");
	return o_rMessage.empty();
}

std::uint32_t VParameterSet::Apply(
    const std::shared_ptr<const FlowParametersItem>& i_rpItem, std::uint32_t i_Flags, std::string* io_pMessage)
{
	if (!i_rpItem || !i_rpItem->m_pParameters)
		return NVX::Status::c_Success;
	VUpdateParametersCookie& rCookie = m_UpdateCookie;
	if (rCookie.m_pItem && IsSameItem(*rCookie.m_pItem, *i_rpItem) && rCookie.m_ChangeCounter == m_ChangeCounter
	    && rCookie.m_Flags == i_Flags)
		return NVX::Status::c_Success;
	std::uint32_t result = NVX::Status::c_Success;
	for (const auto& [name, pParameter] : i_rpItem->m_pParameters->Parameters())
	{
		if (!pParameter->IsSet() && !pParameter->HasDefault())
			continue;
		const std::uint32_t status = Change(
		    name, [&rpFrom = pParameter](VParameter& io_rParameter) { return io_rParameter.SetFrom(*rpFrom); }, i_Flags,
		    io_pMessage);
		if (result == NVX::Status::c_Success)
			result = status;
	}
	// What failed is tried and told again.
	rCookie = result == NVX::Status::c_Success ? VUpdateParametersCookie{i_rpItem, m_ChangeCounter, i_Flags}
	                                           : VUpdateParametersCookie{};
	return result;
}

std::shared_ptr<VParameterSetCookie> VParameterSet::Watch(std::function<void(const std::string&)> i_Callback)
{
	return std::make_shared<VParameterSetCookie>(m_ChangedSignal.Connect(std::move(i_Callback)));
}

std::shared_ptr<VParameterSet> VParameterSet::Clone() const
{
	auto pClone = std::make_shared<VParameterSet>();
	for (const auto& [name, pParameter] : m_Parameters)
		pClone->Add(pParameter->Clone());
	return pClone;
}

} // namespace Flow2Utils
