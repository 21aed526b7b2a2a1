// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Writing the scene to a file: choice of writer and version, and one export.
#include "FbxSdk.h"

#include "access/WriterChoice.h"
#include "calls/LastError.h"

#include <utility>

namespace Tarnell::Fbx {

using detail::fail;

namespace {

/// kept: the settings go to neither the exporter nor the manager, so a write always runs with the platform's own
/// defaults.
void createExportSettings(fbxsdk::FbxManager* manager, bool embedMedia) {
    const std::pair<const char*, bool> values[] = {
        {"Export|AdvOptGrp|Fbx|Material", true},        //
        {"Export|AdvOptGrp|Fbx|Texture", true},         //
        {"Export|AdvOptGrp|Fbx|EMBEDDED", embedMedia},  //
        {"Export|AdvOptGrp|Fbx|Shape", true},           //
        {"Export|AdvOptGrp|Fbx|Gobo", true},            //
        {"Export|AdvOptGrp|Fbx|Animation", true},       //
        {"Export|AdvOptGrp|Fbx|Global_Settings", true}, //
    };
    fbxsdk::FbxIOSettings* settings = fbxsdk::FbxIOSettings::Create(manager, "IOSRoot");
    for (const auto& [path, value] : values)
        settings->SetBoolProp(path, value);
}

} // namespace

void FbxSdk::letPointCachesAppearWithScene() { mCachesAppearWithScene = true; }

bool FbxSdk::saveScene(const TnFbxWriteInfo& info) {
    const detail::CallScope call;
    return saveScene(mManager, mScene, info.getFileName(), info.getFileFormat(), info.getCompatibilityVersion(),
                     /*embedMedia*/ false);
}

bool FbxSdk::saveScene(fbxsdk::FbxManager* manager, fbxsdk::FbxDocument* document, const std::string& fileName,
                       bool asciiFormat, TnFbxWriteInfo::eCompatibilityVersion version, bool embedMedia) {
    if (manager == nullptr)
        return fail(fileName + ": the FBX manager is not initialised");
    fbxsdk::FbxExporter* exporter = fbxsdk::FbxExporter::Create(manager, "");
    exporter->SetFileExportVersion(detail::versionString(version), fbxsdk::FbxSceneRenamer::eNone);

    const fbxsdk::FbxIOPluginRegistry& registry = *manager->GetIOPluginRegistry();
    // kept: with embedded media the native writer, also when ASCII is requested
    const int format =
        embedMedia ? registry.GetNativeWriterFormat() : detail::findWriter(registry, asciiFormat ? "ascii" : "binary");
    if (registry.WriterIsFBX(format))
        createExportSettings(manager, embedMedia);
    return detail::exportDocument(*exporter, document, fileName, format);
}

} // namespace Tarnell::Fbx
