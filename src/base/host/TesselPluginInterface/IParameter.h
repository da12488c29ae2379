#pragma once

#include "NVX/Signal.h"
#include "Variant/Variant.h"

#include <cstdint>
#include <string>
#include <vector>

namespace TesselPluginInterface
{

/// How a control shows a parameter.
enum class EPresentationHint : std::int32_t
{
	EDontCare,
	ESlider,
	EMultiLine,
	ECheckableOption,
	ECheckableSlider,
	EColour
};

enum class EDataConversionHint : std::int32_t
{
	ENoConversion,
	ESecondsToTick135,
	EMillisecondsToTick135
};

/// What a control's file dialog is for.
enum class EFileAccess : std::int32_t
{
	ENone,
	EFolder,
	ESave,
	ELoad,
	ELoadMultiple
};

/// What a control lets the user enter.
enum class EValueKind : std::int32_t
{
	EBool,
	EInteger,
	EReal,
	EText,
	EPath
};

/// One permitted value of an enumerated parameter, and the name that the user chooses it by.
struct VEnumEntry
{
	std::string m_Name;
	NVX::IO::VVariant m_Value;

	bool operator==(const VEnumEntry&) const = default;
};

/// A setting that a panel shows and the host stores. Attributes that were never set have the default of their key:
/// empty, false, or the first of an enumeration.
class IParameter
{
public:
	/// Bits of the flags word.
	enum EFlags : std::uint32_t
	{
		EHidden = 1,
		EAdvanced = 2,
		EDynamic = 4
	};

	virtual ~IParameter() = default;

	virtual const std::string& GetName() const = 0;
	/// Of the value in the host's store.
	virtual const std::string& GetStoreKey() const = 0;
	virtual EValueKind GetValueKind() const = 0;
	/// Of every value that is taken.
	virtual NVX::IO::VSchemaPointer GetSchema() const = 0;

	/// A stored value or a default, and not the empty text, which stands for nothing chosen.
	virtual bool HasValue() const = 0;
	/// What is stored; else the default; empty if there is neither. A stored value of another type is told in the log
	/// and counts as none.
	virtual NVX::IO::VVariant GetValue() const = 0;
	/// Limits and permitted values do not bind a program.
	/// @return false, with nothing changed, for a value of another schema.
	virtual bool SetValue(const NVX::IO::VVariant& i_rValue) = 0;
	/// No value is stored any more.
	virtual void ClearValue() = 0;
	/// Stores the default; clears the value if there is none.
	virtual void ResetToDefault() = 0;

	/// Empty for no value.
	virtual std::string GetValueText() const = 0;
	/// What a user types. The name of an enumeration's entry stands for its value.
	/// @return empty if it is taken, otherwise why it is refused; then nothing has changed.
	virtual std::string SetValueText(const std::string& i_rText) = 0;
	/// The text of any value of this parameter's type.
	virtual std::string ToText(const NVX::IO::VVariant& i_rValue) const = 0;
	/// True keeps a stored value of another type, as another program may have left it, when the default is set; it
	/// counts as no value and refuses writes. Must be set before the default.
	virtual void SetVerifyRequired(bool i_bRequired) = 0;
	virtual bool GetVerifyRequired() const = 0;

	virtual bool HasDefault() const = 0;
	virtual NVX::IO::VVariant GetDefault() const = 0;
	/// @return false, with nothing changed, for a value of another schema.
	virtual bool SetValueDefault(const NVX::IO::VVariant& i_rValue) = 0;

	/// Attributes.
	virtual std::string GetCategory() const = 0;
	virtual void SetCategory(const std::string& i_rText) = 0;
	/// The label.
	virtual std::string GetDisplay() const = 0;
	virtual void SetDisplay(const std::string& i_rText) = 0;
	virtual std::string GetDescription() const = 0;
	virtual void SetDescription(const std::string& i_rText) = 0;
	virtual EPresentationHint GetPresentationHint() const = 0;
	virtual void SetPresentationHint(EPresentationHint i_Hint) = 0;
	virtual EDataConversionHint GetDataConversionHint() const = 0;
	virtual void SetDataConversionHint(EDataConversionHint i_Hint) = 0;
	virtual EFileAccess GetFileAccess() const = 0;
	virtual void SetFileAccess(EFileAccess i_Access) = 0;
	virtual std::string GetFileFilter() const = 0;
	virtual void SetFileFilter(const std::string& i_rText) = 0;
	/// A typed text must match the whole expression.
	virtual std::string GetValidatorRegEx() const = 0;
	virtual void SetValidatorRegEx(const std::string& i_rText) = 0;
	/// EFlags.
	virtual std::uint32_t GetFlags() const = 0;
	virtual void SetFlags(std::uint32_t i_Flags) = 0;

	/// Limits of what a user may enter. Empty for none.
	virtual NVX::IO::VVariant GetMinimum() const = 0;
	virtual bool SetMinimum(const NVX::IO::VVariant& i_rValue) = 0;
	virtual NVX::IO::VVariant GetMaximum() const = 0;
	virtual bool SetMaximum(const NVX::IO::VVariant& i_rValue) = 0;
	/// Permitted values. An empty enumeration permits everything.
	virtual bool HasEnumeration() const = 0;
	virtual std::vector<VEnumEntry> GetEnumeration() const = 0;
	/// @return false, with nothing changed, if a value is of another schema.
	virtual bool SetEnumeration(const std::vector<VEnumEntry>& i_rEntries) = 0;

	/// Always through the dispatcher, after the value or an attribute (the default, limits and enumeration included)
	/// has changed.
	virtual NVX::VConnection ConnectValue(
	    std::function<void()> i_Callback, std::shared_ptr<IDispatcher> i_pDispatcher) = 0;
	virtual NVX::VConnection ConnectAttributes(
	    std::function<void()> i_Callback, std::shared_ptr<IDispatcher> i_pDispatcher) = 0;

	void SetFlag(EFlags i_Flag, bool i_bSet) { SetFlags(i_bSet ? GetFlags() | i_Flag : GetFlags() & ~i_Flag); }
};

} // namespace TesselPluginInterface
