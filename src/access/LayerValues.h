// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The values of a layer element, corner by corner, without allocating.
#pragma once

#include "ItemReader.h"

#include <fbxsdk.h>

#include <optional>

namespace Tarnell::Fbx::detail {

/// One vertex of one polygon.
struct Corner {
    int polygon;
    int polygonVertex; // in the mesh
    int controlPoint;  // −1 or any number in a damaged file
};

struct Colour {
    float red, green, blue, alpha;
};

/// The values of a layer element by index, according to its reference mode. They are read one by one, so that values in
/// a file need not be in memory all at once.
template <class Value>
class ElementValues {
public:
    /// No values.
    ElementValues() = default;

    /// Throws std::runtime_error when the element has no direct array.
    explicit ElementValues(const fbxsdk::FbxLayerElementTemplate<Value>& element) {
        switch (element.GetReferenceMode()) {
        case fbxsdk::FbxLayerElement::eDirect:
            mDirect = ItemReader<Value>(element.GetDirectArray());
            break;
        case fbxsdk::FbxLayerElement::eIndexToDirect:
            mDirect = ItemReader<Value>(element.GetDirectArray());
            mIndex = ItemReader<int>(element.GetIndexArray());
            break;
        default: // an index alone refers to nothing
            break;
        }
    }

    /// Values that are indices where the element has indices only.
    static ElementValues numbered(const fbxsdk::FbxLayerElementTemplate<Value>& element) {
        ElementValues values;
        values.mDirect = ItemReader<Value>(element.GetDirectArray());
        if (element.GetReferenceMode() != fbxsdk::FbxLayerElement::eDirect)
            values.mIndex = ItemReader<int>(element.GetIndexArray());
        return values;
    }

    /// Whether they have no index and there are at least that many, so that they can be read in order.
    bool areInOrder(int count) const { return !mIndex.hasArray() && mDirect.hasArray() && mDirect.count() >= count; }
    /// Calls `use(i, value)` for consecutive values that are in order, i from 0 on.
    template <class Use>
    void forEach(int first, int count, const Use& use) const {
        mDirect.forEach(first, count, use);
    }

    /// Whether they have at least that many indices.
    bool areIndexed(int count) const { return mDirect.hasArray() && mIndex.hasArray() && mIndex.count() >= count; }
    /// Calls `use(i, value)` for consecutive values that are indexed, i from 0 on; with null where there is none.
    template <class Use>
    void forEachIndexed(int first, int count, const Use& use) const {
        mIndex.forEach(
            first, count,
            [&](int i, int index) {
                Value value;
                use(i, mDirect.read(index, value) ? &value : nullptr);
            });
    }

    /// False when there is none; the value is unchanged then.
    bool read(int position, Value& value) const {
        return (!mIndex.hasArray() || mIndex.read(position, position)) && mDirect.read(position, value);
    }

    std::optional<Value> at(int position) const {
        Value value;
        return read(position, value) ? std::optional<Value>(value) : std::nullopt;
    }

private:
    mutable ItemReader<Value> mDirect; // reading moves their windows only
    mutable ItemReader<int> mIndex;
};

} // namespace Tarnell::Fbx::detail
