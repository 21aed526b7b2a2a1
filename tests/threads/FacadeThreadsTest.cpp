// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Concurrent reads and writes of hosts, each with objects of its own.
#include "support/FacadeReads.h"
#include "support/SceneBuilders.h"
#include "support/TemporaryFolder.h"
#include "support/WritingBuilders.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
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
    for (int i = 0; i < kThreads; ++i) {
        threads.emplace_back([&work, i] { work(i); });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
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
        for (int round = 0; round < kRounds; ++round) {
            EXPECT_TRUE(Fbx().writeFile(info, {}, {}, {}, {&null}, {mesh.get()})) << lastError();
        }
    });

    for (int i = 0; i < kThreads; ++i) {
        const std::string name = "object" + std::to_string(i);
        EXPECT_THAT(FacadeRead<TnFbxNull>(folder.file(name + ".fbx")).names(), ElementsAre(name));
        EXPECT_THAT(FacadeRead<TnFbxMesh>(folder.file(name + ".fbx")).names(), ElementsAre(name + " waving"));
    }
}

/// Squares in a row, enough of them for their arrays to be written concurrently.
void fillStrip(TnFbxMesh& mesh, int squares) {
    ASSERT_TRUE(mesh.allocateGeometryData(squares, 2 * squares + 2, 4 * squares));
    for (int i = 0; i < mesh.getNumberOfControlPoints(); ++i) {
        mesh.setControlPoint(i, static_cast<float>(i / 2), static_cast<float>(i % 2), 0.0f);
    }
    for (int square = 0; square < squares; ++square) {
        mesh.setPolygonVertexSize(square, 4);
        for (int corner = 0; corner < 4; ++corner) {
            const int at = 4 * square + corner;
            mesh.setPointIndex(at, 2 * square + (corner == 1 ? 2 : corner == 2 ? 3 : corner / 3));
            mesh.setNormal(at, 0.0f, 0.0f, 1.0f);
            mesh.setUV(at, static_cast<float>(square), static_cast<float>(corner));
            mesh.setColour(at, 0.25f, 0.5f, 0.75f, 1.0f);
        }
    }
    mesh.setValidNormals(true);
    mesh.setValidUVs(true);
    mesh.setValidColours(true);
}

struct ThreadsScope {
    explicit ThreadsScope(int count) { setMaximumThreads(count); }
    ThreadsScope(const ThreadsScope&) = delete;
    ThreadsScope& operator=(const ThreadsScope&) = delete;
    ~ThreadsScope() { setMaximumThreads(1); }
};

TEST(FacadeThreads, WorkOnTheCallersThreadUnlessToldOtherwise) {
    EXPECT_EQ(maximumThreads(), 1);
    const ThreadsScope threads(3);
    EXPECT_EQ(maximumThreads(), 3);
    setMaximumThreads(0);
    EXPECT_EQ(maximumThreads(), static_cast<int>(std::max(1U, std::thread::hardware_concurrency())));
}

TEST(FacadeThreads, WriteTheArraysOfALargeMeshAtTheSameTime) {
    constexpr int kSquares = 20'000;
    const ThreadsScope threads(3);
    const TemporaryFolder folder;
    TnFbxMesh mesh;
    mesh.setName("strip");
    fillStrip(mesh, kSquares);
    TnFbxWriteInfo info;
    info.setFileName(folder.file("strip.fbx"));
    info.setAnimationStackName("walk");
    info.setAnimateMeshVertices(false);
    EXPECT_TRUE(Fbx().writeFile(info, {}, {}, {}, {}, {&mesh})) << lastError();

    FacadeRead<TnFbxMesh> meshes(folder.file("strip.fbx"));
    const TnFbxMesh& back = meshes["strip"];
    ASSERT_EQ(back.getNumberOfPolygonVertices(), 4 * kSquares);
    for (int at = 0; at < 4 * kSquares; ++at) {
        float x = 0.0f, y = 0.0f, z = 0.0f, w = 0.0f;
        ASSERT_EQ(back.getPointIndex(at), mesh.getPointIndex(at));
        ASSERT_TRUE(back.getNormal(at, x, y, z));
        ASSERT_EQ(z, 1.0f);
        ASSERT_TRUE(back.getUV(at, x, y));
        ASSERT_EQ(x, static_cast<float>(at / 4));
        ASSERT_EQ(y, static_cast<float>(at % 4));
        ASSERT_TRUE(back.getColour(at, x, y, z, w));
        ASSERT_EQ(y, 0.5f);
    }
}

TEST(FacadeThreads, ChangeCopiesOfOneMesh) {
    TnFbxMesh mesh;
    fillStrip(mesh, 100);
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
