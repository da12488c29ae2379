#pragma once

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <atomic>
#include <cstdint>

namespace NVX
{

/// The root of host objects that count their owners and end themselves with the last one.
class ICounted
{
public:
	virtual void AddRef() const noexcept = 0;
	virtual void Release() const noexcept = 0;

protected:
	virtual ~ICounted() = default;
};

inline void intrusive_ptr_add_ref(const ICounted* i_pObject) noexcept
{
	i_pObject->AddRef();
}
inline void intrusive_ptr_release(const ICounted* i_pObject) noexcept
{
	i_pObject->Release();
}

/// One owner of a counted object. Taking a plain pointer raises the count, which starts at 0.
template <typename T>
using CountedPointer = boost::intrusive_ptr<T>;

/// Adds the counting to an implementation of a counted interface. Owners may live on different threads.
template <typename TInterface>
class VCounted : public TInterface
{
public:
	void AddRef() const noexcept final { m_Count.fetch_add(1, std::memory_order_relaxed); }

	void Release() const noexcept final
	{
		if (m_Count.fetch_sub(1, std::memory_order_acq_rel) == 1)
			delete this;
	}

protected:
	~VCounted() override = default;

private:
	mutable std::atomic<std::uint32_t> m_Count{0};
};

} // namespace NVX
