// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Objects of a scene, class by class. The class table gives names and properties; the rows below give the records that
// a class has besides.
#include "io/SceneWriting.h"

#include <algorithm>
#include <cstring>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxCache.h>
#include <fbxsdk/FbxCameraStereo.h>
#include <fbxsdk/FbxCameraSwitcher.h>
#include <fbxsdk/FbxGlobalCameraSettings.h>
#include <fbxsdk/FbxLight.h>
#include <fbxsdk/FbxMarker.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxNull.h>
#include <fbxsdk/FbxScene.h>
#include <fbxsdk/FbxSkeleton.h>
#include <fbxsdk/FbxSurfaceMaterial.h>
#include <fbxsdk/FbxTexture.h>
#include <fbxsdk/FbxVideo.h>

#include "animation/CurveEvaluation.h"
#include "document/RecordWriting.h"
#include "geometry/GeometryWriting.h"
#include "object/SceneMembers.h"
#include "schema/Spellings.h"
#include "schema/SubClasses.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

std::string_view writtenSubClass(const FbxObject& object, const SchemaClass& schema) {
    if (const auto* skeleton = FbxCast<FbxSkeleton>(&object))
        return spellingOf(kSkeletonTypes, skeleton->GetSkeletonType(), FbxSkeleton::eLimbNode);
    if (const auto* marker = FbxCast<FbxMarker>(&object))
        return spellingOf(kMarkerTypes, marker->GetType(), FbxMarker::eStandard);
    return schema.subClass == kAnySubClass ? std::string_view() : schema.subClass;
}

struct Writing {
    DocumentObject& target;
    FbxObject& object;

    template <class T>
    [[nodiscard]] T& as() const {
        return static_cast<T&>(object);
    }
};

void setLine(WrittenLines& lines, std::string_view name, const FbxDataType& type, const Value& value) {
    lines.set({name, type.info()->typeName, type.info()->subTypeName, "", lines.keep(value)});
}

WriteRecords versionRecord(int version) {
    return [version](RecordSink& sink, const VersionTraits&) { writeInteger(sink, "Version", version); };
}

/// The kind that a Model states: that of its attribute.
std::string_view kindOf(FbxNode& node) {
    const FbxNodeAttribute* attribute = node.GetNodeAttribute();
    const SchemaClass* schema = attribute ? findSchema(attribute->GetClassId()) : nullptr;
    return schema ? writtenSubClass(*attribute, *schema) : SubClass::kNull;
}

void writeNode(const Writing& writing) {
    constexpr int kVersion = 232;
    auto& node = writing.as<FbxNode>();
    writing.target.subClass = kindOf(node);
    writing.target.content->before = versionRecord(kVersion);
    const bool hidden = node.GetNodeAttribute() && isView(*node.GetNodeAttribute());
    writing.target.content->after = [&node, hidden](RecordSink& sink, const VersionTraits& traits) {
        if (traits.modelStates) {
            writeInteger(sink, "MultiLayer", 0);
            writeInteger(sink, "MultiTake", 0);
        }
        if (hidden && traits.views)
            writeText(sink, "Hidden", "True");
        writeLetter(sink, "Shading", spellingOf(kShadingModes, node.GetShadingMode(), FbxNode::eHardShading));
        writeText(sink, "Culling", "CullingOff");
    };
}

void addNodeLines(FbxObject& node, const ClassOutput&, WrittenLines& lines) {
    const bool hasAttribute = static_cast<FbxNode&>(node).GetNodeAttribute() != nullptr;
    setLine(lines, "DefaultAttributeIndex", FbxIntDT, Value::ofInteger(hasAttribute ? 0 : -1));
}

void writeVector(RecordSink& sink, std::string_view name, const FbxDouble3& vector) {
    writeReals(sink, name, {vector[0], vector[1], vector[2]});
}

/// Some readers look at these records only, so they repeat the properties.
void writeCameraRecords(RecordSink& sink, const FbxCamera& camera) {
    constexpr int kGeometryVersion = 124;
    writeText(sink, "TypeFlags", SubClass::kCamera);
    writeInteger(sink, "GeometryVersion", kGeometryVersion);
    writeVector(sink, "Position", camera.Position.Get());
    writeVector(sink, "Up", camera.UpVector.Get());
    writeVector(sink, "LookAt", camera.InterestPosition.Get());
    writeInteger(sink, "ShowInfoOnMoving", camera.FindProperty("ShowInfoOnMoving").Get<FbxInt>());
    writeInteger(sink, "ShowAudio", camera.FindProperty("ShowAudio").Get<FbxInt>());
    writeVector(sink, "AudioColor", camera.FindProperty("AudioColor").Get<FbxDouble3>());
    writeReal(sink, "CameraOrthoZoom", camera.FindProperty("OrthoZoom").Get<FbxDouble>());
}

