// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The allocation functions of C in an executable that fail where a test chooses, for all libraries in it: those written
// in C++ allocate through them, too, and so do those that inflate and parse.
#pragma once

namespace faults {

/// How many allocations all threads have made since the last call of this or of `failAllocation`.
[[nodiscard]] long countAllocations();
/// The allocation of that number, counted from 0, fails, and with `andAllBehind` every later one.
void failAllocation(long number, bool andAllBehind);
void failNoAllocation();

} // namespace faults
