// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The traversal of the nodes of a kind.
#include "Reading.h"

#include "access/NodeWalk.h"
#include "access/Normalisation.h"
#include "calls/LastError.h"

#include <cstddef>
#include <string>
#include <vector>

namespace Tarnell::Fbx::faithful {

namespace {

using Attribute = fbxsdk::FbxNodeAttribute;
using fbxsdk::FbxNode;

/// The cameras of an application's own views are not part of the scene.
bool isProducer(fbxsdk::FbxScene& scene, FbxNode& node) {
    const auto* camera = fbxsdk::FbxCast<fbxsdk::FbxCamera>(node.GetNodeAttribute());
    return camera != nullptr && scene.GlobalCameraSettings().IsProducerCamera(camera);
}

Attribute::EType typeOf(FbxNode& node) {
    const Attribute* attribute = node.GetNodeAttribute();
    return attribute != nullptr ? attribute->GetAttributeType() : Attribute::eUnknown;
}

/// Which nodes are objects of a kind.
template <class Object>
bool isOfKind(FbxNode& node);
template <>
bool isOfKind<TnFbxMesh>(FbxNode& node) {
    return typeOf(node) == Attribute::eMesh;
}
template <>
bool isOfKind<TnFbxCamera>(FbxNode& node) {
    return typeOf(node) == Attribute::eCamera || typeOf(node) == Attribute::eCameraStereo;
}
template <>
bool isOfKind<TnFbxLight>(FbxNode& node) {
    return typeOf(node) == Attribute::eLight;
}
template <>
bool isOfKind<TnFbxMarker>(FbxNode& node) {
    return typeOf(node) == Attribute::eMarker;
}
template <>
bool isOfKind<TnFbxNull>(FbxNode& node) {
    return typeOf(node) == Attribute::eNull || node.GetNodeAttribute() == nullptr;
}
template <>
bool isOfKind<TnFbxTransform>(FbxNode& /*node*/) {
    return true;
}

template <class Object>
constexpr bool kNeedsMeshes = false;
template <>
constexpr bool kNeedsMeshes<TnFbxMesh> = true;

/// The nodes of a read, parents before their children.
template <class Object>
std::vector<FbxNode*> nodesOf(Scene& scene, const TnFbxReadInfo& info) {
    if (kNeedsMeshes<Object>)
        triangulateSurfaces(scene);
    std::vector<FbxNode*> nodes;
    detail::walkBelow(scene.scene().GetRootNode(), [&](FbxNode& node) {
        const bool asked = info.getAllObjects() || info.getObjectName() == node.GetName();
        if (asked && isOfKind<Object>(node) && !isProducer(scene.scene(), node))
            nodes.push_back(&node);
        return info.getAllObjects() || nodes.empty();
    });
    return nodes;
}

} // namespace

void triangulateSurfaces(Scene& scene) {
    detail::Triangulation triangulation(scene.manager());
    detail::walkNodes(scene.scene().GetRootNode(), [&](FbxNode& node) {
        triangulation.visit(node);
        const Attribute::EType type = typeOf(node);
        if (type == Attribute::eNurbs || type == Attribute::ePatch || type == Attribute::eNurbsSurface ||
            type == Attribute::eTrimNurbsSurface)
            detail::warn(scene.fileName() + ": the surface of \"" + node.GetName() +
                         "\" cannot be converted to a mesh");
        return true;
    });
    triangulation.warnOfCoarser();
}

template <class Object>
bool readObjects(Scene& scene, const TnFbxReadInfo& info, Object** objects, int& count) {
    const std::vector<FbxNode*> nodes = nodesOf<Object>(scene, info);
    if (!scene.grantBytes(nodes.size() * sizeof(Object)))
        return false;
    if (nodes.empty())
        return detail::succeed();
    *objects = new Object[nodes.size()];
    count = static_cast<int>(nodes.size());
    for (std::size_t i = 0; i < nodes.size(); ++i) {
        (*objects)[i].setName(nodes[i]->GetName());
        if (!readNode(scene, info, *nodes[i], (*objects)[i]))
            return false;
    }
    scene.warnings().report();
    scene.warnings().forget();
    return detail::succeed();
}

template <class Object>
bool readObjects(const TnFbxReadInfo& info, Object** objects, int& count) {
    return detail::failOnFault(
        info.getFileName(),
        [&] {
            Scene scene;
            return scene.load(info) && readObjects(scene, info, objects, count);
        });
}

template bool readObjects(const TnFbxReadInfo&, TnFbxMesh**, int&);
template bool readObjects(Scene&, const TnFbxReadInfo&, TnFbxMesh**, int&);
template bool readObjects(const TnFbxReadInfo&, TnFbxCamera**, int&);
template bool readObjects(Scene&, const TnFbxReadInfo&, TnFbxCamera**, int&);
template bool readObjects(const TnFbxReadInfo&, TnFbxLight**, int&);
template bool readObjects(Scene&, const TnFbxReadInfo&, TnFbxLight**, int&);
template bool readObjects(const TnFbxReadInfo&, TnFbxMarker**, int&);
template bool readObjects(Scene&, const TnFbxReadInfo&, TnFbxMarker**, int&);
template bool readObjects(const TnFbxReadInfo&, TnFbxNull**, int&);
template bool readObjects(Scene&, const TnFbxReadInfo&, TnFbxNull**, int&);
template bool readObjects(const TnFbxReadInfo&, TnFbxTransform**, int&);
template bool readObjects(Scene&, const TnFbxReadInfo&, TnFbxTransform**, int&);

} // namespace Tarnell::Fbx::faithful
