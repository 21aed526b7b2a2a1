// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Damaged and hostile files through the facade: a false result with a reason, or objects; memory in proportion to the
// file's size.
#include <filesystem>
#include <fstream>
#include <memory>
#include <random>
#include <string>
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
#include "support/TemporaryFolder.h"

namespace Tarnell::Fbx {
namespace {

template <class Object>
void read(bool (Fbx::*reader)(TnFbxReadInfo&, Object**, int&) const, TnFbxReadInfo& info) {
    Object* objects = nullptr;
    int count = -1;
    const bool result = (Fbx().*reader)(info, &objects, count);
    const std::unique_ptr<Object[]> owner(objects);
    EXPECT_TRUE(result || !lastError().empty());
    EXPECT_EQ(objects == nullptr, count == 0);
}

void readEverything(const std::string& file, bool global) {
    TnFbxReadInfo info;
    info.setFileName(file);
    info.setAnimationStackName("Take 001");
    info.setGlobalTransform(global);
    info.setComputeCameraRotation(!global);
    read(&Fbx::getMeshes, info);
    read(&Fbx::getCameras, info);
    read(&Fbx::getLights, info);
    read(&Fbx::getMarkers, info);
    read(&Fbx::getNulls, info);
    read(&Fbx::getTransforms, info);
    float start = 0.0f, end = 0.0f;
    (void)Fbx().getAnimationFrameRange(file.c_str(), start, end);
}

std::vector<std::filesystem::path> ownFiles() {
    std::vector<std::filesystem::path> files;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(TARNELL_TEST_DATA))
        if (entry.path().extension() == ".fbx")
            files.push_back(entry.path());
    return files;
}

std::string bytesOf(const std::filesystem::path& path) {
    std::ifstream in(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

} // namespace

TEST(HostileFile, GivesObjectsOrAReasonWhereverItIsCutOff) {
    const support::TemporaryFolder folder;
    constexpr std::size_t kCuts = 40;
    for (const auto& path : ownFiles()) {
        const std::string whole = bytesOf(path);
        for (std::size_t i = 0; i <= kCuts; ++i)
            readEverything(folder.write("cut.fbx", whole.substr(0, whole.size() * i / kCuts)), i % 2 == 0);
    }
}

TEST(HostileFile, GivesObjectsOrAReasonWhateverByteIsChanged) {
    const support::TemporaryFolder folder;
    std::mt19937 random(11); // a fixed seed is intended
    for (const auto& path : ownFiles()) {
        const std::string whole = bytesOf(path);
        for (int round = 0; round < 60 && !whole.empty(); ++round) {
            std::string damaged = whole;
            for (int i = 0; i < 3; ++i)
                damaged[random() % damaged.size()] = static_cast<char>(random());
            readEverything(folder.write("damaged.fbx", damaged), round % 2 == 0);
        }
    }
}

TEST(HostileFile, ClaimsOfAnEndlessAnimationCostNoMemory) {
    std::string objects, connections;
    for (int id = 100; id < 140; ++id) {
        const std::string number = std::to_string(id);
        objects += "Model: " + number + ", \"Model::n" + number + "\", \"Null\" { }\n";
        connections += "C: \"OO\"," + number + ",0\n";
    }
    const support::TemporaryFolder folder;
    // 46 186 158 000 ticks are a second: this span has ten million frames.
    const std::string file = folder.write(
        "endless.fbx", "; FBX 7.4.0 project file\nGlobalSettings: { Properties70: {\n"
                       "P: \"TimeMode\", \"enum\", \"\", \"\",11 } }\nObjects: {\n" +
                           objects +
                           "AnimationStack: 1, \"AnimStack::Take 001\", \"\" { Properties70: {\n"
                           "P: \"LocalStop\", \"KTime\", \"Time\", \"\",19244232500000000 } }\n}\nConnections: {\n" +
                           connections + "}\n");
    TnFbxReadInfo info;
    info.setFileName(file);
    info.setAnimationStackName("Take 001");

    TnFbxNull* nulls = nullptr;
    int count = 0;
    ASSERT_TRUE(Fbx().getNulls(info, &nulls, count)) << lastError();
    const std::unique_ptr<TnFbxNull[]> owner(nulls);

    ASSERT_EQ(count, 40);
    for (int i = 0; i < count; ++i) {
        const TnFbxChannel& channel = *nulls[i].getTransformChannel(TnFbxTransform::kFbxTransformPositionX);
        EXPECT_EQ(channel.getTime().getEndFrame(), 10'000'000);
        EXPECT_TRUE(channel.isConstant());
        EXPECT_EQ(nulls[i].getTransformValue(TnFbxTransform::kFbxTransformScaleX), 1.0f);
    }
}

} // namespace Tarnell::Fbx
