// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Which target shape a blend-shape channel applies.
#pragma once

#include <optional>

namespace Tarnell::Fbx::detail {

/// The target that step `step` of a channel selects at a weight, by the full weights of the channel's targets; none
/// when the weight is between none of them.
///
/// kept: every step on its own may select the first target, so below the first full weight a channel of k targets
/// applies it k times; and a weight that equals a full weight selects nothing. The last step has no weight to compare
/// with above its own.
inline std::optional<int> targetOfStep(int step, double weight, const double* fullWeights, int targetCount) {
    if (step + 1 < targetCount && fullWeights[step] < weight && weight < fullWeights[step + 1])
        return step + 1;
    if (weight > 0.0 && weight < fullWeights[0])
        return 0;
    return std::nullopt;
}

} // namespace Tarnell::Fbx::detail
