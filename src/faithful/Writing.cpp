// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Writing.h"

#include "access/WriterChoice.h"
#include "calls/LastError.h"

namespace Tarnell::Fbx::faithful {

namespace {

template <class Object>
void addAll(WrittenScene& scene, bool wanted, const std::vector<Object*>& objects) {
    for (Object* object : objects)
        if (wanted && object != nullptr)
            addObject(scene, *object);
}

bool save(WrittenScene& scene) {
    const TnFbxWriteInfo& info = scene.info();
    fbxsdk::FbxManager& manager = scene.manager();
    auto& exporter = *fbxsdk::FbxExporter::Create(&manager, "");
    exporter.SetFileExportVersion(detail::versionString(info.getCompatibilityVersion()),
                                  fbxsdk::FbxSceneRenamer::eNone);
    const int format = detail::findWriter(*manager.GetIOPluginRegistry(), info.getFileFormat() ? "ascii" : "binary");
    return detail::exportDocument(exporter, &scene.scene(), info.getFileName(), format);
}

} // namespace

bool writeObjects(const TnFbxWriteInfo& info, const std::vector<TnFbxCamera*>& cameras,
                  const std::vector<TnFbxLight*>& lights, const std::vector<TnFbxTransform*>& transforms,
                  const std::vector<TnFbxNull*>& nulls, const std::vector<TnFbxMesh*>& meshes) {
    WrittenScene scene;
    if (!scene.begin(info))
        return false;
    addAll(scene, info.getWriteCameras(), cameras);
    addAll(scene, info.getWriteLights(), lights);
    addAll(scene, info.getWriteTransforms(), transforms);
    addAll(scene, info.getWriteNulls(), nulls);
    addAll(scene, info.getWriteMeshes(), meshes);
    scene.finish();
    if (scene.keys().memory().exceeded())
        return detail::fail(info.getFileName() + ": " + scene.keys().memory().describe("keys"));
    return save(scene);
}

} // namespace Tarnell::Fbx::faithful
