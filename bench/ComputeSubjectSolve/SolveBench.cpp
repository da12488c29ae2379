// A warm frame of a subject with 102 active states and 34 targets, and of larger and smaller ones: ours, and Ceres on
// the same cost from the same start, with automatic and with analytic derivatives. Before the table: how the cost at
// our end compares with that of Ceres at tight tolerances, and the distribution of our times and iterations.
#include "../Ratios.h"
#include "CeresPeer.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "ComputeSubjectSolve/ComputeSubjectSolve.h"
#include "CoreOrlexTypes/Subject.h"

#include <cmath>
#include <ctime>
#include <random>

namespace
{

using CoreOrlexTypes::VSubject;
using VJointTypes = CoreOrlexTypes::VSubjectParametrised::VJoint;

/// A trunk with head, arms with fingers, legs and a tail: 33 segments, or this body with more or fewer branches.
VSubject Body(std::size_t i_Segments)
{
	constexpr std::uint32_t c_Parents[] = {0, 0, 1, 2, 3, 4, 4, 6, 7, 8, 9, 9, 9, 9, 4, 14, 15, 16, 17, 17, 17, 17, 0,
	    22, 23, 24, 0, 26, 27, 28, 0, 30, 31};
	std::mt19937 random(1);
	std::uniform_real_distribution<double> angle(-0.8, 0.8);
	VSubject subject;
	for (std::uint32_t i = 0; i < i_Segments; ++i)
	{
		const std::uint32_t body = i / 33 * 33;
		VSubject::VSegment segment;
		segment.m_ParentSegmentIndex = i == 0 ? CoreOrlexTypes::c_NoParent : i == body ? 4 : body + c_Parents[i % 33];
		segment.m_Joint.m_JointType = i == 0 ? VJointTypes::EFree : VJointTypes::EBall;
		segment.m_PreRotation = {angle(random), angle(random), angle(random)};
		segment.m_PreTranslation = {20.0, 30.0, 200.0};
		if (i > 0)
		{
			segment.m_Joint.m_Mean = {0.0, 0.0, 0.0};
			segment.m_Joint.m_Covariance = {10.0, 0.0, 0.0, 0.0, 10.0, 0.0, 0.0, 0.0, 10.0};
		}
		subject.m_Segments.push_back(segment);
		VSubject::VTarget target;
		target.m_SegmentIndices = {i};
		target.m_Weight = 1.0;
		const auto add = [&](bool i_bRotation)
		{
			target.m_State = {angle(random), angle(random), angle(random)};
			target.m_MarkerIndices.clear();
			target.m_RotationObservationIndices.clear();
			if (i_bRotation)
			{
				target.m_Type = VSubject::VTarget::ELocalRotationToWorldRotation;
				target.m_RotationObservationIndices = {static_cast<std::uint32_t>(subject.m_Rotations.size())};
				subject.m_Rotations.emplace_back();
			}
			else
			{
				target.m_Type = VSubject::VTarget::ELocalPointToWorldPoint;
				target.m_MarkerIndices = {static_cast<std::uint32_t>(subject.m_Markers.size())};
				for (double& rValue : target.m_State)
					rValue *= 60.0;
				subject.m_Markers.emplace_back();
			}
			subject.m_Targets.push_back(target);
		};
		add(i % 2 == 1);
		if (i == 0)
			add(true);
	}
	return subject;
}

struct VMotionFrame
{
	std::vector<double> m_Positions;
	std::vector<double> m_Rotations;
};

/// A motion at 120 Hz that the targets cannot follow quite: some mm, some degrees are off.
std::vector<VMotionFrame> Motion(const VSubject& i_rSubject, std::size_t i_Frames)
{
	std::mt19937 random(3);
	std::uniform_real_distribution<double> size(0.1, 0.6);
	std::normal_distribution<double> off(0.0, 1.0);
	ComputeSubject::VComputeSubjectFK kinematics(i_rSubject);
	std::vector<std::array<double, 3>> waves(kinematics.NumberOfStates());
	for (auto& rWave : waves)
		rWave = {size(random), 10.0 * size(random), 10.0 * size(random)};
	std::vector<VMotionFrame> frames;
	std::vector<double> states(waves.size());
	std::vector<Rotation::VVector3> positions;
	std::vector<Rotation::VMatrix3> rotations;
	std::vector<double> noise;
	for (std::size_t i = 0; i < 3 * i_rSubject.m_Targets.size(); ++i)
		noise.push_back(off(random));
	for (std::size_t frame = 0; frame < i_Frames; ++frame)
	{
		for (std::size_t i = 0; i < states.size(); ++i)
			states[i] = waves[i][0] * std::sin(waves[i][1] * double(frame) / 120.0 + waves[i][2])
			    * (i >= 3 && i < 6 ? 500.0 : 1.0);
		kinematics.Update(states.data());
		kinematics.ComputeMarkers(positions);
		kinematics.ComputeRotations(rotations);
		VMotionFrame motion;
		std::size_t next = 0;
		for (const auto& rPosition : positions)
			for (const double value : rPosition)
				motion.m_Positions.push_back(value + 8.0 * noise[next++]);
		for (const auto& rRotation : rotations)
		{
			const auto turned = Rotation::Product(Rotation::RotationMatrixFromAngleAxis({0.05 * noise[next],
			                                          0.05 * noise[next + 1], 0.05 * noise[next + 2]}),
			    rRotation);
			next += 3;
			motion.m_Rotations.insert(motion.m_Rotations.end(), turned.begin(), turned.end());
		}
		frames.push_back(std::move(motion));
	}
	return frames;
}

constexpr std::size_t c_Frames = 500;

/// All frames, and where our solve stood before each.
struct VTrack
{
	explicit VTrack(std::size_t i_Segments) : m_Subject(Body(i_Segments)), m_Frames(Motion(m_Subject, c_Frames + 1))
	{
		ComputeSubject::VComputeSubjectSolve solve(m_Subject, {});
		for (const VMotionFrame& rFrame : m_Frames)
			m_States.push_back(solve.Solve({rFrame.m_Positions, rFrame.m_Rotations}).m_States);
	}

