#pragma once

#include "NVX/Signal.h"
#include "Variant/Variant.h"

#include <string>
#include <vector>

namespace TesselPluginInterface
{

/// Typed values by key ("RetargetSetup/TargetScale"), shared by the host and its plug-ins. Code reads and writes
/// through the holders of TesselDataStore, which keep the lock for their life: many readers at once, or one writer.
class IDataStore
{
public:
	virtual ~IDataStore() = default;

	/// Locks count per thread: a thread may read again while it reads, and read and write again while it writes.
	/// A lock is released by the thread that took it.
	virtual void LockRead() = 0;
	virtual void UnlockRead() = 0;
	/// A thread that reads and asks to write would wait for itself: that fails an assertion.
	/// @return false then, without a lock.
	virtual bool LockWrite() = 0;
	/// With the thread's last one the changes are told.
	virtual void UnlockWrite() = 0;

	/// For who holds a lock. Null if there is no such entry; valid until the lock is released or the entry written.
	virtual const NVX::IO::VVariant* Find(const std::string& i_rKey) const = 0;
	virtual std::vector<std::string> GetKeys(const std::string& i_rPrefix) const = 0;

	/// For who holds the write lock.
	virtual void Set(const std::string& i_rKey, NVX::IO::VVariant i_Value) = 0;
	virtual bool Remove(const std::string& i_rKey) = 0;

	/// Calls back with an entry's key after its value has changed, once for each time that a writer ended; always
	/// through the dispatcher, so that the callback may read and write. A write of what stood there already is no
	/// change. The callback reads the current value itself, which may have changed again by then.
	/// @param i_rKey of the entry; one that is empty or ends with "/" stands for all keys that begin with it.
	/// @param i_pDispatcher must not be null.
	using VChangedCallback = std::function<void(const std::string& i_rKey)>;
	virtual NVX::VConnection Subscribe(
	    const std::string& i_rKey, VChangedCallback i_Callback, std::shared_ptr<IDispatcher> i_pDispatcher) = 0;
};

} // namespace TesselPluginInterface
