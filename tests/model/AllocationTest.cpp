// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What the value classes allocate, and their state when an allocation fails.
//
// The allocation functions of this executable are replaced by ones that count, and that refuse what is larger than a
// limit, so that a gap of billions of frames can be requested on any machine.
#include "TnFbxCamera.h"
#include "TnFbxMesh.h"

#include "TransformOwner.h"

#include <cstddef>
#include <cstdlib>
#include <limits>
#include <new>
#include <vector>

namespace {

std::size_t gAllocationLimit = std::numeric_limits<std::size_t>::max();
std::size_t gAllocationCount = 0;

void* allocate(std::size_t size) noexcept {
    ++gAllocationCount;
    return size <= gAllocationLimit ? std::malloc(size != 0 ? size : 1) : nullptr;
}

void* allocateOrThrow(std::size_t size) {
    if (void* memory = allocate(size))
        return memory;
    throw std::bad_alloc();
}

} // namespace

void* operator new(std::size_t size) { return allocateOrThrow(size); }
void* operator new[](std::size_t size) { return allocateOrThrow(size); }
void* operator new(std::size_t size, const std::nothrow_t&) noexcept { return allocate(size); }
void* operator new[](std::size_t size, const std::nothrow_t&) noexcept { return allocate(size); }
void operator delete(void* memory) noexcept { std::free(memory); }
void operator delete[](void* memory) noexcept { std::free(memory); }
void operator delete(void* memory, std::size_t) noexcept { std::free(memory); }
void operator delete[](void* memory, std::size_t) noexcept { std::free(memory); }
void operator delete(void* memory, const std::nothrow_t&) noexcept { std::free(memory); }
void operator delete[](void* memory, const std::nothrow_t&) noexcept { std::free(memory); }

