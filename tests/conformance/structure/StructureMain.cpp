// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Rewrites the files that applications saved in a version, in the same version, and compares the records of the
// copies with those of the files. The scenes are the same, so every difference is the writer's. Fails on every
// deviation that the table next to it does not explain, and on every explanation that explains nothing.
#include "../Corpus.h"
#include "../Rewriting.h"
#include "Explanations.h"
#include "Structure.h"

#include "container/Record.h"

#include <cstdio>
#include <exception>
#include <memory>
#include <stdexcept>
#include <string_view>
#include <utility>

namespace conformance {
namespace {

constexpr int kSkipped = 77; // ctest's SKIP_RETURN_CODE
constexpr int kUsage = 2;

/// Files that were made by hand break rules deliberately.
bool isMadeByHand(const std::string& name) { return name.starts_with("synthetic_"); }

/// The scripted exporter follows rules of its own.
bool isEvidence(const std::string& name) { return !isMadeByHand(name) && !name.starts_with("blender_"); }

std::unique_ptr<fbxsdk::detail::RecordTree> readFile(const std::filesystem::path& path) {
    fbxsdk::FbxStatus status;
    return fbxsdk::detail::readRecords(path.string(), status);
}

/// The container's version of what is written under that name.
std::uint32_t versionOf(const WrittenForm& form) {
    constexpr std::pair<std::string_view, std::uint32_t> kVersions[] = {
        {"FBX201000", 6100}, {"FBX201400", 7400}, {"FBX201600", 7500}};
    for (const auto& [name, version] : kVersions)
        if (name == form.version)
            return version;
    throw std::runtime_error("nothing to compare with for " + form.version);
}

void addCopy(const CorpusFile& copy, std::uint32_t version, Structure& ours) {
    const auto tree = readFile(copy.path);
    if (!tree || tree->version != version)
        throw std::runtime_error(copy.name + " was written, but not as version " + std::to_string(version));
    ours.add(copy.name, *tree);
}

int run(const std::string& formText) {
    const auto corpus = findCorpus();
    if (!corpus) {
        std::puts("corpus not found: conformance tests skipped");
        return kSkipped;
    }
    const WrittenForm form = *parseWrittenForm(formText);
    const RewrittenCorpus rewritten(*corpus, form);
    const std::vector<CorpusFile> files = listCorpus(*corpus);
    Structure ours, theirs;
    const std::uint32_t version = versionOf(form);
    for (const CorpusFile& file : files) {
        const auto tree = isEvidence(file.name) ? readFile(file.path) : nullptr;
        if (!tree || tree->version != version)
            continue;
        if (tree->ascii == form.ascii)
            theirs.add(file.name, *tree);
        // The other encoding has the same data: its copies count, too.
        if (const std::optional<CorpusFile> copy = rewritten.rewrite(file))
            addCopy(*copy, version, ours);
    }
    if (!ours.find("") || !theirs.find(""))
        throw std::runtime_error("there is nothing to compare");
    std::printf("%s: %d copies, %d files of version %u, %zu places\n", formText.c_str(), ours.find("")->records,
                theirs.find("")->records, version, ours.places().size());

    Explanations explanations(TARNELL_STRUCTURE_EXPLANATIONS, formText);
    int failures = 0;
    for (const std::string& deviation : deviations(ours, theirs)) {
        if (explanations.explain(deviation))
            continue;
        std::printf("FAILED %s\n", deviation.c_str());
        ++failures;
    }
    for (const std::string& pattern : explanations.unused()) {
        std::printf("FAILED explains nothing: %s\n", pattern.c_str());
        ++failures;
    }
    return failures == 0 ? 0 : 1;
}

} // namespace
} // namespace conformance

int main(int argc, char** argv) {
    if (argc != 2 || !conformance::parseWrittenForm(argv[1])) {
        std::fputs("usage: structure VERSION:ENCODING, for example FBX201000:binary\n", stderr);
        return conformance::kUsage;
    }
    try {
        return conformance::run(argv[1]);
    } catch (const std::exception& error) {
        std::fprintf(stderr, "structure: %s\n", error.what());
        return 1;
    }
}
