#pragma once

/// The part of the FBX SDK that this system calls, with the SDK's own signatures, over our own reader of the format.
/// Code that includes only this header compiles against the SDK itself as well.

#include "fbxsdk/sdk/AffineMatrix.h"
#include "fbxsdk/sdk/Deformer.h"
#include "fbxsdk/sdk/GlobalSettings.h"
#include "fbxsdk/sdk/Importer.h"
#include "fbxsdk/sdk/Manager.h"
#include "fbxsdk/sdk/Material.h"
#include "fbxsdk/sdk/Mesh.h"
#include "fbxsdk/sdk/Node.h"
#include "fbxsdk/sdk/Scene.h"
#include "fbxsdk/sdk/Status.h"
#include "fbxsdk/sdk/Stream.h"

using namespace fbxsdk;
