#pragma once

#include "TesselPluginInterface/IFlowFrame.h"
#include "TesselPluginInterface/IItemFactory.h"

#include <functional>
#include <map>
#include <string>
#include <vector>

namespace InMemoryHost
{

template <typename T>
class VFlowItem : public NVX::VCounted<TesselPluginInterface::IFlowItemOf<T>>
{
public:
	explicit VFlowItem(std::string i_FlowType) : m_FlowType(std::move(i_FlowType)) {}

	const std::string& FlowType() const override { return m_FlowType; }
	std::shared_ptr<const T> Value() const override { return m_pValue; }
	void SetValue(std::shared_ptr<const T> i_pValue) override { m_pValue = std::move(i_pValue); }

private:
	const std::string m_FlowType;
	std::shared_ptr<const T> m_pValue;
};

/// Knows the flow types of the item catalogue, items of parameters and of the scene, and what is registered.
class VItemFactory : public NVX::VCounted<TesselPluginInterface::IItemFactory>
{
public:
	VItemFactory();

	NVX::CountedPointer<TesselPluginInterface::IFlowItem> CreateItem(const std::string& i_rFlowType) override;

	/// Items of this flow type carry a T from then on.
	template <typename T>
	void Register(const std::string& i_rFlowType)
	{
		m_Makers[i_rFlowType] = [i_rFlowType] { return new VFlowItem<T>(i_rFlowType); };
	}

private:
	std::map<std::string, std::function<TesselPluginInterface::IFlowItem*()>> m_Makers;
};

class VFlowFrame : public NVX::VCounted<TesselPluginInterface::IFlowFrame>
{
public:
	void AddItem(const NVX::CountedPointer<TesselPluginInterface::IFlowItem>& i_rpItem) override;
	NVX::CountedPointer<TesselPluginInterface::IFlowItem> Item(const std::string& i_rFlowType) const override;
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> Copy() const override;

	/// In the order in which they were added.
	const std::vector<NVX::CountedPointer<TesselPluginInterface::IFlowItem>>& Items() const { return m_Items; }

private:
	std::vector<NVX::CountedPointer<TesselPluginInterface::IFlowItem>> m_Items;
};

class VFrameFactory : public NVX::VCounted<TesselPluginInterface::IFrameFactory>
{
public:
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> CreateFrame() override;
};

} // namespace InMemoryHost
