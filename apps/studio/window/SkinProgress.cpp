#include "studio/window/SkinProgress.h"

#include "OrlexGraphics/skins/SkinCache.h"
#include "studio/window/Named.h"
#include "studio/window/PlainTexts.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QPointer>
#include <QProgressBar>
#include <QStringList>

namespace StudioHost
{
namespace
{

/// In pixels, of a bar that runs to and fro.
constexpr QSize c_BarSize{80, 8};

QWidget* MakeBar()
{
	auto* const pBar = Named(new QProgressBar, "SkinProgressBar", VSkinProgress::tr("A skin is being loaded"));
	pBar->setRange(0, 0);
	pBar->setTextVisible(false);
	pBar->setFixedSize(c_BarSize);
	return pBar;
}

} // namespace

VSkinProgress::VSkinProgress(std::shared_ptr<OrlexGraphics::VSkinCache> i_pSkinCache,
    const std::shared_ptr<TesselPluginInterface::IDispatcher>& i_rpDispatcher, QWidget* i_pParent)
    : QWidget(i_pParent), m_pSkinCache(std::move(i_pSkinCache)),
      m_pText(Named(new QLabel, "SkinProgressText", tr("Skins that are being loaded"))), m_pBar(MakeBar())
{
	Named(this, "SkinProgress", tr("Progress of skins"));
	auto* const pLayout = new QHBoxLayout(this);
	pLayout->setContentsMargins(4, 0, 8, 0);
	pLayout->addWidget(m_pText);
	pLayout->addWidget(m_pBar);
	m_pSkinCache->LoadingSignal().Connect(
	    [pThis = QPointer<VSkinProgress>(this)]
	    {
		    if (!pThis)
			    throw NVX::VDeregisterWeakCallbackException();
		    pThis->Refresh();
	    },
	    i_rpDispatcher);
	Refresh();
}

void VSkinProgress::Refresh()
{
	QStringList names;
	for (const std::string& rName : m_pSkinCache->Loading())
		names << ShownText(QString::fromStdString(rName));
	m_pText->setText(names.isEmpty() ? QString() : tr("Loading skin %1").arg(names.join(", ")));
	m_pBar->setVisible(!names.isEmpty());
	adjustSize();
	updateGeometry();
}

} // namespace StudioHost

#include "moc_SkinProgress.cpp"
