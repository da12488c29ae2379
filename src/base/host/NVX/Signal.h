#pragma once

#include "NVX/Shared.h"
#include "TesselPluginInterface/IDispatcher.h"

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
		auto pCall = std::make_shared<VCall>(std::move(i_Callback));
		VConnection connection{std::shared_ptr<std::atomic<bool>>(pCall, &pCall->m_bAlive)};
		const std::lock_guard lock(m_Mutex);
		// A signal that seldom fires must not gather what has gone.
		Purge();
		m_Entries.push_back({std::move(pCall), std::move(i_pDispatcher)});
		return connection;
	}

	void Fire(const VArguments&... i_rArguments)
	{
		for (const VEntry& rEntry : LivingEntries())
		{
			// What is posted does not own the dispatcher: the two would keep each other if it never ran.
			if (rEntry.m_pDispatcher)
				rEntry.m_pDispatcher->Post([pCall = rEntry.m_pCall, i_rArguments...] { pCall->Run(i_rArguments...); });
			else
				rEntry.m_pCall->Run(i_rArguments...);
		}
		const std::lock_guard lock(m_Mutex);
		Purge();
	}

	/// Callbacks that would be called now.
	std::size_t Count() { return LivingEntries().size(); }

private:
	struct VCall
	{
		explicit VCall(VCallback i_Callback) : m_Callback(std::move(i_Callback)) {}

		void Run(const VArguments&... i_rArguments)
		{
			if (!m_bAlive.load())
				return;
			try
			{
				m_Callback(i_rArguments...);
			}
			catch (const VDeregisterWeakCallbackException&)
			{
				m_bAlive.store(false);
			}
		}

		const VCallback m_Callback;
		std::atomic<bool> m_bAlive{true};
	};

	struct VEntry
	{
		std::shared_ptr<VCall> m_pCall;
		std::shared_ptr<TesselPluginInterface::IDispatcher> m_pDispatcher;
	};

	std::vector<VEntry> LivingEntries()
	{
		const std::lock_guard lock(m_Mutex);
		Purge();
		return m_Entries;
	}

	void Purge()
	{
		std::erase_if(m_Entries, [](const VEntry& i_rEntry) { return !i_rEntry.m_pCall->m_bAlive.load(); });
	}

	std::mutex m_Mutex;
	std::vector<VEntry> m_Entries;
};

} // namespace NVX
