// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Surfaces, curves and lines: the inverse of NurbsReading, PatchReading and LineReading.
#include "geometry/GeometryWriting.h"

#include <span>
#include <string_view>
#include <vector>

#include <fbxsdk/FbxLine.h>
#include <fbxsdk/FbxNurbs.h>
#include <fbxsdk/FbxPatch.h>
#include <fbxsdk/FbxTrimNurbsSurface.h>

#include "document/RecordWriting.h"
#include "geometry/NurbsNumbers.h"
#include "schema/Spellings.h"
#include "schema/SubClasses.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr int kVersion = 100;
constexpr int kGeometryVersion = 124;

void writePoints(RecordSink& sink, const FbxGeometryBase& geometry, int components) {
    const int count = geometry.GetControlPointsCount();
    const FbxVector4* const points = geometry.GetControlPoints();
    std::vector<double> numbers;
    for (int i = 0; i < count; ++i)
        for (int component = 0; component < components; ++component)
            numbers.push_back(points[i][component]);
    writeArray<double>(sink, "Points", numbers);
}

template <class Number>
std::span<const Number> spanOf(const Number* numbers, int count) {
    return {numbers, numbers ? static_cast<std::size_t>(count) : 0};
}

std::string_view formName(FbxNurbsSurfaceBase::EType type) {
    return spellingOf(kSurfaceForms, type, FbxNurbsSurfaceBase::eOpen);
}

/// The names of the records of the two classes of surfaces.
struct SurfaceNames {
    std::string_view type, version, order;
};

void writeSurface(const FbxNurbsSurfaceBase& surface, const SurfaceNames& names, RecordSink& sink) {
    writeText(sink, "Type", names.type);
    writeInteger(sink, names.version, kVersion);
    writeIntegers(sink, "SurfaceDisplay", {4, 4, 4});
    writeIntegers(sink, names.order, {surface.GetUOrder(), surface.GetVOrder()});
    writeIntegers(sink, "Dimensions", {surface.GetUCount(), surface.GetVCount()});
    writeIntegers(sink, "Step", {surface.GetUStep(), surface.GetVStep()});
    writeTexts(sink, "Form", {formName(surface.GetNurbsUType()), formName(surface.GetNurbsVType())});
    writePoints(sink, surface, 4);
    writeArray(sink, "KnotVectorU", spanOf<double>(surface.GetUKnotVector(), surface.GetUKnotCount()));
    writeArray(sink, "KnotVectorV", spanOf<double>(surface.GetVKnotVector(), surface.GetVKnotCount()));
    writeInteger(sink, "GeometryVersion", kGeometryVersion);
}

void writeCurve(const FbxNurbsCurve& curve, RecordSink& sink) {
    writeInteger(sink, "GeometryVersion", kGeometryVersion);
    writeText(sink, "Type", SubClass::kNurbsCurve);
    writeInteger(sink, "NurbsCurveVersion", kVersion);
    writeInteger(sink, "Order", curve.GetOrder());
    writeInteger(sink, "Dimension", curve.GetDimension());
    // kept: the applications' files have no such record; it is written for hosts that set another step.
    if (curve.GetStep() != kUsualStep)
        writeInteger(sink, "Step", curve.GetStep());
    writeText(sink, "Form", spellingOf(kCurveForms, curve.GetType(), FbxNurbsCurve::eOpen));
    writeInteger(sink, "Rational", curve.IsRational() ? 1 : 0);
    writePoints(sink, curve, 4);
    writeArray(sink, "KnotVector", spanOf<double>(curve.GetKnotVector(), curve.GetKnotCount()));
}

std::string_view patchTypeName(FbxPatch::EType type) { return spellingOf(kPatchTypes, type, FbxPatch::eBezier); }

void writePatch(const FbxPatch& patch, RecordSink& sink) {
    writeText(sink, "Type", SubClass::kPatch);
    writeInteger(sink, "PatchVersion", kVersion);
    writeTexts(sink, "PatchType", {patchTypeName(patch.GetPatchUType()), patchTypeName(patch.GetPatchVType())});
    writeIntegers(sink, "Dimensions", {patch.GetUCount(), patch.GetVCount()});
    writeIntegers(sink, "Step", {patch.GetUStep(), patch.GetVStep()});
    writeIntegers(sink, "Closed", {patch.GetUClosed() ? 1 : 0, patch.GetVClosed() ? 1 : 0});
    writeIntegers(sink, "UCapped", {patch.GetUCappedBottom() ? 1 : 0, patch.GetUCappedTop() ? 1 : 0});
    writeIntegers(sink, "VCapped", {patch.GetVCappedBottom() ? 1 : 0, patch.GetVCappedTop() ? 1 : 0});
    writePoints(sink, patch, 4);
    writeInteger(sink, "GeometryVersion", kGeometryVersion);
}

void writeLine(FbxLine& line, RecordSink& sink) {
    writeInteger(sink, "GeometryVersion", kGeometryVersion);
    writeText(sink, "Type", SubClass::kLine);
    writeInteger(sink, "LineVersion", kVersion);
    writePoints(sink, line, 3);
    // The end of a polyline is marked in the stored index, which GetPointIndexAt would decode.
    writeArray(sink, "PointsIndex", spanOf<std::int32_t>(line.indices().data(), line.GetIndexArraySize()));
}

void writeTrimNurbsSurface(const FbxTrimNurbsSurface& surface, RecordSink& sink) {
    writeInteger(sink, "TrimmedNurbVersion", kVersion);
    writeText(sink, "Type", SubClass::kTrimNurbsSurface);
    writeInteger(sink, "FlipNormals", surface.GetFlipNormals() ? 1 : 0);
}

void writeBoundary(RecordSink& sink) {
    writeText(sink, "Type", SubClass::kBoundary);
    writeInteger(sink, "BoundaryVersion", kVersion);
}

} // namespace

void writeNurbsRecords(FbxGeometryBase& geometry, RecordSink& sink) {
    if (const auto* nurbs = FbxCast<FbxNurbs>(&geometry))
        writeSurface(*nurbs, {SubClass::kNurb, "NurbVersion", "NurbOrder"}, sink);
    else if (const auto* surface = FbxCast<FbxNurbsSurface>(&geometry))
        writeSurface(*surface, {SubClass::kNurbsSurface, "NurbsSurfaceVersion", "NurbsSurfaceOrder"}, sink);
    else if (const auto* curve = FbxCast<FbxNurbsCurve>(&geometry))
        writeCurve(*curve, sink);
    else if (const auto* patch = FbxCast<FbxPatch>(&geometry))
        writePatch(*patch, sink);
    else if (auto* line = FbxCast<FbxLine>(&geometry))
        writeLine(*line, sink);
    else if (const auto* trimmed = FbxCast<FbxTrimNurbsSurface>(&geometry))
        writeTrimNurbsSurface(*trimmed, sink);
    else if (geometry.Is<FbxBoundary>())
        writeBoundary(sink);
}

void writeRecordsBehindLayers(const FbxGeometryBase& geometry, RecordSink& sink) {
    if (geometry.Is<FbxNurbs>() || geometry.Is<FbxNurbsSurface>())
        writeInteger(sink, "FlipNormals", static_cast<const FbxNurbsSurfaceBase&>(geometry).GetFlipNormals() ? 1 : 0);
}

} // namespace detail
FBXSDK_NAMESPACE_END
