// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxGeometryBase.h>

FBXSDK_NAMESPACE_BEGIN

class FbxBlendShapeChannel;
class FbxGeometry;

/// A target of a blend shape. The control points are full positions, one for each point of the geometry that is
/// deformed. Files store offsets; they become positions on the first access after the shape was connected to its
/// geometry. Until then there are no points.
class FBXSDK_DLL FbxShape : public FbxGeometryBase {
    FBXSDK_OBJECT_DECLARE(FbxShape, FbxGeometryBase)

public:
    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override; ///< eShape.

    /// The channel that the shape is a target of; null when there is none.
    [[nodiscard]] FbxBlendShapeChannel* GetBlendShapeChannel() const;
    /// The geometry that the channel's blend shape deforms; null when there is none.
    [[nodiscard]] FbxGeometry* GetBaseGeometry();

protected:
    /// Fills the shape from the file.
    FBXSDK_LOCAL bool readSource(const detail::GeometrySource& pSource) override;
};

FBXSDK_NAMESPACE_END
