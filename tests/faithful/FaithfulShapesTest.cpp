// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Blend shapes: weights between, at and beyond their targets, on either side of 0; and the normals of what they
// reshape.
#include "FaithfulFixture.h"

#include <cmath>
#include <utility>
#include <vector>

namespace Tarnell::Fbx::test {
namespace {

using fbxsdk::FbxBlendShapeChannel;
using fbxsdk::FbxLayerElement;
using fbxsdk::FbxVector4;

/// A square of two triangles, (0,0) (1,0) (1,1) and (0,0) (1,1) (0,1), with a blend shape.
struct ShapedScene : TestScene {
    explicit ShapedScene(int lastFrame = 0) : TestScene(0, lastFrame) {
        node = add<fbxsdk::FbxMesh>("mesh");
        mesh = node->GetMesh();
        fillMesh(*mesh, {{0.0, 0.0, 0.0}, {1.0, 0.0, 0.0}, {1.0, 1.0, 0.0}, {0.0, 1.0, 0.0}}, {{0, 1, 2}, {0, 2, 3}});
        addDeformer();
    }

    void addDeformer() {
        deformer = fbxsdk::FbxBlendShape::Create(scene, "shapes");
        mesh->AddDeformer(deformer);
    }

    FbxBlendShapeChannel& addChannel(double percent) {
        auto* channel = FbxBlendShapeChannel::Create(scene, "channel");
        deformer->AddBlendShapeChannel(channel);
        channel->DeformPercent.Set(percent);
        return *channel;
    }

    /// Moves the first `count` points, fully at a weight.
    void addTarget(FbxBlendShapeChannel& channel, double fullWeight, const FbxVector4& move, int count = 4) {
        auto* shape = fbxsdk::FbxShape::Create(scene, "target");
        shape->InitControlPoints(count);
        for (int i = 0; i < count; ++i)
            shape->SetControlPointAt(i < 4 ? mesh->GetControlPointAt(i) + move : FbxVector4(9.0, 9.0, 9.0), i);
        EXPECT_TRUE(channel.AddTargetShape(shape, fullWeight));
    }

    void addNormals(FbxLayerElement::EMappingMode mapping, const std::vector<FbxVector4>& normals) {
        auto* element = fbxsdk::FbxLayerElementNormal::Create(mesh, "");
        element->SetMappingMode(mapping);
        element->SetReferenceMode(FbxLayerElement::eDirect);
        for (const FbxVector4& normal : normals)
            element->GetDirectArray().Add(normal);
        mesh->GetLayer(mesh->CreateLayer())->SetNormals(element);
    }

    TnFbxMesh read(float frame = 0.0f) {
        const SavedScene saved(*this);
        TnFbxReadInfo info = saved.info();
        info.setFrame(frame);
        return FacadeRead<TnFbxMesh>(info)["mesh"];
    }

    /// How far a point moved.
    Samples moved(int point = 0, float frame = 0.0f) {
        const Samples points = pointsOf(read(frame));
        const FbxVector4 base = mesh->GetControlPointAt(point);
        Samples result;
        for (int axis = 0; axis < 3 && points.size() == 12; ++axis)
            result.push_back(points[static_cast<std::size_t>(3 * point + axis)] - static_cast<float>(base[axis]));
        return result;
    }

