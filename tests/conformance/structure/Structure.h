// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The structure of files: for every place in the tree which records it has, in which order, and how their values
// are stored. Objects of different classes are different places.
#pragma once

#include "container/Record.h"

#include <map>
#include <set>
#include <string>
#include <vector>

namespace conformance {

/// All records of one place.
struct Place {
    int records = 0;
    std::set<std::string> files;                         ///< that have one
    std::set<std::string> codes;                         ///< how their values are stored, one entry for each way
    std::map<std::string, int> children;                 ///< in how many of the records each kind of child occurs
    std::set<std::pair<std::string, std::string>> order; ///< kinds of which the first was seen to begin earlier
};

/// Places by their path, like "Objects/Model Mesh/Vertices".
class Structure {
public:
    void add(const std::string& fileName, const fbxsdk::detail::RecordTree& tree);
    [[nodiscard]] const std::map<std::string, Place>& places() const { return mPlaces; }
    [[nodiscard]] const Place* find(const std::string& path) const;

private:
    void addChildren(const std::string& path, const fbxsdk::detail::Record& parent);
    void addRecord(const std::string& path, const fbxsdk::detail::Record& record);

    const fbxsdk::detail::RecordTree* mTree = nullptr;
    std::string mFile;
    std::map<std::string, Place> mPlaces;
};

/// A sentence for every difference of `ours` from all of `theirs`. Places that theirs do not have are named once,
/// without their content.
std::vector<std::string> deviations(const Structure& ours, const Structure& theirs);

} // namespace conformance
