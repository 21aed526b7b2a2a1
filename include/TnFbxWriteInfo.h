// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The options of one write: which file, which format and version, which kinds of objects and which frames.
#pragma once

#include "TnFbxExport.h"
#include "TnFbxFidelity.h"

#include <string>

namespace Tarnell::Fbx {

/// Write options: storage, defaults and copying, nothing else.
class TARNELL_FBX_API TnFbxWriteInfo {
public:
    /// The version of the written file; values above the last one mean the last one.
    enum eCompatibilityVersion : int {
        kFbxVersion2010,
        kFbxVersion2011,
        kFbxVersion2012,
        kFbxVersion2013,
        kFbxVersion2014,
        kFbxVersion2016
    };

    static constexpr float kDefaultFPS = 24.0f;
    static constexpr float kDefaultStartFrame = 1.0f;
    static constexpr float kDefaultEndFrame = 1.0f;

    TnFbxWriteInfo();
    TnFbxWriteInfo(const TnFbxWriteInfo& other) = default;
    ~TnFbxWriteInfo();

    /// Copies every option except the compatibility version: a host that copies options sets the version explicitly.
    TnFbxWriteInfo& operator=(const TnFbxWriteInfo& other);

    /// Both go back to the state of new options; always true.
    bool initWriteInfo();
    bool deleteWriteInfo();

    /// Every setter stores what it is given, without a check, and is always true. Strings stay valid until they are set
    /// again.
    bool setFileName(const std::string& fileName);
    const std::string& getFileName() const; ///< FBX file to write; point caches are named after it.

    bool setAnimationStackName(const std::string& animationStackName);
    const std::string& getAnimationStackName() const; ///< Of a faithful write, where an empty one is "Take 001".

    bool setFileFormat(bool fileFormat);
    bool getFileFormat() const; ///< True: ASCII; false: binary. Default true.

    /// Which kinds of objects are written. Default: all.
    bool setWriteCameras(bool writeCameras);
    bool getWriteCameras() const;
    bool setWriteLights(bool writeLights);
    bool getWriteLights() const;
    bool setWriteTransforms(bool writeTransforms);
    bool getWriteTransforms() const;
    bool setWriteNulls(bool writeNulls);
    bool getWriteNulls() const;
    bool setWriteMeshes(bool writeMeshes);
    bool getWriteMeshes() const;

    bool setAnimateMeshVertices(bool animateMeshVertices);
    bool getAnimateMeshVertices() const; ///< Animated mesh points are written as point caches. Default true.

    bool setMayaVertexCacheFormat(bool mayaVertexCacheFormat);
    bool getMayaVertexCacheFormat() const; ///< True: Maya caches; false: Max ".pc2" caches. Default true.

    bool setFPS(float framesPerSecond);
    float getFPS() const; ///< Frames per second.

    /// First and last frame; their fractions are dropped. Point caches have a sample for each of them, and the span of
    /// the file reaches from the first to the last, and beyond as far as there are keys. Frames 1 to 1, the default,
    /// say nothing about the span. Channels are written over their own ranges in any case.
    bool setStartFrame(float startFrame);
    float getStartFrame() const;
    bool setEndFrame(float endFrame);
    float getEndFrame() const;

    bool setCompatibilityVersion(eCompatibilityVersion compatibilityVersion);
    eCompatibilityVersion getCompatibilityVersion() const; ///< Default `kFbxVersion2016`.

    /// Faithful: what is written comes back; the stack bears its name, and fractions of the first and last frame belong
    /// to the span.
    bool setFidelity(EFbxFidelity fidelity);
    EFbxFidelity getFidelity() const; ///< What the file says of the objects; see docs/faithful.md. Default compatible.

    bool setComputeCameraRotation(bool computeCameraRotation);
    /// A faithful write turns cameras that have a look-at point and no rotation toward the point. Default true.
    bool getComputeCameraRotation() const;

private:
    struct Options {
        std::string fileName;
        std::string animationStackName;
        bool fileFormat = true;
        bool writeCameras = true;
        bool writeLights = true;
        bool writeTransforms = true;
        bool writeNulls = true;
        bool writeMeshes = true;
        bool animateMeshVertices = true;
        bool mayaVertexCacheFormat = true;
        float framesPerSecond = kDefaultFPS;
        float startFrame = kDefaultStartFrame;
        float endFrame = kDefaultEndFrame;
        EFbxFidelity fidelity = kFbxFidelityCompatible;
        bool computeCameraRotation = true;
    };

    Options mOptions;
    eCompatibilityVersion mCompatibilityVersion; // apart from the others: assignment skips it
};

} // namespace Tarnell::Fbx
