// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxGeometry.h>

FBXSDK_NAMESPACE_BEGIN

class FbxMesh;

/// A subdivision surface, as a kind of attribute; files hold none with content of its own.
class FBXSDK_DLL FbxSubDiv : public FbxGeometry {
    FBXSDK_OBJECT_DECLARE(FbxSubDiv, FbxGeometry)

public:
    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override; ///< eSubDiv.

    /// Replaces the mesh that is subdivided. False for null, which removes it.
    bool SetBaseMesh(FbxMesh* pMesh);
    [[nodiscard]] FbxMesh* GetBaseMesh() const; ///< The first mesh among the sources; null when there is none.

protected:
    /// There is nothing to read.
    FBXSDK_LOCAL bool readSource(const detail::GeometrySource& pSource) override;
};

FBXSDK_NAMESPACE_END
