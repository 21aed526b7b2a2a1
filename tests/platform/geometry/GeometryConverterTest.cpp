// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of surfaces and polygons to triangle meshes, with everything that is connected to them.
#include <fbxsdk/FbxGeometryConverter.h>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxBlendShape.h>
#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxCluster.h>
#include <fbxsdk/FbxLine.h>
#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxNull.h>
#include <fbxsdk/FbxShape.h>
#include <fbxsdk/FbxSkin.h>
#include <fbxsdk/FbxSurfaceMaterial.h>
#include <fbxsdk/FbxTrimNurbsSurface.h>
#include <fbxsdk/FbxVertexCacheDeformer.h>

#include <limits>

#include "GeometryFixture.h"
#include "NurbsSamples.h"
#include "geometry/tessellation/TessellationGrid.h"
#include "object/ManagerData.h"

namespace fbxsdk {
namespace {

using detail::expectNear;

class GeometryConverter : public GeometryFixture {
protected:
    GeometryConverter() : converter(manager), node(make<FbxNode>("node")) { scene->GetRootNode()->AddChild(node); }

    FbxPatch* bilinear(int steps) {
        auto* patch = make<FbxPatch>("patch");
        detail::makeBilinear(*patch);
        patch->SetStep(steps, steps);
        node->SetNodeAttribute(patch);
        return patch;
    }
    FbxMesh* converted(FbxNodeAttribute* attribute, bool replace = true) {
        return FbxCast<FbxMesh>(converter.Triangulate(attribute, replace));
    }

    /// A square with one more corner, and a triangle.
    FbxMesh* polygons() {
        auto* mesh = make<FbxMesh>("polygons");
        mesh->InitControlPoints(6);
        const double points[6][2] = {{0, 0}, {2, 0}, {2, 2}, {1, 3}, {0, 2}, {4, 0}};
        for (int i = 0; i < 6; ++i)
            mesh->SetControlPointAt(FbxVector4(points[i][0], points[i][1], 0), i);
        addPolygon(*mesh, {0, 1, 2, 3, 4});
        addPolygon(*mesh, {3, 4});
        addPolygon(*mesh, {1, 5, 2});
        node->SetNodeAttribute(mesh);
        return mesh;
    }
    static void addPolygon(FbxMesh& mesh, const std::vector<int>& corners) {
        mesh.BeginPolygon();
        for (const int corner : corners)
            mesh.AddPolygon(corner);
        mesh.EndPolygon();
    }
    static std::vector<int> cornersOf(const FbxMesh& mesh) {
        return {mesh.GetPolygonVertices(), mesh.GetPolygonVertices() + mesh.GetPolygonVertexCount()};
    }

    FbxSkin* addSkin(FbxGeometry& geometry, FbxNode* link, const std::vector<std::pair<int, double>>& weights) {
        auto* skin = make<FbxSkin>("skin");
        skin->SetSkinningType(FbxSkin::eDualQuaternion);
        auto* cluster = make<FbxCluster>("cluster");
        FbxAMatrix matrix;
        matrix.SetT(FbxVector4(1, 2, 3));
        cluster->SetTransformMatrix(matrix);
        cluster->SetTransformLinkMatrix(matrix);
        cluster->SetLinkMode(FbxCluster::eTotalOne);
        cluster->SetLink(link);
        for (const auto& [point, weight] : weights)
            cluster->AddControlPointIndex(point, weight);
        skin->AddCluster(cluster);
        geometry.AddDeformer(skin);
        return skin;
    }
    FbxBlendShapeChannel* addShape(FbxGeometry& geometry, int point, const FbxVector4& offset) {
        auto* shape = make<FbxShape>("target");
        shape->InitControlPoints(geometry.GetControlPointsCount());
        for (int i = 0; i < geometry.GetControlPointsCount(); ++i)
            shape->SetControlPointAt(geometry.GetControlPointAt(i), i);
        shape->SetControlPointAt(geometry.GetControlPointAt(point) + offset, point);
        auto* channel = make<FbxBlendShapeChannel>("channel");
        channel->AddTargetShape(shape, 80.0);
        channel->DeformPercent.Set(25.0);
        auto* blendShape = make<FbxBlendShape>("blend");
        blendShape->AddBlendShapeChannel(channel);
        geometry.AddDeformer(blendShape);
        return channel;
    }

