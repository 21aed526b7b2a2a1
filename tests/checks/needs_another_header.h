// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A header that does not compile alone: the header check must refuse it.
#pragma once

inline std::string name() { return "no <string> here"; }
