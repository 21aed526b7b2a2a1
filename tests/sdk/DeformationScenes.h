// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes of a few points with their deformers, and their deformed points.
#pragma once

#include "support/SceneBuilders.h"

#include <gtest/gtest.h>

#include <memory>
#include <vector>

namespace Tarnell::Fbx::test {

using fbxsdk::FbxAMatrix;
using fbxsdk::FbxCluster;
using fbxsdk::FbxVector4;
using Points = std::vector<FbxVector4>;

inline FbxAMatrix translation(double x, double y, double z) {
    FbxAMatrix matrix;
    matrix.SetT(FbxVector4(x, y, z));
    return matrix;
}

/// A mesh of single points along X, (0,0,0), (1,0,0), …
inline fbxsdk::FbxNode* addPoints(TestScene& scene, int count) {
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxMesh>("mesh");
    Points points;
    for (int i = 0; i < count; ++i)
        points.emplace_back(static_cast<double>(i), 0.0, 0.0);
    fillMesh(*node->GetMesh(), points, {{0, 0, 0}});
    return node;
}

/// The deformed points of a node's mesh at a frame; empty when there are none.
inline Points deformed(TestScene& scene, fbxsdk::FbxNode* node, int frame = 0, FbxAMatrix globalPosition = {}) {
    fbxsdk::FbxTime time = timeOfFrame(frame);
    FbxVector4* made = nullptr;
    scene.sdk.getDeformedControlPoints(node, node->GetMesh(), time, globalPosition, &made);
    const std::unique_ptr<FbxVector4[]> owned(made);
    return made != nullptr ? Points(made, made + node->GetMesh()->GetControlPointsCount()) : Points();
}

inline fbxsdk::FbxSkin* addSkin(TestScene& scene, fbxsdk::FbxNode* node) {
    fbxsdk::FbxSkin* skin = fbxsdk::FbxSkin::Create(scene.scene, "skin");
    node->GetMesh()->AddDeformer(skin);
    return skin;
}

/// A cluster on a new bone, which was at the origin when it was bound.
inline FbxCluster* addCluster(TestScene& scene, fbxsdk::FbxSkin* skin, const FbxVector4& bonePosition,
                              FbxCluster::ELinkMode mode = FbxCluster::eNormalize) {
    fbxsdk::FbxNode* bone = scene.addNode("bone");
    bone->LclTranslation.Set({bonePosition[0], bonePosition[1], bonePosition[2]});
    FbxCluster* cluster = FbxCluster::Create(scene.scene, "cluster");
    cluster->SetLink(bone);
    cluster->SetLinkMode(mode);
    skin->AddCluster(cluster);
    return cluster;
}

inline void expectPoint(const FbxVector4& point, double x, double y, double z) {
    EXPECT_DOUBLE_EQ(point[0], x);
    EXPECT_DOUBLE_EQ(point[1], y);
    EXPECT_DOUBLE_EQ(point[2], z);
}

} // namespace Tarnell::Fbx::test
