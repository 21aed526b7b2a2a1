// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Any bytes, read as a host reads a file, give valid objects or a reason; and what was read can be written and read
// again.
#include "fuzz/FuzzSupport.h"

#include <Fbx.h>
#include <TnFbxCamera.h>
#include <TnFbxError.h>
#include <TnFbxLight.h>
#include <TnFbxMarker.h>
#include <TnFbxMesh.h>
#include <TnFbxNull.h>
#include <TnFbxReadInfo.h>
#include <TnFbxTransform.h>
#include <TnFbxWriteInfo.h>

#include <algorithm>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace {

using namespace Tarnell::Fbx;

/// Longer clips are read, but not written: they would only take time.
constexpr int kLongestWrittenClip = 500;

using fuzz::checkMesh;
using fuzz::List;
using fuzz::require;

/// The frames of the longest of the channels, which are numbered from 0 to the last one.
template <class Object, class Channel>
int longestClip(const Object& object, TnFbxTime (Object::*timeOf)(Channel) const, Channel last) {
    int longest = 0;
    for (int i = 0; i <= last; ++i) {
        const TnFbxTime time = (object.*timeOf)(static_cast<Channel>(i));
        longest = std::max(longest, time.getEndFrame() - time.getStartFrame());
    }
    return longest;
}

int longestClip(const TnFbxTransform& object) {
    return longestClip(object, &TnFbxTransform::getTransformTime, TnFbxTransform::kFbxTransformPivotZ);
}
int longestClip(const TnFbxCamera& camera) {
    return std::max(longestClip(static_cast<const TnFbxTransform&>(camera)),
                    longestClip(camera, &TnFbxCamera::getTime, TnFbxCamera::kFbxCameraFilmOffsetY));
}
int longestClip(const TnFbxLight& light) {
    return std::max(longestClip(static_cast<const TnFbxTransform&>(light)),
                    longestClip(light, &TnFbxLight::getTime, TnFbxLight::kFbxLightConeAngle));
}

template <class Object>
bool areShort(const List<Object>& list) {
    for (const Object* object : list.pointers())
        if (longestClip(*object) > kLongestWrittenClip)
            return false;
    return true;
}

/// How a file is read and written depends on its bytes, so that every path is taken.
struct Choices {
    std::size_t left;
    int take(std::size_t count) {
        const std::size_t taken = left % count;
        left /= count;
        return static_cast<int>(taken);
    }
    bool take() { return take(2) != 0; }
};

TnFbxReadInfo readInfo(const std::string& file, Choices& choices) {
    TnFbxReadInfo info;
    info.setFileName(file);
    info.setAnimationStackName("any");
    info.setGlobalTransform(choices.take());
    info.setTransformPoints(choices.take());
    info.setComputeCameraRotation(choices.take());
    info.setUseSampleFPS(choices.take(4) == 0);
    info.setSampleFPS(12.5F);
    info.setFrame(static_cast<float>(choices.take(5)));
    return info;
}

TnFbxWriteInfo writeInfo(const std::string& file, Choices& choices) {
    TnFbxWriteInfo info;
    info.setFileName(file);
    info.setAnimationStackName("Take 001");
    info.setFileFormat(choices.take());
    info.setCompatibilityVersion(static_cast<TnFbxWriteInfo::eCompatibilityVersion>(choices.take(6)));
    info.setAnimateMeshVertices(false);
    return info;
}

void readAndWrite(const support::TemporaryFolder& folder, Choices choices) {
    TnFbxReadInfo info = readInfo(folder.file("input.fbx"), choices);
    const List<TnFbxCamera> cameras(info, &Fbx::getCameras);
    const List<TnFbxLight> lights(info, &Fbx::getLights);
    const List<TnFbxMarker> markers(info, &Fbx::getMarkers);
    const List<TnFbxNull> nulls(info, &Fbx::getNulls);
    const List<TnFbxTransform> transforms(info, &Fbx::getTransforms);
    const List<TnFbxMesh> meshes(info, &Fbx::getMeshes);
    for (const TnFbxMesh* mesh : meshes.pointers())
        checkMesh(*mesh);
    const auto opens = [](const auto& list) { return list.read || list.isTooLarge; };
    require(opens(cameras) == opens(lights) && opens(lights) == opens(markers) && opens(markers) == opens(nulls) &&
                opens(nulls) == opens(transforms),
            "a file that opens for one kind and not for another");
    const bool areRead = cameras.read && lights.read && markers.read && nulls.read && transforms.read && meshes.read;
    if (!areRead || !areShort(cameras) || !areShort(lights) || !areShort(transforms) || !areShort(meshes))
        return;

    const std::string copy = folder.file("copy.fbx");
    const TnFbxWriteInfo target = writeInfo(copy, choices);
    if (!Fbx().writeFile(target, cameras.pointers(), lights.pointers(), transforms.pointers(), nulls.pointers(),
                         meshes.pointers())) {
        require(!lastError().empty(), "a failure without a reason");
        return;
    }
    TnFbxReadInfo again;
    again.setFileName(copy);
    again.setAnimationStackName("any");
    const List<TnFbxLight> lightsAgain(again, &Fbx::getLights);
    require(lightsAgain.read && lightsAgain.count == lights.count, "a copy with other lights");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    static const support::TemporaryFolder folder;
    [[maybe_unused]] static const bool isLimited = fuzz::limitMemory();
    const std::string content(reinterpret_cast<const char*>(bytes), size);
    fuzz::writeOldFile(folder, "input.fbx", content);
    readAndWrite(folder, Choices{std::hash<std::string>{}(content)});
    return 0;
}
