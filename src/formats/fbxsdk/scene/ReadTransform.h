#pragma once

#include "fbxsdk/container/ElementTree.h"
#include "fbxsdk/scene/NodeTransform.h"

namespace FbxFormat
{

/// The properties of a node, or of a template, that place it; what the record does not tell stays as it is.
void ReadTransform(const VElementTree& i_rTree, VElementIndex i_Object, VNodeTransform& io_rTransform);

} // namespace FbxFormat
