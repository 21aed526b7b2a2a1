// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The default camera and the seven producer cameras, which belong to the settings and not to the node tree.
#pragma once

#include <array>

#include <fbxsdk/FbxStatus.h>

FBXSDK_NAMESPACE_BEGIN

class FbxCamera;
class FbxCameraSwitcher;
class FbxNode;
class FbxObject;
class FbxScene;

class FBXSDK_DLL FbxGlobalCameraSettings {
public:
    enum EViewingMode { eStandard, eXRay, eModelsOnly };

    explicit FbxGlobalCameraSettings(FbxScene& pScene) : mScene(&pScene) {}

    /// True for one of the eight fixed names and for the name of a camera below the root; it is then the default camera
    /// of the global settings, where 7.x files keep it.
    bool SetDefaultCamera(const char* pCameraName, FbxStatus* pStatus = nullptr);
    /// "Producer Perspective" where the global settings name none. Valid until the name changes.
    [[nodiscard]] const char* GetDefaultCamera() const;

    /// Makes those of the seven cameras, and the switcher, that are not there. Each stands on a node of its own, which
    /// belongs to the scene but hangs nowhere.
    void CreateProducerCameras();
    void DestroyProducerCameras();
    [[nodiscard]] bool IsProducerCamera(const FbxCamera* pCamera) const;
    [[nodiscard]] FbxCameraSwitcher* GetCameraSwitcher() const { return mSwitcher; }
    /// It joins the scene; one of another scene changes nothing.
    void SetCameraSwitcher(FbxCameraSwitcher* pCameraSwitcher);

    // Null until made or found in a file.
    [[nodiscard]] FbxCamera* GetCameraProducerPerspective() const { return mCameras[0]; }
    [[nodiscard]] FbxCamera* GetCameraProducerTop() const { return mCameras[1]; }
    [[nodiscard]] FbxCamera* GetCameraProducerBottom() const { return mCameras[2]; }
    [[nodiscard]] FbxCamera* GetCameraProducerFront() const { return mCameras[3]; }
    [[nodiscard]] FbxCamera* GetCameraProducerBack() const { return mCameras[4]; }
    [[nodiscard]] FbxCamera* GetCameraProducerRight() const { return mCameras[5]; }
    [[nodiscard]] FbxCamera* GetCameraProducerLeft() const { return mCameras[6]; }
    void RestoreDefaultSettings();

    /// Takes over a camera node of a file that bears the name of a producer camera or of the switcher. False for any
    /// other node, and when there is one already.
    bool adoptProducerCamera(FbxNode& pNode);
    /// The object has left the scene: if it is one of the cameras or the switcher, there is none any more.
    void forget(const FbxObject& pObject);

private:
    FbxScene* mScene;
    std::array<FbxCamera*, 7> mCameras{};
    FbxCameraSwitcher* mSwitcher = nullptr;
};

FBXSDK_NAMESPACE_END
