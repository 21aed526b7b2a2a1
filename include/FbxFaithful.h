// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A file that is read faithfully and stays loaded, for who reads several kinds of objects or many frames.
// Hosts that do not can call `Fbx`, which loads the file for every call.
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

/// One file, loaded once, in centimetres, Y up. The values are those of docs/faithful.md, whatever the fidelity in the
/// options.
///
/// It belongs to one thread, whose time mode is the file's for as long as it lives. False is a failure, and
/// `lastError()` says why; each operation is a call of its own as far as `lastWarnings()` goes.
class TARNELL_FBX_API FbxFaithful {
public:
    FbxFaithful();
    ~FbxFaithful();
    FbxFaithful(const FbxFaithful&) = delete;
    FbxFaithful& operator=(const FbxFaithful&) = delete;

    /// Once. Selects the stack and the frames; what the options say of spaces and points holds for all reads.
    bool load(const TnFbxReadInfo& info);

    /// Null before a file is loaded. Scene objects stay the scene's; nobody but this may change them.
    fbxsdk::FbxScene* getScene() const;

    /// Frames per second of samples, and the first and last one.
    double getFrameRate() const;
    long long getFirstFrame() const;
    long long getLastFrame() const;

    /// From now on static values, and meshes, are those at that frame. False for a frame that is no number.
    bool setFrame(float frame);

    /// Puts meshes in the place of NURBS and patches. A read of all meshes does so by itself.
    bool makeMeshes();

    /// All objects of a kind, or the first of the name in the options, in an array that the caller owns; null for none.
    /// After a failure there may be one as well. Each call may hand out as much as `memoryLimit()` says.
    template <class Object>
    bool readAll(Object** objects, int& count);

    /// One node of the kind into a new object. All of them together may take as much as `memoryLimit()` says.
    template <class Object>
    bool read(fbxsdk::FbxNode& node, Object& object);

    /// Adds the points of the node's mesh at the frame to a mesh that was read from it: one more set.
    bool readPoints(fbxsdk::FbxNode& node, TnFbxMesh& mesh);

private:
    struct File;
    std::unique_ptr<File> mFile;
};

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
