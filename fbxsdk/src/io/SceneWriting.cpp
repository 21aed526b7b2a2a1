// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Objects of a scene in the order of files, with ids from a counter, and their connections.
#include "io/SceneWriting.h"

#include <algorithm>
#include <array>
#include <memory>
#include <unordered_set>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxGlobalCameraSettings.h>
#include <fbxsdk/FbxGlobalLightSettings.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>

#include "object/SceneMembers.h"
#include "scene/IdleCurveNode.h"
#include "scene/SceneData.h"
#include "schema/VersionTraits.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// The order of kinds within a file; others follow in order of membership.
constexpr std::string_view kRecordOrder[] = {
    "NodeAttribute",  "Geometry", "Model",          "Material",       "Deformer",           "Video",          "Texture",
    "LayeredTexture", "Cache",    "AnimationStack", "AnimationCurve", "AnimationCurveNode", "AnimationLayer",
};

std::size_t rankOf(std::string_view record) {
    return static_cast<std::size_t>(std::find(std::begin(kRecordOrder), std::end(kRecordOrder), record) -
                                    std::begin(kRecordOrder));
}

struct ChosenObject {
    FbxObject* object;
    const SchemaClass* schema;
    std::size_t rank; ///< of its kind
};

/// The ids in the file, by the place of objects in the manager's list, which stays while a scene is written.
class FileIds {
public:
    FileIds(const std::vector<ChosenObject>& objects, std::int64_t first) {
        for (const ChosenObject& chosen : objects) {
            const std::size_t slot = chosen.object->data().managerSlot;
            if (slot >= mIds.size())
                mIds.resize(std::max(slot + 1, 2 * mIds.size()));
            mIds[slot] = first++;
        }
    }

    /// 0 for objects that are not in the file.
    [[nodiscard]] std::int64_t of(const FbxObject& object) const {
        const std::size_t slot = object.data().managerSlot;
        return slot < mIds.size() ? mIds[slot] : 0;
    }

private:
    std::vector<std::int64_t> mIds;
};

/// The scene's objects that a file holds.
class ObjectChoice {
public:
    ObjectChoice(FbxScene& scene, const VersionTraits& traits) : mScene(scene) {
        if (!traits.views)
            excludeViews();
    }

    [[nodiscard]] std::vector<ChosenObject> choose() const {
        std::vector<ChosenObject> chosen;
        for (const ConnectionPoint* source : mScene.data().plug.sources) {
            FbxObject& object = *source->object;
            if (source->property >= 0 || !isWritten(object))
                continue;
            if (const SchemaClass* schema = findSchema(object.GetClassId()))
                chosen.push_back({&object, schema, rankOf(schema->record)});
        }
        std::stable_sort(chosen.begin(), chosen.end(),
                         [](const ChosenObject& a, const ChosenObject& b) { return a.rank < b.rank; });
        return chosen;
    }

private:
    [[nodiscard]] bool isWritten(const FbxObject& object) const {
        if (mScene.sceneData().isFixed(object) || mExcluded.count(&object) > 0)
            return false;
        if (const auto* node = FbxCast<FbxAnimCurveNode>(&object))
            return !isIdle(*node);
        // A component without keys is only the value of its curve node.
        const auto* curve = FbxCast<FbxAnimCurve>(&object);
        return !curve || curve->KeyGetCount() > 0;
    }

    /// Files from 7.0 on cannot hold the application's views.
    void excludeViews() {
        for (const FbxNodeAttribute* attribute : sourcesOf<FbxNodeAttribute>(mScene)) {
            if (!isView(*attribute))
                continue;
            mExcluded.insert(attribute);
            for (int i = 0; i < attribute->GetNodeCount(); ++i)
                mExcluded.insert(attribute->GetNode(i));
        }
    }

    FbxScene& mScene;
    std::unordered_set<const FbxObject*> mExcluded;
};

/// Connections between objects of the file. Their order in the file matters to human readers only; the
/// order among the sources of one object does.
class ConnectionWriter {
public:
    ConnectionWriter(FbxScene& scene, const FileIds& ids, std::vector<DocumentConnection>& connections,
                     CommonTexts& texts)
        : mScene(scene), mIds(ids), mConnections(connections), mTexts(texts) {}

    void write(const std::vector<ChosenObject>& objects) {
        const FbxNode& root = *mScene.GetRootNode();
        for (const ConnectionPoint* source : root.data().plug.sources)
            if (source->property < 0 && source->object->Is<FbxNode>())
                add(kHierarchy, mIds.of(*source->object), 0);
        for (const ChosenObject& chosen : objects)
            writeSources(*chosen.object);
        for (const std::vector<DocumentConnection>& connections : mRanked)
            mConnections.insert(mConnections.end(), connections.begin(), connections.end());
    }

private:
    enum Rank { kHierarchy, kLayers, kLayerMembers, kOthers, kCurves, kRanks };

    void add(Rank rank, std::int64_t source, std::int64_t destination, std::string_view sourceProperty = {},
             std::string_view destinationProperty = {}) {
        if (source != 0)
            mRanked[rank].push_back({source, destination, sourceProperty, destinationProperty});
    }

