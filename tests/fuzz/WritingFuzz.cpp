// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Any value objects, however contradictory, are written or refused with a reason: in every version, as text and as
// binary. No incomplete file stays, every file that is written can be read, and what was read can be written again.
//
// The bytes of an input are the choices by which the objects are made.
#include "fuzz/FuzzSupport.h"

#include <TnFbxCamera.h>
#include <TnFbxLight.h>
#include <TnFbxMesh.h>
#include <TnFbxNull.h>
#include <TnFbxTransform.h>
#include <TnFbxWriteInfo.h>

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstdint>
#include <iterator>
#include <limits>
#include <span>
#include <string>
#include <vector>

namespace {

using namespace Tarnell::Fbx;
using fuzz::List;
using fuzz::require;

constexpr int kMostObjects = 3;
constexpr int kMostSamples = 6;
constexpr int kMostSets = 4;

/// Choices from bytes, and zeros after the last one.
class Choices {
public:
    explicit Choices(std::span<const std::uint8_t> bytes) : mLeft(bytes) {}

    int below(int count) { return take<std::uint8_t>() % count; }
    bool flip() { return below(2) != 0; }

    int integer() {
        constexpr int kSpecial[] = {
            0, 1, -1, 2, 3, 24, 1001, 1 << 24, std::numeric_limits<int>::max(), std::numeric_limits<int>::min()};
        const auto choice = static_cast<std::size_t>(below(16));
        return choice < std::size(kSpecial) ? kSpecial[choice] : take<std::int32_t>();
    }
    float number() {
        using Limits = std::numeric_limits<float>;
        constexpr float kSpecial[] = {0.0f,
                                      -0.0f,
                                      1.0f,
                                      -1.0f,
                                      24.0f,
                                      Limits::max(),
                                      Limits::min(),
                                      Limits::denorm_min(),
                                      Limits::quiet_NaN(),
                                      Limits::infinity(),
                                      -Limits::infinity()};
        const auto choice = static_cast<std::size_t>(below(16));
        if (choice < std::size(kSpecial))
            return kSpecial[choice];
        return choice % 2 == 0 ? std::bit_cast<float>(take<std::uint32_t>()) : static_cast<float>(take<std::int8_t>());
    }
    std::string text() {
        constexpr const char* kSpecial[] = {
            "name",     "",         "Camera Switcher", "Producer Perspective",    "a::b",
            "Model::m", "\xC3\xA4", "\xFF\xC0\x80",    "quote\"&quot;\r\n;{}:,*", "../up/.."};
        const auto choice = static_cast<std::size_t>(below(16));
        if (choice < std::size(kSpecial))
            return kSpecial[choice];
        std::string bytes;
        for (int left = below(12); left > 0; --left)
            bytes.push_back(take<char>());
        return choice == 15 ? bytes + std::string(5000, 'x') : bytes;
    }

private:
    template <class Value>
    Value take() {
        std::uint64_t bits = 0;
        for (std::size_t i = 0; i < sizeof(Value) && !mLeft.empty(); ++i, mLeft = mLeft.subspan(1))
            bits |= std::uint64_t{mLeft.front()} << (8 * i);
        return static_cast<Value>(bits);
    }

