// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The channel operations of transforms, cameras, lights and markers, written once over a table of each kind's
// channels: their enumerators, names and defaults.
#pragma once

#include "TnFbxChannel.h"
#include "TnFbxTime.h"

#include <array>
#include <cstddef>
#include <iterator>
#include <type_traits>
#include <utility>
#include <vector>

namespace Tarnell::Fbx::detail {

/// One channel of one kind of object.
template <typename Enumeration>
struct ChannelRow {
    Enumeration channel;
    const char* name;
    float defaultValue;
};

/// A channel as an index. Negative numbers become large ones, so one comparison checks both ends.
template <typename Enumeration>
constexpr std::size_t indexOf(Enumeration channel) {
    return static_cast<unsigned int>(channel);
}

/// True when row i of a table is the row of enumerator i.
template <typename Enumeration, std::size_t kCount>
constexpr bool inEnumeratorOrder(const ChannelRow<Enumeration> (&rows)[kCount]) {
    for (std::size_t i = 0; i < kCount; ++i)
        if (indexOf(rows[i].channel) != i)
            return false;
    return true;
}

/// The channel operations of the kind of object that `kRows` describes.
///
/// Every one but `init` and `clear` takes a channel that may be out of range and then does nothing and returns false,
/// null, 0 or a default time record.
template <const auto& kRows>
struct ChannelSet {
    static constexpr std::size_t kCount = std::size(kRows);
    using Channel = std::remove_const_t<decltype(kRows[0].channel)>;
    using Array = std::array<TnFbxChannel, kCount>;

    static_assert(inEnumeratorOrder(kRows));

    /// Every channel at its default.
    static void init(Array& channels) {
        for (std::size_t i = 0; i < kCount; ++i)
            channels[i].initChannel(kRows[i].defaultValue);
    }

    /// The same for channels as their constructor leaves them.
    static void initNew(Array& channels) {
        for (std::size_t i = 0; i < kCount; ++i)
            if (kRows[i].defaultValue != TnFbxChannel::kDefaultChannelValue)
                channels[i].setValue(kRows[i].defaultValue);
    }

    // kept: 0 for every channel, whatever its default
    static void clear(Array& channels) {
        for (TnFbxChannel& channel : channels)
            channel.deleteChannel();
    }

    static TnFbxChannel* find(Array& channels, Channel channel) {
        return indexOf(channel) < kCount ? &channels[indexOf(channel)] : nullptr;
    }

    static const TnFbxChannel* find(const Array& channels, Channel channel) {
        return indexOf(channel) < kCount ? &channels[indexOf(channel)] : nullptr;
    }

    static const char* name(Channel channel) {
        return indexOf(channel) < kCount ? kRows[indexOf(channel)].name : nullptr;
    }

    static bool setValue(Array& channels, Channel channel, float value) {
        TnFbxChannel* found = find(channels, channel);
        return found != nullptr && found->setValue(value);
    }

    static bool setValues(Array& channels, Channel channel, const TnFbxTime& time, const std::vector<float>& values) {
        TnFbxChannel* found = find(channels, channel);
        return found != nullptr && found->setAnimatedValues(time, values);
    }

    static bool moveValues(Array& channels, Channel channel, const TnFbxTime& time, std::vector<float>&& values) {
        TnFbxChannel* found = find(channels, channel);
        return found != nullptr && found->moveAnimatedValues(time, std::move(values));
    }

    static float value(const Array& channels, Channel channel) {
        const TnFbxChannel* found = find(channels, channel);
        return found != nullptr ? found->getValue() : TnFbxChannel::kDefaultChannelValue;
    }

    static float valueAt(const Array& channels, Channel channel, float frame) {
        const TnFbxChannel* found = find(channels, channel);
        return found != nullptr ? found->getAnimatedValue(frame) : TnFbxChannel::kDefaultChannelValue;
    }

    static bool animated(const Array& channels, Channel channel) {
        const TnFbxChannel* found = find(channels, channel);
        return found != nullptr && found->getAnimated();
    }

    static TnFbxTime time(const Array& channels, Channel channel) {
        const TnFbxChannel* found = find(channels, channel);
        return found != nullptr ? found->getTime() : TnFbxTime();
    }
};

} // namespace Tarnell::Fbx::detail
