#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>

namespace ComputeSubject
{

/// How likely a joint's state is. Spans hold NumberOfStates() values.
class IComputeJointPrior
{
public:
	virtual ~IComputeJointPrior() = default;
	virtual std::size_t NumberOfStates() const = 0;

	/// From the mean to the state that was set last, in the space of the prior.
	virtual void Deviation(std::span<double> o_Deviation) const = 0;

	/// Half the squared Mahalanobis distance of the state that was set last; 0 at the mean.
	virtual double Energy() const = 0;

	/// Reads NumberOfStates() values and moves the pointer behind them.
	virtual void SetState(const double*& io_rpState) = 0;
};

/// Which states of a joint are allowed.
class IComputeJointRange
{
public:
	virtual ~IComputeJointRange() = default;
	virtual std::size_t NumberOfStates() const = 0;

	/// The state in the range space, where the centre of the range is the origin. Both spans hold NumberOfStates()
	/// values.
	virtual void RangeState(std::span<const double> i_State, std::span<double> o_RangeState) const = 0;

	/// Shares nothing with this one.
	virtual void Clone(std::unique_ptr<IComputeJointRange>& o_rpTarget) const = 0;
};

class VComputeJointPriorInterfaceForSegment : public IComputeJointPrior
{
public:
	/// Shares nothing with this one.
	virtual std::unique_ptr<VComputeJointPriorInterfaceForSegment> Clone() const = 0;

	/// Of the segment whose joint this is about.
	virtual std::uint32_t SegmentIndex() const = 0;
};

class VComputeJointPriorForSegment : public VComputeJointPriorInterfaceForSegment
{
public:
	explicit VComputeJointPriorForSegment(std::uint32_t i_SegmentIndex) : m_SegmentIndex(i_SegmentIndex) {}
	std::uint32_t SegmentIndex() const override { return m_SegmentIndex; }

private:
	std::uint32_t m_SegmentIndex;
};

class VComputeJointRangeForSegment : public IComputeJointRange
{
public:
	explicit VComputeJointRangeForSegment(std::uint32_t i_SegmentIndex) : m_SegmentIndex(i_SegmentIndex) {}
	std::uint32_t SegmentIndex() const { return m_SegmentIndex; }

private:
	std::uint32_t m_SegmentIndex;
};

/// Says nothing: every state is as likely as any other.
template <std::size_t t_States>
class VDefaultJointPrior : public VComputeJointPriorForSegment
{
public:
	explicit VDefaultJointPrior(std::uint32_t i_SegmentIndex) : VComputeJointPriorForSegment(i_SegmentIndex) {}
	std::size_t NumberOfStates() const override { return t_States; }
	void Deviation(std::span<double> o_Deviation) const override
	{
		std::fill(o_Deviation.begin(), o_Deviation.end(), 0.0);
	}
	double Energy() const override { return 0.0; }
	void SetState(const double*& io_rpState) override { io_rpState += t_States; }
	std::unique_ptr<VComputeJointPriorInterfaceForSegment> Clone() const override
	{
		return std::make_unique<VDefaultJointPrior>(SegmentIndex());
	}
};

/// Says nothing: every state is the centre of the range.
template <std::size_t t_States>
class VDefaultJointRange : public VComputeJointRangeForSegment
{
public:
	explicit VDefaultJointRange(std::uint32_t i_SegmentIndex) : VComputeJointRangeForSegment(i_SegmentIndex) {}
	std::size_t NumberOfStates() const override { return t_States; }
	void RangeState(std::span<const double>, std::span<double> o_RangeState) const override
	{
		std::fill(o_RangeState.begin(), o_RangeState.end(), 0.0);
	}
	void Clone(std::unique_ptr<IComputeJointRange>& o_rpTarget) const override
	{
		o_rpTarget = std::make_unique<VDefaultJointRange>(SegmentIndex());
	}
};

} // namespace ComputeSubject
