// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A polygon mesh as plain arrays, with one set of control points per frame where the points are animated.
#pragma once

#include "TnFbxExport.h"
#include "TnFbxSharedArray.h"
#include "TnFbxTransform.h"

namespace Tarnell::Fbx {

namespace detail {
class MeshArrays;
class MeshInstances;
} // namespace detail

/// A polygon mesh.
///
/// Polygons are runs of polygon vertices, one after the other; each polygon vertex refers to a control point and has a
/// normal, a texture coordinate and a colour of its own. Point j of set k is control point k × number of control
/// points + j. Points are in centimetres where the mesh was read from a file.
///
/// Copies and assigned meshes share their arrays, and so do instances of one mesh that a read returns, as far as they
/// are equal. The first change of a shared array copies it, which takes memory; the other meshes keep the original
/// elements. Meshes that share arrays may be used by different threads like any others.
class TARNELL_FBX_API TnFbxMesh : public TnFbxTransform {
public:
    /// A component of a new control point (P), normal (N), texture coordinate (U, V) or colour.
    /// @{
    static constexpr float kDefaultMeshPX = 0.0f;
    static constexpr float kDefaultMeshPY = 0.0f;
    static constexpr float kDefaultMeshPZ = 0.0f;
    static constexpr float kDefaultMeshNX = 0.0f;
    static constexpr float kDefaultMeshNY = 0.0f;
    static constexpr float kDefaultMeshNZ = 0.0f;
    static constexpr float kDefaultMeshU = 0.0f;
    static constexpr float kDefaultMeshV = 0.0f;
    static constexpr float kDefaultMeshRed = 1.0f;
    static constexpr float kDefaultMeshGreen = 1.0f;
    static constexpr float kDefaultMeshBlue = 1.0f;
    static constexpr float kDefaultMeshAlpha = 1.0f;
    /// @}

    /// A default transform and no geometry.
    TnFbxMesh();
    TnFbxMesh(const TnFbxMesh& other) = default;
    ~TnFbxMesh() override;

    /// Copies the geometry; the target keeps its own transform and name.
    TnFbxMesh& operator=(const TnFbxMesh& other);

    /// Removes the geometry; its memory is kept and the transform stays as it is. Always true.
    /// @{
    bool initMesh();
    bool deleteMesh();
    /// @}

    /// Sizes all arrays for one set of control points: polygon sizes, point indices, points, normals and texture
    /// coordinates of 0, colours of opaque white. The flags stay false until they are set.
    /// False when a number is below 1; the mesh is empty then, also if it was not before.
    bool allocateGeometryData(int numberOfPolygons, int numberOfControlPoints, int numberOfPolygonVertices);

    /// Appends one control point and changes neither count; always true.
    bool addControlPoint(float x, float y, float z);

    /// Declares one more set, whose points the caller appends with `addControlPoint`; always true.
    bool addControlPointSet();

    /// Sets one element of an array; control points are counted through all sets. False when there is no such element;
    /// nothing changes then. Values are not checked: a point index may refer to a point that does not exist.
    /// @{
    bool setPolygonVertexSize(int polygon, int size);
    bool setPointIndex(int polygonVertex, int controlPoint);
    bool setControlPoint(int index, float x, float y, float z);
    bool setNormal(int polygonVertex, float x, float y, float z);
    bool setUV(int polygonVertex, float u, float v);
    bool setColour(int polygonVertex, float red, float green, float blue, float alpha);
    /// @}

    int getPolygonVertexSize(int polygon) const; ///< −1 when there is no such polygon: no polygon has that size.
    int getPointIndex(int polygonVertex) const;  ///< 0, a valid point, when there is no such polygon vertex.

    /// Gets one element of an array; control points are counted through all sets. False when there is no such element;
    /// the outputs are untouched then.
    /// @{
    bool getControlPoint(int index, float& x, float& y, float& z) const;
    bool getNormal(int polygonVertex, float& x, float& y, float& z) const;
    bool getUV(int polygonVertex, float& u, float& v) const;
    bool getColour(int polygonVertex, float& red, float& green, float& blue, float& alpha) const;
    /// @}

    /// Sets whether the array carries data; always true.
    /// @{
    bool setValidNormals(bool valid);
    bool setValidUVs(bool valid);
    bool setValidColours(bool valid);
    /// @}
    /// Whether the array carries data: false in a new mesh and where the file had none, whatever the size of the array.
    /// @{
    bool getValidNormals() const;
    bool getValidUVs() const;
    bool getValidColours() const;
    /// @}

    /// Sets whether the points are already multiplied by the mesh's transform; always true.
    bool setPointsPlaced(bool placed);
    /// True after a faithful read with `setTransformPoints(true)`: a faithful write removes the transform from the
    /// points again. Default false.
    bool getPointsPlaced() const;

    int getNumberOfPolygons() const;        ///< The length of the polygon sizes.
    int getNumberOfPolygonVertices() const; ///< The length of the point indices.
    int getNumberOfControlPoints() const;   ///< Of one set.
    int
    getNumberOfControlPointSets() const; ///< One per frame where the points are animated, else 1; 0 without geometry.

private:
    friend class detail::MeshArrays;
    friend class detail::MeshInstances;

    struct Vector {
        float x, y, z;
    };
    struct TextureCoordinate {
        float u, v;
    };
    struct Colour {
        float red, green, blue, alpha;
    };
    struct Geometry {
        detail::SharedArray<int> polygonVertexSizes;
        detail::SharedArray<int> pointIndices;
        detail::SharedArray<Vector> controlPoints;
        detail::SharedArray<Vector> normals;
        detail::SharedArray<TextureCoordinate> uvs;
        detail::SharedArray<Colour> colours;
        int controlPointCount = 0; // of one set
        int controlPointSetCount = 0;
        bool validNormals = false;
        bool validUVs = false;
        bool validColours = false;
        bool pointsPlaced = false;
    };

    Geometry mGeometry;
};

} // namespace Tarnell::Fbx
