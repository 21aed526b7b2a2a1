// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Sets the memory limit for a scope.
#pragma once

#include "TnFbxLimits.h"

#include <cstdint>

namespace support {

class MemoryLimitScope {
public:
    explicit MemoryLimitScope(std::uint64_t bytes) { Tarnell::Fbx::setMemoryLimit(bytes); }
    ~MemoryLimitScope() { Tarnell::Fbx::setMemoryLimit(0); }
    MemoryLimitScope(const MemoryLimitScope&) = delete;
    MemoryLimitScope& operator=(const MemoryLimitScope&) = delete;
};

} // namespace support
