#pragma once

#include "math/IMathFactory.h"

#include <functional>
#include <map>
#include <string>

namespace Math
{

/// Values by name, as the two maps below keep them.
class VNamedValues
{
public:
	void Set(std::string_view i_Name, const IVector& i_rValue)
	{
		auto found = m_Values.find(i_Name);
		if (found == m_Values.end())
			found = m_Values.emplace(i_Name, std::vector<double>()).first;
		found->second.resize(i_rValue.Size());
		for (std::size_t i = 0; i < found->second.size(); ++i)
			found->second[i] = i_rValue.Get(i);
	}

	/// Null if there is none.
	const std::vector<double>* Find(std::string_view i_Name) const
	{
		const auto found = m_Values.find(i_Name);
		return found == m_Values.end() ? nullptr : &found->second;
	}

	void Clear() { m_Values.clear(); }

private:
	std::map<std::string, std::vector<double>, std::less<>> m_Values;
};

template <typename TBase>
class VMathFactoryVariableMap : public TBase
{
public:
	void SetVariable(std::string_view i_Name, const IVector& i_rValue) override { m_Variables.Set(i_Name, i_rValue); }

	VMathNodePointer GetVariable(std::string_view i_Name) override
	{
		const std::vector<double>* const pValue = m_Variables.Find(i_Name);
		return pValue ? this->MakeVariable(i_Name, *pValue) : nullptr;
	}

	/// The components without a node; null if there is no such variable.
	const std::vector<double>* FindVariable(std::string_view i_Name) const { return m_Variables.Find(i_Name); }

	void ClearVariables() override { m_Variables.Clear(); }

private:
	VNamedValues m_Variables;
};

template <typename TBase>
class VMathFactoryConstantMap : public TBase
{
public:
	void SetConstant(std::string_view i_Name, const IVector& i_rValue) override { m_Constants.Set(i_Name, i_rValue); }

	VMathNodePointer GetConstant(std::string_view i_Name) override
	{
		const std::vector<double>* const pValue = m_Constants.Find(i_Name);
		return pValue ? this->MakeConstant(i_Name, *pValue) : nullptr;
	}

	/// The components without a node; null if there is no such constant.
	const std::vector<double>* FindConstant(std::string_view i_Name) const { return m_Constants.Find(i_Name); }

	void ClearConstants() override { m_Constants.Clear(); }

private:
	VNamedValues m_Constants;
};

using VMathFactoryMaps = VMathFactoryConstantMap<VMathFactoryVariableMap<IMathFactory>>;

} // namespace Math
