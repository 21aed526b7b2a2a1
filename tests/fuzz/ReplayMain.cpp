// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Runs a fuzz target without a fuzzer: over the files it is given, over those in the folders it is given, and over
// mutations of each, which depend on nothing but the file's name and bytes.
//
//     fuzz_Name [--mutations COUNT] PATH...
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
    if (!fs::is_directory(path)) {
        return {path};
    }
    std::vector<fs::path> files;
    for (const fs::directory_entry& entry : fs::recursive_directory_iterator(path)) {
        if (entry.is_regular_file()) {
            files.push_back(entry.path());
        }
    }
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
    for (const char c : text) {
        value = (value ^ static_cast<unsigned char>(c)) * 0x100000001B3;
    }
    return value;
}

/// One small accident: a byte changed, a number made extreme, a piece doubled, dropped or moved, the end cut off.
void mutate(std::string& bytes, Random& random) {
    if (bytes.empty()) {
        return;
    }
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
        for (auto accidents = 1 + random() % 4; accidents > 0; --accidents) {
            mutate(bytes, random);
        }
        run(bytes);
    }
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
