// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Which nodes of two scenes are the same.
#pragma once

#include <vector>

#include <fbxsdk.h>

namespace tool {

struct NodePair {
    FbxNode* a = nullptr; ///< null: the node is in the second scene only
    FbxNode* b = nullptr;
};

/// Pairs of nodes, parents before children. Children of one pair match by their names, several of one name
/// in their order; the remaining ones match by a name that is unique among them on both sides (moved), and then
/// by their number in the file, or as the only remaining child of its kind below a pair (renamed). Producer
/// cameras, and unparented nodes, are not included.
std::vector<NodePair> matchNodes(FbxScene& a, FbxScene& b);

/// Parents before children, in the order in which a faithful read has them.
std::vector<FbxNode*> nodesOfTree(FbxScene& scene);

} // namespace tool
