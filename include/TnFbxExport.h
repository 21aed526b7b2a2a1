// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What the shared library exports.
#pragma once

#if defined(TARNELL_FBX_BUILDING)
/// Marks what the shared library exports; on a class, every member function without another mark.
#define TARNELL_FBX_API __attribute__((visibility("default")))
/// Marks a private member function of an exported class that the shared library does not export.
#define TARNELL_FBX_LOCAL __attribute__((visibility("hidden")))
#else
/// Marks what the shared library exports; on a class, every member function without another mark.
#define TARNELL_FBX_API
/// Marks a private member function of an exported class that the shared library does not export.
#define TARNELL_FBX_LOCAL
#endif
