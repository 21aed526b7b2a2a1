// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How a file stores each value of a record, one letter each. The record tree converts numbers into each other, so the
// letters come from the bytes themselves.
#pragma once

#include "container/Record.h"

#include <string>

namespace conformance {

/// The type letters of a binary file (`I` a whole number of 32 bits, `D` a double, `d` an array of doubles, …), where
/// `N` is a text that names an object with its class. ASCII files do not tell numbers apart; there it is `n` for a
/// number, `S` or `N` for text and `C` for a word.
std::string valueCodes(const fbxsdk::detail::RecordTree& tree, const fbxsdk::detail::Record& record);

} // namespace conformance
