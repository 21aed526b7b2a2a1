// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The hand-made files of tests/data/container, each with its expected records.
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "container/Record.h"
#include "support/RecordText.h"

namespace {

std::vector<std::string> recordFiles() {
    std::vector<std::string> files;
    for (const auto& entry : std::filesystem::directory_iterator(TARNELL_TEST_DATA "/container"))
        if (entry.path().extension() == ".fbx")
            files.push_back(entry.path().stem());
    return files;
}

class RecordFiles : public testing::TestWithParam<std::string> {};

INSTANTIATE_TEST_SUITE_P(HandMade, RecordFiles, testing::ValuesIn(recordFiles()),
                         [](const auto& test) { return test.param; });

TEST_P(RecordFiles, AreCutIntoTheRecordsBesideThem) {
    const std::string path = TARNELL_TEST_DATA "/container/" + GetParam();
    std::ifstream expectedFile(path + ".records", std::ios::binary);
    const std::string expected{std::istreambuf_iterator<char>(expectedFile), {}};
    ASSERT_FALSE(expected.empty()) << path << ".records is missing";
    fbxsdk::FbxStatus status;

    const auto tree = fbxsdk::detail::readRecords(path + ".fbx", status);

    ASSERT_TRUE(tree) << status.GetErrorString();
    EXPECT_EQ(recordsText(tree->root) + "\n", expected);
}

} // namespace
