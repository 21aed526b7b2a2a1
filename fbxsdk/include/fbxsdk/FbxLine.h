// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxGeometry.h>

FBXSDK_NAMESPACE_BEGIN

/// Polylines. Each entry of the index array is a control point, or, with all bits inverted, the last one of its
/// polyline.
class FBXSDK_DLL FbxLine : public FbxGeometry {
    FBXSDK_OBJECT_DECLARE(FbxLine, FbxGeometry)

public:
    FbxPropertyT<FbxBool> Renderable; ///< false by default

    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override; ///< eLine.

    void SetIndexArraySize(int pCount);          ///< New entries refer to control point 0. Negative counts as 0.
    [[nodiscard]] int GetIndexArraySize() const; ///< The entries of all polylines.
    /// Sets an entry to a control point, which need not exist. False out of range and for a negative point.
    bool SetPointIndexAt(int pValue, int pIndex, bool pAsEndPoint = false);
    /// The control point, also at the end of a polyline; -1 out of range.
    [[nodiscard]] int GetPointIndexAt(int pIndex) const;
    /// How many polylines there are; an unterminated last one does not count.
    [[nodiscard]] int GetEndPointCount() const;
    /// The position in the index array where that polyline ends; -1 out of range.
    [[nodiscard]] int GetEndPointAt(int pEndPointIndex) const;

    /// The platform's own view: the entries in memory, without reading the file.
    [[nodiscard]] detail::PlainArray<int>& indices() { return mIndices; }

protected:
    /// Fills the object from the file.
    FBXSDK_LOCAL bool readSource(const detail::GeometrySource& pSource) override;

private:
    detail::PlainArray<int> mIndices;
};

FBXSDK_NAMESPACE_END
