#pragma once

#include <QObject>

#include <functional>
#include <map>
#include <memory>
#include <utility>

class QAbstractItemModel;

namespace StudioHost
{

/// Makes the list model of a parameter group, by store path and group name; the group may come later than its model.
using VParameterGroupModelMaker = std::function<std::unique_ptr<QAbstractItemModel>(const QString&, const QString&)>;

/// The singleton "TesselParameters" of "Orlex.Tessel.Parameters".
class VTesselParameters : public QObject
{
	Q_OBJECT

public:
	explicit VTesselParameters(VParameterGroupModelMaker i_MakeModel, QObject* i_pParent = nullptr);
	~VTesselParameters() override;

	/// The one list model of a group, as long as the engine lives. Null without a maker.
	Q_INVOKABLE QObject* ParameterGroupModel(const QString& i_rPath, const QString& i_rGroup);

private:
	const VParameterGroupModelMaker m_MakeModel;
	std::map<std::pair<QString, QString>, std::unique_ptr<QAbstractItemModel>> m_Models;
};

} // namespace StudioHost
