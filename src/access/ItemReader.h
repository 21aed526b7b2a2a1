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
#include <type_traits>

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

/// The distance of items in files, where vectors have three numbers.
template <class Value>
constexpr std::size_t storedBytes() {
    return std::is_same_v<Value, fbxsdk::FbxVector4> ? 3 * sizeof(double) : sizeof(Value);
}

/// Calls `use(i, item)` for `count` items that exist, i from 0 on. `runAt(index)` returns items around one.
template <class Value, class RunAt, class Use>
void forEachInRuns(int first, int count, const RunAt& runAt, const Use& use) {
    for (int done = 0; done < count;) {
        const fbxsdk::extensions::ItemRun run = runAt(first + done);
        const int end = std::min(count, run.first + run.count - first);
        const char* bytes = run.at(first + done);
        if (run.itemBytes == storedBytes<Value>()) // for the compiler, which knows that distance
            for (; done < end; ++done, bytes += storedBytes<Value>())
                use(done, loadItem<Value>(bytes));
        for (; done < end; ++done, bytes += run.itemBytes)
            use(done, loadItem<Value>(bytes));
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

    /// Calls `use(i, item)` for consecutive items, which must exist, i from 0 on.
    template <class Use>
    void forEach(int first, int count, const Use& use) {
#ifdef TARNELL_FBX_EXTERNAL_FBXSDK
        for (int i = 0; i < count; ++i)
            use(i, mArray->GetAt(first + i));
#else
        mRun = {};
        forEachInRuns<Value>(
            first, count, [this](int index) { return fbxsdk::extensions::itemRun(*mArray, index); }, use);
#endif
    }

private:
    Array* mArray = nullptr;
#ifndef TARNELL_FBX_EXTERNAL_FBXSDK
    fbxsdk::extensions::ItemRun mRun; // that was read last
#endif
};

/// Calls `use(i, point)` for consecutive control points, which must exist, i from 0 on. Throws std::runtime_error when
/// the file has been changed.
template <class Use>
void forEachControlPoint(fbxsdk::FbxGeometryBase& geometry, int first, int count, const Use& use) {
#ifdef TARNELL_FBX_EXTERNAL_FBXSDK
    for (int i = 0; i < count; ++i)
        use(i, geometry.GetControlPointAt(first + i));
#else
    forEachInRuns<fbxsdk::FbxVector4>(
        first, count, [&geometry](int index) { return fbxsdk::extensions::controlPointRun(geometry, index); }, use);
#endif
}

} // namespace Tarnell::Fbx::detail
