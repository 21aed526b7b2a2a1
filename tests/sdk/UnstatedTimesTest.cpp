// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files that omit the span of a stack or the rate of their time mode: both are derived from the keys.
#include "FixtureFiles.h"
#include "support/FacadeReads.h"
#include "support/SceneBuilders.h"
#include "support/TemporaryFolder.h"

#include "FbxSdk.h"
#include "TnFbxWriteInfo.h"

#include <cmath>
#include <fstream>
#include <iterator>
#include <string>

namespace Tarnell::Fbx {
namespace {

using namespace test;

constexpr auto kX = TnFbxTransform::kFbxTransformPositionX;

/// The text of a fixture, with every occurrence of a piece replaced; there must be one.
std::string changed(std::string text, const std::string& piece, const std::string& by) {
    EXPECT_NE(text.find(piece), std::string::npos) << piece;
    for (std::size_t at = text.find(piece); at != std::string::npos; at = text.find(piece, at + by.size()))
        text.replace(at, piece.size(), by);
    return text;
}

std::string textOf(const char* name) {
    std::ifstream in(fixture(name), std::ios::binary);
    return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

/// The range and the rate of the stack that is read.
TnFbxTime stackTime(const std::string& fileName) {
    FbxSdk sdk;
    TnFbxTime time;
    EXPECT_TRUE(Fbx().loadScene(fileName, sdk)) << lastError();
    EXPECT_TRUE(sdk.getGlobalAnimationStackTime(time, 0.0f, false, 0.0f));
    return time;
}

void expectTime(const TnFbxTime& time, int first, int last, float rate) {
    EXPECT_EQ(time.getStartFrame(), first);
    EXPECT_EQ(time.getEndFrame(), last);
    EXPECT_EQ(time.getFrameRate(), rate);
}

// ---- Spans of stacks ----

constexpr const char* kSpan[] = {"\t\t\tP: \"LocalStart\", \"KTime\", \"Time\", \"\",7389785280\n",
                                 "\t\t\tP: \"LocalStop\", \"KTime\", \"Time\", \"\",18474463200\n"};

/// The fixture of 12.5 frames per second with keys on the frames 2 and 5, and a stack that states no span.
std::string withoutSpan() { return changed(changed(textOf("custom_rate_7400_ascii.fbx"), kSpan[0], ""), kSpan[1], ""); }

std::string withoutKeys(const std::string& text) { return changed(text, "\tC: \"OP\",11,10, \"d|X\"\n", ""); }

TEST(StackWithoutSpan, HasTheSpanOfItsKeys) {
    const support::TemporaryFolder folder;
    expectTime(stackTime(folder.write("a.fbx", withoutSpan())), 2, 5, 12.5f);
}

TEST(StackWithoutSpan, HasItsReferenceSpanWithoutKeys) {
    const support::TemporaryFolder folder;
    const std::string reference = "P: \"ReferenceStart\", \"KTime\", \"Time\", \"\",3694892640\n"
                                  "P: \"ReferenceStop\", \"KTime\", \"Time\", \"\",14779570560\n";
    const std::string stack = "\"AnimStack::Take 001\", \"\" {\n\t\tProperties70:  {\n";
    const std::string text = changed(withoutSpan(), stack, stack + reference);
    expectTime(stackTime(folder.write("a.fbx", withoutKeys(text))), 1, 4, 12.5f);
    expectTime(stackTime(folder.write("b.fbx", text)), 2, 5, 12.5f);
}

TEST(StackWithoutSpan, HasThatOfTheSceneWithoutAnyOtherTime) {
    const support::TemporaryFolder folder;
    const std::string rate = "P: \"CustomFrameRate\", \"double\", \"Number\", \"\",12.5\n";
    const std::string text = changed(withoutSpan(), rate,
                                     rate + "P: \"TimeSpanStart\", \"KTime\", \"Time\", \"\",3694892640\n"
                                            "P: \"TimeSpanStop\", \"KTime\", \"Time\", \"\",36948926400\n");
    expectTime(stackTime(folder.write("a.fbx", withoutKeys(text))), 1, 10, 12.5f);
    expectTime(stackTime(folder.write("b.fbx", withoutKeys(withoutSpan()))), 0, 0, 12.5f);
}

TEST(StackWithoutSpan, LeavesAStatedOneAlone) {
    const support::TemporaryFolder folder;
    const std::string text = textOf("custom_rate_7400_ascii.fbx");
    // a writer omits what is the default
    expectTime(stackTime(folder.write("a.fbx", changed(text, kSpan[0], ""))), 0, 5, 12.5f);
}

TEST(TakeWithoutSpan, HasTheSpanOfItsKeys) {
    const support::TemporaryFolder folder;
    for (const char* name : {"takes_6100_ascii.fbx", "takes_5800_ascii.fbx"}) {
        const std::string text =
            changed(changed(textOf(name), "LocalTime:", "OtherTime:"), "ReferenceTime:", "Nothing:");
        expectTime(stackTime(folder.write(name, text)), 0, 12, 24.0f);
    }
}

// ---- Rates of custom time modes ----

/// The result of a write at that rate: a custom time mode without a rate, and a key for each frame.
TnFbxTime writtenAndRead(float rate, int first, int last, TnFbxWriteInfo::eCompatibilityVersion version) {
    const support::TemporaryFolder folder;
    TnFbxNull null;
    null.setName("node");
    TnFbxTime time;
    time.setTime(0.0f, first, last, rate);
    std::vector<float> samples;
    for (int frame = first; frame <= last; ++frame)
        samples.push_back(static_cast<float>(frame));
    EXPECT_TRUE(null.setTransformValueAt(kX, time, samples));
    TnFbxWriteInfo info;
    info.setFileName(folder.file("a.fbx"));
    info.setAnimationStackName("any");
    info.setFPS(rate);
    info.setCompatibilityVersion(version);
    EXPECT_TRUE(Fbx().writeFile(info, {}, {}, {}, {&null}, {})) << lastError();
    FacadeRead<TnFbxNull> nulls(localRead(folder.file("a.fbx")));
    const TnFbxTime read = nulls["node"].getTransformTime(kX);
    for (int frame = first; frame <= last && read.getStartFrame() == first; ++frame)
        EXPECT_NEAR(nulls["node"].getTransformValueAt(kX, static_cast<float>(frame)), static_cast<float>(frame), 1e-3f);
    return read;
}

TEST(CustomRate, ComesBackFromAFileThatDoesNotStateIt) {
    for (const auto version : {TnFbxWriteInfo::kFbxVersion2010, TnFbxWriteInfo::kFbxVersion2014}) {
        for (const float rate : {29.97f, 12.0f, 15.0f, 90.0f}) {
            expectTime(writtenAndRead(rate, 1, 20, version), 1, 20, rate);
            expectTime(writtenAndRead(rate, 1001, 1040, version), 1001, 1040, rate);
        }
    }
}

/// The fixture of 12.5 frames per second without its rate, with keys at other times.
std::string withKeysAt(const std::string& first, const std::string& last) {
    const std::string text = changed(textOf("custom_rate_7400_ascii.fbx"),
                                     "\t\tP: \"CustomFrameRate\", \"double\", \"Number\", \"\",12.5\n", "");
    return changed(text, "a: 7389785280,18474463200", "a: " + first + "," + last);
}

TEST(CustomRate, IsWorkedOutWithAWarning) {
    const support::TemporaryFolder folder;
    const std::string file = folder.write("a.fbx", withKeysAt("0", "3694892640"));
    FacadeRead<TnFbxNull> nulls(localRead(file));

    EXPECT_EQ(nulls["node"].getTransformTime(kX).getFrameRate(), 12.5f);
    EXPECT_EQ(lastWarnings(),
              std::vector<std::string>{file + ": the time mode is custom, but states no frame rate; 12.5 frames per "
                                              "second were derived from its times"});
}

TEST(CustomRate, IsThirtyWhereNothingTellsAnother) {
    const support::TemporaryFolder folder;
    const std::string file = folder.write("a.fbx", withKeysAt("1", "3"));
    FacadeRead<TnFbxNull> nulls(localRead(file));

    ASSERT_EQ(lastWarnings().size(), 1U);
    EXPECT_NE(lastWarnings()[0].find("30 frames per second are assumed"), std::string::npos);
}

TEST(CustomRate, OfAFileThatStatesItIsNoWarning) {
    FacadeRead<TnFbxNull> nulls(fixture("custom_rate_7400_ascii.fbx"));

    EXPECT_TRUE(lastWarnings().empty());
}

// ---- Texts of other systems ----

TEST(TextOfAnotherSystem, IsReadWithCarriageReturnsForLineEnds) {
    const support::TemporaryFolder folder;
    const std::string file = folder.write("a.fbx", changed(textOf("custom_rate_7400_ascii.fbx"), "\n", "\r"));
    FacadeRead<TnFbxNull> nulls(localRead(file));

    EXPECT_EQ(nulls["node"].getTransformValueAt(kX, 5.0f), 3.0f);
}

TEST(TextOfAnotherSystem, IsRefusedWithDecimalCommas) {
    const support::TemporaryFolder folder;
    const std::string file = folder.write("a.fbx", changed(textOf("custom_rate_7400_ascii.fbx"), "12.5", "12,5"));
    TnFbxReadInfo info = localRead(file);
    TnFbxNull* nulls = nullptr;
    int count = 0;

    EXPECT_FALSE(Fbx().getNulls(info, &nulls, count));
    EXPECT_EQ(lastError(), file + ": line 14: the property \"CustomFrameRate\" has more numbers than its type allows");
}

// Wherever an ASCII file ends, reading it gives its node or a reason.
TEST(TextThatIsCutOff, IsNeverAnEmptyScene) {
    const support::TemporaryFolder folder;
    const std::string text = textOf("custom_rate_7400_ascii.fbx");
    const std::size_t objects = text.find("Objects:"), connections = text.find("Connections:");
    for (std::size_t size = objects + 10; size < connections; ++size) {
        TnFbxReadInfo info = localRead(folder.write("a.fbx", text.substr(0, size)));
        TnFbxNull* nulls = nullptr;
        int count = 0;
        const bool whole = size > text.rfind('}', connections); // the last section ended
        EXPECT_EQ(Fbx().getNulls(info, &nulls, count), whole) << size;
        delete[] nulls;
    }
}

} // namespace
} // namespace Tarnell::Fbx
