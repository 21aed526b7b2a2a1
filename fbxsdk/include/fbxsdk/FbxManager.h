// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <memory>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

class FbxIOPluginRegistry;
class FbxIOSettings;

namespace detail {
class ManagerData;
}

/// The owner of every object.
///
/// Any number of managers may exist at once; they share nothing. A manager and its objects are used by one thread at
/// a time. Only Destroy ends it; FbxManager is never deleted directly.
class FBXSDK_DLL FbxManager {
public:
    /// A new manager without objects. Never null: when memory runs out std::bad_alloc is thrown.
    static FbxManager* Create();
    FbxManager(const FbxManager&) = delete;            ///< Managers are not copied.
    FbxManager& operator=(const FbxManager&) = delete; ///< Managers are not assigned.

    /// Destroys every object of the manager, whatever state it is in, then the manager. All pointers to them are
    /// invalid afterwards.
    virtual void Destroy();

    /// The list of formats; never null, valid as long as the manager.
    [[nodiscard]] FbxIOPluginRegistry* GetIOPluginRegistry() const;
    /// Null until set. The caller owns the settings; once they are destroyed the result is null again.
    [[nodiscard]] virtual FbxIOSettings* GetIOSettings() const;
    /// Stores the pointer for GetIOSettings. Reading and writing ignore the settings.
    virtual void SetIOSettings(FbxIOSettings* pIOSettings);
    /// The name and version of this platform; the same in both forms.
    static const char* GetVersion(bool pFull = true);

    /// The platform's own view of the manager.
    [[nodiscard]] detail::ManagerData& data() const { return *mData; }

protected:
    FBXSDK_LOCAL FbxManager();          ///< For Create.
    FBXSDK_LOCAL virtual ~FbxManager(); ///< For Destroy.

private:
    std::unique_ptr<detail::ManagerData> mData;
};

FBXSDK_NAMESPACE_END
