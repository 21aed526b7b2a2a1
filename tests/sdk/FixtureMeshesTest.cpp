// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes of hand-written files: materials, mapping and reference modes, and the surfaces that are converted to meshes.
#include "FixtureFiles.h"

#include <cmath>

namespace Tarnell::Fbx {
namespace {

using test::FacadeRead;
using test::fixture;
using test::isNear;
using test::pointIndicesOf;
using test::pointsOf;
using test::Samples;
using testing::ElementsAre;
using testing::FloatNear;

/// The values of all polygon vertices, in one row.
Samples normalsOf(const TnFbxMesh& mesh) {
    Samples all;
    for (int i = 0; i < mesh.getNumberOfPolygonVertices(); ++i) {
        float x = 0.0f, y = 0.0f, z = 0.0f;
        EXPECT_TRUE(mesh.getNormal(i, x, y, z));
        all.insert(all.end(), {x, y, z});
    }
    return all;
}
Samples uvsOf(const TnFbxMesh& mesh) {
    Samples all;
    for (int i = 0; i < mesh.getNumberOfPolygonVertices(); ++i) {
        float u = 0.0f, v = 0.0f;
        EXPECT_TRUE(mesh.getUV(i, u, v));
        all.insert(all.end(), {u, v});
    }
    return all;
}
Samples colourOf(const TnFbxMesh& mesh, int polygonVertex) {
    Samples colour(4);
    EXPECT_TRUE(mesh.getColour(polygonVertex, colour[0], colour[1], colour[2], colour[3]));
    return colour;
}
/// The red of all polygon vertices, where the other components are not of interest.
Samples redsOf(const TnFbxMesh& mesh) {
    Samples all;
    for (int i = 0; i < mesh.getNumberOfPolygonVertices(); ++i)
        all.push_back(colourOf(mesh, i)[0]);
    return all;
}

// ---- Materials ----

class MaterialsOfEachGeneration : public testing::TestWithParam<const char*> {};

INSTANTIATE_TEST_SUITE_P(Files, MaterialsOfEachGeneration,
                         testing::Values("materials_6100_ascii.fbx", "materials_7400_ascii.fbx"));

TEST_P(MaterialsOfEachGeneration, GiveTheirDiffuseColoursToTheirPolygons) {
    const Samples red = {1.0f, 0.25f, 0.125f, 1.0f}, glass = {0.0f, 0.5f, 1.0f, 0.25f}; // of a transparency of 0.75
    FacadeRead<TnFbxMesh> meshes(fixture(GetParam()));
    const TnFbxMesh& strip = meshes["strip"];

    EXPECT_TRUE(strip.getValidColours());
    ASSERT_EQ(strip.getNumberOfPolygonVertices(), 4 + 4 + 3);
    for (int corner = 0; corner < 11; ++corner) {
        const bool second = corner >= 4 && corner < 8;
        EXPECT_EQ(colourOf(strip, corner), second ? red : glass) << corner;
    }
}

TEST_P(MaterialsOfEachGeneration, LeaveThePolygonsAsTheyAre) {
    FacadeRead<TnFbxMesh> meshes(fixture(GetParam()));
    const TnFbxMesh& strip = meshes["strip"];

    EXPECT_EQ(strip.getNumberOfPolygons(), 3);
    EXPECT_EQ(strip.getPolygonVertexSize(0), 4);
    EXPECT_EQ(strip.getPolygonVertexSize(2), 3);
    EXPECT_THAT(pointIndicesOf(strip), ElementsAre(0, 1, 5, 4, 1, 2, 6, 5, 2, 3, 7));
    EXPECT_EQ(pointsOf(strip), Samples({0, 0, 0, 1, 0, 0, 2, 0, 0, 3, 0, 0, 0, 1, 0, 1, 1, 0, 2, 1, 0, 3, 1, 0}));
}

TEST(MaterialsFixture, ComeWithTextureCoordinatesByControlPoint) {
    FacadeRead<TnFbxMesh> meshes(fixture("materials_6100_ascii.fbx"));

    // u of the four columns is 0, ¼, ½ and 1
    EXPECT_TRUE(meshes["strip"].getValidUVs());
    EXPECT_EQ(uvsOf(meshes["strip"]),
              Samples({0, 0, 0.25f, 0, 0.25f, 1, 0, 1, 0.25f, 0, 0.5f, 0, 0.5f, 1, 0.25f, 1, 0.5f, 0, 1, 0, 1, 1}));
}

// ---- Modes: the triangles 0 1 2 and 2 1 3 ----

TEST(MappingModesFixture, ByControlPoint) {
    FacadeRead<TnFbxMesh> meshes(fixture("mapping_modes_7400_ascii.fbx"));
    const TnFbxMesh& mesh = meshes["points"];

    EXPECT_THAT(pointIndicesOf(mesh), ElementsAre(0, 1, 2, 2, 1, 3));
    EXPECT_EQ(normalsOf(mesh), Samples({1, 0, 0, 0, 1, 0, 0, 0, 1, 0, 0, 1, 0, 1, 0, -1, 0, 0})); // directly
    // point p has the values 3 − p
    EXPECT_EQ(uvsOf(mesh), Samples({1.5f, 1.75f, 1, 1.25f, 0.5f, 0.75f, 0.5f, 0.75f, 1, 1.25f, 0, 0.25f}));
    EXPECT_EQ(redsOf(mesh), Samples({0.75f, 0.5f, 0.25f, 0.25f, 0.5f, 0}));
}

TEST(MappingModesFixture, ByPolygonVertex) {
    FacadeRead<TnFbxMesh> meshes(fixture("mapping_modes_7400_ascii.fbx"));
    const TnFbxMesh& mesh = meshes["corners"];

    EXPECT_EQ(normalsOf(mesh), Samples({1, 0, 0, 0, 1, 0, 0, 0, 1, 0, 0, 1, 0, 1, 0, 1, 0, 0})); // 0 1 2 2 1 0
    EXPECT_EQ(uvsOf(mesh), Samples({0, 0.25f, 0.5f, 0.75f, 1, 1.25f, 1.5f, 1.75f, 2, 2.25f, 2.5f, 2.75f}));
    EXPECT_EQ(redsOf(mesh), Samples({0, 0.25f, 0.5f, 0.75f, 1, 1}));
    EXPECT_EQ(colourOf(mesh, 4), Samples({1, 0, 0, 1}));
    EXPECT_EQ(colourOf(mesh, 5), Samples({1, 1, 1, 1}));
}

// kept: no other mode is read, and the default values stay
TEST(MappingModesFixture, ByPolygonOrForAllAreNotRead) {
    FacadeRead<TnFbxMesh> meshes(fixture("mapping_modes_7400_ascii.fbx"));
    const TnFbxMesh& mesh = meshes["others"];

    EXPECT_FALSE(mesh.getValidNormals());
    EXPECT_FALSE(mesh.getValidUVs());
    EXPECT_FALSE(mesh.getValidColours());
    EXPECT_EQ(normalsOf(mesh), Samples(18, 0.0f));
    EXPECT_EQ(uvsOf(mesh), Samples(12, 0.0f));
    EXPECT_EQ(colourOf(mesh, 0), Samples({1, 1, 1, 1}));
}

// ---- Surfaces. Their samples run along U first ----

/// The square (0,0), (2,0), (2,2), (0,2) has four sides: two triangles each, the last of which end at the first points.
const std::vector<int> kRoundTrip = {0, 1, 5, 0, 5, 4, 1, 2, 6, 1, 6, 5, 2, 3, 7, 2, 7, 6, 3, 0, 4, 3, 4, 7};

// Of degree 1, the surface is its control points.
TEST(NurbsFormsFixture, ClosedAlongUEndsAtItsFirstPoints) {
    FacadeRead<TnFbxMesh> meshes(fixture("nurbs_forms_7400_ascii.fbx"));
    const TnFbxMesh& mesh = meshes["closed"];

    EXPECT_EQ(pointsOf(mesh), Samples({0, 0, 0, 2, 0, 0, 2, 2, 0, 0, 2, 0, 0, 0, 1, 2, 0, 1, 2, 2, 1, 0, 2, 1}));
    EXPECT_EQ(pointIndicesOf(mesh), kRoundTrip);
}

// Of degree 2 with even knots, the surface passes at every knot through the middle between two control points.
TEST(NurbsFormsFixture, PeriodicAlongURunsThroughTheMiddlesOfItsSides) {
    FacadeRead<TnFbxMesh> meshes(fixture("nurbs_forms_7400_ascii.fbx"));
    const TnFbxMesh& mesh = meshes["periodic"];

    EXPECT_THAT(pointsOf(mesh), isNear({1, 0, 0, 2, 1, 0, 1, 2, 0, 0, 1, 0, 1, 0, 1, 2, 1, 1, 1, 2, 1, 0, 1, 1}));
    EXPECT_EQ(pointIndicesOf(mesh), kRoundTrip);
}

// The weights 1, √½, 1 over a right angle make a circle, symmetric about its middle.
TEST(NurbsFormsFixture, WithWeightsIsAQuarterOfACylinder) {
    FacadeRead<TnFbxMesh> meshes(fixture("nurbs_forms_7400_ascii.fbx"));
    const Samples points = pointsOf(meshes["quarter"]);

    ASSERT_EQ(points.size(), 3U * 5U * 2U); // four steps along U, one along V
    for (std::size_t i = 0; i < 10; ++i) {
        const float x = points[3 * i], y = points[3 * i + 1];
        EXPECT_THAT(std::hypot(x, y), FloatNear(1.0f, 1e-6f)) << i;
        EXPECT_EQ(points[3 * i + 2], i < 5 ? 0.0f : 3.0f) << i;
    }
    EXPECT_THAT(Samples(points.begin(), points.begin() + 2), isNear({1, 0}));
    EXPECT_THAT(Samples(points.begin() + 6, points.begin() + 8), isNear({std::sqrt(0.5f), std::sqrt(0.5f)}));
    EXPECT_THAT(Samples(points.begin() + 12, points.begin() + 14), isNear({0, 1}));
}

// A normal of the cylinder is the direction from its axis.
TEST(NurbsFormsFixture, HaveNormalsOfTheSurface) {
    FacadeRead<TnFbxMesh> meshes(fixture("nurbs_forms_7400_ascii.fbx"));
    const TnFbxMesh& mesh = meshes["quarter"];
    const Samples points = pointsOf(mesh), normals = normalsOf(mesh);

    EXPECT_TRUE(mesh.getValidNormals());
    ASSERT_EQ(mesh.getNumberOfPolygonVertices(), 2 * 3 * 4);
    for (std::size_t corner = 0; corner < 24; ++corner) {
        const auto point = static_cast<std::size_t>(mesh.getPointIndex(static_cast<int>(corner)));
        const Samples outward = {points[3 * point], points[3 * point + 1], 0.0f};
        EXPECT_THAT(Samples(normals.begin() + static_cast<std::ptrdiff_t>(3 * corner),
                            normals.begin() + static_cast<std::ptrdiff_t>(3 * corner + 3)),
                    isNear(outward))
            << corner;
    }
}

// The control points (0,0), (0,8), (8,8), (8,0): in the middle the weights are 1/8, 3/8, 3/8, 1/8.
TEST(PatchesFixture, OfBezierRunThroughTheirOuterPoints) {
    FacadeRead<TnFbxMesh> meshes(fixture("patches_7400_ascii.fbx"));

    EXPECT_THAT(pointsOf(meshes["bezier"]), isNear({0, 0, 0, 4, 6, 0, 8, 0, 0, 0, 0, 1, 4, 6, 1, 8, 0, 1}));
    EXPECT_THAT(pointIndicesOf(meshes["bezier"]), ElementsAre(0, 1, 4, 0, 4, 3, 1, 2, 5, 1, 5, 4));
}

// In the middle between two points the weights of the four next ones are −1/16, 9/16, 9/16, −1/16. Beyond the ends
// are (0,−8) and (8,−8), so that the first middle is (−8, 72 + 8 − 8)/16, the second (64, 144)/16.
TEST(PatchesFixture, OfTheCardinalKindRunThroughAllTheirPoints) {
    const Samples curve = {0, 0, -0.5f, 4.5f, 0, 8, 4, 9, 8, 8, 8.5f, 4.5f, 8, 0};
    Samples expected;
    for (const float z : {0.0f, 1.0f})
        for (std::size_t i = 0; i < curve.size(); i += 2)
            expected.insert(expected.end(), {curve[i], curve[i + 1], z});
    FacadeRead<TnFbxMesh> meshes(fixture("patches_7400_ascii.fbx"));

    EXPECT_THAT(pointsOf(meshes["cardinal"]), isNear(expected));
}

} // namespace
} // namespace Tarnell::Fbx
