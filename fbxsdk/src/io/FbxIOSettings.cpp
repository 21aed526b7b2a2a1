// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxIOSettings.h>

#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxIOSettings, FbxObject, std::span<const detail::PropertyRow>{})

namespace {

struct KnownPath {
    const char* path;
    bool value;
};
constexpr KnownPath kKnownPaths[] = {
    {IMP_FBX_MATERIAL, true},
    {IMP_FBX_TEXTURE, true},
    {IMP_FBX_LINK, true},
    {IMP_FBX_SHAPE, true},
    {IMP_FBX_GOBO, true},
    {IMP_FBX_ANIMATION, true},
    {IMP_FBX_GLOBAL_SETTINGS, true},
    {EXP_FBX_MATERIAL, true},
    {EXP_FBX_TEXTURE, true},
    {EXP_FBX_EMBEDDED, false},
    {EXP_FBX_SHAPE, true},
    {EXP_FBX_GOBO, true},
    {EXP_FBX_ANIMATION, true},
    {EXP_FBX_GLOBAL_SETTINGS, true},
};

} // namespace

FbxIOSettings::FbxIOSettings(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxObject(pManager, pInfo) {
    for (const KnownPath& known : kKnownPaths)
        mValues.emplace(known.path, known.value);
}
FbxIOSettings::~FbxIOSettings() = default;

void FbxIOSettings::SetBoolProp(const char* pName, bool pValue) {
    const auto found = pName ? mValues.find(pName) : mValues.end();
    if (found != mValues.end())
        found->second = pValue;
}

bool FbxIOSettings::GetBoolProp(const char* pName, bool pDefValue) const {
    const auto found = pName ? mValues.find(pName) : mValues.end();
    return found == mValues.end() ? pDefValue : found->second;
}

FBXSDK_NAMESPACE_END
