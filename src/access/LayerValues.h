// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The values of a layer element, corner by corner, without allocating.
#pragma once

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
            mDirect = &element.GetDirectArray();
            break;
        case fbxsdk::FbxLayerElement::eIndexToDirect:
            mDirect = &element.GetDirectArray();
            mIndex = &element.GetIndexArray();
            break;
        default: // an index alone refers to nothing
            break;
        }
    }

    /// Values that are indices where the element has indices only.
    static ElementValues numbered(const fbxsdk::FbxLayerElementTemplate<Value>& element) {
        ElementValues values;
        values.mDirect = &element.GetDirectArray();
        if (element.GetReferenceMode() != fbxsdk::FbxLayerElement::eDirect) {
            values.mIndex = &element.GetIndexArray();
        }
        return values;
    }

    /// The values themselves where they have no index and there are at least that many; else null.
    const fbxsdk::FbxLayerElementArrayTemplate<Value>* inOrder(int count) const {
        return mIndex == nullptr && mDirect != nullptr && mDirect->GetCount() >= count ? mDirect : nullptr;
    }

    std::optional<Value> at(int position) const {
        if (mIndex != nullptr) {
            if (position < 0 || position >= mIndex->GetCount()) {
                return std::nullopt;
            }
            position = mIndex->GetAt(position);
        }
        if (mDirect == nullptr || position < 0 || position >= mDirect->GetCount()) {
            return std::nullopt;
        }
        return mDirect->GetAt(position);
    }

private:
    const fbxsdk::FbxLayerElementArrayTemplate<Value>* mDirect = nullptr;
    const fbxsdk::FbxLayerElementArrayTemplate<int>* mIndex = nullptr;
};

} // namespace Tarnell::Fbx::detail
