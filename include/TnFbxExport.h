// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What the shared library exports.
#pragma once

/// Marks a class or function that the shared library exports. Of a class these are all member functions that
/// are not marked otherwise.
#if defined(TARNELL_FBX_BUILDING)
#define TARNELL_FBX_API __attribute__((visibility("default")))
#else
#define TARNELL_FBX_API
#endif

/// Marks a private member function of an exported class: it is not exported.
#define TARNELL_FBX_LOCAL __attribute__((visibility("hidden")))
