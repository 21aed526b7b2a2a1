// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What both sinks write, the readers read back: every type of value, in every layout.
#include "container/RecordSink.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <functional>
#include <limits>
#include <new>
#include <random>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <fbxsdk/extensions/Threads.h>

#include "support/RecordText.h"
#include "support/SinkOutput.h"

namespace fbxsdk::detail {
namespace {

using support::Container;
using support::sinkBytes;

struct Layout {
    Container container;
    std::uint32_t version;
};

void PrintTo(const Layout& layout, std::ostream* stream) {
    *stream << (layout.container == Container::ascii ? "ASCII " : "binary ") << layout.version;
}

/// A tree together with the bytes it points to.
struct ReadBack {
    std::string bytes;
    std::unique_ptr<RecordTree> tree;
};

class SinkLayout : public testing::TestWithParam<Layout> {
protected:
    [[nodiscard]] static std::string bytesOf(const support::Emit& emit) {
        return sinkBytes(GetParam().container, GetParam().version, emit);
    }
    /// The first record of the output.
    const Record& readBack(const support::Emit& emit) {
        mBytes = bytesOf(emit);
        FbxStatus status;
        mTree = readRecords(std::span<const char>(mBytes), "test.fbx", status);
        EXPECT_TRUE(mTree) << status.GetErrorString();
        static const Record kNone;
        return mTree && mTree->root.firstChild ? *mTree->root.firstChild : kNone;
    }
    template <class Number>
    std::vector<Number> arrayBack(const std::vector<Number>& numbers) {
        const Record& record = readBack([&](RecordSink& sink) {
            sink.beginRecord("A");
            sink.array(std::span(numbers));
            sink.endRecord();
        });
        std::vector<Number> back(record.numberCount());
        EXPECT_TRUE(record.readNumbers(std::span(back)));
        return back;
    }
    [[nodiscard]] const RecordTree& tree() const { return *mTree; }
    [[nodiscard]] static bool isBinary() { return GetParam().container == Container::binary; }

private:
    std::string mBytes;
    std::unique_ptr<RecordTree> mTree;
};

const auto kLayouts =
    testing::Values(Layout{Container::binary, 6100}, Layout{Container::binary, 7100}, Layout{Container::binary, 7400},
                    Layout{Container::binary, 7500}, Layout{Container::ascii, 6100}, Layout{Container::ascii, 7100},
                    Layout{Container::ascii, 7200}, Layout{Container::ascii, 7500});
INSTANTIATE_TEST_SUITE_P(EveryLayout, SinkLayout, kLayouts);

TEST_P(SinkLayout, StatesItsVersion) {
    readBack([](RecordSink&) {});

    EXPECT_EQ(tree().version, GetParam().version);
    EXPECT_EQ(tree().ascii, !isBinary());
    EXPECT_EQ(tree().root.firstChild, nullptr);
}

TEST_P(SinkLayout, KeepsEveryKindOfWholeNumberAtItsLimits) {
    const Record& record = readBack([](RecordSink& sink) {
        sink.beginRecord("N");
        sink.byte(255);
        sink.shortInteger(-32768);
        sink.integer(std::numeric_limits<std::int32_t>::min());
        sink.longInteger(std::numeric_limits<std::int64_t>::min());
        sink.longInteger(std::numeric_limits<std::int64_t>::max());
        sink.endRecord();
    });

    ASSERT_EQ(record.values.size(), 5U);
    EXPECT_EQ(record.value(0).toInteger(), 255);
    EXPECT_EQ(record.value(1).toInteger(), -32768);
    EXPECT_EQ(record.value(2).toInteger(), -2147483648LL);
    EXPECT_EQ(record.value(3).toInteger(), std::numeric_limits<std::int64_t>::min());
    EXPECT_EQ(record.value(4).toInteger(), std::numeric_limits<std::int64_t>::max());
}

TEST_P(SinkLayout, KeepsTheBitsOfReals) {
    std::mt19937_64 random(7);
    std::vector<double> numbers{0.0, -0.0, 1.0 / 3, 5e-324, std::numeric_limits<double>::max(), 25.114999771118164};
    while (numbers.size() < 1000) {
        const auto number = std::bit_cast<double>(random());
        if (std::isfinite(number))
            numbers.push_back(number);
    }

    const std::vector<double> back = arrayBack(numbers);

    ASSERT_EQ(back.size(), numbers.size());
    for (std::size_t i = 0; i < numbers.size(); ++i)
        EXPECT_EQ(std::bit_cast<std::uint64_t>(back[i]), std::bit_cast<std::uint64_t>(numbers[i])) << i;
}

TEST_P(SinkLayout, KeepsTheBitsOfFloats) {
    std::mt19937 random(7);
    std::vector<float> numbers{0.0F, -0.0F, 1.0F / 3, 1e-45F, std::numeric_limits<float>::max()};
    while (numbers.size() < 1000) {
        const auto number = std::bit_cast<float>(static_cast<std::uint32_t>(random()));
        if (std::isfinite(number))
            numbers.push_back(number);
    }

    const std::vector<float> back = arrayBack(numbers);

    ASSERT_EQ(back.size(), numbers.size());
    for (std::size_t i = 0; i < numbers.size(); ++i)
        EXPECT_EQ(std::bit_cast<std::uint32_t>(back[i]), std::bit_cast<std::uint32_t>(numbers[i])) << i;
}

TEST_P(SinkLayout, KeepsArraysOfWholeNumbers) {
    std::vector<std::int32_t> small;
    std::vector<std::int64_t> large;
    for (std::int32_t i = -500; i < 500; ++i) {
        small.push_back(i * 4000000);
        large.push_back(i * std::int64_t{18446744073709551});
    }

    EXPECT_EQ(arrayBack(small), small);
    EXPECT_EQ(arrayBack(large), large);
}

TEST_P(SinkLayout, KeepsArraysOfBooleans) {
    const std::vector<std::uint8_t> flags{1, 0, 0, 1, 1};

    const Record& record = readBack([&](RecordSink& sink) {
        sink.beginRecord("B");
        sink.array(std::span(flags));
        sink.endRecord();
    });

    std::vector<std::int32_t> back(record.numberCount());
    ASSERT_TRUE(record.readNumbers(std::span(back)));
    EXPECT_EQ(back, std::vector<std::int32_t>({1, 0, 0, 1, 1}));
}

TEST_P(SinkLayout, KeepsArraysWithoutElements) {
    EXPECT_TRUE(arrayBack(std::vector<double>()).empty());
    EXPECT_TRUE(arrayBack(std::vector<std::int32_t>()).empty());
}

TEST_P(SinkLayout, KeepsTheBitsOfPackedKeyData) {
    const std::vector<std::uint32_t> words{0, 0x3F800000, 0x0D050D05, 0x26AB26AB, 0x80000000, 0x00000001};

    const Record& record = readBack([&](RecordSink& sink) {
        sink.beginRecord("KeyAttrDataFloat");
        sink.floatBits(words);
        sink.endRecord();
    });

    std::vector<std::uint32_t> back(record.numberCount());
    ASSERT_TRUE(record.readFloatBits(back));
    EXPECT_EQ(back, words);
}

TEST_P(SinkLayout, KeepsTextsWithQuotesColonsLineBreaksAndNothing) {
    const std::string texts[] = {"",
                                 "plain",
                                 "a \"quoted\" one",
                                 "first\nsecond\r\nthird",
                                 "C:\\folder\\x",
                                 "a::b; c",
                                 "{ not, a: block",
                                 "größe 寸法 🎥",
                                 "&amp; & &lt;"};

    const Record& record = readBack([&](RecordSink& sink) {
        sink.beginRecord("T");
        for (const std::string& text : texts) {
            sink.text(text);
        }
        sink.endRecord();
    });

    ASSERT_EQ(record.values.size(), std::size(texts));
    for (std::size_t i = 0; i < std::size(texts); ++i)
        EXPECT_EQ(record.value(i).toText(), texts[i]);
}

TEST_P(SinkLayout, KeepsLetters) {
    const Record& record = readBack([](RecordSink& sink) {
        sink.beginRecord("Shading");
        sink.letter('T');
        sink.endRecord();
    });

    EXPECT_EQ(record.value(0).toLetter(), 'T');
}

TEST_P(SinkLayout, PutsTheClassBeforeOrBehindTheName) {
    const Record& record = readBack([](RecordSink& sink) {
        sink.beginRecord("Model");
        sink.objectName("Model", "a \"b\"::c");
        sink.objectName("NodeAttribute", "");
        sink.endRecord();
    });

    using namespace std::string_view_literals;
    EXPECT_EQ(record.value(0).toText(), isBinary() ? "a \"b\"::c\0\1Model"sv : "Model::a \"b\"::c"sv);
    EXPECT_EQ(record.value(1).toText(), isBinary() ? "\0\1NodeAttribute"sv : "NodeAttribute::"sv);
}

TEST_P(SinkLayout, KeepsTheNestingAndEmptyBlocks) {
    const std::string text = readText(bytesOf([](RecordSink& sink) {
        sink.beginRecord("References");
        sink.beginBlock();
        sink.endRecord();
        sink.beginRecord("Objects");
        sink.beginBlock();
        sink.beginRecord("Model");
        sink.longInteger(17);
        sink.beginBlock();
        sink.beginRecord("Version");
        sink.integer(232);
        sink.endRecord();
        sink.beginRecord("Nothing");
        sink.endRecord();
        sink.endRecord();
        sink.beginRecord("After");
        sink.text("it");
        sink.endRecord();
        sink.endRecord();
    }));

    EXPECT_EQ(text, "References: { } Objects: { Model: 17 { Version: 232 Nothing: } After: \"it\" }");
}

TEST_P(SinkLayout, GivesTheSameBytesAgain) {
    const auto emit = [](RecordSink& sink) {
        sink.heading("Heading");
        sink.beginRecord("A");
        sink.array(std::span<const double>(std::vector<double>(5000, 1.5)));
        sink.endRecord();
    };

    EXPECT_EQ(bytesOf(emit), bytesOf(emit));
}

TEST_P(SinkLayout, WritesListsOfAHundredThousandElements) {
    std::vector<double> numbers(100000);
    for (std::size_t i = 0; i < numbers.size(); ++i)
        numbers[i] = static_cast<double>(i) / 7;

    EXPECT_EQ(arrayBack(numbers), numbers);
}

// ---- Repeated records ----

void emitLines(RecordSink& sink) {
    for (const std::int32_t number : {1, 2}) {
        sink.beginRecord("Line");
        sink.text("name");
        sink.integer(number);
        sink.real(0.5);
        sink.endRecord();
    }
}

/// Calls in a block and in a block of a block, so many times that the records exceed what a sink keeps in memory.
std::string bytesOfNestedLines(const std::function<std::string(const support::Emit&)>& bytesOf,
                               const std::function<void(RecordSink&)>& outer,
                               const std::function<void(RecordSink&)>& inner) {
    return bytesOf([&](RecordSink& sink) {
        sink.beginRecord("Outer");
        sink.beginBlock();
        for (int i = 0; i < 3000; ++i) {
            outer(sink);
            sink.beginRecord("Inner");
            sink.beginBlock();
            inner(sink);
            sink.endRecord();
        }
        sink.endRecord();
    });
}

TEST_P(SinkLayout, RepeatsEncodedRecordsAsIfTheyWereWrittenAgain) {
    RecordSink::EncodedRecords outer, inner;
    const auto repeat = [](RecordSink& sink, RecordSink::EncodedRecords& records) {
        if (records.bytes.empty())
            records = sink.encoded(emitLines);
        sink.repeat(records);
    };

    const std::string repeated = bytesOfNestedLines(
        bytesOf, [&](RecordSink& sink) { repeat(sink, outer); }, [&](RecordSink& sink) { repeat(sink, inner); });

    EXPECT_TRUE(repeated == bytesOfNestedLines(bytesOf, emitLines, emitLines));
}

// ---- Several threads ----

struct SinkThreads : SinkLayout {
    ~SinkThreads() override { extensions::setMaximumThreads(1); }

