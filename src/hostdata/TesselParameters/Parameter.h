#pragma once

#include "TesselParameters/ParameterChecker.h"

#include "NVX/Shared.h"
#include "TesselDataStore/StoredValue.h"
#include "TesselPluginInterface/IDataStore.h"
#include "TesselPluginInterface/IParameter.h"

#include <optional>

namespace TesselParameters
{

/// A parameter whose value lives in a store of the host under "<path>/<name>". Made by NVX::MakeShared, mostly through
/// a group. Values and attributes may be used from any thread.
class VParameter : public TesselPluginInterface::IParameter, public NVX::VShared
{
public:
	/// @param i_pStore of the value; null keeps it in a store of the parameter's own. The default and the attributes
	/// live and end with the parameter.
	VParameter(std::shared_ptr<TesselPluginInterface::IDataStore> i_pStore, const std::string& i_rPath,
	    std::string i_Name, std::shared_ptr<const VParameterChecker> i_pChecker);
	~VParameter() override;

	const std::string& GetName() const override { return m_Name; }
	const std::string& GetStoreKey() const override { return m_StoreKey; }
	TesselPluginInterface::EValueKind GetValueKind() const override { return m_pChecker->GetValueKind(); }
	NVX::IO::VSchemaPointer GetSchema() const override { return m_pChecker->GetSchema(); }

	bool HasValue() const override;
	NVX::IO::VVariant GetValue() const override;
	bool SetValue(const NVX::IO::VVariant& i_rValue) override;
	void ClearValue() override;
	void ResetToDefault() override;
	std::string GetValueText() const override;
	std::string SetValueText(const std::string& i_rText) override;
	std::string ToText(const NVX::IO::VVariant& i_rValue) const override { return m_pChecker->ToText(i_rValue); }
	void SetVerifyRequired(bool i_bRequired) override;
	bool GetVerifyRequired() const override { return m_bVerifyRequired; }

	bool HasDefault() const override;
	NVX::IO::VVariant GetDefault() const override;
	bool SetValueDefault(const NVX::IO::VVariant& i_rValue) override;

	std::string GetCategory() const override;
	void SetCategory(const std::string& i_rText) override;
	std::string GetDisplay() const override;
	void SetDisplay(const std::string& i_rText) override;
	std::string GetDescription() const override;
	void SetDescription(const std::string& i_rText) override;
	TesselPluginInterface::EPresentationHint GetPresentationHint() const override;
	void SetPresentationHint(TesselPluginInterface::EPresentationHint i_Hint) override;
	TesselPluginInterface::EDataConversionHint GetDataConversionHint() const override;
	void SetDataConversionHint(TesselPluginInterface::EDataConversionHint i_Hint) override;
	TesselPluginInterface::EFileAccess GetFileAccess() const override;
	void SetFileAccess(TesselPluginInterface::EFileAccess i_Access) override;
	std::string GetFileFilter() const override;
	void SetFileFilter(const std::string& i_rText) override;
	std::string GetValidatorRegEx() const override;
	void SetValidatorRegEx(const std::string& i_rText) override;
	std::uint32_t GetFlags() const override;
	void SetFlags(std::uint32_t i_Flags) override;

	NVX::IO::VVariant GetMinimum() const override;
	bool SetMinimum(const NVX::IO::VVariant& i_rValue) override;
	NVX::IO::VVariant GetMaximum() const override;
	bool SetMaximum(const NVX::IO::VVariant& i_rValue) override;
	bool HasEnumeration() const override;
	std::vector<TesselPluginInterface::VEnumEntry> GetEnumeration() const override;
	bool SetEnumeration(const std::vector<TesselPluginInterface::VEnumEntry>& i_rEntries) override;

	NVX::VConnection ConnectValue(
	    std::function<void()> i_Callback, std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher) override;
	NVX::VConnection ConnectAttributes(
	    std::function<void()> i_Callback, std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher) override;

	/// The same with values of the types of TesselDataStore/StoredValue.h ("text" included).
	template <typename T>
	bool Set(const T& i_rValue)
	{
		return SetValue(TesselDataStore::ToVariant(i_rValue));
	}
	template <typename T>
	bool SetDefault(const T& i_rValue)
	{
		return SetValueDefault(TesselDataStore::ToVariant(i_rValue));
	}
	template <typename T>
	bool SetLimits(const T& i_rMinimum, const T& i_rMaximum)
	{
		return SetMinimum(TesselDataStore::ToVariant(i_rMinimum)) && SetMaximum(TesselDataStore::ToVariant(i_rMaximum));
	}
	/// @return false, with the value untouched, if there is none of that type.
	template <typename T>
	bool Get(T& io_rValue) const
	{
		return TesselDataStore::FromVariant(GetValue(), io_rValue);
	}

private:
	template <typename T>
	T Attribute(const char* i_pKey) const;
	template <typename T>
	void SetAttribute(const char* i_pKey, const T& i_rValue);
	NVX::IO::VVariant AttributeValue(const char* i_pKey) const;
	bool SetAttributeValue(const char* i_pKey, const NVX::IO::VVariant& i_rValue);

	const std::string m_Name;
	const std::string m_StoreKey;
	const std::shared_ptr<TesselPluginInterface::IDataStore> m_pStore;
	/// Default and attributes.
	const std::shared_ptr<TesselPluginInterface::IDataStore> m_pAttributes;
	const std::shared_ptr<const VParameterChecker> m_pChecker;
	std::atomic<bool> m_bVerifyRequired{false};
};

} // namespace TesselParameters
