// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Converting.h"

#include <fbxsdk.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <map>
#include <stdexcept>
#include <vector>

#include <spawn.h>
#include <sys/wait.h>

extern char** environ; // NOLINT(readability-redundant-declaration): of the C library, which need not declare it

namespace conformance {
namespace {

int run(std::vector<std::string> words) {
    std::vector<char*> arguments;
    for (std::string& word : words)
        arguments.push_back(word.data());
    arguments.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    ::posix_spawn_file_actions_init(&actions);
    ::posix_spawn_file_actions_addopen(&actions, 2, "/dev/null", 1, 0); // losses are not compared
    pid_t child = 0;
    const int failure = ::posix_spawn(&child, words[0].c_str(), &actions, nullptr, arguments.data(), environ);
    ::posix_spawn_file_actions_destroy(&actions);
    int status = -1;
    if (failure != 0 || ::waitpid(child, &status, 0) != child)
        return -1;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

} // namespace

std::optional<ConvertedForm> parseConvertedForm(const std::string& text) {
    const std::size_t colon = text.find(':');
    const std::string encoding = colon == std::string::npos ? "" : text.substr(colon + 1);
    if (encoding != "ascii" && encoding != "binary")
        return std::nullopt;
    return ConvertedForm{text.substr(0, colon), encoding == "ascii"};
}

FlatPlaces flatPlacesOf(const LoadedFile& file) {
    std::map<const SceneNode*, FlatPlace> places;
    std::array<int, kFlatGroups> counts{};
    fbxsdk::FbxGlobalCameraSettings* settings = file.scene() ? &file.scene()->GlobalCameraSettings() : nullptr;
    for (const SceneNode& entry : file.nodes()) {
        const auto* camera = fbxsdk::FbxCast<fbxsdk::FbxCamera>(entry.node->GetNodeAttribute());
        if (camera && settings->IsProducerCamera(camera))
            continue;
        const FlatGroup group = flatGroupOf(*entry.node, /*converted*/ false);
        places[&entry] = {group, counts[static_cast<std::size_t>(group)]++};
    }
    FlatPlaces result;
    for (std::size_t i = 0; i < file.reference().nodes.size(); ++i) {
        const auto found = places.find(file.nodeOf(i));
        result.push_back(found == places.end() ? std::nullopt : std::optional(found->second));
    }
    return result;
}

CorpusFile ConvertedCorpus::convert(const CorpusFile& file, const Reference& reference, bool deforms) const {
    CorpusFile copy = file;
    copy.path = mFolder.file(file.name + ".fbx");
    std::vector<std::string> words = {
        TARNELL_CONFORMANCE_TOOL, "convert", "--force", "--version", mForm.year, mForm.ascii ? "--ascii" : "--binary"};
    double first = 1e9, last = -1e9;
    for (const double frame : reference.frames) {
        if (isWholeFrame(frame)) {
            first = std::min(first, frame);
            last = std::max(last, frame);
        }
    }
    if (deforms && first <= last) {
        words.emplace_back("--frames");
        words.push_back(std::to_string(std::lround(first)) + ":" + std::to_string(std::lround(last)));
    }
    words.push_back(file.path.string());
    words.push_back(copy.path.string());
    const int status = run(words);
    if (status != 0)
        throw std::runtime_error(file.name + " cannot be converted: exit status " + std::to_string(status));
    return copy;
}

} // namespace conformance
