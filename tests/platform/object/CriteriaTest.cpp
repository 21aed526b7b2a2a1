// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Class identities and criteria over them, against the class tree written out by hand.
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include <fbxsdk.h>

namespace {

using namespace fbxsdk;

struct Derivation {
    const FbxClassId& id;
    const FbxClassId& parent;
    const char* name;
};

const std::vector<Derivation>& derivations() {
    static const std::vector<Derivation> kDerivations = {
        {FbxSurfacePhong::ClassId, FbxSurfaceLambert::ClassId, "FbxSurfacePhong"},
        {FbxSurfaceLambert::ClassId, FbxSurfaceMaterial::ClassId, "FbxSurfaceLambert"},
        {FbxSurfaceMaterial::ClassId, FbxObject::ClassId, "FbxSurfaceMaterial"},
        {FbxMesh::ClassId, FbxGeometry::ClassId, "FbxMesh"},
        {FbxNurbs::ClassId, FbxGeometry::ClassId, "FbxNurbs"},
        {FbxPatch::ClassId, FbxGeometry::ClassId, "FbxPatch"},
        {FbxNurbsSurface::ClassId, FbxGeometry::ClassId, "FbxNurbsSurface"},
        {FbxGeometry::ClassId, FbxGeometryBase::ClassId, "FbxGeometry"},
        {FbxShape::ClassId, FbxGeometryBase::ClassId, "FbxShape"},
        {FbxGeometryBase::ClassId, FbxLayerContainer::ClassId, "FbxGeometryBase"},
        {FbxLayerContainer::ClassId, FbxNodeAttribute::ClassId, "FbxLayerContainer"},
        {FbxCamera::ClassId, FbxNodeAttribute::ClassId, "FbxCamera"},
        {FbxLight::ClassId, FbxNodeAttribute::ClassId, "FbxLight"},
        {FbxNull::ClassId, FbxNodeAttribute::ClassId, "FbxNull"},
        {FbxMarker::ClassId, FbxNodeAttribute::ClassId, "FbxMarker"},
        {FbxNodeAttribute::ClassId, FbxObject::ClassId, "FbxNodeAttribute"},
        {FbxSkin::ClassId, FbxDeformer::ClassId, "FbxSkin"},
        {FbxBlendShape::ClassId, FbxDeformer::ClassId, "FbxBlendShape"},
        {FbxVertexCacheDeformer::ClassId, FbxDeformer::ClassId, "FbxVertexCacheDeformer"},
        {FbxDeformer::ClassId, FbxObject::ClassId, "FbxDeformer"},
        {FbxCluster::ClassId, FbxSubDeformer::ClassId, "FbxCluster"},
        {FbxBlendShapeChannel::ClassId, FbxSubDeformer::ClassId, "FbxBlendShapeChannel"},
        {FbxSubDeformer::ClassId, FbxObject::ClassId, "FbxSubDeformer"},
        {FbxAnimStack::ClassId, FbxCollection::ClassId, "FbxAnimStack"},
        {FbxAnimLayer::ClassId, FbxCollection::ClassId, "FbxAnimLayer"},
        {FbxDocument::ClassId, FbxCollection::ClassId, "FbxDocument"},
        {FbxScene::ClassId, FbxDocument::ClassId, "FbxScene"},
        {FbxCollection::ClassId, FbxObject::ClassId, "FbxCollection"},
        {FbxAnimCurve::ClassId, FbxAnimCurveBase::ClassId, "FbxAnimCurve"},
        {FbxAnimCurveBase::ClassId, FbxObject::ClassId, "FbxAnimCurveBase"},
        {FbxAnimCurveNode::ClassId, FbxObject::ClassId, "FbxAnimCurveNode"},
        {FbxImporter::ClassId, FbxIOBase::ClassId, "FbxImporter"},
        {FbxExporter::ClassId, FbxIOBase::ClassId, "FbxExporter"},
        {FbxIOBase::ClassId, FbxObject::ClassId, "FbxIOBase"},
        {FbxFileTexture::ClassId, FbxTexture::ClassId, "FbxFileTexture"},
        {FbxTexture::ClassId, FbxObject::ClassId, "FbxTexture"},
        {FbxGlobalSettings::ClassId, FbxObject::ClassId, "FbxGlobalSettings"},
        {FbxIOSettings::ClassId, FbxObject::ClassId, "FbxIOSettings"},
        {FbxCache::ClassId, FbxObject::ClassId, "FbxCache"},
        {FbxNode::ClassId, FbxObject::ClassId, "FbxNode"},
    };
    return kDerivations;
}

TEST(FbxClassIdTest, HasTheDocumentedParentAndName) {
    for (const Derivation& row : derivations()) {
        EXPECT_STREQ(row.id.GetName(), row.name);
        EXPECT_EQ(row.id.GetParent(), row.parent) << row.name;
        EXPECT_TRUE(row.id.IsValid()) << row.name;
    }
    EXPECT_FALSE(FbxObject::ClassId.GetParent().IsValid());
}

TEST(FbxClassIdTest, IsItselfAndItsAncestorsOnly) {
    for (const Derivation& row : derivations()) {
        EXPECT_TRUE(row.id.Is(row.id)) << row.name;
        EXPECT_TRUE(row.id.Is(row.parent)) << row.name;
        EXPECT_TRUE(row.id.Is(FbxObject::ClassId)) << row.name;
        EXPECT_FALSE(row.parent.Is(row.id)) << row.name;
    }
    EXPECT_FALSE(FbxCamera::ClassId.Is(FbxLight::ClassId));
}

TEST(FbxClassIdTest, OfNothingIsNothing) {
    const FbxClassId none;

    EXPECT_FALSE(none.IsValid());
    EXPECT_STREQ(none.GetName(), "");
    EXPECT_FALSE(none.GetParent().IsValid());
    EXPECT_FALSE(none.Is(FbxObject::ClassId));
    EXPECT_FALSE(none.Is(none));
    EXPECT_FALSE(FbxObject::ClassId.Is(none));
    EXPECT_NE(none, FbxObject::ClassId);
    EXPECT_EQ(none, FbxClassId());
}

TEST(FbxCriteriaTest, MeetsEverythingByDefault) {
    EXPECT_TRUE(FbxCriteria().isMetBy(FbxObject::ClassId));
    EXPECT_TRUE(FbxCriteria().isMetBy(FbxMesh::ClassId));
}

TEST(FbxCriteriaTest, OfATypeMeetsDerivedClassesToo) {
    const FbxCriteria attributes = FbxCriteria::ObjectType(FbxNodeAttribute::ClassId);

    EXPECT_TRUE(attributes.isMetBy(FbxNodeAttribute::ClassId));
    EXPECT_TRUE(attributes.isMetBy(FbxMesh::ClassId));
    EXPECT_FALSE(attributes.isMetBy(FbxNode::ClassId));
    EXPECT_FALSE(attributes.isMetBy(FbxObject::ClassId));
}

TEST(FbxCriteriaTest, OfAStrictTypeMeetsThatClassAlone) {
    const FbxCriteria lambert = FbxCriteria::ObjectTypeStrict(FbxSurfaceLambert::ClassId);

    EXPECT_TRUE(lambert.isMetBy(FbxSurfaceLambert::ClassId));
    EXPECT_FALSE(lambert.isMetBy(FbxSurfacePhong::ClassId));
    EXPECT_FALSE(lambert.isMetBy(FbxSurfaceMaterial::ClassId));
}

TEST(FbxCriteriaTest, OfPropertiesMeetsNoObject) {
    EXPECT_FALSE(FbxCriteria::IsProperty().isMetBy(FbxObject::ClassId));
    EXPECT_TRUE((!FbxCriteria::IsProperty()).isMetBy(FbxObject::ClassId));
}

TEST(FbxCriteriaTest, CombineAsLogicSays) {
    const FbxCriteria camera = FbxCriteria::ObjectType(FbxCamera::ClassId);
    const FbxCriteria light = FbxCriteria::ObjectType(FbxLight::ClassId);
    const FbxCriteria attribute = FbxCriteria::ObjectType(FbxNodeAttribute::ClassId);

    EXPECT_TRUE((camera || light).isMetBy(FbxLight::ClassId));
    EXPECT_TRUE((camera || light).isMetBy(FbxCamera::ClassId));
    EXPECT_FALSE((camera || light).isMetBy(FbxNull::ClassId));
    EXPECT_FALSE((camera && light).isMetBy(FbxCamera::ClassId));
    EXPECT_TRUE((attribute && !camera).isMetBy(FbxNull::ClassId));
    EXPECT_FALSE((attribute && !camera).isMetBy(FbxCamera::ClassId));
    EXPECT_FALSE((attribute && !camera).isMetBy(FbxNode::ClassId));
    EXPECT_TRUE((!(camera || light)).isMetBy(FbxNode::ClassId));
    EXPECT_TRUE((!!camera).isMetBy(FbxCamera::ClassId));
}

TEST(FbxCriteriaTest, OutlivesItsParts) {
    FbxCriteria combined;
    {
        const FbxCriteria camera = FbxCriteria::ObjectType(FbxCamera::ClassId);
        combined = camera || FbxCriteria::ObjectType(FbxLight::ClassId);
    }
    const FbxCriteria copy = combined;
    combined = FbxCriteria::IsProperty();

    EXPECT_TRUE(copy.isMetBy(FbxLight::ClassId));
}

} // namespace
