// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxIOSettings.h>

#include <cstddef>
#include <cstring>
#include <iterator>

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

/// The bit of a path; 0 for an unknown one.
std::uint32_t bitOf(const char* name) {
    for (std::size_t i = 0; name && i < std::size(kKnownPaths); ++i)
        if (std::strcmp(name, kKnownPaths[i].path) == 0)
            return std::uint32_t{1} << i;
    return 0;
}

constexpr std::uint32_t kDefaults = [] {
    static_assert(std::size(kKnownPaths) <= 32);
    std::uint32_t bits = 0;
    for (std::size_t i = 0; i < std::size(kKnownPaths); ++i)
        bits |= std::uint32_t{kKnownPaths[i].value} << i;
    return bits;
}();

} // namespace

FbxIOSettings::FbxIOSettings(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxObject(pManager, pInfo), mValues(kDefaults) {}
FbxIOSettings::~FbxIOSettings() = default;

void FbxIOSettings::SetBoolProp(const char* pName, bool pValue) {
    const std::uint32_t bit = bitOf(pName);
    mValues = pValue ? mValues | bit : mValues & ~bit;
}

bool FbxIOSettings::GetBoolProp(const char* pName, bool pDefValue) const {
    const std::uint32_t bit = bitOf(pName);
    return bit == 0 ? pDefValue : (mValues & bit) != 0;
}

FBXSDK_NAMESPACE_END
