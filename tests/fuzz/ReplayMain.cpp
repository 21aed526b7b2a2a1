// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Runs a fuzz target without a fuzzer: over the files it is given, over those in the folders it is given, and over
// mutations of each, which depend only on the file's name and bytes.
//
//     fuzz_Name [--mutations COUNT] PATH...
//     fuzz_Name [--mutations COUNT] --corpus FOLDER
//
// The second form takes a folder of real files, $TARNELL_CORPUS rather than the one named, and of these 30 binary and
// 30 ASCII ones, which are also truncated in 100 places each. Without such a folder it says so and ends with 77.
#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <random>
#include <string>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size);

namespace {

namespace fs = std::filesystem;
using Random = std::mt19937_64;

std::vector<fs::path> filesIn(const fs::path& path) {
    if (!fs::is_directory(path))
        return {path};
    std::vector<fs::path> files;
    for (const fs::directory_entry& entry : fs::recursive_directory_iterator(path))
        if (entry.is_regular_file())
            files.push_back(entry.path());
    std::sort(files.begin(), files.end());
    return files;
}

std::string readFile(const fs::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

void run(const std::string& bytes) {
    // Exactly sized, so that a sanitizer sees any read beyond the end.
    const std::vector<std::uint8_t> exact(bytes.begin(), bytes.end());
    LLVMFuzzerTestOneInput(exact.data(), exact.size());
}

/// FNV-1a.
std::uint64_t hash(const std::string& text) {
    std::uint64_t value = 0xCBF29CE484222325;
    for (const char c : text)
        value = (value ^ static_cast<unsigned char>(c)) * 0x100000001B3;
    return value;
}

/// One small mutation: a byte changed, a number made extreme, a part doubled, dropped or moved, the end truncated.
void mutate(std::string& bytes, Random& random) {
    if (bytes.empty())
        return;
    constexpr std::size_t kLongestPiece = 64;
    const std::size_t place = random() % bytes.size();
    const std::size_t length = std::min<std::size_t>(1 + random() % kLongestPiece, bytes.size() - place);
    switch (random() % 6) {
    case 0:
        bytes[place] = static_cast<char>(random());
        break;
    case 1:
        bytes[place] = static_cast<char>(static_cast<unsigned char>(bytes[place]) ^ (1U << random() % 8));
        break;
    case 2:
        std::fill_n(bytes.begin() + static_cast<std::ptrdiff_t>(place), std::min<std::size_t>(length, 8),
                    random() % 2 == 0 ? '\xFF' : '\0');
        break;
    case 3:
        bytes.insert(random() % bytes.size(), bytes.substr(place, length));
        break;
    case 4:
        bytes.erase(place, length);
        break;
    default:
        bytes.resize(place);
        break;
    }
}

void runMutations(const fs::path& path, const std::string& original, int count) {
    Random random(hash(path.filename().string() + original));
    for (int i = 0; i < count; ++i) {
        std::string bytes = original;
        for (auto accidents = 1 + random() % 4; accidents > 0; --accidents)
            mutate(bytes, random);
        run(bytes);
    }
}

constexpr std::size_t kCorpusFilesPerContainer = 30;
constexpr std::size_t kCuts = 100;
/// Large files only take time: their damage is that of small ones.
constexpr std::size_t kLargestCorpusFile = 300000;
constexpr int kSkipped = 77;

/// Every n-th file of a container, so that all writers and versions are among them.
std::vector<fs::path> sampleOf(const std::vector<fs::path>& files) {
    std::vector<fs::path> sample;
    const std::size_t count = std::min(kCorpusFilesPerContainer, files.size());
    for (std::size_t i = 0; i < count; ++i)
        sample.push_back(files[i * files.size() / count]);
    return sample;
}

std::vector<fs::path> corpusFiles(const fs::path& folder) {
    std::vector<fs::path> binary, ascii;
    for (const fs::path& path : filesIn(folder))
        if (path.extension() == ".fbx" && fs::file_size(path) <= kLargestCorpusFile)
            (readFile(path).starts_with("Kaydara") ? binary : ascii).push_back(path);
    std::vector<fs::path> files = sampleOf(binary);
    for (const fs::path& path : sampleOf(ascii))
        files.push_back(path);
    return files;
}

int runCorpus(const char* fallback, int mutations) {
    const char* named = std::getenv("TARNELL_CORPUS");
    const fs::path folder = named ? named : fallback;
    if (!fs::is_directory(folder)) {
        std::printf("corpus not found: its files are skipped\n");
        return kSkipped;
    }
    std::size_t inputs = 0;
    for (const fs::path& path : corpusFiles(folder)) {
        const std::string bytes = readFile(path);
        run(bytes);
        for (std::size_t i = 0; i < kCuts; ++i)
            run(bytes.substr(0, bytes.size() * i / kCuts));
        runMutations(path, bytes, mutations);
        inputs += 1 + kCuts + static_cast<std::size_t>(mutations);
    }
    std::printf("%zu inputs\n", inputs);
    return inputs > 0 ? EXIT_SUCCESS : EXIT_FAILURE;
}

} // namespace

int main(int argumentCount, char** arguments) {
    int mutations = 0;
    int inputs = 0;
    for (int i = 1; i < argumentCount; ++i) {
        if (std::strcmp(arguments[i], "--mutations") == 0 && i + 1 < argumentCount) {
            mutations = std::atoi(arguments[++i]);
            continue;
        }
        if (std::strcmp(arguments[i], "--corpus") == 0 && i + 1 < argumentCount)
            return runCorpus(arguments[i + 1], mutations);
        if (!fs::exists(arguments[i])) {
            std::fprintf(stderr, "%s: not there\n", arguments[i]);
            return EXIT_FAILURE;
        }
        for (const fs::path& path : filesIn(arguments[i])) {
            const std::string bytes = readFile(path);
            run(bytes);
            runMutations(path, bytes, mutations);
            inputs += 1 + mutations;
        }
    }
    std::printf("%d inputs\n", inputs);
    return inputs > 0 ? EXIT_SUCCESS : EXIT_FAILURE;
}
