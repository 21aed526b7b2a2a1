// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes written faithfully: placed points, mirrors, skews, instances, layers, and caches that cannot be written. The
// points in the world are computed from the transforms by hand.
#include "FaithfulFile.h"

#include "FbxFaithful.h"
#include "TnFbxError.h"

#include <array>
#include <cmath>
#include <filesystem>
#include <fstream>
#include <limits>
#include <memory>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

namespace Tarnell::Fbx::test {
namespace {

using Transform = TnFbxTransform;
using Channel = Transform::EFbxTransformChannelType;

/// A quarter of a turn about Z, and a scale: x, y, z are at (positionX − scaleY · y, scaleX · x, scaleZ · z).
void place(Transform& object, float positionX, float scaleX, float scaleY, float scaleZ) {
    object.setTransformValue(Transform::kFbxTransformPositionX, positionX);
    object.setTransformValue(Transform::kFbxTransformRotationZ, 90.0f);
    object.setTransformValue(Transform::kFbxTransformScaleX, scaleX);
    object.setTransformValue(Transform::kFbxTransformScaleY, scaleY);
    object.setTransformValue(Transform::kFbxTransformScaleZ, scaleZ);
}

/// Samples of the frames from 1 on.
void animate(Transform& object, Channel channel, const std::vector<float>& values) {
    object.setTransformValueAt(channel, timeOf(1, values.size()), values);
}

/// A file of the frames 1 to 3.
struct ThreeFrames : FaithfulFile {
    explicit ThreeFrames(bool maya = true) {
        info.setStartFrame(1.0f);
        info.setEndFrame(3.0f);
        info.setMayaVertexCacheFormat(maya);
    }

