// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The same as <fbxsdk.h>, for code that has a header of nearly that name itself.
#pragma once

#include "../fbxsdk.h"
