// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Arrays whose items stay with their source as long as only values are read. The source of these tests
// overwrites what is released, so that reading it does not go unnoticed.
#include <fbxsdk/FbxPlainArray.h>

#include <algorithm>
#include <cstring>
#include <numeric>
#include <random>
#include <stdexcept>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "geometry/StoredItems.h"
#include "support/BinaryRecordBuilder.h"
#include "support/TemporaryFolder.h"

namespace fbxsdk::detail {
namespace {

using testing::ElementsAre;

struct Calls {
    std::size_t spoiled = 0; ///< released bytes
    int restored = 0;
    bool gone = false;
};

class SpoilingBytes final : public StoredBytes {
public:
    SpoilingBytes(std::vector<char> bytes, Calls& calls)
        : mBytes(std::move(bytes)), mOriginal(mBytes), mThere(mBytes.size(), 1), mCalls(calls) {}
    ~SpoilingBytes() override { mCalls.gone = true; }

    std::span<const char> bytes() const override { return mBytes; }
    void release(std::span<const char> part) override {
        const auto first = static_cast<std::size_t>(part.data() - mBytes.data());
        ASSERT_LE(first + part.size(), mBytes.size());
        std::fill_n(mBytes.begin() + static_cast<std::ptrdiff_t>(first), part.size(), '\x7F');
        std::fill_n(mThere.begin() + static_cast<std::ptrdiff_t>(first), part.size(), '\0');
        mCalls.spoiled = static_cast<std::size_t>(std::count(mThere.begin(), mThere.end(), '\0'));
    }
    void restore() override {
        std::copy(mOriginal.begin(), mOriginal.end(), mBytes.begin());
        std::fill(mThere.begin(), mThere.end(), '\1');
        mCalls.spoiled = 0;
        ++mCalls.restored;
    }

private:
    std::vector<char> mBytes, mOriginal, mThere;
    Calls& mCalls;
};

template <class Item, class Number>
void keep(PlainArray<Item>& array, const std::vector<Number>& numbers, Calls& calls) {
    std::vector<char> bytes(numbers.size() * sizeof(Number));
    std::memcpy(bytes.data(), numbers.data(), bytes.size());
    const int count = static_cast<int>(bytes.size() / kStoredBytes<Item>);
    array.setSource(
        std::make_unique<StoredItems<Item>>(std::make_unique<SpoilingBytes>(std::move(bytes), calls), count));
}

std::vector<int> upTo(int count) {
    std::vector<int> numbers(static_cast<std::size_t>(count));
    std::iota(numbers.begin(), numbers.end(), 0);
    return numbers;
}

constexpr int kMany = 1'000'000;
constexpr std::size_t kManyBytes = kMany * sizeof(int);

TEST(StoredItems, AreGivenUpBehindAReaderInOrder) {
    Calls calls;
    PlainArray<int> array;
    keep(array, upTo(kMany), calls);

    for (int i = 0; i < kMany / 2; ++i)
        ASSERT_EQ(array.value(i), i);
    EXPECT_GT(calls.spoiled, kManyBytes / 4);
    for (int i = kMany / 2; i < kMany; ++i)
        ASSERT_EQ(array.value(i), i);

    EXPECT_GT(calls.spoiled, kManyBytes / 8 * 7);
    EXPECT_EQ(calls.restored, 0);
}

TEST(StoredItems, AreGivenUpAlsoWhenTheyAreFew) {
    for (const int count : {100, 1000, 10000}) {
        Calls calls;
        PlainArray<int> array;
        keep(array, upTo(count), calls);

        for (int i = 0; i < count; ++i)
            ASSERT_EQ(array.value(i), i);

        EXPECT_GT(calls.spoiled, static_cast<std::size_t>(count) * sizeof(int) / 8 * 7) << count;
    }
}

TEST(StoredItems, AreReadInRuns) {
    Calls calls;
    PlainArray<int> array;
    keep(array, upTo(kMany), calls);

    for (int i = 0; i < kMany;) {
        const ItemRun run = array.run(i);
        ASSERT_TRUE(run.contains(i));
        ASSERT_EQ(run.itemBytes, sizeof(int));
        for (; run.contains(i); ++i) {
            int item = -1;
            std::memcpy(&item, run.at(i), sizeof item);
            ASSERT_EQ(item, i);
        }
    }

    EXPECT_GT(calls.spoiled, kManyBytes / 8 * 7);
    EXPECT_EQ(calls.restored, 0);
}

TEST(StoredItems, AreOneRunWhenTheyAreInMemory) {
    Calls calls;
    PlainArray<FbxVector4> array;
    keep(array, std::vector<double>{1, 2, 3, 4, 5, 6}, calls);
    EXPECT_EQ(array.run(1).itemBytes, 3 * sizeof(double)) << "in the file";

    array[0] = FbxVector4(7, 8, 9, 10);

    const ItemRun run = array.run(1);
    EXPECT_EQ(run.first, 0);
    EXPECT_EQ(run.count, 2);
    EXPECT_EQ(run.itemBytes, sizeof(FbxVector4));
    EXPECT_FALSE(run.contains(2));
    EXPECT_FALSE(run.contains(-1));
    double w = 0.0;
    std::memcpy(&w, run.at(0) + 3 * sizeof(double), sizeof w);
    EXPECT_EQ(w, 10.0);
}

TEST(StoredItems, ComeAgainForAReaderWhoStartsOver) {
    Calls calls;
    PlainArray<int> array;
    keep(array, upTo(kMany), calls);

    for (int round = 0; round < 3; ++round)
        for (int i = 0; i < kMany; ++i)
            ASSERT_EQ(array.value(i), i) << round;
    EXPECT_EQ(calls.restored, 2);
}

TEST(StoredItems, AreGivenUpBehindAReaderWhoGoesBackALittle) {
    Calls calls;
    PlainArray<int> array;
    keep(array, upTo(kMany), calls);

    for (int i = 0; i + 1000 < kMany; ++i) { // as the corners of a grid do
        ASSERT_EQ(array.value(i + 1000), i + 1000);
        ASSERT_EQ(array.value(i), i);
    }

    EXPECT_GT(calls.spoiled, kManyBytes / 8 * 7);
    EXPECT_EQ(calls.restored, 0);
}

TEST(StoredItems, StayForAReaderWithoutOrder) {
    Calls calls;
    PlainArray<int> array;
    keep(array, upTo(kMany), calls);
    std::mt19937 random(5);

    for (int i = 0; i < 10000; ++i) {
        const int index = static_cast<int>(random() % kMany);
        ASSERT_EQ(array.value(index), index);
    }

    EXPECT_EQ(calls.spoiled, 0U);
    EXPECT_LE(calls.restored, 1);
}

TEST(StoredItems, HaveTheirValuesWhateverTheOrder) {
    std::mt19937 random(7);
    for (int round = 0; round < 200; ++round) {
        const int count = 1 + static_cast<int>(random() % 5000);
        Calls calls;
        PlainArray<int> array;
        keep(array, upTo(count), calls);
        int index = 0;
        for (int i = 0; i < 3 * count; ++i) {
            ASSERT_EQ(array.value(index), index) << count;
            const int kind = static_cast<int>(random() % 100);
            const int jump = static_cast<int>(random() % static_cast<unsigned>(count));
            index = kind == 0 ? jump : kind == 1 ? 0 : kind == 2 ? count - 1 : kind < 20 ? index - kind : index + 1;
            index = std::clamp(index, 0, count - 1);
        }
    }
}

TEST(StoredItems, OfOneOrTwoAreReadAsAnyOthers) {
    for (const int count : {1, 2, 3}) {
        Calls calls;
        PlainArray<int> array;
        keep(array, upTo(count), calls);
        for (int round = 0; round < 2; ++round)
            for (int i = count - 1; i >= 0; --i)
                EXPECT_EQ(array.value(i), i);
    }
}

TEST(StoredItems, GetTheWThatFilesDoNotHave) {
    Calls calls;
    PlainArray<FbxVector4> array;
    keep(array, std::vector<double>{1, 2, 3, 4, 5, 6}, calls);

    ASSERT_EQ(array.count(), 2);
    EXPECT_EQ(array.value(1), FbxVector4(4, 5, 6, 1));
    EXPECT_EQ(array[0], FbxVector4(1, 2, 3, 1));
    EXPECT_EQ(array[1], FbxVector4(4, 5, 6, 1));
}

TEST(StoredItems, ComeIntoMemoryForAPointerAndStayAsTheyAreChanged) {
    Calls calls;
    PlainArray<int> array;
    keep(array, upTo(kMany), calls);
    for (int i = 0; i < kMany; ++i)
        ASSERT_EQ(array.value(i), i); // releases most of them

    int* const items = array.data();
    ASSERT_TRUE(std::equal(items, items + kMany, upTo(kMany).begin()));
    EXPECT_TRUE(calls.gone);
    items[17] = -1;

    EXPECT_EQ(array.value(17), -1);
    EXPECT_EQ(array.data(), items);
}

TEST(StoredItems, CanBeAddedToInsertedAndRemoved) {
    Calls calls;
    PlainArray<int> added, inserted, removed, resized, cleared;
    for (PlainArray<int>* array : {&added, &inserted, &removed, &resized, &cleared})
        keep(*array, upTo(3), calls);

    added.add(9);
    inserted.insert(1, 9);
    removed.remove(1);
    resized.resize(5, 7);
    cleared.clear();

    const auto itemsOf = [](const PlainArray<int>& array) { return std::vector<int>(array.begin(), array.end()); };
    EXPECT_THAT(itemsOf(added), ElementsAre(0, 1, 2, 9));
    EXPECT_THAT(itemsOf(inserted), ElementsAre(0, 9, 1, 2));
    EXPECT_THAT(itemsOf(removed), ElementsAre(0, 2));
    EXPECT_THAT(itemsOf(resized), ElementsAre(0, 1, 2, 7, 7));
    EXPECT_THAT(itemsOf(cleared), ElementsAre());
    cleared.add(4);
    EXPECT_THAT(itemsOf(cleared), ElementsAre(4));
}

TEST(StoredItems, TakeThePlaceOfWhatWasThere) {
    Calls first, second;
    PlainArray<int> array;
    array.add(8);
    keep(array, upTo(3), first);
    keep(array, upTo(2), second);

    EXPECT_TRUE(first.gone);
    EXPECT_EQ(array.count(), 2);
    EXPECT_EQ(array.value(1), 1);
}

/// Three numbers that cannot be shown, and can be read from the second time on.
class ReluctantItems final : public ItemSource {
public:
    explicit ReluctantItems(Calls& calls, bool sound = true) : mCalls(calls), mSound(sound) {}
    ~ReluctantItems() override { mCalls.gone = true; }

