// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes, layers, skins, blend shapes, caches and other geometry in files of every version.
#include "geometry/GeometryWriting.h"

#include <string>
#include <vector>

#include <gmock/gmock.h>

#include <fbxsdk/FbxAMatrix.h>
#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxBlendShape.h>
#include <fbxsdk/FbxBlendShapeChannel.h>
#include <fbxsdk/FbxCache.h>
#include <fbxsdk/FbxCluster.h>
#include <fbxsdk/FbxLine.h>
#include <fbxsdk/FbxNurbsCurve.h>
#include <fbxsdk/FbxNurbsSurface.h>
#include <fbxsdk/FbxPatch.h>
#include <fbxsdk/FbxSkeleton.h>
#include <fbxsdk/FbxSkin.h>
#include <fbxsdk/FbxVertexCacheDeformer.h>

#include "ExportFixture.h"
#include "platform/scene/Animate.h"

namespace {

using namespace fbxsdk;
using Element = FbxLayerElement;

class GeometryWriting : public exporting::EveryLayout {
protected:
    /// Two polygons, a triangle and a quadrangle, over five points.
    FbxMesh* addMesh(const char* name = "mesh") {
        FbxMesh* mesh = make<FbxMesh>(name);
        mesh->InitControlPoints(5);
        for (int i = 0; i < 5; ++i)
            mesh->SetControlPointAt(FbxVector4(i, 0.1 * i, -i), i);
        for (const std::vector<int>& corners : {std::vector<int>{0, 1, 2}, std::vector<int>{4, 3, 2, 1}}) {
            mesh->BeginPolygon();
            for (const int corner : corners)
                mesh->AddPolygon(corner);
            mesh->EndPolygon();
        }
        addNode(name, mesh);
        return mesh;
    }
};

INSTANTIATE_TEST_SUITE_P(Versions, GeometryWriting, testing::ValuesIn(exporting::allLayouts()));

template <class Item>
std::vector<Item> itemsOf(const FbxLayerElementArrayTemplate<Item>& array) {
    std::vector<Item> items;
    for (int i = 0; i < array.GetCount(); ++i)
        items.push_back(array.GetAt(i));
    return items;
}

void expectPoint(const FbxVector4& point, double x, double y, double z) {
    EXPECT_EQ(point[0], x);
    EXPECT_EQ(point[1], y);
    EXPECT_EQ(point[2], z);
}

TEST_P(GeometryWriting, KeepsPointsAndPolygons) {
    addMesh();

    FbxMesh* back = attributeOf<FbxMesh>(writeAndRead());

    ASSERT_NE(back, nullptr);
    ASSERT_EQ(back->GetControlPointsCount(), 5);
    for (int i = 0; i < 5; ++i)
        expectPoint(back->GetControlPointAt(i), i, 0.1 * i, -i);
    ASSERT_EQ(back->GetPolygonCount(), 2);
    EXPECT_EQ(std::vector<int>(back->GetPolygonVertices(), back->GetPolygonVertices() + 7),
              std::vector<int>({0, 1, 2, 4, 3, 2, 1}));
    EXPECT_EQ(back->GetPolygonSize(1), 4);
}

TEST_P(GeometryWriting, KeepsAMeshWithoutAnything) {
    addNode("node", make<FbxMesh>("empty"));

    FbxMesh* back = attributeOf<FbxMesh>(writeAndRead());

    ASSERT_NE(back, nullptr);
    EXPECT_EQ(back->GetControlPointsCount(), 0);
    EXPECT_EQ(back->GetPolygonCount(), 0);
    EXPECT_EQ(back->GetLayerCount(), 0);
}

TEST_P(GeometryWriting, KeepsNormalsOfEveryMapping) {
    FbxMesh* mesh = addMesh();
    const struct {
        Element::EMappingMode mapping;
        int count;
    } kMappings[] = {{Element::eByControlPoint, 5},
                     {Element::eByPolygonVertex, 7},
                     {Element::eByPolygon, 2},
                     {Element::eAllSame, 1}};
    for (const auto& row : kMappings) {
        FbxLayer* layer = mesh->GetLayer(mesh->CreateLayer());
        auto* normals = FbxLayerElementNormal::Create(mesh, "normals");
        normals->SetMappingMode(row.mapping);
        normals->SetReferenceMode(Element::eDirect);
        for (int i = 0; i < row.count; ++i)
            normals->GetDirectArray().Add(FbxVector4(i, 1.0 / (i + 1), -0.0, 1.0));
        layer->SetNormals(normals);
    }

    FbxMesh* back = attributeOf<FbxMesh>(writeAndRead());

    ASSERT_NE(back, nullptr);
    ASSERT_EQ(back->GetLayerCount(), 4);
    for (int i = 0; i < 4; ++i) {
        const FbxLayerElementNormal* normals = back->GetLayer(i)->GetNormals();
        ASSERT_NE(normals, nullptr) << i;
        EXPECT_STREQ(normals->GetName(), "normals");
        EXPECT_EQ(normals->GetMappingMode(), kMappings[i].mapping);
        EXPECT_EQ(normals->GetReferenceMode(), Element::eDirect);
        ASSERT_EQ(normals->GetDirectArray().GetCount(), kMappings[i].count);
        for (int k = 0; k < kMappings[i].count; ++k)
            expectPoint(normals->GetDirectArray().GetAt(k), k, 1.0 / (k + 1), 0);
    }
}

/// The fourth numbers of vectors are 1 in versions that do not write them.
TEST_P(GeometryWriting, KeepsTheFourthNumbersOfNormalsTangentsAndBinormals) {
    constexpr int kManyCorners = 4000; // enough for their array to be fetched in portions
    const bool written = detail::findVersion(GetParam().version)->fourthNumbers;
    FbxMesh* mesh = addMesh();
    FbxLayer* layer = mesh->GetLayer(mesh->CreateLayer());
    const auto fill = [&](auto* element, int count, double unusual) {
        element->SetMappingMode(Element::eByPolygonVertex);
        for (int i = 0; i < count; ++i)
            element->GetDirectArray().Add(FbxVector4(i, 2, 3, i % 2 == 0 ? unusual : 1.0));
        return element;
    };
    layer->SetNormals(fill(FbxLayerElementNormal::Create(mesh, ""), kManyCorners, 0.0));
    layer->SetTangents(fill(FbxLayerElementTangent::Create(mesh, ""), 7, -1.0));
    layer->SetBinormals(fill(FbxLayerElementBinormal::Create(mesh, ""), kManyCorners, 1.0));

    const FbxMesh* back = attributeOf<FbxMesh>(writeAndRead());

    ASSERT_NE(back, nullptr);
    const auto expectVectors = [&](const auto* element, int count, double unusual) {
        ASSERT_NE(element, nullptr);
        ASSERT_EQ(element->GetDirectArray().GetCount(), count);
        for (int i = 0; i < count; ++i) {
            const double fourth = i % 2 == 0 && written ? unusual : 1.0;
            ASSERT_EQ(element->GetDirectArray().GetAt(i), FbxVector4(i, 2, 3, fourth)) << i;
        }
    };
    expectVectors(back->GetLayer(0)->GetNormals(), kManyCorners, 0.0);
    expectVectors(back->GetLayer(0)->GetTangents(), 7, -1.0);
    expectVectors(back->GetLayer(0)->GetBinormals(), kManyCorners, 1.0);
}

TEST_P(GeometryWriting, KeepsIndexedCoordinatesAndColours) {
    FbxMesh* mesh = addMesh();
    FbxLayer* layer = mesh->GetLayer(mesh->CreateLayer());
    auto* uvs = FbxLayerElementUV::Create(mesh, "map1");
    uvs->SetMappingMode(Element::eByPolygonVertex);
    uvs->SetReferenceMode(Element::eIndexToDirect);
    uvs->GetDirectArray().Add(FbxVector2(0.25, 0.5));
    uvs->GetDirectArray().Add(FbxVector2(1.0 / 3, -1));
    auto* colors = FbxLayerElementVertexColor::Create(mesh, "colours");
    colors->SetMappingMode(Element::eByPolygonVertex);
    colors->SetReferenceMode(Element::eIndexToDirect);
    colors->GetDirectArray().Add(FbxColor(0.1, 0.2, 0.3, 0.4));
    for (int i = 0; i < 7; ++i) {
        uvs->GetIndexArray().Add(i % 2);
        colors->GetIndexArray().Add(0);
    }
    layer->SetUVs(uvs);
    layer->SetVertexColors(colors);
    auto* bump = FbxLayerElementUV::Create(mesh, "bump");
    bump->SetMappingMode(Element::eByControlPoint);
    bump->GetDirectArray().SetCount(5);
    layer->SetUVs(bump, Element::eTextureBump);

    FbxMesh* back = attributeOf<FbxMesh>(writeAndRead());

    ASSERT_NE(back, nullptr);
    const FbxLayerElementUV* backUVs = back->GetLayer(0)->GetUVs();
    ASSERT_NE(backUVs, nullptr);
    EXPECT_STREQ(backUVs->GetName(), "map1");
    EXPECT_EQ(backUVs->GetDirectArray().GetAt(1)[0], 1.0 / 3);
    EXPECT_EQ(itemsOf(backUVs->GetIndexArray()), std::vector<int>({0, 1, 0, 1, 0, 1, 0}));
    const FbxLayerElementVertexColor* backColors = back->GetLayer(0)->GetVertexColors();
    ASSERT_NE(backColors, nullptr);
    EXPECT_EQ(backColors->GetDirectArray().GetAt(0), FbxColor(0.1, 0.2, 0.3, 0.4));
    EXPECT_EQ(backColors->GetIndexArray().GetCount(), 7);
    ASSERT_NE(back->GetLayer(0)->GetUVs(Element::eTextureBump), nullptr);
    EXPECT_STREQ(back->GetLayer(0)->GetUVs(Element::eTextureBump)->GetName(), "bump");
}

TEST_P(GeometryWriting, KeepsTheOtherElements) {
    FbxMesh* mesh = addMesh();
    FbxLayer* layer = mesh->GetLayer(mesh->CreateLayer());
    auto* tangents = FbxLayerElementTangent::Create(mesh, "");
    tangents->SetMappingMode(Element::eByControlPoint);
    tangents->GetDirectArray().SetCount(5);
    layer->SetTangents(tangents);
    auto* binormals = FbxLayerElementBinormal::Create(mesh, "");
    binormals->SetMappingMode(Element::eByControlPoint);
    binormals->GetDirectArray().SetCount(5);
    layer->SetBinormals(binormals);
    auto* smoothing = FbxLayerElementSmoothing::Create(mesh, "");
    smoothing->SetMappingMode(Element::eByPolygon);
    for (const int bits : {5, -2147483647})
        smoothing->GetDirectArray().Add(bits);
    layer->SetSmoothing(smoothing);
    auto* crease = FbxLayerElementCrease::Create(mesh, "");
    crease->SetMappingMode(Element::eByControlPoint);
    for (int i = 0; i < 5; ++i)
        crease->GetDirectArray().Add(0.5 * i);
    layer->SetVertexCrease(crease);
    auto* hole = FbxLayerElementHole::Create(mesh, "");
    hole->SetMappingMode(Element::eByPolygon);
    hole->GetDirectArray().Add(true);
    hole->GetDirectArray().Add(false);
    layer->SetHole(hole);
    auto* groups = FbxLayerElementPolygonGroup::Create(mesh, "");
    groups->SetMappingMode(Element::eByPolygon);
    groups->SetReferenceMode(Element::eIndex);
    for (const int group : {7, 8})
        groups->GetIndexArray().Add(group);
    layer->SetPolygonGroups(groups);

    FbxMesh* back = attributeOf<FbxMesh>(writeAndRead());

    ASSERT_NE(back, nullptr);
    ASSERT_EQ(back->GetLayerCount(), 1);
    FbxLayer* backLayer = back->GetLayer(0);
    ASSERT_TRUE(backLayer->GetTangents() && backLayer->GetBinormals() && backLayer->GetSmoothing() &&
                backLayer->GetVertexCrease() && backLayer->GetHole() && backLayer->GetPolygonGroups());
    EXPECT_EQ(itemsOf(backLayer->GetSmoothing()->GetDirectArray()), std::vector<int>({5, -2147483647}));
    EXPECT_EQ(itemsOf(backLayer->GetVertexCrease()->GetDirectArray()), std::vector<double>({0, 0.5, 1, 1.5, 2}));
    EXPECT_TRUE(backLayer->GetHole()->GetDirectArray().GetAt(0));
    EXPECT_FALSE(backLayer->GetHole()->GetDirectArray().GetAt(1));
    EXPECT_EQ(itemsOf(backLayer->GetPolygonGroups()->GetIndexArray()), std::vector<int>({7, 8}));
}

TEST_P(GeometryWriting, KeepsMaterialNumbers) {
    FbxMesh* mesh = addMesh();
    FbxLayer* layer = mesh->GetLayer(mesh->CreateLayer());
    auto* materials = FbxLayerElementMaterial::Create(mesh, "");
    materials->SetMappingMode(Element::eByPolygon);
    materials->SetReferenceMode(Element::eIndexToDirect);
    for (const int material : {1, 0})
        materials->GetIndexArray().Add(material);
    layer->SetMaterials(materials);

    FbxMesh* back = attributeOf<FbxMesh>(writeAndRead());

    ASSERT_NE(back, nullptr);
    ASSERT_NE(back->GetLayer(0)->GetMaterials(), nullptr);
    EXPECT_EQ(back->GetLayer(0)->GetMaterials()->GetMappingMode(), Element::eByPolygon);
    EXPECT_EQ(itemsOf(back->GetLayer(0)->GetMaterials()->GetIndexArray()), std::vector<int>({1, 0}));
}

TEST_P(GeometryWriting, GivesOneMaterialForAllTheFirstNumber) {
    FbxMesh* mesh = addMesh();
    auto* materials = FbxLayerElementMaterial::Create(mesh, "");
    materials->SetMappingMode(Element::eAllSame);
    materials->SetReferenceMode(Element::eIndexToDirect);
    mesh->GetLayer(mesh->CreateLayer())->SetMaterials(materials);

    FbxMesh* back = attributeOf<FbxMesh>(writeAndRead());

    ASSERT_NE(back, nullptr);
    ASSERT_NE(back->GetLayer(0)->GetMaterials(), nullptr);
    EXPECT_EQ(itemsOf(back->GetLayer(0)->GetMaterials()->GetIndexArray()), std::vector<int>({0}));
}

TEST_P(GeometryWriting, LeavesOutElementsByEdgeOfAMeshWithoutEdges) {
    FbxMesh* mesh = addMesh();
    auto* smoothing = FbxLayerElementSmoothing::Create(mesh, "");
    smoothing->SetMappingMode(Element::eByEdge);
    smoothing->GetDirectArray().SetCount(6);
    mesh->GetLayer(mesh->CreateLayer())->SetSmoothing(smoothing);

    const std::string bytes = write();

    EXPECT_EQ(bytes.find("Smoothing"), std::string::npos);
}

TEST_P(GeometryWriting, KeepsLargeMeshes) {
    FbxMesh* mesh = make<FbxMesh>("grid");
    constexpr int kSide = 100;
    mesh->InitControlPoints(kSide * kSide);
    for (int i = 0; i < kSide * kSide; ++i)
        mesh->SetControlPointAt(FbxVector4(i % kSide / 7.0, i / kSide / 3.0, 1.0 / (i + 1)), i);
    for (int i = 0; i + kSide + 1 < kSide * kSide; ++i) {
        mesh->BeginPolygon();
        for (const int corner : {i, i + 1, i + kSide + 1, i + kSide})
            mesh->AddPolygon(corner);
        mesh->EndPolygon();
    }
    addNode("node", mesh);

    FbxMesh* back = attributeOf<FbxMesh>(writeAndRead());

    ASSERT_NE(back, nullptr);
    ASSERT_EQ(back->GetControlPointsCount(), kSide * kSide);
    for (int i = 0; i < kSide * kSide; ++i)
        expectPoint(back->GetControlPointAt(i), i % kSide / 7.0, i / kSide / 3.0, 1.0 / (i + 1));
    EXPECT_EQ(back->GetPolygonCount(), mesh->GetPolygonCount());
}

TEST_P(GeometryWriting, KeepsASkin) {
    FbxMesh* mesh = addMesh();
    FbxNode* bone = addNode("bone", make<FbxSkeleton>("bone"));
    FbxSkin* skin = make<FbxSkin>("skin");
    skin->SetDeformAccuracy(75.0);
    skin->SetSkinningType(FbxSkin::eDualQuaternion);
    skin->AddControlPointIndex(1, 0.5);
    FbxCluster* cluster = make<FbxCluster>("cluster");
    cluster->SetLink(bone);
    cluster->SetLinkMode(FbxCluster::eTotalOne);
    cluster->AddControlPointIndex(0, 1.0);
    cluster->AddControlPointIndex(4, 0.25);
    FbxAMatrix geometry, link;
    geometry.SetTRS(FbxVector4(1, 2, 3), FbxVector4(10, 20, 30), FbxVector4(1, 2, 1));
    link.SetTRS(FbxVector4(4, 5, 6), FbxVector4(-30, 0, 90), FbxVector4(1, 1, 1));
    cluster->SetTransformMatrix(geometry);
    cluster->SetTransformLinkMatrix(link);
    skin->AddCluster(cluster);
    FbxCluster* empty = make<FbxCluster>("empty");
    empty->SetLink(bone);
    skin->AddCluster(empty);
    mesh->AddDeformer(skin);

    FbxScene* copy = writeAndRead();

    FbxMesh* back = attributeOf<FbxMesh>(copy);
    ASSERT_NE(back, nullptr);
    auto* backSkin = FbxCast<FbxSkin>(back->GetDeformer(0));
    ASSERT_NE(backSkin, nullptr);
    EXPECT_EQ(backSkin->GetDeformAccuracy(), 75.0);
    if (GetParam().hasIds()) {
        EXPECT_EQ(backSkin->GetSkinningType(), FbxSkin::eDualQuaternion);
        ASSERT_EQ(backSkin->GetControlPointIndicesCount(), 1);
        EXPECT_EQ(backSkin->GetControlPointBlendWeights()[0], 0.5);
    }
    ASSERT_EQ(backSkin->GetClusterCount(), 2);
    FbxCluster* backCluster = backSkin->GetCluster(0);
    EXPECT_EQ(backCluster->GetLink(), copy->GetRootNode()->GetChild(1));
    EXPECT_EQ(backCluster->GetLinkMode(), FbxCluster::eTotalOne);
    ASSERT_EQ(backCluster->GetControlPointIndicesCount(), 2);
    EXPECT_EQ(backCluster->GetControlPointIndices()[1], 4);
    EXPECT_EQ(backCluster->GetControlPointWeights()[1], 0.25);
    FbxAMatrix backGeometry, backLink;
    backCluster->GetTransformMatrix(backGeometry);
    backCluster->GetTransformLinkMatrix(backLink);
    for (int i = 0; i < 16; ++i) {
        EXPECT_NEAR(backGeometry[i / 4][i % 4], geometry[i / 4][i % 4], 1e-12) << i;
        EXPECT_EQ(backLink[i / 4][i % 4], link[i / 4][i % 4]) << i;
    }
    EXPECT_EQ(backSkin->GetCluster(1)->GetControlPointIndicesCount(), 0);
}

class ShapeWriting : public GeometryWriting {
protected:
    FbxShape* addShape(FbxBlendShapeChannel* channel, const char* name, double fullPercent, double offset) {
        FbxShape* shape = make<FbxShape>(name);
        shape->InitControlPoints(5);
        for (int i = 0; i < 5; ++i)
            shape->SetControlPointAt(FbxVector4(i, 0.1 * i + (i == 3 ? offset : 0), -i), i);
        channel->AddTargetShape(shape, fullPercent);
        return shape;
    }
    FbxBlendShapeChannel* addChannel(FbxBlendShape* blendShape, const char* name, double percent) {
        FbxBlendShapeChannel* channel = make<FbxBlendShapeChannel>(name);
        channel->DeformPercent.Set(percent);
        blendShape->AddBlendShapeChannel(channel);
        return channel;
    }
};

INSTANTIATE_TEST_SUITE_P(Versions, ShapeWriting, testing::ValuesIn(exporting::allLayouts()));

TEST_P(ShapeWriting, KeepsShapesTheirWeightsAndTheirKeys) {
    FbxMesh* mesh = addMesh();
    FbxBlendShape* blendShape = make<FbxBlendShape>("blend");
    mesh->AddDeformer(blendShape);
    FbxBlendShapeChannel* smile = addChannel(blendShape, "smile", 25);
    FbxBlendShapeChannel* frown = addChannel(blendShape, "frown", 0);
    addShape(smile, "smile", 100, 2);
    addShape(frown, "frown", 100, -3);
    FbxAnimLayer* layer = animate::addStack(*scene, "take");
    animate::keys(frown->DeformPercent, layer, nullptr, {{0, 0}, {1, 80}});

    FbxScene* copy = writeAndRead();

    FbxMesh* back = attributeOf<FbxMesh>(copy);
    ASSERT_NE(back, nullptr);
    ASSERT_EQ(back->GetShapeCount(), 2);
    auto* backBlend = FbxCast<FbxBlendShape>(back->GetDeformer(0, FbxDeformer::eBlendShape));
    ASSERT_NE(backBlend, nullptr);
    ASSERT_EQ(backBlend->GetBlendShapeChannelCount(), 2);
    FbxBlendShapeChannel* backSmile = backBlend->GetBlendShapeChannel(0);
    EXPECT_STREQ(backSmile->GetName(), "smile");
    EXPECT_EQ(backSmile->DeformPercent.Get(), 25.0);
    expectPoint(backSmile->GetTargetShape(0)->GetControlPointAt(3), 3, 0.1 * 3 + 2, -3);
    expectPoint(backSmile->GetTargetShape(0)->GetControlPointAt(2), 2, 0.2, -2);
    expectPoint(backBlend->GetBlendShapeChannel(1)->GetTargetShape(0)->GetControlPointAt(3), 3, 0.1 * 3 - 3, -3);
    auto* backStack = copy->GetSrcObject<FbxAnimStack>(0);
    ASSERT_NE(backStack, nullptr);
    FbxAnimCurve* curve = back->GetShapeChannel(0, 1, backStack->GetMember<FbxAnimLayer>(0));
    ASSERT_NE(curve, nullptr);
    ASSERT_EQ(curve->KeyGetCount(), 2);
    EXPECT_EQ(curve->KeyGetValue(1), 80.0F);
    EXPECT_EQ(back->GetShapeChannel(0, 0, backStack->GetMember<FbxAnimLayer>(0)), nullptr);
}

TEST_P(ShapeWriting, KeepsInBetweensWhereFilesHaveThem) {
    FbxMesh* mesh = addMesh();
    FbxBlendShape* blendShape = make<FbxBlendShape>("blend");
    mesh->AddDeformer(blendShape);
    FbxBlendShapeChannel* channel = addChannel(blendShape, "channel", 0);
    addShape(channel, "half", 50, 1);
    addShape(channel, "full", 100, 5);

    FbxMesh* back = attributeOf<FbxMesh>(writeAndRead());

    ASSERT_NE(back, nullptr);
    auto* backBlend = FbxCast<FbxBlendShape>(back->GetDeformer(0, FbxDeformer::eBlendShape));
    ASSERT_NE(backBlend, nullptr);
    FbxBlendShapeChannel* backChannel = backBlend->GetBlendShapeChannel(0);
    const bool inlined = GetParam().hasInlineShapes();
    ASSERT_EQ(backChannel->GetTargetShapeCount(), inlined ? 1 : 2);
    if (!inlined) {
        EXPECT_EQ(backChannel->GetTargetShapeFullWeights()[0], 50.0);
        EXPECT_EQ(backChannel->GetTargetShapeFullWeights()[1], 100.0);
    }
    expectPoint(backChannel->GetTargetShape(inlined ? 0 : 1)->GetControlPointAt(3), 3, 0.1 * 3 + 5, -3);
}

TEST_P(ShapeWriting, DistinguishesShapesOfOneName) {
    FbxMesh* mesh = addMesh();
    FbxBlendShape* blendShape = make<FbxBlendShape>("blend");
    mesh->AddDeformer(blendShape);
    for (int i = 0; i < 3; ++i)
        addShape(addChannel(blendShape, "", 10.0 * i), i == 2 ? "Color" : "", 100, i + 1);

    FbxMesh* back = attributeOf<FbxMesh>(writeAndRead());

    ASSERT_NE(back, nullptr);
    auto* backBlend = FbxCast<FbxBlendShape>(back->GetDeformer(0, FbxDeformer::eBlendShape));
    ASSERT_NE(backBlend, nullptr);
    ASSERT_EQ(backBlend->GetBlendShapeChannelCount(), 3);
    for (int i = 0; i < 3; ++i) {
        FbxBlendShapeChannel* channel = backBlend->GetBlendShapeChannel(i);
        EXPECT_EQ(channel->DeformPercent.Get(), 10.0 * i);
        expectPoint(channel->GetTargetShape(0)->GetControlPointAt(3), 3, 0.1 * 3 + i + 1, -3);
    }
    expectPoint(FbxVector4(back->Color.Get()[0], back->Color.Get()[1], back->Color.Get()[2]), 0.8, 0.8, 0.8);
}

TEST_P(GeometryWriting, KeepsANurbsSurface) {
    FbxNurbsSurface* surface = make<FbxNurbsSurface>("surface");
    surface->SetOrder(4, 3);
    surface->SetStep(5, 6);
    surface->InitControlPoints(5, FbxNurbsSurfaceBase::eOpen, 4, FbxNurbsSurfaceBase::eOpen);
    for (int i = 0; i < 20; ++i)
        surface->SetControlPointAt(FbxVector4(i, i * i, -i, 1.0 + i), i);
    for (int i = 0; i < surface->GetUKnotCount(); ++i)
        surface->GetUKnotVector()[i] = i;
    for (int i = 0; i < surface->GetVKnotCount(); ++i)
        surface->GetVKnotVector()[i] = 2 * i;
    surface->SetFlipNormals(true);
    addNode("node", surface);

    FbxNurbsSurface* back = attributeOf<FbxNurbsSurface>(writeAndRead());

    ASSERT_NE(back, nullptr);
    EXPECT_EQ(back->GetUOrder(), 4);
    EXPECT_EQ(back->GetVOrder(), 3);
    EXPECT_EQ(back->GetUStep(), 5);
    EXPECT_EQ(back->GetVStep(), 6);
    ASSERT_EQ(back->GetControlPointsCount(), 20);
    EXPECT_EQ(back->GetControlPointAt(7)[3], 8.0);
    ASSERT_EQ(back->GetVKnotCount(), surface->GetVKnotCount());
    EXPECT_EQ(back->GetVKnotVector()[3], 6.0);
    EXPECT_TRUE(back->GetFlipNormals());
}

TEST_P(GeometryWriting, KeepsANurbsCurve) {
    FbxNurbsCurve* curve = make<FbxNurbsCurve>("curve");
    curve->SetOrder(3);
    curve->InitControlPoints(4, FbxNurbsCurve::eOpen);
    for (int i = 0; i < 4; ++i)
        curve->SetControlPointAt(FbxVector4(i, 2 * i, 0, 0.5), i);
    for (int i = 0; i < curve->GetKnotCount(); ++i)
        curve->GetKnotVector()[i] = 0.25 * i;
    addNode("node", curve);

    FbxNurbsCurve* back = attributeOf<FbxNurbsCurve>(writeAndRead());

    ASSERT_NE(back, nullptr);
    EXPECT_EQ(back->GetOrder(), 3);
    ASSERT_EQ(back->GetControlPointsCount(), 4);
    EXPECT_EQ(back->GetControlPointAt(3)[1], 6.0);
    EXPECT_EQ(back->GetControlPointAt(3)[3], 0.5);
    ASSERT_EQ(back->GetKnotCount(), 7);
    EXPECT_EQ(back->GetKnotVector()[6], 1.5);
}

TEST_P(GeometryWriting, KeepsAPatch) {
    FbxPatch* patch = make<FbxPatch>("patch");
    patch->InitControlPoints(4, FbxPatch::eBezier, 5, FbxPatch::eBSpline);
    for (int i = 0; i < 20; ++i)
        patch->SetControlPointAt(FbxVector4(i, 0, -i), i);
    patch->SetStep(2, 3);
    patch->SetClosed(false, true);
    patch->SetUCapped(true, false);
    addNode("node", patch);

    FbxPatch* back = attributeOf<FbxPatch>(writeAndRead());

    ASSERT_NE(back, nullptr);
    EXPECT_EQ(back->GetUCount(), 4);
    EXPECT_EQ(back->GetPatchVType(), FbxPatch::eBSpline);
    EXPECT_EQ(back->GetVStep(), 3);
    EXPECT_TRUE(back->GetVClosed());
    EXPECT_TRUE(back->GetUCappedBottom());
    EXPECT_FALSE(back->GetUCappedTop());
    expectPoint(back->GetControlPointAt(19), 19, 0, -19);
}

TEST_P(GeometryWriting, KeepsLines) {
    FbxLine* line = make<FbxLine>("line");
    line->InitControlPoints(3);
    for (int i = 0; i < 3; ++i)
        line->SetControlPointAt(FbxVector4(i, i, i), i);
    line->SetIndexArraySize(4);
    const int indices[] = {0, 1, 1, 2};
    for (int i = 0; i < 4; ++i)
        line->SetPointIndexAt(indices[i], i, /*pAsEndPoint=*/i % 2 == 1);
    addNode("node", line);

    FbxLine* back = attributeOf<FbxLine>(writeAndRead());

    ASSERT_NE(back, nullptr);
    ASSERT_EQ(back->GetIndexArraySize(), 4);
    EXPECT_EQ(back->GetPointIndexAt(3), 2);
    EXPECT_EQ(back->GetEndPointCount(), 2);
    EXPECT_EQ(back->GetEndPointAt(0), 1);
}

TEST_P(GeometryWriting, KeepsACacheOnItsDeformer) {
    FbxMesh* mesh = make<FbxMesh>("mesh");
    addNode("node", mesh);
    FbxVertexCacheDeformer* deformer = make<FbxVertexCacheDeformer>("deformer");
    deformer->Channel.Set("points");
    deformer->Active.Set(false);
    FbxCache* cache = make<FbxCache>("cache");
    cache->SetCacheFileFormat(FbxCache::eMayaCache);
    cache->SetCacheFileName("fpc\\points.xml", "/absolute/fpc/points.xml");
    deformer->SetCache(cache);
    mesh->AddDeformer(deformer);

    FbxMesh* back = attributeOf<FbxMesh>(writeAndRead());

    ASSERT_NE(back, nullptr);
    auto* backDeformer = FbxCast<FbxVertexCacheDeformer>(back->GetDeformer(0));
    ASSERT_NE(backDeformer, nullptr);
    EXPECT_STREQ(backDeformer->Channel.Get().Buffer(), "points");
    EXPECT_FALSE(backDeformer->Active.Get());
    ASSERT_NE(backDeformer->GetCache(), nullptr);
    EXPECT_EQ(backDeformer->GetCache()->GetCacheFileFormat(), FbxCache::eMayaCache);
    FbxString relative, absolute;
    backDeformer->GetCache()->GetCacheFileName(relative, absolute);
    EXPECT_STREQ(relative.Buffer(), "fpc\\points.xml");
    EXPECT_STREQ(absolute.Buffer(), "/absolute/fpc/points.xml");
}

} // namespace
