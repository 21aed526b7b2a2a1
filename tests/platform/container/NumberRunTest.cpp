// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Long lists of numbers in a text, scanned and parsed by one thread and by several.
#include "container/NumberRun.h"

#include <algorithm>
#include <functional>
#include <random>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <fbxsdk/extensions/Threads.h>

#include "container/Record.h"

namespace fbxsdk::detail {
namespace {

constexpr int kNumbers = 200'000;

struct LongRun : testing::Test {
    ~LongRun() override { extensions::setMaximumThreads(1); }

    /// What reading the list gives, in one string of bytes: the numbers, or what is wrong.
    template <class Number>
    static std::string read(const std::string& list, int threads) {
        extensions::setMaximumThreads(threads);
        const std::string text = "; FBX 7.4.0 project file\nList: *" + std::to_string(kNumbers) + " {\n\ta: " + list +
                                 "\n}\nNext: *3 {\n\ta: 1,2,3\n}\nLast: 4\n";
        FbxStatus status;
        const auto tree = readRecords(text, "list.fbx", status);
        if (!tree)
            return status.GetErrorString();
        EXPECT_EQ(tree->root.child("Next")->numberCount(), 3U);
        EXPECT_EQ(tree->placeOf(*tree->root.child("Last")), "line " + std::to_string(2 + countLines(list) + 6));
        const Record& record = *tree->root.child("List");
        std::vector<Number> numbers(record.numberCount());
        EXPECT_TRUE(record.readNumbers(std::span<Number>(numbers)));
        return {static_cast<const char*>(static_cast<const void*>(numbers.data())), numbers.size() * sizeof(Number)};
    }
    static std::size_t countLines(const std::string& text) {
        return static_cast<std::size_t>(std::count(text.begin(), text.end(), '\n'));
    }

    static void expectTheSameByAll(const std::string& list) {
        ASSERT_GT(read<float>(list, 1).size(), std::size_t{1} << 18) << "it is sound";
        for (const int threads : {2, 8}) {
            EXPECT_TRUE(read<double>(list, 1) == read<double>(list, threads)) << threads;
            EXPECT_TRUE(read<float>(list, 1) == read<float>(list, threads)) << threads;
            EXPECT_TRUE(read<std::int32_t>(list, 1) == read<std::int32_t>(list, threads)) << threads;
        }
    }

    /// Numbers of all lengths, and what stands behind each of them.
    static std::string listOf(const std::function<std::string(int)>& separator) {
        std::mt19937 random(7);
        std::string list;
        for (int i = 0; i < kNumbers; ++i) {
            const double number = (static_cast<double>(random()) - 2e9) / static_cast<double>(1 + random() % 100'000);
            list += i % 5 == 0 ? std::to_string(i) : std::to_string(number);
            list += i + 1 < kNumbers ? separator(i) : "";
        }
        return list;
    }
};

TEST_F(LongRun, IsReadAlikeByAnyNumberOfThreads) {
    const std::string list = listOf([](int) { return ","; });
    expectTheSameByAll(list);
    EXPECT_EQ(read<double>(list, 3).size(), kNumbers * sizeof(double));
}

TEST_F(LongRun, MayHaveBlanksAndLinesBetweenNumbers) {
    expectTheSameByAll(listOf([](int i) { return i % 3 == 0 ? "," : i % 3 == 1 ? " ,\r\n\t" : ",  "; }));
}

TEST_F(LongRun, MayHaveCommasInCommentsAndCommasTooMany) {
    expectTheSameByAll(listOf([](int i) { return i % 1000 == 0 ? ", ; 1,2,3,\n" : ","; }));
    expectTheSameByAll(listOf([](int i) { return i % 1000 == 0 ? ",," : ","; }));
    expectTheSameByAll(listOf([](int i) { return i % 2 == 0 ? ",;1,\n" : ","; }));
}

TEST_F(LongRun, MayHaveALongCommentFullOfCommas) {
    std::string comment = ",;";
    for (int i = 0; i < 300'000; ++i)
        comment += "5,";
    comment += '\n';
    expectTheSameByAll(listOf([&](int i) { return i == kNumbers / 2 ? comment : std::string(","); }));
}

TEST_F(LongRun, MayHaveWordsAndNumbersThatAreNotFinite) {
    const std::string list = listOf([](int i) { return i % 777 == 0 ? ",T,1.#INF,-nan,1e400,-0,1e-400," : ","; });
    expectTheSameByAll(list.substr(0, list.rfind(',', list.size() * 9 / 10)));
}

TEST_F(LongRun, IsRefusedForTheSameReasonByAnyNumberOfThreads) {
    for (const int place : {10, kNumbers / 3, kNumbers / 2, kNumbers - 2}) {
        const std::string list = listOf([&](int i) {
            return i == place ? ",12x,\n" : i == place + 1 ? ",1 2,\n" : ",\n";
        });
        const std::string reason = read<double>(list, 1);
        EXPECT_EQ(reason,
                  "list.fbx: line " + std::to_string(3 + place) + ": expected a number or '}' instead of '12x'");
        EXPECT_EQ(read<double>(list, 2), reason);
        EXPECT_EQ(read<double>(list, 8), reason);
    }
}

TEST_F(LongRun, IsRefusedWithMoreNumbersThanItsCount) {
    const std::string list = listOf([](int i) { return i == kNumbers / 2 ? ",1," : ","; });
    const std::string reason = read<double>(list, 1);
    EXPECT_NE(reason.find("holds 200001 numbers, but its count is 200000"), std::string::npos) << reason;
    EXPECT_EQ(read<double>(list, 3), reason);
}

TEST_F(LongRun, EndsWhereTheFileDoes) {
    const std::string list = listOf([](int) { return ","; });
    for (const std::string& text : {list, list + ',', list + ", Name: 1,2,3", list + " 5", list + ",}"}) {
        extensions::setMaximumThreads(1);
        const NumberRun alone = scanNumbers(text.data(), text.data() + text.size(), /*wordsCount*/ false);
        extensions::setMaximumThreads(3);
        const NumberRun together = scanNumbers(text.data(), text.data() + text.size(), /*wordsCount*/ false);
        EXPECT_EQ(alone.count, static_cast<std::uint64_t>(kNumbers));
        EXPECT_EQ(together.count, alone.count);
        EXPECT_EQ(together.numbersEnd, alone.numbersEnd);
        EXPECT_EQ(together.next, alone.next);
        EXPECT_EQ(together.afterComma, alone.afterComma);
    }
}

TEST_F(LongRun, IsCutWhereCommasCountTheNumbers) {
    extensions::setMaximumThreads(2);
    const std::string list = listOf([](int) { return ", "; });
    const std::vector<NumberPiece> pieces = piecesOfRun(list, kNumbers);
    ASSERT_GT(pieces.size(), 3U);
    EXPECT_EQ(pieces[0].text, list.data());
    EXPECT_EQ(pieces.back().first + pieces.back().count, static_cast<std::uint64_t>(kNumbers));

    EXPECT_TRUE(piecesOfRun(list, kNumbers - 1).empty());
    extensions::setMaximumThreads(1);
    EXPECT_TRUE(piecesOfRun(list, kNumbers).empty());
}

} // namespace
} // namespace fbxsdk::detail
