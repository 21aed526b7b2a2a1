// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <memory>
#include <optional>
#include <set>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "CameraFacts.h"
#include "FaithfulRead.h"
#include "ReportMesh.h"
#include "SceneFile.h"
#include "SceneQueries.h"

#include "TnFbxCamera.h"
#include "TnFbxLight.h"
#include "TnFbxMesh.h"
#include "TnFbxNull.h"

namespace tool {

/// The frames of a report's values: first, first + step, … in whole frames of the file's rate.
struct ReportFrames {
    double rate = 24.0;
    int first = 0;
    int step = 1;
    int count = 1;
    [[nodiscard]] int at(int index) const { return first + index * step; }
};

/// One node and its attribute, if that is drawn.
struct ReportNode {
    TreeNode tree;
    Tarnell::Fbx::TnFbxTransform* transform = nullptr; ///< of cameras and lights, their own: they look along -Z
    Tarnell::Fbx::TnFbxCamera* camera = nullptr;
    Tarnell::Fbx::TnFbxLight* light = nullptr;
    Tarnell::Fbx::TnFbxNull* null = nullptr;
    int mesh = -1; ///< index of the mesh
};

/// A mesh in the space of its node. Static points have one set; others one for each of the shape frames.
struct ReportShape {
    ReportMesh mesh;
    std::vector<std::vector<Point>> sets;
};

struct ReportWishes {
    std::string take;                          ///< empty: the first one
    std::optional<std::pair<int, int>> frames; ///< only these
};

/// The data of a report about one file: faithful values of all its nodes, frame by frame, limited to what a page can
/// hold.
class ReportScene {
public:
    /// Throws Unreadable.
    ReportScene(const std::string& file, const ReportWishes& wishes);

    [[nodiscard]] const SceneFile& opened() const { return mOpened; }
    [[nodiscard]] const std::string& take() const { return mTake; }
    /// The facts of a camera; null where they could not be read.
    [[nodiscard]] const CameraFacts* factsOf(const FbxNode& node) const;
    [[nodiscard]] const ReportFrames& frames() const { return mFrames; }
    /// The number of frames of the file's rate between two samples.
    [[nodiscard]] int sampleStep() const { return mSampleStep; }
    [[nodiscard]] const std::vector<ReportNode>& nodes() const { return mNodes; }
    [[nodiscard]] const std::vector<ReportShape>& shapes() const { return mShapes; }
    /// The indices of the frames at which deforming points were read.
    [[nodiscard]] const std::vector<int>& shapeFrames() const { return mShapeFrames; }
    /// The library's warnings while reading.
    [[nodiscard]] const std::vector<std::string>& warnings() const { return mWarnings; }
    /// What the report leaves out, one sentence each.
    [[nodiscard]] const std::vector<std::string>& notes() const { return mNotes; }

private:
    template <class Object>
    struct Objects {
        std::shared_ptr<Object[]> array;
        std::size_t count = 0, next = 0;
    };
    template <class Object>
    using Reader = bool (Tarnell::Fbx::Fbx::*)(Tarnell::Fbx::TnFbxReadInfo&, Object**, int&) const;

    void chooseFrames(const ReportWishes& wishes);
    void boundFrames(const ReportWishes& wishes);
    template <class Object>
    Objects<Object> read(Reader<Object> reader);
    /// Options that sample every n-th frame, and read static values and meshes at a frame.
    void readEvery(int step, int frame);
    /// Options that read at one time and, where that is exact, sample almost nothing.
    void readOneMoment(int frame);
    template <class Object>
    Object* next(Objects<Object>& objects, const FbxNode& node);
    void linkNodes();
    void readShapes();
    void readMovingPoints(const std::vector<int>& wanted);
    void thinShapes(const Objects<Tarnell::Fbx::TnFbxMesh>& meshes);
    void gatherCameras(const std::string& take);
    void note(const std::string& sentence) { mNotes.push_back(sentence); }

    std::string mFile;
    SceneFile mOpened;
    std::string mTake;
    std::unordered_map<const FbxNode*, CameraFacts> mCameraFacts;
    Tarnell::Fbx::TnFbxReadInfo mInfo;
    int mSampleStep = 1;
    ReportFrames mFrames;
    std::vector<ReportNode> mNodes;
    Objects<Tarnell::Fbx::TnFbxTransform> mTransforms;
    Objects<Tarnell::Fbx::TnFbxCamera> mCameras;
    Objects<Tarnell::Fbx::TnFbxLight> mLights;
    Objects<Tarnell::Fbx::TnFbxNull> mNulls;
    std::vector<ReportShape> mShapes;
    std::vector<int> mShapeFrames;
    std::vector<std::string> mWarnings, mNotes;
    std::set<std::string> mKnownWarnings; ///< each kind of object repeats those of the file
};

} // namespace tool
