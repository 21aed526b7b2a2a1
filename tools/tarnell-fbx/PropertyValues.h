// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The value of a property of any type.
#pragma once

#include <string>

#include <fbxsdk.h>

#include "JsonWriter.h"

namespace tool {

/// How a file spells the type: "Lcl Translation", "KString", "enum".
std::string typeName(const FbxProperty& property);

/// The letters of a file's flags: A animatable, + animated, U user-defined, H hidden.
std::string flagLetters(const FbxProperty& property);

/// The value on one line: "1, 2, 3", "true", "\"text\"", "0.5 s"; empty where a property has none (a compound).
std::string valueText(const FbxProperty& property);

/// The value: a number, true or false, a text, an array of numbers, a time in seconds, or null.
void printValue(const FbxProperty& property, JsonWriter& json);

/// How many numbers the property holds; 0 when it holds none.
int componentCount(const FbxProperty& property);

} // namespace tool
