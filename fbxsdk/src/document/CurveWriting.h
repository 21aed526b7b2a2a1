// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Keys of curves as files hold them.
#pragma once

#include "container/RecordSink.h"
#include "document/Document.h"
#include "schema/VersionTraits.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The records of an AnimationCurve: packed arrays.
void writeCurve(RecordSink& sink, const VersionTraits& traits, const CurveKeys& curve);

/// The records of a channel of a take: one list of keys. Automatic tangents with a bias, a break or a clamp have no
/// letter in it; they must be user tangents by now.
void writeLegacyCurve(RecordSink& sink, const VersionTraits& traits, const CurveKeys& curve, double defaultValue);

} // namespace detail
FBXSDK_NAMESPACE_END
