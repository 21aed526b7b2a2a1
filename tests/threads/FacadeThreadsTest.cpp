// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Concurrent reads and writes of hosts, each with objects of its own.
#include "support/FacadeReads.h"
#include "support/SceneBuilders.h"
#include "support/StripMesh.h"
#include "support/TemporaryFolder.h"
#include "support/WritingBuilders.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <fstream>
#include <iterator>
#include <memory>
#include <set>
#include <string>
#include <thread>
#include <vector>

namespace Tarnell::Fbx {
namespace {

using support::TemporaryFolder;
using test::FacadeRead;
using test::samplesOf;
using test::timeOf;
using testing::ElementsAre;

constexpr int kThreads = 3;
constexpr int kRounds = 5;

template <class Work>
void onAllThreads(const Work& work) {
    std::vector<std::thread> threads;
    for (int i = 0; i < kThreads; ++i)
        threads.emplace_back([&work, i] { work(i); });
    for (std::thread& thread : threads)
        thread.join();
}

std::string dataFile(const char* name) { return std::string(TARNELL_TEST_DATA "/sdk/") + name; }

TEST(FacadeThreads, ReadTheSameFilesAtTheSameTime) {
    onAllThreads([](int) {
        for (int round = 0; round < kRounds; ++round) {
            FacadeRead<TnFbxCamera> cameras(dataFile("camera_7400_ascii.fbx"));
            ASSERT_EQ(cameras.count, 8);
            EXPECT_EQ(samplesOf(cameras.objects[7], TnFbxTransform::kFbxTransformPositionX).size(), 10U);
            EXPECT_EQ(FacadeRead<TnFbxLight>(dataFile("lights_7400_ascii.fbx")).count, 4);
            EXPECT_EQ(FacadeRead<TnFbxMesh>(dataFile("mesh_7400_ascii.fbx")).count, 1);
            EXPECT_EQ(FacadeRead<TnFbxMesh>(dataFile("nurbs_7400_ascii.fbx")).count, 1);
        }
    });
}

TEST(FacadeThreads, WriteFilesOfTheirOwnAtTheSameTime) {
    const TemporaryFolder folder;
    onAllThreads([&folder](int thread) {
        const std::string name = "object" + std::to_string(thread);
        TnFbxNull null;
        null.setName(name);
        null.setTransformValueAt(TnFbxTransform::kFbxTransformPositionX, timeOf(1, 2), {1.0f, 2.0f});
        const auto mesh = test::movingMesh(name + " waving", 2);
        TnFbxWriteInfo info;
        info.setFileName(folder.file(name + ".fbx"));
        info.setAnimationStackName("walk");
        info.setFPS(thread == 0 ? 24.0f : 60.0f); // rates are set per thread
        info.setStartFrame(1);
        info.setEndFrame(2);
        for (int round = 0; round < kRounds; ++round)
            EXPECT_TRUE(Fbx().writeFile(info, {}, {}, {}, {&null}, {mesh.get()})) << lastError();
    });

    for (int i = 0; i < kThreads; ++i) {
        const std::string name = "object" + std::to_string(i);
        EXPECT_THAT(FacadeRead<TnFbxNull>(folder.file(name + ".fbx")).names(), ElementsAre(name));
        EXPECT_THAT(FacadeRead<TnFbxMesh>(folder.file(name + ".fbx")).names(), ElementsAre(name + " waving"));
    }
}

struct ThreadsScope {
    explicit ThreadsScope(int count) { setMaximumThreads(count); }
    ThreadsScope(const ThreadsScope&) = delete;
    ThreadsScope& operator=(const ThreadsScope&) = delete;
    ~ThreadsScope() { setMaximumThreads(1); }
};

TEST(FacadeThreads, WorkOnTheCallersThreadByDefault) {
    EXPECT_EQ(maximumThreads(), 1);
    const ThreadsScope threads(3);
    EXPECT_EQ(maximumThreads(), 3);
    setMaximumThreads(0);
    EXPECT_EQ(maximumThreads(), static_cast<int>(std::max(1U, std::thread::hardware_concurrency())));
}

/// What a read gives, or fails for, to the bit.
std::string meshesOf(const std::string& fileName, EFbxFidelity fidelity = kFbxFidelityCompatible) {
    TnFbxReadInfo info = test::localRead(fileName);
    info.setFidelity(fidelity);
    info.setAnimationStackName("Take 001");
    TnFbxMesh* meshes = nullptr;
    int count = 0;
    const bool read = Fbx().getMeshes(info, &meshes, count);
    const std::unique_ptr<TnFbxMesh[]> owner(meshes);
    std::string answer = (read ? "read " : "failed ") + lastError();
    for (const std::string& warning : lastWarnings())
        answer += "; " + warning;
    const auto add = [&answer](auto... numbers) {
        for (const float number : {static_cast<float>(numbers)...})
            answer.append(static_cast<const char*>(static_cast<const void*>(&number)), sizeof(number));
    };
    for (int i = 0; meshes != nullptr && i < count; ++i) {
        const TnFbxMesh& mesh = meshes[i];
        float x = 0.0f, y = 0.0f, z = 0.0f, w = 0.0f;
        for (int point = 0; point < mesh.getNumberOfControlPoints(); ++point) {
            mesh.getControlPoint(point, x, y, z);
            add(x, y, z);
        }
        for (int at = 0; at < mesh.getNumberOfPolygonVertices(); ++at) {
            mesh.getNormal(at, x, y, z);
            add(mesh.getPointIndex(at), x, y, z);
            mesh.getUV(at, x, y);
            mesh.getColour(at, x, y, z, w);
            add(x, y, z, w);
        }
        add(mesh.getValidNormals(), mesh.getValidUVs(), mesh.getValidColours());
    }
    return answer;
}

std::string contentOf(const std::string& fileName) {
    std::ifstream file(fileName, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

class FacadeReads : public testing::TestWithParam<bool> {
protected:
    // Of the third mesh on, arrays are inflated before it is its turn.
    FacadeReads() { test::writeStrips(mFile, {test::kLongStrip, 200, 5000, 3, test::kLongStrip, 4000}, GetParam()); }
    ~FacadeReads() override { setMaximumThreads(1); }

    TemporaryFolder mFolder;
    std::string mFile = mFolder.file("strip.fbx");
};

TEST_P(FacadeReads, GiveTheSameForAnyNumberOfThreads) {
    for (const EFbxFidelity fidelity : {kFbxFidelityCompatible, kFbxFidelityFaithful}) {
        setMaximumThreads(1);
        const std::string alone = meshesOf(mFile, fidelity);
        EXPECT_GT(alone.size(), std::size_t{4 * test::kLongStrip}) << alone;
        for (const int threads : {2, 8}) {
            setMaximumThreads(threads);
            EXPECT_TRUE(meshesOf(mFile, fidelity) == alone) << threads;
        }
    }
}

TEST_P(FacadeReads, GiveTheSameAtTheSameTime) {
    const std::string alone = meshesOf(mFile);
    setMaximumThreads(3);
    onAllThreads([&](int) {
        for (int round = 0; round < 2; ++round)
            EXPECT_TRUE(meshesOf(mFile) == alone);
    });
}

TEST_P(FacadeReads, MeetTheSameFaultsInADamagedFile) {
    const std::string sound = contentOf(mFile);
    std::set<std::string> answers;
    for (const std::size_t tenth : {2U, 4U, 6U, 8U}) {
        std::string bytes = sound;
        bytes.replace(sound.size() / 10 * tenth, 8, "\"x,,.-e:");
        const std::string damaged = mFolder.write("damaged.fbx", bytes);
        setMaximumThreads(1);
        const std::string alone = meshesOf(damaged);
        answers.insert(alone);
        setMaximumThreads(3);
        EXPECT_TRUE(meshesOf(damaged) == alone);
    }
    EXPECT_GT(answers.size(), 1U);
    EXPECT_EQ(answers.count(meshesOf(mFile)), 0U);
}

INSTANTIATE_TEST_SUITE_P(Encodings, FacadeReads, testing::Bool(),
                         [](const auto& suite) { return std::string(suite.param ? "Ascii" : "Binary"); });

TEST(FacadeThreads, WriteTheArraysOfALargeMeshAtTheSameTime) {
    constexpr int kSquares = 20'000;
    const TemporaryFolder folder;
    test::writeStrips(folder.file("alone.fbx"), {kSquares}, /*ascii*/ false);
    const ThreadsScope threads(3);
    test::writeStrips(folder.file("together.fbx"), {kSquares}, /*ascii*/ false);
    TnFbxMesh mesh;
    test::fillStrip(mesh, kSquares);

    FacadeRead<TnFbxMesh> meshes(folder.file("together.fbx"));
    const TnFbxMesh& back = meshes["strip"];
    ASSERT_EQ(back.getNumberOfPolygonVertices(), 4 * kSquares);
    for (int at = 0; at < 4 * kSquares; ++at) {
        float x = 0.0f, y = 0.0f, z = 0.0f, w = 0.0f, wanted = 0.0f;
        ASSERT_EQ(back.getPointIndex(at), mesh.getPointIndex(at));
        ASSERT_TRUE(mesh.getNormal(at, wanted, y, z));
        ASSERT_TRUE(back.getNormal(at, x, y, z));
        ASSERT_EQ(x, wanted);
        ASSERT_TRUE(back.getUV(at, x, y));
        ASSERT_EQ(x, static_cast<float>(at / 4));
        ASSERT_EQ(y, static_cast<float>(at % 4));
        ASSERT_TRUE(back.getColour(at, x, y, z, w));
        ASSERT_EQ(y, 0.5f);
    }
    EXPECT_EQ(meshesOf(folder.file("together.fbx")), meshesOf(folder.file("alone.fbx")));
}

TEST(FacadeThreads, ChangeCopiesOfOneMesh) {
    TnFbxMesh mesh;
    test::fillStrip(mesh, 100);
    std::vector<TnFbxMesh> copies(kThreads, mesh);

    onAllThreads([&copies](int thread) {
        TnFbxMesh& own = copies[static_cast<std::size_t>(thread)];
        const TnFbxMesh passing(own);
        for (int i = 0; i < own.getNumberOfControlPoints(); ++i) {
            float x = 0.0f, y = 0.0f, z = 0.0f;
            EXPECT_TRUE(passing.getControlPoint(i, x, y, z));
            EXPECT_TRUE(own.setControlPoint(i, x, y, static_cast<float>(thread + 1)));
        }
    });

    for (int thread = 0; thread < kThreads; ++thread) {
        float x = 0.0f, y = 0.0f, z = 0.0f;
        ASSERT_TRUE(copies[static_cast<std::size_t>(thread)].getControlPoint(3, x, y, z));
        EXPECT_EQ(x, 1.0f);
        EXPECT_EQ(z, static_cast<float>(thread + 1));
        ASSERT_TRUE(mesh.getControlPoint(3, x, y, z));
        EXPECT_EQ(z, 0.0f);
    }
}

TEST(FacadeThreads, HaveALastErrorEach) {
    onAllThreads([](int thread) {
        const std::string missing = "missing" + std::to_string(thread) + ".fbx";
        for (int round = 0; round < kRounds; ++round) {
            TnFbxReadInfo info = test::localRead(missing);
            TnFbxNull* nulls = nullptr;
            int count = 0;
            EXPECT_FALSE(Fbx().getNulls(info, &nulls, count));
            EXPECT_THAT(lastError(), testing::HasSubstr(missing));
        }
    });
    EXPECT_EQ(lastError(), "") << "nothing failed on this thread";
}

} // namespace
} // namespace Tarnell::Fbx
