#pragma once

#include "TesselPluginInterface/IDataStore.h"

#include <map>
#include <mutex>
#include <optional>
#include <shared_mutex>

namespace TesselDataStore
{

/// A store in memory. All functions may be called from any thread.
class VDataStore : public TesselPluginInterface::IDataStore
{
public:
	VDataStore() = default;
	VDataStore(const VDataStore&) = delete;
	VDataStore& operator=(const VDataStore&) = delete;

	void LockRead() override;
	void UnlockRead() override;
	bool LockWrite() override;
	void UnlockWrite() override;

	const NVX::IO::VVariant* Find(const std::string& i_rKey) const override;
	std::vector<std::string> GetKeys(const std::string& i_rPrefix) const override;
	void Set(const std::string& i_rKey, NVX::IO::VVariant i_Value) override;
	bool Remove(const std::string& i_rKey) override;

	NVX::VConnection Subscribe(const std::string& i_rKey, VChangedCallback i_Callback,
	    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher) override;

private:
	using VEntries = std::map<std::string, NVX::IO::VVariant>;
	using VSubscribers = NVX::VSignal<std::string>;

	/// What stood at a key when the writer came; nothing if there was no entry.
	void Remember(const std::string& i_rKey);
	std::vector<std::string> TakeChanges();
	void Tell(const std::vector<std::string>& i_rKeys);

	std::shared_mutex m_Mutex;
	VEntries m_Entries;
	/// Of the writer.
	std::map<std::string, std::optional<NVX::IO::VVariant>> m_Before;

	std::mutex m_SubscribersMutex;
	std::map<std::string, std::shared_ptr<VSubscribers>> m_Subscribers;
};

} // namespace TesselDataStore