    std::span<const std::uint8_t> mLeft;
};

void fill(TnFbxChannel& channel, Choices& choices) {
    channel.setValue(choices.number());
    if (choices.below(4) != 0)
        return;
    const int count = 1 + choices.below(kMostSamples);
    const int start = std::min(choices.integer(), std::numeric_limits<int>::max() - count);
    std::vector<float> values;
    for (int i = 0; i < count; ++i)
        values.push_back(choices.number());
    TnFbxTime time;
    time.setTime(choices.number(), start, start + count - 1, choices.flip() ? 24.0f : choices.number());
    channel.setAnimatedValues(time, values);
}

void fill(TnFbxTransform& object, Choices& choices) {
    object.setName(choices.text());
    for (int left = choices.below(5); left > 0; --left)
        fill(*object.getTransformChannel(static_cast<TnFbxTransform::EFbxTransformChannelType>(choices.below(15))),
             choices);
    object.setTransformRotationOrder(static_cast<TnFbxTransform::EFbxTransformRotationOrder>(choices.integer()));
}

void fill(TnFbxNull& object, Choices& choices) {
    fill(static_cast<TnFbxTransform&>(object), choices);
    object.setNullSize(choices.number());
    object.setNullLookType(static_cast<TnFbxNull::EFbxNullLookType>(choices.integer()));
}

void fill(TnFbxCamera& object, Choices& choices) {
    fill(static_cast<TnFbxTransform&>(object), choices);
    for (int left = choices.below(6); left > 0; --left)
        fill(*object.getCameraChannel(static_cast<TnFbxCamera::EFbxCameraChannelType>(choices.below(17))), choices);
    object.setProjectionType(static_cast<TnFbxCamera::EFbxCameraProjectionType>(choices.integer()));
    object.setApertureMode(static_cast<TnFbxCamera::EFbxCameraApertureMode>(choices.integer()));
}

void fill(TnFbxLight& object, Choices& choices) {
    fill(static_cast<TnFbxTransform&>(object), choices);
    for (int left = choices.below(5); left > 0; --left)
        fill(*object.getLightChannel(static_cast<TnFbxLight::EFbxLightChannelType>(choices.below(6))), choices);
    object.setLightType(static_cast<TnFbxLight::EFbxLightType>(choices.integer()));
    object.setDecayType(static_cast<TnFbxLight::EFbxLightDecayType>(choices.integer()));
}

/// Polygons that have other corners than the mesh, corners at missing points, sets of too few points.
void fill(TnFbxMesh& mesh, Choices& choices) {
    fill(static_cast<TnFbxTransform&>(mesh), choices);
    const int polygons = choices.below(5), points = choices.below(9), corners = choices.below(17);
    mesh.allocateGeometryData(polygons, points, corners);
    for (int i = 0; i < polygons; ++i)
        mesh.setPolygonVertexSize(i, choices.below(8) == 0 ? choices.integer() : corners / polygons);
    for (int i = 0; i < corners; ++i)
        mesh.setPointIndex(i, choices.below(8) == 0 ? choices.integer() : i % std::max(points, 1));
    for (int left = choices.below(4); left > 0; --left) {
        const int corner = choices.below(17);
        mesh.setControlPoint(choices.below(9), choices.number(), choices.number(), choices.number());
        mesh.setNormal(corner, choices.number(), choices.number(), choices.number());
        mesh.setUV(corner, choices.number(), choices.number());
        mesh.setColour(corner, choices.number(), choices.number(), choices.number(), choices.number());
    }
    mesh.setValidNormals(choices.flip());
    mesh.setValidUVs(choices.flip());
    mesh.setValidColours(choices.flip());
    for (int left = choices.below(kMostSets); left > 0; --left) {
        mesh.addControlPointSet();
        for (int point = choices.below(8) == 0 ? choices.below(9) : points; point > 0; --point)
            mesh.addControlPoint(choices.number(), 1.0f, 2.0f);
    }
}

/// Up to three objects of a kind; one of the pointers may be null, or point to the object before.
template <class Object>
struct Objects {
    std::vector<Object> all;
    std::vector<Object*> pointers;

    explicit Objects(Choices& choices) : all(static_cast<std::size_t>(choices.below(kMostObjects + 1))) {
        for (Object& object : all) {
            fill(object, choices);
            pointers.push_back(&object);
        }
        if (!all.empty() && choices.below(16) == 0)
            pointers.push_back(choices.flip() ? nullptr : pointers.back());
    }
};

TnFbxWriteInfo options(Choices& choices) {
    TnFbxWriteInfo info;
    info.setAnimationStackName(choices.below(16) == 0 ? choices.text() : "any");
    info.setFileFormat(choices.flip());
    info.setFidelity(choices.below(4) == 0 ? kFbxFidelityFaithful : kFbxFidelityCompatible);
    info.setCompatibilityVersion(static_cast<TnFbxWriteInfo::eCompatibilityVersion>(
        choices.below(16) == 0 ? choices.integer() : choices.below(6)));
    info.setAnimateMeshVertices(choices.flip());
    info.setMayaVertexCacheFormat(choices.flip());
    info.setFPS(choices.flip() ? 24.0f : choices.number());
    const float start = choices.number();
    info.setStartFrame(start);
    info.setEndFrame(choices.below(4) == 0 ? choices.number() : start + static_cast<float>(choices.below(kMostSets)));
    return info;
}

struct Scene {
    Objects<TnFbxCamera> cameras;
    Objects<TnFbxLight> lights;
    Objects<TnFbxTransform> transforms;
    Objects<TnFbxNull> nulls;
    Objects<TnFbxMesh> meshes;

    explicit Scene(Choices& choices)
        : cameras(choices), lights(choices), transforms(choices), nulls(choices), meshes(choices) {}

    [[nodiscard]] bool write(const TnFbxWriteInfo& info) const {
        return Fbx().writeFile(info, cameras.pointers, lights.pointers, transforms.pointers, nulls.pointers,
                               meshes.pointers);
    }
};

template <class Object>
int countOf(const std::vector<Object*>& pointers) {
    return static_cast<int>(std::count_if(
        pointers.begin(), pointers.end(), [](const Object* o) { return o; }));
}

/// The content of a file of the scene.
struct Copy {
    List<TnFbxCamera> cameras;
    List<TnFbxLight> lights;
    List<TnFbxNull> nulls;
    List<TnFbxMesh> meshes;

