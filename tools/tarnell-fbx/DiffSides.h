// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The data of two files for the comparisons, and the comparisons themselves.
#pragma once

#include <functional>
#include <string>
#include <unordered_map>
#include <vector>

#include "CameraFacts.h"
#include "DiffFacts.h"
#include "FaithfulRead.h"
#include "MaterialMatching.h"
#include "NodeMatching.h"
#include "TnFbxLight.h"
#include "TnFbxMesh.h"
#include "TnFbxTransform.h"

namespace tool {

/// One of the two files.
struct DiffSide {
    DiffSide(const DiffFile& file, const std::string& takeName);

    const DiffFile& file;
    std::string takeName;
    FbxAnimStack* stack;
    TakeFacts take;
    double unit; ///< centimetres
    CameraList cameras;
    FaithfulObjects<Tarnell::Fbx::TnFbxTransform> transforms;
    FaithfulObjects<Tarnell::Fbx::TnFbxLight> lights;
    std::unordered_map<const FbxNode*, const Tarnell::Fbx::TnFbxTransform*> transformOf;
    std::unordered_map<const FbxNode*, Tarnell::Fbx::TnFbxLight*> lightOf;
    std::unordered_map<const FbxNode*, const CameraFacts*> cameraOf;
};

/// A time that both files have, as a frame of each.
struct DiffMoment {
    double a, b;
};

/// The frames that both takes have, or the first one of each where they have none in common. None is stored: a take may
/// claim any number of them, and where nothing changes only the first one is used.
class DiffMoments {
public:
    DiffMoments(const TakeFacts& a, const TakeFacts& b);

    [[nodiscard]] std::size_t size() const { return mCount; }
    [[nodiscard]] DiffMoment operator[](std::size_t index) const {
        const double frames = static_cast<double>(index);
        return {mFirst.a + frames, mFirst.b + frames * mStep};
    }

private:
    DiffMoment mFirst;
    double mStep = 1.0; ///< frames of the second file for one of the first
    std::size_t mCount = 1;
};

/// Both files, and the differences found so far.
class Comparison {
public:
    Comparison(const DiffFile& a, const DiffFile& b, const DiffSettings& settings);

    const DiffSide a, b;
    const DiffSettings& settings;
    std::vector<NodePair> pairs;
    std::vector<MaterialPair> materials;
    DiffMoments moments;
    std::vector<Difference> found;

    /// Whether two numbers count as different.
    [[nodiscard]] bool differ(double one, double other) const;
    void add(DiffKind kind, const std::string& object, std::string what, std::string saysA, std::string saysB) {
        found.push_back({kind, object, std::move(what), std::move(saysA), std::move(saysB), {}, {}, {}, 0});
    }
    /// Adds a number at the time where it differs most, if it does. Where neither changes one time is enough.
    void addWorst(Difference difference, bool changes, const std::function<std::pair<double, double>(DiffMoment)>& at);
};

void compareFiles(Comparison& comparison);      // rate, unit, axes, takes
void compareTrees(Comparison& comparison);      // nodes
void compareTransforms(Comparison& comparison); // transforms of nodes
void compareCameras(Comparison& comparison);
void compareLights(Comparison& comparison);
void compareCurves(Comparison& comparison);
void compareMeshes(Comparison& comparison);
void compareMaterials(Comparison& comparison); // and textures

} // namespace tool
