// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What a scene keeps beside its members.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <fbxsdk/FbxScene.h>

#include "document/Document.h"
#include "object/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

extern const PropertyRow kDocumentTable[1];
inline constexpr std::span<const PropertyRow> kDocumentRows{kDocumentTable}; ///< of documents and scenes

struct SceneData {
    explicit SceneData(FbxScene& scene) : lights(scene), cameras(scene), times(scene) {}

    FbxNode* root = nullptr;
    FbxGlobalSettings* settings = nullptr;
    FbxGlobalLightSettings lights;
    FbxGlobalCameraSettings cameras;
    FbxGlobalTimeSettings times;
    FbxAnimStack* currentStack = nullptr;
    std::vector<FbxNode*> nodes;       ///< in order of entry
    std::vector<FbxAnimStack*> stacks; ///< likewise
    /// How many samples surfaces that became meshes have beyond what their control points are good for.
    std::int64_t samplesUsed = 0;
    /// The files that were read into the scene; geometry is read from them on first use.
    std::vector<std::shared_ptr<const Document>> documents;

    /// Keeps the lists in step when an object becomes a member or stops being one.
    void enter(FbxObject& member);
    void leave(FbxObject& member);
    /// Whether the object is one that every scene has: it stays as long as the scene.
    [[nodiscard]] bool isFixed(const FbxObject& member) const;
    /// The name of the file that was read last; empty for a scene made in memory.
    [[nodiscard]] std::string fileName() const;
};

} // namespace detail
FBXSDK_NAMESPACE_END
