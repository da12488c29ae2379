// One frame of forward kinematics of a chain of ball joints below a free root: ours, a plain flat loop over structs
// that does the same arithmetic and keeps the same results, and the chain solver of KDL.
#include "../Ratios.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypes/Subject.h"

#include <kdl/chain.hpp>
#include <kdl/chainfksolverpos_recursive.hpp>

#include <cmath>
#include <random>

namespace
{

using CoreOrlexTypes::VSubject;
using VJointTypes = CoreOrlexTypes::VSubjectParametrised::VJoint;

VSubject Chain(std::size_t i_Segments)
{
	std::mt19937 random(1);
	std::uniform_real_distribution<double> angle(-1.5, 1.5);
	std::uniform_real_distribution<double> length(-100.0, 100.0);
	VSubject subject;
	subject.m_Segments.resize(i_Segments);
	for (std::size_t i = 0; i < i_Segments; ++i)
	{
		VSubject::VSegment& rSegment = subject.m_Segments[i];
		rSegment.m_ParentSegmentIndex = i == 0 ? CoreOrlexTypes::c_NoParent : static_cast<std::uint32_t>(i - 1);
		rSegment.m_Joint.m_JointType = i == 0 ? VJointTypes::EFree : VJointTypes::EBall;
		rSegment.m_PreRotation = {angle(random), angle(random), angle(random)};
		rSegment.m_PreTranslation = {length(random), length(random), length(random)};
	}
	return subject;
}

std::vector<double> State(std::size_t i_Size)
{
	std::mt19937 random(2);
	std::uniform_real_distribution<double> angle(-1.5, 1.5);
	std::vector<double> state(i_Size);
	for (double& rValue : state)
		rValue = angle(random);
	return state;
}

/// The floor. Everything that it needs stands in one array of structs, in one translation unit.
namespace Flat
{

struct VPose
{
	double R[9];
	double t[3];
};

struct VSegment
{
	int m_Type;
	int m_Parent;
	VPose m_Base;
	VPose m_Joint;
	VPose m_Local;
	VPose m_World;
};

void Compose(const VPose& a, const VPose& b, VPose& o)
{
	for (int row = 0; row < 3; ++row)
	{
		for (int column = 0; column < 3; ++column)
			o.R[3 * row + column] =
			    a.R[3 * row] * b.R[column] + a.R[3 * row + 1] * b.R[3 + column] + a.R[3 * row + 2] * b.R[6 + column];
		o.t[row] = a.R[3 * row] * b.t[0] + a.R[3 * row + 1] * b.t[1] + a.R[3 * row + 2] * b.t[2] + a.t[row];
	}
}

void FromAngleAxis(const double* v, double* R)
{
	const double angle = std::sqrt(v[0] * v[0] + v[1] * v[1] + v[2] * v[2]);
	if (angle < 2.220446049250313e-15)
	{
		for (int i = 0; i < 9; ++i)
			R[i] = i % 4 == 0;
		return;
	}
	const double x = v[0] / angle;
	const double y = v[1] / angle;
	const double z = v[2] / angle;
	const double c = std::cos(angle);
	const double s = std::sin(angle);
	const double C = 1.0 - c;
	R[0] = C * x * x + c;
	R[1] = C * x * y - s * z;
	R[2] = C * x * z + s * y;
	R[3] = C * y * x + s * z;
	R[4] = C * y * y + c;
	R[5] = C * y * z - s * x;
	R[6] = C * z * x - s * y;
	R[7] = C * z * y + s * x;
	R[8] = C * z * z + c;
}

void Update(std::vector<VSegment>& io_rSegments, const double* i_pState)
{
	for (VSegment& rSegment : io_rSegments)
	{
		switch (rSegment.m_Type)
		{
		case VJointTypes::EFree:
			FromAngleAxis(i_pState, rSegment.m_Joint.R);
			for (int i = 0; i < 3; ++i)
				rSegment.m_Joint.t[i] = i_pState[3 + i];
			i_pState += 6;
			break;
		case VJointTypes::EBall:
			FromAngleAxis(i_pState, rSegment.m_Joint.R);
			for (int i = 0; i < 3; ++i)
				rSegment.m_Joint.t[i] = 0.0;
			i_pState += 3;
			break;
		case VJointTypes::EHinge:
		{
			const double c = std::cos(*i_pState);
			const double s = std::sin(*i_pState);
			rSegment.m_Joint = {{c, -s, 0, s, c, 0, 0, 0, 1}, {0, 0, 0}};
			++i_pState;
			break;
		}
		default: rSegment.m_Joint = {{1, 0, 0, 0, 1, 0, 0, 0, 1}, {0, 0, 0}}; break;
		}
		Compose(rSegment.m_Base, rSegment.m_Joint, rSegment.m_Local);
		if (rSegment.m_Parent < 0)
			rSegment.m_World = rSegment.m_Local;
		else
			Compose(io_rSegments[rSegment.m_Parent].m_World, rSegment.m_Local, rSegment.m_World);
	}
}

std::vector<VSegment> Segments(const VSubject& i_rSubject)
{
	std::vector<VSegment> segments;
	for (const VSubject::VSegment& rSegment : i_rSubject.m_Segments)
	{
		VSegment flat{};
		flat.m_Type = rSegment.m_Joint.m_JointType;
		flat.m_Parent = static_cast<int>(rSegment.m_ParentSegmentIndex);
		FromAngleAxis(rSegment.m_PreRotation.data(), flat.m_Base.R);
		for (int i = 0; i < 3; ++i)
			flat.m_Base.t[i] = rSegment.m_PreTranslation[i];
		segments.push_back(flat);
	}
	return segments;
}

} // namespace Flat

void Report(benchmark::State& io_rState)
{
	io_rState.counters["per segment"] = benchmark::Counter(static_cast<double>(io_rState.range(0)),
	    benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
}

void Floor(benchmark::State& io_rState)
{
	const VSubject subject = Chain(io_rState.range(0));
	auto segments = Flat::Segments(subject);
	const std::vector<double> state = State(3 + 3 * subject.m_Segments.size());
	for (auto _ : io_rState)
	{
		Flat::Update(segments, state.data());
		benchmark::DoNotOptimize(segments.data());
		benchmark::ClobberMemory();
	}
	Report(io_rState);
}

void Update(benchmark::State& io_rState)
{
	const VSubject subject = Chain(io_rState.range(0));
	ComputeSubject::VComputeSubjectFK fk(subject);
	const std::vector<double> state = State(fk.NumberOfStates());

	// The peer that it is held against must compute the same.
	auto segments = Flat::Segments(subject);
	Flat::Update(segments, state.data());
	fk.Update(state.data());
	const auto& rLast = fk.Segment(fk.NumberOfSegments() - 1).WorldPose();
	for (int i = 0; i < 3; ++i)
		if (std::abs(rLast.t[i] - segments.back().m_World.t[i]) > 1e-6)
			io_rState.SkipWithError("differs from the floor");

	for (auto _ : io_rState)
	{
		fk.Update(state.data());
		benchmark::ClobberMemory();
	}
	Report(io_rState);
}

/// A ball joint is three revolute joints there, the free root three more prismatic ones.
void KDLChain(benchmark::State& io_rState)
{
	const VSubject subject = Chain(io_rState.range(0));
	KDL::Chain chain;
	for (const auto type : {KDL::Joint::TransX, KDL::Joint::TransY, KDL::Joint::TransZ})
		chain.addSegment(KDL::Segment(KDL::Joint(type)));
	for (const VSubject::VSegment& rSegment : subject.m_Segments)
	{
		const auto& t = rSegment.m_PreTranslation;
		chain.addSegment(KDL::Segment(KDL::Joint(KDL::Joint::RotX)));
		chain.addSegment(KDL::Segment(KDL::Joint(KDL::Joint::RotY)));
		chain.addSegment(KDL::Segment(KDL::Joint(KDL::Joint::RotZ), KDL::Frame(KDL::Vector(t[0], t[1], t[2]))));
	}
	KDL::ChainFkSolverPos_recursive solver(chain);
	KDL::JntArray joints(chain.getNrOfJoints());
	const std::vector<double> state = State(chain.getNrOfJoints());
	for (std::size_t i = 0; i < state.size(); ++i)
		joints(static_cast<unsigned>(i)) = state[i];
	std::vector<KDL::Frame> frames(chain.getNrOfSegments());
	for (auto _ : io_rState)
	{
		if (solver.JntToCart(joints, frames) < 0)
			io_rState.SkipWithError("refused");
		benchmark::DoNotOptimize(frames.data());
		benchmark::ClobberMemory();
	}
	Report(io_rState);
}

constexpr std::size_t c_Frames = 240;

/// Ten seconds of a take, by i_Compute(kinematics, states, poses out).
template <typename TCompute>
void Frames(benchmark::State& io_rState, TCompute i_Compute)
{
	ComputeSubject::VComputeSubjectFK fk(Chain(io_rState.range(0)));
	const std::vector<double> states = State(c_Frames * fk.NumberOfStates());
	std::vector<Rotation::VPose<double>> poses(c_Frames * fk.NumberOfSegments());
	for (auto _ : io_rState)
	{
		i_Compute(fk, states, poses);
		benchmark::DoNotOptimize(poses.data());
		benchmark::ClobberMemory();
	}
}

void UpdateEach(benchmark::State& io_rState)
{
	Frames(io_rState,
	    [](ComputeSubject::VComputeSubjectFK& io_rFK, const auto& i_rStates, auto& o_rPoses)
	    {
		    auto pose = o_rPoses.begin();
		    for (std::size_t frame = 0; frame < c_Frames; ++frame)
		    {
			    io_rFK.Update(&i_rStates[frame * io_rFK.NumberOfStates()]);
			    for (std::size_t i = 0; i < io_rFK.NumberOfSegments(); ++i)
				    io_rFK.Segment(i).SegmentPose(*pose++);
		    }
	    });
}

template <unsigned c_Threads>
void UpdateMany(benchmark::State& io_rState)
{
	Frames(io_rState,
	    [](const ComputeSubject::VComputeSubjectFK& i_rFK, const auto& i_rStates, auto& o_rPoses)
	    { i_rFK.UpdateMany(i_rStates, o_rPoses, c_Threads); });
}

void Sizes(benchmark::internal::Benchmark* io_pBenchmark)
{
	for (const int segments : {30, 70, 100, 300, 1000, 3000})
		io_pBenchmark->Arg(segments);
}

BENCHMARK(Floor)->Apply(Sizes);
BENCHMARK(Update)->Apply(Sizes);
BENCHMARK(KDLChain)->Apply(Sizes);
BENCHMARK(UpdateEach)->Arg(70)->Arg(300);
BENCHMARK(UpdateMany<1>)->Name("UpdateMany")->Arg(70)->Arg(300);
BENCHMARK(UpdateMany<1>)->Name("UpdateManyAlone")->Arg(70)->Arg(300)->UseRealTime();
BENCHMARK(UpdateMany<2>)->Name("UpdateManyTwoThreads")->Arg(70)->Arg(300)->UseRealTime();

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	return Ratios::Main(i_Count, i_ppArguments,
	    {{"Update", "Floor", 0.6, {"30", "70", "100", "300", "1000"}}, {"Update", "Floor", 0.8, {"3000"}},
	        {"Update", "KDLChain", 0.35}, {"UpdateMany", "UpdateEach", 1 / 1.8}});
}
