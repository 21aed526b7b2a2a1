// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The normalisation of every scene before it is read: centimetres, Y up, right-handed, and meshes instead of surfaces.
#pragma once

#include <fbxsdk.h>

namespace Tarnell::Fbx::detail {

void convertToCentimetres(fbxsdk::FbxScene& scene);
void convertToYUp(fbxsdk::FbxScene& scene);

/// Replaces NURBS and patches by meshes, node by node.
class Triangulation {
public:
    explicit Triangulation(fbxsdk::FbxManager* manager) : mConverter(manager) {}
    /// False when the node's surface cannot be converted and stays.
    bool visit(fbxsdk::FbxNode& node);
    /// To be called at the end: warns of surfaces that were sampled too coarsely, where the platform reports them.
    void warnOfCoarser() const;

private:
    fbxsdk::FbxGeometryConverter mConverter;
};

} // namespace Tarnell::Fbx::detail
