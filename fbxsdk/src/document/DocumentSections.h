// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The parts of a file that are alike in all generations, and the two writers.
#pragma once

#include "container/RecordSink.h"
#include "document/Document.h"
#include "schema/VersionTraits.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// FBXHeaderExtension, and in binary files the file's id, time and creator.
void writeHeader(const Document& document, const VersionTraits& traits, RecordSink& sink);
/// What the header of 7.x files and an object of older ones hold about the scene's origin.
void writeSceneInfo(const Document& document, const VersionTraits& traits, RecordSink& sink);

/// One kind of object and how many there are.
struct ObjectCount {
    std::string_view record;
    std::int32_t count = 0;
    const DocumentObject* first = nullptr; ///< null for what is no object of its own
};
/// Kinds in order of their first object.
[[nodiscard]] std::vector<ObjectCount> countObjects(const Document& document);

/// A property by its name; null when there is none.
[[nodiscard]] const DocumentProperty* findProperty(std::span<const DocumentProperty> properties, std::string_view name);

/// The name and times of a take, as its first records.
void writeTakeTimes(const DocumentTake& take, RecordSink& sink);

void writeGeneration7(const Document& document, const VersionTraits& traits, RecordSink& sink);
void writeGeneration6(const Document& document, const VersionTraits& traits, RecordSink& sink);

} // namespace detail
FBXSDK_NAMESPACE_END
