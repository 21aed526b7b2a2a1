// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The facade: each operation opens one FBX file, reads the requested data and closes it
// again, or writes one file.
#pragma once

#include "TnFbxCamera.h"
#include "TnFbxError.h"
#include "TnFbxExport.h"
#include "TnFbxLight.h"
#include "TnFbxLimits.h"
#include "TnFbxMarker.h"
#include "TnFbxMesh.h"
#include "TnFbxNull.h"
#include "TnFbxReadInfo.h"
#include "TnFbxTransform.h"
#include "TnFbxWriteInfo.h"

#include <string>
#include <vector>

/// The library: value classes, the facade and the adapters.
namespace Tarnell::Fbx {

class FbxSdk; // FbxSdk.h includes the platform's headers, which few hosts need

/// The facade. It has no state: any number of threads may call any number of facades.
///
/// Where a bool is returned, false is a failure, and `lastError()` says why. When memory runs out, either that
/// happens or std::bad_alloc is thrown; no other exception is thrown. A file that is changed while it is read is a
/// failure as well, unless all of the requested data had been read by then.
class TARNELL_FBX_API Fbx {
public:
    /// Trivial; opens no file.
    Fbx();
    ~Fbx();
    Fbx(const Fbx& other) = default;
    /// Trivial: the facade has no state.
    Fbx& operator=(const Fbx& other);

    /// Loads a file into the caller's context and converts NURBS and patches to meshes. After a failure the
    /// context is no longer initialised.
    bool loadScene(const std::string& fileName, FbxSdk& sdk) const;

    /// How many objects a read yields: `count`, the number of candidates, when all are requested; otherwise 1 when a
    /// node of the kind has exactly the name, else 0. A negative count gives 0.
    int getNumberOfObjects(int count, bool allObjects, int nodeTypeMask, const std::string& objectName,
                           FbxSdk& sdk) const;

    /// Replaces both lists: by the names of the file's animation stacks, and by those of its nodes of the kinds in the
    /// mask (meshes 4, cameras 32, lights 64, markers 1, nulls 0x4000, transforms 0x4005).
    bool getAnimationStackNodeNames(const char* fileName, long nodeTypeMask, std::vector<std::string>& stackNames,
                                    std::vector<std::string>& nodeNames) const;

    /// The time between the first and the last key of the file, in seconds although the name says frames. False also
    /// when nothing in the file is animated.
    bool getAnimationFrameRange(const char* fileName, float& start, float& end) const;

    /// Reads every object of the kind in the file, or the one named by `info.getObjectName()`.
    ///
    /// `*objects` receives an array of `count` objects, parents before their children; null when `count` is 0, which is
    /// a success. The caller owns it and releases it with `delete[]`, also after a failure and after std::bad_alloc.
    /// False when `objects` is null (`count` is untouched then), when `info` names no file or no animation stack, and
    /// when the file cannot be read. The first stack of the file is read, whatever the name; docs/kept-behaviours.md
    /// lists what else is kept. With `kFbxFidelityFaithful` in `info` the stack of the name is read, an empty name
    /// means the first one, and the values are those of docs/faithful.md.
    /// @{
    bool getMeshes(TnFbxReadInfo& info, TnFbxMesh** objects, int& count) const;
    bool getLights(TnFbxReadInfo& info, TnFbxLight** objects, int& count) const;
    bool getMarkers(TnFbxReadInfo& info, TnFbxMarker** objects, int& count) const;
    /// @}

    /// As `getMeshes`. Unless the read is faithful, the seven producer cameras come first, and a file that has none
    /// gets them.
    bool getCameras(TnFbxReadInfo& info, TnFbxCamera** objects, int& count) const;

    /// As `getMeshes`. Unless the read is faithful, NURBS surfaces are counted but not read: as many objects at the end
    /// of the array stay in the state of new ones.
    bool getNulls(TnFbxReadInfo& info, TnFbxNull** objects, int& count) const;

    /// As `getMeshes`: nulls, markers and meshes, and NURBS surfaces as with `getNulls`; every node below the root when
    /// the read is faithful.
    bool getTransforms(TnFbxReadInfo& info, TnFbxTransform** objects, int& count) const;

    /// Writes one file, and next to it the point caches of animated meshes. The objects are only read; null pointers
    /// are skipped, and so are kinds that `info` does not select. Markers are read but never written. False when `info`
    /// names no file or no animation stack, and when the file cannot be written. Curves go into the stack "Take 001",
    /// whatever the name. With `kFbxFidelityFaithful` in `info` they go into the stack of the name, which may be empty,
    /// and a read returns what was written: docs/faithful.md. The file and its caches appear together, or the previous
    /// files stay. A mesh whose cache cannot be written is written without it; `lastWarnings()` reports that, and
    /// whatever else the file lacks or no program can interpret.
    bool writeFile(const TnFbxWriteInfo& info, const std::vector<TnFbxCamera*>& cameras,
                   const std::vector<TnFbxLight*>& lights, const std::vector<TnFbxTransform*>& transforms,
                   const std::vector<TnFbxNull*>& nulls, const std::vector<TnFbxMesh*>& meshes) const;
};

} // namespace Tarnell::Fbx
