// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The table of classes against the kinds of objects that files have.
#include "io/SchemaClass.h"

#include <set>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxLODGroup.h>
#include <fbxsdk/FbxLight.h>
#include <fbxsdk/FbxMarker.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxNull.h>
#include <fbxsdk/FbxSkeleton.h>
#include <fbxsdk/FbxSurfaceMaterial.h>
#include <fbxsdk/FbxTexture.h>
#include <fbxsdk/FbxVideo.h>

#include "schema/Schema.h"

namespace {

using namespace fbxsdk;
using namespace fbxsdk::detail;

/// Filled before any initialiser of ordinary priority has run.
struct EarlyLook {
    EarlyLook() {
        for (const SchemaClass& row : schemaClasses()) {
            propertiesOfClasses.push_back(row.info->rows.size());
            if (!row.classId().IsValid() || std::string_view(row.templateName()).empty())
                incomplete = true;
        }
        firstType = kNodeRows[0].type->GetName();
        nodeIsKnown = FbxNode::ClassId.IsValid();
    }
    std::vector<std::size_t> propertiesOfClasses;
    std::string firstType;
    bool incomplete = false;
    bool nodeIsKnown = false;
};

__attribute__((init_priority(101))) const EarlyLook kEarlyLook;

TEST(SchemaClass, IsThereBeforeAnyInitialiserHasRun) {
    ASSERT_EQ(kEarlyLook.propertiesOfClasses.size(), schemaClasses().size());
    for (std::size_t i = 0; i < schemaClasses().size(); ++i)
        EXPECT_EQ(kEarlyLook.propertiesOfClasses[i], schemaClasses()[i].info->rows.size()) << schemaClasses()[i].record;
    EXPECT_FALSE(kEarlyLook.incomplete);
    EXPECT_TRUE(kEarlyLook.nodeIsKnown);
    EXPECT_EQ(kEarlyLook.firstType, kNodeRows[0].type->GetName());
    EXPECT_NE(kEarlyLook.firstType, "");
}

TEST(SchemaClass, HasNoNameTwiceInAClass) {
    for (const SchemaClass& row : schemaClasses()) {
        std::set<std::string_view> names;
        for (const PropertyRow& property : row.info->rows)
            EXPECT_TRUE(names.insert(property.name).second) << row.templateName() << ' ' << property.name;
    }
}

TEST(SchemaClass, KnowsTheTypeOfEveryRow) {
    for (const SchemaClass& row : schemaClasses())
        for (const PropertyRow& property : row.info->rows)
            EXPECT_TRUE(property.type->Valid()) << row.templateName() << ' ' << property.name;
}

TEST(SchemaClass, CallsAnimatableWhatFilesSpellAnimatable) {
    // Types of two words ("double", "Number") are those that cannot be animated.
    for (const SchemaClass& row : schemaClasses()) {
        for (const PropertyRow& property : row.info->rows) {
            if (std::string_view(property.flags) != "A")
                continue;
            EXPECT_EQ(std::string_view(property.type->info()->subTypeName), "")
                << row.templateName() << ' ' << property.name;
        }
    }
}

struct ClassCase {
    const char* record;
    const char* subClass;
    const char* className; ///< nullptr: not kept
    const char* nameClass;
};

TEST(SchemaClass, FindsTheClassOfEveryKindOfObject) {
    const ClassCase cases[] = {
        {"Model", "Mesh", "FbxNode", "Model"},
        {"Model", "", "FbxNode", "Model"},
        {"Model", "NobodyKnows", "FbxNode", "Model"},
        {"NodeAttribute", "Null", "FbxNull", "NodeAttribute"},
        {"NodeAttribute", "LimbNode", "FbxSkeleton", "NodeAttribute"},
        {"NodeAttribute", "Limb", "FbxSkeleton", "NodeAttribute"},
        {"NodeAttribute", "Root", "FbxSkeleton", "NodeAttribute"},
        {"NodeAttribute", "Camera", "FbxCamera", "NodeAttribute"},
        {"NodeAttribute", "CameraStereo", "FbxCameraStereo", "NodeAttribute"},
        {"NodeAttribute", "CameraSwitcher", "FbxCameraSwitcher", "NodeAttribute"},
        {"NodeAttribute", "Light", "FbxLight", "NodeAttribute"},
        {"NodeAttribute", "Marker", "FbxMarker", "NodeAttribute"},
        {"NodeAttribute", "IKEffector", "FbxMarker", "NodeAttribute"},
        {"NodeAttribute", "FKEffector", "FbxMarker", "NodeAttribute"},
        {"NodeAttribute", "LodGroup", "FbxLODGroup", "NodeAttribute"},
        {"NodeAttribute", "NobodyKnows", "FbxNodeAttribute", "NodeAttribute"},
        {"NodeAttribute", "", "FbxNodeAttribute", "NodeAttribute"},
        {"Geometry", "Mesh", "FbxMesh", "Geometry"},
        {"Geometry", "Shape", "FbxShape", "Geometry"},
        {"Geometry", "NurbsSurface", "FbxNurbsSurface", "Geometry"},
        {"Geometry", "NurbsCurve", "FbxNurbsCurve", "Geometry"},
        {"Geometry", "TrimNurbsSurface", "FbxTrimNurbsSurface", "Geometry"},
        {"Geometry", "Boundary", "FbxBoundary", "Geometry"},
        {"Geometry", "Nurb", "FbxNurbs", "Geometry"},
        {"Geometry", "Patch", "FbxPatch", "Geometry"},
        {"Geometry", "Line", "FbxLine", "Geometry"},
        {"Geometry", "NobodyKnows", nullptr, nullptr},
        {"Deformer", "Skin", "FbxSkin", "Deformer"},
        {"Deformer", "Cluster", "FbxCluster", "SubDeformer"},
        {"Deformer", "BlendShape", "FbxBlendShape", "Deformer"},
        {"Deformer", "BlendShapeChannel", "FbxBlendShapeChannel", "SubDeformer"},
        {"Deformer", "VertexCacheDeformer", "FbxVertexCacheDeformer", "Deformer"},
        {"Cache", "", "FbxCache", "Cache"},
        {"Material", "", "FbxSurfaceMaterial", "Material"},
        {"Texture", "", "FbxFileTexture", "Texture"},
        {"LayeredTexture", "", "FbxLayeredTexture", "LayeredTexture"},
        {"Video", "Clip", "FbxVideo", "Video"},
        {"AnimationStack", "", "FbxAnimStack", "AnimStack"},
        {"AnimationLayer", "", "FbxAnimLayer", "AnimLayer"},
        {"AnimationCurveNode", "", "FbxAnimCurveNode", "AnimCurveNode"},
        {"AnimationCurve", "", "FbxAnimCurve", "AnimCurve"},
        {"Constraint", "Aim", nullptr, nullptr},
        {"model", "Mesh", nullptr, nullptr},
        {"", "", nullptr, nullptr},
    };
    for (const ClassCase& each : cases) {
        SCOPED_TRACE(std::string(each.record) + ' ' + each.subClass);
        const SchemaClass* found = findSchema(each.record, each.subClass);
        ASSERT_EQ(found != nullptr, each.className != nullptr);
        if (!found)
            continue;
        EXPECT_STREQ(found->templateName(), each.className);
        EXPECT_STREQ(found->classId().GetName(), each.className);
        EXPECT_EQ(found->nameClass, each.nameClass);
    }
}

TEST(SchemaClass, FindsHowFilesTellAClass) {
    struct {
        FbxClassId id;
        const char* record;
        const char* subClass;
    } cases[] = {
        {FbxNode::ClassId, "Model", "*"},
        {FbxSkeleton::ClassId, "NodeAttribute", "LimbNode"},
        {FbxMarker::ClassId, "NodeAttribute", "Marker"},
        {FbxLODGroup::ClassId, "NodeAttribute", "LodGroup"},
        {FbxNodeAttribute::ClassId, "NodeAttribute", "*"},
        {FbxSurfacePhong::ClassId, "Material", "*"},
        {FbxVideo::ClassId, "Video", "Clip"},
    };
    for (const auto& each : cases) {
        const SchemaClass* found = findSchema(each.id);
        ASSERT_NE(found, nullptr) << each.record;
        EXPECT_EQ(found->record, each.record);
        EXPECT_EQ(found->subClass, each.subClass);
        EXPECT_EQ(found->classId(), each.id);
    }
    EXPECT_EQ(findSchema(FbxObject::ClassId), nullptr);
    EXPECT_EQ(findSchema(FbxClassId()), nullptr);
}

TEST(SchemaClass, NamesTheTemplatesOfFiles) {
    EXPECT_EQ(findSchema(FbxSurfacePhong::ClassId)->rows.data(), kPhongRows.data());
    EXPECT_STREQ(findSchema(FbxSurfacePhong::ClassId)->templateName(), "FbxSurfacePhong");
    EXPECT_EQ(findSchema("AnimationCurveNode", "")->rows.size(), 1U);
    EXPECT_TRUE(findSchema("Deformer", "BlendShapeChannel")->rows.empty());
    EXPECT_TRUE(findSchema("Deformer", "Skin")->rows.empty());
}

} // namespace
