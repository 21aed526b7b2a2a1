// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What every scene becomes before it is read: centimetres, Y up, right-handed, and meshes in the place of surfaces.
#pragma once

#include <fbxsdk.h>

namespace Tarnell::Fbx::detail {

void convertToCentimetres(fbxsdk::FbxScene& scene);
void convertToYUp(fbxsdk::FbxScene& scene);

/// Puts meshes in the place of NURBS and patches, node by node.
class Triangulation {
public:
    explicit Triangulation(fbxsdk::FbxManager* manager) : mConverter(manager) {}
    /// False when the node's surface cannot become a mesh and stays.
    bool visit(fbxsdk::FbxNode& node);
    /// To be called in the end: warns of surfaces that became coarser than they ask for, where the platform can tell.
    void warnOfCoarser() const;

private:
    fbxsdk::FbxGeometryConverter mConverter;
};

} // namespace Tarnell::Fbx::detail