    void writeSources(const FbxObject& destination) {
        const std::int64_t id = mIds.of(destination);
        for (const ConnectionPoint* source : destination.data().plug.sources)
            if (!source->object->Is<FbxAnimCurve>() || !destination.Is<FbxAnimCurveNode>())
                add(rankOf(*source->object, destination), mIds.of(*source->object), id, nameOf(*source));
        for (const PropertyData* property : destination.data().properties())
            for (const ConnectionPoint* source : property->plug.sources)
                add(kOthers, mIds.of(*source->object), id, nameOf(*source), propertyName(destination, property->index));
        if (const auto* node = FbxCast<FbxAnimCurveNode>(&destination))
            writeChannels(*node, id);
    }

    void writeChannels(const FbxAnimCurveNode& node, std::int64_t id) {
        for (unsigned int channel = 0; channel < node.GetChannelsCount(); ++channel) {
            const int count = node.GetCurveCount(channel);
            for (int i = 0; i < count; ++i) {
                add(kCurves, mIds.of(*node.GetCurve(channel, static_cast<unsigned int>(i))), id, {},
                    mTexts.channel(node.GetChannelName(static_cast<int>(channel)).Buffer()));
            }
        }
    }

    /// Empty for an object.
    static std::string_view nameOf(const ConnectionPoint& point) {
        return point.property < 0 ? std::string_view() : propertyName(*point.object, point.property);
    }

    static Rank rankOf(const FbxObject& source, const FbxObject& destination) {
        if (source.Is<FbxNode>() && destination.Is<FbxNode>())
            return kHierarchy;
        if (destination.Is<FbxAnimStack>())
            return kLayers;
        return destination.Is<FbxAnimLayer>() ? kLayerMembers : kOthers;
    }

    FbxScene& mScene;
    const FileIds& mIds;
    std::vector<DocumentConnection>& mConnections;
    CommonTexts& mTexts;
    std::array<std::vector<DocumentConnection>, kRanks> mRanked;
};

void writeSettings(FbxScene& scene, ClassOutputs& classes, Document& document) {
    const FbxGlobalSettings& settings = scene.GetGlobalSettings();
    WrittenLines lines;
    addLines(settings, PropertyChoice::all, classes.defaultsOf(settings.data().info->rows), classes.texts(), lines);
    const char* const camera = scene.GlobalCameraSettings().GetDefaultCamera();
    lines.set({"DefaultCamera", "KString", "", "", lines.keep(Value::ofText(camera))});
    document.globalSettings = lines.kept(*document.tree);

    const FbxGlobalLightSettings& lights = scene.GlobalLightSettings();
    DocumentLightSettings& target = document.lightSettings;
    const auto store = [](double(&numbers)[4], const FbxColor& color) {
        numbers[0] = color.mRed;
        numbers[1] = color.mGreen;
        numbers[2] = color.mBlue;
        numbers[3] = color.mAlpha;
    };
    store(target.ambientColor, lights.GetAmbientColor());
    store(target.fogColor, lights.GetFogColor());
    target.fogEnable = lights.GetFogEnable();
    target.fogMode = static_cast<int>(lights.GetFogMode());
    target.fogDensity = lights.GetFogDensity();
    target.fogStart = lights.GetFogStart();
    target.fogEnd = lights.GetFogEnd();
}

void writeTemplates(const std::vector<ChosenObject>& objects, ClassOutputs& classes, Document& document) {
    std::unordered_set<const SchemaClass*> done;
    for (const ChosenObject& chosen : objects) {
        if (done.insert(chosen.schema).second)
            document.templates.push_back(
                {chosen.schema->record, chosen.schema->templateName(), classes.defaultsOf(chosen.schema->rows).lines});
    }
}

void writeTakes(const std::vector<ChosenObject>& objects, Document& document) {
    for (const ChosenObject& chosen : objects) {
        const auto* stack = FbxCast<FbxAnimStack>(chosen.object);
        if (!stack)
            continue;
        const WrittenSpan local = writtenSpan(stack->GetLocalTimeSpan(), *stack);
        const WrittenSpan reference = writtenSpan(stack->GetReferenceTimeSpan(), *stack);
        document.takes.push_back({stack->GetName(),
                                  {},
                                  local.start,
                                  local.stop,
                                  reference.start,
                                  reference.stop,
                                  /*hasLocal*/ true,
                                  /*hasReference*/ true});
    }
}

} // namespace

void writeScene(FbxScene& scene, const VersionTraits& traits, Document& document) {
    const std::vector<ChosenObject> objects = ObjectChoice(scene, traits).choose();
    document.id = 1;
    document.activeStackName = scene.ActiveAnimStackName.Get().Buffer();
    auto owned = std::make_unique<ClassOutputs>(*document.tree, traits);
    ClassOutputs& classes = *owned;
    document.companion = std::move(owned); // the objects refer to it
    writeSettings(scene, classes, document);
    writeTemplates(objects, classes, document);
    document.objects.reserve(objects.size());
    for (const ChosenObject& chosen : objects) {
        document.objects.push_back(writableObject(*chosen.object, classes.of(*chosen.object, *chosen.schema)));
        document.objects.back().id = document.id + static_cast<std::int64_t>(document.objects.size());
    }
    ConnectionWriter(scene, FileIds(objects, document.id + 1), document.connections, classes.texts()).write(objects);
    writeTakes(objects, document);
}

} // namespace detail
FBXSDK_NAMESPACE_END
