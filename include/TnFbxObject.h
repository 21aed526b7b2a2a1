// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The root of every scene object: its name, and a virtual destructor so that hosts can own objects through it.
#pragma once

#include "TnFbxExport.h"

#include <string>

namespace Tarnell::Fbx {

/// A named scene object. Nothing but its destruction is virtual.
class TARNELL_FBX_API TnFbxObject {
public:
    TnFbxObject();
    TnFbxObject(const TnFbxObject& other) = default;
    virtual ~TnFbxObject();
    TnFbxObject& operator=(const TnFbxObject& other);

    /// Both empty the name; always true.
    bool initObject();
    bool deleteObject();

    bool setName(const std::string& name);
    const std::string& getName() const; ///< Valid as long as the object is and its name does not change.

private:
    std::string mName;
};

} // namespace Tarnell::Fbx
