// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The root of every scene object: its name, and a virtual destructor so that hosts can own objects through it.
#pragma once

#include "TnFbxExport.h"

#include <string>

namespace Tarnell::Fbx {

/// A named scene object. Only the destructor is virtual.
class TARNELL_FBX_API TnFbxObject {
public:
    /// An empty name.
    TnFbxObject();
    TnFbxObject(const TnFbxObject& other) = default;
    virtual ~TnFbxObject();
    /// Copies the name.
    TnFbxObject& operator=(const TnFbxObject& other);

    /// Empties the name; always true.
    /// @{
    bool initObject();
    bool deleteObject();
    /// @}

    /// Any UTF-8 text; names need not be unique within a file. Always true.
    bool setName(const std::string& name);
    const std::string& getName() const; ///< UTF-8. The reference is valid for the life of the object.

private:
    std::string mName;
};

} // namespace Tarnell::Fbx