void writeCamera(const Writing& writing) {
    auto& camera = writing.as<FbxCamera>();
    writing.target.content->after = [&camera](RecordSink& sink, const VersionTraits&) {
        writeCameraRecords(sink, camera);
    };
}

void writeCameraStereo(const Writing& writing) {
    writing.target.content->after = [](RecordSink& sink, const VersionTraits&) {
        writeText(sink, "TypeFlags", SubClass::kCameraStereo);
        writeInteger(sink, "Version", 100);
    };
}

void writeCameraSwitcher(const Writing& writing) {
    auto& switcher = writing.as<FbxCameraSwitcher>();
    writing.target.content->after = [&switcher](RecordSink& sink, const VersionTraits&) {
        writeInteger(sink, "Version", 101);
        sink.beginRecord("Name");
        sink.objectName("Model", switcher.GetName());
        sink.endRecord();
        writeInteger(sink, "CameraId", 0);
        writeInteger(sink, "CameraName", 100);
        writeEmpty(sink, "CameraIndexName");
    };
}

void writeLight(const Writing& writing) {
    writing.target.content->after = [](RecordSink& sink, const VersionTraits&) {
        writeText(sink, "TypeFlags", SubClass::kLight);
        writeInteger(sink, "GeometryVersion", 124);
    };
}

template <const std::string_view& flags>
void writeTypeFlags(const Writing& writing) {
    writing.target.content->after = [](RecordSink& sink, const VersionTraits&) { writeText(sink, "TypeFlags", flags); };
}
constexpr std::string_view kMarkerFlags = "Marker";
constexpr std::string_view kSkeletonFlags = "Skeleton";

/// The record states the material's class; a name that states another would be read as another.
std::string shadingModelOf(const FbxSurfaceMaterial& material) {
    const FbxString stated = material.ShadingModel.Get();
    const char* const model = material.Is<FbxSurfacePhong>()     ? "phong"
                              : material.Is<FbxSurfaceLambert>() ? "lambert"
                                                                 : nullptr;
    if (model)
        return stated.CompareNoCase(model) == 0 ? stated.Buffer() : model;
    const bool claimed = stated.CompareNoCase("phong") == 0 || stated.CompareNoCase("lambert") == 0;
    return claimed ? "unknown" : stated.Buffer();
}

void writeMaterial(const Writing& writing) {
    auto& material = writing.as<FbxSurfaceMaterial>();
    writing.target.content->before = [&material](RecordSink& sink, const VersionTraits&) {
        writeInteger(sink, "Version", 102);
        writeText(sink, "ShadingModel", shadingModelOf(material));
        writeInteger(sink, "MultiLayer", material.MultiLayer.Get() ? 1 : 0);
    };
}

/// The record's content need not be repeated. Older files list all properties.
void omitShadingModel(FbxObject& object, const ClassOutput& common, WrittenLines& lines) {
    constexpr std::string_view kName = "ShadingModel";
    const WrittenLine* const line = common.choice == PropertyChoice::changed ? lines.find(kName) : nullptr;
    if (line && line->value().toText() == shadingModelOf(static_cast<FbxSurfaceMaterial&>(object)))
        lines.remove(kName);
}

void writeTextureName(RecordSink& sink, std::string_view record, std::string_view className, const FbxObject* object) {
    sink.beginRecord(record);
    if (object)
        sink.objectName(className, object->GetName());
    else
        sink.text("");
    sink.endRecord();
}

void writeFileTexture(const Writing& writing) {
    auto& texture = writing.as<FbxFileTexture>();
    writing.target.content->before = [&texture](RecordSink& sink, const VersionTraits&) {
        writeText(sink, "Type", "TextureVideoClip");
        writeInteger(sink, "Version", 202);
        writeTextureName(sink, "TextureName", "Texture", &texture);
    };
    writing.target.content->after = [&texture](RecordSink& sink, const VersionTraits&) {
        writeTextureName(sink, "Media", "Video", texture.GetSrcObject<FbxVideo>());
        writeText(sink, "FileName", texture.GetFileName());
        writeText(sink, "RelativeFilename", texture.GetRelativeFileName());
        writeReals(sink, "ModelUVTranslation", {texture.GetTranslationU(), texture.GetTranslationV()});
        writeReals(sink, "ModelUVScaling", {texture.GetScaleU(), texture.GetScaleV()});
        writeText(sink, "Texture_Alpha_Source", "None");
        writeIntegers(sink, "Cropping", {0, 0, 0, 0});
    };
}

