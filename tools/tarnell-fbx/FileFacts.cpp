// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "FileFacts.h"

#include <algorithm>
#include <cstddef>

#include "SceneFacts.h"

namespace tool {

using namespace fbxsdk;

namespace {

bool isOfKind(const FbxNode& node, const std::string& kind) {
    const FbxNodeAttribute* attribute = node.GetNodeAttribute();
    const auto type = attribute ? attribute->GetAttributeType() : FbxNodeAttribute::eUnknown;
    if (kind == "cameras")
        return type == FbxNodeAttribute::eCamera || type == FbxNodeAttribute::eCameraStereo;
    if (kind == "lights")
        return type == FbxNodeAttribute::eLight;
    if (kind == "markers")
        return type == FbxNodeAttribute::eMarker;
    if (kind == "nulls")
        return type == FbxNodeAttribute::eNull || !attribute;
    if (kind == "meshes") // surfaces are read as meshes
        return type == FbxNodeAttribute::eMesh || type == FbxNodeAttribute::eNurbs || type == FbxNodeAttribute::ePatch;
    return true;
}

/// Parents before their children.
std::vector<FbxNode*> nodesOf(FbxScene& scene, const std::string& kind) {
    std::vector<FbxNode*> nodes, waiting = {scene.GetRootNode()};
    while (!waiting.empty()) {
        FbxNode* node = waiting.back();
        waiting.pop_back();
        if (node->GetParent() && isOfKind(*node, kind))
            nodes.push_back(node);
        for (int i = node->GetChildCount() - 1; i >= 0; --i)
            waiting.push_back(node->GetChild(i));
    }
    return nodes;
}

FbxCriteria isStack() { return FbxCriteria::ObjectType(FbxAnimStack::ClassId); }

} // namespace

FileFacts::~FileFacts() {
    if (mManager)
        mManager->Destroy();
}

std::string FileFacts::load(const std::string& file) {
    mManager = FbxManager::Create();
    mScene = FbxScene::Create(mManager, "");
    FbxImporter* importer = FbxImporter::Create(mManager, "");
    if (importer->Initialize(file.c_str(), -1, nullptr) && importer->Import(mScene))
        return {};
    return importer->GetStatus().GetErrorString();
}

double FileFacts::unitInCentimetres() const { return mScene->GetGlobalSettings().GetSystemUnit().GetScaleFactor(); }

std::string FileFacts::axes() const {
    const Axes axes = axesOf(mScene->GetGlobalSettings().GetAxisSystem());
    return axes.up + " up, " + axes.toViewer + " to the viewer, " + (axes.rightHanded ? "right" : "left") + "-handed";
}

std::vector<std::string> FileFacts::stackNames() const {
    std::vector<std::string> names;
    for (int i = 0; i < mScene->GetSrcObjectCount(isStack()); ++i)
        names.emplace_back(mScene->GetSrcObject(isStack(), i)->GetName());
    return names;
}

std::optional<std::pair<double, double>> FileFacts::keyedRange(const std::string& stackName) const {
    const std::vector<std::string> names = stackNames();
    for (std::size_t i = 0; i < names.size(); ++i) {
        if (!stackName.empty() && names[i] != stackName)
            continue;
        auto* stack = FbxCast<FbxAnimStack>(mScene->GetSrcObject(isStack(), static_cast<int>(i)));
        FbxTimeSpan span(FBXSDK_TIME_INFINITE, FBXSDK_TIME_MINUS_INFINITE);
        bool keyed = false;
        const int layers = stack->GetSrcObjectCount(FbxCriteria::ObjectType(FbxAnimLayer::ClassId));
        for (int layer = 0; layer < layers; ++layer)
            keyed = mScene->GetRootNode()->GetAnimationInterval(span, stack, layer) || keyed;
        if (keyed)
            return std::pair(span.GetStart().GetSecondDouble(), span.GetStop().GetSecondDouble());
        break;
    }
    return std::nullopt;
}

bool FileFacts::has(const std::string& kind, const std::string& name) const {
    const std::vector<FbxNode*> nodes = nodesOf(*mScene, kind);
    return std::any_of(nodes.begin(), nodes.end(), [&name](const FbxNode* node) { return name == node->GetName(); });
}

void FileFacts::beginNodes(const std::string& kind) {
    mNodes = nodesOf(*mScene, kind);
    mNext = 0;
}

std::optional<std::string> FileFacts::parentOfNext(const std::string& name) {
    while (mNext < mNodes.size()) {
        const FbxNode* node = mNodes[mNext++];
        if (name != node->GetName())
            continue;
        const FbxNode* parent = node->GetParent();
        return parent && parent->GetParent() ? std::optional<std::string>(parent->GetName()) : std::nullopt;
    }
    return std::nullopt;
}

} // namespace tool
