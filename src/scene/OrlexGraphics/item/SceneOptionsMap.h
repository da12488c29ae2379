#pragma once

#include "OrlexGraphics/frame/SceneOptions.h"

class QQmlPropertyMap;

namespace OrlexGraphics
{

/// Sets the value of every option in the map, under the option's key; that of an option of a subject class is the
/// class, a minus sign and the option ("SolvingSubject-SkinXRay"). The map tells QML, but does not emit valueChanged.
void WriteOptionsToMap(const VSceneOptions& i_rOptions, QQmlPropertyMap& io_rMap);

/// Reads every option back. An option that the map lacks, or whose value does not convert to its type or is no finite
/// number, keeps its value.
/// @return false if there is such an option.
bool ReadOptionsFromMap(const QQmlPropertyMap& i_rMap, VSceneOptions& io_rOptions);

} // namespace OrlexGraphics
