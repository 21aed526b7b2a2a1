// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Layers and elements from the records of files: every spelling of the modes, and what files omit.
#include "GeometryFixture.h"

#include <string>

#include "geometry/LayerElementAccess.h"

using namespace fbxsdk;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

const std::string kTriangle = "Vertices: *9 { a: 0,0,0, 1,0,0, 0,1,0 }\nPolygonVertexIndex: *3 { a: 0,1,-3 }\n";

std::string element(const std::string& type, const std::string& mapping, const std::string& reference,
                    const std::string& data, int number = 0) {
    const auto mode = [](const char* record, const std::string& value) {
        return value.empty() ? "" : std::string(record) + ": \"" + value + "\"\n";
    };
    return type + ": " + std::to_string(number) + " {\nVersion: 101\nName: \"set\"\n" +
           mode("MappingInformationType", mapping) + mode("ReferenceInformationType", reference) + data + "\n}\n";
}

std::string layer(int number, const std::vector<std::pair<std::string, int>>& entries) {
    std::string text = "Layer: " + std::to_string(number) + " {\nVersion: 100\n";
    for (const auto& [type, typedIndex] : entries)
        text += "LayerElement:  {\nType: \"" + type + "\"\nTypedIndex: " + std::to_string(typedIndex) + "\n}\n";
    return text + "}\n";
}

const std::string kNormals = "Normals: *9 { a: 1,0,0, 0,1,0, 0,0,1 }";
const std::string kUvs = "UV: *4 { a: 0,0.5,1,0.25 }";
const std::string kUvIndex = "UVIndex: *3 { a: 1,0,-1 }";

class LayerReading : public GeometryFixture {
protected:
    FbxMesh* triangle(const std::string& records) { return read<FbxMesh>(kTriangle + records); }

    /// The texture coordinates of layer 0 for records that hold one element; null when it is dropped.
    FbxLayerElementUV* uvs(const std::string& mapping, const std::string& reference, const std::string& data) {
        FbxMesh* mesh = triangle(element("LayerElementUV", mapping, reference, data));
        return mesh->GetLayer(0) ? mesh->GetLayer(0)->GetUVs() : nullptr;
    }
};

} // namespace

TEST_F(LayerReading, KnowsEverySpellingOfMappings) {
    constexpr struct {
        const char* spelling;
        FbxLayerElement::EMappingMode mode;
    } kSpellings[] = {
        {"ByVertice", FbxLayerElement::eByControlPoint},      {"ByVertex", FbxLayerElement::eByControlPoint},
        {"ByControlPoint", FbxLayerElement::eByControlPoint}, {"ByPolygonVertex", FbxLayerElement::eByPolygonVertex},
        {"ByPolygon", FbxLayerElement::eByPolygon},           {"AllSame", FbxLayerElement::eAllSame}};
    for (const auto& row : kSpellings) {
        const FbxLayerElementUV* element = uvs(row.spelling, "Direct", kUvs);
        ASSERT_NE(element, nullptr) << row.spelling;
        EXPECT_EQ(element->GetMappingMode(), row.mode) << row.spelling;
    }
}

TEST_F(LayerReading, LeavesOutElementsWithoutSoundMapping) {
    for (const char* mapping : {"", "NoMappingInformation", "Missing", "bypolygonvertex"})
        EXPECT_EQ(uvs(mapping, "Direct", kUvs), nullptr) << mapping;
}

TEST_F(LayerReading, ReadsDirectValues) {
    const FbxLayerElementUV* element = uvs("ByVertice", "Direct", kUvs);

    ASSERT_NE(element, nullptr);
    EXPECT_STREQ(element->GetName(), "set");
    EXPECT_EQ(element->GetReferenceMode(), FbxLayerElement::eDirect);
    EXPECT_THAT(itemsOf(element->GetDirectArray()), ElementsAre(FbxVector2(0, 0.5), FbxVector2(1, 0.25)));
    EXPECT_THAT(itemsOf(element->GetIndexArray()), IsEmpty());
}

