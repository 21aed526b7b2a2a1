// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include "Timeline.h"
#include "TnFbxReadInfo.h"
#include "access/FrameTimes.h"
#include "access/ObjectWarnings.h"
#include "access/TimeModeScope.h"
#include "calls/MemoryLimit.h"
#include "model/MeshInstances.h"

#include <fbxsdk.h>

#include <string>
#include <unordered_map>
#include <vector>

namespace Tarnell::Fbx::faithful {

/// One file prepared for one read: loaded, normalised, with the requested animation stack and frames.
class Scene {
public:
    Scene() = default;
    ~Scene();
    Scene(const Scene&) = delete;
    Scene& operator=(const Scene&) = delete;

    /// To be called once. False, with the reason noted, when the file cannot be read or lacks what the options name.
    bool load(const TnFbxReadInfo& info);

    /// Selects another stack and other frames. False, with the reason noted, when the options name none that exist;
    /// the former ones stay.
    bool select(const TnFbxReadInfo& info);

    bool isLoaded() const { return mLoaded; }
    fbxsdk::FbxManager* manager() const { return mManager; }
    fbxsdk::FbxScene& scene() const { return *mScene; }
    const std::string& fileName() const { return mFileName; }
    const Timeline& timeline() const { return mTimeline; }
    /// Calls `use(frame, times)` for all frames, some at a time: the first of these, and the times of all of them.
    /// False as soon as a call returns that.
    template <class Use>
    bool inPortions(Use&& use) {
        mFrameTimes.begin(mTimeline.first(), mTimeline.rate());
        return mFrameTimes.inPortions(mTimeline.count(), use);
    }
    /// Of the file, in centimetres, the unit of the scene.
    double unit() const { return mUnit; }
    /// Frames per second of the file, exactly.
    double fileRate() const { return mFileRate; }
    /// The frame of the static values, and its time.
    float frame() const { return mFrame; }
    fbxsdk::FbxTime now() const { return mNow; }
    /// Sets another one; false, with the reason noted, when it is not a number.
    bool setFrame(float frame);

    /// Whether the property, or anything of the object, is keyed in the stack.
    bool isKeyed(fbxsdk::FbxProperty property) const;
    bool isKeyed(const fbxsdk::FbxObject& object) const;
    /// Whether the node, or one of its ancestors, has keys for its transform in the stack.
    bool moves(fbxsdk::FbxNode& node);

    /// Reserves the memory of that many channels with a sample for every frame. False, with the reason noted.
    bool grantSamples(std::int64_t channels);
    /// The same for other bytes that are returned.
    bool grantBytes(std::uint64_t bytes);
    void giveBackBytes(std::uint64_t bytes) { mMemory.giveBack(bytes); }
    /// Returns memory that was granted.
    void forgetMemory() {
        mMemory.begin();
        mInstances.forget();
    }
    /// The granted meshes that several nodes share.
    detail::MeshInstances& instances() { return mInstances; }
    /// Warnings about nodes, reported by the readers.
    detail::ObjectWarnings& warnings() { return mWarnings; }

private:
    bool selectStack(const std::string& name);
    bool selectFrames(const TnFbxReadInfo& info);
    fbxsdk::FbxTimeSpan animatedSpan();

    detail::TimeModeScope mTimeMode;        // an import leaves the file's
    fbxsdk::FbxManager* mManager = nullptr; // owned
    fbxsdk::FbxScene* mScene = nullptr;     // owned by the manager
    bool mLoaded = false;                   // the scene is that of a file
    std::string mFileName;
    fbxsdk::FbxAnimStack* mStack = nullptr; // null: nothing is animated
    std::vector<fbxsdk::FbxAnimLayer*> mLayers;
    Timeline mTimeline;
    detail::FrameTimes mFrameTimes;
    double mUnit = 1.0;
    double mFileRate = 24.0;
    float mFrame = 0.0f;
    fbxsdk::FbxTime mNow;
    detail::MemoryAccount mMemory;
    detail::MeshInstances mInstances;
    detail::ObjectWarnings mWarnings;
    std::unordered_map<const fbxsdk::FbxNode*, bool> mMoves;
};

} // namespace Tarnell::Fbx::faithful
