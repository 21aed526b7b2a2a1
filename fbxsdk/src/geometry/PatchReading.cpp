// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Records of patches.
#include "geometry/GeometryReading.h"

#include <algorithm>
#include <string_view>

#include <fbxsdk/FbxPatch.h>

#include "geometry/NurbsNumbers.h"
#include "schema/Spellings.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// By name or by number; anything else is a Bezier patch.
FbxPatch::EType typeOf(const Value& value) {
    const int stated = static_cast<int>(std::clamp<std::int64_t>(value.toInteger(-1), -1, kPatchTypes.size()));
    const std::string_view spelling =
        value.isNumber() ? spellingOf(kPatchTypes, stated, FbxPatch::eBezier) : value.toText();
    return static_cast<FbxPatch::EType>(numberOf(kPatchTypes, spelling, FbxPatch::eBezier));
}

bool flag(const Record* record, std::size_t index) { return integerAt(record, index, 0) != 0; }

bool readDirection(FbxPatch::Direction& direction, const Record& body, std::size_t index) {
    const std::int64_t count = integerAt(body.child("Dimensions"), index, 0);
    if (count < 1 || count > kMostPoints)
        return false;
    direction.count = static_cast<int>(count);
    direction.step = stepOf(integerAt(body.child("Step"), index, kUsualStep));
    if (const Record* type = body.child("PatchType"))
        direction.type = typeOf(type->value(index));
    direction.closed = flag(body.child("Closed"), index);
    const Record* capped = body.child(index == 0 ? "UCapped" : "VCapped");
    direction.cappedBottom = flag(capped, 0);
    direction.cappedTop = flag(capped, 1);
    return true;
}

} // namespace

void readPatch(FbxPatch& patch, const Record& body) {
    FbxPatch::Direction u, v;
    if (!readDirection(u, body, 0) || !readDirection(v, body, 1))
        return;
    const std::int64_t count = std::int64_t{u.count} * v.count;
    // Writers differ in whether points have a fourth number.
    if (!readPoints(patch.points(), body, count, 4) && !readPoints(patch.points(), body, count, 3))
        return;
    patch.parameters(0) = u;
    patch.parameters(1) = v;
}

} // namespace detail
FBXSDK_NAMESPACE_END
