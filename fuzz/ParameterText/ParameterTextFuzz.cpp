// Texts of values as a user types them or a file holds them, of parameters of the panel and of the flow.
#include "../Require.h"

#include "Flow2TypesUtils/ParameterText.h"
#include "RetargetSetupCore/ParseNumber.h"
#include "TesselParameters/Attributes.h"
#include "TesselParameters/ParameterGroup.h"
#include "math/NumberText.h"

#include <boost/filesystem/path.hpp>

#include <cmath>

namespace
{

/// What a parameter took it holds within its limits, and shows as a text that it takes again.
template <typename T>
void TypeInto(TesselParameters::VParameter& io_rParameter, const std::string& i_rText)
{
	T before{};
	io_rParameter.ClearValue();
	const std::string refusal = io_rParameter.SetValueText(i_rText);
	Require(refusal.empty() == io_rParameter.Get(before), "taken, or refused with a reason");
	if (!refusal.empty())
		return;
	const std::string shown = io_rParameter.GetValueText();
	Require(
	    io_rParameter.SetValueText(shown).empty() && io_rParameter.GetValueText() == shown, "what is shown is taken");
	T after{};
	Require(io_rParameter.Get(after) && after == before, "the value stays");
	if constexpr (std::is_same_v<T, double>)
		Require(std::isfinite(after), "a number is finite");
}

template <typename T>
void TypeFlow(const std::string& i_rText)
{
	T value{};
	if (!Flow2Utils::FromText(i_rText, value))
		return;
	const std::string shown = Flow2Utils::ToText(value);
	T again{};
	Require(Flow2Utils::FromText(shown, again), "what is shown can be read");
	Require(Flow2Utils::ToText(again) == shown, "it is shown the same");
}

struct VParameters
{
	TesselParameters::VParameterGroup m_Group{nullptr, "Fuzz", "Fuzz"};
	std::shared_ptr<TesselParameters::VParameter> m_pFlag = m_Group.Add<bool>("Flag");
	std::shared_ptr<TesselParameters::VParameter> m_pWhole = m_Group.Add<std::int32_t>("Whole");
	std::shared_ptr<TesselParameters::VParameter> m_pCount = m_Group.Add<std::uint32_t>("Count");
	std::shared_ptr<TesselParameters::VParameter> m_pReal = m_Group.Add<double>("Real");
	std::shared_ptr<TesselParameters::VParameter> m_pText = m_Group.Add<std::string>("Text");
	std::shared_ptr<TesselParameters::VParameter> m_pPath = m_Group.Add<boost::filesystem::path>("Path");
	std::shared_ptr<TesselParameters::VParameter> m_pWord = m_Group.Add<std::string>("Word");

	VParameters()
	{
		m_pWhole->SetLimits<std::int32_t>(-1'000'000, 1'000'000);
		m_pReal->SetLimits(-1e100, 1e100);
		m_pWord->SetValidatorRegEx("([A-Za-z_][A-Za-z0-9_]*)(:[A-Za-z0-9_]+)*");
	}
};

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	static VParameters s_Parameters;
	const std::string text(reinterpret_cast<const char*>(i_pData), i_Size);
	TypeInto<bool>(*s_Parameters.m_pFlag, text);
	TypeInto<std::int32_t>(*s_Parameters.m_pWhole, text);
	TypeInto<std::uint32_t>(*s_Parameters.m_pCount, text);
	TypeInto<double>(*s_Parameters.m_pReal, text);
	TypeInto<std::string>(*s_Parameters.m_pText, text);
	TypeInto<boost::filesystem::path>(*s_Parameters.m_pPath, text);
	TypeInto<std::string>(*s_Parameters.m_pWord, text);
	TypeFlow<bool>(text);
	TypeFlow<std::int32_t>(text);
	TypeFlow<std::uint32_t>(text);
	TypeFlow<float>(text);
	TypeFlow<double>(text);
	double number = 0.0;
	if (RetargetSetup::ParseNumber(text, number))
	{
		double again = 0.0;
		Require(RetargetSetup::ParseNumber(NumberText::PrintG17(number), again), "what is printed can be read");
		Require(again == number || (std::isnan(again) && std::isnan(number)), "as the same number");
	}
	// An expression that comes from a module, over a text that does not.
	if (const std::size_t split = text.find('\n'); split != std::string::npos && split < 24)
	{
		s_Parameters.m_pText->SetValidatorRegEx(text.substr(0, split));
		s_Parameters.m_pText->SetValueText(text.substr(split + 1));
		s_Parameters.m_pText->SetValidatorRegEx({});
	}
	return 0;
}
