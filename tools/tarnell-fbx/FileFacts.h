// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The settings of a file before it is normalised, for documents that contain more than values.
#pragma once

#include <fbxsdk.h>

#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace tool {

/// A file's scene as it is stored.
class FileFacts {
public:
    FileFacts() = default;
    ~FileFacts();
    FileFacts(const FileFacts&) = delete;
    FileFacts& operator=(const FileFacts&) = delete;

    /// Empty when the file was read, else the reason.
    std::string load(const std::string& file);

    [[nodiscard]] double unitInCentimetres() const;
    [[nodiscard]] std::string axes() const; ///< "+Y up, +Z to the viewer, right-handed"
    [[nodiscard]] std::vector<std::string> stackNames() const;
    /// The seconds from the first to the last key of the stack of that name, or of the first one; nothing without keys.
    [[nodiscard]] std::optional<std::pair<double, double>> keyedRange(const std::string& stackName) const;

    /// Whether a node of the kind has the name.
    [[nodiscard]] bool has(const std::string& kind, const std::string& name) const;
    /// Starts again with the nodes of a kind, as the library lists them.
    void beginNodes(const std::string& kind);
    /// The name of the parent of the next node of that name; nothing below the root.
    std::optional<std::string> parentOfNext(const std::string& name);

private:
    fbxsdk::FbxManager* mManager = nullptr; // owned
    fbxsdk::FbxScene* mScene = nullptr;     // owned by the manager
    std::vector<fbxsdk::FbxNode*> mNodes;
    std::size_t mNext = 0;
};

} // namespace tool
