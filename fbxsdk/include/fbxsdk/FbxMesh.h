// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxGeometry.h>

FBXSDK_NAMESPACE_BEGIN

/// Polygons over control points. Polygon p has its corners, indices of control points, at GetPolygonVertexIndex(p) and
/// the following positions of the polygon vertex array. In a mesh read from a file all of them are control points that
/// exist.
class FBXSDK_DLL FbxMesh : public FbxGeometry {
    FBXSDK_OBJECT_DECLARE(FbxMesh, FbxGeometry)

public:
    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override; ///< eMesh.

    /// Starts a polygon. Material, texture and group are stored when layer 0 has such an element mapped by polygon; -1
    /// stores nothing.
    void BeginPolygon(int pMaterial = -1, int pTexture = -1, int pGroup = -1, bool pLegacy = true);
    /// Appends a corner; whether the control point exists is not checked. The texture coordinate's index is stored when
    /// it is not negative and layer 0 has coordinates mapped by polygon vertex with indices. Without a polygon in
    /// progress nothing happens.
    void AddPolygon(int pIndex, int pTextureUVIndex = -1);
    /// Ends the polygon; one with fewer than three corners is kept.
    void EndPolygon();

    /// How many polygons there are.
    [[nodiscard]] int GetPolygonCount() const {
        ensureLoaded();
        return mPolygonStarts.count();
    }
    /// How many corners the polygon has; 0 out of range.
    [[nodiscard]] int GetPolygonSize(int pPolygonIndex) const {
        if (pPolygonIndex < 0 || pPolygonIndex >= GetPolygonCount())
            return 0;
        return polygonEnd(pPolygonIndex) - mPolygonStarts[pPolygonIndex];
    }
    /// How many corners all polygons have together.
    [[nodiscard]] int GetPolygonVertexCount() const {
        ensureLoaded();
        return mPolygonVertices.count();
    }
    /// Where the polygon starts in the polygon vertex array; -1 out of range.
    [[nodiscard]] int GetPolygonVertexIndex(int pPolygonIndex) const {
        return pPolygonIndex >= 0 && pPolygonIndex < GetPolygonCount() ? mPolygonStarts[pPolygonIndex] : -1;
    }
    /// The control points of all corners; writing to them changes the mesh. Null when there are none; valid until the
    /// count changes.
    [[nodiscard]] int* GetPolygonVertices() const {
        return GetPolygonVertexCount() == 0 ? nullptr : mPolygonVertices.data();
    }
    /// A corner's control point; -1 out of range.
    [[nodiscard]] int GetPolygonVertex(int pPolygonIndex, int pPositionInPolygon) const {
        const int corner = cornerOf(pPolygonIndex, pPositionInPolygon);
        return corner < 0 ? -1 : mPolygonVertices[corner];
    }

    /// The normal of layer 0 at a corner, as stored, when it is mapped by polygon vertex or by control point. False
    /// otherwise; the normal is untouched then.
    bool GetPolygonVertexNormal(int pPolyIndex, int pVertexIndex, FbxVector4& pNormal) const;
    /// The index of the corner's texture coordinate in the direct array of layer 0, when it is mapped by polygon
    /// vertex; -1 otherwise.
    [[nodiscard]] int GetTextureUVIndex(int pPolygonIndex, int pPositionInPolygon,
                                        FbxLayerElement::EType pTypeIdentifier = FbxLayerElement::eTextureDiffuse);

    /// Removes the polygon, with the layers' entries for it and its corners. Its former index, or -1 when there is
    /// none.
    int RemovePolygon(int pPolygonIndex);
    /// Whether every polygon has three corners; true without polygons.
    [[nodiscard]] bool IsTriangleMesh() const;
    /// Reserves capacity for that many polygons; the count stays.
    void ReservePolygonCount(int pCount);
    /// Reserves capacity for that many corners; the count stays.
    void ReservePolygonVertexCount(int pCount);

    /// Of the corners in the file, those that referred to missing points: they are moved to point 0 or, in a mesh
    /// without points, dropped. 0 for a mesh that is not from a file.
    [[nodiscard]] int GetRepairedCornerCount() const {
        ensureLoaded();
        return mRepairedCorners;
    }

    /// The platform's own view: the polygons in memory, without reading the file.
    [[nodiscard]] detail::PlainArray<int>& polygonVertices() { return mPolygonVertices; }
    /// Where each polygon begins among the corners.
    [[nodiscard]] detail::PlainArray<int>& polygonStarts() { return mPolygonStarts; }
    /// What elements mapped by edge are indexed by: for each edge the position in the polygon vertex array where it
    /// starts. Empty unless a file had them, and after the first change of polygons. Read from the file on the first
    /// access.
    [[nodiscard]] detail::PlainArray<int>& edges();

protected:
    FBXSDK_LOCAL bool readSource(const detail::GeometrySource& pSource) override;

private:
    [[nodiscard]] int polygonEnd(int pPolygonIndex) const {
        const int next = pPolygonIndex + 1;
        return next < mPolygonStarts.count() ? mPolygonStarts[next] : mPolygonVertices.count();
    }
    FBXSDK_LOCAL void dropEdges();
    /// The corner's position in the polygon vertex array; -1 out of range.
    [[nodiscard]] int cornerOf(int pPolygonIndex, int pPositionInPolygon) const {
        const bool inRange = pPositionInPolygon >= 0 && pPositionInPolygon < GetPolygonSize(pPolygonIndex);
        return inRange ? mPolygonStarts[pPolygonIndex] + pPositionInPolygon : -1;
    }

    detail::PlainArray<int> mPolygonVertices;
    detail::PlainArray<int> mPolygonStarts;
    detail::PlainArray<int> mEdges;
    int mRepairedCorners = 0;
    bool mPolygonOpen = false;
};

FBXSDK_NAMESPACE_END