    static std::string bytesWith(int threads, const support::Emit& emit) {
        extensions::setMaximumThreads(threads);
        return bytesOf(emit);
    }
};
INSTANTIATE_TEST_SUITE_P(EveryLayout, SinkThreads, kLayouts);

/// A record with a block, open as long as the object exists.
class Block {
public:
    Block(RecordSink& sink, std::string_view name) : mSink(sink) {
        sink.beginRecord(name);
        sink.beginBlock();
    }
    Block(const Block&) = delete;
    Block& operator=(const Block&) = delete;
    ~Block() { mSink.endRecord(); }

private:
    RecordSink& mSink;
};

void emitInteger(RecordSink& sink, std::int32_t number) {
    sink.beginRecord("Integer");
    sink.integer(number);
    sink.endRecord();
}

template <class Number>
void emitArray(RecordSink& sink, const std::vector<Number>& numbers) {
    sink.beginRecord("Array");
    sink.array(std::span<const Number>(numbers));
    sink.endRecord();
}

std::vector<double> noise(std::size_t size, unsigned seed) {
    std::mt19937 random(seed);
    std::vector<double> numbers(size);
    std::generate(numbers.begin(), numbers.end(), [&] { return static_cast<double>(random() % 4096) / 16; });
    return numbers;
}

/// Objects with arrays of all sizes, records before, between and behind them, and values beside them.
void emitObjects(RecordSink& sink) {
    const Block objects(sink, "Objects");
    for (unsigned i = 0; i < 60; ++i) {
        const Block object(sink, "Object");
        emitInteger(sink, static_cast<std::int32_t>(i));
        sink.beginRecord("Numbers");
        sink.text("first");
        sink.array(std::span<const double>(noise(i * i * 3, i)));
        sink.array(std::span<const std::int32_t>(std::vector<std::int32_t>(i * 40, 7)));
        sink.integer(5);
        if (i % 2 == 0) {
            sink.beginBlock();
            emitArray(sink, std::vector<float>(i * 100, 0.5F));
        }
        sink.endRecord();
        const Block empty(sink, "Empty");
    }
}

TEST_P(SinkThreads, WriteTheSameBytesWhateverTheirNumber) {
    const std::string one = bytesWith(1, emitObjects);

    for (const int threads : {2, 3, 5})
        EXPECT_TRUE(bytesWith(threads, emitObjects) == one) << threads;
}

TEST_P(SinkThreads, WriteManyRecordsBehindAnArray) {
    const auto emit = [](RecordSink& sink) {
        const Block objects(sink, "Objects");
        emitArray(sink, noise(300000, 1));
        for (int i = 0; i < 200000; ++i)
            emitInteger(sink, i);
    };

    EXPECT_TRUE(bytesWith(3, emit) == bytesWith(1, emit));
}

TEST_P(SinkThreads, RepeatRecordsBehindAnArray) {
    const auto emit = [](RecordSink& sink) {
        const Block objects(sink, "Objects");
        const RecordSink::EncodedRecords lines = sink.encoded(emitLines);
        emitArray(sink, noise(30000, 1));
        sink.repeat(lines);
    };

    EXPECT_TRUE(bytesWith(3, emit) == bytesWith(1, emit));
}

TEST_P(SinkThreads, EndWhenTheWriterGivesUp) {
    const auto emit = [](RecordSink& sink) {
        emitObjects(sink);
        throw std::bad_alloc();
    };

    EXPECT_THROW(static_cast<void>(bytesWith(3, emit)), std::bad_alloc);
}

} // namespace
} // namespace fbxsdk::detail
