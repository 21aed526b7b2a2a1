// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The memory of one call's results, checked against `memoryLimit()`.
#pragma once

#include <cstdint>
#include <string>

namespace Tarnell::Fbx::detail {

/// Counts the bytes of the objects that a call returns. Once they exceed the limit nothing more is granted, but
/// the rest is still counted, so that the failure can state how much would have been needed.
class MemoryAccount {
public:
    /// Restarts the count, against the limit at this time.
    void begin();
    /// Removes the limit from here on.
    void end() { *this = {}; }
    /// False when the bytes counted so far, these included, are more than the limit.
    bool take(std::uint64_t bytes);
    /// Returns bytes that were granted and are not needed.
    void giveBack(std::uint64_t bytes) { mNeeded -= bytes; }
    std::uint64_t limit() const { return mLimit; }
    bool exceeded() const { return mNeeded > mLimit; }
    /// "12.3 GiB of samples and points would be needed; the limit is 8.0 GiB".
    std::string describe(const char* what = "samples and points") const;

private:
    std::uint64_t mNeeded = 0;
    std::uint64_t mLimit = UINT64_MAX; // outside of a call: none
};

/// A number of bytes for display: "512 bytes", "3.4 MiB".
std::string describeBytes(std::uint64_t bytes);

} // namespace Tarnell::Fbx::detail