namespace Tarnell::Fbx {
namespace {

using test::channelOver;
using test::expectTime;
using test::kInfinity;
using test::kNaN;
using test::range;
using test::samplesOf;
using Samples = std::vector<float>;

/// Refuses allocations above a limit for its lifetime.
class AllocationLimit {
public:
    explicit AllocationLimit(std::size_t bytes) { gAllocationLimit = bytes; }
    ~AllocationLimit() { gAllocationLimit = std::numeric_limits<std::size_t>::max(); }
    AllocationLimit(const AllocationLimit&) = delete;
    AllocationLimit& operator=(const AllocationLimit&) = delete;
};

constexpr std::size_t kSixteenMegabytes = std::size_t{16} << 20;

template <typename Work>
std::size_t allocationsOf(Work work) {
    const std::size_t before = gAllocationCount;
    work();
    return gAllocationCount - before;
}

TEST(Allocation, AGapWithoutMemoryThrowsAndLeavesTheChannelAsItWas) {
    TnFbxChannel channel = channelOver(10, {1.0f, 2.0f});
    const AllocationLimit limit(kSixteenMegabytes);

    for (const float farFrame : {2e7f, -2e7f}) {
        SCOPED_TRACE(farFrame);
        EXPECT_THROW(channel.setValueAt(farFrame, 5.0f), std::bad_alloc);
        EXPECT_TRUE(channel.getAnimated());
        expectTime(channel.getTime(), 0.0f, 10, 11, 24.0f);
        EXPECT_EQ(samplesOf(channel), (Samples{1.0f, 2.0f}));
    }
}

TEST(Allocation, AnImplausibleGapIsRefusedBeforeMemoryIsAllocated) {
    TnFbxChannel channel = channelOver(10, {1.0f, 2.0f});
    const float beyond = static_cast<float>(TnFbxChannel::kMostAddedSamples) + 100.0f;

    for (const float farFrame : {beyond, -beyond, 1e9f, -1e9f, kInfinity, -kInfinity, kNaN}) {
        SCOPED_TRACE(farFrame);
        EXPECT_EQ(allocationsOf([&] { EXPECT_FALSE(channel.setValueAt(farFrame, 5.0f)); }), 0u);
        EXPECT_TRUE(channel.getAnimated());
        expectTime(channel.getTime(), 0.0f, 10, 11, 24.0f);
        EXPECT_EQ(samplesOf(channel), (Samples{1.0f, 2.0f}));
    }
}

TEST(Allocation, TheWidestGapOfAllIsRefused) {
    TnFbxChannel channel;
    ASSERT_TRUE(channel.setValueAt(-kInfinity, 1.0f));

    EXPECT_FALSE(channel.setValueAt(kInfinity, 2.0f));

    EXPECT_EQ(channel.getTime().getStartFrame(), test::kLowest);
    EXPECT_EQ(channel.getTime().getEndFrame(), test::kLowest);
    EXPECT_EQ(channel.getAnimatedValue(0.0f), 1.0f);
}

TEST(Allocation, AConstantChannelTakesTheMemoryOfOneSample) {
    const AllocationLimit limit(kSixteenMegabytes);
    TnFbxChannel channel;

    ASSERT_TRUE(channel.setConstantValues(range(test::kLowest, test::kHighest), 2.5f));

    EXPECT_TRUE(channel.isConstant());
    EXPECT_EQ(channel.getAnimatedValue(-2e9f), 2.5f);
    EXPECT_EQ(channel.getAnimatedValue(0.5f), 2.5f);
    const TnFbxChannel copy = channel;
    EXPECT_EQ(copy.getAnimatedValue(2e9f), 2.5f);
    TnFbxChannel assigned;
    assigned = channel;
    EXPECT_EQ(assigned.getAnimatedValue(2e9f), 2.5f);

    EXPECT_TRUE(channel.setValueAt(7.0f, 2.5f));  // nothing changes
    EXPECT_FALSE(channel.setValueAt(7.0f, 3.0f)); // 2^32 samples would have to be stored
    EXPECT_EQ(channel.getAnimatedValue(7.0f), 2.5f);
    EXPECT_TRUE(channel.isConstant());
}

TEST(Allocation, AGapThatFitsIsFilled) {
    TnFbxChannel channel;
    channel.setValueAt(0.0f, 1.0f);

    channel.setValueAt(1e6f, 2.0f);

    EXPECT_EQ(channel.getTime().getEndFrame(), 1000000);
    EXPECT_EQ(channel.getAnimatedValue(0.0f), 1.0f);
    EXPECT_EQ(channel.getAnimatedValue(500000.0f), 0.0f);
    EXPECT_EQ(channel.getAnimatedValue(1e6f), 2.0f);
}

TEST(Allocation, ClearingAChannelKeepsItsMemoryForTheNextSamples) {
    Samples values(1000, 1.0f);
    values.back() = 2.0f;
    TnFbxChannel channel;
    channel.setAnimatedValues(range(1, 1000), values);

    EXPECT_EQ(allocationsOf([&] {
                  channel.initChannel();
                  channel.setAnimatedValues(range(1, 1000), values);
                  channel.deleteAnimatedValues();
                  channel.setValueAt(1000.0f, 1.0f);
                  channel.setValueAt(1.0f, 1.0f);
                  channel.deleteChannel();
                  channel.setAnimatedValues(range(1, 1000), values);
              }),
              0u);
}

TEST(Allocation, KeyingFrameByFrameGrowsGeometrically) {
    TnFbxChannel channel;

    const std::size_t allocations = allocationsOf([&] {
        for (int frame = 0; frame < 1024; ++frame)
            channel.setValueAt(static_cast<float>(frame), 1.0f);
    });

    EXPECT_EQ(allocations, 11u); // 1, 2, 4, … 1024 samples
}

TEST(Allocation, TheLookAtConversionAllocatesNothing) {
    TnFbxCamera camera;
    camera.setValueAt(TnFbxCamera::kFbxCameraRoll, range(1, 2), {1.0f, 2.0f});
    float x = 0.0f;
    float y = 0.0f;
    float z = 0.0f;

    EXPECT_EQ(allocationsOf([&] { camera.calculateCameraRotationAt(x, y, z, 1.5f); }), 0u);
}

TEST(Allocation, ClearingAMeshKeepsItsMemory) {
    TnFbxMesh mesh;
    mesh.allocateGeometryData(100, 100, 300);

    EXPECT_EQ(allocationsOf([&] {
                  mesh.initMesh();
                  mesh.allocateGeometryData(100, 100, 300);
                  mesh.deleteMesh();
                  mesh.allocateGeometryData(50, 60, 200);
              }),
              0u);
}

TEST(Allocation, CopiesOfAMeshShareItsArraysUntilOneIsChanged) {
    TnFbxMesh mesh;
    mesh.allocateGeometryData(100, 100, 300);
    TnFbxMesh copy;

    EXPECT_EQ(allocationsOf([&] { copy = mesh; }), 0u);
    EXPECT_EQ(allocationsOf([&] { copy.setValidNormals(true); }), 0u);
    EXPECT_EQ(allocationsOf([&] { copy.setControlPoint(0, 1.0f, 2.0f, 3.0f); }), 2u) << "one array alone";
    EXPECT_EQ(allocationsOf([&] { copy.setControlPoint(1, 1.0f, 2.0f, 3.0f); }), 0u) << "which is its own now";
    mesh.deleteMesh();
    EXPECT_EQ(allocationsOf([&] { copy.setNormal(0, 1.0f, 2.0f, 3.0f); }), 0u) << "that nobody else has any more";
}

TEST(Allocation, AChangeOfASharedArrayWithoutMemoryThrowsAndChangesNothing) {
    TnFbxMesh mesh;
    mesh.allocateGeometryData(1, 2000000, 3);
    mesh.setControlPoint(5, 1.0f, 2.0f, 3.0f);
    TnFbxMesh copy(mesh);
    const AllocationLimit limit(kSixteenMegabytes);

    EXPECT_THROW(copy.setControlPoint(5, 0.0f, 0.0f, 0.0f), std::bad_alloc);
    EXPECT_THROW(copy.addControlPoint(0.0f, 0.0f, 0.0f), std::bad_alloc);

    EXPECT_EQ(copy.getNumberOfControlPoints(), 2000000);
    for (const TnFbxMesh* each : {&mesh, &copy}) {
        float x = 0.0f, y = 0.0f, z = 0.0f;
        ASSERT_TRUE(each->getControlPoint(5, x, y, z));
        EXPECT_EQ(z, 3.0f);
        EXPECT_FALSE(each->getControlPoint(2000000, x, y, z));
    }
}

TEST(Allocation, AMeshWithoutMemoryThrowsAndIsEmpty) {
    TnFbxMesh mesh;
    mesh.allocateGeometryData(2, 4, 6);
    const AllocationLimit limit(kSixteenMegabytes);

    // one array after the other is the first that does not fit
    const struct {
        int polygons, controlPoints, polygonVertices;
    } tooLarge[] = {{test::kHighest, 1, 1}, {1, test::kHighest, 1}, {1, 1, test::kHighest}, {1, 1, 1200000}};
    for (const auto& [polygons, controlPoints, polygonVertices] : tooLarge) {
        EXPECT_THROW(mesh.allocateGeometryData(polygons, controlPoints, polygonVertices), std::bad_alloc);
        EXPECT_EQ(mesh.getNumberOfPolygons(), 0);
        EXPECT_EQ(mesh.getNumberOfPolygonVertices(), 0);
        EXPECT_EQ(mesh.getNumberOfControlPoints(), 0);
        EXPECT_EQ(mesh.getNumberOfControlPointSets(), 0);
        EXPECT_EQ(mesh.getPolygonVertexSize(0), -1);
    }
}

TEST(Allocation, AMeshIsAssignedWithoutMemory) {
    TnFbxMesh source;
    source.allocateGeometryData(1, 1, 1200000);
    TnFbxMesh target;
    target.allocateGeometryData(2, 4, 6);
    const AllocationLimit limit(0);

    target = source;

    EXPECT_EQ(target.getNumberOfControlPoints(), 1);
    EXPECT_EQ(target.getNumberOfPolygonVertices(), 1200000);
}

} // namespace
} // namespace Tarnell::Fbx
