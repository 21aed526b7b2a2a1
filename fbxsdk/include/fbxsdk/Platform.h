// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The same as <fbxsdk.h>, for code with a header of a similar name of its own.
#pragma once

#include "../fbxsdk.h"