    int count() const override { return 3; }
    std::size_t itemSize() const override { return sizeof(int); }
    bool show() override { return false; }
    bool read(void* items) override {
        if (!mAsked) {
            mAsked = true;
            throw std::runtime_error("the file was changed");
        }
        std::iota(static_cast<int*>(items), static_cast<int*>(items) + 3, 5);
        return mSound;
    }

    void moveWindow(int) override { FAIL() << "nothing is shown"; }

private:
    Calls& mCalls;
    bool mSound;
    bool mAsked = false;
};

TEST(LateItems, AreReadAtTheFirstQuestionWhateverItIs) {
    const auto read = [](auto&& ask) {
        Calls calls;
        PlainArray<int> array;
        array.setSource(std::make_unique<ReluctantItems>(calls));
        EXPECT_TRUE(array.isPending());
        EXPECT_THROW(ask(array), std::runtime_error);
        EXPECT_TRUE(array.isPending()) << "what could not be read fails again, or is there";
        EXPECT_FALSE(calls.gone);
        ask(array);
        EXPECT_FALSE(array.isPending());
        EXPECT_TRUE(calls.gone);
        return std::vector<int>(array.begin(), array.end());
    };
    EXPECT_THAT(read([](PlainArray<int>& array) { EXPECT_EQ(array.count(), 3); }), ElementsAre(5, 6, 7));
    EXPECT_THAT(read([](PlainArray<int>& array) { EXPECT_EQ(array.value(1), 6); }), ElementsAre(5, 6, 7));
    EXPECT_THAT(read([](PlainArray<int>& array) { EXPECT_TRUE(array.contains(2)); }), ElementsAre(5, 6, 7));
    EXPECT_THAT(read([](PlainArray<int>& array) { array.add(8); }), ElementsAre(5, 6, 7, 8));
    EXPECT_THAT(read([](PlainArray<int>& array) { array.remove(1); }), ElementsAre(5, 7));
    EXPECT_THAT(read([](PlainArray<int>& array) { array.reserve(9); }), ElementsAre(5, 6, 7));
}

TEST(LateItems, AreNoneWhereTheyAreCorrupt) {
    Calls calls;
    PlainArray<int> array;
    array.setSource(std::make_unique<ReluctantItems>(calls, /*sound*/ false));
    EXPECT_THROW(static_cast<void>(array.data()), std::runtime_error);

    EXPECT_EQ(array.count(), 0);
    array.add(1);
    EXPECT_THAT(std::vector<int>(array.begin(), array.end()), ElementsAre(1));
}

TEST(LateItems, AreNotReadToBeCleared) {
    Calls calls;
    PlainArray<int> array;
    array.setSource(std::make_unique<ReluctantItems>(calls));
    array.clear();

    EXPECT_TRUE(calls.gone);
    EXPECT_EQ(array.count(), 0);
}

class InflatedBytesTest : public testing::Test {
protected:
    static constexpr std::size_t kSize = std::size_t{1} << 20;

