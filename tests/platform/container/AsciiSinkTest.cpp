// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// ASCII files, character by character: readers that parse line by line depend on the layout.
#include "container/AsciiSink.h"

#include <limits>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/RecordText.h"
#include "support/SinkOutput.h"

namespace fbxsdk::detail {
namespace {

using support::Container;
using support::sinkBytes;

/// The content after the three lines of the header.
std::string asciiBody(std::uint32_t version, const support::Emit& emit) {
    const std::string text = sinkBytes(Container::ascii, version, emit);
    return text.substr(text.find("\n\n") + 2);
}

std::string valuesOf(const std::function<void(RecordSink&)>& values, std::uint32_t version = 7400) {
    const std::string line = asciiBody(version, [&](RecordSink& sink) {
        sink.beginRecord("V");
        values(sink);
        sink.endRecord();
    });
    return line.substr(3, line.size() - 4);
}

TEST(AsciiSink, BeginsWithTheVersion) {
    EXPECT_EQ(sinkBytes(Container::ascii, 7500, [](RecordSink&) {}),
              "; FBX 7.5.0 project file\n; ----------------------------------------------------\n\n");
    EXPECT_EQ(sinkBytes(Container::ascii, 6100, [](RecordSink&) {}).substr(0, 25), "; FBX 6.1.0 project file\n");
}

TEST(AsciiSink, IndentsByATabPerLevel) {
    const std::string text = asciiBody(7400, [](RecordSink& sink) {
        sink.beginRecord("Objects");
        sink.beginBlock();
        sink.beginRecord("Model");
        sink.longInteger(17);
        sink.objectName("Model", "cube");
        sink.text("Mesh");
        sink.beginBlock();
        sink.beginRecord("Version");
        sink.integer(232);
        sink.endRecord();
        sink.beginRecord("Properties70");
        sink.beginBlock();
        sink.endRecord();
        sink.endRecord();
        sink.endRecord();
    });

    EXPECT_EQ(text, "Objects:  {\n"
                    "\tModel: 17, \"Model::cube\", \"Mesh\" {\n"
                    "\t\tVersion: 232\n"
                    "\t\tProperties70:  {\n"
                    "\t\t}\n"
                    "\t}\n"
                    "}\n");
}

TEST(AsciiSink, PutsABlankBeforeTextsOnly) {
    EXPECT_EQ(valuesOf([](RecordSink& sink) {
                  sink.text("UpAxis");
                  sink.text("int");
                  sink.text("");
                  sink.integer(1);
                  sink.real(0.5);
                  sink.text("end");
              }),
              "\"UpAxis\", \"int\", \"\",1,0.5, \"end\"");
}

TEST(AsciiSink, WritesNumbersInTheShortestForm) {
    EXPECT_EQ(valuesOf([](RecordSink& sink) {
                  sink.real(0.1);
                  sink.real(1.0 / 3);
                  sink.real(-0.0);
                  sink.real(25.114999771118164);
                  sink.real(1e300);
                  sink.singleReal(0.1F);
              }),
              "0.1,0.3333333333333333,-0,25.114999771118164,1e+300,0.1");
}

TEST(AsciiSink, WritesZeroForWhatIsNoNumber) {
    EXPECT_EQ(valuesOf([](RecordSink& sink) {
                  sink.real(std::numeric_limits<double>::quiet_NaN());
                  sink.real(-std::numeric_limits<double>::infinity());
                  sink.singleReal(std::numeric_limits<float>::infinity());
              }),
              "0,0,0");
}

TEST(AsciiSink, WritesArraysBehindTheirCount) {
    const std::string text = asciiBody(7400, [](RecordSink& sink) {
        sink.beginRecord("Geometry");
        sink.beginBlock();
        sink.beginRecord("Vertices");
        sink.array(std::span<const double>(std::vector<double>{0, 1.5, -2}));
        sink.endRecord();
        sink.endRecord();
    });

    EXPECT_EQ(text, "Geometry:  {\n"
                    "\tVertices: *3 {\n"
                    "\t\ta: 0,1.5,-2\n"
                    "\t} \n"
                    "}\n");
}

TEST(AsciiSink, WritesArraysOfOlderVersionsAsPlainLists) {
    EXPECT_EQ(valuesOf(
                  [](RecordSink& sink) {
                      sink.array(std::span<const std::int32_t>(std::vector<std::int32_t>{0, 1, -3}));
                  },
                  6100),
              "0,1,-3");
}

TEST(AsciiSink, BreaksLongArraysBehindAComma) {
    const std::string text =
        valuesOf([](RecordSink& sink) { sink.array(std::span<const double>(std::vector<double>(3000, 0.25))); });

    std::istringstream lines(text);
    std::string line;
    std::size_t longest = 0;
    while (std::getline(lines, line)) {
        longest = std::max(longest, line.size());
        EXPECT_NE(line.front(), ',');
    }
    EXPECT_GT(longest, 2000U);
    EXPECT_LT(longest, 2100U);
}

TEST(AsciiSink, BreaksLongListsOfOlderVersionsBeforeAComma) {
    const std::string text =
        valuesOf([](RecordSink& sink) { sink.array(std::span<const double>(std::vector<double>(200, 0.25))); }, 6100);

    std::istringstream lines(text);
    std::string line;
    std::getline(lines, line);
    EXPECT_LT(line.size(), 130U);
    while (std::getline(lines, line)) {
        EXPECT_EQ(line.substr(0, 15), "             ,0");
        EXPECT_LT(line.size(), 130U);
    }
}

TEST(AsciiSink, SpellsPackedKeyDataAsWholeNumbersFrom7200On) {
    const std::vector<std::uint32_t> words{218434821, 0x80000000};
    const auto emit = [&](RecordSink& sink) { sink.floatBits(words); };

    EXPECT_EQ(valuesOf(emit, 7200), "*2 {\n\ta: 218434821,-2147483648\n} ");
    EXPECT_EQ(valuesOf(emit, 7100), "*2 {\n\ta: 4.099946e-31,-0\n} ");
}

TEST(AsciiSink, EscapesQuotesAndLineBreaksAndNothingElse) {
    EXPECT_EQ(valuesOf([](RecordSink& sink) { sink.text("a\"b\nc\rd&e\\f\tg"); }), "\"a&quot;b&lf;c&cr;d&e\\f\tg\"");
}

TEST(AsciiSink, WritesBytesAsBase64) {
    EXPECT_EQ(valuesOf([](RecordSink& sink) { sink.raw(std::string_view("light work.")); }),
              ",\n \"bGlnaHQgd29yay4=\"");
    EXPECT_EQ(valuesOf([](RecordSink& sink) { sink.raw(std::string_view("light work")); }), ",\n \"bGlnaHQgd29yaw==\"");
    EXPECT_EQ(valuesOf([](RecordSink& sink) { sink.raw(std::string_view("light wor")); }), ",\n \"bGlnaHQgd29y\"");
}

TEST(AsciiSink, WritesHeadingsAsComments) {
    EXPECT_EQ(asciiBody(
                  7400, [](RecordSink& sink) { sink.heading("Object properties"); }),
              "\n; Object properties\n;------------------------------------------------------------------\n\n");
}

} // namespace
} // namespace fbxsdk::detail
