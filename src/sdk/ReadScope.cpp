// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "ReadScope.h"

#include "SampleAccount.h"
#include "access/ObjectWarnings.h"
#include "calls/LastError.h"
#include "calls/MemoryLimit.h"
#include "model/MeshInstances.h"

#include <utility>

namespace Tarnell::Fbx {

using detail::ReadScope;

ReadScope::ReadScope(FbxSdk& sdk) : mSdk(sdk), mIsOutermost(!std::exchange(sdk.mIsReading, true)) {
    if (mIsOutermost) {
        sdk.mMemory->begin();
        sdk.mSamples->begin();
        sdk.mWarnings->forget();
    }
}

ReadScope::~ReadScope() {
    if (mIsOutermost) {
        mSdk.mIsReading = false;
        mSdk.mMemory->end();
        mSdk.mInstances->forget();
    }
}

bool ReadScope::finish(bool result) const {
    if (mIsOutermost)
        mSdk.mWarnings->report();
    if (!mIsOutermost || !result || !mSdk.mMemory->exceeded())
        return result;
    const std::string file = mSdk.mFileName.empty() ? "" : mSdk.mFileName + ": ";
    return fail(file + mSdk.mSamples->describe() + mSdk.mMemory->describe());
}

} // namespace Tarnell::Fbx
