// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reading and writing while one allocation, or all from one on, fail. The result is std::bad_alloc, or false with a
// reason, or the complete result; never less with success, and never the end of the process.
#include "FailingMalloc.h"

#include <algorithm>
#include <cstdlib>
#include <functional>
#include <memory>
#include <new>
#include <optional>
#include <string>
#include <tuple>
#include <vector>

#include <gtest/gtest.h>

#include "Fbx.h"
#include "TnFbxCamera.h"
#include "TnFbxError.h"
#include "TnFbxLight.h"
#include "TnFbxMarker.h"
#include "TnFbxMesh.h"
#include "TnFbxNull.h"
#include "TnFbxReadInfo.h"
#include "TnFbxTransform.h"
#include "support/StripMesh.h"
#include "support/TemporaryFolder.h"
#include "support/WritingBuilders.h"

namespace Tarnell::Fbx {
namespace {

/// The result of a call, as far as it can be compared; nothing when it ran out of memory or failed.
using Answer = std::optional<std::vector<double>>;

class Numbers {
public:
    void add(double number) { mNumbers.push_back(number); }
    void addChannels(const TnFbxTransform& object) {
        add(static_cast<double>(object.getName().size()));
        for (int i = 0; i <= TnFbxTransform::kFbxTransformPivotZ; ++i) {
            const auto channel = static_cast<TnFbxTransform::EFbxTransformChannelType>(i);
            add(static_cast<double>(object.getTransformValue(channel)));
            add(object.getTransformAnimated(channel) ? 1.0 : 0.0);
        }
    }
    void addMesh(const TnFbxMesh& mesh) {
        add(mesh.getNumberOfPolygons());
        for (int i = 0; i < mesh.getNumberOfControlPoints(); ++i) {
            float x = 0.0f, y = 0.0f, z = 0.0f;
            mesh.getControlPoint(i, x, y, z);
            add(static_cast<double>(x) + 2.0 * static_cast<double>(y) + 4.0 * static_cast<double>(z));
        }
        for (int i = 0; i < mesh.getNumberOfPolygonVertices(); ++i) {
            float u = 0.0f, v = 0.0f, x = 0.0f, y = 0.0f, z = 0.0f;
            mesh.getUV(i, u, v);
            mesh.getNormal(i, x, y, z);
            add(mesh.getPointIndex(i));
            add(static_cast<double>(u) + 2.0 * static_cast<double>(v) + static_cast<double>(x + y + z));
        }
    }
    std::vector<double> take() { return std::move(mNumbers); }

private:
    std::vector<double> mNumbers;
};

/// Of an unlimited call: a call that gets less may report it by another one.
std::vector<std::string>& usualWarnings() {
    static std::vector<std::string> warnings;
    return warnings;
}

void failUnlessTold(bool result) {
    if (!result && lastError().empty())
        ADD_FAILURE() << "a failure without a reason";
}

/// Objects of one kind, read while allocations may fail, and accessed when they do not any more.
template <class Object>
Answer read(bool (Fbx::*reader)(TnFbxReadInfo&, Object**, int&) const, TnFbxReadInfo& info) {
    Object* objects = nullptr;
    int count = 0;
    bool result = false;
    bool hadMemory = true;
    try {
        result = (Fbx().*reader)(info, &objects, count);
    } catch (const std::bad_alloc&) {
        hadMemory = false;
    }
    faults::failNoAllocation();
    const std::unique_ptr<Object[]> owner(objects);
    EXPECT_TRUE(objects == nullptr || count > 0);
    if (hadMemory)
        failUnlessTold(result);
    Numbers numbers;
    for (int i = 0; objects != nullptr && i < count; ++i) { // whatever the result, they can be accessed
        numbers.addChannels(objects[i]);
        if constexpr (std::is_same_v<Object, TnFbxMesh>)
            numbers.addMesh(objects[i]);
    }
    return result && lastWarnings() == usualWarnings() ? Answer(numbers.take()) : std::nullopt;
}

/// Runs the work once without failures, and then with failing allocations.
void tryPositions(const std::function<Answer()>& work) {
    static_cast<void>(work()); // what is created once and kept exists by now
    usualWarnings() = lastWarnings();
    static_cast<void>(faults::countAllocations());
    const Answer expected = work();
    const long all = faults::countAllocations();
    ASSERT_TRUE(expected) << lastError();
    for (long position = 0; position < all; ++position) {
        for (const bool andAllBehind : {false, true}) {
            faults::failAllocation(position, andAllBehind);
            const Answer answer = work();
            faults::failNoAllocation();
            if (answer) {
                EXPECT_TRUE(*answer == *expected)
                    << "less, with success, when allocation " << position << " of " << all << " fails";
            }
        }
    }
}

std::string fidelityName(EFbxFidelity fidelity) { return fidelity == kFbxFidelityFaithful ? "Faithful" : "Compatible"; }

class ReadingWithoutMemory : public testing::TestWithParam<std::tuple<const char*, EFbxFidelity>> {};

TEST_P(ReadingWithoutMemory, GivesAllOrFails) {
    const auto [file, fidelity] = GetParam();
    TnFbxReadInfo info;
    info.setFileName(std::string(TARNELL_TEST_DATA) + "/" + file);
    info.setFidelity(fidelity);
    if (fidelity == kFbxFidelityCompatible)
        info.setAnimationStackName("Take 001");
    tryPositions([&] { return read(&Fbx::getMeshes, info); });
    tryPositions([&] { return read(&Fbx::getCameras, info); });
    tryPositions([&] { return read(&Fbx::getTransforms, info); });
}

INSTANTIATE_TEST_SUITE_P(
    Files, ReadingWithoutMemory,
    testing::Combine(testing::Values("blender/layers_7400_binary.fbx", "blender/skin_7400_binary.fbx",
                                     "container/handmade_values_3000_binary.fbx", "sdk/camera_5800_ascii.fbx",
                                     "sdk/skin_5800_ascii.fbx", "sdk/blend_shape_6100_ascii.fbx",
                                     "sdk/layers_7400_ascii.fbx", "sdk/nurbs_7400_ascii.fbx",
                                     "sdk/caches_7400_ascii.fbx", "sdk/rig_7400_ascii.fbx", "tool/moving_triangle.fbx"),
                     testing::Values(kFbxFidelityCompatible, kFbxFidelityFaithful)),
    [](const auto& param) {
        std::string name = std::get<0>(param.param);
        std::replace_if(
            name.begin(), name.end(), [](char c) { return c == '/' || c == '.'; }, '_');
        return name + "_" + fidelityName(std::get<1>(param.param));
    });

/// Instances of one mesh, some of them placed alike and some not.
constexpr char kInstances[] = "; FBX 7.4.0 project file\nFBXHeaderExtension: {\nFBXVersion: 7400\n}\nObjects: {\n"
                              "Geometry: 10, \"Geometry::\", \"Mesh\" {\nVertices: *9 {\na: 0,0,0,1,0,0,0,1,0\n}\n"
                              "PolygonVertexIndex: *3 {\na: 0,1,-3\n}\n}\n"
                              "Model: 1, \"Model::a\", \"Mesh\" {\n}\nModel: 2, \"Model::b\", \"Mesh\" {\n}\n"
                              "Model: 3, \"Model::c\", \"Mesh\" {\nProperties70: {\n"
                              "P: \"Lcl Translation\", \"Lcl Translation\", \"\", \"A\",5,0,0\n}\n}\n}\n"
                              "Connections: {\nC: \"OO\",1,0\nC: \"OO\",2,0\nC: \"OO\",3,0\n"
                              "C: \"OO\",10,1\nC: \"OO\",10,2\nC: \"OO\",10,3\n}\n";

class ReadingInstancesWithoutMemory : public testing::TestWithParam<EFbxFidelity> {};

TEST_P(ReadingInstancesWithoutMemory, GivesAllOrFails) {
    const support::TemporaryFolder folder;
    TnFbxReadInfo info;
    info.setFileName(folder.write("instances.fbx", kInstances));
    info.setFidelity(GetParam());
    info.setTransformPoints(true);
    if (GetParam() == kFbxFidelityCompatible)
        info.setAnimationStackName("Take 001");
    tryPositions([&] { return read(&Fbx::getMeshes, info); });
}

INSTANTIATE_TEST_SUITE_P(BothFidelities, ReadingInstancesWithoutMemory,
                         testing::Values(kFbxFidelityCompatible, kFbxFidelityFaithful),
                         [](const auto& param) { return fidelityName(param.param); });

/// Allocations that other threads make are counted in the order in which they happen to come.
class ReadingOnThreadsWithoutMemory : public testing::TestWithParam<bool> {
protected:
    ReadingOnThreadsWithoutMemory() { setMaximumThreads(3); }
    ~ReadingOnThreadsWithoutMemory() override { setMaximumThreads(1); }
};

TEST_P(ReadingOnThreadsWithoutMemory, GivesAllOrFails) {
    const support::TemporaryFolder folder;
    TnFbxReadInfo info;
    info.setFileName(folder.file("strip.fbx"));
    info.setAnimationStackName("Take 001");
    info.setTransformPoints(false);
    const bool ascii = GetParam(); // where every mesh is parsed again for every allocation: one will do
    const std::vector<int> lengths =
        ascii ? std::vector<int>{test::kLongStrip} : std::vector<int>{test::kLongStrip, 2000, 2000};
    test::writeStrips(info.getFileName(), lengths, ascii);
    tryPositions([&] { return read(&Fbx::getMeshes, info); });
}

INSTANTIATE_TEST_SUITE_P(Encodings, ReadingOnThreadsWithoutMemory, testing::Bool(),
                         [](const auto& param) { return std::string(param.param ? "Ascii" : "Binary"); });

class WritingWithoutMemory : public testing::TestWithParam<std::tuple<int, EFbxFidelity>> {};

TEST_P(WritingWithoutMemory, WritesAllOrFails) {
    const auto [version, fidelity] = GetParam();
    const support::TemporaryFolder folder;
    const auto mesh = test::polygonMesh("box", 5);
    TnFbxCamera camera;
    camera.setName("camera");
    TnFbxTime frames;
    frames.setStartFrame(1);
    frames.setEndFrame(3);
    camera.setTransformValueAt(TnFbxTransform::kFbxTransformRotationY, frames, {10.0f, 20.0f, 40.0f});
    camera.setValueAt(TnFbxCamera::kFbxCameraFocalLength, frames, {35.0f, 50.0f, 35.0f});
    TnFbxLight light;
    light.setName("camera"); // a name that occurs twice
    TnFbxWriteInfo info;
    info.setFileName(folder.file("shot.fbx"));
    info.setAnimationStackName("Take 001");
    info.setFidelity(fidelity);
    info.setFileFormat(version % 2 == 0);
    info.setAnimateMeshVertices(false);
    info.setCompatibilityVersion(static_cast<TnFbxWriteInfo::eCompatibilityVersion>(version));
    setenv("SOURCE_DATE_EPOCH", "1000000000", 1); // equal scenes give equal files
    const auto content = [&] { return static_cast<double>(std::hash<std::string>()(folder.read("shot.fbx"))); };
    tryPositions([&]() -> Answer {
        bool result = false;
        bool hadMemory = true;
        try {
            result = Fbx().writeFile(info, {&camera}, {&light}, {}, {}, {mesh.get()});
        } catch (const std::bad_alloc&) {
            hadMemory = false;
        }
        faults::failNoAllocation();
        if (hadMemory)
            failUnlessTold(result);
        EXPECT_EQ(testing::PrintToString(folder.files()), R"({ "shot.fbx" })");
        return result && lastWarnings() == usualWarnings() ? Answer(std::vector<double>{content()}) : std::nullopt;
    });
}

INSTANTIATE_TEST_SUITE_P(Versions, WritingWithoutMemory,
                         testing::Combine(testing::Range(0, 6),
                                          testing::Values(kFbxFidelityCompatible, kFbxFidelityFaithful)),
                         [](const auto& param) {
                             return std::to_string(std::get<0>(param.param)) + "_" +
                                    fidelityName(std::get<1>(param.param));
                         });

} // namespace
} // namespace Tarnell::Fbx
