// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Names as the identity of objects, in files before 7.0.
#pragma once

#include <string>
#include <unordered_map>
#include <unordered_set>

#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The class and the name by which files identify an object.
struct LegacyName {
    std::string_view nameClass;
    std::string name;
};

/// A name for every object that is unique in its class: the object's own, or, when that is taken, the same followed by
/// a number, `cube_ncl1_1`.
class LegacyNames {
public:
    explicit LegacyNames(const std::vector<DocumentObject>& objects);

    /// The root for the id 0.
    [[nodiscard]] const LegacyName& operator[](std::int64_t id) const { return mNames.at(id); }

private:
    std::unordered_map<std::int64_t, LegacyName> mNames;
};

} // namespace detail
FBXSDK_NAMESPACE_END
