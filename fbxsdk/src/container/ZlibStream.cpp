// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The only place that knows the compression library.
#include "container/ZlibStream.h"

#include <memory>

#include <libdeflate.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

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

} // namespace detail
FBXSDK_NAMESPACE_END
