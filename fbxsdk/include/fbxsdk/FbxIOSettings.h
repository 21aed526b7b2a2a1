// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <cstdint>

#include <fbxsdk/FbxObject.h>

/// The name that hosts give their settings object; any other works as well.
#define IOSROOT "IOSRoot"
/// The path of the option: read materials.
#define IMP_FBX_MATERIAL "Import|AdvOptGrp|FileFormat|Fbx|Material"
/// The path of the option: read textures.
#define IMP_FBX_TEXTURE "Import|AdvOptGrp|FileFormat|Fbx|Texture"
/// The path of the option: read skins and their clusters.
#define IMP_FBX_LINK "Import|AdvOptGrp|FileFormat|Fbx|Link"
/// The path of the option: read blend shapes.
#define IMP_FBX_SHAPE "Import|AdvOptGrp|FileFormat|Fbx|Shape"
/// The path of the option: read the images that lights project.
#define IMP_FBX_GOBO "Import|AdvOptGrp|FileFormat|Fbx|Gobo"
/// The path of the option: read animation.
#define IMP_FBX_ANIMATION "Import|AdvOptGrp|FileFormat|Fbx|Animation"
/// The path of the option: read the global settings.
#define IMP_FBX_GLOBAL_SETTINGS "Import|AdvOptGrp|FileFormat|Fbx|Global_Settings"
/// The path of the option: write materials.
#define EXP_FBX_MATERIAL "Export|AdvOptGrp|Fbx|Material"
/// The path of the option: write textures.
#define EXP_FBX_TEXTURE "Export|AdvOptGrp|Fbx|Texture"
/// The path of the option: embed media in the file.
#define EXP_FBX_EMBEDDED "Export|AdvOptGrp|Fbx|EMBEDDED"
/// The path of the option: write blend shapes.
#define EXP_FBX_SHAPE "Export|AdvOptGrp|Fbx|Shape"
/// The path of the option: write the images that lights project.
#define EXP_FBX_GOBO "Export|AdvOptGrp|Fbx|Gobo"
/// The path of the option: write animation.
#define EXP_FBX_ANIMATION "Export|AdvOptGrp|Fbx|Animation"
/// The path of the option: write the global settings.
#define EXP_FBX_GLOBAL_SETTINGS "Export|AdvOptGrp|Fbx|Global_Settings"

FBXSDK_NAMESPACE_BEGIN

/// Options of import and export: true or false under a fixed set of paths.
///
/// Importers and exporters accept settings and ignore them: everything is read and written, and media are not
/// embedded. Setting an unknown path has no effect; getting one returns the default that was passed.
class FBXSDK_DLL FbxIOSettings : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxIOSettings, FbxObject)

public:
    /// Sets the option of that path, one of the IMP_FBX_… and EXP_FBX_… macros; no effect for any other and for
    /// null.
    void SetBoolProp(const char* pName, bool pValue);
    /// The option of that path: true until set, for EXP_FBX_EMBEDDED false; pDefValue for an unknown path and null.
    [[nodiscard]] bool GetBoolProp(const char* pName, bool pDefValue) const;

private:
    std::uint32_t mValues; ///< a bit for each known path
};

FBXSDK_NAMESPACE_END
