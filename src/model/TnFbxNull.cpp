// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The null: a size and a look.
#include "TnFbxNull.h"

namespace Tarnell::Fbx {

TnFbxNull::TnFbxNull() { initNull(); }

TnFbxNull::~TnFbxNull() = default;

// kept: nothing of the transform is copied, nor the name
TnFbxNull& TnFbxNull::operator=(const TnFbxNull& other) {
    if (this != &other)
        mProperties = other.mProperties;
    return *this;
}

bool TnFbxNull::initNull() {
    mProperties = Properties();
    return true;
}

bool TnFbxNull::deleteNull() { return initNull(); }

bool TnFbxNull::setNullSize(float size) {
    mProperties.size = size;
    return true;
}

float TnFbxNull::getNullSize() const { return mProperties.size; }

bool TnFbxNull::setNullLookType(EFbxNullLookType lookType) {
    mProperties.lookType = lookType;
    return true;
}

TnFbxNull::EFbxNullLookType TnFbxNull::getNullLookType() const { return mProperties.lookType; }

} // namespace Tarnell::Fbx
