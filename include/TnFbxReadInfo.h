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
    static constexpr float kDefaultSampleFPS = 24.0f; ///< Frames per second of new options.
    static constexpr float kDefaultFrame = 0.0f;      ///< The frame of new options.

    /// No file, no animation stack, and the defaults that the getters name.
    TnFbxReadInfo();
    TnFbxReadInfo(const TnFbxReadInfo& other) = default;
    ~TnFbxReadInfo();
    /// Copies every option.
    TnFbxReadInfo& operator=(const TnFbxReadInfo& other);

    /// Restores the state of new options; always true.
    /// @{
    bool initReadInfo();
    bool deleteReadInfo();
    /// @}

    /// Stores its argument without a check; always true. The meaning of an option is described at its getter.
    /// @{
    bool setFileName(const std::string& fileName);
    bool setAnimationStackName(const std::string& animationStackName);
    bool setGlobalTransform(bool globalTransform);
    bool setTransformPoints(bool transformPoints);
    bool setUseSampleFPS(bool useSampleFPS);
    bool setSampleFPS(float sampleFPS);
    bool setFrame(float frame);
    bool setComputeCameraRotation(bool computeCameraRotation);
    bool setAllObjects(bool allObjects);
    bool setObjectName(const std::string& objectName);
    bool setObjectID(int objectID);
    bool setFidelity(EFbxFidelity fidelity);
    /// @}

    const std::string& getFileName() const; ///< FBX file to read. Default empty.

    /// The animation stack to read. Spelt without the n: hosts call it so. With an empty name a
    /// compatible read fails while a faithful one takes the first. A compatible read takes the first whatever the name.
    const std::string& getAimationStackName() const;
    bool haveAnimationStack() const; ///< Whether an animation stack name is set.

    bool getGlobalTransform() const; ///< Transforms are read in the world, not relative to their parents. Default true.

    /// Mesh points are multiplied by their node's transform. Default true. A compatible read returns the points of
    /// skins in the world, where this would transform them twice: switch it off for these.
    bool getTransformPoints() const;

    bool getUseSampleFPS() const; ///< Sampled at `getSampleFPS` instead of the scene's own rate. Default false.
    float getSampleFPS() const;   ///< Frames per second. Default 24.
    float getFrame() const;       ///< The frame at which static values and meshes are taken. Default 0.

    bool getComputeCameraRotation() const; ///< Camera rotations come from the look-at values. Default false.

    bool getAllObjects() const; ///< Every object of the kind, not only the one called `getObjectName`. Default true.
    const std::string& getObjectName() const; ///< Name of the single object to read, compared exactly.
    int getObjectID() const;                  ///< Kept for the host; the library does not read it. Default −1.

    EFbxFidelity getFidelity() const; ///< Which behaviour a read follows; see docs/faithful.md. Default compatible.

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
