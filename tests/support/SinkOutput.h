// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The bytes that a function writes into a sink, of either kind.
#pragma once

#include <cstdint>
#include <functional>
#include <string>

#include "container/AsciiSink.h"
#include "container/BinarySink.h"

namespace support {

enum class Container { binary, ascii };

using Emit = std::function<void(fbxsdk::detail::RecordSink&)>;

inline constexpr fbxsdk::detail::CreationTime kSampleTime{2020, 3, 31, 21, 34, 23, 150};

[[nodiscard]] inline std::string sinkBytes(Container container, std::uint32_t version, const Emit& emit) {
    fbxsdk::detail::MemoryOutput output;
    if (container == Container::binary) {
        fbxsdk::detail::BinarySink sink(output, version);
        emit(sink);
        sink.finish(kSampleTime);
    } else {
        fbxsdk::detail::AsciiSink sink(output, version);
        emit(sink);
        sink.finish();
    }
    return output.bytes();
}

} // namespace support