TEST_F(LayerReading, ReadsIndexedValues) {
    for (const char* reference : {"IndexToDirect", "Index", ""}) {
        const FbxLayerElementUV* element = uvs("ByPolygonVertex", reference, kUvs + "\n" + kUvIndex);
        ASSERT_NE(element, nullptr) << reference;
        EXPECT_EQ(element->GetReferenceMode(), FbxLayerElement::eIndexToDirect) << reference;
        EXPECT_EQ(element->GetDirectArray().GetCount(), 2) << reference;
        EXPECT_THAT(itemsOf(element->GetIndexArray()), ElementsAre(1, 0, -1)) << reference;
    }
}

TEST_F(LayerReading, TakesIndexedValuesWithoutIndicesForDirectOnes) {
    for (const char* reference : {"IndexToDirect", "Index", ""}) {
        const FbxLayerElementUV* element = uvs("ByPolygonVertex", reference, kUvs);
        ASSERT_NE(element, nullptr) << reference;
        EXPECT_EQ(element->GetReferenceMode(), FbxLayerElement::eDirect) << reference;
    }
}

TEST_F(LayerReading, IgnoresTheIndicesOfDirectValues) {
    const FbxLayerElementUV* element = uvs("ByPolygonVertex", "Direct", kUvs + "\n" + kUvIndex);

    ASSERT_NE(element, nullptr);
    EXPECT_EQ(element->GetReferenceMode(), FbxLayerElement::eDirect);
    EXPECT_THAT(itemsOf(element->GetIndexArray()), IsEmpty());
}

TEST_F(LayerReading, LeavesOutElementsWithoutValues) {
    EXPECT_EQ(uvs("ByPolygonVertex", "IndexToDirect", kUvIndex), nullptr);
    EXPECT_EQ(uvs("ByPolygonVertex", "Direct", ""), nullptr);
    EXPECT_EQ(uvs("ByPolygonVertex", "Direct", "UV: "), nullptr);
    EXPECT_EQ(uvs("ByPolygonVertex", "Direct", "UV: \"text\""), nullptr);
}

TEST_F(LayerReading, ReadsEveryTypeOfElement) {
    FbxMesh* mesh =
        triangle("Edges: *1 { a: 0 }\n" + element("LayerElementNormal", "ByPolygonVertex", "Direct", kNormals) +
                 element("LayerElementBinormal", "ByPolygonVertex", "Direct", "Binormals: *3 { a: 1,2,3 }") +
                 element("LayerElementTangent", "ByPolygonVertex", "Direct", "Tangents: *3 { a: 4,5,6 }") +
                 element("LayerElementColor", "ByPolygonVertex", "IndexToDirect",
                         "Colors: *4 { a: 0.25,0.5,0.75,1 }\nColorIndex: *3 { a: 0,0,0 }") +
                 element("LayerElementSmoothing", "ByPolygon", "Direct", "Smoothing: *1 { a: 5 }") +
                 element("LayerElementEdgeCrease", "ByEdge", "Direct", "EdgeCrease: *1 { a: 0.5 }") +
                 element("LayerElementVertexCrease", "ByVertice", "Direct", "VertexCrease: *2 { a: 0.25,1 }") +
                 element("LayerElementHole", "ByPolygon", "Direct", "Hole: *3 { a: 1,0,7 }") +
                 element("LayerElementVisibility", "ByEdge", "Direct", "Visibility: *1 { a: 1 }") +
                 element("LayerElementPolygonGroup", "ByPolygon", "Index", "PolygonGroup: *1 { a: 3 }"));

    ASSERT_EQ(mesh->GetLayerCount(), 1);
    const FbxLayer* layer = mesh->GetLayer(0);
    EXPECT_THAT(itemsOf(layer->GetNormals()->GetDirectArray()),
                ElementsAre(FbxVector4(1, 0, 0, 1), FbxVector4(0, 1, 0, 1), FbxVector4(0, 0, 1, 1)));
    EXPECT_THAT(itemsOf(layer->GetBinormals()->GetDirectArray()), ElementsAre(FbxVector4(1, 2, 3, 1)));
    EXPECT_THAT(itemsOf(layer->GetTangents()->GetDirectArray()), ElementsAre(FbxVector4(4, 5, 6, 1)));
    EXPECT_THAT(itemsOf(layer->GetVertexColors()->GetDirectArray()), ElementsAre(FbxColor(0.25, 0.5, 0.75, 1)));
    EXPECT_THAT(itemsOf(layer->GetVertexColors()->GetIndexArray()), ElementsAre(0, 0, 0));
    EXPECT_THAT(itemsOf(layer->GetSmoothing()->GetDirectArray()), ElementsAre(5));
    EXPECT_THAT(itemsOf(layer->GetEdgeCrease()->GetDirectArray()), ElementsAre(0.5));
    EXPECT_THAT(itemsOf(layer->GetVertexCrease()->GetDirectArray()), ElementsAre(0.25, 1));
    EXPECT_THAT(itemsOf(layer->GetHole()->GetDirectArray()), ElementsAre(true, false, true));
    EXPECT_THAT(itemsOf(layer->GetVisibility()->GetDirectArray()), ElementsAre(true));
    EXPECT_EQ(layer->GetPolygonGroups()->GetReferenceMode(), FbxLayerElement::eIndex);
    EXPECT_THAT(itemsOf(layer->GetPolygonGroups()->GetIndexArray()), ElementsAre(3));
}

