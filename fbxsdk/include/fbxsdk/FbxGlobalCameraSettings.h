// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <array>

#include <fbxsdk/FbxStatus.h>

FBXSDK_NAMESPACE_BEGIN

class FbxCamera;
class FbxCameraSwitcher;
class FbxNode;
class FbxObject;
class FbxScene;

/// The default camera, the seven producer cameras (an application's own views: perspective, top, bottom, front, back,
/// right, left) and the camera switcher. They are members of the scene and not below its root.
class FBXSDK_DLL FbxGlobalCameraSettings {
public:
    /// How an application draws; no call here uses it.
    enum EViewingMode {
        eStandard,  ///< everything
        eXRay,      ///< hidden objects are visible through others
        eModelsOnly ///< models without lights, cameras and bones
    };

    /// For the scene, which owns one.
    explicit FbxGlobalCameraSettings(FbxScene& pScene) : mScene(&pScene) {}

    /// True for one of the eight fixed names ("Producer Perspective" and so on, "Camera Switcher") and for the name of
    /// a camera below the root; it is then the default camera of the global settings, where 7.x files keep it. False,
    /// with a status, for any other.
    bool SetDefaultCamera(const char* pCameraName, FbxStatus* pStatus = nullptr);
    /// "Producer Perspective" where the global settings name none. Never null; valid until the name changes.
    [[nodiscard]] const char* GetDefaultCamera() const;

    /// Creates those of the seven cameras, and the switcher, that are missing. Each has a node of its own, which
    /// belongs to the scene and is unparented.
    void CreateProducerCameras();
    /// Destroys the seven cameras, the switcher and their nodes; pointers to them are invalid afterwards.
    void DestroyProducerCameras();
    /// Whether it is one of the seven; false for null.
    [[nodiscard]] bool IsProducerCamera(const FbxCamera* pCamera) const;
    /// Null until created, set or found in a file.
    [[nodiscard]] FbxCameraSwitcher* GetCameraSwitcher() const { return mSwitcher; }
    /// It joins the scene; one of another scene changes nothing. Null removes the switcher without destroying it.
    void SetCameraSwitcher(FbxCameraSwitcher* pCameraSwitcher);

    /// Null until created or found in a file, as the following ones. Perspective, from in front and above.
    [[nodiscard]] FbxCamera* GetCameraProducerPerspective() const { return mCameras[0]; }
    /// Orthogonal, looking down; null until created.
    [[nodiscard]] FbxCamera* GetCameraProducerTop() const { return mCameras[1]; }
    /// Orthogonal, looking up; null until created.
    [[nodiscard]] FbxCamera* GetCameraProducerBottom() const { return mCameras[2]; }
    /// Orthogonal, from positive Z; null until created.
    [[nodiscard]] FbxCamera* GetCameraProducerFront() const { return mCameras[3]; }
    /// Orthogonal, from negative Z; null until created.
    [[nodiscard]] FbxCamera* GetCameraProducerBack() const { return mCameras[4]; }
    /// Orthogonal, from positive X; null until created.
    [[nodiscard]] FbxCamera* GetCameraProducerRight() const { return mCameras[5]; }
    /// Orthogonal, from negative X; null until created.
    [[nodiscard]] FbxCamera* GetCameraProducerLeft() const { return mCameras[6]; }
    /// Recreates the cameras and the switcher and makes "Producer Perspective" the default camera; pointers to the
    /// former ones are invalid.
    void RestoreDefaultSettings();

    /// Takes over a camera node of a file that has the name of a producer camera or of the switcher. False for any
    /// other node, and when there is one already.
    bool adoptProducerCamera(FbxNode& pNode);
    /// The object has left the scene: if it was one of the cameras or the switcher, it is no longer set.
    void forget(const FbxObject& pObject);

private:
    FbxScene* mScene;
    std::array<FbxCamera*, 7> mCameras{};
    FbxCameraSwitcher* mSwitcher = nullptr;
};

FBXSDK_NAMESPACE_END
