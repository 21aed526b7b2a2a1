// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The mesh: six arrays, two counts and three flags.
#include "TnFbxMesh.h"

#include "MeshArrays.h"

#include <cstddef>

namespace Tarnell::Fbx {

namespace {

using detail::SharedArray;

template <typename Element>
int lengthOf(const SharedArray<Element>& array) {
    return static_cast<int>(array.size());
}

/// The element at an index, null when there is none.
template <typename Element>
const Element* elementAt(const SharedArray<Element>& array, int index) {
    return index >= 0 && index < lengthOf(array) ? &array[static_cast<std::size_t>(index)] : nullptr;
}

template <typename Element>
bool setElement(SharedArray<Element>& array, int index, const Element& value) {
    if (index < 0 || index >= lengthOf(array))
        return false;
    array.own()[static_cast<std::size_t>(index)] = value;
    return true;
}

template <typename Vector>
bool getVector(const SharedArray<Vector>& array, int index, float& x, float& y, float& z) {
    const Vector* vector = elementAt(array, index);
    if (vector == nullptr)
        return false;
    x = vector->x;
    y = vector->y;
    z = vector->z;
    return true;
}

} // namespace

TnFbxMesh::TnFbxMesh() { initMesh(); }

TnFbxMesh::~TnFbxMesh() = default;

// kept: nothing of the transform is copied, nor the name
TnFbxMesh& TnFbxMesh::operator=(const TnFbxMesh& other) {
    if (this != &other) {
        deleteMesh();
        mGeometry = other.mGeometry;
    }
    return *this;
}

bool TnFbxMesh::initMesh() {
    Geometry& g = mGeometry;
    g.controlPointCount = g.controlPointSetCount = 0;
    g.polygonVertexSizes.clear();
    g.pointIndices.clear();
    g.controlPoints.clear();
    g.normals.clear();
    g.uvs.clear();
    g.colours.clear();
    g.validNormals = g.validUVs = g.validColours = g.pointsPlaced = false;
    return true;
}

bool TnFbxMesh::deleteMesh() { return initMesh(); }

bool TnFbxMesh::allocateGeometryData(int numberOfPolygons, int numberOfControlPoints, int numberOfPolygonVertices) {
    return detail::MeshArrays(*this).allocate(numberOfPolygons, numberOfControlPoints, numberOfPolygonVertices);
}

bool TnFbxMesh::addControlPoint(float x, float y, float z) {
    mGeometry.controlPoints.own().push_back({x, y, z});
    return true;
}

bool TnFbxMesh::addControlPointSet() {
    ++mGeometry.controlPointSetCount;
    return true;
}

bool TnFbxMesh::setPolygonVertexSize(int polygon, int size) {
    return setElement(mGeometry.polygonVertexSizes, polygon, size);
}

bool TnFbxMesh::setPointIndex(int polygonVertex, int controlPoint) {
    return setElement(mGeometry.pointIndices, polygonVertex, controlPoint);
}

bool TnFbxMesh::setControlPoint(int index, float x, float y, float z) {
    return setElement(mGeometry.controlPoints, index, {x, y, z});
}

bool TnFbxMesh::setNormal(int polygonVertex, float x, float y, float z) {
    return setElement(mGeometry.normals, polygonVertex, {x, y, z});
}

bool TnFbxMesh::setUV(int polygonVertex, float u, float v) { return setElement(mGeometry.uvs, polygonVertex, {u, v}); }

bool TnFbxMesh::setColour(int polygonVertex, float red, float green, float blue, float alpha) {
    return setElement(mGeometry.colours, polygonVertex, {red, green, blue, alpha});
}

// kept: the two integer getters differ, −1 is no size but 0 is a point
int TnFbxMesh::getPolygonVertexSize(int polygon) const {
    const int* size = elementAt(mGeometry.polygonVertexSizes, polygon);
    return size != nullptr ? *size : -1;
}

int TnFbxMesh::getPointIndex(int polygonVertex) const {
    const int* controlPoint = elementAt(mGeometry.pointIndices, polygonVertex);
    return controlPoint != nullptr ? *controlPoint : 0;
}

bool TnFbxMesh::getControlPoint(int index, float& x, float& y, float& z) const {
    return getVector(mGeometry.controlPoints, index, x, y, z);
}

bool TnFbxMesh::getNormal(int polygonVertex, float& x, float& y, float& z) const {
    return getVector(mGeometry.normals, polygonVertex, x, y, z);
}

bool TnFbxMesh::getUV(int polygonVertex, float& u, float& v) const {
    const TextureCoordinate* uv = elementAt(mGeometry.uvs, polygonVertex);
    if (uv == nullptr)
        return false;
    u = uv->u;
    v = uv->v;
    return true;
}

bool TnFbxMesh::getColour(int polygonVertex, float& red, float& green, float& blue, float& alpha) const {
    const Colour* colour = elementAt(mGeometry.colours, polygonVertex);
    if (colour == nullptr)
        return false;
    red = colour->red;
    green = colour->green;
    blue = colour->blue;
    alpha = colour->alpha;
    return true;
}

bool TnFbxMesh::setValidNormals(bool valid) {
    mGeometry.validNormals = valid;
    return true;
}

bool TnFbxMesh::getValidNormals() const { return mGeometry.validNormals; }

bool TnFbxMesh::setValidUVs(bool valid) {
    mGeometry.validUVs = valid;
    return true;
}

bool TnFbxMesh::getValidUVs() const { return mGeometry.validUVs; }

bool TnFbxMesh::setValidColours(bool valid) {
    mGeometry.validColours = valid;
    return true;
}

bool TnFbxMesh::getValidColours() const { return mGeometry.validColours; }

bool TnFbxMesh::setPointsPlaced(bool placed) {
    mGeometry.pointsPlaced = placed;
    return true;
}

bool TnFbxMesh::getPointsPlaced() const { return mGeometry.pointsPlaced; }

int TnFbxMesh::getNumberOfPolygons() const { return lengthOf(mGeometry.polygonVertexSizes); }

int TnFbxMesh::getNumberOfPolygonVertices() const { return lengthOf(mGeometry.pointIndices); }

int TnFbxMesh::getNumberOfControlPoints() const { return mGeometry.controlPointCount; }

int TnFbxMesh::getNumberOfControlPointSets() const { return mGeometry.controlPointSetCount; }

} // namespace Tarnell::Fbx
