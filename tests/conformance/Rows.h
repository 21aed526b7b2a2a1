// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The rows of the conformance table: what is compared, and the function that compares it for one file.
#pragma once

#include "Findings.h"
#include "LoadedFile.h"

#include <span>

namespace conformance {

struct Row {
    const char* name; ///< the key in expected.json
    const char* meaning;
    void (*check)(LoadedFile& file, Findings& findings);
};

std::span<const Row> rows();

// Whether the file loads at all.
void checkLoads(LoadedFile& file, Findings& findings);

// The tree and its animation.
void checkNodes(LoadedFile& file, Findings& findings);
void checkNodeSettings(LoadedFile& file, Findings& findings);
void checkStacks(LoadedFile& file, Findings& findings);
void checkGeometricTransforms(LoadedFile& file, Findings& findings);
void checkWorldMatrices(LoadedFile& file, Findings& findings);
void checkCurves(LoadedFile& file, Findings& findings);

// Attributes.
void checkCameras(LoadedFile& file, Findings& findings);
void checkLights(LoadedFile& file, Findings& findings);

// Meshes.
void checkMeshTopology(LoadedFile& file, Findings& findings);
void checkWorldPoints(LoadedFile& file, Findings& findings);
void checkDeformedPoints(LoadedFile& file, Findings& findings);
void checkWavefrontPoints(LoadedFile& file, Findings& findings);
void checkDeformedWavefrontPoints(LoadedFile& file, Findings& findings);
// What the library returns in the scene's spaces.
void checkLibraryMeshes(LoadedFile& file, Findings& findings);
void checkLibraryLocalSamples(LoadedFile& file, Findings& findings);
// What it returns by default.
void checkLibraryWorldTransforms(LoadedFile& file, Findings& findings);
void checkLibraryBakedMeshes(LoadedFile& file, Findings& findings);
void checkLibraryCameras(LoadedFile& file, Findings& findings);
void checkLibraryLights(LoadedFile& file, Findings& findings);

// Replaces the surfaces by meshes, so this row comes last.
void checkNurbsSurfaces(LoadedFile& file, Findings& findings);

} // namespace conformance
