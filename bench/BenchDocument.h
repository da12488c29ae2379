#pragma once

#include "../tests/Matrices.h"
#include "Ratios.h"

#include "InMemoryHost/PluginContext.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/TargetConstruction.h"
#include "RetargetSetupDocument/RetargetSetup.h"

#include <map>
#include <memory>
#include <random>

/// A character in a host: bones with up to four children, a target on every fourth segment.
class VBenchDocument
{
public:
	explicit VBenchDocument(std::size_t i_Segments)
	    : m_pDocument(
	        std::make_shared<VRetargetSetup>(m_Host.GetDispatcher(), m_Host.GetFrameFactory(), m_Host.GetItemFactory()))
	{
		std::mt19937 random(1);
		std::uniform_real_distribution<float> number(-90.0f, 90.0f);
		FBXIO::VSkinSkeleton bones(i_Segments);
		for (std::size_t i = 0; i < i_Segments; ++i)
		{
			bones[i].m_Name = "Character:Segment" + std::to_string(i);
			bones[i].m_ParentIndex = (std::int64_t(i) - 1) / 4 - (i == 0 ? 1 : 0);
			Turn(bones[i].m_PreRotation, number(random), 1, 0, 0);
			Move(bones[i].m_Local, number(random), number(random), number(random));
			Turn(bones[i].m_Local, number(random), 0, 1, 0);
		}
		CoreOrlexTypes::VSubjectParametrised subject;
		CoreOrlexTypes::VSubjectApplicationData data;
		subject.m_Name = RetargetSetup::c_SubjectName;
		subject.m_SubjectId = data.m_SubjectId = RetargetSetup::c_SubjectId;
		RetargetSetup::BuildTargetSubject(bones, subject, data, 0);
		RetargetSetup::SetGlobalScale(subject, 1.0);
		m_Document.SetSourceSubject(subject, data);
		m_Document.SetTargetSubject(std::move(subject), std::move(data));
		// Each target is an edit: those of thousands of segments take seconds, and benchmarks begin anew many times.
		static std::map<std::size_t, VRetargetSetup::VSubjectValues> s_Starts;
		const auto [start, bNew] = s_Starts.try_emplace(i_Segments);
		if (bNew)
		{
			for (std::size_t i = 0; i < i_Segments; i += 4)
				m_Document.AddTarget(int(i), int(i), i % 8 == 0, false);
			start->second = m_Document.TargetValues();
		}
		m_Start = start->second;
		Restore();
	}

	void Restore() { m_Document.SetTargetSubject(*m_Start.m_pParametrised, *m_Start.m_pApplicationData); }

	InMemoryHost::VPluginContext m_Host;
	const std::shared_ptr<VRetargetSetup> m_pDocument;
	VRetargetSetup& m_Document = *m_pDocument;
	VRetargetSetup::VSubjectValues m_Start;
};

inline void Report(benchmark::State& io_rState)
{
	io_rState.counters["per segment"] = benchmark::Counter(
	    double(io_rState.iterations() * io_rState.range(0)), benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}

/// The deep copies that an edit must make: subjects are replaced and never changed, so at least a new editable subject,
/// a new evaluated one and new application data come into being.
inline void Copies(benchmark::State& io_rState)
{
	VBenchDocument bench(std::size_t(io_rState.range(0)));
	for (auto _ : io_rState)
	{
		benchmark::DoNotOptimize(
		    std::make_shared<CoreOrlexTypes::VSubjectParametrised>(*bench.m_Start.m_pParametrised));
		benchmark::DoNotOptimize(std::make_shared<CoreOrlexTypes::VSubject>(*bench.m_Start.m_pSubject));
		benchmark::DoNotOptimize(
		    std::make_shared<CoreOrlexTypes::VSubjectApplicationData>(*bench.m_Start.m_pApplicationData));
	}
	Report(io_rState);
}