	VSubject m_Subject;
	std::vector<VMotionFrame> m_Frames;
	std::vector<std::vector<double>> m_States;
};

const VTrack& Track(std::size_t i_Segments)
{
	static std::map<std::size_t, VTrack> s_Tracks;
	return s_Tracks.try_emplace(i_Segments, i_Segments).first->second;
}

/// Of this thread, in milliseconds: the machine may do other work.
double ProcessorTime()
{
	timespec time;
	clock_gettime(CLOCK_THREAD_CPUTIME_ID, &time);
	return 1e3 * double(time.tv_sec) + 1e-6 * double(time.tv_nsec);
}

void CompareCosts()
{
	const VTrack& rTrack = Track(33);
	ComputeSubject::VComputeSubjectSolve solve(rTrack.m_Subject, {});
	VCeresPeer peer(rTrack.m_Subject, true);
	std::vector<double> times, ratios;
	std::vector<std::size_t> iterations;
	double sum = 0.0, peerSum = 0.0;
	std::size_t notConverged = 0, peerIterations = 0;
	for (std::size_t i = 1; i <= c_Frames; ++i)
	{
		const VMotionFrame& rFrame = rTrack.m_Frames[i];
		solve.StartFrom(rTrack.m_States[i - 1]);
		const double start = ProcessorTime();
		const auto& rSolved = solve.Solve({rFrame.m_Positions, rFrame.m_Rotations});
		times.push_back(ProcessorTime() - start);
		iterations.push_back(rSolved.m_Iterations);
		notConverged += !rSolved.m_bConverged;
		const double cost = peer.Solve(rFrame.m_Positions, rFrame.m_Rotations, rTrack.m_States[i - 1], 1e-14);
		peerIterations += peer.Iterations();
		sum += rSolved.m_Cost;
		peerSum += cost;
		ratios.push_back(rSolved.m_Cost / cost);
	}
	for (auto* pValues : {&times, &ratios})
		std::sort(pValues->begin(), pValues->end());
	std::sort(iterations.begin(), iterations.end());
	const auto at = [](const auto& i_rSorted, double i_Part)
	{ return i_rSorted[std::size_t(i_Part * (i_rSorted.size() - 1))]; };
	std::printf("%zu active states, %zu targets, %zu frames, not converged: %zu\n", solve.NumberOfActiveStates(),
	    rTrack.m_Subject.m_Targets.size(), c_Frames, notConverged);
	std::printf(
	    "cost / cost of Ceres at tight tolerances: all %.9f, worst frame %.9f (limit 1.001)%s; of a frame %.0f mm2\n",
	    sum / peerSum, ratios.back(), ratios.back() > 1.001 ? " EXCEEDED" : "", sum / c_Frames);
	std::printf("milliseconds of the processor: median %.3f (limit 1), 95 %% %.3f (limit 2.5); iterations: median %zu "
	            "(limit 4), 95 %% %zu "
	            "(limit 15), Ceres %.1f\n",
	    at(times, 0.5), at(times, 0.95), at(iterations, 0.5), at(iterations, 0.95), double(peerIterations) / c_Frames);
}

void Solve(benchmark::State& io_rState)
{
	const VTrack& rTrack = Track(std::size_t(io_rState.range(0)));
	ComputeSubject::VComputeSubjectSolve solve(rTrack.m_Subject, {});
	std::size_t frame = 0;
	for (auto _ : io_rState)
	{
		frame = frame % c_Frames + 1;
		const VMotionFrame& rFrame = rTrack.m_Frames[frame];
		solve.StartFrom(rTrack.m_States[frame - 1]);
		benchmark::DoNotOptimize(solve.Solve({rFrame.m_Positions, rFrame.m_Rotations}).m_Cost);
	}
}

/// To the tolerance at which its costs are ours.
void Peer(benchmark::State& io_rState, bool i_bAnalytic)
{
	const VTrack& rTrack = Track(std::size_t(io_rState.range(0)));
	VCeresPeer peer(rTrack.m_Subject, i_bAnalytic);
	std::size_t frame = 0;
	for (auto _ : io_rState)
	{
		frame = frame % c_Frames + 1;
		const VMotionFrame& rFrame = rTrack.m_Frames[frame];
		benchmark::DoNotOptimize(peer.Solve(rFrame.m_Positions, rFrame.m_Rotations, rTrack.m_States[frame - 1], 1e-6));
	}
}

void CeresAutomatic(benchmark::State& io_rState)
{
	Peer(io_rState, false);
}

void CeresAnalytic(benchmark::State& io_rState)
{
	Peer(io_rState, true);
}

void Sizes(benchmark::internal::Benchmark* io_pBenchmark)
{
	for (const int segments : {30, 33, 70, 150, 300})
		io_pBenchmark->Arg(segments);
}

BENCHMARK(Solve)->Apply(Sizes);
BENCHMARK(CeresAutomatic)->Arg(33)->Arg(70);
BENCHMARK(CeresAnalytic)->Arg(33)->Arg(70);

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	CompareCosts();
	return Ratios::Main(i_Count, i_ppArguments, {{"Solve", "CeresAutomatic", 0.2}, {"Solve", "CeresAnalytic", 0.5}});
}
