// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The tree of nodes, the animation stacks, and the placement of nodes.
#include "Matrices.h"
#include "Rows.h"
#include "Tolerances.h"

namespace conformance {
namespace {

using namespace fbxsdk;

struct KindRow {
    FbxNodeAttribute::EType type;
    const char* kind;
};

constexpr KindRow kKinds[] = {
    {FbxNodeAttribute::eNull, "null"},
    {FbxNodeAttribute::eMarker, "marker"},
    {FbxNodeAttribute::eSkeleton, "skeleton"},
    {FbxNodeAttribute::eMesh, "mesh"},
    {FbxNodeAttribute::eNurbs, "nurbs_surface"},
    {FbxNodeAttribute::eCamera, "camera"},
    {FbxNodeAttribute::eCameraStereo, "stereo_camera"},
    {FbxNodeAttribute::eCameraSwitcher, "camera_switcher"},
    {FbxNodeAttribute::eLight, "light"},
    {FbxNodeAttribute::eNurbsCurve, "nurbs_curve"},
    {FbxNodeAttribute::eNurbsSurface, "nurbs_surface"},
    {FbxNodeAttribute::eLODGroup, "lod_group"},
    {FbxNodeAttribute::eLine, "line"},
};

std::string kindOf(const FbxNode& node) {
    const FbxNodeAttribute* attribute = node.GetNodeAttribute();
    if (attribute == nullptr)
        return "none";
    for (const KindRow& row : kKinds)
        if (row.type == attribute->GetAttributeType())
            return row.kind;
    return "other";
}

struct Description {
    std::string name, kind;
    int parent = -1;

