// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Takes of files before 7.x become animation stacks, layers, curve nodes and curves.
#pragma once

#include "document/legacy/LegacyObjects.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// One component of a channel: the property it becomes on the curve node, and the record with its default and keys.
struct ChannelComponent {
    std::string_view label; ///< "d|X", …, or "d|" and the property's name
    std::size_t axis = 0;   ///< which of the property's values it is
    const Record* record = nullptr;
};

/// A channel and its target.
struct LegacyChannel {
    std::int64_t owner = 0;
    std::string_view property; ///< in the spelling of 7.x
    std::string_view nodeName; ///< "T", "R", "S" or the property's name
    double scale = 1;          ///< factor from the file's unit to that of 7.x: percents of old visibilities
    std::vector<ChannelComponent> components;
};

/// All channels of an object's record, of the record itself or of a take's record for it.
[[nodiscard]] std::vector<LegacyChannel> readChannels(LegacyObjects& objects, std::int64_t object,
                                                      const Record& record);
/// The static value of a component.
[[nodiscard]] double componentDefault(const LegacyChannel& channel, const ChannelComponent& component);

/// Reads all takes below the top-level record.
void readTakes(LegacyObjects& objects);

} // namespace detail
FBXSDK_NAMESPACE_END
