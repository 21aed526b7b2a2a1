// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Settings that older files keep in records of their own: light, fog, frame rate, default camera.
#pragma once

#include "document/DocumentBuilder.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// What stands in Version5 of a 6.x file and at the top level of older ones. Only fills what is not said yet.
void readLegacySettings(DocumentBuilder& builder, const Record& parent);

} // namespace detail
FBXSDK_NAMESPACE_END
