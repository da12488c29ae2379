#include "TesselDataStore/DataStore.h"

#include "DebugServices/Assert.h"

#include <algorithm>

namespace TesselDataStore
{

namespace
{

/// What the thread holds of a store.
struct VHold
{
	const void* m_pStore = nullptr;
	std::size_t m_Readers = 0;
	std::size_t m_Writers = 0;
	VHold* m_pNext = nullptr;
};

/// Few: a thread seldom has more than two stores open. A plain pointer, since g++'s runtime on Windows destroys what
/// belongs to a thread too late; what it points to is gone when nothing is held.
thread_local VHold* t_pHolds = nullptr;

VHold& HoldOf(const void* i_pStore)
{
	for (VHold* pHold = t_pHolds; pHold; pHold = pHold->m_pNext)
		if (pHold->m_pStore == i_pStore)
			return *pHold;
	return *(t_pHolds = new VHold{i_pStore, 0, 0, t_pHolds});
}

void ForgetIfIdle(const void* i_pStore)
{
	for (VHold** ppHold = &t_pHolds; *ppHold; ppHold = &(*ppHold)->m_pNext)
		if (VHold* const pHold = *ppHold; pHold->m_pStore == i_pStore && pHold->m_Readers + pHold->m_Writers == 0)
		{
			*ppHold = pHold->m_pNext;
			delete pHold;
			return;
		}
}

bool StandsFor(const std::string& i_rSubscribed, const std::string& i_rKey)
{
	if (i_rSubscribed.empty() || i_rSubscribed.back() == '/')
		return i_rKey.starts_with(i_rSubscribed);
	return i_rKey == i_rSubscribed;
}

} // namespace

void VDataStore::LockRead()
{
	VHold& rHold = HoldOf(this);
	if (rHold.m_Readers == 0 && rHold.m_Writers == 0)
		m_Mutex.lock_shared();
	++rHold.m_Readers;
}

void VDataStore::UnlockRead()
{
	VHold& rHold = HoldOf(this);
	--rHold.m_Readers;
	if (rHold.m_Readers == 0 && rHold.m_Writers == 0)
		m_Mutex.unlock_shared();
	ForgetIfIdle(this);
}

bool VDataStore::LockWrite()
{
	VHold& rHold = HoldOf(this);
	if (rHold.m_Writers == 0)
	{
		if (rHold.m_Readers != 0)
		{
			DebugServices::CallAssertFailHandler(
			    "Fatal attempt to acquire a write lock from within a read lock.", __FILE__, __LINE__);
			return false;
		}
		m_Mutex.lock();
	}
	++rHold.m_Writers;
	return true;
}

void VDataStore::UnlockWrite()
{
	VHold& rHold = HoldOf(this);
	if (--rHold.m_Writers != 0)
		return;
	const std::vector<std::string> changed = TakeChanges();
	m_Mutex.unlock();
	// A reader that outlives the writer within which it began.
	if (rHold.m_Readers != 0)
		m_Mutex.lock_shared();
	ForgetIfIdle(this);
	Tell(changed);
}

const NVX::IO::VVariant* VDataStore::Find(const std::string& i_rKey) const
{
	const auto found = m_Entries.find(i_rKey);
	return found == m_Entries.end() ? nullptr : &found->second;
}

std::vector<std::string> VDataStore::GetKeys(const std::string& i_rPrefix) const
{
	std::vector<std::string> keys;
	for (auto at = m_Entries.lower_bound(i_rPrefix); at != m_Entries.end() && at->first.starts_with(i_rPrefix); ++at)
		keys.push_back(at->first);
	return keys;
}

void VDataStore::Set(const std::string& i_rKey, NVX::IO::VVariant i_Value)
{
	Remember(i_rKey);
	m_Entries[i_rKey] = std::move(i_Value);
}

bool VDataStore::Remove(const std::string& i_rKey)
{
	Remember(i_rKey);
	return m_Entries.erase(i_rKey) != 0;
}

NVX::VConnection VDataStore::Subscribe(const std::string& i_rKey, VChangedCallback i_Callback,
    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher)
{
	NVX_ASSERT(i_pDispatcher != nullptr);
	if (!i_pDispatcher)
		return {};
	const std::lock_guard lock(m_SubscribersMutex);
	// Those that have gone are not kept for a change that may never come.
	std::erase_if(m_Subscribers, [](const auto& i_rEntry) { return i_rEntry.second->Count() == 0; });
	std::shared_ptr<VSubscribers>& rpSubscribers = m_Subscribers[i_rKey];
	if (!rpSubscribers)
		rpSubscribers = std::make_shared<VSubscribers>();
	return rpSubscribers->Connect(std::move(i_Callback), std::move(i_pDispatcher));
}

void VDataStore::Remember(const std::string& i_rKey)
{
	const auto [at, bNew] = m_Before.try_emplace(i_rKey);
	if (!bNew)
		return;
	if (const NVX::IO::VVariant* const pEntry = Find(i_rKey))
		at->second = *pEntry;
}

std::vector<std::string> VDataStore::TakeChanges()
{
	std::vector<std::string> changed;
	for (const auto& [rKey, rBefore] : m_Before)
	{
		const NVX::IO::VVariant* const pNow = Find(rKey);
		if (rBefore.has_value() != (pNow != nullptr) || (pNow && *rBefore != *pNow))
			changed.push_back(rKey);
	}
	m_Before.clear();
	return changed;
}

void VDataStore::Tell(const std::vector<std::string>& i_rKeys)
{
	if (i_rKeys.empty())
		return;
	std::vector<std::pair<std::string, std::shared_ptr<VSubscribers>>> subscribers;
	{
		const std::lock_guard lock(m_SubscribersMutex);
		subscribers.assign(m_Subscribers.begin(), m_Subscribers.end());
	}
	for (const std::string& rKey : i_rKeys)
		for (const auto& [rSubscribed, rpSubscribers] : subscribers)
			if (StandsFor(rSubscribed, rKey))
				rpSubscribers->Fire(rKey);
}

} // namespace TesselDataStore