    /// The points at a frame: in the world, or in the object's own space.
    Samples points(bool inWorld, float frame = 1.0f, const char* name = "mesh") const {
        TnFbxReadInfo read = readInfo();
        read.setTransformPoints(inWorld);
        read.setFrame(frame);
        FacadeRead<TnFbxMesh> meshes(read);
        EXPECT_EQ(lastWarnings(), std::vector<std::string>());
        return pointsOf(meshes[name]);
    }
};

/// The points of polygonMesh: (0,0,z), (1,1,z), (2,4,z).
Samples ownPoints(float z = 0.0f) { return {0.0f, 0.0f, z, 1.0f, 1.0f, z, 2.0f, 4.0f, z}; }

/// Those in the world.
Samples placedPoints(float positionX, float scaleX, float scaleY, float z) {
    return {positionX, 0.0f, z, positionX - scaleY, scaleX, z, positionX - 4.0f * scaleY, 2.0f * scaleX, z};
}

void setPoints(TnFbxMesh& mesh, int set, const Samples& points) {
    for (int i = 0; i < 3; ++i) {
        const auto at = static_cast<std::size_t>(3 * i);
        EXPECT_TRUE(mesh.setControlPoint(3 * set + i, points[at], points[at + 1], points[at + 2]));
    }
}

// ---- Points that a read has placed ----

TEST(FaithfulMeshWriting, PutsPlacedPointsBackIntoTheirSpaceAtEveryFrame) {
    for (const bool maya : {true, false}) {
        ThreeFrames file(maya);
        auto mesh = movingMesh("mesh", 3);
        place(*mesh, 10.0f, 2.0f, 3.0f, 1.0f);
        animate(*mesh, Transform::kFbxTransformPositionX, {10.0f, 20.0f, 40.0f});
        animate(*mesh, Transform::kFbxTransformScaleX, {2.0f, 4.0f, -8.0f}); // a mirror at the last frame
        const std::array<Samples, 3> placed = {placedPoints(10.0f, 2.0f, 3.0f, 0.0f),
                                               placedPoints(20.0f, 4.0f, 3.0f, 1.0f),
                                               placedPoints(40.0f, -8.0f, 3.0f, 2.0f)};
        for (int set = 0; set < 3; ++set)
            setPoints(*mesh, set, placed[static_cast<std::size_t>(set)]);
        mesh->setPointsPlaced(true);
        file.write({{}, {}, {}, {}, {mesh.get()}});
        EXPECT_EQ(file.warningText(), "");
        for (int frame = 1; frame <= 3; ++frame) {
            const auto number = static_cast<float>(frame);
            EXPECT_THAT(file.points(/*inWorld*/ false, number), isNear(ownPoints(number - 1.0f))) << frame;
            EXPECT_THAT(file.points(/*inWorld*/ true, number), isNear(placed[static_cast<std::size_t>(frame - 1)]))
                << frame;
        }
    }
}

TEST(FaithfulMeshWriting, LeavesPlacedPointsWhereTheyAreWhenTheirTransformIsFlat) {
    ThreeFrames file;
    auto mesh = polygonMesh("mesh");
    place(*mesh, 10.0f, 2.0f, 3.0f, 0.0f);
    setPoints(*mesh, 0, placedPoints(10.0f, 2.0f, 3.0f, 0.0f));
    mesh->setPointsPlaced(true);
    file.write({{}, {}, {}, {}, {mesh.get()}});
    EXPECT_NE(file.warningText().find("mesh: its points were multiplied by a transform that has no inverse"),
              std::string::npos)
        << file.warningText();
    EXPECT_THAT(file.points(/*inWorld*/ true), isNear(placedPoints(10.0f, 2.0f, 3.0f, 0.0f)));
    EXPECT_THAT(positionOf(file.read<TnFbxMesh>()["mesh"]), isNear({0.0f, 0.0f, 0.0f}));
    EXPECT_THAT(scaleOf(file.read<TnFbxMesh>()["mesh"]), isNear({1.0f, 1.0f, 1.0f}));
}

TEST(FaithfulMeshWriting, LeavesPlacedPointsWhereTheyAreWhenTheirTransformIsFlatAtALaterFrame) {
    ThreeFrames file;
    auto mesh = movingMesh("mesh", 3);
    place(*mesh, 10.0f, 2.0f, 3.0f, 1.0f);
    animate(*mesh, Transform::kFbxTransformScaleX, {2.0f, 0.0f, 2.0f});
    std::array<Samples, 3> placed;
    for (int set = 0; set < 3; ++set) {
        const auto z = static_cast<float>(set);
        placed[static_cast<std::size_t>(set)] = placedPoints(10.0f, set == 1 ? 0.0f : 2.0f, 3.0f, z);
        setPoints(*mesh, set, placed[static_cast<std::size_t>(set)]);
    }
    mesh->setPointsPlaced(true);
    file.write({{}, {}, {}, {}, {mesh.get()}});
    EXPECT_NE(file.warningText().find("has no inverse"), std::string::npos) << file.warningText();
    for (int frame = 1; frame <= 3; ++frame)
        EXPECT_THAT(file.points(/*inWorld*/ true, static_cast<float>(frame)),
                    isNear(placed[static_cast<std::size_t>(frame - 1)]));
    EXPECT_FALSE(file.read<TnFbxMesh>()["mesh"].getTransformAnimated(Transform::kFbxTransformScaleX));
}

TEST(FaithfulMeshWriting, RemovesASkewFromPlacedPoints) {
    FaithfulFile file;
    auto mesh = polygonMesh("mesh");
    place(*mesh, 10.0f, 2.0f, 3.0f, 1.0f);
    mesh->setTransformValue(Transform::kFbxTransformSkewX, 0.5f); // X gets half of 3 · y
    const Samples placed = {10.0f, 0.0f, 0.0f, 7.0f, 3.5f, 0.0f, -2.0f, 10.0f, 0.0f};
    setPoints(*mesh, 0, placed);
    mesh->setPointsPlaced(true);
    file.write({{}, {}, {}, {}, {mesh.get()}});
    EXPECT_EQ(file.warningText(), "");
    auto own = file.read<TnFbxMesh>();
    EXPECT_THAT(pointsOf(own["mesh"]), isNear(ownPoints()));
    EXPECT_NEAR(own["mesh"].getTransformValue(Transform::kFbxTransformSkewX), 0.5f, 1e-5f);
    TnFbxReadInfo world = file.readInfo();
    world.setTransformPoints(true);
    EXPECT_THAT(pointsOf(FacadeRead<TnFbxMesh>(world)["mesh"]), isNear(placed));
}

TEST(FaithfulMeshWriting, WritesPlacedPointsBelowShearingParentsWhereTheyWere) {
    TestScene scene;
    fbxsdk::FbxNode* parent = scene.addNode("parent");
    parent->LclScaling.Set(fbxsdk::FbxDouble3(3.0, 1.0, 1.0));
    fbxsdk::FbxNode* node = addTriangle(scene, "mesh");
    parent->AddChild(node);
    node->LclRotation.Set(fbxsdk::FbxDouble3(0.0, 0.0, 45.0));
    node->SetTransformationInheritType(fbxsdk::FbxTransform::eInheritRSrs);
    const auto half = static_cast<float>(std::sqrt(0.5));
    const Samples expected = {0.0f, 0.0f, 0.0f, 3.0f * half, half, 0.0f, -3.0f * half, half, 0.0f};
    auto placed = readFaithfully<TnFbxMesh>(scene);
    EXPECT_THAT(pointsOf(placed["mesh"]), isNear(expected));
    FaithfulFile file;
    file.write({{}, {}, {}, {}, {&placed["mesh"]}});
    EXPECT_EQ(file.warningText(), "");
    TnFbxReadInfo world = file.readInfo();
    world.setTransformPoints(true);
    EXPECT_THAT(pointsOf(FacadeRead<TnFbxMesh>(world)["mesh"]), isNear(expected));
    EXPECT_THAT(pointsOf(file.read<TnFbxMesh>()["mesh"]),
                isNear({0.0f, 0.0f, 0.0f, 1.0f, 0.0f, 0.0f, 0.0f, 1.0f, 0.0f}));
}

/// The values of a corner: its point, its texture coordinate and its colour are all numbered alike.
void setCorner(TnFbxMesh& mesh, int corner, int point) {
    const float number = 0.125f * static_cast<float>(point);
    mesh.setPointIndex(corner, point);
    mesh.setUV(corner, number, 1.0f - number);
    mesh.setColour(corner, number, 0.5f, 0.25f, 1.0f - number);
    mesh.setNormal(corner, 0.0f, 0.0f, point % 2 == 0 ? 1.0f : -1.0f);
}

void expectCorners(const TnFbxMesh& mesh, const std::vector<int>& points) {
    EXPECT_EQ(pointIndicesOf(mesh), points);
    for (int corner = 0; corner < mesh.getNumberOfPolygonVertices(); ++corner) {
        const int point = points[static_cast<std::size_t>(corner)];
        const float number = 0.125f * static_cast<float>(point);
        float x = 0.0f, y = 0.0f, z = 0.0f, w = 0.0f;
        EXPECT_TRUE(mesh.getUV(corner, x, y));
        EXPECT_THAT((Samples{x, y}), isNear({number, 1.0f - number})) << corner;
        EXPECT_TRUE(mesh.getColour(corner, x, y, z, w));
        EXPECT_THAT((Samples{x, y, z, w}), isNear({number, 0.5f, 0.25f, 1.0f - number})) << corner;
        EXPECT_TRUE(mesh.getNormal(corner, x, y, z));
        EXPECT_THAT((Samples{x, y, z}), isNear({0.0f, 0.0f, point % 2 == 0 ? 1.0f : -1.0f})) << corner;
    }
}

/// A triangle, a polygon without corners and a square.
TnFbxMesh threePolygons() {
    TnFbxMesh mesh;
    mesh.setName("mesh");
    mesh.allocateGeometryData(3, 5, 7);
    const int points[] = {0, 1, 2, 0, 2, 3, 4};
    const int sizes[] = {3, 0, 4};
    for (int polygon = 0; polygon < 3; ++polygon)
        mesh.setPolygonVertexSize(polygon, sizes[polygon]);
    for (int corner = 0; corner < 7; ++corner)
        setCorner(mesh, corner, points[corner]);
    for (int i = 0; i < 5; ++i)
        mesh.setControlPoint(i, static_cast<float>(i), static_cast<float>(i * i), 0.0f);
    mesh.setValidNormals(true);
    mesh.setValidUVs(true);
    mesh.setValidColours(true);
    return mesh;
}

TEST(FaithfulMeshWriting, TurnsPolygonsRoundAgainWithTheValuesOfTheirCorners) {
    FaithfulFile first, second;
    TnFbxMesh mesh = threePolygons();
    place(mesh, 10.0f, 2.0f, -3.0f, 1.0f);
    first.write({{}, {}, {}, {}, {&mesh}});
    FacadeRead<TnFbxMesh> placed(faithfulRead(first.info.getFileName()));
    expectCorners(placed["mesh"], {0, 2, 1, 0, 4, 3, 2});
    second.write({{}, {}, {}, {}, {&placed["mesh"]}});
    EXPECT_EQ(second.warningText(), "");
    auto own = second.read<TnFbxMesh>();
    expectCorners(own["mesh"], {0, 1, 2, 0, 2, 3, 4});
    EXPECT_THAT(pointsOf(own["mesh"]), isNear(pointsOf(mesh)));
    EXPECT_THAT(scaleOf(own["mesh"]), isNear({2.0f, -3.0f, 1.0f}));
}

TEST(FaithfulMeshWriting, AddsNoLayersToPlacedPoints) {
    FaithfulFile file;
    auto mesh = polygonMesh("mesh");
    place(*mesh, 10.0f, -2.0f, 3.0f, 1.0f);
    mesh->setPointsPlaced(true);
    file.write({{}, {}, {}, {}, {mesh.get()}});
    auto read = file.read<TnFbxMesh>();
    EXPECT_FALSE(read["mesh"].getValidNormals());
    EXPECT_FALSE(read["mesh"].getValidUVs());
    EXPECT_FALSE(read["mesh"].getValidColours());
}

// ---- Mirrors and instances ----

TEST(FaithfulMeshWriting, KeepsNegativeScalesOnTheirAxes) {
    for (const auto& [x, y, z] :
         {std::tuple(-2.0f, 3.0f, 1.0f), std::tuple(2.0f, -3.0f, 1.0f), std::tuple(2.0f, 3.0f, -1.0f),
          std::tuple(-2.0f, -3.0f, -1.0f), std::tuple(-2.0f, -3.0f, 1.0f)}) {
        ThreeFrames file;
        auto mesh = polygonMesh("mesh");
        place(*mesh, 10.0f, x, y, z);
        file.write({{}, {}, {}, {}, {mesh.get()}});
        auto read = file.read<TnFbxMesh>();
        EXPECT_THAT(scaleOf(read["mesh"]), isNear({x, y, z}));
        EXPECT_THAT(rotationOf(read["mesh"]), isNear({0.0f, 0.0f, 90.0f}));
        EXPECT_THAT(file.points(/*inWorld*/ true), isNear(placedPoints(10.0f, x, y, 0.0f)));
        FacadeRead<TnFbxMesh> placed(faithfulRead(file.info.getFileName()));
        EXPECT_EQ(placed["mesh"].getPointIndex(1), x * y * z < 0.0f ? 2 : 1);
    }
}

TEST(FaithfulMeshWriting, WritesPlacedInstancesWhereTheyWere) {
    ThreeFrames first, second;
    auto straight = polygonMesh("straight");
    TnFbxMesh mirrored(*straight);
    mirrored.setName("mirrored");
    place(*straight, 10.0f, 2.0f, 3.0f, 1.0f);
    place(mirrored, 20.0f, -2.0f, 3.0f, 1.0f);
    first.write({{}, {}, {}, {}, {straight.get(), &mirrored}});
    FacadeRead<TnFbxMesh> placed(faithfulRead(first.info.getFileName()));
    second.write({{}, {}, {}, {}, {&placed["straight"], &placed["mirrored"]}});
    for (const ThreeFrames* file : {&first, &second}) {
        EXPECT_EQ(file->warningText(), "");
        EXPECT_THAT(file->points(true, 1.0f, "straight"), isNear(placedPoints(10.0f, 2.0f, 3.0f, 0.0f)));
        EXPECT_THAT(file->points(true, 1.0f, "mirrored"), isNear(placedPoints(20.0f, -2.0f, 3.0f, 0.0f)));
        EXPECT_THAT(file->points(false, 1.0f, "mirrored"), isNear(ownPoints()));
        EXPECT_THAT(pointIndicesOf(file->read<TnFbxMesh>()["mirrored"]), testing::ElementsAre(0, 1, 2));
    }
}

TEST(FaithfulMeshWriting, GivesInstancesThatMoveTheirOwnMeshes) {
    ThreeFrames file;
    auto still = polygonMesh("still");
    TnFbxMesh moving(*still);
    moving.setName("moving");
    for (int set = 1; set < 3; ++set) {
        moving.addControlPointSet();
        for (int i = 0; i < 3; ++i)
            moving.addControlPoint(static_cast<float>(i), static_cast<float>(i * i), static_cast<float>(set));
    }
    file.write({{}, {}, {}, {}, {still.get(), &moving}});
    EXPECT_EQ(file.warningText(), "");
    for (int frame = 1; frame <= 3; ++frame) {
        const auto number = static_cast<float>(frame);
        EXPECT_THAT(file.points(false, number, "still"), isNear(ownPoints()));
        EXPECT_THAT(file.points(false, number, "moving"), isNear(ownPoints(number - 1.0f)));
    }
}

// ---- Empty meshes and those that cannot be written ----

TEST(FaithfulMeshWriting, KeepsPointsWithoutPolygons) {
    for (const bool placed : {false, true}) {
        FaithfulFile file;
        TestScene scene;
        fillMesh(*scene.add<fbxsdk::FbxMesh>("points")->GetMesh(), {{1.0, 2.0, 3.0}, {4.0, 5.0, 6.0}}, {});
        scene.scene->GetRootNode()->GetChild(0)->LclTranslation.Set(fbxsdk::FbxDouble3(0.0, 0.0, 10.0));
        const SavedScene saved(scene);
        TnFbxReadInfo info = saved.info();
        info.setTransformPoints(placed);
        FacadeRead<TnFbxMesh> read(info);
        file.write({{}, {}, {}, {}, {&read["points"]}});
        EXPECT_EQ(file.warningText(), "");
        auto again = file.read<TnFbxMesh>();
        EXPECT_EQ(again["points"].getNumberOfPolygons(), 0);
        EXPECT_THAT(pointsOf(again["points"]), isNear({1.0f, 2.0f, 3.0f, 4.0f, 5.0f, 6.0f}));
        EXPECT_THAT(positionOf(again["points"]), isNear({0.0f, 0.0f, 10.0f}));
    }
}

TEST(FaithfulMeshWriting, KeepsANodeForAMeshOfNothing) {
    for (const bool placed : {false, true}) {
        FaithfulFile file;
        TnFbxMesh mesh;
        mesh.setName("nothing");
        place(mesh, 10.0f, 2.0f, 3.0f, 1.0f);
        mesh.setPointsPlaced(placed);
        file.write({{}, {}, {}, {}, {&mesh}});
        auto read = file.read<TnFbxMesh>();
        EXPECT_EQ(read["nothing"].getNumberOfControlPoints(), 0);
        EXPECT_THAT(positionOf(read["nothing"]), isNear({10.0f, 0.0f, 0.0f}));
    }
}

TEST(FaithfulMeshWriting, LeavesOutAMeshWhosePolygonsClaimMoreThanItHas) {
    FaithfulFile file;
    auto mesh = polygonMesh("greedy"), sound = polygonMesh("sound");
    mesh->setPolygonVertexSize(0, 1000000);
    file.write({{}, {}, {}, {}, {mesh.get(), sound.get()}});
    EXPECT_NE(file.warningText().find("greedy: left out"), std::string::npos) << file.warningText();
    EXPECT_EQ(file.read<TnFbxMesh>().names(), std::vector<std::string>{"sound"});
}

// ---- Point caches ----

TEST(FaithfulMeshWriting, WritesTheFirstPointsWhereNoCacheIsRequested) {
    ThreeFrames file;
    file.info.setAnimateMeshVertices(false);
    auto mesh = movingMesh("mesh", 3);
    file.write({{}, {}, {}, {}, {mesh.get()}});
    EXPECT_NE(file.warningText().find("mesh: its control points are animated, but no point cache was requested"),
              std::string::npos)
        << file.warningText();
    for (const float frame : {1.0f, 3.0f})
        EXPECT_THAT(file.points(false, frame), isNear(ownPoints()));
}

std::string cacheFolder(const FaithfulFile& file) {
    return std::filesystem::path(file.info.getFileName()).replace_extension().string() + "_fpc";
}

void expectNoCache(const ThreeFrames& file) {
    EXPECT_NE(file.warningText().find("mesh: written without its animation: "), std::string::npos)
        << file.warningText();
    EXPECT_THAT(file.points(false, 3.0f), isNear(ownPoints())); // without a warning about a missing cache
    FbxFaithful reader;
    ASSERT_TRUE(reader.load(file.readInfo()));
    EXPECT_EQ(reader.getScene()->GetSrcObjectCount(fbxsdk::FbxCriteria::ObjectType(fbxsdk::FbxCache::ClassId)), 0);
}

TEST(FaithfulMeshWriting, WritesTheFirstPointsWhereTheFolderOfCachesCannotBe) {
    ThreeFrames file;
    std::ofstream(cacheFolder(file)) << "in the way";
    auto mesh = movingMesh("mesh", 3);
    file.write({{}, {}, {}, {}, {mesh.get()}});
    expectNoCache(file);
}

TEST(FaithfulMeshWriting, WritesTheFirstPointsWhereACacheHasNoPlace) {
    for (const bool maya : {true, false}) {
        ThreeFrames file(maya);
        std::filesystem::create_directories(cacheFolder(file) + (maya ? "/mesh.xml" : "/mesh.pc2") + "/in the way");
        auto mesh = movingMesh("mesh", 3);
        file.write({{}, {}, {}, {}, {mesh.get()}});
        expectNoCache(file);
    }
}

TEST(FaithfulMeshWriting, WritesTheFirstPointsWhereACacheCannotHoldTheOthers) {
    for (const bool maya : {true, false}) {
        ThreeFrames file(maya);
        auto mesh = movingMesh("mesh", 3);
        mesh->setControlPoint(5, std::numeric_limits<float>::infinity(), 0.0f, 0.0f);
        file.write({{}, {}, {}, {}, {mesh.get()}});
        expectNoCache(file);
    }
}

// ---- Layers ----

/// All that the corners of a mesh have.
Samples cornersOf(const TnFbxMesh& mesh) {
    Samples all = {mesh.getValidNormals() ? 1.0f : 0.0f, mesh.getValidUVs() ? 1.0f : 0.0f,
                   mesh.getValidColours() ? 1.0f : 0.0f};
    for (int i = 0; i < mesh.getNumberOfPolygonVertices(); ++i) {
        float x = 0.0f, y = 0.0f, z = 0.0f, w = 0.0f;
        mesh.getNormal(i, x, y, z);
        all.insert(all.end(), {static_cast<float>(mesh.getPointIndex(i)), x, y, z});
        mesh.getUV(i, x, y);
        all.insert(all.end(), {x, y});
        mesh.getColour(i, x, y, z, w);
        all.insert(all.end(), {x, y, z, w});
    }
    return all;
}

TEST(FaithfulMeshWriting, KeepsTheValuesOfCornersThatWereMappedInAnyMode) {
    for (const char* name : {"mapping_modes_7400_ascii.fbx", "materials_7400_ascii.fbx", "mesh_7400_ascii.fbx"}) {
        FacadeRead<TnFbxMesh> read(faithfulRead(fixture(name)));
        ASSERT_GT(read.count, 0);
        FaithfulFile file;
        WrittenObjects objects;
        for (int i = 0; i < read.count; ++i)
            objects.meshes.push_back(&read.objects[static_cast<std::size_t>(i)]);
        file.write(objects);
        FacadeRead<TnFbxMesh> again(faithfulRead(file.info.getFileName()));
        ASSERT_EQ(again.count, read.count);
        for (std::size_t i = 0; i < static_cast<std::size_t>(read.count); ++i) {
            EXPECT_THAT(cornersOf(again.objects[i]), isNear(cornersOf(read.objects[i])))
                << name << ", " << read.objects[i].getName();
            EXPECT_THAT(pointsOf(again.objects[i]), isNear(pointsOf(read.objects[i]))) << name;
        }
    }
}

// ---- Rates and spans ----

TEST(FaithfulMeshWriting, CountsTheFramesOfChannelsThatDoNotChange) {
    FaithfulFile file;
    TnFbxNull still, moving;
    still.setName("still");
    moving.setName("moving");
    still.setTransformValueAt(Transform::kFbxTransformPositionX, timeOf(3, 18), std::vector<float>(18, 5.0f));
    moving.setTransformValueAt(Transform::kFbxTransformPositionX, timeOf(5, 3), {1.0f, 2.0f, 3.0f});
    file.write({{}, {}, {}, {&still, &moving}, {}});
    auto read = file.read<TnFbxNull>();
    EXPECT_FALSE(read["still"].getTransformAnimated(Transform::kFbxTransformPositionX));
    const TnFbxTime time = read["moving"].getTransformTime(Transform::kFbxTransformPositionX);
    EXPECT_EQ(time.getStartFrame(), 3);
    EXPECT_EQ(time.getEndFrame(), 20);
}

} // namespace
} // namespace Tarnell::Fbx::test
