// Reading and writing skeleton files of ball joints with all their statistics, a marker and a point target for each
// segment. The floors do on the very same file what cannot be left out: parsing it with rapidxml and turning each of
// its numbers into a double, and turning each of the numbers into text.
#include "../Ratios.h"

#include "CoreOrlexQRTIO/Reader.h"
#include "CoreOrlexQRTIO/Writer.h"

#include <rapidxml/rapidxml.hpp>

#include <charconv>
#include <random>

namespace
{

using namespace CoreOrlexQRTIO;
using CoreOrlexTypes::VSubjectParametrised;

struct VContent
{
	VSubjectParametrised m_Subject;
	CoreOrlexTypes::VSubjectApplicationData m_ApplicationData;
	VSubjectQRTExtras m_Extras;
};

VContent MakeContent(std::size_t i_Segments)
{
	std::mt19937 random(1);
	std::uniform_real_distribution<double> number(-100.0, 100.0);
	const auto numbers = [&](std::size_t i_Count)
	{
		std::vector<double> values(i_Count);
		for (double& rValue : values)
			rValue = number(random);
		return values;
	};
	const auto length = [&] { return std::to_string(number(random)) + "*GlobalScale"; };
	VContent content;
	content.m_Subject.m_DynamicParameters.push_back({"GlobalScale", 1.0, 0.0, 1.0, true});
	for (std::size_t i = 0; i < i_Segments; ++i)
	{
		VSubjectParametrised::VSegment segment;
		segment.m_Name = "Segment" + std::to_string(i);
		segment.m_SegmentIndex = static_cast<std::uint32_t>(i);
		// Limbs of eight on a common root.
		if (i > 0)
			segment.m_ParentSegmentIndex = static_cast<std::uint32_t>(i % 8 == 1 ? 0 : i - 1);
		segment.m_TreeDepth = i == 0 ? 0 : static_cast<std::uint32_t>(1 + (i - 1) % 8);
		segment.m_PreTranslation = {length(), length(), length()};
		VSubjectParametrised::VJoint& rJoint = segment.m_Joint;
		rJoint.m_Name = segment.m_Name + "Joint";
		rJoint.m_JointType = VSubjectParametrised::VJoint::EBall;
		for (std::vector<double>* pState : {&rJoint.m_Mean, &rJoint.m_TPoseMean, &rJoint.m_TemplateMean,
		         &rJoint.m_RangeCentringState, &rJoint.m_TemplateRangeCentringState, &rJoint.m_BindPose})
			*pState = numbers(3);
		for (std::vector<double>* pMatrix : {&rJoint.m_Covariance, &rJoint.m_TPoseCovariance,
		         &rJoint.m_TemplateCovariance, &rJoint.m_RangeMatrix, &rJoint.m_TemplateRangeMatrix})
			*pMatrix = numbers(9);
		content.m_Subject.m_Segments.push_back(std::move(segment));
		content.m_Subject.m_Markers.emplace_back().m_Name = "Marker" + std::to_string(i);
		VSubjectParametrised::VTarget& rTarget = content.m_Subject.m_Targets.emplace_back();
		rTarget.m_Type = VSubjectParametrised::VTarget::ELocalPointToWorldPoint;
		rTarget.m_MarkerIndices = rTarget.m_SegmentIndices = {static_cast<std::uint32_t>(i)};
		rTarget.m_StateExpressions = {length(), length(), length()};
		rTarget.m_TemplateCovariance = numbers(9);
		rTarget.m_ViewNormals.emplace_back();
	}
	content.m_ApplicationData.m_Segments.resize(i_Segments);
	content.m_ApplicationData.m_Markers.resize(i_Segments);
	content.m_ApplicationData.m_Targets.resize(i_Segments);
	return content;
}

std::string MakeText(const VContent& i_rContent)
{
	std::string text;
	std::vector<std::string> errors;
	std::vector<std::string> warnings;
	VWriter().WriteText(i_rContent.m_Subject, i_rContent.m_ApplicationData, i_rContent.m_Extras, c_AutomaticVersion,
	    text, errors, warnings);
	return text;
}

/// Calls with each number of each attribute, those in front of expressions included.
template <typename TFunction>
void ForEachNumber(const rapidxml::xml_node<char>& i_rNode, const TFunction& i_rFunction)
{
	for (const auto* pAttribute = i_rNode.first_attribute(); pAttribute; pAttribute = pAttribute->next_attribute())
	{
		const char* p = pAttribute->value();
		const char* const pEnd = p + pAttribute->value_size();
		while (p != pEnd)
		{
			double value = 0.0;
			const auto result = std::from_chars(p, pEnd, value);
			if (result.ec == std::errc())
				i_rFunction(value);
			p = std::find(result.ptr, pEnd, ' ');
			if (p != pEnd)
				++p;
		}
	}
	for (const auto* pChild = i_rNode.first_node(); pChild; pChild = pChild->next_sibling())
		ForEachNumber(*pChild, i_rFunction);
}

std::vector<double> NumbersOf(std::string i_Text)
{
	rapidxml::xml_document<char> document;
	document.parse<0>(i_Text.data());
	std::vector<double> numbers;
	ForEachNumber(document, [&](double i_Value) { numbers.push_back(i_Value); });
	return numbers;
}

void PerSegment(benchmark::State& io_rState)
{
	io_rState.counters["s/segment"] = benchmark::Counter(
	    double(io_rState.range(0)), benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
}

void Read(benchmark::State& io_rState)
{
	const std::string text = MakeText(MakeContent(io_rState.range(0)));
	std::vector<std::string> errors;
	std::vector<std::string> warnings;
	for (auto unused : io_rState)
	{
		VContent content;
		if (!VReader().ReadText(
		        text, "Template", 1, content.m_Subject, content.m_ApplicationData, content.m_Extras, errors, warnings))
			io_rState.SkipWithError("The file could not be read.");
		benchmark::DoNotOptimize(content);
	}
	io_rState.SetLabel(std::to_string(NumbersOf(text).size()) + " numbers");
	PerSegment(io_rState);
}

void ParseAndFromChars(benchmark::State& io_rState)
{
	const std::string text = MakeText(MakeContent(io_rState.range(0)));
	for (auto unused : io_rState)
	{
		std::string copy = text;
		rapidxml::xml_document<char> document;
		document.parse<rapidxml::parse_validate_closing_tags>(copy.data());
		double sum = 0.0;
		ForEachNumber(document, [&](double i_Value) { sum += i_Value; });
		benchmark::DoNotOptimize(sum);
	}
	PerSegment(io_rState);
}

void Write(benchmark::State& io_rState)
{
	const VContent content = MakeContent(io_rState.range(0));
	for (auto unused : io_rState)
		benchmark::DoNotOptimize(MakeText(content));
	PerSegment(io_rState);
}

/// In the form that the file has, 17 digits.
void ToChars(benchmark::State& io_rState)
{
	const std::vector<double> numbers = NumbersOf(MakeText(MakeContent(io_rState.range(0))));
	for (auto unused : io_rState)
	{
		std::string text;
		for (const double value : numbers)
		{
			char buffer[32];
			const auto result = std::to_chars(buffer, buffer + sizeof(buffer), value, std::chars_format::general, 17);
			text.append(buffer, result.ptr);
			text += ' ';
		}
		benchmark::DoNotOptimize(text);
	}
	PerSegment(io_rState);
}

BENCHMARK(Read)->Arg(30)->Arg(70)->Arg(100)->Arg(300)->Arg(1000)->Arg(3000);
BENCHMARK(ParseAndFromChars)->Arg(30)->Arg(70)->Arg(100)->Arg(300)->Arg(1000)->Arg(3000);
BENCHMARK(Write)->Arg(30)->Arg(70)->Arg(100)->Arg(300)->Arg(1000)->Arg(3000);
BENCHMARK(ToChars)->Arg(30)->Arg(70)->Arg(100)->Arg(300)->Arg(1000)->Arg(3000);

} // namespace

int main(int i_Count, char** i_ppArguments)
{
	return Ratios::Main(i_Count, i_ppArguments, {{"Read", "ParseAndFromChars", 2}, {"Write", "ToChars", 1.4}});
}
