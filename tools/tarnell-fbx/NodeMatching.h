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

/// Nodes that belong together, parents before children. Children of one pair match by their names, several of one name
/// in their order; what is left matches by a name that only one node on either side still has (it was moved), and then
/// by its number in the file, or as the only child of its kind that is left below a pair (it was renamed). Producer
/// cameras, and what hangs nowhere, are no part of it.
std::vector<NodePair> matchNodes(FbxScene& a, FbxScene& b);

/// Parents before children, in the order in which a faithful read has them.
std::vector<FbxNode*> nodesOfTree(FbxScene& scene);

} // namespace tool
