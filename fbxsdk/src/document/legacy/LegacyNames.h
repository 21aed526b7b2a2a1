// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Names as the identity of objects, in files before 7.0.
#pragma once

#include <deque>
#include <string>
#include <string_view>
#include <vector>

#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The class and the name by which files identify an object.
struct LegacyName {
    std::string_view nameClass, name;

    bool operator==(const LegacyName&) const = default;
};

/// Something for each object of a document that is to be written.
template <class T>
class IdTable {
public:
    [[nodiscard]] T operator[](std::int64_t id) const {
        return static_cast<std::size_t>(id) < mElements.size() ? mElements[static_cast<std::size_t>(id)] : T{};
    }
    /// For changes.
    [[nodiscard]] T& at(std::int64_t id) {
        if (static_cast<std::size_t>(id) >= mElements.size())
            mElements.resize(static_cast<std::size_t>(id) + 1);
        return mElements[static_cast<std::size_t>(id)];
    }

private:
    std::vector<T> mElements;
};

/// A name for every object that is unique in its class: the object's own, or, when that is taken, the same followed by
/// a number, `cube_ncl1_1`.
class LegacyNames {
public:
    explicit LegacyNames(const std::vector<DocumentObject>& objects);

    /// The root for the id 0.
    [[nodiscard]] LegacyName operator[](std::int64_t id) const { return mNames[id]; }

private:
    IdTable<LegacyName> mNames;
    std::deque<std::string> mNumbered; ///< the names that are not the objects' own
};

} // namespace detail
FBXSDK_NAMESPACE_END
