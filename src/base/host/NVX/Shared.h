#pragma once

#include <exception>
#include <functional>
#include <memory>
#include <type_traits>
#include <utility>

namespace NVX
{

/// Raised by a weak-bound callback whose object is gone; a signal that catches it drops the callback.
class VDeregisterWeakCallbackException : public std::exception
{
public:
	const char* what() const noexcept override { return "The object of this callback is gone"; }
};

class VShared;

namespace MakeSharedDetail
{

/// What MakeShared allocates: the last class of the line, so that nothing else can make a half-finished T.
template <typename T>
class VSharedFinal final : public T
{
public:
	using T::T;
};

} // namespace MakeSharedDetail

/// For objects that need shared ownership of themselves to finish their construction: made by MakeShared, which stores
/// a weak pointer to the object in it and then calls OnShared once.
class VShared
{
public:
	virtual ~VShared() = default;
	VShared(const VShared&) = delete;
	VShared& operator=(const VShared&) = delete;

protected:
	VShared() = default;

	/// Completes the construction: the object is shared now, and WeakBind works.
	virtual void OnShared() {}

	/// A callback that calls a member of this object while it lives, and raises VDeregisterWeakCallbackException after.
	/// The object is kept alive for the time of the call.
	template <typename T, typename... VArguments>
	std::function<void(VArguments...)> WeakBind(void (T::*i_pMember)(VArguments...)) const
	{
		static_assert(std::is_base_of_v<VShared, T>);
		return [pWeak = m_pWeakThis, i_pMember](VArguments... i_Arguments)
		{
			const std::shared_ptr<VShared> pShared = pWeak.lock();
			if (!pShared)
				throw VDeregisterWeakCallbackException();
			(static_cast<T&>(*pShared).*i_pMember)(std::forward<VArguments>(i_Arguments)...);
		};
	}

private:
	template <typename T, typename... VArguments>
	friend std::shared_ptr<T> MakeShared(VArguments&&... i_Arguments);

	std::weak_ptr<VShared> m_pWeakThis;
};

/// Makes a T, which derives from VShared: construction, the weak pointer to itself, then OnShared.
template <typename T, typename... VArguments>
std::shared_ptr<T> MakeShared(VArguments&&... i_Arguments)
{
	const auto pObject = std::make_shared<MakeSharedDetail::VSharedFinal<T>>(std::forward<VArguments>(i_Arguments)...);
	VShared& rShared = *pObject;
	rShared.m_pWeakThis = pObject;
	rShared.OnShared();
	return pObject;
}

} // namespace NVX
