// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The display form of untrusted texts.
#include "calls/Printable.h"

#include <gtest/gtest.h>

#include "calls/LastError.h"

#include "TnFbxError.h"

namespace Tarnell::Fbx {
namespace {

using detail::printable;

TEST(Printable, LeavesOrdinaryTextAsItIs) {
    for (const char* text : {"", "pCube1", "Würfel \xE7\xAB\x8B\xE6\x96\xB9 \xF0\x9F\x8E\xA5", "a\\b\"c"})
        EXPECT_EQ(printable(text), text);
}

TEST(Printable, EscapesWhatATerminalObeys) {
    EXPECT_EQ(printable("\x1B]0;owned\x07"), "\\x1B]0;owned\\x07");
    EXPECT_EQ(printable(std::string("a\0b\r\n\x7F", 6)), "a\\x00b\\x0D\\x0A\\x7F");
    EXPECT_EQ(printable("\xC2\x9B"
                        "31m"),
              "\\u009B31m");
    EXPECT_EQ(printable("\xE2\x80\xAEtxt.exe"), "\\u202Etxt.exe");
}

TEST(Printable, EscapesBytesThatAreNoUtf8) {
    EXPECT_EQ(printable("\x9B"
                        "31m"),
              "\\x9B31m");
    EXPECT_EQ(printable("\xC3"), "\\xC3");
    EXPECT_EQ(printable("\xC0\x9B"), "\\xC0\\x9B");          // longer than need be
    EXPECT_EQ(printable("\xED\xA0\x80"), "\\xED\\xA0\\x80"); // half of a pair
    EXPECT_EQ(printable("\xF5\x80\x80\x80"), "\\xF5\\x80\\x80\\x80");
    EXPECT_EQ(printable("\xE2\x28\xA1"), "\\xE2(\\xA1");
}

TEST(Printable, KeepsLinesWhereItIsToldTo) { EXPECT_EQ(printable("a\nb\r\n", true), "a\nb\\x0D\n"); }

TEST(Printable, IsWhatErrorsAndWarningsAre) {
    const detail::CallScope call;
    detail::fail("node \x1B[2J: missing");
    detail::warn("node \x1B[2J: empty");
    EXPECT_EQ(lastError(), "node \\x1B[2J: missing");
    EXPECT_EQ(lastWarnings(), std::vector<std::string>{"node \\x1B[2J: empty"});
}

} // namespace
} // namespace Tarnell::Fbx
