// What an edit pays for its values, by number of segments: the deep copy of a subject, its comparison, its conversion
// to numbers, and the two spellings of its text form read back.
#include "../Ratios.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypes/TextForm.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"

#include "math/NumberText.h"

namespace
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;
using VJoint = VSubjectParametrised::VJoint;

/// A chain as it is made from a character: lengths times the scale, ball joints with bind poses, a target for every
/// third segment.
VSubjectParametrised Chain(std::size_t i_Segments)
{
	VSubjectParametrised subject;
	subject.m_Name = "Template";
	subject.m_DynamicParameters = {{"GlobalScale", 1.0, 0.0, 1.0, false}};
	subject.m_Segments.resize(i_Segments);
	for (std::uint32_t i = 0; i < i_Segments; ++i)
	{
		auto& rSegment = subject.m_Segments[i];
		rSegment.m_Name = "Character:Segment" + std::to_string(i);
		rSegment.m_SegmentIndex = i;
		rSegment.m_ParentSegmentIndex = i == 0 ? CoreOrlexTypes::c_NoParent : i - 1;
		rSegment.m_TreeDepth = i;
		for (std::size_t c = 0; c < 3; ++c)
		{
			rSegment.m_PreTranslation[c] = NumberText::PrintF(10.0 * i + 0.1 * double(c)) + "*GlobalScale";
			rSegment.m_PreRotation[c] = NumberText::PrintF(0.01 * i);
		}
		rSegment.m_Joint.m_JointType = i == 0 ? VJoint::EFree : VJoint::EBall;
		rSegment.m_Joint.m_Mean.assign(CoreOrlexTypes::StateSize(rSegment.m_Joint.m_JointType), 0.1);
		rSegment.m_Joint.m_BindPose = rSegment.m_Joint.m_Mean;
		rSegment.m_Joint.m_Covariance = CoreOrlexTypes::DefaultCovariance(rSegment.m_Joint.m_JointType);
		if (i % 3)
			continue;
		subject.m_Markers.emplace_back().m_Name = rSegment.m_Name;
		auto& rTarget = subject.m_Targets.emplace_back();
		rTarget.m_Type = VSubjectParametrised::VTarget::ELocalPointToWorldPoint;
		rTarget.m_SegmentIndices = {i};
		rTarget.m_MarkerIndices = {i / 3};
		rTarget.m_ViewNormals = {{0, 0, 0}};
		rTarget.m_StateExpressions.assign(3, "12.345678*GlobalScale");
	}
	return subject;
}

/// Runs the work on a chain of as many segments as the row says and counts the time of each.
template <typename TWork>
void Run(benchmark::State& io_rState, TWork i_Work)
{
	const VSubjectParametrised subject = Chain(std::size_t(io_rState.range(0)));
	for (auto unused : io_rState)
		if (!i_Work(subject))
			io_rState.SkipWithError("The work failed.");
	io_rState.counters["s/segment"] = benchmark::Counter(
	    double(io_rState.range(0)), benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
}

void Copy(benchmark::State& io_rState)
{
	Run(io_rState,
	    [](const VSubjectParametrised& i_rSubject)
	    {
		    VSubjectParametrised copy = i_rSubject;
		    benchmark::DoNotOptimize(copy);
		    return !copy.m_Segments.empty();
	    });
}

void Compare(benchmark::State& io_rState)
{
	VSubjectParametrised copy;
	Run(io_rState,
	    [&](const VSubjectParametrised& i_rSubject)
	    {
		    if (copy.m_Segments.empty())
			    copy = i_rSubject;
		    return copy == i_rSubject;
	    });
}

void Convert(benchmark::State& io_rState)
{
	VSubject converted;
	Run(io_rState,
	    [&](const VSubjectParametrised& i_rSubject)
	    { return CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(i_rSubject, converted); });
}

template <CoreOrlexTypes::ETextSpelling c_Spelling>
void ReadTextForm(benchmark::State& io_rState)
{
	std::string text;
	VSubjectParametrised read;
	Run(io_rState,
	    [&](const VSubjectParametrised& i_rSubject)
	    {
		    if (text.empty() && !WriteText(i_rSubject, text, c_Spelling))
			    return false;
		    return ReadText(text, read);
	    });
}

void Sizes(benchmark::internal::Benchmark* io_pBenchmark)
{
	for (const int size : {30, 100, 300, 1000, 3000})
		io_pBenchmark->Arg(size);
}

BENCHMARK(Copy)->Apply(Sizes);
BENCHMARK(Compare)->Apply(Sizes);
BENCHMARK(Convert)->Apply(Sizes);
BENCHMARK(ReadTextForm<CoreOrlexTypes::ETextSpelling::EKeyed>)->Apply(Sizes);
BENCHMARK(ReadTextForm<CoreOrlexTypes::ETextSpelling::EPositional>)->Apply(Sizes);

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	return Ratios::Main(i_Count, i_ppArguments, {});
}
