// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "SampleAccount.h"

#include <array>
#include <cstdio>

namespace Tarnell::Fbx {

std::string detail::SampleAccount::describe() const {
    if (mFrames.first > mFrames.last)
        return {};
    std::array<char, 96> text{};
    std::snprintf(text.data(), text.size(), "frames %d to %d at %g frames per second: ", mFrames.first, mFrames.last,
                  static_cast<double>(mRate));
    return text.data();
}

} // namespace Tarnell::Fbx
