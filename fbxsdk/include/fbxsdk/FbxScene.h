// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
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

/// A node tree, settings, and every object that belongs to them. The objects are the scene's members, its sources in
/// order of entry; they are destroyed with it.
class FBXSDK_DLL FbxScene : public FbxDocument {
    FBXSDK_OBJECT_DECLARE(FbxScene, FbxDocument)

public:
    /// The ancestor of all other nodes; never null. Present from the start: "RootNode", without attribute, at the
    /// identity. It is not saved.
    [[nodiscard]] FbxNode* GetRootNode() const;

    [[nodiscard]] FbxGlobalSettings& GetGlobalSettings(); ///< Axes, unit, time mode; valid as long as the scene.
    [[nodiscard]] const FbxGlobalSettings& GetGlobalSettings() const; ///< The same for a const scene.
    /// Ambient light and fog; valid as long as the scene.
    [[nodiscard]] FbxGlobalLightSettings& GlobalLightSettings();
    [[nodiscard]] FbxGlobalCameraSettings& GlobalCameraSettings(); ///< The default camera and the producer cameras.
    [[nodiscard]] FbxGlobalTimeSettings& GlobalTimeSettings();     ///< The time mode as files before 7.x hold it.

    /// How many nodes are members: the root, its descendants, and unparented nodes, such as those of the producer
    /// cameras.
    [[nodiscard]] int GetNodeCount() const;
    /// The node at that index in order of entry, the root first; null out of range.
    [[nodiscard]] FbxNode* GetNode(int pIndex) const;

    /// The stack by which transforms and properties are evaluated. Null means the scene's first one; a stack that is
    /// not the scene's changes nothing. Its name becomes the document's ActiveAnimStackName.
    void SetCurrentAnimationStack(FbxAnimStack* pAnimStack);
    /// The stack that was set, else the scene's first, whatever ActiveAnimStackName says; null without any.
    [[nodiscard]] FbxAnimStack* GetCurrentAnimationStack() const;

    /// The platform's own view of the scene.
    [[nodiscard]] detail::SceneData& sceneData() const { return *mSceneData; }

private:
    std::unique_ptr<detail::SceneData> mSceneData;
};

FBXSDK_NAMESPACE_END
