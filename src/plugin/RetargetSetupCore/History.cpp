#include "RetargetSetupCore/History.h"

#include <string_view>
#include <utility>

namespace RetargetSetup
{

bool VHistory::GoesOn(const VEdit& i_rEdit) const
{
	return m_bOpen && i_rEdit.m_Way != 0 && i_rEdit.m_Way == m_Back.back().m_Edit.m_Way
	    && std::string_view(i_rEdit.m_pName) == m_Back.back().m_Edit.m_pName;
}

bool VHistory::Add(const VEdit& i_rEdit, VTargetState i_Before, const VTargetState& i_rNow)
{
	EndStep(i_Before);
	const std::size_t bytes = BytesBeside(i_Before, i_rNow);
	m_Back.push_back({i_rEdit, std::move(i_Before), bytes});
	m_Bytes += bytes;
	m_Held = std::exchange(m_Forward, {});
	m_bOpen = i_rEdit.m_Way != 0;
	if (!m_bOpen)
		Drop(m_Held);
	const bool bFits = m_Bytes <= m_MostBytes;
	while (m_Bytes > m_MostBytes && m_Back.size() > 1)
	{
		m_Bytes -= m_Back.front().m_Bytes;
		m_Back.pop_front();
	}
	return bFits;
}

void VHistory::EndStep(const VTargetState& i_rNow)
{
	if (!std::exchange(m_bOpen, false))
		return;
	if (!HoldTheSame(m_Back.back().m_State, i_rNow))
		return Drop(m_Held);
	m_Bytes -= m_Back.back().m_Bytes;
	m_Back.pop_back();
	m_Forward = std::exchange(m_Held, {});
}

const char* VHistory::Move(bool i_bBack, VTargetState& io_rNow)
{
	VSteps& rFrom = StepsOf(i_bBack);
	if (rFrom.empty())
		return nullptr;
	VStep step = std::move(rFrom.back());
	rFrom.pop_back();
	std::swap(step.m_State, io_rNow);
	m_Bytes -= step.m_Bytes;
	step.m_Bytes = BytesBeside(step.m_State, io_rNow);
	m_Bytes += step.m_Bytes;
	const char* const pName = step.m_Edit.m_pName;
	StepsOf(!i_bBack).push_back(std::move(step));
	return pName;
}

const char* VHistory::NextName(bool i_bBack) const
{
	const VSteps& rSteps = StepsOf(i_bBack);
	return rSteps.empty() ? nullptr : rSteps.back().m_Edit.m_pName;
}

void VHistory::Clear()
{
	for (VSteps* const pSteps : {&m_Back, &m_Forward, &m_Held})
		Drop(*pSteps);
	m_bOpen = false;
}

void VHistory::Drop(VSteps& io_rSteps)
{
	for (const VStep& rStep : io_rSteps)
		m_Bytes -= rStep.m_Bytes;
	io_rSteps.clear();
}

} // namespace RetargetSetup
