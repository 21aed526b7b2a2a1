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
        kFbxVersion2010, ///< File version 6.1.
        kFbxVersion2011, ///< File version 7.1.
        kFbxVersion2012, ///< File version 7.2.
        kFbxVersion2013, ///< File version 7.3.
        kFbxVersion2014, ///< File version 7.4.
        kFbxVersion2016  ///< File version 7.5. The default.
    };

    static constexpr float kDefaultFPS = 24.0f;       ///< Frames per second of new options.
    static constexpr float kDefaultStartFrame = 1.0f; ///< The first frame of new options.
    static constexpr float kDefaultEndFrame = 1.0f;   ///< The last frame of new options.

    /// No file, no animation stack, and the defaults that the getters name.
    TnFbxWriteInfo();
    TnFbxWriteInfo(const TnFbxWriteInfo& other) = default;
    ~TnFbxWriteInfo();

    /// Copies every option except the compatibility version: a host that copies options sets the version explicitly.
    TnFbxWriteInfo& operator=(const TnFbxWriteInfo& other);

    /// Restores the state of new options; always true.
    /// @{
    bool initWriteInfo();
    bool deleteWriteInfo();
    /// @}

    /// Stores its argument without a check; always true. The meaning of an option is described at its getter.
    /// @{
    bool setFileName(const std::string& fileName);
    bool setAnimationStackName(const std::string& animationStackName);
    bool setFileFormat(bool fileFormat);
    bool setWriteCameras(bool writeCameras);
    bool setWriteLights(bool writeLights);
    bool setWriteTransforms(bool writeTransforms);
    bool setWriteNulls(bool writeNulls);
    bool setWriteMeshes(bool writeMeshes);
    bool setAnimateMeshVertices(bool animateMeshVertices);
    bool setMayaVertexCacheFormat(bool mayaVertexCacheFormat);
    bool setFPS(float framesPerSecond);
    bool setStartFrame(float startFrame);
    bool setEndFrame(float endFrame);
    bool setCompatibilityVersion(eCompatibilityVersion compatibilityVersion);
    bool setFidelity(EFbxFidelity fidelity);
    bool setComputeCameraRotation(bool computeCameraRotation);
    /// @}

    const std::string& getFileName() const; ///< FBX file to write; point caches are named after it.

    /// The name of the animation stack in a faithful write; empty means "Take 001". A compatible write fails without a
    /// name and names the stack "Take 001" in any case.
    const std::string& getAnimationStackName() const;

    bool getFileFormat() const; ///< True: ASCII; false: binary. Default true.

    /// Whether objects of the kind are written. Default true.
    /// @{
    bool getWriteCameras() const;
    bool getWriteLights() const;
    bool getWriteTransforms() const;
    bool getWriteNulls() const;
    bool getWriteMeshes() const;
    /// @}

    bool getAnimateMeshVertices() const;   ///< Animated mesh points are written as point caches. Default true.
    bool getMayaVertexCacheFormat() const; ///< True: Maya caches; false: Max ".pc2" caches. Default true.

    float getFPS() const; ///< Frames per second. Default 24.

    /// The first or last frame. A compatible write drops fractions; in a faithful one they belong to the span. Point
    /// caches have a sample for each frame, and the span of the file reaches from the first to the last, and beyond as
    /// far as there are keys. Frames 1 to 1, the default, do not define the span. Channels are written over their
    /// own ranges in any case.
    /// @{
    float getStartFrame() const;
    float getEndFrame() const;
    /// @}

    eCompatibilityVersion getCompatibilityVersion() const; ///< Default `kFbxVersion2016`.

    EFbxFidelity getFidelity() const; ///< Which behaviour a write follows; see docs/faithful.md. Default compatible.

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
    eCompatibilityVersion mCompatibilityVersion; // separate from the others: assignment skips it
};

} // namespace Tarnell::Fbx
