// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The table itself.
#include "Rows.h"

namespace conformance {
namespace {

constexpr Row kRows[] = {
    {"loads", "the file loads, or is refused", checkLoads},
    {"nodes", "names, parents and kinds of all nodes, in order", checkNodes},
    {"nodeSettings", "inherit types and rotation orders", checkNodeSettings},
    {"stacks", "animation stacks: names, times, layers", checkStacks},
    {"geometricTransforms", "geometric transforms of the nodes", checkGeometricTransforms},
    {"worldMatrices", "world matrices of all nodes at all frames", checkWorldMatrices},
    {"curves", "sums of the transform curves at all frames", checkCurves},
    {"cameras", "camera values as stored", checkCameras},
    {"lights", "light values as stored", checkLights},
    {"meshTopology", "counts, polygons, layers and deformers of meshes", checkMeshTopology},
    {"worldPoints", "points of undeformed meshes in the world", checkWorldPoints},
    {"deformedPoints", "points of skinned and cached meshes in the world", checkDeformedPoints},
    {"wavefront", "undeformed meshes against Wavefront files", checkWavefrontPoints},
    {"deformedWavefront", "skinned and cached meshes against Wavefront files", checkDeformedWavefrontPoints},
    {"libraryMeshes", "meshes of the library, points where the mesh has them", checkLibraryMeshes},
    {"libraryLocalSamples", "local transform samples of the library", checkLibraryLocalSamples},
    {"libraryWorldTransforms", "places in the world, as the library hands them out by default",
     checkLibraryWorldTransforms},
    {"libraryBakedMeshes", "meshes in the world, as the library hands them out by default", checkLibraryBakedMeshes},
    {"libraryCameras", "cameras, as the library hands them out by default", checkLibraryCameras},
    {"libraryLights", "lights, as the library hands them out by default", checkLibraryLights},
    {"nurbsSurfaces", "NURBS surfaces: points of Wavefront files and of our meshes lie on them", checkNurbsSurfaces},
};

} // namespace

std::span<const Row> rows() { return kRows; }

} // namespace conformance
