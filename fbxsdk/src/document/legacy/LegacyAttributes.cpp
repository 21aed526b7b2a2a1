// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Tables of the records that become properties.
#include "document/legacy/LegacyRecords.h"
#include "schema/SubClasses.h"

#include <algorithm>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// A record that becomes a property of the same values under another name.
struct RecordRow {
    std::string_view record, property, typeName, subTypeName, flags;
    std::size_t values;
};

constexpr RecordRow kCameraRows[] = {
    {"Position", "Position", "Vector", "", "A", 3},
    {"Up", "UpVector", "Vector", "", "A", 3},
    {"LookAt", "InterestPosition", "Vector", "", "A", 3},
    {"Roll", "Roll", "Roll", "", "A", 1},
    {"TurnTable", "TurnTable", "Number", "", "A", 1},
    {"AspectType", "AspectRatioMode", "enum", "", "", 1},
    {"AspectW", "AspectWidth", "double", "Number", "", 1},
    {"AspectH", "AspectHeight", "double", "Number", "", 1},
    {"PixelRatio", "PixelAspectRatio", "double", "Number", "", 1},
    {"NearPlane", "NearPlane", "double", "Number", "", 1},
    {"FarPlane", "FarPlane", "double", "Number", "", 1},
    {"CameraLock", "LockMode", "bool", "", "", 1},
    {"ApertureMode", "ApertureMode", "enum", "", "", 1},
    {"SqueezeRatio", "FilmSqueezeRatio", "double", "Number", "", 1},
    {"FocalLength", "FocalLength", "Number", "", "A", 1},
    {"Aperture", "FieldOfView", "FieldOfView", "", "A", 1},
    {"FieldOfViewXProperty", "FieldOfViewX", "FieldOfViewX", "", "A", 1},
    {"FieldOfViewYProperty", "FieldOfViewY", "FieldOfViewY", "", "A", 1},
    {"OpticalCenterXProperty", "OpticalCenterX", "OpticalCenterX", "", "A", 1},
    {"OpticalCenterYProperty", "OpticalCenterY", "OpticalCenterY", "", "A", 1},
    {"CameraOrthoZoom", "OrthoZoom", "double", "Number", "", 1},
    {"ViewFrustumPlane", "ViewFrustumBackPlaneMode", "enum", "", "", 1},
    {"ViewFrustumPlaneDistance", "BackPlaneDistance", "Number", "", "A", 1},
    {"ViewFrustumPlaneDistanceMode", "BackPlaneDistanceMode", "enum", "", "", 1},
    {"ViewFrustum", "ViewFrustumNearFarPlane", "bool", "", "", 1},
    {"ViewLookAt", "ViewCameraToLookAt", "bool", "", "", 1},
    {"BackgroundTreshold", "BackgroundAlphaTreshold", "double", "Number", "", 1},
    {"BackGroundColor", "BackgroundColor", "Color", "", "A", 3},
    {"AudioColor", "AudioColor", "Vector3D", "Vector", "", 3},
    {"UseFrameColor", "UseFrameColor", "bool", "", "", 1},
    {"FrameColor", "FrameColor", "ColorRGB", "Color", "", 3},
    {"ShowGrid", "ShowGrid", "bool", "", "", 1},
    {"ShowAzimut", "ShowAzimut", "bool", "", "", 1},
    {"ShowName", "ShowName", "bool", "", "", 1},
    {"ShowInfoOnMoving", "ShowInfoOnMoving", "bool", "", "", 1},
    {"ShowTimeCode", "ShowTimeCode", "bool", "", "", 1},
    {"ShowAudio", "ShowAudio", "bool", "", "", 1},
    {"DisplaySafeArea", "DisplaySafeArea", "bool", "", "", 1},
    {"DisplaySafeAreaOnRender", "DisplaySafeAreaOnRender", "bool", "", "", 1},
    {"SafeAreaStyle", "SafeAreaDisplayStyle", "enum", "", "", 1},
};
constexpr RecordRow kLightRows[] = {
    {"LightType", "LightType", "enum", "", "", 1},
    {"CastLight", "CastLightOnObject", "bool", "", "", 1},
    {"Color", "Color", "Color", "", "A", 3},
    {"Intensity", "Intensity", "Number", "", "A", 1},
    {"HotSpot", "InnerAngle", "Number", "", "A", 1},
    {"ConeAngle", "OuterAngle", "Number", "", "A", 1},
    {"Fog", "Fog", "Number", "", "A", 1},
};
/// Below the record Properties of nulls and bones.
constexpr RecordRow kDisplayRows[] = {
    {"Size", "Size", "double", "Number", "", 1},
    {"Color", "Color", "ColorRGB", "Color", "", 3},
    {"Look", "Look", "enum", "", "", 1},
};
constexpr RecordRow kMaterialRows[] = {
    {"Ambient", "AmbientColor", "Color", "", "A", 3},
    {"Diffuse", "DiffuseColor", "Color", "", "A", 3},
    {"Specular", "SpecularColor", "Color", "", "A", 3},
    {"Emissive", "EmissiveColor", "Color", "", "A", 3},
    {"Shininess", "ShininessExponent", "Number", "", "A", 1},
    {"Reflectivity", "ReflectionFactor", "Number", "", "A", 1},
    {"Alpha", "Opacity", "double", "Number", "", 1},
};