    fbxsdk::FbxNode* node = nullptr;
    fbxsdk::FbxMesh* mesh = nullptr;
    fbxsdk::FbxBlendShape* deformer = nullptr;
};

using Heights = std::vector<std::pair<double, double>>;

/// The movement along Z at each percentage.
void expectHeights(ShapedScene& scene, FbxBlendShapeChannel& channel, const Heights& heights) {
    for (const auto& [percent, height] : heights) {
        channel.DeformPercent.Set(percent);
        EXPECT_THAT(scene.moved(2), isNear({0.0f, 0.0f, static_cast<float>(height)})) << "at " << percent;
    }
}

TEST(FaithfulShapes, AreExtrapolatedOnBothSidesOfASingleTarget) {
    ShapedScene scene;
    FbxBlendShapeChannel& channel = scene.addChannel(0.0);
    scene.addTarget(channel, 100.0, {0.0, 0.0, 2.0});
    expectHeights(scene, channel, {{-150.0, -3.0}, {-50.0, -1.0}, {0.0, 0.0}, {25.0, 0.5}, {100.0, 2.0}, {250.0, 5.0}});
}

TEST(FaithfulShapes, AreReachedAtTheirFullWeight) {
    ShapedScene scene;
    FbxBlendShapeChannel& channel = scene.addChannel(0.0);
    scene.addTarget(channel, 40.0, {0.0, 0.0, 2.0});
    expectHeights(scene, channel, {{10.0, 0.5}, {40.0, 2.0}, {100.0, 5.0}, {-20.0, -1.0}});
}

TEST(FaithfulShapes, GoFromOneInBetweenTargetToTheNext) {
    ShapedScene scene;
    FbxBlendShapeChannel& channel = scene.addChannel(0.0);
    scene.addTarget(channel, 20.0, {0.0, 0.0, 4.0});
    scene.addTarget(channel, 60.0, {0.0, 0.0, 2.0});
    scene.addTarget(channel, 100.0, {0.0, 0.0, 10.0});
    expectHeights(
        scene, channel,
        {{-10.0, -2.0}, {10.0, 2.0}, {20.0, 4.0}, {30.0, 3.5}, {60.0, 2.0}, {70.0, 4.0}, {100.0, 10.0}, {120.0, 14.0}});
}

TEST(FaithfulShapes, HaveTargetsOnEitherSideOfZero) {
    ShapedScene scene;
    FbxBlendShapeChannel& channel = scene.addChannel(0.0);
    scene.addTarget(channel, -100.0, {0.0, 0.0, 6.0});
    scene.addTarget(channel, -50.0, {0.0, 0.0, 1.0});
    scene.addTarget(channel, 100.0, {0.0, 0.0, -4.0});
    expectHeights(scene, channel,
                  {{-150.0, 11.0},
                   {-100.0, 6.0},
                   {-75.0, 3.5},
                   {-50.0, 1.0},
                   {-25.0, 0.5},
                   {0.0, 0.0},
                   {50.0, -2.0},
                   {150.0, -6.0}});
}

TEST(FaithfulShapes, OfAFullWeightOfZeroAreReachedAtAHundred) {
    ShapedScene scene;
    FbxBlendShapeChannel& channel = scene.addChannel(0.0);
    scene.addTarget(channel, 0.0, {0.0, 0.0, 2.0});
    expectHeights(scene, channel, {{0.0, 0.0}, {50.0, 1.0}, {100.0, 2.0}});
}

TEST(FaithfulShapes, OfSeveralChannelsAndDeformersAddUp) {
    ShapedScene scene;
    scene.addTarget(scene.addChannel(50.0), 100.0, {0.0, 0.0, 2.0});
    scene.addTarget(scene.addChannel(-25.0), 100.0, {4.0, 0.0, 0.0});
    scene.addChannel(100.0); // without a target
    scene.addDeformer();
    scene.addTarget(scene.addChannel(100.0), 100.0, {0.0, 0.5, 0.0});
    EXPECT_THAT(scene.moved(), isNear({-1.0f, 0.5f, 1.0f}));
}

TEST(FaithfulShapes, FollowTheirCurveBetweenKeys) {
    ShapedScene scene(4);
    FbxBlendShapeChannel& channel = scene.addChannel(77.0);
    scene.addTarget(channel, 50.0, {0.0, 0.0, 1.0});
    scene.addTarget(channel, 100.0, {0.0, 0.0, 5.0});
    scene.key(channel.DeformPercent, nullptr, {{0, -100.0f}, {2, 100.0f}, {4, 0.0f}});
    const std::pair<float, float> heights[] = {{0.0f, -2.0f}, {0.5f, -1.0f}, {1.0f, 0.0f}, {1.5f, 1.0f},
                                               {1.75f, 3.0f}, {2.0f, 5.0f},  {3.0f, 1.0f}, {4.5f, 0.0f}};
    for (const auto& [frame, height] : heights)
        EXPECT_THAT(scene.moved(1, frame), isNear({0.0f, 0.0f, height})) << frame;
}

TEST(FaithfulShapes, OfAnotherNumberOfPointsMoveThoseThatBothHave) {
    for (const int count : {2, 6}) {
        ShapedScene scene;
        scene.addTarget(scene.addChannel(100.0), 100.0, {0.0, 0.0, 2.0}, count);
        EXPECT_THAT(scene.moved(1), isNear({0.0f, 0.0f, 2.0f})) << count;
        EXPECT_THAT(scene.moved(3), isNear({0.0f, 0.0f, count == 2 ? 0.0f : 2.0f})) << count;
    }
}

TEST(FaithfulShapes, ComeBeforeTheSkin) {
    ShapedScene scene;
    scene.addTarget(scene.addChannel(50.0), 100.0, {2.0, 0.0, 0.0});
    auto* skin = fbxsdk::FbxSkin::Create(scene.scene, "skin");
    auto* cluster = fbxsdk::FbxCluster::Create(scene.scene, "cluster");
    fbxsdk::FbxNode* bone = scene.add<fbxsdk::FbxSkeleton>("bone");
    bone->LclRotation.Set(fbxsdk::FbxDouble3(0.0, 0.0, 90.0));
    cluster->SetLink(bone);
    for (int i = 0; i < 4; ++i)
        cluster->AddControlPointIndex(i, 1.0);
    skin->AddCluster(cluster);
    scene.mesh->AddDeformer(skin);
    // (1,0,0) to (2,0,0), and that a quarter of a turn.
    const Samples points = pointsOf(scene.read());
    EXPECT_THAT(Samples(points.begin() + 3, points.begin() + 6), isNear({0.0f, 2.0f, 0.0f}));
}

// ---- Normals ----

Samples joined(const std::vector<FbxVector4>& normals) {
    Samples numbers;
    for (const FbxVector4& normal : normals) {
        const double length = std::hypot(normal[0], normal[1], normal[2]);
        for (int axis = 0; axis < 3; ++axis)
            numbers.push_back(static_cast<float>(length > 0.0 ? normal[axis] / length : 0.0));
    }
    return numbers;
}

/// The last point is raised to (0,1,1): its triangle's normal times twice its area is (1,−1,1), the other's (0,0,1).
struct RaisedScene : ShapedScene {
    RaisedScene() {
        auto* shape = fbxsdk::FbxShape::Create(scene, "target");
        shape->InitControlPoints(4);
        for (int i = 0; i < 4; ++i)
            shape->SetControlPointAt(mesh->GetControlPointAt(i) + FbxVector4(0.0, 0.0, i == 3 ? 1.0 : 0.0), i);
        addChannel(100.0).AddTargetShape(shape, 100.0);
    }
};

TEST(FaithfulShapes, ShareNormalsWhereTheyWereSharedByArea) {
    RaisedScene scene;
    scene.addNormals(FbxLayerElement::eAllSame, {{0.0, 0.0, 1.0}});
    const FbxVector4 flat(0.0, 0.0, 1.0), raised(1.0, -1.0, 1.0), both(1.0, -1.0, 2.0);
    EXPECT_THAT(normalsOf(scene.read()), isNear(joined({both, flat, both, both, both, raised})));
}

TEST(FaithfulShapes, KeepEdgesBetweenNormalsThatDiffered) {
    RaisedScene scene;
    scene.addNormals(FbxLayerElement::eByPolygon, {{0.0, 0.0, 1.0}, {0.0, 0.1, 1.0}});
    const FbxVector4 flat(0.0, 0.0, 1.0), raised(1.0, -1.0, 1.0);
    EXPECT_THAT(normalsOf(scene.read()), isNear(joined({flat, flat, flat, raised, raised, raised})));
}

TEST(FaithfulShapes, HaveNormalsThatFaceAsBeforeUnderAMirror) {
    RaisedScene scene;
    scene.addNormals(FbxLayerElement::eAllSame, {{0.0, 0.0, 1.0}});
    scene.node->LclScaling.Set(fbxsdk::FbxDouble3(-1.0, 1.0, 1.0));
    const TnFbxMesh mesh = scene.read();
    EXPECT_THAT(pointIndicesOf(mesh), testing::ElementsAre(0, 2, 1, 0, 3, 2));
    const FbxVector4 flat(0.0, 0.0, 1.0), raised(-1.0, -1.0, 1.0), both(-1.0, -1.0, 2.0);
    EXPECT_THAT(normalsOf(mesh), isNear(joined({both, both, flat, both, raised, both})));
}

TEST(FaithfulShapes, ThatCollapseTheirPolygonsHaveNormalsOfNoLength) {
    ShapedScene scene;
    auto* shape = fbxsdk::FbxShape::Create(scene.scene, "target");
    shape->InitControlPoints(4); // all at the origin
    scene.addChannel(100.0).AddTargetShape(shape, 100.0);
    scene.addNormals(FbxLayerElement::eAllSame, {{0.0, 0.0, 1.0}});
    EXPECT_EQ(normalsOf(scene.read()), Samples(18, 0.0f));
}

TEST(FaithfulShapes, WithoutAWeightLeaveTheNormalsOfTheFile) {
    RaisedScene scene;
    scene.deformer->GetBlendShapeChannel(0)->DeformPercent.Set(0.0);
    scene.addNormals(FbxLayerElement::eByControlPoint, {{0, 0, 1}, {0, 1, 0}, {1, 0, 0}, {0, 0, -1}});
    EXPECT_THAT(normalsOf(scene.read()), isNear({0, 0, 1, 0, 1, 0, 1, 0, 0, 0, 0, 1, 1, 0, 0, 0, 0, -1}));
}

// ---- Colours of materials ----

/// A material of each kind for the two triangles; the corners' colours by the mapping of the material numbers.
Samples redsOf(FbxLayerElement::EMappingMode mapping, const std::vector<int>& numbers) {
    ShapedScene scene;
    auto* lambert = fbxsdk::FbxSurfaceLambert::Create(scene.scene, "lambert");
    lambert->Diffuse.Set(fbxsdk::FbxDouble3(0.25, 0.0, 0.0));
    scene.node->AddMaterial(lambert);
    auto* phong = fbxsdk::FbxSurfacePhong::Create(scene.scene, "phong");
    phong->Diffuse.Set(fbxsdk::FbxDouble3(0.5, 0.0, 0.0));
    phong->TransparencyFactor.Set(1.0);
    phong->TransparentColor.Set(fbxsdk::FbxDouble3(0.25, 0.5, 0.75));
    scene.node->AddMaterial(phong);
    auto* element = fbxsdk::FbxLayerElementMaterial::Create(scene.mesh, "");
    element->SetMappingMode(mapping);
    element->SetReferenceMode(FbxLayerElement::eIndexToDirect);
    for (const int number : numbers)
        element->GetIndexArray().Add(number);
    scene.mesh->GetLayer(scene.mesh->CreateLayer())->SetMaterials(element);
    const TnFbxMesh mesh = scene.read();
    Samples reds;
    for (int i = 0; mesh.getValidColours() && i < mesh.getNumberOfPolygonVertices(); ++i) {
        float red = 0.0f, green = 0.0f, blue = 0.0f, alpha = 0.0f;
        EXPECT_TRUE(mesh.getColour(i, red, green, blue, alpha));
        const float opaque = red == 0.25f ? 1.0f : red == 0.5f ? 0.5f : alpha;
        EXPECT_EQ(alpha, opaque) << "1 − the mean of what is let through";
        reds.push_back(red);
    }
    return reds;
}

TEST(FaithfulMaterials, ColourTheCornersInEveryMapping) {
    EXPECT_THAT(redsOf(FbxLayerElement::eAllSame, {1}), isNear({0.5f, 0.5f, 0.5f, 0.5f, 0.5f, 0.5f}));
    EXPECT_THAT(redsOf(FbxLayerElement::eByPolygon, {1, 0}), isNear({0.5f, 0.5f, 0.5f, 0.25f, 0.25f, 0.25f}));
    EXPECT_THAT(redsOf(FbxLayerElement::eByControlPoint, {0, 1, 0, 1}),
                isNear({0.25f, 0.5f, 0.25f, 0.25f, 0.25f, 0.5f}));
    EXPECT_THAT(redsOf(FbxLayerElement::eByPolygonVertex, {0, 1, 1, 0, 0, 1}),
                isNear({0.25f, 0.5f, 0.5f, 0.25f, 0.25f, 0.5f}));
}

TEST(FaithfulMaterials, ThatAreNotThereLeaveTheDefaultColour) {
    const Samples reds = redsOf(FbxLayerElement::eByPolygon, {1, 7});
    ASSERT_EQ(reds.size(), 6u);
    TnFbxMesh untouched;
    untouched.allocateGeometryData(1, 3, 3);
    float red = 0.0f, green = 0.0f, blue = 0.0f, alpha = 0.0f;
    untouched.getColour(0, red, green, blue, alpha);
    EXPECT_THAT(reds, isNear({0.5f, 0.5f, 0.5f, red, red, red}));
    const Samples fewer = redsOf(FbxLayerElement::eByPolygon, {1});
    EXPECT_THAT(fewer, isNear({0.5f, 0.5f, 0.5f, red, red, red}));
    EXPECT_EQ(redsOf(FbxLayerElement::eByPolygon, {7, -1}), Samples()) << "no corner has one";
}

/// A square with a material that is no Lambert one.
TnFbxMesh shaded(bool statesColour) {
    ShapedScene scene;
    auto* material = fbxsdk::FbxSurfaceMaterial::Create(scene.scene, "shader");
    if (statesColour)
        fbxsdk::FbxProperty::Create(material, fbxsdk::FbxColor3DT, "DiffuseColor")
            .Set(fbxsdk::FbxDouble3(0.25, 0.5, 0.75));
    scene.node->AddMaterial(material);
    return scene.read();
}

TEST(FaithfulMaterials, OfOtherShadersHaveTheirDiffuseColourWhereTheyStateOne) {
    const TnFbxMesh mesh = shaded(true);
    float red = 0.0f, green = 0.0f, blue = 0.0f, alpha = 0.0f;
    EXPECT_TRUE(mesh.getValidColours());
    EXPECT_TRUE(mesh.getColour(5, red, green, blue, alpha));
    EXPECT_THAT((Samples{red, green, blue, alpha}), isNear({0.25f, 0.5f, 0.75f, 1.0f}));
    EXPECT_FALSE(shaded(false).getValidColours());
}

} // namespace
} // namespace Tarnell::Fbx::test
