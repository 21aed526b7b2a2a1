// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The rows of the second table: what a host reads through the facade when it requests what the application shows.
#pragma once

#include "Rows.h"
#include "WavefrontFile.h"

#include <functional>

namespace conformance {

std::span<const Row> faithfulRows();
/// Whether the row applies to converted files, too, in which every node is below the root and has a key per frame.
bool survivesConversion(const Row& row);
/// Whether the file has meshes that skins, blend shapes or caches deform.
bool deforms(const CorpusFile& file);
/// Clips that last for days.
bool isLongClip(const Reference& reference);

void checkFaithfulLoads(LoadedFile& file, Findings& findings);
void checkFaithfulTransforms(LoadedFile& file, Findings& findings);
void checkFaithfulLocals(LoadedFile& file, Findings& findings);
void checkFaithfulSamples(LoadedFile& file, Findings& findings);
void checkFaithfulCurves(LoadedFile& file, Findings& findings);
void checkFaithfulCameras(LoadedFile& file, Findings& findings);
void checkFaithfulLenses(LoadedFile& file, Findings& findings);
void checkFaithfulLights(LoadedFile& file, Findings& findings);
void checkFaithfulPoints(LoadedFile& file, Findings& findings);
void checkFaithfulNormals(LoadedFile& file, Findings& findings);
void checkFaithfulWavefront(LoadedFile& file, Findings& findings);

/// The points of the node that the reference has at an index, at a frame of the file or, without one, as it was saved.
using PointSource = std::function<std::vector<Point>(std::size_t nodeIndex)>;
/// All meshes of the file against one of its Wavefront files.
void compareWithWavefront(LoadedFile& file, const WavefrontSibling& sibling, const PointSource& pointsOf,
                          Findings& findings);
/// The time in the file at which a Wavefront file was saved.
double secondsOf(const WavefrontSibling& sibling, const Reference& reference);

} // namespace conformance
