// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Curves of files before 7.x: a channel record with one flat list of keys.
#pragma once

#include <optional>

#include "document/DocumentBuilder.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The curve of a channel, its values multiplied; none when it has no keys or its key list is inconsistent (then with a
/// warning).
[[nodiscard]] std::optional<CurveKeys> readLegacyCurve(DocumentBuilder& builder, const Record& channel, double scale);

/// Reads the extrapolation block of that name; constant when there is none.
[[nodiscard]] Extrapolation readExtrapolation(const Record& owner, std::string_view name);

/// Sorts the keys by time; of keys at the same time the last one is kept.
void sortKeys(CurveKeys& curve);

} // namespace detail
FBXSDK_NAMESPACE_END
