// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Namespace, export and base types of the platform.
#pragma once

#include <cstddef>
#include <cstdint>

#if defined(FBXSDK_BUILDING)
/// Marks what the shared library exports; on a class, every member function without another mark.
#define FBXSDK_DLL __attribute__((visibility("default")))
/// Marks a private or protected member function of an exported class that the shared library does not export.
#define FBXSDK_LOCAL __attribute__((visibility("hidden")))
#else
/// Marks what the shared library exports; on a class, every member function without another mark.
#define FBXSDK_DLL
/// Marks a private or protected member function of an exported class that the shared library does not export.
#define FBXSDK_LOCAL
#endif

/// The namespace of the API, for sources that write it by this macro.
#define FBXSDK_NAMESPACE fbxsdk

/// \namespace fbxsdk
/// The platform: our own implementation of the documented API, in the inline namespace `tarnell`.

/// The platform's classes are in an inline namespace: the sources read `fbxsdk::FbxNode` as documented, while the
/// symbols never collide with those of another SDK that the same host has loaded.
#define FBXSDK_NAMESPACE_BEGIN                                                                                         \
    namespace fbxsdk {                                                                                                 \
    inline namespace tarnell {
/// Closes what FBXSDK_NAMESPACE_BEGIN opened.
#define FBXSDK_NAMESPACE_END                                                                                           \
    }                                                                                                                  \
    }

FBXSDK_NAMESPACE_BEGIN

using FbxBool = bool;               ///< True or false.
using FbxChar = signed char;        ///< 8 bits with sign.
using FbxUChar = unsigned char;     ///< 8 bits without sign.
using FbxShort = short;             ///< 16 bits with sign.
using FbxUShort = unsigned short;   ///< 16 bits without sign.
using FbxInt = int;                 ///< 32 bits with sign.
using FbxUInt = unsigned int;       ///< 32 bits without sign.
using FbxLongLong = std::int64_t;   ///< 64 bits with sign.
using FbxULongLong = std::uint64_t; ///< 64 bits without sign.
using FbxFloat = float;             ///< Single precision.
using FbxDouble = double;           ///< Double precision.
using FbxEnum = int;                ///< The number of an enumerator.
using FbxReference = void*;         ///< A pointer to anything.

FBXSDK_NAMESPACE_END
