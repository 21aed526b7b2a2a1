// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Queries to a scene.
#include "SceneQueries.h"

#include <algorithm>

#include <fbxsdk/extensions/FileFacts.h>

#include "Similarity.h"

namespace tool {
namespace {

/// Appends a node and all descendants, without recursion: trees may have any depth.
void appendTree(TreeNode top, std::vector<TreeNode>& nodes) {
    std::vector<TreeNode> pending{top};
    while (!pending.empty()) {
        const TreeNode next = pending.back();
        pending.pop_back();
        const int index = static_cast<int>(nodes.size());
        nodes.push_back(next);
        const int count = next.node->GetChildCount();
        for (int i = count - 1; i >= 0; --i)
            pending.push_back({next.node->GetChild(i), index, next.depth + 1, i == count - 1, next.isDetached});
    }
}

} // namespace

std::vector<TreeNode> nodesInOrder(FbxScene& scene) {
    std::vector<TreeNode> nodes;
    FbxNode& root = *scene.GetRootNode();
    for (int i = 0; i < root.GetChildCount(); ++i)
        appendTree({root.GetChild(i), -1, 0, i == root.GetChildCount() - 1, false}, nodes);
    std::vector<FbxNode*> detached;
    for (int i = 0; i < scene.GetNodeCount(); ++i) {
        FbxNode* node = scene.GetNode(i);
        if (node != &root && !node->GetParent())
            detached.push_back(node);
    }
    for (FbxNode* node : detached)
        appendTree({node, -1, 0, node == detached.back(), true}, nodes);
    return nodes;
}

bool isAnimated(const FbxProperty& property) {
    for (int i = 0; i < property.GetSrcObjectCount<FbxAnimCurveNode>(); ++i)
        if (property.GetSrcObject<FbxAnimCurveNode>(i)->IsAnimated())
            return true;
    return false;
}

std::vector<FbxBlendShapeChannel*> blendChannelsOf(FbxNode& node) {
    std::vector<FbxBlendShapeChannel*> channels;
    auto* geometry = FbxCast<FbxGeometry>(node.GetNodeAttribute());
    for (int d = 0; geometry && d < geometry->GetDeformerCount(FbxDeformer::eBlendShape); ++d) {
        auto* shapes = FbxCast<FbxBlendShape>(geometry->GetDeformer(d, FbxDeformer::eBlendShape));
        for (int c = 0; shapes && c < shapes->GetBlendShapeChannelCount(); ++c)
            channels.push_back(shapes->GetBlendShapeChannel(c));
    }
    return channels;
}

bool isProducer(const FbxNode& node) {
    const auto* camera = FbxCast<FbxCamera>(node.GetNodeAttribute());
    return camera && node.GetScene()->GlobalCameraSettings().IsProducerCamera(camera);
}

bool isSkewHelper(const FbxNode& node) {
    if (node.GetNodeAttribute() || node.GetChildCount() != 1)
        return false;
    const FbxNode& skewed = *node.GetChild(0);
    FbxTransform::EInheritType inheritType = FbxTransform::eInheritRrSs;
    skewed.GetTransformationInheritType(inheritType);
    const FbxDouble3 offset = skewed.LclTranslation.Get();
    const bool isApart = offset[0] != 0.0 || offset[1] != 0.0 || offset[2] != 0.0;
    const std::string name = std::string(skewed.GetName()) + " skew"; // a number may follow
    return inheritType == FbxTransform::eInheritRSrs && !isApart && !isAnimated(skewed.LclTranslation) &&
           std::string(node.GetName()).compare(0, name.size(), name) == 0;
}

std::vector<FbxProperty> propertiesOf(const FbxObject& object) {
    std::vector<FbxProperty> properties;
    for (FbxProperty each = object.GetFirstProperty(); each.IsValid(); each = object.GetNextProperty(each))
        properties.push_back(each);
    return properties;
}

std::vector<FbxObject*> objectsNamed(FbxScene& scene, const std::string& name) {
    std::vector<FbxObject*> found;
    for (FbxObject* object : extensions::objectsOf(scene))
        if (!name.empty() && name == object->GetName())
            found.push_back(object);
    std::stable_partition(found.begin(), found.end(), [](const FbxObject* object) { return object->Is<FbxNode>(); });
    return found;
}

std::string spokenName(const FbxObject& object) {
    const std::string name = object.GetName();
    const auto* attribute = FbxCast<FbxNodeAttribute>(&object);
    return name.empty() && attribute && attribute->GetNodeCount() > 0 ? attribute->GetNode(0)->GetName() : name;
}

std::string className(const FbxObject& object) {
    const std::string name = object.GetClassId().GetName();
    return name.rfind("Fbx", 0) == 0 ? name.substr(3) : name;
}

std::string unknownObject(FbxScene& scene, const std::string& name) {
    std::vector<std::string> names;
    for (const FbxObject* object : extensions::objectsOf(scene))
        names.emplace_back(object->GetName());
    std::string similar;
    for (const std::string& each : mostSimilar(name, names))
        similar += (similar.empty() ? "; similar: \"" : ", \"") + each + '"';
    return "there is no object \"" + name + '"' + similar;
}

void printId(const FbxObject& object, bool hasIds, JsonWriter& json) {
    json.key("id");
    if (hasIds)
        json.integer(extensions::fileIdOf(object));
    else
        json.null();
}

} // namespace tool
