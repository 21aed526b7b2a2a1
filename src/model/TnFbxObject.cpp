// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "TnFbxObject.h"

namespace Tarnell::Fbx {

TnFbxObject::TnFbxObject() = default;

TnFbxObject::~TnFbxObject() = default;

TnFbxObject& TnFbxObject::operator=(const TnFbxObject& other) {
    if (this != &other)
        mName = other.mName;
    return *this;
}

bool TnFbxObject::initObject() {
    mName.clear();
    return true;
}

bool TnFbxObject::deleteObject() { return initObject(); }

bool TnFbxObject::setName(const std::string& name) {
    mName = name;
    return true;
}

const std::string& TnFbxObject::getName() const { return mName; }

} // namespace Tarnell::Fbx
