// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/extensions/FileFacts.h>

#include <algorithm>

#include "object/ObjectData.h"
#include "scene/SceneData.h"

FBXSDK_NAMESPACE_BEGIN
namespace extensions {

std::int64_t fileIdOf(const FbxObject& object) { return object.data().fileId; }

bool isStated(const FbxProperty& property) {
    return property.IsValid() && property.index() >= 0 &&
           property.GetFbxObject()->data().property(property.index()) != nullptr;
}

// The flag is one of properties that have data: no class has a row with it.
bool hasUserDefinedProperties(const FbxObject& object) {
    const std::vector<detail::PropertyData*>& properties = object.data().properties();
    return std::any_of(properties.begin(), properties.end(), [](const detail::PropertyData* property) {
        return (property->flags & static_cast<unsigned>(FbxPropertyFlags::eUserDefined)) != 0;
    });
}

bool statesFrameRate(const FbxScene& scene) { return scene.sceneData().fileStatesRate; }

std::vector<FbxObject*> objectsOf(const FbxScene& scene) {
    std::vector<FbxObject*> objects;
    for (const detail::ConnectionPoint* point : scene.data().plug.sources)
        if (point->property < 0)
            objects.push_back(point->object);
    return objects;
}

} // namespace extensions
FBXSDK_NAMESPACE_END
