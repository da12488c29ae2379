#include "FileSystemWatcher/DirectoryMonitor.h"

#include <algorithm>

bool FileSystemWatcher::PairRenames(std::vector<VSystemEvent>& io_rEvents, bool i_bMoreToCome)
{
	std::vector<VSystemEvent> events;
	events.reserve(io_rEvents.size());
	for (VSystemEvent& rEvent : io_rEvents)
	{
		// The halves come one after the other, but events of other directories may stand between them.
		const auto isPartner = [&](const VSystemEvent& i_rOther)
		{
			return i_rOther.m_Change == ERenamedOld && i_rOther.m_Rename == rEvent.m_Rename
			    && i_rOther.m_Watch == rEvent.m_Watch;
		};
		if (rEvent.m_Change == ERenamedNew && rEvent.m_Rename != 0)
		{
			const auto old = std::find_if(events.begin(), events.end(), isPartner);
			if (old == events.end())
				rEvent.m_Change = EAdded;
			else
			{
				VSystemEvent first = std::move(*old);
				events.erase(old);
				first.m_Rename = rEvent.m_Rename = 0;
				events.push_back(std::move(first));
			}
		}
		events.push_back(std::move(rEvent));
	}
	io_rEvents = std::move(events);
	bool bLeft = false;
	for (VSystemEvent& rEvent : io_rEvents)
		if (rEvent.m_Change == ERenamedOld && rEvent.m_Rename != 0)
		{
			if (i_bMoreToCome && &rEvent == &io_rEvents.back())
				bLeft = true;
			else
				rEvent.m_Change = ERemoved;
		}
	return bLeft;
}
