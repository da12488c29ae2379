#include "studio/qmltypes/TesselParameters.h"

#include <QAbstractItemModel>
#include <QQmlEngine>

namespace StudioHost
{

VTesselParameters::VTesselParameters(VParameterGroupModelMaker i_MakeModel, QObject* i_pParent)
    : QObject(i_pParent), m_MakeModel(std::move(i_MakeModel))
{
}

VTesselParameters::~VTesselParameters() = default;

QObject* VTesselParameters::ParameterGroupModel(const QString& i_rPath, const QString& i_rGroup)
{
	if (!m_MakeModel)
		return nullptr;
	std::unique_ptr<QAbstractItemModel>& rpModel = m_Models[{i_rPath, i_rGroup}];
	if (!rpModel)
	{
		rpModel = m_MakeModel(i_rPath, i_rGroup);
		QQmlEngine::setObjectOwnership(rpModel.get(), QQmlEngine::CppOwnership);
	}
	return rpModel.get();
}

} // namespace StudioHost

#include "moc_TesselParameters.cpp"
