// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How the classes of geometry read themselves from their file: their own records, and the layers.
#include <fbxsdk/FbxLine.h>
#include <fbxsdk/FbxNurbs.h>
#include <fbxsdk/FbxPatch.h>
#include <fbxsdk/FbxSubDiv.h>
#include <fbxsdk/FbxTrimNurbsSurface.h>

#include "geometry/GeometryReading.h"
#include "geometry/NurbsReading.h"

FBXSDK_NAMESPACE_BEGIN
namespace {

template <class Class>
bool read(Class& geometry, void (*readRecords)(Class& geometry, const detail::Record& body),
          const detail::GeometrySource& source) {
    readRecords(geometry, *source.body);
    detail::readLayers(geometry, source);
    return true;
}

} // namespace

bool FbxNurbs::readSource(const detail::GeometrySource& pSource) { return read(*this, detail::readNurbs, pSource); }
bool FbxNurbsSurface::readSource(const detail::GeometrySource& pSource) {
    return read(*this, detail::readNurbsSurface, pSource);
}
bool FbxNurbsCurve::readSource(const detail::GeometrySource& pSource) {
    return read(*this, detail::readNurbsCurve, pSource);
}
bool FbxTrimNurbsSurface::readSource(const detail::GeometrySource& pSource) {
    return read(*this, detail::readTrimNurbsSurface, pSource);
}
bool FbxBoundary::readSource(const detail::GeometrySource& pSource) {
    return read(*this, detail::readBoundary, pSource);
}
bool FbxPatch::readSource(const detail::GeometrySource& pSource) { return read(*this, detail::readPatch, pSource); }
bool FbxLine::readSource(const detail::GeometrySource& pSource) { return read(*this, detail::readLine, pSource); }

/// Files hold no subdivision surfaces with content of their own.
bool FbxSubDiv::readSource(const detail::GeometrySource& pSource) {
    detail::readLayers(*this, pSource);
    return true;
}

/// Offsets need the points that they are offsets from.
bool FbxShape::readSource(const detail::GeometrySource& pSource) {
    FbxGeometry* base = GetBaseGeometry();
    if (!base)
        return false;
    detail::readShape(*this, *base, *pSource.body);
    return true;
}

FBXSDK_NAMESPACE_END
