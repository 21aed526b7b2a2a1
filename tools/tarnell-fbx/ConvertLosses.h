// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What of a scene the library's objects have no place for, with counts.
#pragma once

#include <string>
#include <vector>

#include <fbxsdk.h>

namespace tool {

/// Sentences like "not written: materials: 3".
class Losses {
public:
    /// About the kinds that are asked for, as in the options of `convert`: none are all.
    explicit Losses(const std::vector<std::string>& kinds) : mKinds(kinds) {}

    [[nodiscard]] bool wants(const char* kind) const;
    /// Nothing for a count of 0.
    void add(int count, const std::string& what);
    [[nodiscard]] const std::vector<std::string>& sentences() const { return mSentences; }

    /// All that is lost of the objects that are written. Surfaces must still be surfaces.
    void addScene(FbxScene& scene);
    /// What stands in the file and in no scene: constraints, poses, characters, subdivision.
    void addRecords(const std::string& file);

private:
    const std::vector<std::string>& mKinds;
    std::vector<std::string> mSentences;
};

} // namespace tool
