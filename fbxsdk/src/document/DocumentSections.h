// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The parts of a file that are common to all generations, and the two writers.
#pragma once

#include <span>

#include "container/RecordSink.h"
#include "document/Document.h"
#include "schema/VersionTraits.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

struct WrittenLine;

/// FBXHeaderExtension, and in binary files the file's id, time and creator.
void writeHeader(const Document& document, const VersionTraits& traits, RecordSink& sink);
/// What the header of 7.x files and an object of older ones state about the scene's origin.
void writeSceneInfo(const Document& document, const VersionTraits& traits, RecordSink& sink);

/// One kind of object and how many there are.
struct ObjectCount {
    std::string_view record;
    std::int32_t count = 0;
    const DocumentObject* first = nullptr; ///< null for kinds without an object of their own
};
/// Kinds in order of their first object.
[[nodiscard]] std::vector<ObjectCount> countObjects(const Document& document);

/// A property by its name; null when there is none.
[[nodiscard]] const DocumentProperty* findProperty(std::span<const DocumentProperty> properties, std::string_view name);

/// The name and times of a take, as its first records.
void writeTakeTimes(const DocumentTake& take, RecordSink& sink);

void writeGeneration7(const Document& document, const VersionTraits& traits, RecordSink& sink);
void writeGeneration6(const Document& document, const VersionTraits& traits, RecordSink& sink);

/// The records of an AnimationCurve: packed arrays.
void writeCurve(RecordSink& sink, const VersionTraits& traits, const CurveKeys& curve);

/// The records of a channel of a take: one list of keys. It has no letter for automatic tangents with a bias, a break
/// or a clamp; they must be user tangents by now.
void writeLegacyCurve(RecordSink& sink, const VersionTraits& traits, const CurveKeys& curve, double defaultValue);

/// `Properties70 { P: name, type, subtype, flags, values }`.
void writeProperties70(RecordSink& sink, std::span<const DocumentProperty> properties);
/// The same for an object's lines; nothing when there are none.
void writeLines70(RecordSink& sink, std::span<const WrittenLine> lines);
/// `Property: name, type, flags, values` as lines of `Properties60`.
void writeProperty60(RecordSink& sink, const DocumentProperty& property, std::string_view flags);

} // namespace detail
FBXSDK_NAMESPACE_END
