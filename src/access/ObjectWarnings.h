// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Warnings about objects of a scene, of which there may be many with the same fault.
#pragma once

#include <string>
#include <vector>

namespace Tarnell::Fbx::detail {

/// Names the first object that has a fault and counts the others, so that the list stays short enough to be read.
class ObjectWarnings {
public:
    /// `fault` states what is wrong and its consequence.
    void add(const std::string& object, const std::string& fault);
    /// Adds one sentence per fault to `lastWarnings()`.
    void report() const;
    void forget() { mRows.clear(); }

private:
    struct Row {
        std::string fault, first;
        int others;
    };
    std::vector<Row> mRows;
};

} // namespace Tarnell::Fbx::detail
