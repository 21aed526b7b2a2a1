// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The one walk over the node tree: parents before their children, children in order.
#pragma once

#include <fbxsdk.h>

#include <vector>

namespace Tarnell::Fbx::detail {

/// Calls `visit(node)` for a node and everything below it, until it returns false; whether it never did. Null is an
/// empty tree.
///
/// The way back up is kept in a vector, not on the stack: a file can nest its nodes as deep as it likes. The child
/// count is asked for again after every child.
template <class Visit>
bool walkNodes(fbxsdk::FbxNode* top, Visit&& visit) {
    struct Position {
        fbxsdk::FbxNode* node;
        int nextChild;
    };
    std::vector<Position> path;
    const auto enter = [&](fbxsdk::FbxNode* node) {
        if (node == nullptr) {
            return true;
        }
        path.push_back({node, 0});
        return static_cast<bool>(visit(*node));
    };

    bool goOn = enter(top);
    while (goOn && !path.empty()) {
        Position& position = path.back();
        if (position.nextChild < position.node->GetChildCount()) {
            goOn = enter(position.node->GetChild(position.nextChild++));
        } else {
            path.pop_back();
        }
    }
    return goOn;
}

/// The same for everything below a node, but not the node itself.
template <class Visit>
bool walkBelow(fbxsdk::FbxNode* top, Visit&& visit) {
    bool goOn = true;
    for (int i = 0; goOn && top != nullptr && i < top->GetChildCount(); ++i) {
        goOn = walkNodes(top->GetChild(i), visit);
    }
    return goOn;
}

} // namespace Tarnell::Fbx::detail
