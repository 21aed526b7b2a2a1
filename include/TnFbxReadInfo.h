// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The options of one read: which file, which animation, which objects and how to sample them.
#pragma once

#include "TnFbxExport.h"
#include "TnFbxFidelity.h"

#include <string>

namespace Tarnell::Fbx {

/// Read options: storage, defaults and copying, nothing else.
class TARNELL_FBX_API TnFbxReadInfo {
public:
    static constexpr float kDefaultSampleFPS = 24.0f;
    static constexpr float kDefaultFrame = 0.0f;

    TnFbxReadInfo();
    TnFbxReadInfo(const TnFbxReadInfo& other) = default;
    ~TnFbxReadInfo();
    TnFbxReadInfo& operator=(const TnFbxReadInfo& other);

    /// Both go back to the state of new options; always true.
    bool initReadInfo();
    bool deleteReadInfo();

    /// Every setter stores what it is given, without a check, and is always true. Strings stay valid until they are set
    /// again.
    bool setFileName(const std::string& fileName);
    const std::string& getFileName() const; ///< FBX file to read.

    bool setAnimationStackName(const std::string& animationStackName);
    const std::string& getAimationStackName() const; ///< Spelt without the n; empty: no animation stack chosen.
    bool haveAnimationStack() const;                 ///< Whether an animation stack name is set.

    bool setGlobalTransform(bool globalTransform);
    bool getGlobalTransform() const; ///< Transforms are read in the world, not relative to their parents. Default true.

    bool setTransformPoints(bool transformPoints);
    /// Mesh points are multiplied by their node's transform. Default true. Points of a skin are in the world without
    /// it, and would be moved twice: switch it off to get them where the application shows them.
    bool getTransformPoints() const;

    bool setUseSampleFPS(bool useSampleFPS);
    bool getUseSampleFPS() const; ///< Sampled at `getSampleFPS` instead of the scene's own rate. Default false.

    bool setSampleFPS(float sampleFPS);
    float getSampleFPS() const; ///< Frames per second.

    bool setFrame(float frame);
    float getFrame() const; ///< The frame at which static values are taken.

    bool setComputeCameraRotation(bool computeCameraRotation);
    bool getComputeCameraRotation() const; ///< Camera rotations come from the look-at values. Default false.

    bool setAllObjects(bool allObjects);
    bool getAllObjects() const; ///< Every object of the kind, not only the one called `getObjectName`. Default true.

    bool setObjectName(const std::string& objectName);
    const std::string& getObjectName() const; ///< Name of the single object to read.

    bool setObjectID(int objectID);
    int getObjectID() const; ///< Kept for the host; the library does not read it. Default −1.

    /// Faithful: the stack of the name, an empty one meaning the first; every channel complete or a failure.
    bool setFidelity(EFbxFidelity fidelity);
    EFbxFidelity getFidelity() const; ///< What the values stand for; see docs/faithful.md. Default compatible.

private:
    struct Options {
        std::string fileName;
        std::string animationStackName;
        bool globalTransform = true;
        bool transformPoints = true;
        bool useSampleFPS = false;
        float sampleFPS = kDefaultSampleFPS;
        float frame = kDefaultFrame;
        bool computeCameraRotation = false;
        bool allObjects = true;
        std::string objectName;
        int objectID = -1;
        EFbxFidelity fidelity = kFbxFidelityCompatible;
    };

    Options mOptions;
};

} // namespace Tarnell::Fbx
