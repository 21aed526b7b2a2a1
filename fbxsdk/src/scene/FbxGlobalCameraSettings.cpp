// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The default camera, and the viewing cameras that files before 7.x hold outside of the node tree.
#include <fbxsdk/FbxGlobalCameraSettings.h>

#include <algorithm>
#include <cstring>

#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxCameraSwitcher.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>

#include "object/ObjectData.h"
#include "scene/NodeTree.h"
#include "schema/ProducerCameras.h"

FBXSDK_NAMESPACE_BEGIN

namespace {

using Place = detail::ProducerCamera::Place;
constexpr const char* nameOf(Place place) { return detail::kProducerCameraNames[place]; }

/// The viewing cameras of the application that the format comes from, with the values in its files.
struct ProducerRow {
    const char* name;
    double position[3];
    double up[3];
    FbxCamera::EProjectionType projection;
    double nearPlane, farPlane;
};
constexpr ProducerRow kProducerCameras[] = {
    {nameOf(Place::perspective), {0, 71.3, 287.5}, {0, 1, 0}, FbxCamera::ePerspective, 10, 4000},
    {nameOf(Place::top), {0, 4000, 0}, {0, 0, -1}, FbxCamera::eOrthogonal, 1, 30000},
    {nameOf(Place::bottom), {0, -4000, 0}, {0, 0, -1}, FbxCamera::eOrthogonal, 1, 30000},
    {nameOf(Place::front), {0, 0, 4000}, {0, 1, 0}, FbxCamera::eOrthogonal, 1, 30000},
    {nameOf(Place::back), {0, 0, -4000}, {0, 1, 0}, FbxCamera::eOrthogonal, 1, 30000},
    {nameOf(Place::right), {4000, 0, 0}, {0, 1, 0}, FbxCamera::eOrthogonal, 1, 30000},
    {nameOf(Place::left), {-4000, 0, 0}, {0, 1, 0}, FbxCamera::eOrthogonal, 1, 30000},
};
constexpr double kProducerFieldOfView = 40.0;
constexpr double kProducerFocalLength = 21.354493494969105; // the focal length of 40° over a film height of 0.612 inch

FbxNode* makeNode(FbxScene& scene, const char* name, FbxNodeAttribute& attribute) {
    FbxNode* node = FbxNode::Create(&scene, name);
    node->SetNodeAttribute(&attribute);
    node->FindProperty("Show").Set(false);
    node->SetShadingMode(FbxNode::eWireFrame);
    return node;
}

FbxCamera* makeProducerCamera(FbxScene& scene, const ProducerRow& row) {
    FbxCamera* camera = FbxCamera::Create(&scene, row.name);
    camera->Position.Set(FbxDouble3(row.position[0], row.position[1], row.position[2]));
    camera->UpVector.Set(FbxDouble3(row.up[0], row.up[1], row.up[2]));
    camera->ProjectionType.Set(row.projection);
    camera->NearPlane.Set(row.nearPlane);
    camera->FarPlane.Set(row.farPlane);
    camera->FieldOfView.Set(kProducerFieldOfView);
    camera->FocalLength.Set(kProducerFocalLength);
    FbxNode* node = makeNode(scene, row.name, *camera);
    node->LclTranslation.Set(FbxDouble3(row.position[0], row.position[1], row.position[2]));
    return camera;
}

bool isFixedName(const char* name) {
    return std::strcmp(name, detail::kCameraSwitcherName) == 0 ||
           std::any_of(
               std::begin(kProducerCameras), std::end(kProducerCameras),
               [&](const ProducerRow& row) { return std::strcmp(row.name, name) == 0; });
}

/// Several nodes may have the name; one of them being a camera is enough.
bool hasCamera(FbxNode& root, const char* name) {
    detail::NodesBelow<FbxNode> below(root);
    while (FbxNode* node = below.next())
        if (std::strcmp(node->GetName(), name) == 0 && node->GetCamera())
            return true;
    return false;
}

} // namespace

