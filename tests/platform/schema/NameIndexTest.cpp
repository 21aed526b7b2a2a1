// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Rows of a class by name.
#include "object/RowIndex.h"

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "schema/Schema.h"

namespace {

using namespace fbxsdk;
using namespace fbxsdk::detail;

TEST(RowIndex, FindsEveryRowOfTheLargestClasses) {
    for (const std::span<const PropertyRow> rows : {kNodeRows, kCameraStereoRows, kGlobalSettingsRows, kPhongRows}) {
        const RowIndex index(rows);
        for (const PropertyRow& row : rows)
            EXPECT_EQ(index.find(row.name), rowIndex(rows, row.name)) << row.name;
    }
}

TEST(RowIndex, FindsNothingElse) {
    const RowIndex index(kNodeRows);
    for (const char* name : {"", "lcl translation", "Lcl Translatio", "Lcl Translation ", "no such property"})
        EXPECT_EQ(index.find(name), -1) << name;
    EXPECT_EQ(index.find(std::string_view()), -1);
    EXPECT_EQ(index.find(std::string(1000, 'x')), -1);
    EXPECT_EQ(RowIndex({}).find("Show"), -1);
}

TEST(RowIndex, TakesTheFirstOfSeveralRowsOfOneName) {
    const PropertyRow rows[] = {{"a", &FbxIntDT, ""}, {"same", &FbxIntDT, ""}, {"same", &FbxIntDT, ""}};
    EXPECT_EQ(RowIndex(rows).find("same"), 1);
}

TEST(RowIndex, TellsNamesApartThatDifferInTheMiddleOnly) {
    std::vector<std::string> names;
    for (int i = 0; i < 100; ++i)
        names.push_back("12345678 " + std::to_string(100 + i) + " 87654321");
    std::vector<PropertyRow> rows;
    for (const std::string& name : names)
        rows.push_back({name.c_str(), &FbxIntDT, ""});
    const RowIndex index(rows);
    for (std::size_t i = 0; i < names.size(); ++i)
        EXPECT_EQ(index.find(names[i]), static_cast<int>(i));
}

} // namespace
