// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The data for the checks of the rules, and the checks themselves; each implements one rule and reports its findings.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include <fbxsdk/extensions/RecordFile.h>

#include "CameraFacts.h"
#include "Curves.h"
#include "LintRules.h"
#include "SceneQueries.h"
#include "TakeFacts.h"

namespace tool {

/// A number that keys drive in a take.
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
    std::vector<TreeNode> nodes;
    std::vector<FbxObject*> objects;
    std::vector<FbxMesh*> meshes;
    std::vector<std::vector<KeyedChannel>> channelsByTake; ///< as `takes`

    // Of the current take; of the first one for checks of the file.
    TakeFacts take; ///< a default where the file has none
    const std::vector<KeyedChannel>* channels = nullptr;
    std::shared_ptr<const CameraList> cameras;
    std::string unreadable; ///< why the library cannot read the take faithfully

    [[nodiscard]] FbxScene& scene() const { return file.scene(); }
    [[nodiscard]] double unit() const { return scene().GetGlobalSettings().GetSystemUnit().GetScaleFactor(); }
    /// The first frame of the take.
    [[nodiscard]] FbxTime firstMoment() const;
    /// The node in the file's world, at that frame.
    [[nodiscard]] FbxAMatrix worldOf(FbxNode& node) const;
    /// Opened when first asked for. Throws Unreadable.
    [[nodiscard]] const extensions::RecordFile& records() const;

    mutable std::unique_ptr<extensions::RecordFile> openedRecords;
};

struct LintReport {
    const LintRule* rule = nullptr;
    std::vector<Finding> findings;
    void add(const std::string& object, std::string text) { findings.push_back({rule, object, std::move(text), {}}); }
};

// Time.
LintCheck rateUnstated, keysBetweenFrames, spanDiffersFromKeys, takeWithoutSpan, takeWithoutKeys, severalTakes,
    severalLayers, rotationFlips;
// Cameras.
LintCheck lensOutOfRange, lensValuesDisagree, filmShapeDiffers, filmFormatDisagrees, squeezedFilm, filmOffset,
    clipPlanes, clipPlanesFarApart, cameraScale, rollWithoutTarget, interestElsewhere, imageShiftNotRead, noResolution;
// The file, and placement.
LintCheck notReadable, repaired, oldVersion, asciiEncoding, unitShiftsOptics, axesShiftOptics, leftHanded,
    farFromOrigin, meshAtOrigin, zeroScale, mirroredNode, shearedNode, inheritedScale, valuesNotFinite, keysNotFinite;
// Names and structure.
LintCheck duplicateNames, unnamedNodes, oddNames, unparentedNodes, constraints, curveThatStopsThreeJs;
// Meshes and caches.
LintCheck polygonsOutOfRange, smallPolygons, meshWithoutPolygons, meshWithoutNormals, cacheMissing, cacheForeignPath,
    cacheUnusable, cacheRange, cacheRate;

/// The name of the object for display: a camera or mesh by its node.
std::string nameOf(const FbxObject& object);

/// The records of the file's objects, unchanged: including what the scene cannot hold, or has repaired.
void forEachObjectRecord(const extensions::RecordFile& file,
                         const std::function<void(const extensions::FileRecord&)>& work);
/// An object's name without its class: "Geometry::tri" in an ASCII file, with the two in reverse order in a binary
/// file.
std::string plainName(std::string_view name);

/// "1 key", "3 keys".
template <class Count>
std::string countOf(Count count, const char* one, const char* several) {
    return std::to_string(count) + ' ' + (count == 1 ? one : several);
}

} // namespace tool
