// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What makes a class part of the shared library's interface.
#pragma once

#if defined(TARNELL_FBX_BUILDING)
#define TARNELL_FBX_API __attribute__((visibility("default")))
#else
#define TARNELL_FBX_API
#endif
