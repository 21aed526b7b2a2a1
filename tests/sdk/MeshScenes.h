// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes with layers as tests build them, and the results of reading them.
#pragma once

#include "support/SceneBuilders.h"

#include "TnFbxError.h"

#include <gtest/gtest.h>

#include <vector>

namespace Tarnell::Fbx::test {

using fbxsdk::FbxColor;
using fbxsdk::FbxVector2;
using fbxsdk::FbxVector4;
using Element = fbxsdk::FbxLayerElement;
using Floats = std::vector<float>;

struct ReadOptions {
    bool transformPoints = false;
    bool global = false;
    float frame = 0.0f;
    float sampleRate = 0.0f; // converts key frames when above 0
};

inline bool readInto(TestScene& scene, fbxsdk::FbxNode* node, TnFbxMesh& mesh, ReadOptions options = {}) {
    TnFbxTime time = scene.time(options.frame);
    fbxsdk::FbxAMatrix geometric;
    if (node != nullptr) {
        geometric.SetTRS(node->GetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot),
                         node->GetGeometricRotation(fbxsdk::FbxNode::eSourcePivot),
                         node->GetGeometricScaling(fbxsdk::FbxNode::eSourcePivot));
    }
    return scene.sdk.getMesh(time, options.global, options.sampleRate > 0.0f, options.sampleRate, node,
                             options.transformPoints, mesh, geometric);
}

inline TnFbxMesh readMesh(TestScene& scene, fbxsdk::FbxNode* node, ReadOptions options = {}) {
    TnFbxMesh mesh;
    EXPECT_TRUE(readInto(scene, node, mesh, options)) << lastError();
    return mesh;
}

inline Floats pointOf(const TnFbxMesh& mesh, int index) {
    Floats p(3);
    EXPECT_TRUE(mesh.getControlPoint(index, p[0], p[1], p[2]));
    return p;
}

inline Floats normalOf(const TnFbxMesh& mesh, int polygonVertex) {
    Floats n(3);
    EXPECT_TRUE(mesh.getNormal(polygonVertex, n[0], n[1], n[2]));
    return n;
}

inline Floats uvOf(const TnFbxMesh& mesh, int polygonVertex) {
    Floats uv(2);
    EXPECT_TRUE(mesh.getUV(polygonVertex, uv[0], uv[1]));
    return uv;
}

inline Floats colourOf(const TnFbxMesh& mesh, int polygonVertex) {
    Floats c(4);
    EXPECT_TRUE(mesh.getColour(polygonVertex, c[0], c[1], c[2], c[3]));
    return c;
}

/// A quad 0 1 2 3 and a triangle 3 2 4, without layers.
inline fbxsdk::FbxNode* addTwoPolygons(TestScene& scene) {
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxMesh>("mesh");
    fillMesh(*node->GetMesh(), {{0.0, 0.0, 0.0}, {1.0, 0.0, 0.0}, {1.0, 1.0, 0.0}, {0.0, 1.0, 0.0}, {0.0, 2.0, 0.0}},
             {{0, 1, 2, 3}, {3, 2, 4}});
    return node;
}

inline fbxsdk::FbxLayer& layerOf(fbxsdk::FbxNode* node, int index = 0) {
    fbxsdk::FbxMesh* mesh = node->GetMesh();
    while (mesh->GetLayerCount() <= index)
        mesh->CreateLayer();
    return *mesh->GetLayer(index);
}

template <class ElementType, class Value>
ElementType* makeElement(fbxsdk::FbxNode* node, Element::EMappingMode mapping, Element::EReferenceMode reference,
                         const std::vector<Value>& values, const std::vector<int>& indices) {
    auto* element = ElementType::Create(node->GetMesh(), "");
    element->SetMappingMode(mapping);
    element->SetReferenceMode(reference);
    for (const Value& value : values)
        element->GetDirectArray().Add(value);
    for (const int index : indices)
        element->GetIndexArray().Add(index);
    return element;
}

inline void setNormals(fbxsdk::FbxNode* node, Element::EMappingMode mapping, Element::EReferenceMode reference,
                       const std::vector<FbxVector4>& values, const std::vector<int>& indices = {}, int layer = 0) {
    layerOf(node, layer)
        .SetNormals(makeElement<fbxsdk::FbxLayerElementNormal>(node, mapping, reference, values, indices));
}

inline void setUVs(fbxsdk::FbxNode* node, Element::EMappingMode mapping, Element::EReferenceMode reference,
                   const std::vector<FbxVector2>& values, const std::vector<int>& indices = {}, int layer = 0) {
    layerOf(node, layer)
        .SetUVs(makeElement<fbxsdk::FbxLayerElementUV>(node, mapping, reference, values, indices),
                Element::eTextureDiffuse);
}

inline void setColours(fbxsdk::FbxNode* node, Element::EMappingMode mapping, Element::EReferenceMode reference,
                       const std::vector<FbxColor>& values, const std::vector<int>& indices = {}, int layer = 0) {
    layerOf(node, layer)
        .SetVertexColors(makeElement<fbxsdk::FbxLayerElementVertexColor>(node, mapping, reference, values, indices));
}

inline const std::vector<FbxVector4> kSevenNormals = {{0.0, 0.0, 1.0}, {0.0, 0.0, 2.0}, {0.0, 0.0, 3.0},
                                                      {0.0, 0.0, 4.0}, {0.0, 0.0, 5.0}, {0.0, 0.0, 6.0},
                                                      {0.0, 0.0, 7.0}};
inline const Floats kWhite = {1.0f, 1.0f, 1.0f, 1.0f};
inline const Floats kZero3 = {0.0f, 0.0f, 0.0f};
inline const Floats kZero2 = {0.0f, 0.0f};

} // namespace Tarnell::Fbx::test
