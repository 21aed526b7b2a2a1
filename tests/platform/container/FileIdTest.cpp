// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Times of files, and the codes of known files for their times.
#include "container/FileId.h"

#include <cstdio>
#include <string>

#include <gtest/gtest.h>

namespace fbxsdk::detail {
namespace {

using std::chrono::milliseconds;
using std::chrono::system_clock;

std::string hex(const FileCode& code) {
    std::string text;
    for (const std::uint8_t byte : code) {
        char digits[3];
        std::snprintf(digits, sizeof digits, "%02X", byte);
        text += digits;
    }
    return text;
}

TEST(FileId, HasTheCodesOfAFileOfMarch2020) {
    const CreationTime time{2020, 3, 31, 21, 34, 23, 150};

    EXPECT_EQ(time.text(), "2020-03-31 21:34:23:150");
    EXPECT_EQ(hex(fileId(time)), "2AB22BE8B625CEC0BCCEB526A022F6FF");
    EXPECT_EQ(hex(footerCode(time)), "FABCA908D3CAD765B077F9841BFC287C");
}

TEST(FileId, HasTheCodesThatManyWritersCarryAsConstants) {
    const CreationTime time{1970, 1, 1, 10, 0, 0, 0};

    EXPECT_EQ(time.text(), "1970-01-01 10:00:00:000");
    EXPECT_EQ(hex(fileId(time)), "28B32AEBB624CCC2BFC8B02AA92BFCF1");
    EXPECT_EQ(hex(footerCode(time)), "FABCAB09D0C8D466B176FB831CF7267E");
}

TEST(FileId, ChangesWithEveryHundredthOfASecondButNotWithin) {
    const CreationTime a{2024, 5, 6, 7, 8, 9, 120}, b{2024, 5, 6, 7, 8, 9, 129}, c{2024, 5, 6, 7, 8, 9, 130};

    EXPECT_EQ(fileId(a), fileId(b));
    EXPECT_NE(fileId(a), fileId(c));
}

TEST(CreationTime, BreaksAMomentDownInUniversalTime) {
    const CreationTime time = utcTime(system_clock::time_point(milliseconds(1585690463150)));

    EXPECT_EQ(time.text(), "2020-03-31 21:34:23:150");
    EXPECT_EQ(time.dayFirstText(), "31/03/2020 21:34:23.150");
}

TEST(CreationTime, IsTheEpochAtZero) {
    EXPECT_EQ(utcTime(system_clock::time_point()).text(), "1970-01-01 00:00:00:000");
}

TEST(CreationTime, BreaksMomentsBeforeTheEpochDownToo) {
    EXPECT_EQ(utcTime(system_clock::time_point(milliseconds(-1))).text(), "1969-12-31 23:59:59:999");
}

TEST(CreationTime, FillsEveryPartWithZeros) {
    EXPECT_EQ((CreationTime{7, 1, 2, 3, 4, 5, 6}).text(), "0007-01-02 03:04:05:006");
}

} // namespace
} // namespace fbxsdk::detail
