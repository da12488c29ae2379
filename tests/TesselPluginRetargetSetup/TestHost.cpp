#include "TestHost.h"

#include "../QtApplication.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "OrlexGraphics/item/SceneFramebufferObject.h"
#include "OrlexGraphics/skins/SkinCache.h"
#include "TesselParametersGUI/ParameterGroupModel.h"
#include "studio/qmltypes/QmlModules.h"

#include <QtQml>

namespace
{

[[maybe_unused]] auto* const g_pApplication = testing::AddGlobalTestEnvironment(new VQtApplication);

} // namespace

VTestEngine::VTestEngine(VTestContext& i_rContext, bool i_bModules)
{
	QObject::connect(&m_Engine, &QQmlEngine::warnings,
	    [this](const QList<QQmlError>& i_rErrors)
	    {
		    for (const QQmlError& rError : i_rErrors)
			    m_Warnings.append(rError.toString());
	    });
	if (!i_bModules)
		return;
	StudioHost::VQmlServices services;
	services.m_pSelectionManager = i_rContext.GetSelectionManager();
	services.m_MakeParameterGroupModel = [&i_rContext](const QString& i_rPath, const QString& i_rGroup)
	{
		return std::make_unique<TesselParametersGUI::VParameterGroupModel>(
		    i_rContext.GetParameterRegistry(), i_rContext.GetDispatcher(), i_rPath, i_rGroup);
	};
	StudioHost::RegisterQmlModules(m_Engine, services);
}

VTestGui::VTestGui(VTestContext& i_rContext, bool i_bModules)
    : m_pEngine(std::make_shared<VTestEngine>(i_rContext, i_bModules)),
      m_pShaderLibrary(std::make_shared<CoreGraphics::VShaderLibrary>()),
      m_pSkinCache(NVX::MakeShared<OrlexGraphics::VSkinCache>(i_rContext.GetDispatcher()))
{
}

void RunAll(VTestContext& io_rContext)
{
	do
		QCoreApplication::sendPostedEvents();
	while (io_rContext.Dispatcher().RunPending() > 0);
	QCoreApplication::processEvents();
}
