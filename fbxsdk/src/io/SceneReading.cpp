// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From document to scene: settings, objects in file order, then connections in file order.
#include "io/SceneReading.h"

#include <string>
#include <vector>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxGlobalCameraSettings.h>
#include <fbxsdk/FbxGlobalLightSettings.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>

#include "io/ObjectReading.h"
#include "object/SceneMembers.h"
#include "scene/MissingTimes.h"
#include "scene/SceneData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// The scene's objects by their index in Document::objects; null where the platform has no such class.
using ObjectTable = std::vector<FbxObject*>;

void readLightSettings(const DocumentLightSettings& source, FbxGlobalLightSettings& settings) {
    const auto color = [](const double(&c)[4]) { return FbxColor(c[0], c[1], c[2], c[3]); };
    if (source.hasAmbient)
        settings.SetAmbientColor(color(source.ambientColor));
    if (!source.hasFog)
        return;
    settings.SetFogEnable(source.fogEnable);
    settings.SetFogMode(static_cast<FbxGlobalLightSettings::EFogMode>(source.fogMode));
    settings.SetFogDensity(source.fogDensity);
    settings.SetFogStart(source.fogStart);
    settings.SetFogEnd(source.fogEnd);
    settings.SetFogColor(color(source.fogColor));
}

void readSettings(const Document& document, FbxScene& scene) {
    readProperties(scene.GetGlobalSettings(), document.globalSettings);
    readLightSettings(document.lightSettings, scene.GlobalLightSettings());
    scene.ActiveAnimStackName.Set(FbxString(document.activeStackName.c_str()));
}

/// Connections of a file, end by end.
class ConnectionReader {
public:
    ConnectionReader(const Document& document, const ObjectTable& objects, FbxScene& scene)
        : mDocument(document), mObjects(objects), mScene(scene) {}

    void read(const DocumentConnection& connection) {
        FbxObject* source = objectOf(connection.source);
        if (connection.destination == 0) {
            if (connection.destinationProperty.empty())
                connectToRoot(source);
            return;
        }
        FbxObject* destination = objectOf(connection.destination);
        if (!source || !destination)
            return;
        if (connectCurve(*source, *destination, connection))
            return;
        if (connection.destinationProperty.empty())
            connectToObject(*source, *destination, connection);
        else
            connectToProperty(*source, *destination, connection);
    }

private:
    FbxObject* objectOf(std::int64_t id) const {
        const DocumentObject* object = id == 0 ? nullptr : mDocument.find(id);
        return object ? mObjects[static_cast<std::size_t>(object - mDocument.objects.data())] : nullptr;
    }

    void connectToRoot(FbxObject* source) {
        if (auto* node = FbxCast<FbxNode>(source))
            mScene.GetRootNode()->AddChild(node);
    }

    /// A curve is connected to a channel of its curve node: "d|X", or without a name the only one.
    static bool connectCurve(FbxObject& source, FbxObject& destination, const DocumentConnection& connection) {
        auto* curve = FbxCast<FbxAnimCurve>(&source);
        auto* node = FbxCast<FbxAnimCurveNode>(&destination);
        if (!curve || !node)
            return false;
        std::string channel(connection.destinationProperty);
        if (channel.starts_with("d|"))
            channel.erase(0, 2);
        if (channel.empty()) {
            node->ConnectToChannel(curve, 0U);
        } else {
            node->addChannel(channel.c_str(), 0.0); // no effect when it exists
            node->ConnectToChannel(curve, channel.c_str());
        }
        return true;
    }

    static void connectToObject(FbxObject& source, FbxObject& destination, const DocumentConnection& connection) {
        if (!connection.sourceProperty.empty())
            destination.ConnectSrcProperty(source.FindProperty(std::string(connection.sourceProperty).c_str()));
        else if (auto* child = FbxCast<FbxNode>(&source); child && destination.Is<FbxNode>())
            static_cast<FbxNode&>(destination).AddChild(child);
        else
            destination.ConnectSrcObject(&source);
    }

    static void connectToProperty(FbxObject& source, FbxObject& destination, const DocumentConnection& connection) {
        FbxProperty property = destination.FindProperty(std::string(connection.destinationProperty).c_str());
        if (!property.IsValid())
            return;
        if (connection.sourceProperty.empty())
            property.ConnectSrcObject(&source);
        else
            property.ConnectSrcProperty(source.FindProperty(std::string(connection.sourceProperty).c_str()));
    }

    const Document& mDocument;
    const ObjectTable& mObjects;
    FbxScene& mScene;
};

/// Files name the channels of a vector in any order and omit some; the platform requires all of them in order.
void arrangeChannels(const ObjectTable& objects) {
    for (FbxObject* object : objects) {
        auto* node = FbxCast<FbxAnimCurveNode>(object);
        const FbxProperty property = node ? node->GetDstProperty() : FbxProperty();
        const FbxDouble4 values = property.Get<FbxDouble4>();
        switch (property.GetPropertyDataType().GetType()) {
        case eFbxDouble2:
            node->arrangeChannels({values[0], values[1]});
            break;
        case eFbxDouble3:
            node->arrangeChannels({values[0], values[1], values[2]});
            break;
        case eFbxDouble4:
            node->arrangeChannels({values[0], values[1], values[2], values[3]});
            break;
        default:
            break;
        }
    }
}

/// Unparented camera nodes with the name of a producer camera belong to the settings.
void readProducerCameras(FbxScene& scene) {
    for (FbxNode* node : sourcesOf<FbxNode>(scene)) {
        if (node->GetParent() || node == scene.GetRootNode())
            continue;
        scene.GlobalCameraSettings().adoptProducerCamera(*node);
    }
}

} // namespace

bool readScene(const std::shared_ptr<const Document>& document, FbxScene& scene, FbxStatus& status,
               std::vector<std::string>* notes) {
    status.Clear();
    scene.sceneData().documents.push_back(document);
    readSettings(*document, scene);
    ObjectTable objects;
    objects.reserve(document->objects.size());
    ObjectReader objectReader(document, scene);
    for (const DocumentObject& source : document->objects)
        objects.push_back(objectReader.read(source));
    ConnectionReader reader(*document, objects, scene);
    for (const DocumentConnection& connection : document->connections)
        reader.read(connection);
    arrangeChannels(objects);
    readProducerCameras(scene);
    fillStackSpans(*document, objects, scene);
    if (std::string note = fillFrameRate(*document, objects, scene); notes && !note.empty())
        notes->push_back(std::move(note));
    return true;
}

} // namespace detail
FBXSDK_NAMESPACE_END
