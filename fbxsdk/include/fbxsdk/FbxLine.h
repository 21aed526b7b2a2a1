// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Polylines.
#pragma once

#include <fbxsdk/FbxGeometry.h>

FBXSDK_NAMESPACE_BEGIN

/// Each entry of the index array is a control point, or, with all bits inverted, the last one of its polyline.
class FBXSDK_DLL FbxLine : public FbxGeometry {
    FBXSDK_OBJECT_DECLARE(FbxLine, FbxGeometry)

public:
    FbxPropertyT<FbxBool> Renderable;

    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override;

    void SetIndexArraySize(int pCount);
    [[nodiscard]] int GetIndexArraySize() const;
    /// False out of range.
    bool SetPointIndexAt(int pValue, int pIndex, bool pAsEndPoint = false);
    /// The control point, also at the end of a polyline; -1 out of range.
    [[nodiscard]] int GetPointIndexAt(int pIndex) const;
    /// How many polylines there are, and where in the index array each one ends; -1 out of range.
    [[nodiscard]] int GetEndPointCount() const;
    [[nodiscard]] int GetEndPointAt(int pEndPointIndex) const;

    /// The platform's own view: as it is, without asking the file.
    [[nodiscard]] detail::PlainArray<int>& indices() { return mIndices; }

protected:
    bool readSource(const detail::GeometrySource& pSource) override;

private:
    detail::PlainArray<int> mIndices;
};

FBXSDK_NAMESPACE_END
