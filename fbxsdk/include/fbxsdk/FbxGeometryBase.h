// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxLayer.h>
#include <fbxsdk/FbxStatus.h>

FBXSDK_NAMESPACE_BEGIN

/// Control points with layers. The content of a file is read on the first access; a file that has been
/// changed since then makes such a call throw std::runtime_error.
class FBXSDK_DLL FbxGeometryBase : public FbxLayerContainer {
    FBXSDK_ABSTRACT_DECLARE(FbxGeometryBase, FbxLayerContainer)

public:
    FbxPropertyT<FbxBool> PrimaryVisibility, ///< in files "Primary Visibility"; true
        CastShadow,                          ///< in files "Casts Shadows"; true
        ReceiveShadow;                       ///< in files "Receive Shadows"; true
    FbxPropertyT<FbxDouble3> BBoxMin,        ///< the smallest coordinates as the file states them; not kept up to date
        BBoxMax;                             ///< the largest coordinates as the file states them; not kept up to date

    /// Exactly that many points, all of them (0, 0, 0, 1). Negative counts as 0.
    virtual void InitControlPoints(int pCount);
    [[nodiscard]] virtual int GetControlPointsCount() const; ///< 0 for new geometry.
    /// A contiguous array in the geometry's own space, valid until the count changes; writing to it changes the points.
    /// Null, with a status, when there are no points.
    [[nodiscard]] virtual FbxVector4* GetControlPoints(FbxStatus* pStatus = nullptr) const;
    /// No effect out of range.
    virtual void SetControlPointAt(const FbxVector4& pCtrlPoint, int pIndex);
    /// A copy of the point; (0, 0, 0, 1) out of range.
    [[nodiscard]] virtual FbxVector4 GetControlPointAt(int pIndex) const;

    /// The platform's own view: the points in memory, without reading the file.
    [[nodiscard]] detail::PlainArray<FbxVector4>& points() { return mControlPoints; }

private:
    detail::PlainArray<FbxVector4> mControlPoints;
};

FBXSDK_NAMESPACE_END
