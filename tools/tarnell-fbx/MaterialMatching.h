// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Matches the materials of two scenes.
#pragma once

#include <vector>

#include <fbxsdk.h>

#include "NodeMatching.h"

namespace tool {

struct MaterialPair {
    FbxSurfaceMaterial* a = nullptr; ///< null: the material is in the second scene only
    FbxSurfaceMaterial* b = nullptr;
};

/// Materials match by their names, several of one name in their order; the remaining ones match if nodes that match
/// have them in the same slot (renamed).
std::vector<MaterialPair> matchMaterials(FbxScene& a, FbxScene& b, const std::vector<NodePair>& nodes);

} // namespace tool
