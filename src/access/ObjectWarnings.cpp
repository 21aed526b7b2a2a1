// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "ObjectWarnings.h"

#include "calls/LastError.h"

#include <algorithm>

namespace Tarnell::Fbx {

void detail::ObjectWarnings::add(const std::string& object, const std::string& fault) {
    const auto known =
        std::find_if(mRows.begin(), mRows.end(), [&fault](const Row& row) { return row.fault == fault; });
    if (known == mRows.end())
        mRows.push_back({fault, object, 0});
    else
        ++known->others;
}

void detail::ObjectWarnings::report() const {
    for (const Row& row : mRows) {
        const std::string others = row.others > 0 ? " and " + std::to_string(row.others) + " more" : "";
        warn(row.first + others + ": " + row.fault);
    }
}

} // namespace Tarnell::Fbx
