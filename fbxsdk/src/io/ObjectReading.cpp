// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Objects of a document, class by class. The class table gives the class and its properties; the rows below are the
// data that a class keeps outside its properties.
#include "io/ObjectReading.h"

#include <algorithm>
#include <string>
#include <unordered_map>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxDeformer.h>
#include <fbxsdk/FbxGeometryBase.h>
#include <fbxsdk/FbxMarker.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>
#include <fbxsdk/FbxSkeleton.h>
#include <fbxsdk/FbxSurfaceMaterial.h>
#include <fbxsdk/FbxTexture.h>

#include "geometry/GeometryReading.h"
#include "io/SchemaClass.h"
#include "object/ManagerData.h"
#include "schema/Spellings.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

struct Reading {
    const std::shared_ptr<const Document>& document;
    const DocumentObject& source;
    FbxObject& object;

    template <class T>
    [[nodiscard]] T& as() const {
        return static_cast<T&>(object);
    }
    [[nodiscard]] const Value& record(std::string_view name) const { return source.body->childValue(name); }
};

std::string textOf(const Value& value) { return std::string(value.toText()); }

void readNode(const Reading& reading) {
    if (const char letter = reading.record("Shading").toLetter())
        reading.as<FbxNode>().SetShadingMode(
            static_cast<FbxNode::EShadingMode>(numberOf(kShadingModes, letter, FbxNode::eHardShading)));
}

/// In a file whose class defaults and objects both omit the flag, rotations are active.
void readNodeProperties(const Reading& reading) {
    const bool stated = reading.source.property("RotationActive") != nullptr ||
                        std::any_of(reading.document->templates.begin(), reading.document->templates.end(),
                                    [](const DocumentTemplate& each) { return each.className == "FbxNode"; });
    if (!stated)
        reading.as<FbxNode>().SetRotationActive(true);
}

/// Cameras of old writers state position, up and interest as records only.
void readCameraProperties(const Reading& reading) {
    constexpr struct {
        const char* property;
        const char* record;
    } kRecords[] = {{"Position", "Position"}, {"UpVector", "Up"}, {"InterestPosition", "LookAt"}};
    for (const auto& row : kRecords) {
        const Record* record = reading.source.body->child(row.record);
        if (!record || record->values.size() < 3 || reading.source.property(row.property))
            continue;
        reading.object.FindProperty(row.property)
            .Set(FbxDouble3(record->value(0).toReal(), record->value(1).toReal(), record->value(2).toReal()));
    }
}

void readSkeleton(const Reading& reading) {
    const int type = numberOf(kSkeletonTypes, reading.source.subClass, FbxSkeleton::eLimbNode);
    reading.as<FbxSkeleton>().SetSkeletonType(static_cast<FbxSkeleton::EType>(type));
}

void readMarker(const Reading& reading) {
    const int type = numberOf(kMarkerTypes, reading.source.subClass, FbxMarker::eStandard);
    reading.as<FbxMarker>().SetType(static_cast<FbxMarker::EType>(type));
}

/// The channels of a curve node are its properties "d|X", "d|Y", … or "d|<property name>".
void readCurveNode(const Reading& reading) {
    for (const DocumentProperty& line : reading.source.properties) {
        if (!line.name.starts_with("d|"))
            continue;
        const double value = line.values.empty() ? 0.0 : line.values.front().toReal();
        reading.as<FbxAnimCurveNode>().addChannel(std::string(line.name.substr(2)).c_str(), value);
    }
}

void readCurveKeys(const Reading& reading) { reading.as<FbxAnimCurve>().setSource(reading.document, reading.source); }

void readMaterialProperties(const Reading& reading) {
    const std::string model = textOf(reading.record("ShadingModel"));
    if (!model.empty())
        reading.as<FbxSurfaceMaterial>().ShadingModel.Set(FbxString(model.c_str()));
}

void readFileTexture(const Reading& reading) {
    auto& texture = reading.as<FbxFileTexture>();
    texture.SetFileName(textOf(reading.record("FileName")).c_str());
    texture.SetRelativeFileName(textOf(reading.record("RelativeFilename")).c_str());
}

void readGeometry(const Reading& reading) {
    attachSource(reading.as<FbxGeometryBase>(), reading.document, reading.source);
}

void readAnyDeformer(const Reading& reading) { readDeformer(reading.object, reading.document, reading.source); }

using ReadFunction = void (*)(const Reading&);

/// Applied in order to every object that is of the class.
struct ClassReader {
    const FbxClassId& id;
    ReadFunction read;
};