bool FbxGlobalCameraSettings::SetDefaultCamera(const char* pCameraName, FbxStatus* pStatus) {
    if (pStatus)
        pStatus->Clear();
    if (!pCameraName || (!isFixedName(pCameraName) && !hasCamera(*mScene->GetRootNode(), pCameraName))) {
        if (pStatus)
            pStatus->SetCode(FbxStatus::eInvalidParameter, "there is no camera %s", pCameraName ? pCameraName : "");
        return false;
    }
    return mScene->GetGlobalSettings().SetDefaultCamera(pCameraName);
}

const char* FbxGlobalCameraSettings::GetDefaultCamera() const {
    const FbxGlobalSettings& settings = mScene->GetGlobalSettings();
    const detail::PropertyData* stated = settings.data().property(settings.FindProperty("DefaultCamera").index());
    return stated && !stated->value.text.empty() ? stated->value.text.c_str() : kProducerCameras[0].name;
}

void FbxGlobalCameraSettings::CreateProducerCameras() {
    for (std::size_t i = 0; i < mCameras.size(); ++i)
        if (!mCameras[i])
            mCameras[i] = makeProducerCamera(*mScene, kProducerCameras[i]);
    if (mSwitcher)
        return;
    mSwitcher = FbxCameraSwitcher::Create(mScene, detail::kCameraSwitcherName);
    makeNode(*mScene, detail::kCameraSwitcherName, *mSwitcher);
}

void FbxGlobalCameraSettings::DestroyProducerCameras() {
    const auto destroy = [](FbxNodeAttribute* attribute) {
        if (!attribute)
            return;
        if (FbxNode* node = attribute->GetNode())
            node->Destroy();
        attribute->Destroy();
    };
    for (FbxCamera*& camera : mCameras) {
        destroy(camera);
        camera = nullptr;
    }
    destroy(mSwitcher);
    mSwitcher = nullptr;
}

void FbxGlobalCameraSettings::forget(const FbxObject& pObject) {
    for (FbxCamera*& camera : mCameras)
        if (static_cast<const FbxObject*>(camera) == &pObject)
            camera = nullptr;
    if (static_cast<const FbxObject*>(mSwitcher) == &pObject)
        mSwitcher = nullptr;
}

void FbxGlobalCameraSettings::SetCameraSwitcher(FbxCameraSwitcher* pCameraSwitcher) {
    if (pCameraSwitcher && !pCameraSwitcher->GetScene())
        mScene->ConnectSrcObject(pCameraSwitcher);
    if (!pCameraSwitcher || pCameraSwitcher->GetScene() == mScene)
        mSwitcher = pCameraSwitcher;
}

bool FbxGlobalCameraSettings::IsProducerCamera(const FbxCamera* pCamera) const {
    return pCamera && std::find(mCameras.begin(), mCameras.end(), pCamera) != mCameras.end();
}

void FbxGlobalCameraSettings::RestoreDefaultSettings() {
    DestroyProducerCameras();
    CreateProducerCameras();
    SetDefaultCamera(kProducerCameras[0].name);
}

bool FbxGlobalCameraSettings::adoptProducerCamera(FbxNode& pNode) {
    FbxNodeAttribute* attribute = pNode.GetNodeAttribute();
    if (auto* switcher = FbxCast<FbxCameraSwitcher>(attribute)) {
        if (mSwitcher)
            return false;
        mSwitcher = switcher;
        return true;
    }
    auto* camera = FbxCast<FbxCamera>(attribute);
    for (std::size_t i = 0; camera && i < mCameras.size(); ++i) {
        if (mCameras[i] || std::strcmp(kProducerCameras[i].name, pNode.GetName()) != 0)
            continue;
        mCameras[i] = camera;
        return true;
    }
    return false;
}

FBXSDK_NAMESPACE_END
