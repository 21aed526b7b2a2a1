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
    /// Nothing for a count of 0.
    void add(int count, const std::string& what);
    [[nodiscard]] const std::vector<std::string>& sentences() const { return mSentences; }

    /// All that is lost of a scene whatever is written of it. Surfaces must still be surfaces.
    void addScene(FbxScene& scene);
    /// What stands in the file and in no scene: constraints, poses, characters.
    void addRecords(const std::string& file);

private:
    std::vector<std::string> mSentences;
};

} // namespace tool
