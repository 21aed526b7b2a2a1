// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

class FbxManager;
class FbxNodeAttribute;
class FbxScene;

/// Makes meshes of triangles from surfaces and from other meshes.
class FBXSDK_DLL FbxGeometryConverter {
public:
    /// Objects are made by the manager of what is converted, whichever this one is.
    explicit FbxGeometryConverter(FbxManager*) {}

    /// A mesh of triangles for a NURBS surface, patch or mesh, with materials, skins and shapes carried over; the
    /// attribute itself when it is a mesh of triangles already. Null for other kinds and for degenerate surfaces.
    ///
    /// With pReplace the mesh takes the attribute's place on every node, and the attribute is destroyed; without, the
    /// mesh is added to every node. pLegacy makes no difference.
    FbxNodeAttribute* Triangulate(FbxNodeAttribute* pNodeAttribute, bool pReplace, bool pLegacy = false);
    /// The same for every attribute of the scene that it applies to. False when one of them could not be converted.
    bool Triangulate(FbxScene* pScene, bool pReplace, bool pLegacy = false);

    /// The platform's own: how many surfaces this converter sampled in coarser steps than they ask for, since they ask
    /// for more samples than their control points and those of their scene allow.
    [[nodiscard]] int coarserSurfaces() const { return mCoarser; }

private:
    int mCoarser = 0;
};

FBXSDK_NAMESPACE_END
