// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// JSON output.
#include "JsonWriter.h"

#include <nlohmann/json.hpp>

namespace tool {

void JsonWriter::key(std::string_view name) {
    text(name);
    mOut << (mPretty ? ": " : ":");
    mAfterKey = true;
}

void JsonWriter::text(std::string_view value) {
    // Names may hold anything; what is no UTF-8 becomes the replacement character.
    raw(nlohmann::json(std::string(value)).dump(-1, ' ', false, nlohmann::json::error_handler_t::replace));
}

void JsonWriter::open(char bracket) {
    separate();
    mOut << bracket;
    mLevels.emplace_back();
}

void JsonWriter::close(char bracket) {
    const bool wasEmpty = mLevels.back().empty;
    mLevels.pop_back();
    if (!wasEmpty)
        breakLine();
    mOut << bracket;
}

void JsonWriter::separate() {
    if (mAfterKey || mLevels.empty()) {
        mAfterKey = false;
        return;
    }
    if (!mLevels.back().empty)
        mOut << ',';
    mLevels.back().empty = false;
    breakLine();
}

void JsonWriter::breakLine() {
    if (!mPretty)
        return;
    mOut << '\n';
    for (std::size_t i = 0; i < mLevels.size(); ++i)
        mOut << "  ";
}

} // namespace tool
