// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files of the corpus, converted by the tool.
#pragma once

#include "../support/TemporaryFolder.h"
#include "Corpus.h"
#include "LoadedFile.h"

#include <optional>
#include <string>

namespace conformance {

/// The target of a conversion: "2016:binary".
struct ConvertedForm {
    std::string year;
    bool ascii = false;
};
std::optional<ConvertedForm> parseConvertedForm(const std::string& text);

/// Where convert places the nodes of a loaded file.
FlatPlaces flatPlacesOf(const LoadedFile& file);

/// Removed with all its files.
class ConvertedCorpus {
public:
    explicit ConvertedCorpus(ConvertedForm form) : mForm(std::move(form)) {}

    /// The converted file; deformed meshes have their points at the whole frames of the reference.
    /// Throws std::runtime_error when the tool fails.
    [[nodiscard]] CorpusFile convert(const CorpusFile& file, const Reference& reference, bool deforms) const;

private:
    support::TemporaryFolder mFolder;
    ConvertedForm mForm;
};

} // namespace conformance
