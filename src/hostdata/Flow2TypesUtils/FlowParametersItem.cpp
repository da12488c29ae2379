#include "Flow2TypesUtils/FlowParametersItem.h"

#include <atomic>

std::uint64_t Flow2TypesUtils::FlowParametersItem::NewIdentity()
{
	static std::atomic<std::uint64_t> s_Last{0};
	return s_Last.fetch_add(1, std::memory_order_relaxed) + 1;
}