TEST_F(LayerReading, ReadsMaterialsAsIndicesAlone) {
    FbxMesh* mesh = triangle(element("LayerElementMaterial", "ByPolygon", "IndexToDirect", "Materials: *2 { a: 1,0 }"));

    const FbxLayerElementMaterial* materials = mesh->GetLayer(0)->GetMaterials();
    EXPECT_EQ(materials->GetMappingMode(), FbxLayerElement::eByPolygon);
    EXPECT_EQ(materials->GetReferenceMode(), FbxLayerElement::eIndexToDirect);
    EXPECT_THAT(itemsOf(materials->GetIndexArray()), ElementsAre(1, 0));
    EXPECT_EQ(materials->GetDirectArray().GetCount(), 0);
}

TEST_F(LayerReading, TakesMaterialNumbersForIndicesWhateverTheReference) {
    FbxMesh* mesh = triangle(element("LayerElementMaterial", "ByPolygon", "Direct", "Materials: *1 { a: 4 }"));

    EXPECT_EQ(mesh->GetLayer(0)->GetMaterials()->GetReferenceMode(), FbxLayerElement::eIndexToDirect);
}

TEST_F(LayerReading, ReadsTexturesAndCoordinatesByChannel) {
    FbxMesh* mesh =
        triangle(element("LayerElementTexture", "AllSame", "IndexToDirect", "TextureId: 0") +
                 element("LayerElementEmissive_Textures", "AllSame", "IndexToDirect", "TextureId: 1") +
                 element("LayerElementEmissiveUV", "ByPolygonVertex", "IndexToDirect", kUvs + "\n" + kUvIndex) +
                 element("LayerElementBumpTextures", "AllSame", "IndexToDirect", "TextureId: 2"));

    FbxLayer* layer = mesh->GetLayer(0);
    ASSERT_NE(layer, nullptr);
    EXPECT_THAT(itemsOf(layer->GetTextures(FbxLayerElement::eTextureDiffuse)->GetIndexArray()), ElementsAre(0));
    EXPECT_THAT(itemsOf(layer->GetTextures(FbxLayerElement::eTextureEmissive)->GetIndexArray()), ElementsAre(1));
    EXPECT_THAT(itemsOf(layer->GetTextures(FbxLayerElement::eTextureBump)->GetIndexArray()), ElementsAre(2));
    EXPECT_NE(layer->GetUVs(FbxLayerElement::eTextureEmissive), nullptr);
    EXPECT_EQ(layer->GetUVs(), nullptr);
}

TEST_F(LayerReading, LeavesOutElementsByEdgeWithoutEdges) {
    const std::string crease = element("LayerElementEdgeCrease", "ByEdge", "Direct", "EdgeCrease: *1 { a: 0.5 }");

    EXPECT_EQ(triangle(crease)->GetLayerCount(), 0);
    EXPECT_EQ(triangle("Edges: *1 { a: 0 }\n" + crease)->GetLayerCount(), 1);
}

TEST_F(LayerReading, IgnoresTypesThatItDoesNotKnow) {
    EXPECT_EQ(triangle(element("LayerElementUserData", "ByPolygon", "Direct", "UserDataId: 1"))->GetLayerCount(), 0);
    EXPECT_EQ(triangle(element("LayerElementFuture", "ByPolygon", "Direct", "Future: 1"))->GetLayerCount(), 0);
}

