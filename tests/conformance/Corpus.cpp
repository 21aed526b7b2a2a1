// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Names carry the structure: <feature>_<version>_<ascii|binary>.fbx (some have a take's name after that), and
// <feature>.obj or <feature>_<frame>.obj for all versions of a feature.
#include "Corpus.h"

#include <algorithm>
#include <cstdlib>
#include <map>
#include <regex>

namespace conformance {
namespace {

namespace fs = std::filesystem;

bool holdsCorpus(const fs::path& folder) {
    return fs::is_directory(folder / "fbx") && fs::is_directory(folder / "refs");
}

/// `maya_cube_7500_ascii` is a file of `maya_cube`, `sausage_7500_ascii_spin` one of `sausage_spin`.
std::string featureOf(const std::string& fileName) {
    static const std::regex kVersionAndFormat("_[0-9]{4}_(ascii|binary)");
    return std::regex_replace(fileName, kVersionAndFormat, "");
}

std::vector<fs::path> filesBelow(const fs::path& folder, const std::string& extension) {
    std::vector<fs::path> files;
    for (const fs::directory_entry& entry : fs::recursive_directory_iterator(folder))
        if (entry.is_regular_file() && entry.path().extension() == extension)
            files.push_back(entry.path());
    return files;
}

void addWavefrontFiles(const fs::path& folder, std::vector<CorpusFile>& files) {
    static const std::regex kFrame("(.*)_([0-9]+)");
    std::multimap<std::string, CorpusFile*> byFeature;
    for (CorpusFile& file : files)
        byFeature.emplace(featureOf(file.name), &file);

    for (const fs::path& path : filesBelow(folder, ".obj")) {
        std::string feature = path.stem().string();
        std::optional<double> frame;
        std::smatch parts;
        if (!byFeature.contains(feature) && std::regex_match(feature, parts, kFrame)) {
            frame = std::stod(parts[2]);
            feature = std::string(parts[1]);
        }
        const auto [begin, end] = byFeature.equal_range(feature);
        for (auto it = begin; it != end; ++it)
            it->second->wavefront.push_back({path, frame});
    }
    for (CorpusFile& file : files)
        std::ranges::sort(file.wavefront, {}, &WavefrontSibling::path);
}

} // namespace

std::optional<fs::path> findCorpus() {
    if (const char* named = std::getenv("TARNELL_CORPUS"))
        return holdsCorpus(named) ? std::optional<fs::path>(named) : std::nullopt;
    const fs::path beside = fs::path(TARNELL_PROJECT_FOLDER).parent_path() / "shared" / "corpus";
    return holdsCorpus(beside) ? std::optional<fs::path>(beside) : std::nullopt;
}

std::vector<CorpusFile> listCorpus(const fs::path& folder) {
    std::vector<CorpusFile> files;
    for (const fs::path& path : filesBelow(folder / "fbx", ".fbx")) {
        CorpusFile file{path.stem().string(), path, std::nullopt, {}};
        const fs::path reference = folder / "refs" / (file.name + ".json");
        if (fs::exists(reference))
            file.reference = reference;
        files.push_back(file);
    }
    std::ranges::sort(files, {}, &CorpusFile::name);
    addWavefrontFiles(folder / "fbx", files);
    return files;
}

} // namespace conformance