    bool operator==(const Description&) const = default;
    [[nodiscard]] std::string text() const { return kind + " \"" + name + "\" below " + std::to_string(parent); }
};

/// The reference's nodes in the tree. Parents are renumbered where producer cameras are omitted.
std::vector<Description> referenceTree(const LoadedFile& file) {
    std::vector<Description> tree;
    std::vector<int> newIndex;
    const std::vector<ReferenceNode>& nodes = file.reference().nodes;
    for (std::size_t i = 0; i < nodes.size(); ++i) {
        newIndex.push_back(static_cast<int>(tree.size()));
        if (file.besideTree(i))
            continue;
        const int parent = nodes[i].parent;
        tree.push_back({nodes[i].name, nodes[i].kind, parent < 0 ? -1 : newIndex[static_cast<std::size_t>(parent)]});
    }
    return tree;
}

std::vector<Description> sceneTree(const LoadedFile& file) {
    std::vector<Description> tree;
    for (const SceneNode& entry : file.nodes())
        tree.push_back({entry.name, kindOf(*entry.node), entry.parent});
    return tree;
}

/// The reference counts: 0 component-wise (RSrs), 1 without the parent's scale (Rrs), 2 scale after rotation (RrSs).
int referenceInherit(const FbxNode& node) {
    FbxTransform::EInheritType type{};
    node.GetTransformationInheritType(type);
    switch (type) {
    case FbxTransform::eInheritRSrs:
        return 0;
    case FbxTransform::eInheritRrs:
        return 1;
    case FbxTransform::eInheritRrSs:
        return 2;
    }
    return -1;
}

std::string missing(const ReferenceNode& node) { return "no node \"" + node.name + "\""; }

std::string difference(const std::string& what, const Matrix12& actual, const Matrix12& expected) {
    return what + ": " + printed(actual.data(), actual.size()) + " instead of " +
           printed(expected.data(), expected.size());
}

} // namespace

void checkNodes(LoadedFile& file, Findings& findings) {
    const std::vector<Description> expected = referenceTree(file);
    const std::vector<Description> actual = sceneTree(file);
    for (std::size_t i = 0; i < std::max(expected.size(), actual.size()); ++i) {
        const bool both = i < expected.size() && i < actual.size();
        findings.compare(both && actual[i] == expected[i], [&] {
            return "node " + std::to_string(i) + ": " + (i < actual.size() ? actual[i].text() : "nothing") +
                   " instead of " + (i < expected.size() ? expected[i].text() : "nothing");
        });
    }
}

void checkNodeSettings(LoadedFile& file, Findings& findings) {
    for (std::size_t i = 0; i < file.reference().nodes.size(); ++i) {
        const ReferenceNode& expected = file.reference().nodes[i];
        const SceneNode* entry = file.nodeOf(i);
        if (entry == nullptr) {
            findings.compare(false, [&] { return missing(expected); });
            continue;
        }
        FbxEuler::EOrder order{};
        entry->node->GetRotationOrder(FbxNode::eSourcePivot, order);
        const int inherit = referenceInherit(*entry->node);
        findings.compare(inherit == expected.inherit && order == expected.rotationOrder, [&] {
            return "\"" + expected.name + "\": inherits " + std::to_string(inherit) + ", rotation order " +
                   std::to_string(order) + " instead of " + std::to_string(expected.inherit) + ", " +
                   std::to_string(expected.rotationOrder);
        });
    }
}

void checkStacks(LoadedFile& file, Findings& findings) {
    if (!file.loaded())
        return;
    const FbxCriteria stacks = FbxCriteria::ObjectType(FbxAnimStack::ClassId);
    const std::vector<ReferenceStack>& expected = file.reference().stacks;
    const std::size_t count = static_cast<std::size_t>(file.scene()->GetSrcObjectCount(stacks));
    for (std::size_t i = 0; i < std::max(count, expected.size()); ++i) {
        auto* stack = FbxCast<FbxAnimStack>(file.scene()->GetSrcObject(stacks, static_cast<int>(i)));
        if (stack == nullptr || i >= expected.size()) {
            findings.compare(
                false, [&] { return std::to_string(count) + " stacks instead of " + std::to_string(expected.size()); });
            continue;
        }
        const FbxTimeSpan span = stack->GetLocalTimeSpan();
        const double begin = span.GetStart().GetSecondDouble();
        const double end = span.GetStop().GetSecondDouble();
        const int layers = stack->GetSrcObjectCount(FbxCriteria::ObjectType(FbxAnimLayer::ClassId));
        findings.compare(stack->GetName() == expected[i].name && layers == expected[i].layers &&
                             closeTo(begin, expected[i].begin, kSecondsTolerance) &&
                             closeTo(end, expected[i].end, kSecondsTolerance),
                         [&] {
                             return "\"" + std::string(stack->GetName()) + "\" " + printed(begin) + " to " +
                                    printed(end) + ", " + std::to_string(layers) + " layers instead of \"" +
                                    expected[i].name + "\" " + printed(expected[i].begin) + " to " +
                                    printed(expected[i].end) + ", " + std::to_string(expected[i].layers);
                         });
    }
}

void checkGeometricTransforms(LoadedFile& file, Findings& findings) {
    for (std::size_t i = 0; i < file.reference().nodes.size(); ++i) {
        const ReferenceNode& expected = file.reference().nodes[i];
        const SceneNode* entry = file.nodeOf(i);
        const Matrix12 actual = entry ? asMatrix12(geometricMatrix(*entry->node)) : Matrix12{};
        findings.compare(entry && sameMatrix(actual, expected.geometric, kEvaluatedTolerance), [&] {
            return entry ? difference("\"" + expected.name + "\"", actual, expected.geometric) : missing(expected);
        });
    }
}

void checkWorldMatrices(LoadedFile& file, Findings& findings) {
    const Reference& reference = file.reference();
    for (std::size_t i = 0; i < reference.nodes.size(); ++i) {
        const ReferenceNode& expected = reference.nodes[i];
        const SceneNode* entry = file.nodeOf(i);
        for (std::size_t f = 0; f < expected.world.size(); ++f) {
            const Matrix12 actual =
                entry ? asMatrix12(worldMatrix(*entry->node, timeOfSeconds(reference.seconds(f)))) : Matrix12{};
            findings.compare(entry && sameMatrix(actual, expected.world[f], kEvaluatedTolerance), [&] {
                if (!entry)
                    return missing(expected);
                return difference("\"" + expected.name + "\" at frame " + printed(reference.frames[f]), actual,
                                  expected.world[f]);
            });
        }
    }
}

} // namespace conformance