void writeLayeredTexture(const Writing& writing) {
    writing.target.content->before = [](RecordSink& sink, const VersionTraits&) {
        writeInteger(sink, "LayeredTexture", 101);
    };
}

void writeVideo(const Writing& writing) {
    auto& video = writing.as<FbxVideo>();
    writing.target.content->before = [](RecordSink& sink, const VersionTraits&) {
        writeText(sink, "Type", SubClass::kClip);
    };
    writing.target.content->after = [&video](RecordSink& sink, const VersionTraits&) {
        writeInteger(sink, "UseMipMap", 0);
        writeText(sink, "Filename", video.GetFileName().Buffer());
        writeText(sink, "RelativeFilename", video.GetRelativeFileName().Buffer());
    };
}

void writeVersion100(const Writing& writing) { writing.target.content->before = versionRecord(100); }

void addStackLines(FbxObject& object, const ClassOutput&, WrittenLines& lines) {
    auto& stack = static_cast<FbxAnimStack&>(object);
    const WrittenSpan local = writtenSpan(stack.GetLocalTimeSpan(), stack);
    const WrittenSpan reference = writtenSpan(stack.GetReferenceTimeSpan(), stack);
    const std::pair<std::string_view, std::int64_t> times[] = {{"LocalStart", local.start},
                                                               {"LocalStop", local.stop},
                                                               {"ReferenceStart", reference.start},
                                                               {"ReferenceStop", reference.stop}};
    // All four, in this order, also where the stack itself holds only some that differ from the defaults.
    for (const auto& [name, time] : times)
        lines.remove(name);
    for (const auto& [name, time] : times)
        setLine(lines, name, FbxTimeDT, Value::ofInteger(time));
}

/// The property that a curve node drives; invalid when it drives none.
FbxProperty drivenProperty(const FbxAnimCurveNode& node) { return node.GetDstProperty(0); }

/// A curve node's channels are its properties: "d|X", … or "d|" and the name of the property that it drives.
void addChannelLines(FbxObject& object, const ClassOutput& common, WrittenLines& lines) {
    auto& node = static_cast<FbxAnimCurveNode&>(object);
    const FbxProperty driven = drivenProperty(node);
    const bool single = node.GetChannelsCount() == 1 && driven.IsValid();
    const std::string_view typeName = single ? channelTypeName(driven.GetPropertyDataType()) : "Number";
    for (unsigned int i = 0; i < node.GetChannelsCount(); ++i)
        lines.add({common.texts.channel(node.GetChannelName(static_cast<int>(i)).Buffer()), typeName, "", "A",
                   lines.keep(Value::ofReal(node.channelValue(i)))});
}

void writeCurveKeys(const Writing& writing) {
    auto& curve = writing.as<FbxAnimCurve>();
    writing.target.name = {}; // files give curves no names
    writing.target.content->curve = [&curve](const VersionTraits& traits, const UseKeys& use) {
        if (traits.allTangents)
            use(curve.keys());
        else
            use(legacyKeys(curve.keys()));
    };
}

void writeGeometry(const Writing& writing) {
    auto& geometry = writing.as<FbxGeometryBase>();
    writing.target.content->after = [&geometry](RecordSink& sink, const VersionTraits& traits) {
        writeGeometryRecords(geometry, traits, sink);
    };
}

void writeAnyDeformer(const Writing& writing) {
    FbxObject& deformer = writing.object;
    writing.target.content->before = [&deformer](RecordSink& sink, const VersionTraits& traits) {
        writeDeformerVersion(deformer, traits, sink);
    };
    writing.target.content->after = [&deformer](RecordSink& sink, const VersionTraits& traits) {
        writeDeformerRecords(deformer, traits, sink);
    };
}

} // namespace

/// The first row whose class the object has applies.
struct ClassWriter {
    const FbxClassId& id;
    void (*write)(const Writing& writing) = nullptr;
    /// Changes the lines of the object's properties.
    void (*addLines)(FbxObject& object, const ClassOutput& common, WrittenLines& lines) = nullptr;
};

