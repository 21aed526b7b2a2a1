// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From the scene to a file: which writer, which version, and one export.
#include "FbxSdk.h"

#include "WriterChoice.h"
#include "calls/LastError.h"

#include <iterator>
#include <utility>

namespace Tarnell::Fbx {

using detail::fail;
using detail::failAbout;
using detail::succeed;

namespace {

/// By compatibility version; what is none of them is the newest. There was no change of the format in 2015.
constexpr const char* kVersions[] = {"FBX201000", "FBX201100", "FBX201200", "FBX201300", "FBX201400"};
constexpr const char* kNewestVersion = "FBX201600";

const char* versionString(TnFbxWriteInfo::eCompatibilityVersion version) {
    const auto index = static_cast<int>(version);
    return index >= 0 && index < static_cast<int>(std::size(kVersions)) ? kVersions[index] : kNewestVersion;
}

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
    for (const auto& [path, value] : values) {
        settings->SetBoolProp(path, value);
    }
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
    if (manager == nullptr) {
        return fail(fileName + ": the FBX manager is not initialised");
    }
    fbxsdk::FbxExporter* exporter = fbxsdk::FbxExporter::Create(manager, "");
    exporter->SetFileExportVersion(versionString(version), fbxsdk::FbxSceneRenamer::eNone);

    const fbxsdk::FbxIOPluginRegistry& registry = *manager->GetIOPluginRegistry();
    // kept: with embedded media the native writer, also when text is asked for
    const int format =
        embedMedia ? registry.GetNativeWriterFormat() : detail::findWriter(registry, asciiFormat ? "ascii" : "binary");
    if (registry.WriterIsFBX(format)) {
        createExportSettings(manager, embedMedia);
    }
    if (!exporter->Initialize(fileName.c_str(), format, /*pIOSettings*/ nullptr)) {
        // the manager releases the exporter
        return failAbout(fileName, exporter->GetStatus().GetErrorString(), "cannot be written");
    }
    const bool exported = exporter->Export(document, /*pNonBlocking*/ false);
    const bool result =
        exported ? succeed() : failAbout(fileName, exporter->GetStatus().GetErrorString(), "cannot be written");
    exporter->Destroy(/*pRecursive*/ false);
    return result;
}

} // namespace Tarnell::Fbx
