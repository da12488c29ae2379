#pragma once

#include "TesselPluginInterface/IFlowFrame.h"

#include <cstdint>

namespace NVX
{

/// A stage of the flow, which makes a frame of a frame. It may keep what it needs to know of the frames before.
class IFlowStateTransform
{
public:
	virtual ~IFlowStateTransform() = default;

	/// @param o_rpOut the frame to pass on, which may be the one that came in
	/// @param i_Time of the frame in the host's ticks; 0 where there is no time
	virtual void Transform(CountedPointer<TesselPluginInterface::IFlowFrame>& o_rpOut,
	    const CountedPointer<TesselPluginInterface::IFlowFrame>& i_rpIn, std::uint64_t i_Time) = 0;
};

} // namespace NVX
