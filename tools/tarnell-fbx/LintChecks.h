// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The data for the checks of the rules, and the checks themselves; each implements one rule and reports its findings.
#pragma once

#include <functional>
#include <string>
#include <vector>

#include <fbxsdk/extensions/RecordFile.h>

#include "CameraFacts.h"
#include "Curves.h"
#include "LintRules.h"
#include "SceneQueries.h"
#include "TakeFacts.h"

namespace tool {

/// A number that keys drive in the first take.
struct KeyedChannel {
    const FbxObject* object;
    Channel channel;
    [[nodiscard]] std::string fullName() const { return channel.fullName(); }
};

struct LintContext {
    const std::string& fileName;
    const SceneFile& file;
    std::vector<FbxAnimStack*> stacks;
    std::vector<TakeFacts> takes; ///< of the stacks
    TakeFacts first;              ///< the first take, or a default without one
    std::vector<TreeNode> nodes;
    std::vector<FbxObject*> objects;
    std::vector<FbxMesh*> meshes;
    std::vector<KeyedChannel> channels;
    CameraList cameras;
    std::string unreadable; ///< why the library cannot read the file faithfully

    [[nodiscard]] FbxScene& scene() const { return file.scene(); }
    [[nodiscard]] double unit() const { return scene().GetGlobalSettings().GetSystemUnit().GetScaleFactor(); }
    /// The node in the file's world, at the first frame of the take.
    [[nodiscard]] FbxAMatrix worldOf(FbxNode& node) const;
};

struct LintReport {
    const LintRule* rule = nullptr;
    std::vector<Finding> findings;
    void add(const std::string& object, std::string text) { findings.push_back({rule, object, std::move(text)}); }
};

using LintCheck = void(const LintContext& context, LintReport& report);

// Time.
LintCheck rateUnstated, keysBetweenFrames, spanDiffersFromKeys, takeWithoutSpan, takeWithoutKeys, severalTakes,
    severalLayers, rotationFlips;
// Cameras.
LintCheck lensOutOfRange, lensValuesDisagree, filmShapeDiffers, filmFormatDisagrees, squeezedFilm, filmOffset,
    clipPlanes, clipPlanesFarApart, cameraScale, rollWithoutTarget, interestElsewhere, imageShiftNotRead, noResolution;
// The file, and placement.
LintCheck notReadable, repaired, oldVersion, asciiEncoding, unitShiftsOptics, axesShiftOptics, leftHanded,
    farFromOrigin, meshAtOrigin, zeroScale, mirroredNode, shearedNode, inheritedScale, notFinite;
// Names and structure.
LintCheck duplicateNames, unnamedNodes, oddNames, constraints, curveThatStopsThreeJs;
// Meshes and caches.
LintCheck polygonsOutOfRange, smallPolygons, meshWithoutPolygons, meshWithoutNormals, cacheMissing, cacheForeignPath,
    cacheUnusable, cacheRange, cacheRate;

/// The name of the object for display: a camera or mesh by its node.
std::string nameOf(const FbxObject& object);

/// The records of the file's objects, unchanged: including what the scene cannot hold, or has repaired.
void forEachObjectRecord(const std::string& file, const std::function<void(const extensions::FileRecord&)>& work);

/// "1 key", "3 keys".
template <class Count>
std::string countOf(Count count, const char* one, const char* several) {
    return std::to_string(count) + ' ' + (count == 1 ? one : several);
}

} // namespace tool
