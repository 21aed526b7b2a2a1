// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// One reading call of the host, checked against `memoryLimit()`.
#pragma once

#include "FbxSdk.h"

namespace Tarnell::Fbx::detail {

/// Reading calls call each other; the outermost one counts the results of all of them.
class ReadScope {
public:
    explicit ReadScope(FbxSdk& sdk);
    ~ReadScope();
    ReadScope(const ReadScope&) = delete;
    ReadScope& operator=(const ReadScope&) = delete;

    /// The result of the call: false, with the reason, when it would be true but something was not returned.
    bool finish(bool result) const;

private:
    FbxSdk& mSdk;
    bool mIsOutermost;
};

} // namespace Tarnell::Fbx::detail
