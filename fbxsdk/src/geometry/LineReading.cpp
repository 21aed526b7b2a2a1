// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Records of polylines.
#include "geometry/GeometryReading.h"

#include <algorithm>

#include <fbxsdk/FbxLine.h>

#include "geometry/ItemReading.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

void readIndices(PlainArray<int>& indices, const Record& body, int points) {
    const Record* record = body.child("PointsIndex");
    if (!record || points == 0 || !readItems(*record, indices))
        return;
    for (int& index : indices) {
        const bool ends = index < 0;
        if ((ends ? ~index : index) >= points)
            index = ends ? ~0 : 0;
    }
}

} // namespace

void readLine(FbxLine& line, const Record& body) {
    line.indices().clear();
    const Record* points = body.child("Points");
    if (points && readItems(*points, line.points()))
        readIndices(line.indices(), body, line.points().count());
}

} // namespace detail
FBXSDK_NAMESPACE_END
