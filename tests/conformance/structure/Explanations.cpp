// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A table in JSON, so that it is read as one.
#include "Explanations.h"

#include <algorithm>
#include <fstream>
#include <stdexcept>
#include <string_view>

#include <nlohmann/json.hpp>

namespace conformance {
namespace {

/// Whether the text matches the pattern, where `*` matches any number of characters.
bool matches(std::string_view pattern, std::string_view text) {
    std::size_t at = 0, p = 0, star = std::string_view::npos, resume = 0;
    while (at < text.size()) {
        if (p < pattern.size() && pattern[p] == '*') {
            star = p++;
            resume = at;
        } else if (p < pattern.size() && pattern[p] == text[at]) {
            ++p;
            ++at;
        } else if (star != std::string_view::npos) {
            p = star + 1;
            at = ++resume;
        } else {
            return false;
        }
    }
    return pattern.find_first_not_of('*', p) == std::string_view::npos;
}

} // namespace

Explanations::Explanations(const std::filesystem::path& path, const std::string& form) {
    std::ifstream file(path);
    for (const nlohmann::json& entry : nlohmann::json::parse(file)) {
        if (entry.at("reason").get<std::string>().empty())
            throw std::runtime_error("an explanation without a reason");
        const auto forms = entry.at("forms").get<std::vector<std::string>>();
        if (std::find(forms.begin(), forms.end(), form) == forms.end())
            continue;
        for (const nlohmann::json& deviation : entry.at("deviations"))
            mPatterns.push_back({deviation.get<std::string>()});
    }
}

bool Explanations::explain(const std::string& deviation) {
    bool explained = false;
    for (Pattern& pattern : mPatterns)
        if (matches(pattern.text, deviation))
            explained = pattern.used = true;
    return explained;
}

std::vector<std::string> Explanations::unused() const {
    std::vector<std::string> texts;
    for (const Pattern& pattern : mPatterns)
        if (!pattern.used)
            texts.push_back(pattern.text);
    return texts;
}

} // namespace conformance
