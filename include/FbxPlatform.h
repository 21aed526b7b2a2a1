// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The platform's header, by a path that "FbxSdk.h" cannot be taken for: where file names ignore case, <fbxsdk.h> would
// be found as "FbxSdk.h", since hosts search the library's folder first.
#pragma once

#if __has_include(<fbxsdk/Platform.h>)
#include <fbxsdk/Platform.h>
#else
#include <fbxsdk.h> // an external SDK on the host's own include path
#endif
