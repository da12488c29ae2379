#include "InMemoryHost/Dispatcher.h"

namespace InMemoryHost
{

void VDispatcher::Post(std::function<void()> i_Callback)
{
	const std::lock_guard lock(m_Mutex);
	m_Queue.push_back(std::move(i_Callback));
}

std::size_t VDispatcher::RunPending()
{
	for (std::size_t count = 0;; ++count)
	{
		std::function<void()> callback;
		{
			const std::lock_guard lock(m_Mutex);
			if (m_Queue.empty())
				return count;
			callback = std::move(m_Queue.front());
			m_Queue.pop_front();
		}
		callback();
	}
}

std::size_t VDispatcher::PendingCount() const
{
	const std::lock_guard lock(m_Mutex);
	return m_Queue.size();
}

} // namespace InMemoryHost
