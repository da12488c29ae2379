#pragma once

#include "TesselParameters/Parameter.h"

#include "TesselPluginInterface/IParameterGroup.h"

namespace TesselParameters
{

/// Makes and holds parameters under one path of a store. User interface thread only.
class VParameterGroup : public TesselPluginInterface::IParameterGroup
{
public:
	/// @param i_Path of the store ("RetargetSetup"); the group's own name ("Subject") is no part of its parameters'
	/// store keys.
	VParameterGroup(
	    std::shared_ptr<TesselPluginInterface::IDataStore> i_pStore, std::string i_Path, std::string i_Name);
	~VParameterGroup() override;
	VParameterGroup(const VParameterGroup&) = delete;
	VParameterGroup& operator=(const VParameterGroup&) = delete;

	/// Makes a parameter for values of T with the texts that a control shows.
	template <typename T>
	std::shared_ptr<VParameter> Add(
	    const std::string& i_rName, const std::string& i_rDisplay = {}, const std::string& i_rDescription = {})
	{
		return AddNew<VParameter>(i_rDisplay, i_rDescription, i_rName, CheckerOf<T>());
	}

	/// As Add, for a class that derives from VParameter and takes more arguments behind store and path.
	template <typename TParameter, typename... VArguments>
	std::shared_ptr<TParameter> AddNew(
	    const std::string& i_rDisplay, const std::string& i_rDescription, VArguments&&... i_Arguments)
	{
		auto pParameter = NVX::MakeShared<TParameter>(m_pStore, m_Path, std::forward<VArguments>(i_Arguments)...);
		pParameter->SetDisplay(i_rDisplay);
		pParameter->SetDescription(i_rDescription);
		Add(pParameter);
		return pParameter;
	}

	void Add(std::shared_ptr<TesselPluginInterface::IParameter> i_pParameter);
	void AddChild(std::shared_ptr<TesselPluginInterface::IParameterGroup> i_pGroup);

	const std::string& GetPath() const override { return m_Path; }
	const std::string& GetName() const override { return m_Name; }
	std::string GetDisplay() const override;
	void SetDisplay(const std::string& i_rText);
	std::string GetDescription() const override;
	void SetDescription(const std::string& i_rText);
	const std::vector<std::shared_ptr<TesselPluginInterface::IParameter>>& GetParameters() const override
	{
		return m_Parameters;
	}
	std::shared_ptr<TesselPluginInterface::IParameter> Find(const std::string& i_rName) const override;
	const std::vector<std::shared_ptr<TesselPluginInterface::IParameterGroup>>& GetChildren() const override
	{
		return m_Children;
	}
	NVX::VSignal<>& ChangedSignal() override { return m_ChangedSignal; }
	NVX::VSignal<>& EndingSignal() override { return m_EndingSignal; }

private:
	const std::shared_ptr<TesselPluginInterface::IDataStore> m_pStore;
	const std::string m_Path;
	const std::string m_Name;
	const std::shared_ptr<TesselPluginInterface::IDataStore> m_pAttributes;
	std::vector<std::shared_ptr<TesselPluginInterface::IParameter>> m_Parameters;
	std::vector<std::shared_ptr<TesselPluginInterface::IParameterGroup>> m_Children;
	NVX::VSignal<> m_ChangedSignal;
	NVX::VSignal<> m_EndingSignal;
};

} // namespace TesselParameters
