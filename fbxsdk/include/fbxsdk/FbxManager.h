// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The manager: owner of every object.
#pragma once

#include <memory>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

class FbxIOPluginRegistry;
class FbxIOSettings;

namespace detail {
class ManagerData;
}

/// Any number of managers may exist at once; they share nothing. One manager and its objects are used by one thread at
/// a time.
class FBXSDK_DLL FbxManager {
public:
    static FbxManager* Create();
    FbxManager(const FbxManager&) = delete;
    FbxManager& operator=(const FbxManager&) = delete;

    /// Destroys every object of the manager, then the manager.
    virtual void Destroy();

    [[nodiscard]] FbxIOPluginRegistry* GetIOPluginRegistry() const;
    /// Null until set. The settings stay the caller's.
    [[nodiscard]] virtual FbxIOSettings* GetIOSettings() const;
    virtual void SetIOSettings(FbxIOSettings* pIOSettings);
    static const char* GetVersion(bool pFull = true);

    /// The platform's own view of the manager.
    [[nodiscard]] detail::ManagerData& data() const { return *mData; }

protected:
    FbxManager();
    virtual ~FbxManager();

private:
    std::unique_ptr<detail::ManagerData> mData;
};

FBXSDK_NAMESPACE_END
