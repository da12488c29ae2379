#pragma once

#include "numerics/Rotation.h"

#include <map>
#include <string>
#include <vector>

/// World poses of each node in each frame, as another program reads them: in the file's own axes and unit, without the
/// scene's root. Empty, with a failure, if there is no such animation.
using VNodePoses = std::map<std::string, std::vector<Rotation::VPose<double>>>;
VNodePoses ReadByAssimp(
    const std::string& i_rBytes, const char* i_pForm, const std::string& i_rAnimation, std::size_t i_Frames);

/// Where the first frame of the animation puts the points of all meshes that bones move.
std::vector<Rotation::VVector3> SkinnedPoints(const std::string& i_rBytes, const char* i_pForm);
