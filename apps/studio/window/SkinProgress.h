#pragma once

#include <QWidget>

#include <memory>

class QLabel;

namespace OrlexGraphics
{
class VSkinCache;
}

namespace TesselPluginInterface
{
class IDispatcher;
}

namespace StudioHost
{

/// Which skins are being loaded; empty when none is.
class VSkinProgress : public QWidget
{
	Q_OBJECT

public:
	VSkinProgress(std::shared_ptr<OrlexGraphics::VSkinCache> i_pSkinCache,
	    const std::shared_ptr<TesselPluginInterface::IDispatcher>& i_rpDispatcher, QWidget* i_pParent = nullptr);

private:
	void Refresh();

	const std::shared_ptr<OrlexGraphics::VSkinCache> m_pSkinCache;
	QLabel* const m_pText;
	QWidget* const m_pBar;
};

} // namespace StudioHost