    explicit Copy(TnFbxReadInfo info)
        : cameras(info, &Fbx::getCameras), lights(info, &Fbx::getLights), nulls(info, &Fbx::getNulls),
          meshes(info, &Fbx::getMeshes) {}

    [[nodiscard]] bool isTooLarge() const {
        return cameras.isTooLarge || lights.isTooLarge || nulls.isTooLarge || meshes.isTooLarge;
    }
};

TnFbxReadInfo readInfo(const std::string& file) {
    TnFbxReadInfo info;
    info.setFileName(file);
    info.setAnimationStackName("any");
    info.setGlobalTransform(false);
    info.setTransformPoints(false);
    return info;
}

/// Position and scale are read back unchanged; a zero may lose its sign. ASCII has no spelling for what is not finite.
void requireSamePlace(const TnFbxTransform& written, const TnFbxTransform& read, bool ascii) {
    using Channel = TnFbxTransform::EFbxTransformChannelType;
    for (const int first : {TnFbxTransform::kFbxTransformPositionX, TnFbxTransform::kFbxTransformScaleX}) {
        for (int i = first; i < first + 3; ++i) {
            const auto channel = static_cast<Channel>(i);
            const float value = written.getTransformValue(channel);
            if (!written.getTransformAnimated(channel) && (!ascii || std::isfinite(value)))
                require(read.getTransformValue(channel) == value || std::isnan(value), "an object at another place");
        }
    }
}

/// The objects of a kind are consecutive in the copy, in order.
template <class Object, class Read>
void requireSamePlaces(const std::vector<Object*>& written, const List<Read>& copy, int from, bool ascii) {
    for (const Object* object : written)
        if (object)
            requireSamePlace(*object, copy.objects[static_cast<std::size_t>(from++)], ascii);
}

void compare(const Scene& scene, const Copy& copy, bool ascii) {
    constexpr int kProducerCameras = 7;
    const int transforms = countOf(scene.transforms.pointers);
    require(copy.cameras.read && copy.lights.read && copy.nulls.read && copy.meshes.read, "a copy that cannot be read");
    require(copy.lights.count == countOf(scene.lights.pointers), "a copy with other lights");
    require(copy.cameras.count == countOf(scene.cameras.pointers) + kProducerCameras, "a copy with other cameras");
    require(copy.nulls.count == transforms + countOf(scene.nulls.pointers), "a copy with other nulls");
    require(copy.meshes.count <= countOf(scene.meshes.pointers), "a copy with more meshes");
    for (const TnFbxMesh* mesh : copy.meshes.pointers())
        fuzz::checkMesh(*mesh);
    requireSamePlaces(scene.lights.pointers, copy.lights, 0, ascii);
    requireSamePlaces(scene.transforms.pointers, copy.nulls, 0, ascii);
    requireSamePlaces(scene.nulls.pointers, copy.nulls, transforms, ascii);
}

void checkOutcome(const support::TemporaryFolder& folder, const Scene& scene, TnFbxWriteInfo info) {
    const std::string name = "written.fbx", file = folder.file(name);
    info.setFileName(file);
    const bool written = scene.write(info);
    require(written || !lastError().empty(), "a failure without a reason");
    const std::vector<std::string> files = folder.files();
    require(written == std::binary_search(files.begin(), files.end(), name), "a file without success, or none with it");
    require(std::none_of(files.begin(), files.end(), [](const std::string& f) { return f.ends_with(".part"); }),
            "a file that was left behind");
    if (!written)
        return;
    std::filesystem::last_write_time(file, std::filesystem::file_time_type::clock::now() - std::chrono::hours(1));
    const Copy copy(readInfo(file));
    if (copy.isTooLarge())
        return;
    if (info.getFidelity() == kFbxFidelityCompatible)
        compare(scene, copy, info.getFileFormat());

    info.setFileName(folder.file("again.fbx"));
    info.setAnimateMeshVertices(false);
    require(Fbx().writeFile(info, copy.cameras.pointers(), copy.lights.pointers(), {}, copy.nulls.pointers(),
                            copy.meshes.pointers()) ||
                fuzz::isBeyondLimit(),
            "what was read cannot be written");
}

void clear(const support::TemporaryFolder& folder) {
    for (const std::string& name : folder.files())
        std::filesystem::remove_all(folder.file(name));
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    static const support::TemporaryFolder folder;
    [[maybe_unused]] static const bool isLimited = fuzz::limitMemory();
    Choices choices({bytes, size});
    const TnFbxWriteInfo info = options(choices);
    const Scene scene(choices);
    checkOutcome(folder, scene, info);
    clear(folder);
    return 0;
}
