// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Layers and elements created by hosts, and their owners.
#include "GeometryFixture.h"

#include <stdexcept>
#include <string>

#include "geometry/LayerElementAccess.h"

using namespace fbxsdk;

namespace {
class FbxLayerTest : public GeometryFixture {};

template <class Call>
std::string messageOf(Call call) {
    try {
        call();
    } catch (const std::runtime_error& error) {
        return error.what();
    }
    return "";
}

} // namespace

TEST_F(FbxLayerTest, AMeshHasNoneAtFirst) {
    const FbxMesh* mesh = make<FbxMesh>();

    EXPECT_EQ(mesh->GetLayerCount(), 0);
    EXPECT_EQ(mesh->GetLayer(0), nullptr);
}

TEST_F(FbxLayerTest, IsNumberedInOrderOfCreation) {
    FbxMesh* mesh = make<FbxMesh>();

    EXPECT_EQ(mesh->CreateLayer(), 0);
    EXPECT_EQ(mesh->CreateLayer(), 1);

    EXPECT_EQ(mesh->GetLayerCount(), 2);
    EXPECT_NE(mesh->GetLayer(0), nullptr);
    EXPECT_NE(mesh->GetLayer(1), mesh->GetLayer(0));
    EXPECT_EQ(mesh->GetLayer(2), nullptr);
    EXPECT_EQ(mesh->GetLayer(-1), nullptr);
}

TEST_F(FbxLayerTest, HasNoElementAtFirst) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->CreateLayer();
    const FbxLayer* layer = mesh->GetLayer(0);

    EXPECT_EQ(layer->GetNormals(), nullptr);
    EXPECT_EQ(layer->GetUVs(), nullptr);
    EXPECT_EQ(layer->GetVertexColors(), nullptr);
    EXPECT_EQ(layer->GetMaterials(), nullptr);
    EXPECT_EQ(layer->GetTextures(FbxLayerElement::eTextureDiffuse), nullptr);
}

TEST_F(FbxLayerTest, KeepsOneElementOfEachType) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->CreateLayer();
    FbxLayer* layer = mesh->GetLayer(0);
    auto* normals = FbxLayerElementNormal::Create(mesh, "");
    auto* binormals = FbxLayerElementBinormal::Create(mesh, "");
    auto* tangents = FbxLayerElementTangent::Create(mesh, "");
    auto* materials = FbxLayerElementMaterial::Create(mesh, "");
    auto* groups = FbxLayerElementPolygonGroup::Create(mesh, "");
    auto* uvs = FbxLayerElementUV::Create(mesh, "");
    auto* colors = FbxLayerElementVertexColor::Create(mesh, "");
    auto* smoothing = FbxLayerElementSmoothing::Create(mesh, "");
    auto* vertexCrease = FbxLayerElementCrease::Create(mesh, "");
    auto* edgeCrease = FbxLayerElementCrease::Create(mesh, "");
    auto* hole = FbxLayerElementHole::Create(mesh, "");
    auto* visibility = FbxLayerElementVisibility::Create(mesh, "");
    auto* textures = FbxLayerElementTexture::Create(mesh, "");
    layer->SetNormals(normals);
    layer->SetBinormals(binormals);
    layer->SetTangents(tangents);
    layer->SetMaterials(materials);
    layer->SetPolygonGroups(groups);
    layer->SetUVs(uvs);
    layer->SetVertexColors(colors);
    layer->SetSmoothing(smoothing);
    layer->SetVertexCrease(vertexCrease);
    layer->SetEdgeCrease(edgeCrease);
    layer->SetHole(hole);
    layer->SetVisibility(visibility);
    layer->SetTextures(FbxLayerElement::eTextureBump, textures);

    EXPECT_EQ(layer->GetNormals(), normals);
    EXPECT_EQ(layer->GetBinormals(), binormals);
    EXPECT_EQ(layer->GetTangents(), tangents);
    EXPECT_EQ(layer->GetMaterials(), materials);
    EXPECT_EQ(layer->GetPolygonGroups(), groups);
    EXPECT_EQ(layer->GetUVs(), uvs);
    EXPECT_EQ(layer->GetVertexColors(), colors);
    EXPECT_EQ(layer->GetSmoothing(), smoothing);
    EXPECT_EQ(layer->GetVertexCrease(), vertexCrease);
    EXPECT_EQ(layer->GetEdgeCrease(), edgeCrease);
    EXPECT_EQ(layer->GetHole(), hole);
    EXPECT_EQ(layer->GetVisibility(), visibility);
    EXPECT_EQ(layer->GetTextures(FbxLayerElement::eTextureBump), textures);
}

