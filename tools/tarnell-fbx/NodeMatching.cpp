// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "NodeMatching.h"

#include <deque>
#include <map>
#include <string>
#include <string_view>
#include <unordered_map>

#include <fbxsdk/extensions/FileFacts.h>

#include "SceneFacts.h"
#include "SceneQueries.h"

namespace tool {
namespace {

class Matching {
public:
    Matching(FbxScene& a, FbxScene& b) : mA(nodesOfTree(a)), mB(nodesOfTree(b)) {
        mOfA[a.GetRootNode()] = b.GetRootNode();
        mOfB[b.GetRootNode()] = a.GetRootNode();
        matchChildren(*a.GetRootNode(), *b.GetRootNode());
        matchMoved();
        matchRenamed();
    }

    std::vector<NodePair> pairs() const {
        std::vector<NodePair> pairs;
        for (FbxNode* node : mA) {
            const auto found = mOfA.find(node);
            pairs.push_back({node, found == mOfA.end() ? nullptr : found->second});
        }
        for (FbxNode* node : mB)
            if (!mOfB.count(node))
                pairs.push_back({nullptr, node});
        return pairs;
    }

private:
    using ByName = std::map<std::string, std::deque<FbxNode*>, std::less<>>;

    void match(FbxNode& a, FbxNode& b) {
        mOfA[&a] = &b;
        mOfB[&b] = &a;
        matchChildren(a, b);
    }

    /// All descendants of a pair, level by level: trees may have any depth.
    void matchChildren(FbxNode& topA, FbxNode& topB) {
        std::deque<NodePair> waiting{{&topA, &topB}};
        while (!waiting.empty()) {
            const NodePair pair = waiting.front();
            waiting.pop_front();
            ByName byName;
            for (int i = 0; i < pair.b->GetChildCount(); ++i) {
                FbxNode* child = pair.b->GetChild(i);
                if (!mOfB.count(child))
                    byName[child->GetName()].push_back(child);
            }
            for (int i = 0; i < pair.a->GetChildCount(); ++i) {
                FbxNode* child = pair.a->GetChild(i);
                const auto found = byName.find(std::string_view(child->GetName()));
                if (mOfA.count(child) || found == byName.end() || found->second.empty())
                    continue;
                FbxNode* other = found->second.front();
                found->second.pop_front();
                mOfA[child] = other;
                mOfB[other] = child;
                waiting.push_back({child, other});
            }
        }
    }

    template <class Known>
    static ByName leftOf(const std::vector<FbxNode*>& nodes, const Known& known) {
        ByName left;
        for (FbxNode* node : nodes)
            if (!known.count(node))
                left[node->GetName()].push_back(node);
        return left;
    }

    void matchMoved() {
        const ByName left = leftOf(mB, mOfB), own = leftOf(mA, mOfA);
        for (FbxNode* node : mA) {
            const std::string name = node->GetName();
            const auto found = left.find(name);
            if (mOfA.count(node) || name.empty() || found == left.end() || found->second.size() != 1 ||
                own.at(name).size() != 1 || mOfB.count(found->second.front()))
                continue;
            match(*node, *found->second.front());
        }
    }

    void matchRenamed() {
        std::map<std::int64_t, FbxNode*> byId;
        for (FbxNode* node : mB)
            if (!mOfB.count(node))
                byId[extensions::fileIdOf(*node)] = node;
        for (FbxNode* node : mA) {
            const auto found = byId.find(extensions::fileIdOf(*node));
            if (found != byId.end())
                matchIfAlike(*node, found->second);
        }
        for (FbxNode* node : mA)
            if (!mOfA.count(node))
                matchIfAlike(*node, onlySibling(*node));
    }

    void matchIfAlike(FbxNode& a, FbxNode* b) {
        if (b && !mOfA.count(&a) && !mOfB.count(b) && std::string_view(kindOf(a)) == kindOf(*b) && areAsLarge(a, *b))
            match(a, *b);
    }

    /// A mesh with another name and other points is another mesh.
    static bool areAsLarge(FbxNode& a, FbxNode& b) {
        FbxMesh *meshA = a.GetMesh(), *meshB = b.GetMesh();
        return !meshA || !meshB ||
               (meshA->GetControlPointsCount() == meshB->GetControlPointsCount() &&
                meshA->GetPolygonCount() == meshB->GetPolygonCount());
    }

    /// The unmatched nodes below a parent: for each kind the only node, or null where there are several.
    using LeftByKind = std::map<std::string_view, FbxNode*>;

    /// The only unmatched node of the kind below the parent's counterpart, where this is the only one here, too.
    FbxNode* onlySibling(FbxNode& node) {
        const auto parent = mOfA.find(node.GetParent());
        if (parent == mOfA.end())
            return nullptr;
        const char* kind = kindOf(node);
        return onlyLeft(*node.GetParent(), kind, mOfA) ? onlyLeft(*parent->second, kind, mOfB) : nullptr;
    }

    /// Called after all other matches, so that the unmatched nodes are counted once per parent.
    template <class Known>
    FbxNode* onlyLeft(FbxNode& parent, std::string_view kind, const Known& known) {
        const auto [counted, isNew] = mLeft.try_emplace(&parent);
        for (int i = 0; isNew && i < parent.GetChildCount(); ++i) {
            FbxNode* child = parent.GetChild(i);
            if (known.count(child))
                continue;
            const auto [only, isFirst] = counted->second.try_emplace(kindOf(*child), child);
            if (!isFirst)
                only->second = nullptr;
        }
        const auto found = counted->second.find(kind);
        return found == counted->second.end() ? nullptr : found->second;
    }

    std::unordered_map<const FbxNode*, LeftByKind> mLeft;
    std::vector<FbxNode*> mA, mB;
    std::unordered_map<const FbxNode*, FbxNode*> mOfA, mOfB;
};

} // namespace

std::vector<FbxNode*> nodesOfTree(FbxScene& scene) {
    std::vector<FbxNode*> nodes;
    for (const TreeNode& each : nodesInOrder(scene))
        if (!each.isDetached && !isProducer(*each.node))
            nodes.push_back(each.node);
    return nodes;
}

std::vector<NodePair> matchNodes(FbxScene& a, FbxScene& b) { return Matching(a, b).pairs(); }

} // namespace tool
