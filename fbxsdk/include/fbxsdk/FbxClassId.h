// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

namespace detail {
struct ClassInfo;
}

/// The identity of a class of objects. Cheap to copy; compares by identity.
class FBXSDK_DLL FbxClassId {
public:
    constexpr FbxClassId() = default;                                               ///< The invalid id.
    explicit constexpr FbxClassId(const detail::ClassInfo* pInfo) : mInfo(pInfo) {} ///< The platform's own.

    /// True for the same class and when this class derives from the other; false when either is invalid.
    [[nodiscard]] bool Is(const FbxClassId& pId) const;
    /// "FbxNode", "FbxCamera", …; empty for an invalid id.
    [[nodiscard]] const char* GetName() const;
    [[nodiscard]] bool IsValid() const { return mInfo != nullptr; } ///< Whether it is the id of a class.
    [[nodiscard]] FbxClassId GetParent() const; ///< The class it derives from; invalid for FbxObject.

    /// Whether both are the same class.
    bool operator==(const FbxClassId& pOther) const { return mInfo == pOther.mInfo; }
    bool operator!=(const FbxClassId& pOther) const { return mInfo != pOther.mInfo; } ///< The opposite.

    [[nodiscard]] const detail::ClassInfo* info() const { return mInfo; } ///< The platform's own view of the class.

private:
    const detail::ClassInfo* mInfo = nullptr;
};

FBXSDK_NAMESPACE_END