namespace {

const ClassWriter kWriters[] = {
    {FbxNode::ClassId, writeNode, addNodeLines},
    {FbxCameraStereo::ClassId, writeCameraStereo},
    {FbxCamera::ClassId, writeCamera},
    {FbxCameraSwitcher::ClassId, writeCameraSwitcher},
    {FbxLight::ClassId, writeLight},
    {FbxNull::ClassId, writeTypeFlags<SubClass::kNull>},
    {FbxMarker::ClassId, writeTypeFlags<kMarkerFlags>},
    {FbxSkeleton::ClassId, writeTypeFlags<kSkeletonFlags>},
    {FbxGeometryBase::ClassId, writeGeometry},
    {FbxDeformer::ClassId, writeAnyDeformer},
    {FbxSubDeformer::ClassId, writeAnyDeformer},
    {FbxCache::ClassId, writeVersion100},
    {FbxSurfaceMaterial::ClassId, writeMaterial, omitShadingModel},
    {FbxFileTexture::ClassId, writeFileTexture},
    {FbxLayeredTexture::ClassId, writeLayeredTexture},
    {FbxVideo::ClassId, writeVideo},
    {FbxAnimStack::ClassId, nullptr, addStackLines},
    {FbxAnimCurveNode::ClassId, nullptr, addChannelLines},
    {FbxAnimCurve::ClassId, writeCurveKeys},
};

const ClassWriter* findWriter(const FbxClassId& id) {
    const auto* const found =
        std::find_if(std::begin(kWriters), std::end(kWriters), [&](const ClassWriter& each) { return id.Is(each.id); });
    return found == std::end(kWriters) ? nullptr : found;
}

/// Widens the span by that of a curve node.
void widen(FbxTimeSpan& span, bool& found, const FbxAnimCurveNode& node) {
    FbxTimeSpan keys;
    if (!node.GetAnimationInterval(keys))
        return;
    span.SetStart(found ? std::min(span.GetStart(), keys.GetStart()) : keys.GetStart());
    span.SetStop(found ? std::max(span.GetStop(), keys.GetStop()) : keys.GetStop());
    found = true;
}

} // namespace

bool isView(const FbxNodeAttribute& attribute) {
    FbxScene* const scene = attribute.GetScene();
    if (!scene)
        return false;
    const FbxGlobalCameraSettings& settings = scene->GlobalCameraSettings();
    const bool listed = settings.IsProducerCamera(FbxCast<FbxCamera>(&attribute)) ||
                        &attribute == static_cast<const FbxNodeAttribute*>(settings.GetCameraSwitcher());
    for (int i = 0; listed && i < attribute.GetNodeCount(); ++i)
        if (attribute.GetNode(i)->GetParent())
            return false;
    return listed;
}

const ClassOutput& ClassOutputs::of(const FbxObject& object, const SchemaClass& schema) {
    const ClassInfo* const info = object.data().info;
    const auto known = mClasses.find(info);
    if (known != mClasses.end())
        return known->second;
    const ClassOutput made{schema, findWriter(object.GetClassId()), defaultsOf(info->rows), mChoice, mTexts};
    return mClasses.emplace(info, made).first->second;
}

DocumentObject writableObject(FbxObject& object, const ClassOutput& common) {
    DocumentObject target;
    target.content = std::make_unique<ObjectContent>();
    target.record = common.schema.record;
    target.content->nameClass = common.schema.nameClass;
    target.subClass = writtenSubClass(object, common.schema);
    target.name = object.data().name;
    target.content->templateClass = common.schema.templateName();
    target.content->properties = [&object, &common](WrittenLines& lines) {
        addLines(object, common.choice, common.defaults, common.texts, lines);
        if (common.writer && common.writer->addLines)
            common.writer->addLines(object, common, lines);
    };
    if (common.writer && common.writer->write)
        common.writer->write({target, object});
    return target;
}

WrittenSpan writtenSpan(const FbxTimeSpan& span, const FbxAnimStack& stack) {
    const WrittenSpan stated{span.GetStart().Get(), span.GetStop().Get()};
    if (stated.start != 0 || stated.stop != 0)
        return stated;
    FbxTimeSpan keys;
    bool found = false;
    for (const FbxAnimLayer* layer : sourcesOf<FbxAnimLayer>(stack))
        for (const FbxAnimCurveNode* node : sourcesOf<FbxAnimCurveNode>(*layer))
            widen(keys, found, *node);
    if (!found)
        return {0, kTicksPerSecond};
    return {keys.GetStart().Get(), keys.GetStop().Get()};
}

} // namespace detail
FBXSDK_NAMESPACE_END
