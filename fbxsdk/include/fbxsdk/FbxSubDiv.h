// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A subdivision surface, as a kind of attribute; files hold none with content of its own.
#pragma once

#include <fbxsdk/FbxGeometry.h>

FBXSDK_NAMESPACE_BEGIN

class FbxMesh;

class FBXSDK_DLL FbxSubDiv : public FbxGeometry {
    FBXSDK_OBJECT_DECLARE(FbxSubDiv, FbxGeometry)

public:
    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override;

    /// The mesh that is subdivided: the first one among the sources; null when there is none.
    bool SetBaseMesh(FbxMesh* pMesh);
    [[nodiscard]] FbxMesh* GetBaseMesh() const;

protected:
    bool readSource(const detail::GeometrySource& pSource) override;
};

FBXSDK_NAMESPACE_END
