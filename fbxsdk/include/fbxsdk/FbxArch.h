// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Namespace, export and base types of the platform.
#pragma once

#include <cstddef>
#include <cstdint>

#if defined(FBXSDK_BUILDING)
#define FBXSDK_DLL __attribute__((visibility("default")))
#else
#define FBXSDK_DLL
#endif

#define FBXSDK_NAMESPACE fbxsdk

/// The platform's classes stand in an inline namespace: the sources read `fbxsdk::FbxNode` as documented, while the
/// symbols can never mix with those of another SDK that the same host has loaded.
#define FBXSDK_NAMESPACE_BEGIN                                                                                         \
    namespace fbxsdk {                                                                                                 \
    inline namespace tarnell {
#define FBXSDK_NAMESPACE_END                                                                                           \
    }                                                                                                                  \
    }

FBXSDK_NAMESPACE_BEGIN

using FbxBool = bool;
using FbxChar = signed char;
using FbxUChar = unsigned char;
using FbxShort = short;
using FbxUShort = unsigned short;
using FbxInt = int;
using FbxUInt = unsigned int;
using FbxLongLong = std::int64_t;
using FbxULongLong = std::uint64_t;
using FbxFloat = float;
using FbxDouble = double;
using FbxEnum = int;
using FbxReference = void*;

FBXSDK_NAMESPACE_END
