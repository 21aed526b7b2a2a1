// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reading the items of arrays and the points of geometry without a call of the platform for each of them: those of a
// file that are not in memory are read through the platform's window. Another platform is asked for each.
#pragma once

#include <fbxsdk.h>

#include <algorithm>
#include <cstddef>
#include <cstring>

#ifndef TARNELL_FBX_EXTERNAL_FBXSDK
#include <fbxsdk/extensions/ItemRuns.h>
#endif

namespace Tarnell::Fbx::detail {

#ifndef TARNELL_FBX_EXTERNAL_FBXSDK

/// The item that begins with these bytes. The fourth number of a vector is 1: files have three.
template <class Value>
Value loadItem(const char* bytes) {
    Value value;
    std::memcpy(static_cast<void*>(&value), bytes, sizeof(Value));
    return value;
}
template <>
inline fbxsdk::FbxVector4 loadItem<fbxsdk::FbxVector4>(const char* bytes) {
    double numbers[3];
    std::memcpy(numbers, bytes, sizeof numbers);
    return {numbers[0], numbers[1], numbers[2], 1.0};
}

/// Reads `count` items that exist. `runAt(index)` returns items around one.
template <class Value, class RunAt>
void readRuns(int first, int count, Value* values, const RunAt& runAt) {
    for (int done = 0; done < count;) {
        const fbxsdk::extensions::ItemRun run = runAt(first + done);
        const int end = std::min(count, run.first + run.count - first);
        const char* bytes = run.at(first + done);
        for (; done < end; ++done, bytes += run.itemBytes)
            values[done] = loadItem<Value>(bytes);
    }
}

#endif

/// Reads an array in any order; roughly from its beginning to its end is fastest. While a reader is in use nothing else
/// may access the array. Throws std::runtime_error when the file has been changed.
template <class Value>
class ItemReader {
public:
    using Array = fbxsdk::FbxLayerElementArrayTemplate<Value>;

    ItemReader() = default; ///< No array.
    explicit ItemReader(Array& array) : mArray(&array) {}

    bool hasArray() const { return mArray != nullptr; }
    int count() const { return mArray != nullptr ? mArray->GetCount() : 0; }

    /// False when there is no such item; the value is unchanged then.
    bool read(int index, Value& value) {
#ifdef TARNELL_FBX_EXTERNAL_FBXSDK
        if (index < 0 || index >= count())
            return false;
        value = mArray->GetAt(index);
        return true;
#else
        if (!mRun.contains(index)) {
            if (mArray == nullptr)
                return false;
            mRun = fbxsdk::extensions::itemRun(*mArray, index);
            if (!mRun.contains(index))
                return false;
        }
        value = loadItem<Value>(mRun.at(index));
        return true;
#endif
    }

    /// Consecutive items, which must exist.
    void read(int first, int count, Value* values) {
#ifdef TARNELL_FBX_EXTERNAL_FBXSDK
        for (int i = 0; i < count; ++i)
            values[i] = mArray->GetAt(first + i);
#else
        mRun = {};
        readRuns(first, count, values, [this](int index) { return fbxsdk::extensions::itemRun(*mArray, index); });
#endif
    }

private:
    Array* mArray = nullptr;
#ifndef TARNELL_FBX_EXTERNAL_FBXSDK
    fbxsdk::extensions::ItemRun mRun; // that was read last
#endif
};

/// Consecutive control points, which must exist. Throws std::runtime_error when the file has been changed.
inline void readControlPoints(fbxsdk::FbxGeometryBase& geometry, int first, int count, fbxsdk::FbxVector4* points) {
#ifdef TARNELL_FBX_EXTERNAL_FBXSDK
    for (int i = 0; i < count; ++i)
        points[i] = geometry.GetControlPointAt(first + i);
#else
    readRuns(first, count, points,
             [&geometry](int index) { return fbxsdk::extensions::controlPointRun(geometry, index); });
#endif
}

} // namespace Tarnell::Fbx::detail
