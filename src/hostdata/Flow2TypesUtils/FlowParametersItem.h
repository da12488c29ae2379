#pragma once

#include <cstdint>
#include <memory>
#include <string>

namespace Flow2Utils
{
class VParameterSet;
}

namespace Flow2TypesUtils
{

/// What an item of parameters carries through the flow.
struct FlowParametersItem
{
	/// The flow type, which has no tag in the catalogue.
	static constexpr const char* c_pName = "FlowParametersItem";
	static constexpr const char* c_pDocumentation =
	    "Parameters that can be tagged and addressed to a particular target";

	/// Nobody changes it any more. Null counts as no parameters.
	std::shared_ptr<const Flow2Utils::VParameterSet> m_pParameters;
	std::string m_Tag;
	/// Empty for whoever reads it.
	std::string m_Target;
	/// Items of one identity come from one source, and of those with one revision every one holds the same parameters.
	std::uint64_t m_Identity = NewIdentity();
	std::uint64_t m_Revision = 0;

	/// Another one at each call, from any thread.
	static std::uint64_t NewIdentity();
};

} // namespace Flow2TypesUtils