const ClassReader kReaders[] = {
    {FbxNode::ClassId, readNode},
    {FbxSkeleton::ClassId, readSkeleton},
    {FbxMarker::ClassId, readMarker},
    {FbxGeometryBase::ClassId, readGeometry},
    {FbxDeformer::ClassId, readAnyDeformer},
    {FbxSubDeformer::ClassId, readAnyDeformer},
    {FbxFileTexture::ClassId, readFileTexture},
    {FbxAnimCurveNode::ClassId, readCurveNode},
    {FbxAnimCurve::ClassId, readCurveKeys},
};

/// Applied with the object's properties, after those that the file lists.
const ClassReader kPropertyReaders[] = {
    {FbxNode::ClassId, readNodeProperties},
    {FbxCamera::ClassId, readCameraProperties},
    {FbxSurfaceMaterial::ClassId, readMaterialProperties},
};

void applyReaders(std::span<const ClassReader> readers, const Reading& reading) {
    const FbxClassId id = reading.object.GetClassId();
    for (const ClassReader& reader : readers)
        if (id.Is(reader.id))
            reader.read(reading);
}

/// Reads the properties of a document's objects, which have their indexes in the document.
class DocumentProperties final : public PropertySource {
public:
    explicit DocumentProperties(std::shared_ptr<const Document> document) : mDocument(std::move(document)) {}

    void read(FbxObject& object, std::size_t place) const override {
        const DocumentObject& source = mDocument->objects[place];
        readTemplates(object);
        // The channels of curve nodes are no properties.
        if (!object.Is<FbxAnimCurveNode>())
            readProperties(object, source.properties);
        applyReaders(kPropertyReaders, {mDocument, source, object});
    }

private:
    void readTemplates(FbxObject& object) const {
        const ClassInfo* const info = object.GetClassId().info();
        if (const auto known = mTemplates.find(info); known != mTemplates.end()) {
            applyTemplate(object, known->second);
            return;
        }
        std::vector<TemplateLine> lines;
        for (const DocumentTemplate& each : mDocument->templates)
            if (each.className == object.GetClassId().GetName())
                readTemplate(object, each.properties, lines);
        mTemplates.emplace(info, std::move(lines));
    }

    std::shared_ptr<const Document> mDocument;
    /// The changes by the file's class defaults, by class; computed with the first object.
    mutable std::unordered_map<const ClassInfo*, std::vector<TemplateLine>> mTemplates;
};

bool sameText(std::string_view a, std::string_view b) {
    return std::equal(
        a.begin(), a.end(), b.begin(), b.end(),
        [](char x, char y) {
            const auto lower = [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + ('a' - 'A')) : c; };
            return lower(x) == lower(y);
        });
}

/// A material's class follows from its shading model, in any case.
FbxClassId materialClass(const DocumentObject& source) {
    const std::string_view model = source.body->childValue("ShadingModel").toText();
    if (sameText(model, "phong"))
        return FbxSurfacePhong::ClassId;
    if (sameText(model, "lambert"))
        return FbxSurfaceLambert::ClassId;
    return FbxSurfaceMaterial::ClassId;
}

} // namespace

ObjectReader::ObjectReader(std::shared_ptr<const Document> document, FbxScene& scene)
    : mDocument(std::move(document)), mProperties(std::make_shared<DocumentProperties>(mDocument)), mScene(scene) {}
ObjectReader::~ObjectReader() = default;

FbxClassId ObjectReader::classOf(const DocumentObject& source) {
    if (source.record == "Material")
        return materialClass(source);
    if (source.record != mLastRecord || source.subClass != mLastSubClass || mLastRecord.empty()) {
        mLastSchema = findSchema(source.record, source.subClass);
        mLastRecord = source.record;
        mLastSubClass = source.subClass;
    }
    return mLastSchema ? mLastSchema->classId() : FbxClassId();
}

FbxObject* ObjectReader::read(const DocumentObject& source) {
    const FbxClassId id = classOf(source);
    if (!id.IsValid())
        return nullptr;
    FbxObject* object = ManagerData::createObject(&mScene, id, std::string(source.name).c_str());
    if (!object)
        return nullptr;
    object->data().fileId = source.id;
    object->data().readPropertiesLater(mProperties, static_cast<std::size_t>(&source - mDocument->objects.data()));
    applyReaders(kReaders, {mDocument, source, *object});
    return object;
}

} // namespace detail
FBXSDK_NAMESPACE_END
