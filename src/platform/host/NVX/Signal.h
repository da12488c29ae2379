#pragma once

#include "NVX/Shared.h"
#include "TesselPluginInterface/IDispatcher.h"

#include <algorithm>
#include <atomic>
#include <functional>
#include <memory>
#include <mutex>
#include <utility>
#include <vector>

namespace NVX
{

/// One callback's place in a signal. Letting go of it changes nothing: the callback stays until Disconnect is called,
/// or until its object is gone if it is bound to a weak pointer.
class VConnection
{
public:
	VConnection() = default;
	explicit VConnection(std::shared_ptr<std::atomic<bool>> i_pAlive) : m_pAlive(std::move(i_pAlive)) {}

	/// No call begins any more, one that is already posted to a dispatcher included.
	void Disconnect()
	{
		if (m_pAlive)
			m_pAlive->store(false);
	}

	bool IsConnected() const { return m_pAlive && m_pAlive->load(); }

private:
	std::shared_ptr<std::atomic<bool>> m_pAlive;
};

/// A list of callbacks. The lock guards the list alone and is never held during a call, so that a callback may connect,
/// disconnect or fire again.
template <typename... VArguments>
class VSignal
{
public:
	using VCallback = std::function<void(const VArguments&...)>;

	VSignal() = default;
	VSignal(const VSignal&) = delete;
	VSignal& operator=(const VSignal&) = delete;

	/// With a dispatcher the callback is posted to it at each firing, with copies of the arguments; without one it is
	/// called at once, on the thread that fires.
	VConnection Connect(VCallback i_Callback, std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher = {})
	{
		auto pEntry = std::make_shared<VEntry>(std::move(i_Callback), std::move(i_pDispatcher));
		VConnection connection{std::shared_ptr<std::atomic<bool>>(pEntry, &pEntry->m_bAlive)};
		const std::lock_guard lock(m_Mutex);
		m_Entries.push_back(std::move(pEntry));
		return connection;
	}

	void Fire(const VArguments&... i_rArguments)
	{
		for (const std::shared_ptr<VEntry>& pEntry : LivingEntries())
		{
			if (pEntry->m_pDispatcher)
				pEntry->m_pDispatcher->Post([pEntry, i_rArguments...] { Call(*pEntry, i_rArguments...); });
			else
				Call(*pEntry, i_rArguments...);
		}
		const std::lock_guard lock(m_Mutex);
		Purge();
	}

	/// Callbacks that would be called now.
	std::size_t Count() { return LivingEntries().size(); }

private:
	struct VEntry
	{
		VEntry(VCallback i_Callback, std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher)
		    : m_Callback(std::move(i_Callback)), m_pDispatcher(std::move(i_pDispatcher))
		{
		}

		const VCallback m_Callback;
		const std::shared_ptr<TesselPluginInterface::IDispatcher> m_pDispatcher;
		std::atomic<bool> m_bAlive{true};
	};

	static void Call(VEntry& i_rEntry, const VArguments&... i_rArguments)
	{
		if (!i_rEntry.m_bAlive.load())
			return;
		try
		{
			i_rEntry.m_Callback(i_rArguments...);
		}
		catch (const VDeregisterWeakCallbackException&)
		{
			i_rEntry.m_bAlive.store(false);
		}
	}

	std::vector<std::shared_ptr<VEntry>> LivingEntries()
	{
		const std::lock_guard lock(m_Mutex);
		Purge();
		return m_Entries;
	}

	void Purge()
	{
		std::erase_if(m_Entries, [](const auto& i_rpEntry) { return !i_rpEntry->m_bAlive.load(); });
	}

	std::mutex m_Mutex;
	std::vector<std::shared_ptr<VEntry>> m_Entries;
};

} // namespace NVX
