// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A file that is read faithfully and stays loaded, for hosts that read several kinds of objects or many frames.
// Other hosts can call `Fbx`, which loads the file for every call.
#pragma once

#include "FbxPlatform.h"
#include "TnFbxCamera.h"
#include "TnFbxExport.h"
#include "TnFbxLight.h"
#include "TnFbxMarker.h"
#include "TnFbxMesh.h"
#include "TnFbxNull.h"
#include "TnFbxReadInfo.h"
#include "TnFbxTransform.h"

#include <memory>

namespace Tarnell::Fbx {

/// One file, loaded once, in centimetres, Y up. The values are those of docs/faithful.md, regardless of the fidelity in
/// the options.
///
/// An object belongs to one thread, whose time mode is the file's as long as the object exists. False is a failure, and
/// `lastError()` says why; for `lastWarnings()` each operation counts as a call of its own.
class TARNELL_FBX_API FbxFaithful {
public:
    /// No file is loaded yet.
    FbxFaithful();
    ~FbxFaithful();
    FbxFaithful(const FbxFaithful&) = delete;
    FbxFaithful& operator=(const FbxFaithful&) = delete;

    /// Loads the file that the options name, and selects the stack and the frames; the options for spaces and points
    /// apply to all reads. To be called once.
    bool load(const TnFbxReadInfo& info);

    /// Selects the stack and the frames that the options name, of the loaded file; the options apply to all reads from
    /// now on. After a failure the former ones do.
    bool select(const TnFbxReadInfo& info);

    /// The scene of the file, null before one is loaded. It and its objects belong to this object, and the host must
    /// not change them.
    fbxsdk::FbxScene* getScene() const;

    double getFrameRate() const;     ///< Frames per second of samples.
    long long getFirstFrame() const; ///< The first frame of samples.
    long long getLastFrame() const;  ///< The last frame of samples, inclusive.

    /// Sets the frame of the static values and meshes that are read from now on. False for a frame that is NaN or
    /// infinite.
    bool setFrame(float frame);

    /// Converts NURBS and patches to meshes. A read of all meshes does so by itself.
    bool makeMeshes();

    /// All objects of a kind, or the first of the name in the options, in an array that the caller owns; null for none.
    /// After a failure there may be one as well. Each call may return as much as `memoryLimit()` allows.
    template <class Object>
    bool readAll(Object** objects, int& count);

    /// One node of the kind into a new object. All of them together may take as much as `memoryLimit()` allows.
    template <class Object>
    bool read(fbxsdk::FbxNode& node, Object& object);

    /// Adds the points of the node's mesh at the frame to a mesh that was read from that node, as one more set.
    bool readPoints(fbxsdk::FbxNode& node, TnFbxMesh& mesh);

private:
    struct File;
    std::unique_ptr<File> mFile;
};

/// Instances of the templates for one class; they are in the library.
#define TARNELL_FBX_FAITHFUL(Object)                                                                                   \
    extern template TARNELL_FBX_API bool FbxFaithful::readAll(Object**, int&);                                         \
    extern template TARNELL_FBX_API bool FbxFaithful::read(fbxsdk::FbxNode&, Object&);
TARNELL_FBX_FAITHFUL(TnFbxCamera)
TARNELL_FBX_FAITHFUL(TnFbxLight)
TARNELL_FBX_FAITHFUL(TnFbxMarker)
TARNELL_FBX_FAITHFUL(TnFbxMesh)
TARNELL_FBX_FAITHFUL(TnFbxNull)
TARNELL_FBX_FAITHFUL(TnFbxTransform)
#undef TARNELL_FBX_FAITHFUL

} // namespace Tarnell::Fbx