TEST_F(LayerReading, PutsElementsWhereLayersSay) {
    FbxMesh* mesh = triangle(element("LayerElementUV", "ByVertice", "Direct", "UV: *2 { a: 0,0 }", 0) +
                             element("LayerElementUV", "ByVertice", "Direct", "UV: *2 { a: 1,1 }", 1) +
                             layer(0, {{"LayerElementUV", 1}}) + layer(1, {{"LayerElementUV", 0}}));

    ASSERT_EQ(mesh->GetLayerCount(), 2);
    EXPECT_EQ(mesh->GetLayer(0)->GetUVs()->GetDirectArray().GetAt(0), FbxVector2(1, 1));
    EXPECT_EQ(mesh->GetLayer(1)->GetUVs()->GetDirectArray().GetAt(0), FbxVector2(0, 0));
}

TEST_F(LayerReading, KeepsLayersThatAreEmptyOrSkipped) {
    EXPECT_EQ(triangle(layer(0, {}))->GetLayerCount(), 1);
    FbxMesh* mesh =
        triangle(element("LayerElementUV", "ByVertice", "Direct", kUvs) + layer(1, {{"LayerElementUV", 0}}));

    ASSERT_EQ(mesh->GetLayerCount(), 2);
    EXPECT_EQ(mesh->GetLayer(0)->GetUVs(), nullptr);
    EXPECT_NE(mesh->GetLayer(1)->GetUVs(), nullptr);
}

TEST_F(LayerReading, PutsElementsWithoutLayerIntoTheLayerOfTheirNumber) {
    FbxMesh* mesh = triangle(element("LayerElementNormal", "ByPolygonVertex", "Direct", kNormals) +
                             element("LayerElementUV", "ByVertice", "Direct", "UV: *2 { a: 0,0 }", 0) +
                             element("LayerElementUV", "ByVertice", "Direct", "UV: *2 { a: 1,1 }", 1));

    ASSERT_EQ(mesh->GetLayerCount(), 2);
    EXPECT_NE(mesh->GetLayer(0)->GetNormals(), nullptr);
    EXPECT_EQ(mesh->GetLayer(0)->GetUVs()->GetDirectArray().GetAt(0), FbxVector2(0, 0));
    EXPECT_EQ(mesh->GetLayer(1)->GetUVs()->GetDirectArray().GetAt(0), FbxVector2(1, 1));
}

TEST_F(LayerReading, PutsAnElementWhosePlaceIsTakenBehindAllLayers) {
    FbxMesh* mesh = triangle(element("LayerElementUV", "ByVertice", "Direct", "UV: *2 { a: 0,0 }", 0) +
                             element("LayerElementUV", "ByVertice", "Direct", "UV: *2 { a: 1,1 }", 1) + layer(0, {}) +
                             layer(1, {{"LayerElementUV", 0}}));

    ASSERT_EQ(mesh->GetLayerCount(), 3);
    EXPECT_EQ(mesh->GetLayer(1)->GetUVs()->GetDirectArray().GetAt(0), FbxVector2(0, 0));
    EXPECT_EQ(mesh->GetLayer(2)->GetUVs()->GetDirectArray().GetAt(0), FbxVector2(1, 1));
}

TEST_F(LayerReading, CountsTheFirstOfElementsWithTheSameNumber) {
    FbxMesh* mesh = triangle(element("LayerElementUV", "ByVertice", "Direct", "UV: *2 { a: 0,0 }", 0) +
                             element("LayerElementUV", "ByVertice", "Direct", "UV: *2 { a: 1,1 }", 0));

    ASSERT_EQ(mesh->GetLayerCount(), 1);
    EXPECT_EQ(mesh->GetLayer(0)->GetUVs()->GetDirectArray().GetAt(0), FbxVector2(0, 0));
}

TEST_F(LayerReading, IgnoresImplausibleLayerNumbers) {
    const std::string uv = element("LayerElementUV", "ByVertice", "Direct", kUvs, 2000000000);
    FbxMesh* mesh = triangle(uv + layer(1000000000, {{"LayerElementUV", 2000000000}}) + layer(-1, {}));

    ASSERT_EQ(mesh->GetLayerCount(), 1);
    EXPECT_NE(mesh->GetLayer(0)->GetUVs(), nullptr);
}