    InflatedBytesTest() : mContent(kSize, '\0') {
        for (std::size_t i = 0; i < kSize; ++i)
            mContent[i] = static_cast<char>(i % 251);
    }
    InflatedBytes inflated(const std::string& stream) {
        FbxStatus status;
        const auto file = FileBytes::open(mFolder.write("file", stream), status);
        StoredArray array;
        array.element = StoredArray::Element::int8;
        array.compressed = true;
        array.count = kSize;
        array.bytes = file->bytes();
        array.file = file.get();
        return InflatedBytes(file, array);
    }
    static std::string contentOf(const StoredBytes& bytes) { return {bytes.bytes().begin(), bytes.bytes().end()}; }

    support::TemporaryFolder mFolder;
    std::string mContent;
};

TEST_F(InflatedBytesTest, AreInflatedAgainWhenTheyWereReleased) {
    InflatedBytes bytes = inflated(BinaryRecordBuilder::deflated(mContent));
    EXPECT_TRUE(bytes.isSound());
    EXPECT_EQ(contentOf(bytes), mContent);

    bytes.release(bytes.bytes());
    EXPECT_NE(contentOf(bytes), mContent);

    bytes.restore();
    EXPECT_EQ(contentOf(bytes), mContent);
}

TEST_F(InflatedBytesTest, StayOnceTheyWereInflatedTwice) {
    InflatedBytes bytes = inflated(BinaryRecordBuilder::deflated(mContent));
    bytes.release(bytes.bytes());
    bytes.restore();

    bytes.release(bytes.bytes());

    EXPECT_EQ(contentOf(bytes), mContent);
}

TEST_F(InflatedBytesTest, OfACorruptStreamAreZero) {
    std::string stream = BinaryRecordBuilder::deflated(mContent);
    stream[stream.size() / 2] = static_cast<char>(stream[stream.size() / 2] ^ 0x55);

    const InflatedBytes bytes = inflated(stream);

    EXPECT_FALSE(bytes.isSound());
    EXPECT_EQ(contentOf(bytes), std::string(kSize, '\0'));
}

} // namespace
} // namespace fbxsdk::detail
