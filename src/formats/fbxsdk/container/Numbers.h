#pragma once

#include <memory>
#include <vector>

namespace FbxFormat
{

/// Leaves what a vector makes room for undefined: the numbers of an array are decoded over it.
template <typename T>
struct VUninitialised : std::allocator<T>
{
	template <typename TOther>
	struct rebind
	{
		using other = VUninitialised<TOther>;
	};
	using std::allocator<T>::allocator;

	template <typename TOther>
	void construct(TOther* o_pNumber) noexcept
	{
		::new (static_cast<void*>(o_pNumber)) TOther;
	}
	template <typename TOther, typename... TArguments>
	void construct(TOther* o_pNumber, TArguments&&... i_Arguments)
	{
		::new (static_cast<void*>(o_pNumber)) TOther(std::forward<TArguments>(i_Arguments)...);
	}
};

/// The numbers of an array.
template <typename T>
using VArrayNumbers = std::vector<T, VUninitialised<T>>;

} // namespace FbxFormat
