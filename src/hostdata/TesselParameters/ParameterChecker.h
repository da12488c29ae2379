#pragma once

#include "TesselPluginInterface/IParameter.h"

#include <memory>
#include <string>

namespace TesselPluginInterface
{
class IDataReader;
}

namespace TesselParameters
{

/// The rule of a parameter's values: their type, their text, and which of them a user may enter. Holds no state of a
/// parameter, so that like parameters share one.
class VParameterChecker
{
public:
	virtual ~VParameterChecker() = default;

	virtual TesselPluginInterface::EValueKind GetValueKind() const = 0;
	virtual NVX::IO::VSchemaPointer GetSchema() const = 0;
	/// Empty for a value of another type.
	virtual std::string ToText(const NVX::IO::VVariant& i_rValue) const = 0;
	/// @return false if the text is no value of this type.
	virtual bool FromText(const std::string& i_rText, NVX::IO::VVariant& o_rValue) const = 0;
	/// Holds a value against the limits and the permitted values among a parameter's attributes.
	/// @return false with the reason.
	virtual bool IsPermitted(const NVX::IO::VVariant& i_rValue, const TesselPluginInterface::IDataReader& i_rAttributes,
	    std::string& o_rMessage) const = 0;

	/// What a user types: the expression that it must match, its form, then IsPermitted.
	virtual bool Accept(const std::string& i_rText, const TesselPluginInterface::IDataReader& i_rAttributes,
	    NVX::IO::VVariant& o_rValue, std::string& o_rMessage) const;
};

/// For bool, std::int32_t, std::uint32_t, double, std::string (any bytes) and boost::filesystem::path. A limit counts
/// only if it is stored in the schema of T.
template <typename T>
class VParameterCheckerTyped : public VParameterChecker
{
public:
	TesselPluginInterface::EValueKind GetValueKind() const override;
	NVX::IO::VSchemaPointer GetSchema() const override;
	std::string ToText(const NVX::IO::VVariant& i_rValue) const override;
	bool FromText(const std::string& i_rText, NVX::IO::VVariant& o_rValue) const override;
	bool IsPermitted(const NVX::IO::VVariant& i_rValue, const TesselPluginInterface::IDataReader& i_rAttributes,
	    std::string& o_rMessage) const override;
};

/// The one checker of a type.
template <typename T>
const std::shared_ptr<const VParameterChecker>& CheckerOf()
{
	static const std::shared_ptr<const VParameterChecker> s_pChecker =
	    std::make_shared<const VParameterCheckerTyped<T>>();
	return s_pChecker;
}

} // namespace TesselParameters
