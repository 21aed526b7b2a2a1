// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
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

/// The data of a scene: its settings, lists of members by class, and the files it was read from.
struct SceneData final : Membership {
    explicit SceneData(FbxScene& owner) : Membership(owner), lights(owner), cameras(owner), times(owner) {}

    FbxNode* root = nullptr;
    FbxGlobalSettings* settings = nullptr;
    FbxGlobalLightSettings lights;
    FbxGlobalCameraSettings cameras;
    FbxGlobalTimeSettings times;
    FbxAnimStack* currentStack = nullptr;
    std::vector<FbxNode*> nodes;       ///< in order of entry
    std::vector<FbxAnimStack*> stacks; ///< likewise
    bool fileStatesRate = false;       ///< of the file that was read last
    /// How many samples tessellated surfaces have beyond the allowance of their control points.
    std::int64_t samplesUsed = 0;
    /// The files that were read into the scene; geometry is read from them on first use.
    std::vector<std::shared_ptr<const Document>> documents;

    void enter(FbxObject& member) override;
    void leave(FbxObject& member) override;
    [[nodiscard]] bool isFixed(const FbxObject& member) const override;
    /// The name of the file that was read last; empty for a scene made in memory.
    [[nodiscard]] std::string fileName() const;
};

} // namespace detail
FBXSDK_NAMESPACE_END
