// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Arrays that are encoded on other threads while the records after them are written.
#pragma once

#include <cstdint>
#include <functional>
#include <list>
#include <memory>
#include <string>
#include <vector>

#include "core/Parallel.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A place in the bytes after an array where something about the record is known.
struct RecordMark {
    enum class Kind : std::uint8_t { begin, block, end };
    Kind kind;
    std::uint64_t place;
    std::uint64_t count; ///< begin: the bytes of the record's head; end: its values
};

/// An array and what follows it up to the next one.
struct PendingArray {
    std::string bytes{}; ///< of the array, when it is encoded
    std::string after{};
    std::vector<RecordMark> marks{}; ///< within the bytes after the array, in order
};

/// The arrays of a file that are not encoded yet, or wait for one that is not, in their order. They and their memory
/// belong to the thread that writes the file; other threads see an array's elements, which are a copy, and its bytes.
class PendingArrays {
public:
    /// Returns the bytes of an array. The worker is below `workers()`; each encodes one array at a time.
    using Encode = std::function<std::string(std::size_t worker)>;

    /// Whether there is another thread that encodes arrays. The first call starts them.
    [[nodiscard]] bool hasThreads() { return workers() > 1; }
    [[nodiscard]] std::size_t workers();

    [[nodiscard]] bool isEmpty() const { return mArrays.empty(); }
    /// The array that was added last.
    [[nodiscard]] PendingArray& last() { return mArrays.back(); }
    /// Adds an array of that size in bytes.
    void add(std::size_t size, Encode encode);

    /// Whether the first array must be written before another is added, or can be without waiting.
    [[nodiscard]] bool isFirstDue();
    /// Removes the first array, encoded. Rethrows what its encoding threw.
    [[nodiscard]] PendingArray takeFirst();

private:
    std::list<PendingArray> mArrays;
    std::unique_ptr<WorkQueue> mQueue; ///< the last member: its threads use the arrays
};

} // namespace detail
FBXSDK_NAMESPACE_END
