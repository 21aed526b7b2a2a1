// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Which materials of two scenes are the same.
#pragma once

#include <vector>

#include <fbxsdk.h>

#include "NodeMatching.h"

namespace tool {

struct MaterialPair {
    FbxSurfaceMaterial* a = nullptr; ///< null: the material is in the second scene only
    FbxSurfaceMaterial* b = nullptr;
};

/// Materials match by their names, several of one name in their order; what is left matches where nodes that belong
/// together have it at the same place (it was renamed).
std::vector<MaterialPair> matchMaterials(FbxScene& a, FbxScene& b, const std::vector<NodePair>& nodes);

} // namespace tool
