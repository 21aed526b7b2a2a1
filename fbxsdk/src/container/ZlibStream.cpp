// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The only place that knows the compression library.
#include "container/ZlibStream.h"

#include <memory>

#include <libdeflate.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

/// Geometry is mostly mantissa bits: higher levels take several times as long and save a few hundredths.
constexpr int kCompressionLevel = 3;

} // namespace

bool inflateExactly(std::span<const char> stream, std::span<char> destination) {
    const std::unique_ptr<libdeflate_decompressor, decltype(&libdeflate_free_decompressor)> decompressor(
        libdeflate_alloc_decompressor(), &libdeflate_free_decompressor);
    if (!decompressor) {
        return false;
    }
    // Without a place for the actual size the library insists on the exact one.
    return libdeflate_zlib_decompress(decompressor.get(), stream.data(), stream.size(), destination.data(),
                                      destination.size(), nullptr) == LIBDEFLATE_SUCCESS;
}

std::vector<char> deflated(std::span<const char> bytes) {
    const std::unique_ptr<libdeflate_compressor, decltype(&libdeflate_free_compressor)> compressor(
        libdeflate_alloc_compressor(kCompressionLevel), &libdeflate_free_compressor);
    if (!compressor) {
        return {};
    }
    std::vector<char> stream(bytes.size());
    const std::size_t size =
        libdeflate_zlib_compress(compressor.get(), bytes.data(), bytes.size(), stream.data(), stream.size());
    stream.resize(size < bytes.size() ? size : 0);
    return stream;
}

} // namespace detail
FBXSDK_NAMESPACE_END
