// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Stored arrays are decoded to numbers here, on access.
#pragma once

#include <cstdint>
#include <memory>
#include <span>

#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Bytes of one element; 1 for `text`.
[[nodiscard]] std::size_t elementSize(StoredArray::Element element);

/// Decodes the first destination.size() elements, which the array must have.
///
/// An array is inflated straight into the destination, and widened or swapped there; only narrowing and partial reads
/// go through a temporary of the array's size. False when the array is corrupt; the destination is then undefined.
/// Throws FileFault where the file cannot be read any more, and std::bad_alloc.
/// std::uint32_t requests the bits of 32-bit floats.
template <class Number>
[[nodiscard]] bool decodeArray(const StoredArray& array, std::span<Number> destination);

/// The payload is at the array's address, read from the file if necessary. `memory` keeps it.
[[nodiscard]] std::span<const char> payloadOf(const StoredArray& array, std::unique_ptr<char[]>& memory);

extern template bool decodeArray(const StoredArray&, std::span<double>);
extern template bool decodeArray(const StoredArray&, std::span<float>);
extern template bool decodeArray(const StoredArray&, std::span<std::int32_t>);
extern template bool decodeArray(const StoredArray&, std::span<std::int64_t>);
extern template bool decodeArray(const StoredArray&, std::span<std::uint32_t>);

} // namespace detail
FBXSDK_NAMESPACE_END