    FbxGeometryConverter converter;
    FbxNode* node;
};

TEST_F(GeometryConverter, MakesTwoTrianglesOfEachCell) {
    FbxMesh* mesh = converted(bilinear(2));
    ASSERT_NE(mesh, nullptr);
    EXPECT_STREQ(mesh->GetName(), "patch");
    EXPECT_EQ(mesh->GetControlPointsCount(), 9);
    EXPECT_EQ(mesh->GetPolygonCount(), 8);
    EXPECT_TRUE(mesh->IsTriangleMesh());
    const auto corners = cornersOf(*mesh);
    EXPECT_EQ((std::vector<int>(corners.begin(), corners.begin() + 6)), (std::vector<int>{0, 1, 4, 0, 4, 3}));
    EXPECT_EQ((std::vector<int>(corners.end() - 6, corners.end())), (std::vector<int>{4, 5, 8, 4, 8, 7}));
    expectNear(mesh->GetControlPointAt(4), FbxVector4(0.5, 0.5, 2.0));
}

TEST_F(GeometryConverter, TurnsTheTrianglesOfAFlippedSurface) {
    auto* surface = make<FbxNurbsSurface>();
    detail::makeCylinder(*surface);
    for (const bool flipped : {false, true}) {
        surface->SetFlipNormals(flipped);
        FbxMesh* mesh = converted(surface, false);
        ASSERT_NE(mesh, nullptr);
        for (int polygon = 0; polygon < mesh->GetPolygonCount(); ++polygon) {
            FbxVector4 corner[3];
            for (int i = 0; i < 3; ++i)
                corner[i] = mesh->GetControlPointAt(mesh->GetPolygonVertex(polygon, i));
            const FbxVector4 normal = (corner[1] - corner[0]).CrossProduct(corner[2] - corner[0]);
            const double outward = normal[0] * corner[0][0] + normal[1] * corner[0][1];
            EXPECT_GT(flipped ? -outward : outward, 0.0);
            FbxVector4 stored;
            ASSERT_TRUE(mesh->GetPolygonVertexNormal(polygon, 1, stored));
            EXPECT_GT(stored.DotProduct(normal), 0.0);
        }
    }
}

TEST_F(GeometryConverter, GivesCornersNormalsAndTextureCoordinates) {
    FbxMesh* mesh = converted(bilinear(2));
    ASSERT_NE(mesh, nullptr);
    ASSERT_EQ(mesh->GetLayerCount(), 1);
    const FbxLayerElementNormal* normals = mesh->GetLayer(0)->GetNormals();
    ASSERT_NE(normals, nullptr);
    EXPECT_EQ(normals->GetMappingMode(), FbxLayerElement::eByPolygonVertex);
    EXPECT_EQ(normals->GetReferenceMode(), FbxLayerElement::eDirect);
    EXPECT_EQ(normals->GetDirectArray().GetCount(), 24);
    FbxVector4 expected(-1, -2, 1);
    expected.Normalize();
    EXPECT_EQ(normals->GetDirectArray().GetFirst()[3], 1.0);
    expectNear(normals->GetDirectArray().GetFirst(), expected);

    const FbxLayerElementUV* uvs = mesh->GetLayer(0)->GetUVs();
    ASSERT_NE(uvs, nullptr);
    EXPECT_EQ(uvs->GetMappingMode(), FbxLayerElement::eByPolygonVertex);
    EXPECT_EQ(uvs->GetReferenceMode(), FbxLayerElement::eIndexToDirect);
    EXPECT_EQ(uvs->GetDirectArray().GetCount(), 9);
    EXPECT_EQ(mesh->GetTextureUVIndex(7, 1), 8);
    EXPECT_EQ(uvs->GetDirectArray().GetAt(8), FbxVector2(1, 1));
    EXPECT_EQ(uvs->GetDirectArray().GetAt(1), FbxVector2(0.5, 0));
}

TEST_F(GeometryConverter, KeepsTextureCoordinatesApartAtASharedSeam) {
    auto* patch = make<FbxPatch>();
    patch->InitControlPoints(4, FbxPatch::eLinear, 2, FbxPatch::eLinear);
    patch->SetClosed(true, false);
    patch->SetStep(1, 1);
    const double ring[4][2] = {{1, 0}, {0, 1}, {-1, 0}, {0, -1}};
    for (int i = 0; i < 8; ++i)
        patch->SetControlPointAt(FbxVector4(ring[i % 4][0], ring[i % 4][1], i / 4), i);
    FbxMesh* mesh = converted(patch);
    ASSERT_NE(mesh, nullptr);
    EXPECT_EQ(mesh->GetControlPointsCount(), 8);
    EXPECT_EQ(mesh->GetPolygonCount(), 8);
    const FbxLayerElementUV* uvs = mesh->GetLayer(0)->GetUVs();
    EXPECT_EQ(uvs->GetDirectArray().GetCount(), 10);
    // The last cell of the row leads back to the first point, at the far end of the texture.
    EXPECT_EQ(mesh->GetPolygonVertex(6, 1), 0);
    EXPECT_EQ(uvs->GetDirectArray().GetAt(mesh->GetTextureUVIndex(6, 1)), FbxVector2(1, 0));
}

TEST_F(GeometryConverter, TakesTheDirectionOfTheTriangleWhereTheSurfaceHasNone) {
    // Both rows fold back on themselves in v at the start: no tangent, and no mixed derivative either.
    auto* patch = make<FbxPatch>();
    patch->InitControlPoints(2, FbxPatch::eLinear, 3, FbxPatch::eBezierQuadric);
    patch->SetStep(1, 1);
    for (int i = 0; i < 6; ++i)
        patch->SetControlPointAt(FbxVector4(i % 2, i < 4 ? 0.0 : 1.0, 0.0), i);
    FbxMesh* mesh = converted(patch);
    ASSERT_NE(mesh, nullptr);
    FbxVector4 normal;
    ASSERT_TRUE(mesh->GetPolygonVertexNormal(0, 0, normal));
    expectNear(normal, FbxVector4(0, 0, 1));
}

TEST_F(GeometryConverter, GivesHugeSurfacesNormalsToo) {
    FbxPatch* patch = bilinear(2);
    for (int i = 0; i < 4; ++i)
        patch->SetControlPointAt(patch->GetControlPointAt(i) * 1e200, i);
    FbxMesh* mesh = converted(patch);
    ASSERT_NE(mesh, nullptr);
    for (int polygon = 0; polygon < mesh->GetPolygonCount(); ++polygon) {
        FbxVector4 normal;
        ASSERT_TRUE(mesh->GetPolygonVertexNormal(polygon, 0, normal));
        EXPECT_NEAR(normal.Length(), 1.0, 1e-12);
    }
}

TEST_F(GeometryConverter, GivesASurfaceShrunkToAPointNormalsOfZero) {
    auto* patch = make<FbxPatch>();
    patch->InitControlPoints(2, FbxPatch::eLinear, 2, FbxPatch::eLinear);
    FbxMesh* mesh = converted(patch);
    ASSERT_NE(mesh, nullptr);
    FbxVector4 normal;
    ASSERT_TRUE(mesh->GetPolygonVertexNormal(0, 0, normal));
    EXPECT_EQ(normal, FbxVector4(0, 0, 0, 1));
}

TEST_F(GeometryConverter, ConvertsASurfaceWhoseArraysAreStillInTheFile) {
    auto* surface = read<FbxNurbsSurface>(R"(
        NurbsSurfaceOrder: 2,2
        Dimensions: 2,2
        Step: 1,2
        Form: "Open","Open"
        Points: *16 { a: 0,0,0,1, 2,0,0,1, 0,4,0,1, 2,4,0,1 }
        KnotVectorU: *4 { a: 0,0,1,1 }
        KnotVectorV: *4 { a: 0,0,1,1 }
        LayerElementMaterial: 0 {
            MappingInformationType: "AllSame"
            ReferenceInformationType: "IndexToDirect"
            Materials: *1 { a: 2 }
        }
        Layer: 0 { LayerElement: { Type: "LayerElementMaterial" TypedIndex: 0 } }
        FlipNormals: 1)");
    node->SetNodeAttribute(surface);
    FbxMesh* mesh = converted(surface);
    ASSERT_NE(mesh, nullptr);
    EXPECT_EQ(cornersOf(*mesh), (std::vector<int>{0, 3, 1, 0, 2, 3, 2, 5, 3, 2, 4, 5}));
    expectNear(mesh->GetControlPointAt(3), FbxVector4(2, 2, 0));
    ASSERT_NE(mesh->GetLayer(0)->GetMaterials(), nullptr);
    EXPECT_EQ(mesh->GetLayer(0)->GetMaterials()->GetIndexArray().GetFirst(), 2);
}

TEST_F(GeometryConverter, ReplacesTheAttributeOnEveryNode) {
    FbxPatch* patch = bilinear(1);
    auto* other = make<FbxNode>("other");
    other->SetNodeAttribute(patch);
    FbxMesh* mesh = converted(patch);
    ASSERT_NE(mesh, nullptr);
    EXPECT_EQ(node->GetNodeAttribute(), mesh);
    EXPECT_EQ(other->GetNodeAttribute(), mesh);
    EXPECT_EQ(node->GetNodeAttributeCount(), 1);
    EXPECT_EQ(mesh->GetNodeCount(), 2);
    EXPECT_EQ(mesh->GetScene(), scene);
    EXPECT_EQ(scene->GetSrcObjectCount<FbxPatch>(), 0);
}

TEST_F(GeometryConverter, KeepsThePlaceAmongTheAttributesOfANode) {
    FbxPatch* patch = bilinear(1);
    auto* null = make<FbxNull>();
    node->ConnectSrcObject(null);
    node->FindProperty("DefaultAttributeIndex").Set(1);
    ASSERT_EQ(node->GetNodeAttribute(), null);
    FbxMesh* mesh = converted(patch);
    ASSERT_NE(mesh, nullptr);
    EXPECT_EQ(node->GetNodeAttributeByIndex(0), mesh);
    EXPECT_EQ(node->GetNodeAttributeByIndex(1), null);
    EXPECT_EQ(node->GetNodeAttribute(), null);
}

TEST_F(GeometryConverter, LeavesTheAttributeInPlaceWhenNotReplacing) {
    FbxPatch* patch = bilinear(1);
    FbxMesh* mesh = converted(patch, false);
    ASSERT_NE(mesh, nullptr);
    EXPECT_EQ(node->GetNodeAttribute(), patch);
    EXPECT_EQ(node->GetNodeAttributeCount(), 2);
    EXPECT_EQ(mesh->GetNode(), node);
}

TEST_F(GeometryConverter, CarriesTheMaterialForTheWholeMesh) {
    FbxPatch* patch = bilinear(1);
    auto* material = FbxSurfacePhong::Create(scene, "red");
    node->AddMaterial(material);
    auto* element = FbxLayerElementMaterial::Create(patch, "m");
    element->SetMappingMode(FbxLayerElement::eAllSame);
    element->SetReferenceMode(FbxLayerElement::eIndexToDirect);
    element->GetIndexArray().Add(3);
    patch->GetLayer(patch->CreateLayer())->SetMaterials(element);
    FbxMesh* mesh = converted(patch);
    ASSERT_NE(mesh, nullptr);
    const FbxLayerElementMaterial* carried = mesh->GetLayer(0)->GetMaterials();
    ASSERT_NE(carried, nullptr);
    EXPECT_STREQ(carried->GetName(), "m");
    EXPECT_EQ(carried->GetMappingMode(), FbxLayerElement::eAllSame);
    EXPECT_EQ(carried->GetReferenceMode(), FbxLayerElement::eIndexToDirect);
    ASSERT_EQ(carried->GetIndexArray().GetCount(), 1);
    EXPECT_EQ(carried->GetIndexArray().GetAt(0), 3);
    EXPECT_EQ(node->GetMaterial(0), material);
}

TEST_F(GeometryConverter, CarriesPropertiesOfTheGeometry) {
    FbxPatch* patch = bilinear(1);
    patch->CastShadow.Set(false);
    patch->Color.Set(FbxDouble3(1, 0.5, 0));
    FbxProperty::Create(patch, FbxDoubleDT, "mood", "Mood").Set(0.75);
    FbxMesh* mesh = converted(patch);
    ASSERT_NE(mesh, nullptr);
    EXPECT_FALSE(mesh->CastShadow.Get());
    EXPECT_TRUE(mesh->ReceiveShadow.Get());
    EXPECT_EQ(mesh->Color.Get(), FbxDouble3(1, 0.5, 0));
    ASSERT_TRUE(mesh->FindProperty("mood").IsValid());
    EXPECT_EQ(mesh->FindProperty("mood").Get<FbxDouble>(), 0.75);
}

TEST_F(GeometryConverter, CarriesTheAnimationOfProperties) {
    FbxPatch* patch = bilinear(1);
    auto* stack = FbxAnimStack::Create(scene, "stack");
    auto* layer = FbxAnimLayer::Create(scene, "layer");
    stack->ConnectSrcObject(layer);
    FbxAnimCurve* curve = addShape(*patch, 0, FbxVector4(0, 0, 1, 0))->DeformPercent.GetCurve(layer, true);
    ASSERT_NE(curve, nullptr);
    FbxMesh* mesh = converted(patch);
    ASSERT_NE(mesh, nullptr);
    EXPECT_EQ(mesh->GetShapeChannel(0, 0, layer), curve);
}

TEST_F(GeometryConverter, SpreadsSkinWeightsAsThePointsAreBlended) {
    FbxPatch* patch = bilinear(2);
    auto* bone = make<FbxNode>("bone");
    addSkin(*patch, bone, {{0, 0.5}, {0, 0.5}, {1, 0.25}, {77, 1.0}, {-1, 1.0}});
    FbxMesh* mesh = converted(patch);
    ASSERT_NE(mesh, nullptr);
    ASSERT_EQ(mesh->GetDeformerCount(FbxDeformer::eSkin), 1);
    auto* skin = static_cast<FbxSkin*>(mesh->GetDeformer(0, FbxDeformer::eSkin));
    EXPECT_STREQ(skin->GetName(), "skin");
    EXPECT_EQ(skin->GetSkinningType(), FbxSkin::eDualQuaternion);
    ASSERT_EQ(skin->GetClusterCount(), 1);
    FbxCluster* cluster = skin->GetCluster(0);
    EXPECT_EQ(cluster->GetLink(), bone);
    EXPECT_EQ(cluster->GetLinkMode(), FbxCluster::eTotalOne);
    FbxAMatrix matrix;
    expectNear(cluster->GetTransformLinkMatrix(matrix).GetT(), FbxVector4(1, 2, 3));
    expectNear(cluster->GetTransformMatrix(matrix).GetT(), FbxVector4(1, 2, 3));
    std::vector<double> weights(9);
    for (int i = 0; i < cluster->GetControlPointIndicesCount(); ++i)
        weights.at(static_cast<std::size_t>(cluster->GetControlPointIndices()[i])) +=
            cluster->GetControlPointWeights()[i];
    // 1 at the first corner and 1/4 at the second, falling off to the other side.
    EXPECT_EQ(weights, (std::vector<double>{1, 0.625, 0.25, 0.5, 0.3125, 0.125, 0, 0, 0}));
    EXPECT_EQ(scene->GetSrcObjectCount<FbxSkin>(), 1);
    EXPECT_EQ(scene->GetSrcObjectCount<FbxCluster>(), 1);
    EXPECT_EQ(bone->GetScene(), scene);
}

TEST_F(GeometryConverter, MovesShapesAsThePointsAreBlended) {
    FbxPatch* patch = bilinear(2);
    addShape(*patch, 3, FbxVector4(0, 0, 4, 0));
    FbxMesh* mesh = converted(patch);
    ASSERT_NE(mesh, nullptr);
    ASSERT_EQ(mesh->GetShapeCount(), 1);
    auto* blendShape = static_cast<FbxBlendShape*>(mesh->GetDeformer(0, FbxDeformer::eBlendShape));
    FbxBlendShapeChannel* channel = blendShape->GetBlendShapeChannel(0);
    EXPECT_STREQ(channel->GetName(), "channel");
    EXPECT_EQ(channel->DeformPercent.Get(), 25.0);
    EXPECT_EQ(channel->GetTargetShapeFullWeights()[0], 80.0);
    const FbxShape* shape = channel->GetTargetShape(0);
    ASSERT_EQ(shape->GetControlPointsCount(), 9);
    const double lifts[9] = {0, 0, 0, 0, 1, 2, 0, 2, 4};
    for (int i = 0; i < 9; ++i)
        expectNear(shape->GetControlPointAt(i), mesh->GetControlPointAt(i) + FbxVector4(0, 0, lifts[i], 0));
    EXPECT_EQ(scene->GetSrcObjectCount<FbxShape>(), 1);
}

TEST_F(GeometryConverter, LeavesTheDeformersOfAnUnreplacedSurfaceAlone) {
    FbxPatch* patch = bilinear(1);
    FbxSkin* skin = addSkin(*patch, node, {{0, 1.0}});
    FbxMesh* mesh = converted(patch, false);
    ASSERT_NE(mesh, nullptr);
    EXPECT_EQ(patch->GetDeformer(0), skin);
    EXPECT_NE(mesh->GetDeformer(0), skin);
    EXPECT_EQ(skin->GetCluster(0)->GetControlPointIndicesCount(), 1);
}

TEST_F(GeometryConverter, DropsPointCachesOfSurfaces) {
    FbxPatch* patch = bilinear(1);
    patch->AddDeformer(make<FbxVertexCacheDeformer>());
    FbxMesh* mesh = converted(patch);
    ASSERT_NE(mesh, nullptr);
    EXPECT_EQ(mesh->GetDeformerCount(), 0);
}

TEST_F(GeometryConverter, CutsPolygonsIntoFans) {
    FbxMesh* polygon = polygons();
    FbxMesh* mesh = converted(polygon);
    ASSERT_NE(mesh, nullptr);
    EXPECT_EQ(cornersOf(*mesh), (std::vector<int>{0, 1, 2, 0, 2, 3, 0, 3, 4, 1, 5, 2}));
    EXPECT_TRUE(mesh->IsTriangleMesh());
    EXPECT_EQ(mesh->GetControlPointsCount(), 6);
    expectNear(mesh->GetControlPointAt(3), FbxVector4(1, 3, 0));
    EXPECT_EQ(node->GetMesh(), mesh);
}

TEST_F(GeometryConverter, CarriesLayersOfPolygons) {
    FbxMesh* mesh = polygons();
    FbxLayer* layer = mesh->GetLayer(mesh->CreateLayer());
    auto* uvs = FbxLayerElementUV::Create(mesh, "map");
    uvs->SetMappingMode(FbxLayerElement::eByPolygonVertex);
    uvs->SetReferenceMode(FbxLayerElement::eIndexToDirect);
    uvs->GetDirectArray().Add(FbxVector2(7, 8));
    for (int corner = 0; corner < 10; ++corner)
        uvs->GetIndexArray().Add(10 * corner);
    layer->SetUVs(uvs);
    auto* normals = FbxLayerElementNormal::Create(mesh, "");
    normals->SetMappingMode(FbxLayerElement::eByPolygonVertex);
    for (int corner = 0; corner < 10; ++corner)
        normals->GetDirectArray().Add(FbxVector4(corner, 0, 0));
    layer->SetNormals(normals);
    auto* materials = FbxLayerElementMaterial::Create(mesh, "");
    materials->SetMappingMode(FbxLayerElement::eByPolygon);
    materials->SetReferenceMode(FbxLayerElement::eIndexToDirect);
    for (const int material : {5, 6, 7})
        materials->GetIndexArray().Add(material);
    layer->SetMaterials(materials);
    auto* colors = FbxLayerElementVertexColor::Create(mesh, "");
    colors->SetMappingMode(FbxLayerElement::eByControlPoint);
    for (int point = 0; point < 6; ++point)
        colors->GetDirectArray().Add(FbxColor(point, 0, 0, 1));
    layer->SetVertexColors(colors);
    auto* smoothing = FbxLayerElementSmoothing::Create(mesh, "");
    smoothing->SetMappingMode(FbxLayerElement::eByEdge);
    layer->SetSmoothing(smoothing);

    FbxMesh* triangles = converted(mesh);
    ASSERT_NE(triangles, nullptr);
    ASSERT_EQ(triangles->GetLayerCount(), 1);
    FbxLayer* carried = triangles->GetLayer(0);
    const int corners[12] = {0, 1, 2, 0, 2, 3, 0, 3, 4, 7, 8, 9};
    for (int i = 0; i < 12; ++i) {
        EXPECT_EQ(carried->GetUVs()->GetIndexArray().GetAt(i), 10 * corners[i]);
        EXPECT_EQ(carried->GetNormals()->GetDirectArray().GetAt(i)[0], corners[i]);
    }
    EXPECT_STREQ(carried->GetUVs()->GetName(), "map");
    EXPECT_EQ(carried->GetUVs()->GetDirectArray().GetAt(0), FbxVector2(7, 8));
    ASSERT_EQ(carried->GetMaterials()->GetIndexArray().GetCount(), 4);
    EXPECT_EQ(carried->GetMaterials()->GetIndexArray().GetAt(2), 5);
    EXPECT_EQ(carried->GetMaterials()->GetIndexArray().GetAt(3), 7);
    EXPECT_EQ(carried->GetVertexColors()->GetDirectArray().GetCount(), 6);
    EXPECT_EQ(carried->GetSmoothing(), nullptr);
}

TEST_F(GeometryConverter, KeepsTheDeformersOfPolygonsAsTheyAre) {
    FbxMesh* mesh = polygons();
    addSkin(*mesh, node, {{5, 0.5}});
    addShape(*mesh, 2, FbxVector4(0, 0, 4, 0));
    auto* cache = make<FbxVertexCacheDeformer>();
    mesh->AddDeformer(cache);
    FbxMesh* triangles = converted(mesh);
    ASSERT_NE(triangles, nullptr);
    ASSERT_EQ(triangles->GetDeformerCount(), 3);
    const FbxCluster* cluster = static_cast<FbxSkin*>(triangles->GetDeformer(0))->GetCluster(0);
    ASSERT_EQ(cluster->GetControlPointIndicesCount(), 1);
    EXPECT_EQ(cluster->GetControlPointIndices()[0], 5);
    EXPECT_EQ(cluster->GetControlPointWeights()[0], 0.5);
    const FbxShape* shape =
        static_cast<FbxBlendShape*>(triangles->GetDeformer(1))->GetBlendShapeChannel(0)->GetTargetShape(0);
    expectNear(shape->GetControlPointAt(2), FbxVector4(2, 2, 4));
    EXPECT_EQ(triangles->GetDeformer(2), cache);
}

TEST_F(GeometryConverter, ReturnsAMeshOfTrianglesAsItIs) {
    auto* mesh = make<FbxMesh>();
    mesh->InitControlPoints(3);
    addPolygon(*mesh, {0, 1, 2});
    node->SetNodeAttribute(mesh);
    EXPECT_EQ(converted(mesh), mesh);
    auto* empty = make<FbxMesh>();
    EXPECT_EQ(converted(empty), empty);
}

TEST_F(GeometryConverter, GivesNullForOtherKindsAndLeavesThemAlone) {
    auto* null = make<FbxNull>();
    node->SetNodeAttribute(null);
    EXPECT_EQ(converter.Triangulate(null, true), nullptr);
    EXPECT_EQ(converter.Triangulate(static_cast<FbxNodeAttribute*>(nullptr), true), nullptr);
    EXPECT_EQ(converter.Triangulate(make<FbxLine>(), true), nullptr);
    EXPECT_EQ(converter.Triangulate(make<FbxNurbsCurve>(), true), nullptr);
    EXPECT_EQ(converter.Triangulate(make<FbxTrimNurbsSurface>(), true), nullptr);
    EXPECT_EQ(node->GetNodeAttribute(), null);
}

TEST_F(GeometryConverter, GivesNullForADegenerateSurfaceAndLeavesItAlone) {
    auto* surface = make<FbxNurbs>();
    surface->InitControlPoints(4, FbxNurbs::eOpen, 4, FbxNurbs::eOpen); // all knots are zero
    addSkin(*surface, node, {{0, 1.0}});
    node->SetNodeAttribute(surface);
    EXPECT_EQ(converter.Triangulate(surface, true), nullptr);
    EXPECT_EQ(node->GetNodeAttribute(), surface);
    EXPECT_EQ(surface->GetDeformerCount(), 1);
    EXPECT_EQ(scene->GetSrcObjectCount<FbxMesh>(), 0);
}

TEST_F(GeometryConverter, KeepsASurfaceThatATrimmedOneIsCutFrom) {
    auto* surface = make<FbxNurbsSurface>();
    detail::makeCylinder(*surface);
    node->SetNodeAttribute(surface);
    auto* trimmed = make<FbxTrimNurbsSurface>();
    trimmed->SetNurbsSurface(surface);
    ASSERT_NE(converted(surface), nullptr);
    EXPECT_EQ(trimmed->GetNurbsSurface(), surface);
    EXPECT_EQ(surface->GetNodeCount(), 0);
}

TEST_F(GeometryConverter, ConvertsAWholeScene) {
    FbxMesh* polygon = polygons();
    FbxNode* second = make<FbxNode>("second");
    scene->GetRootNode()->AddChild(second);
    auto* surface = make<FbxNurbs>();
    detail::makeSphere(*surface);
    second->SetNodeAttribute(surface);
    FbxNode* instance = make<FbxNode>("instance");
    instance->SetNodeAttribute(surface);
    EXPECT_TRUE(converter.Triangulate(scene, true));
    ASSERT_NE(node->GetMesh(), nullptr);
    EXPECT_NE(node->GetMesh(), polygon);
    ASSERT_NE(second->GetMesh(), nullptr);
    EXPECT_EQ(second->GetMesh(), instance->GetMesh());
    EXPECT_EQ(scene->GetSrcObjectCount<FbxNurbs>(), 0);
}

TEST_F(GeometryConverter, SaysWhenPartOfASceneCouldNotBeConverted) {
    polygons();
    FbxNode* second = make<FbxNode>("second");
    second->SetNodeAttribute(make<FbxPatch>());
    EXPECT_FALSE(converter.Triangulate(scene, true));
    EXPECT_TRUE(node->GetMesh()->IsTriangleMesh());
    EXPECT_FALSE(converter.Triangulate(static_cast<FbxScene*>(nullptr), true));
}

TEST_F(GeometryConverter, FillsTheMeshOfAReplacedSurfaceWithWhatOneBesideItHas) {
    FbxPatch* patch = bilinear(3);
    FbxMesh* beside = converted(patch, false);

    FbxMesh* late = converted(patch);

    ASSERT_TRUE(beside && late);
    EXPECT_EQ(scene->GetSrcObjectCount<FbxPatch>(), 0);
    EXPECT_EQ(cornersOf(*late), cornersOf(*beside));
    ASSERT_EQ(late->GetControlPointsCount(), beside->GetControlPointsCount());
    for (int i = 0; i < late->GetControlPointsCount(); ++i)
        expectNear(late->GetControlPointAt(i), beside->GetControlPointAt(i), 0.0);
    ASSERT_TRUE(late->GetLayer(0) && late->GetLayer(0)->GetNormals() && late->GetLayer(0)->GetUVs());
    EXPECT_EQ(late->GetLayer(0)->GetNormals()->GetDirectArray().GetCount(), late->GetPolygonVertexCount());
}

TEST_F(GeometryConverter, FreesASurfaceWhoseMeshWasNeverAccessed) {
    FbxMesh* mesh = converted(bilinear(3));
    const std::size_t objects = manager->data().objects.size();

    mesh->Destroy();

    EXPECT_EQ(manager->data().objects.size(), objects - 2) << "the mesh and its surface";
}

TEST_F(GeometryConverter, LeavesASurfaceWithoutAFinitePlaceAsItIs) {
    FbxPatch* patch = bilinear(3);
    patch->SetControlPointAt(FbxVector4(std::numeric_limits<double>::infinity(), 0, 0), 1);

    EXPECT_EQ(converted(patch), nullptr);

    EXPECT_EQ(node->GetNodeAttribute(), patch);
}

TEST_F(GeometryConverter, MakesStepsCoarserOnceASceneHasSamplesEnough) {
    int first = 0, last = 0;
    std::int64_t all = 0;
    for (int i = 0; i < 200; ++i) {
        node = make<FbxNode>("node");
        last = converted(bilinear(100))->GetControlPointsCount();
        first = i == 0 ? last : first;
        all += last;
    }

    EXPECT_EQ(first, 101 * 101);
    EXPECT_GE(last, 13 * 13);
    EXPECT_LE(last, 4 * detail::kSamplesPerControlPoint);
    EXPECT_LE(all, detail::kSamplesOfAnyScene + 200 * 4 * detail::kSamplesPerControlPoint);
    EXPECT_GT(converter.coarserSurfaces(), 100);
}

} // namespace
} // namespace fbxsdk
