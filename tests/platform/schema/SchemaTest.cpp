// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The tables of properties against the templates of files.
#include "schema/Schema.h"

#include <charconv>
#include <string>

#include <gtest/gtest.h>

#include "FileTemplates.h"

namespace {

using namespace fbxsdk;
using namespace fbxsdk::detail;

/// The spans are constants, whatever else has been initialised.
static_assert(kNodeRows.size() == 71 && kCameraRows.size() == 106 && kCameraStereoRows.size() == 116);

std::string shortest(double number) {
    char text[40];
    const auto end = std::to_chars(text, text + sizeof text, number).ptr;
    return {text, end};
}

std::size_t componentCount(EFbxType type) {
    switch (type) {
    case eFbxDouble3:
        return 3;
    case eFbxReference:
    case eFbxUndefined:
    case eFbxBlob:
        return 0;
    default:
        return 1;
    }
}

/// The row as a line of a template.
std::string lineOf(const PropertyRow& row) {
    const PropertyTypeInfo& type = *row.type->info();
    std::string line;
    for (const char* text : {row.name, type.typeName, type.subTypeName, row.flags})
        line += (line.empty() ? "\"" : ", \"") + std::string(text) + '"';
    if (type.type == eFbxString)
        return line + ", \"" + row.text + '"';
    for (std::size_t i = 0; i < componentCount(type.type); ++i)
        line += (i == 0 ? ", " : ",") + shortest(row.numbers[i]);
    return line;
}

std::string templateOf(std::span<const PropertyRow> rows) {
    std::string text = "\n";
    for (const PropertyRow& row : rows)
        text += lineOf(row) + '\n';
    return text;
}

struct TemplateCase {
    const char* name;
    std::span<const PropertyRow> rows;
    std::string_view text;
};

class SchemaTemplate : public testing::TestWithParam<TemplateCase> {};

TEST_P(SchemaTemplate, IsThatOfFiles) { EXPECT_EQ(templateOf(GetParam().rows), GetParam().text); }

INSTANTIATE_TEST_SUITE_P(
    Classes, SchemaTemplate,
    testing::Values(TemplateCase{"Node", kNodeRows, templates::kNode},
                    TemplateCase{"NodeAttribute", kNodeAttributeRows, templates::kNodeAttribute},
                    TemplateCase{"Camera", kCameraRows, templates::kCamera},
                    TemplateCase{"StereoOnly", kCameraStereoRows.subspan(kCameraRows.size()), templates::kStereoOnly},
                    TemplateCase{"StereoCamera", kCameraStereoRows.first(kCameraRows.size()), templates::kCamera},
                    TemplateCase{"CameraSwitcher", kCameraSwitcherRows, templates::kCameraSwitcher},
                    TemplateCase{"Light", kLightRows, templates::kLight},
                    TemplateCase{"Marker", kMarkerRows, templates::kMarker},
                    TemplateCase{"Null", kNullRows, templates::kNull},
                    TemplateCase{"Skeleton", kSkeletonRows, templates::kSkeleton},
                    TemplateCase{"LodGroup", kLodGroupRows, templates::kLodGroup},
                    TemplateCase{"Mesh", kMeshRows, templates::kMesh},
                    TemplateCase{"Line", kLineRows, templates::kLine},
                    TemplateCase{"VertexCacheDeformer", kVertexCacheDeformerRows, templates::kVertexCacheDeformer},
                    TemplateCase{"BlendShapeChannel", kBlendShapeChannelRows, templates::kBlendShapeChannel},
                    TemplateCase{"Cache", kCacheRows, templates::kCache},
                    TemplateCase{"AnimStack", kAnimStackRows, templates::kAnimStack},
                    TemplateCase{"AnimLayer", kAnimLayerRows, templates::kAnimLayer},
                    TemplateCase{"AnimCurveNode", kAnimCurveNodeRows, templates::kAnimCurveNode},
                    TemplateCase{"Material", kMaterialRows, templates::kMaterial},
                    TemplateCase{"Lambert", kLambertRows, templates::kLambert},
                    TemplateCase{"Phong", kPhongRows, templates::kPhong},
                    TemplateCase{"FileTexture", kFileTextureRows, templates::kFileTexture},
                    TemplateCase{"LayeredTexture", kLayeredTextureRows, templates::kLayeredTexture},
                    TemplateCase{"Video", kVideoRows, templates::kVideo},
                    TemplateCase{"GlobalSettings", kGlobalSettingsRows, templates::kGlobalSettings}),
    [](const auto& instance) { return std::string(instance.param.name); });

TEST(Schema, FindsARowByName) {
    EXPECT_EQ(rowIndex(kNodeRows, "QuaternionInterpolate"), 0);
    EXPECT_EQ(rowIndex(kNodeRows, "Visibility Inheritance"), 70);
    EXPECT_EQ(rowIndex(kNodeRows, "visibility inheritance"), -1);
    EXPECT_EQ(rowIndex(kNodeRows, ""), -1);
    EXPECT_EQ(rowIndex({}, "Color"), -1);
}

} // namespace
