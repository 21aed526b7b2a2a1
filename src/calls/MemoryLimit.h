// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What one call hands out, held against `memoryLimit()`.
#pragma once

#include <cstdint>
#include <string>

namespace Tarnell::Fbx::detail {

/// Counts the bytes of the objects that a call hands out. Once they go beyond the limit nothing more is granted, but
/// the rest is still counted, so that the failure can say what would have been needed.
class MemoryAccount {
public:
    /// Counts anew, against the limit in force now.
    void begin();
    /// From here on nothing is limited.
    void end() { *this = {}; }
    /// False when the bytes counted so far, these included, are more than the limit.
    bool take(std::uint64_t bytes);
    /// Of bytes that were granted and turned out not to be needed.
    void giveBack(std::uint64_t bytes) { mNeeded -= bytes; }
    std::uint64_t limit() const { return mLimit; }
    bool exceeded() const { return mNeeded > mLimit; }
    /// "12.3 GiB of samples and points would be needed, and the limit is 8.0 GiB".
    std::string describe(const char* what = "samples and points") const;

private:
    std::uint64_t mNeeded = 0;
    std::uint64_t mLimit = UINT64_MAX; // outside of a call: none
};

/// A number of bytes for people: "512 bytes", "3.4 MiB".
std::string describeBytes(std::uint64_t bytes);

} // namespace Tarnell::Fbx::detail
