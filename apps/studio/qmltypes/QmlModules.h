#pragma once

#include "studio/qmltypes/Tessel.h"
#include "studio/qmltypes/TesselParameters.h"

#include <memory>

class QQmlEngine;

namespace TesselPluginInterface
{
class ISelectionManager;
}

namespace StudioHost
{

class VSelectionManager;

/// What the host's QML modules need of the host. What is missing makes its part of them do nothing.
struct VQmlServices
{
	std::shared_ptr<TesselPluginInterface::ISelectionManager> m_pSelectionManager;
	VParameterGroupModelMaker m_MakeParameterGroupModel;
	VCommandRunner m_RunCommand;
};

/// Makes "Orlex.Theme", "Orlex.Controls", "Orlex.Selection", "Orlex.Tessel.Parameters" and "TesselQML", each 1.0, known
/// to an engine, from the program's resources. Once for an engine, before it loads anything; engines of one process may
/// have different services.
/// @param i_rSourceFolder if not empty, the folder of the modules' QML files on disk, which come before the resources.
void RegisterQmlModules(QQmlEngine& io_rEngine, VQmlServices i_Services, const QString& i_rSourceFolder = {});

/// The selection of an engine's services, null if nothing was registered on it.
VSelectionManager* SelectionManagerOf(const QQmlEngine* i_pEngine);

} // namespace StudioHost
