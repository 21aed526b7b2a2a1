// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What the library's objects cannot hold of a scene, with counts.
#pragma once

#include <string>
#include <vector>

#include <fbxsdk.h>

namespace tool {

/// Sentences like "not written: materials: 3".
class Losses {
public:
    /// For the selected kinds, as in the options of `convert`: none means all.
    explicit Losses(const std::vector<std::string>& kinds) : mKinds(kinds) {}

    [[nodiscard]] bool wants(const char* kind) const;
    /// No effect for a count of 0.
    void add(int count, const std::string& what);
    [[nodiscard]] const std::vector<std::string>& sentences() const { return mSentences; }

    /// All losses of the written objects. Surfaces must not have been converted.
    void addScene(FbxScene& scene);
    /// What is in the file but in no scene: constraints, poses, characters, subdivision.
    void addRecords(const std::string& file);

private:
    const std::vector<std::string>& mKinds;
    std::vector<std::string> mSentences;
};

} // namespace tool
