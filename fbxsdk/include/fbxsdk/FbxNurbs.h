// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxNurbsSurface.h>

FBXSDK_NAMESPACE_BEGIN

/// A NURBS surface as older programs write it; FbxGeometryConverter converts it to a mesh.
class FBXSDK_DLL FbxNurbs : public FbxNurbsSurfaceBase {
    FBXSDK_OBJECT_DECLARE(FbxNurbs, FbxGeometry)

public:
    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override; ///< eNurbs.

protected:
    /// Fills the object from the file.
    FBXSDK_LOCAL bool readSource(const detail::GeometrySource& pSource) override;
};

FBXSDK_NAMESPACE_END
