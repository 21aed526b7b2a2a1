// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Rows of a table by name.
#include "schema/NameIndex.h"

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "schema/Schema.h"

namespace {

using namespace fbxsdk;
using namespace fbxsdk::detail;

NameIndex indexOf(std::span<const PropertyRow> rows) {
    return NameIndex(
        rows, [](const PropertyRow& row) { return row.name; });
}

int find(const NameIndex& index, std::string_view name) { return index.find(NameKey(name)); }

TEST(NameIndex, FindsEveryRowOfTheLargestClasses) {
    for (const std::span<const PropertyRow> rows : {kNodeRows, kCameraStereoRows, kGlobalSettingsRows, kPhongRows}) {
        const NameIndex index = indexOf(rows);
        for (const PropertyRow& row : rows)
            EXPECT_EQ(find(index, row.name), rowIndex(rows, row.name)) << row.name;
    }
}

TEST(NameIndex, FindsNothingElse) {
    const NameIndex index = indexOf(kNodeRows);
    for (const char* name : {"", "lcl translation", "Lcl Translatio", "Lcl Translation ", "no such property"})
        EXPECT_EQ(find(index, name), -1) << name;
    EXPECT_EQ(find(index, std::string_view()), -1);
    EXPECT_EQ(find(index, std::string(1000, 'x')), -1);
    EXPECT_EQ(find(indexOf({}), "Show"), -1);
}

TEST(NameIndex, TakesTheFirstOfSeveralRowsOfOneName) {
    const PropertyRow rows[] = {{"a", &FbxIntDT, ""}, {"same", &FbxIntDT, ""}, {"same", &FbxIntDT, ""}};
    EXPECT_EQ(find(indexOf(rows), "same"), 1);
}

TEST(NameIndex, DistinguishesNamesThatDifferInTheMiddleOnly) {
    std::vector<std::string> names;
    for (int i = 0; i < 100; ++i)
        names.push_back("12345678 " + std::to_string(100 + i) + " 87654321");
    std::vector<PropertyRow> rows;
    for (const std::string& name : names)
        rows.push_back({name.c_str(), &FbxIntDT, ""});
    const NameIndex index = indexOf(rows);
    for (std::size_t i = 0; i < names.size(); ++i)
        EXPECT_EQ(find(index, names[i]), static_cast<int>(i));
}

TEST(NameIndex, FindsNamesThatTheCompilerPrepared) {
    const PropertyRow rows[] = {{"", &FbxIntDT, ""},
                                {"short", &FbxIntDT, ""},
                                {"just 8 c", &FbxIntDT, ""},
                                {"a long name, much longer than its ends", &FbxIntDT, ""}};
    const NameIndex index = indexOf(rows);
    EXPECT_EQ(index.find(""), 0);
    EXPECT_EQ(index.find("short"), 1);
    EXPECT_EQ(index.find("just 8 c"), 2);
    EXPECT_EQ(index.find("a long name, much longer than its ends"), 3);
}

} // namespace
