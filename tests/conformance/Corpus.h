// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Where the real files are and which belong together: the FBX file, its reference, and the Wavefront files of its
// scene.
#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

namespace conformance {

/// A Wavefront file of the same scene, at a frame or, without one, as it was when the FBX file was saved.
struct WavefrontSibling {
    std::filesystem::path path;
    std::optional<double> frame;
};

struct CorpusFile {
    std::string name; ///< the file's name without folder and extension
    std::filesystem::path path;
    std::optional<std::filesystem::path> reference;
    std::vector<WavefrontSibling> wavefront;
};

/// The folder that $TARNELL_CORPUS names, else the one next to the project; nothing when there is none.
std::optional<std::filesystem::path> findCorpus();

/// Every FBX file of the corpus, sorted by name.
std::vector<CorpusFile> listCorpus(const std::filesystem::path& folder);

} // namespace conformance
