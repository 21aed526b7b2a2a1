// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The facade: every call has a context of its own, from the creation to the destruction of its manager.
#include "Fbx.h"

#include "FbxSdk.h"
#include "access/NewFolders.h"
#include "access/PointCachePlace.h"
#include "calls/LastError.h"
#include "faithful/Reading.h"
#include "faithful/Writing.h"
#include "sdk/NodeMasks.h"

#include <algorithm>
#include <cstddef>

namespace Tarnell::Fbx {

using detail::CallScope;
using detail::fail;
using detail::succeed;
namespace NodeMask = detail::NodeMask;

namespace {

/// The differences between the readers of two kinds of objects.
template <class Object>
struct ReaderRow {
    int (FbxSdk::*candidateCount)() const;
    int mask;
    bool (FbxSdk::*fill)(TnFbxReadInfo&, Object*, int);
};

template <class Object>
constexpr ReaderRow<Object> kReader{};
template <>
constexpr ReaderRow<TnFbxMesh> kReader<TnFbxMesh> = {&FbxSdk::getNumberOfMeshes, NodeMask::kMeshes, &FbxSdk::getMeshes};
template <>
constexpr ReaderRow<TnFbxCamera> kReader<TnFbxCamera> = {&FbxSdk::getNumberOfCameras, NodeMask::kCameras,
                                                         &FbxSdk::getCameras};
template <>
constexpr ReaderRow<TnFbxLight> kReader<TnFbxLight> = {&FbxSdk::getNumberOfLights, NodeMask::kLights,
                                                       &FbxSdk::getLights};
template <>
constexpr ReaderRow<TnFbxMarker> kReader<TnFbxMarker> = {&FbxSdk::getNumberOfMarkers, NodeMask::kMarkers,
                                                         &FbxSdk::getMarkers};
template <>
constexpr ReaderRow<TnFbxNull> kReader<TnFbxNull> = {&FbxSdk::getNumberOfNulls, NodeMask::kNulls, &FbxSdk::getNulls};
template <>
constexpr ReaderRow<TnFbxTransform> kReader<TnFbxTransform> = {&FbxSdk::getNumberOfTransforms, NodeMask::kTransforms,
                                                               &FbxSdk::getTransforms};

template <class Object>
bool read(const Fbx& fbx, TnFbxReadInfo& info, Object** objects, int& count) {
    const CallScope call;
    if (objects == nullptr)
        return fail("the pointer to the array of objects is null");
    *objects = nullptr;
    count = 0;
    if (info.getFidelity() == kFbxFidelityFaithful) {
        return info.getFileName().empty() ? fail("the read options have no file name")
                                          : faithful::readObjects(info, objects, count);
    }
    if (!info.haveAnimationStack()) // kept: the name is required, though the first stack is read in any case
        return fail("the read options have no animation stack name");
    if (info.getFileName().empty())
        return fail("the read options have no file name");
    FbxSdk sdk;
    if (!fbx.loadScene(info.getFileName(), sdk))
        return false;

    const ReaderRow<Object>& row = kReader<Object>;
    count =
        fbx.getNumberOfObjects((sdk.*row.candidateCount)(), info.getAllObjects(), row.mask, info.getObjectName(), sdk);
    bool result = succeed();
    if (count >= 1) {
        *objects = new Object[static_cast<std::size_t>(count)];
        result = (sdk.*row.fill)(info, *objects, count);
    }
    sdk.destroyFbxSdkManager();
    return result;
}

} // namespace

Fbx::Fbx() = default;

Fbx::~Fbx() = default;

Fbx& Fbx::operator=(const Fbx& /*other*/) = default;

bool Fbx::loadScene(const std::string& fileName, FbxSdk& sdk) const {
    const CallScope call;
    if (fileName.empty())
        return fail("no file name is given");
    if (!sdk.initFbxSdkManager())
        return false;
    if (!sdk.loadScene(fileName, /*convertGeometry*/ true)) {
        sdk.destroyFbxSdkManager();
        return false;
    }
    return true;
}

int Fbx::getNumberOfObjects(int count, bool allObjects, int nodeTypeMask, const std::string& objectName,
                            FbxSdk& sdk) const {
    if (count < 0)
        return 0;
    if (allObjects)
        return count;
    std::vector<std::string> names;
    if (objectName.empty() || !sdk.getNodeNames(nodeTypeMask, names))
        return 0;
    return std::find(names.begin(), names.end(), objectName) != names.end() ? 1 : 0;
}

bool Fbx::getAnimationStackNodeNames(const char* fileName, long nodeTypeMask, std::vector<std::string>& stackNames,
                                     std::vector<std::string>& nodeNames) const {
    const CallScope call;
    FbxSdk sdk;
    if (!loadScene(fileName != nullptr ? fileName : "", sdk))
        return false;
    const bool result = sdk.getAnimationStackNames(stackNames) && sdk.getNodeNames(nodeTypeMask, nodeNames);
    sdk.destroyFbxSdkManager();
    return result;
}

bool Fbx::getAnimationFrameRange(const char* fileName, float& start, float& end) const {
    const CallScope call;
    FbxSdk sdk;
    if (!loadScene(fileName != nullptr ? fileName : "", sdk))
        return false;
    const bool result = sdk.getAnimationFrameRange(start, end);
    sdk.destroyFbxSdkManager();
    return result;
}

bool Fbx::getMeshes(TnFbxReadInfo& info, TnFbxMesh** objects, int& count) const {
    return read(*this, info, objects, count);
}

bool Fbx::getCameras(TnFbxReadInfo& info, TnFbxCamera** objects, int& count) const {
    return read(*this, info, objects, count);
}

bool Fbx::getLights(TnFbxReadInfo& info, TnFbxLight** objects, int& count) const {
    return read(*this, info, objects, count);
}

bool Fbx::getMarkers(TnFbxReadInfo& info, TnFbxMarker** objects, int& count) const {
    return read(*this, info, objects, count);
}

bool Fbx::getNulls(TnFbxReadInfo& info, TnFbxNull** objects, int& count) const {
    return read(*this, info, objects, count);
}

bool Fbx::getTransforms(TnFbxReadInfo& info, TnFbxTransform** objects, int& count) const {
    return read(*this, info, objects, count);
}

bool Fbx::writeFile(const TnFbxWriteInfo& info, const std::vector<TnFbxCamera*>& cameras,
                    const std::vector<TnFbxLight*>& lights, const std::vector<TnFbxTransform*>& transforms,
                    const std::vector<TnFbxNull*>& nulls, const std::vector<TnFbxMesh*>& meshes) const {
    const CallScope call;
    if (info.getFileName().empty())
        return fail("the write options have no file name");
    const bool faithfully = info.getFidelity() == kFbxFidelityFaithful;
    if (!faithfully && info.getAnimationStackName().empty()) // kept: required, though the stack has another name
        return fail("the write options have no animation stack name");
    const auto place = detail::pointCachePlace(info.getFileName(), /*nodeName*/ "", /*extension*/ "");
    detail::NewFolders folders(std::string(place.folder)); // destroyed after the context, which removes its files
    if (faithfully) {
        const bool written = faithful::writeObjects(info, cameras, lights, transforms, nulls, meshes);
        if (written)
            folders.keep();
        return written;
    }
    FbxSdk sdk;
    if (!sdk.initFbxSdkManager())
        return false;
    sdk.letPointCachesAppearWithScene();
    const bool result = sdk.createScene(info, cameras, lights, transforms, nulls, meshes) && sdk.saveScene(info);
    sdk.destroyFbxSdkManager();
    if (result)
        folders.keep();
    return result;
}

} // namespace Tarnell::Fbx
