// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Similar names, by the number of letters to insert, delete, replace or swap with the next one.
#include "Similarity.h"

#include <algorithm>
#include <cctype>
#include <map>
#include <numeric>
#include <utility>

namespace tool {
namespace {

constexpr std::size_t kMostNames = 3;
constexpr std::size_t kLongest = 64; // no name of that length is typed

std::string lowered(std::string_view text) {
    std::string lower(text);
    std::transform(lower.begin(), lower.end(), lower.begin(),
                   [](unsigned char letter) { return static_cast<char>(std::tolower(letter)); });
    return lower;
}

std::size_t editDistance(std::string_view a, std::string_view b) {
    // A row per letter of a: the distances of its beginnings from those of b.
    std::vector<std::size_t> twoBefore(b.size() + 1), before(b.size() + 1), row(b.size() + 1);
    std::iota(row.begin(), row.end(), std::size_t{0});
    for (std::size_t i = 1; i <= a.size(); ++i) {
        twoBefore = std::exchange(before, row);
        row[0] = i;
        for (std::size_t j = 1; j <= b.size(); ++j) {
            row[j] = std::min({before[j - 1] + (a[i - 1] == b[j - 1] ? 0 : 1), row[j - 1] + 1, before[j] + 1});
            const bool isSwapped = i > 1 && j > 1 && a[i - 1] == b[j - 2] && a[i - 2] == b[j - 1];
            if (isSwapped)
                row[j] = std::min(row[j], twoBefore[j - 2] + 1);
        }
    }
    return row.back();
}

/// Smaller is more similar; none when the two are unrelated.
constexpr std::size_t kUnrelated = 1000;
std::size_t difference(const std::string& text, const std::string& name) {
    if (name.size() > kLongest || name.empty())
        return kUnrelated;
    if (text == name)
        return 0;
    const std::size_t distance = editDistance(text, name);
    const bool isPart = text.size() >= 3 && name.find(text) != std::string::npos;
    return isPart || distance <= std::max<std::size_t>(text.size() / 3, 1) ? distance : kUnrelated;
}

} // namespace

std::vector<std::string> mostSimilar(std::string_view text, const std::vector<std::string>& names) {
    const std::string wanted = lowered(text.substr(0, kLongest));
    std::multimap<std::size_t, const std::string*> ranked;
    for (const std::string& name : names) {
        const std::size_t distance = difference(wanted, lowered(name));
        if (distance != kUnrelated)
            ranked.emplace(distance, &name);
    }
    std::vector<std::string> best;
    for (const auto& [distance, name] : ranked)
        if (best.size() < kMostNames && std::find(best.begin(), best.end(), *name) == best.end())
            best.push_back(*name);
    return best;
}

} // namespace tool
