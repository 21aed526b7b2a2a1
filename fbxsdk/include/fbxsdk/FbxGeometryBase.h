// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A node attribute with control points.
#pragma once

#include <fbxsdk/FbxLayer.h>
#include <fbxsdk/FbxStatus.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxGeometryBase : public FbxLayerContainer {
    FBXSDK_ABSTRACT_DECLARE(FbxGeometryBase, FbxLayerContainer)

public:
    FbxPropertyT<FbxBool> PrimaryVisibility, CastShadow, ReceiveShadow;
    FbxPropertyT<FbxDouble3> BBoxMin, BBoxMax; ///< as the file states them; not kept up to date

    /// Exactly that many points, all of them (0, 0, 0, 1).
    virtual void InitControlPoints(int pCount);
    [[nodiscard]] virtual int GetControlPointsCount() const;
    /// One contiguous run, good until the count changes. Null when there are no points; the status then says so.
    [[nodiscard]] virtual FbxVector4* GetControlPoints(FbxStatus* pStatus = nullptr) const;
    /// No effect out of range.
    virtual void SetControlPointAt(const FbxVector4& pCtrlPoint, int pIndex);
    /// (0, 0, 0, 1) out of range.
    [[nodiscard]] virtual FbxVector4 GetControlPointAt(int pIndex) const;

    /// The platform's own view: the points as they are, without asking the file.
    [[nodiscard]] detail::PlainArray<FbxVector4>& points() { return mControlPoints; }

private:
    detail::PlainArray<FbxVector4> mControlPoints;
};

FBXSDK_NAMESPACE_END
