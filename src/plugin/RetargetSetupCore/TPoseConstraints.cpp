#include "RetargetSetupCore/TPoseConstraints.h"

#include "CoreOrlexTypes/JointType.h"

#include <algorithm>

using CoreOrlexQRTIO::VSubjectQRTExtras;
using CoreOrlexTypes::VSubjectParametrised;

namespace RetargetSetup
{

namespace
{

std::size_t JointSize(const VSubjectParametrised::VSegment& i_rSegment)
{
	return CoreOrlexTypes::StateSize(i_rSegment.m_Joint.m_JointType);
}

bool BelongTogether(const VSubjectParametrised& i_rSubject, const VSubjectQRTExtras& i_rExtras)
{
	return std::equal(i_rSubject.m_Segments.begin(), i_rSubject.m_Segments.end(), i_rExtras.m_Segments.begin(),
	    i_rExtras.m_Segments.end(),
	    [](const auto& i_rSegment, const auto& i_rRecord) { return i_rSegment.m_Name == i_rRecord.m_Name; });
}

} // namespace

VTPoseShares::VTPoseShares(const VSubjectParametrised& i_rSubject, const VSubjectQRTExtras& i_rExtras)
{
	const std::vector<double>& rList = i_rSubject.m_TPoseConstraints;
	if (rList.empty())
		return;
	const bool bExtras = BelongTogether(i_rSubject, i_rExtras);
	const auto hasShare = [&i_rExtras](std::size_t i_Index) { return i_rExtras.m_Segments[i_Index].m_Joint.m_bHasT; };
	std::size_t all = 0;
	std::size_t told = 0;
	for (std::size_t i = 0; i < i_rSubject.m_Segments.size(); ++i)
	{
		all += JointSize(i_rSubject.m_Segments[i]);
		told += bExtras && hasShare(i) ? JointSize(i_rSubject.m_Segments[i]) : 0;
	}
	if (told == rList.size())
		m_Layout = ELayout::EJointsOfExtras;
	else if (all == rList.size())
		m_Layout = ELayout::EEveryJoint;
	else
		return;
	auto begin = rList.begin();
	for (std::size_t i = 0; i < i_rSubject.m_Segments.size(); ++i)
	{
		const bool bShare = m_Layout == ELayout::EEveryJoint || hasShare(i);
		const auto end = begin + std::ptrdiff_t(bShare ? JointSize(i_rSubject.m_Segments[i]) : 0);
		m_Shares.emplace_back(begin, end);
		begin = end;
	}
}

void VTPoseShares::Restore(VSubjectParametrised& io_rSubject, VSubjectQRTExtras& io_rExtras) const
{
	if (m_Layout == ELayout::EUnknown)
		return;
	std::vector<double> list;
	for (std::size_t i = 0; i < m_Shares.size(); ++i)
	{
		const std::size_t size = JointSize(io_rSubject.m_Segments[i]);
		if (m_Shares[i].size() == size)
			list.insert(list.end(), m_Shares[i].begin(), m_Shares[i].end());
		else if (m_Layout == ELayout::EEveryJoint)
			list.insert(list.end(), size, CoreOrlexTypes::c_NotSet);
		else
			io_rExtras.m_Segments[i].m_Joint.m_bHasT = false;
	}
	io_rSubject.m_TPoseConstraints = std::move(list);
}

} // namespace RetargetSetup
