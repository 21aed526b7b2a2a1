// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// expected.json: per row the numbers, and the differing files grouped by their reason.
#include "Expectations.h"

#include <nlohmann/json.hpp>

#include <fstream>

namespace conformance {
namespace {

using json = nlohmann::ordered_json;

void checkFiles(const std::string& row, const ExpectedRow& expected, const RowResult& result,
                std::vector<std::string>& violations) {
    for (const std::string& file : result.differingFiles) {
        const auto known = expected.reasons.find(file);
        if (known == expected.reasons.end())
            violations.push_back(row + ": " + file + " differs");
        else if (known->second.empty())
            violations.push_back(row + ": " + file + " differs without a stated reason");
    }
    for (const auto& [file, reason] : expected.reasons)
        if (!result.differingFiles.contains(file))
            violations.push_back(row + ": " + file + " agrees now: remove it from the list");
}

} // namespace

Expectations::Expectations(const std::filesystem::path& path) : mPath(path) {
    std::ifstream stream(path);
    if (!stream)
        return;
    const json file = json::parse(stream);
    for (const auto& [name, value] : file.items()) {
        ExpectedRow& row = mRows[name];
        value.at("compared").get_to(row.compared);
        value.at("agreeing").get_to(row.agreeing);
        for (const json& group : value.at("differing"))
            for (const json& differing : group.at("files"))
                row.reasons[differing] = group.at("reason");
    }
}

std::vector<std::string> Expectations::violations(const Results& results) const {
    std::vector<std::string> violations;
    for (const auto& [name, result] : results) {
        const auto found = mRows.find(name);
        const ExpectedRow expected = found == mRows.end() ? ExpectedRow{} : found->second;
        if (result.compared < expected.compared) {
            violations.push_back(name + ": only " + std::to_string(result.compared) + " of " +
                                 std::to_string(expected.compared) + " values compared");
        }
        if (result.agreeing < expected.agreeing) {
            violations.push_back(name + ": only " + std::to_string(result.agreeing) + " of " +
                                 std::to_string(expected.agreeing) + " values agree");
        }
        checkFiles(name, expected, result, violations);
    }
    return violations;
}

std::string Expectations::reasonOf(const std::string& row, const std::string& file) const {
    const auto expected = mRows.find(row);
    if (expected == mRows.end())
        return {};
    const auto reason = expected->second.reasons.find(file);
    return reason != expected->second.reasons.end() ? reason->second : std::string();
}

void Expectations::update(const Results& results) {
    for (const auto& [name, result] : results) {
        ExpectedRow& row = mRows[name];
        row.compared = result.compared;
        row.agreeing = result.agreeing;
        std::map<std::string, std::string> reasons;
        for (const std::string& file : result.differingFiles)
            reasons[file] = row.reasons[file];
        row.reasons = std::move(reasons);
    }
}

void Expectations::write() const {
    json file = json::object();
    for (const auto& [name, row] : mRows) {
        std::map<std::string, std::vector<std::string>> groups;
        for (const auto& [differing, reason] : row.reasons)
            groups[reason].push_back(differing);
        json differing = json::array();
        for (const auto& [reason, files] : groups)
            differing.push_back({{"reason", reason}, {"files", files}});
        file[name] = {{"compared", row.compared}, {"agreeing", row.agreeing}, {"differing", differing}};
    }
    std::ofstream(mPath) << file.dump(2) << '\n';
}

} // namespace conformance
