// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

class FbxManager;
class FbxNodeAttribute;
class FbxScene;

/// Creates triangle meshes from surfaces and from other meshes.
class FBXSDK_DLL FbxGeometryConverter {
public:
    /// Objects are created by the manager of the converted object, whichever this one is.
    explicit FbxGeometryConverter(FbxManager*) {}

    /// A triangle mesh for a NURBS surface, patch or mesh, with materials, skins and shapes carried over; the
    /// attribute itself when it is a triangle mesh already. Null for other kinds and for degenerate surfaces.
    ///
    /// With pReplace the mesh replaces the attribute on every node, and the attribute is destroyed; without, the
    /// mesh is added to every node. pLegacy has no effect.
    FbxNodeAttribute* Triangulate(FbxNodeAttribute* pNodeAttribute, bool pReplace, bool pLegacy = false);
    /// The same for every attribute of the scene that it applies to. False when one of them could not be converted.
    bool Triangulate(FbxScene* pScene, bool pReplace, bool pLegacy = false);

    /// The platform's own: how many surfaces this converter sampled in coarser steps than they specify, because they
    /// specify more samples than their control points and those of their scene allow.
    [[nodiscard]] int coarserSurfaces() const { return mCoarser; }

private:
    int mCoarser = 0;
};

FBXSDK_NAMESPACE_END
