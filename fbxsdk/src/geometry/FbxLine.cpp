// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Polylines.
#include <fbxsdk/FbxLine.h>

#include <algorithm>

#include "geometry/GeometrySource.h"
#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxLine, FbxGeometry, detail::kLineRows)

FbxLine::FbxLine(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxGeometry(pManager, pInfo), Renderable(detail::bindProperty<FbxBool>(*this, "Renderable")) {}

FbxLine::~FbxLine() = default;

FbxNodeAttribute::EType FbxLine::GetAttributeType() const { return eLine; }

void FbxLine::SetIndexArraySize(int pCount) {
    detachSource();
    mIndices.resize(std::max(pCount, 0), 0);
}

int FbxLine::GetIndexArraySize() const {
    ensureLoaded();
    return mIndices.count();
}

bool FbxLine::SetPointIndexAt(int pValue, int pIndex, bool pAsEndPoint) {
    detachSource();
    if (!mIndices.contains(pIndex) || pValue < 0)
        return false;
    mIndices[pIndex] = pAsEndPoint ? ~pValue : pValue;
    return true;
}

int FbxLine::GetPointIndexAt(int pIndex) const {
    ensureLoaded();
    if (!mIndices.contains(pIndex))
        return -1;
    return mIndices[pIndex] < 0 ? ~mIndices[pIndex] : mIndices[pIndex];
}

int FbxLine::GetEndPointCount() const {
    ensureLoaded();
    return static_cast<int>(std::count_if(mIndices.begin(), mIndices.end(), [](int index) { return index < 0; }));
}

int FbxLine::GetEndPointAt(int pEndPointIndex) const {
    ensureLoaded();
    int ends = 0;
    for (int place = 0; place < mIndices.count(); ++place)
        if (mIndices[place] < 0 && ends++ == pEndPointIndex)
            return place;
    return -1;
}

FBXSDK_NAMESPACE_END
