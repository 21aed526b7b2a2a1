// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// rewritten.json: a list of exceptions, each with a reason, the forms and rows that it concerns, and the files.
#include "RoundTrip.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <cstdio>
#include <fstream>

namespace conformance {

using json = nlohmann::json;

RoundTrip::RoundTrip(const std::filesystem::path& exceptions, std::string form) : mForm(std::move(form)) {
    std::ifstream stream(exceptions);
    for (const json& exception : json::parse(stream)) {
        const auto& forms = exception.at("forms");
        if (std::find(forms.begin(), forms.end(), mForm) == forms.end())
            continue;
        for (const json& row : exception.at("rows"))
            for (const json& file : exception.at("files"))
                mKnown[{row.get<std::string>(), file.get<std::string>()}] = exception.at("reason");
    }
}

void RoundTrip::add(const std::string& file, const Results& before, const Results& after) {
    for (const auto& [row, result] : after) {
        const auto found = before.find(row);
        const RowResult original = found == before.end() ? RowResult{} : found->second;
        Totals& totals = mTotals[row];
        totals.compared += result.compared;
        totals.agreeing += result.agreeing;
        const bool lessCompared = result.compared < original.compared;
        if (lessCompared || result.compared - result.agreeing > original.compared - original.agreeing) {
            ++totals.worseFiles;
            mWorse.emplace(row, file);
        }
    }
}

std::vector<std::string> RoundTrip::violations() const {
    std::vector<std::string> violations;
    for (const auto& [row, file] : mWorse)
        if (!mKnown.contains({row, file}))
            violations.push_back(mForm + ": " + row + ": " + file + " is worse than the file it was made of");
    for (const auto& known : mKnown) {
        if (!mWorse.contains(known.first))
            violations.push_back(mForm + ": " + known.first.first + ": " + known.first.second +
                                 " is as good now: remove it from the list");
    }
    return violations;
}

void RoundTrip::print() const {
    std::printf("\n%s\n%-20s %9s %9s %9s\n", mForm.c_str(), "row", "worse", "compared", "agreeing");
    for (const auto& [row, totals] : mTotals) {
        std::printf("%-20s %9d %9lld %9lld\n", row.c_str(), totals.worseFiles, static_cast<long long>(totals.compared),
                    static_cast<long long>(totals.agreeing));
    }
}

} // namespace conformance
