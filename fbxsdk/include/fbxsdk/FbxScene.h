// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A scene: the node tree, the settings, and every object that belongs to them.
#pragma once

#include <memory>

#include <fbxsdk/FbxDocument.h>
#include <fbxsdk/FbxGlobalCameraSettings.h>
#include <fbxsdk/FbxGlobalLightSettings.h>
#include <fbxsdk/FbxGlobalSettings.h>
#include <fbxsdk/FbxGlobalTimeSettings.h>

FBXSDK_NAMESPACE_BEGIN

class FbxAnimStack;
class FbxNode;

namespace detail {
struct SceneData;
}

class FBXSDK_DLL FbxScene : public FbxDocument {
    FBXSDK_OBJECT_DECLARE(FbxScene, FbxDocument)

public:
    /// There from the start: "RootNode", without attribute, at the identity. It is not saved.
    [[nodiscard]] FbxNode* GetRootNode() const;

    [[nodiscard]] FbxGlobalSettings& GetGlobalSettings();
    [[nodiscard]] const FbxGlobalSettings& GetGlobalSettings() const;
    [[nodiscard]] FbxGlobalLightSettings& GlobalLightSettings();
    [[nodiscard]] FbxGlobalCameraSettings& GlobalCameraSettings();
    [[nodiscard]] FbxGlobalTimeSettings& GlobalTimeSettings();

    /// All nodes in order of entry, the root first, those that hang nowhere included.
    [[nodiscard]] int GetNodeCount() const;
    /// Null out of range.
    [[nodiscard]] FbxNode* GetNode(int pIndex) const;

    /// The stack that transforms are evaluated with: the one set, else the scene's first; null without any. Setting
    /// null means the first again; a stack that is not the scene's changes nothing.
    void SetCurrentAnimationStack(FbxAnimStack* pAnimStack);
    [[nodiscard]] FbxAnimStack* GetCurrentAnimationStack() const;

    /// The platform's own view of the scene.
    [[nodiscard]] detail::SceneData& sceneData() const { return *mSceneData; }

private:
    std::unique_ptr<detail::SceneData> mSceneData;
};

FBXSDK_NAMESPACE_END
