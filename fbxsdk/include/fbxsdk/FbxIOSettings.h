// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Options of import and export, addressed by paths such as "Import|AdvOptGrp|FileFormat|Fbx|Material".
#pragma once

#include <map>
#include <string>

#include <fbxsdk/FbxObject.h>

#define IOSROOT "IOSRoot"
#define IMP_FBX_MATERIAL "Import|AdvOptGrp|FileFormat|Fbx|Material"
#define IMP_FBX_TEXTURE "Import|AdvOptGrp|FileFormat|Fbx|Texture"
#define IMP_FBX_LINK "Import|AdvOptGrp|FileFormat|Fbx|Link"
#define IMP_FBX_SHAPE "Import|AdvOptGrp|FileFormat|Fbx|Shape"
#define IMP_FBX_GOBO "Import|AdvOptGrp|FileFormat|Fbx|Gobo"
#define IMP_FBX_ANIMATION "Import|AdvOptGrp|FileFormat|Fbx|Animation"
#define IMP_FBX_GLOBAL_SETTINGS "Import|AdvOptGrp|FileFormat|Fbx|Global_Settings"
#define EXP_FBX_MATERIAL "Export|AdvOptGrp|Fbx|Material"
#define EXP_FBX_TEXTURE "Export|AdvOptGrp|Fbx|Texture"
#define EXP_FBX_EMBEDDED "Export|AdvOptGrp|Fbx|EMBEDDED"
#define EXP_FBX_SHAPE "Export|AdvOptGrp|Fbx|Shape"
#define EXP_FBX_GOBO "Export|AdvOptGrp|Fbx|Gobo"
#define EXP_FBX_ANIMATION "Export|AdvOptGrp|Fbx|Animation"
#define EXP_FBX_GLOBAL_SETTINGS "Export|AdvOptGrp|Fbx|Global_Settings"

FBXSDK_NAMESPACE_BEGIN

/// Settings take effect only where they are handed to an importer or exporter. Setting an unknown path does nothing;
/// asking for one gives the default passed along.
class FBXSDK_DLL FbxIOSettings : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxIOSettings, FbxObject)

public:
    void SetBoolProp(const char* pName, bool pValue);
    [[nodiscard]] bool GetBoolProp(const char* pName, bool pDefValue) const;

private:
    std::map<std::string, bool> mValues; ///< every known path
};

FBXSDK_NAMESPACE_END