TEST_F(FbxLayerTest, KeepsTextureCoordinatesOfEachChannel) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->CreateLayer();
    FbxLayer* layer = mesh->GetLayer(0);
    auto* bump = FbxLayerElementUV::Create(mesh, "bump");

    layer->SetUVs(bump, FbxLayerElement::eTextureBump);

    EXPECT_EQ(layer->GetUVs(FbxLayerElement::eTextureBump), bump);
    EXPECT_EQ(layer->GetUVs(), nullptr);
    EXPECT_EQ(layer->GetTextures(FbxLayerElement::eTextureBump), nullptr);
}

TEST_F(FbxLayerTest, HasNoTextureCoordinatesForTypesThatAreNoChannel) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->CreateLayer();
    FbxLayer* layer = mesh->GetLayer(0);
    auto* uvs = FbxLayerElementUV::Create(mesh, "");

    for (const auto type : {FbxLayerElement::eUnknown, FbxLayerElement::eNormal, FbxLayerElement::eTypeCount}) {
        layer->SetUVs(uvs, type);
        EXPECT_EQ(layer->GetUVs(type), nullptr);
    }
    EXPECT_EQ(layer->GetNormals(), nullptr);
}

TEST_F(FbxLayerTest, TakesAnElementOutForNull) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->CreateLayer();
    mesh->GetLayer(0)->SetNormals(FbxLayerElementNormal::Create(mesh, ""));

    mesh->GetLayer(0)->SetNormals(nullptr);

    EXPECT_EQ(mesh->GetLayer(0)->GetNormals(), nullptr);
}

TEST_F(FbxLayerTest, IsCountedByWhatItHolds) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->CreateLayer();
    mesh->CreateLayer();
    mesh->GetLayer(1)->SetNormals(FbxLayerElementNormal::Create(mesh, ""));
    mesh->GetLayer(0)->SetUVs(FbxLayerElementUV::Create(mesh, ""));
    mesh->GetLayer(1)->SetUVs(FbxLayerElementUV::Create(mesh, ""));
    mesh->GetLayer(1)->SetUVs(FbxLayerElementUV::Create(mesh, ""), FbxLayerElement::eTextureBump);

    EXPECT_EQ(mesh->GetLayerCount(FbxLayerElement::eNormal), 1);
    EXPECT_EQ(mesh->GetLayerCount(FbxLayerElement::eUV), 2);
    EXPECT_EQ(mesh->GetLayerCount(FbxLayerElement::eTextureBump, true), 1);
    EXPECT_EQ(mesh->GetLayerCount(FbxLayerElement::eTextureBump), 0);
    EXPECT_EQ(mesh->GetLayerCount(FbxLayerElement::eMaterial), 0);
    EXPECT_EQ(mesh->GetLayerCount(FbxLayerElement::eTypeCount), 0);
}

TEST_F(FbxLayerTest, IsDestroyedByClearingButItsElementsAreNot) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->CreateLayer();
    auto* normals = FbxLayerElementNormal::Create(mesh, "kept");
    mesh->GetLayer(0)->SetNormals(normals);

    mesh->ClearLayers();

    EXPECT_EQ(mesh->GetLayerCount(), 0);
    EXPECT_STREQ(normals->GetName(), "kept");
}

