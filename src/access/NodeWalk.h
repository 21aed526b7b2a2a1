// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The traversal of the node tree: parents before their children, children in order.
#pragma once

#include <fbxsdk.h>

#include <vector>

namespace Tarnell::Fbx::detail {

/// Calls `visit(node)` for a node and all its descendants, until it returns false; returns whether it never did. Null
/// is an empty tree.
///
/// The ancestors are kept in a vector, not on the call stack: a file can nest its nodes to any depth. The child
/// count is read again after every child.
template <class Visit>
bool walkNodes(fbxsdk::FbxNode* top, Visit&& visit) {
    struct Position {
        fbxsdk::FbxNode* node;
        int nextChild;
    };
    std::vector<Position> path;
    const auto enter = [&](fbxsdk::FbxNode* node) {
        if (node == nullptr)
            return true;
        path.push_back({node, 0});
        return static_cast<bool>(visit(*node));
    };

    bool goOn = enter(top);
    while (goOn && !path.empty()) {
        Position& position = path.back();
        if (position.nextChild < position.node->GetChildCount())
            goOn = enter(position.node->GetChild(position.nextChild++));
        else
            path.pop_back();
    }
    return goOn;
}

/// The same for all descendants of a node, but not the node itself.
template <class Visit>
bool walkBelow(fbxsdk::FbxNode* top, Visit&& visit) {
    bool goOn = true;
    for (int i = 0; goOn && top != nullptr && i < top->GetChildCount(); ++i)
        goOn = walkNodes(top->GetChild(i), visit);
    return goOn;
}

} // namespace Tarnell::Fbx::detail
