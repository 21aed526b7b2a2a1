// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Traversal of node trees without recursion: the depth of a file is not bounded by the call stack.
#pragma once

#include <utility>
#include <vector>

#include <fbxsdk/FbxNode.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// All descendants of a node, each node before its children. The tree must not change meanwhile.
template <class Node>
class NodesBelow {
public:
    explicit NodesBelow(Node& top) { mPath.emplace_back(&top, 0); }

    /// Null after the last one.
    Node* next() {
        while (!mPath.empty()) {
            auto& [node, index] = mPath.back();
            if (Node* child = node->GetChild(index++)) {
                mPath.emplace_back(child, 0);
                return child;
            }
            mPath.pop_back();
        }
        return nullptr;
    }

private:
    std::vector<std::pair<Node*, int>> mPath; ///< from the top to the last node, each with the next child to visit
};

/// Whether the node is the top or below it. Costs the smaller of the top's subtree and the node's depth, so that a tree
/// of n nodes, in whatever order its edges come, is checked in n log n.
inline bool isAtOrBelow(const FbxNode& top, const FbxNode& node) {
    NodesBelow<const FbxNode> below(top);
    const FbxNode* ancestor = &node;
    const FbxNode* descendant = &top;
    while (ancestor && descendant) {
        if (ancestor == &top || descendant == &node)
            return true;
        ancestor = ancestor->GetParent();
        descendant = below.next();
    }
    return false;
}

} // namespace detail
FBXSDK_NAMESPACE_END