TEST_F(FbxLayerTest, LosesAnElementThatIsDestroyed) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->CreateLayer();
    mesh->CreateLayer();
    auto* normals = FbxLayerElementNormal::Create(mesh, "");
    mesh->GetLayer(0)->SetNormals(normals);
    mesh->GetLayer(1)->SetNormals(normals);

    normals->Destroy();

    EXPECT_EQ(mesh->GetLayer(0)->GetNormals(), nullptr);
    EXPECT_EQ(mesh->GetLayer(1)->GetNormals(), nullptr);
}

TEST_F(FbxLayerTest, AdoptsAnElementWithoutOwner) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->CreateLayer();

    mesh->GetLayer(0)->SetNormals(FbxLayerElementNormal::Create(nullptr, "adopted")); // or the sanitizer reports a leak

    EXPECT_STREQ(mesh->GetLayer(0)->GetNormals()->GetName(), "adopted");
}

TEST_F(FbxLayerTest, TakesAnElementFromAnotherMesh) {
    FbxMesh* from = make<FbxMesh>();
    FbxMesh* to = make<FbxMesh>();
    from->CreateLayer();
    to->CreateLayer();
    auto* normals = FbxLayerElementNormal::Create(from, "moved");
    from->GetLayer(0)->SetNormals(normals);

    to->GetLayer(0)->SetNormals(normals);
    from->Destroy();

    EXPECT_STREQ(to->GetLayer(0)->GetNormals()->GetName(), "moved");
}

TEST_F(FbxLayerTest, LeavesAnElementThatWasReplacedToItsContainer) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->CreateLayer();
    auto* first = FbxLayerElementNormal::Create(mesh, "first");
    mesh->GetLayer(0)->SetNormals(first);

    mesh->GetLayer(0)->SetNormals(FbxLayerElementNormal::Create(mesh, "second"));

    EXPECT_STREQ(mesh->GetLayer(0)->GetNormals()->GetName(), "second");
    EXPECT_STREQ(first->GetName(), "first");
    first->Destroy();
}

TEST_F(FbxLayerTest, MakesElementsUnmappedAndDirect) {
    auto* uvs = FbxLayerElementUV::Create(make<FbxMesh>(), nullptr);

    EXPECT_EQ(uvs->GetMappingMode(), FbxLayerElement::eNone);
    EXPECT_EQ(uvs->GetReferenceMode(), FbxLayerElement::eDirect);
    EXPECT_STREQ(uvs->GetName(), "");
    EXPECT_EQ(uvs->GetDirectArray().GetCount(), 0);
    EXPECT_EQ(uvs->GetIndexArray().GetCount(), 0);
}

TEST_F(FbxLayerTest, EmptiesBothArraysOfAnElement) {
    auto* uvs = FbxLayerElementUV::Create(make<FbxMesh>(), "");
    uvs->GetDirectArray().Add(FbxVector2(1, 2));
    uvs->GetIndexArray().Add(0);

    EXPECT_TRUE(uvs->Clear());

    EXPECT_EQ(uvs->GetDirectArray().GetCount(), 0);
    EXPECT_EQ(uvs->GetIndexArray().GetCount(), 0);
}

TEST_F(FbxLayerTest, ThrowsWhenTheArraysOfADamagedElementAreAccessed) {
    auto* uvs = FbxLayerElementUV::Create(make<FbxMesh>(), "");
    fbxsdk::detail::LayerElementAccess::removeDirectArray(*uvs);
    fbxsdk::detail::LayerElementAccess::removeIndexArray(*uvs);

    EXPECT_EQ(messageOf([&] { (void)uvs->GetDirectArray(); }), "FbxLayerElementArrayTemplate - mDirectArray is NULL");
    EXPECT_EQ(messageOf([&] { (void)uvs->GetIndexArray(); }), "FbxLayerElementArrayTemplate - mIndexArray is NULL");
}
