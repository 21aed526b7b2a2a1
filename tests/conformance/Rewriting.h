// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files of the corpus, read and rewritten: in another version and encoding, in a folder of their own.
#pragma once

#include "../support/TemporaryFolder.h"
#include "Corpus.h"

#include <optional>
#include <string>

namespace conformance {

/// What files are written as: "FBX201000:ascii".
struct WrittenForm {
    std::string version;
    bool ascii = false;
};
std::optional<WrittenForm> parseWrittenForm(const std::string& text);

/// Removed with all its files.
class RewrittenCorpus {
public:
    /// Files next to those of the corpus, such as point caches, are found from the new folder, too.
    RewrittenCorpus(const std::filesystem::path& corpus, WrittenForm form);

    /// The same file, rewritten; nothing when it cannot be read.
    /// Throws std::runtime_error when it is read, but cannot be written.
    [[nodiscard]] std::optional<CorpusFile> rewrite(const CorpusFile& file) const;

private:
    std::filesystem::path mSource;
    support::TemporaryFolder mFolder;
    WrittenForm mForm;
};

} // namespace conformance