TEST_F(LayerReading, HasAtMostOneLayerForEachLayerAndElementOfTheFile) {
    const std::string uv = element("LayerElementUV", "ByVertice", "Direct", kUvs);

    EXPECT_EQ(triangle(uv + layer(1, {{"LayerElementUV", 0}}))->GetLayerCount(), 2);
    EXPECT_EQ(triangle(uv + layer(2, {{"LayerElementUV", 0}}))->GetLayerCount(), 1) << "as if no layer had named it";
}

TEST_F(LayerReading, IgnoresEntriesForElementsThatAreNotThere) {
    FbxMesh* mesh = triangle(layer(0, {{"LayerElementNormal", 0}, {"LayerElementUV", 7}, {"", 0}}));

    ASSERT_EQ(mesh->GetLayerCount(), 1);
    EXPECT_EQ(mesh->GetLayer(0)->GetNormals(), nullptr);
    EXPECT_EQ(mesh->GetLayer(0)->GetUVs(), nullptr);
}

TEST_F(LayerReading, LeavesArraysInTheFileUntilTheFirstAccess) {
    FbxMesh* mesh = triangle(element("LayerElementUV", "ByPolygonVertex", "IndexToDirect", kUvs + "\n" + kUvIndex));
    const FbxLayerElementUV* uvs = mesh->GetLayer(0)->GetUVs();
    ASSERT_NE(uvs, nullptr);
    EXPECT_TRUE(uvs->GetDirectArray().items().isPending());

    EXPECT_EQ(uvs->GetDirectArray().GetCount(), 2);
    EXPECT_FALSE(uvs->GetDirectArray().items().isPending());
    EXPECT_TRUE(uvs->GetIndexArray().items().isPending()) << "each array for itself";
}

TEST_F(LayerReading, KeepsTheFileForArraysThatWereNotAccessed) {
    FbxMesh* mesh = make<FbxMesh>();
    std::weak_ptr<const fbxsdk::detail::Document> watched;
    {
        const auto document =
            documentOf(kTriangle + element("LayerElementNormal", "ByPolygonVertex", "Direct", kNormals));
        watched = document;
        fbxsdk::detail::attachSource(*mesh, document, document->objects.front());
    }
    EXPECT_EQ(mesh->GetControlPointsCount(), 3);
    EXPECT_FALSE(watched.expired());

    FbxVector4 normal;
    EXPECT_TRUE(mesh->GetPolygonVertexNormal(0, 1, normal));
    EXPECT_EQ(normal, FbxVector4(0, 1, 0));
    EXPECT_TRUE(watched.expired());
}

TEST_F(LayerReading, ShortensArraysWhenAPolygonIsRemovedBeforeTheyWereAccessed) {
    FbxMesh* mesh = read<FbxMesh>(
        "Vertices: *9 { a: 0,0,0, 1,0,0, 0,1,0 }\n"
        "PolygonVertexIndex: *6 { a: 0,1,-3,2,1,-1 }\n" +
        element("LayerElementUV", "ByPolygonVertex", "IndexToDirect", kUvs + "\nUVIndex: *6 { a: 0,1,0,1,0,1 }"));

    mesh->RemovePolygon(0);

    EXPECT_THAT(itemsOf(mesh->GetLayer(0)->GetUVs()->GetIndexArray()), ElementsAre(1, 0, 1));
    EXPECT_EQ(mesh->GetLayer(0)->GetUVs()->GetDirectArray().GetCount(), 2);
}

TEST_F(LayerReading, CarriesShortArraysAsTheyAre) {
    FbxMesh* mesh = triangle(element("LayerElementNormal", "ByPolygonVertex", "Direct", "Normals: *4 { a: 1,0,0,9 }"));

    FbxVector4 normal(7, 7, 7);
    EXPECT_TRUE(mesh->GetPolygonVertexNormal(0, 0, normal));
    EXPECT_FALSE(mesh->GetPolygonVertexNormal(0, 1, normal));
    EXPECT_EQ(mesh->GetLayer(0)->GetNormals()->GetDirectArray().GetCount(), 1);
}