/// Film formats by their name in old files; the index is the number.
constexpr std::string_view kFilmFormats[] = {
    "Custom",
    "16mm Theatrical",
    "Super 16mm",
    "35mm Academy",
    "35mm TV Projection",
    "35mm Full Aperture",
    "35mm 1.85 Projection",
    "35mm Anamorphic",
    "70mm Projection",
    "VistaVision",
    "Dynavision",
    "IMAX",
};

/// TypeFlags are less specific than Type, but some records have nothing else.
constexpr std::pair<std::string_view, std::string_view> kKindsOfFlags[] = {{"Skeleton", "LimbNode"}};

using Properties = std::vector<DocumentProperty>;

void addRows(DocumentBuilder& builder, std::span<const RecordRow> rows, const Record& owner, Properties& properties) {
    for (const RecordRow& row : rows) {
        const Record* record = owner.child(row.record);
        if (!record || record->numberCount() < row.values)
            continue;
        properties.push_back(
            propertyOf(row.property, row.typeName, row.subTypeName, row.flags, builder.numbersOf(*record, row.values)));
    }
}

/// The first Type that is a text: cameras have another one, the number of their projection.
const Record* typeRecord(const Record& model, bool wantNumber) {
    for (const Record& child : model.children())
        if (child.name == "Type" && child.value(0).isNumber() == wantNumber)
            return &child;
    return nullptr;
}

void addProjection(DocumentBuilder&, const Record& model, Properties& properties) {
    if (const Record* record = typeRecord(model, true))
        properties.push_back(propertyOf("CameraProjectionType", "enum", "", "", record->values.first(1)));
}

void addFilm(DocumentBuilder& builder, const Record& model, Properties& properties) {
    double size[2] = {0, 0};
    const Record* aperture = model.child("CameraAperture");
    if (!aperture || aperture->numberCount() < 2 || !aperture->readNumbers(size))
        return;
    const auto add = [&](std::string_view name, double value) {
        properties.push_back(propertyOf(name, "double", "Number", "", builder.keep({Value::ofReal(value)})));
    };
    add("FilmWidth", size[0]);
    add("FilmHeight", size[1]);
    if (size[1] > 0)
        add("FilmAspectRatio", size[0] / size[1]);
}

void addFilmFormat(DocumentBuilder& builder, const Record& model, Properties& properties) {
    const auto* format =
        std::find(std::begin(kFilmFormats), std::end(kFilmFormats), model.childValue("ApertureFormat").toText());
    if (format != std::end(kFilmFormats))
        properties.push_back(propertyOf("FilmFormatIndex", "enum", "", "",
                                        builder.keep({Value::ofInteger(format - std::begin(kFilmFormats))})));
}

void addPostRotation(DocumentBuilder& builder, const Record& limits, Properties& properties) {
    constexpr std::string_view kAxes[] = {"RXAxis", "RYAxis", "RZAxis"};
    double angles[3] = {0, 0, 0};
    bool present = false;
    for (std::size_t axis = 0; axis < std::size(kAxes); ++axis) {
        angles[axis] = limits.childValue(kAxes[axis]).toReal();
        present = present || limits.child(kAxes[axis]);
    }
    if (!present)
        return;
    const std::int64_t active = limits.childValue("REnable").toInteger() != 0 ? 1 : 0;
    properties.push_back(propertyOf("PostRotation", "Vector3D", "Vector", "", builder.keepReals(angles)));
    properties.push_back(propertyOf("RotationActive", "bool", "", "", builder.keep({Value::ofInteger(active)})));
}

} // namespace

std::string_view legacyKindOf(const Record& model) {
    if (const Record* type = typeRecord(model, false); type && !type->value(0).toText().empty())
        return type->value(0).toText();
    const std::string_view flags = model.childValue("TypeFlags").toText();
    const auto* row = std::find_if(std::begin(kKindsOfFlags), std::end(kKindsOfFlags),
                                   [&](const auto& candidate) { return candidate.first == flags; });
    if (row != std::end(kKindsOfFlags))
        return row->second;
    if (flags.empty() && (model.child("Vertices") || model.child("PolygonVertexIndex")))
        return SubClass::kMesh;
    return flags;
}

Properties legacyAttributeProperties(DocumentBuilder& builder, std::string_view kind, const Record& model) {
    Properties properties;
    if (kind == SubClass::kCamera) {
        addRows(builder, kCameraRows, model, properties);
        addProjection(builder, model, properties);
        addFilm(builder, model, properties);
        addFilmFormat(builder, model, properties);
    } else if (kind == SubClass::kLight) {
        addRows(builder, kLightRows, model, properties);
    } else if (const Record* display = model.child("Properties")) {
        addRows(builder, kDisplayRows, *display, properties);
    }
    return properties;
}

Properties legacyModelProperties(DocumentBuilder& builder, const Record& model) {
    // In these files a child's scale is always applied in its parent's space.
    constexpr std::int64_t kOrdinaryProduct = 1;
    Properties properties;
    properties.push_back(propertyOf("InheritType", "enum", "", "", builder.keep({Value::ofInteger(kOrdinaryProduct)})));
    if (const Record* limits = model.child("Limits"))
        addPostRotation(builder, *limits, properties);
    return properties;
}

Properties legacyMaterialProperties(DocumentBuilder& builder, const Record& material) {
    Properties properties;
    addRows(builder, kMaterialRows, material, properties);
    return properties;
}

} // namespace detail
FBXSDK_NAMESPACE_END
