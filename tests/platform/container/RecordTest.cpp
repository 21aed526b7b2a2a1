// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Values and records as later stages use them, and as the translation of old generations builds them.
#include "container/Record.h"

#include <cmath>
#include <limits>

#include <gtest/gtest.h>

#include "support/RecordText.h"

using namespace fbxsdk::detail;

namespace {

TEST(Value, IsNothingByDefault) {
    const Value value{};

    EXPECT_EQ(value.type, Value::Type::none);
    EXPECT_FALSE(value.isNumber());
    EXPECT_EQ(value.toInteger(5), 5);
    EXPECT_EQ(value.toReal(0.5), 0.5);
    EXPECT_EQ(value.toText(), "");
    EXPECT_EQ(value.toLetter(), '\0');
}

TEST(Value, ConvertsNumbersIntoEachOther) {
    EXPECT_EQ(Value::ofInteger(-3).toReal(), -3.0);
    EXPECT_EQ(Value::ofReal(-3.9).toInteger(), -3);
    EXPECT_EQ(Value::ofReal(1e30).toInteger(), std::numeric_limits<std::int64_t>::max());
    EXPECT_EQ(Value::ofReal(-1e30).toInteger(), std::numeric_limits<std::int64_t>::min());
    EXPECT_EQ(Value::ofReal(std::nan("")).toInteger(5), 0);
    EXPECT_TRUE(Value::ofReal(0).isNumber());
    EXPECT_TRUE(Value::ofInteger(0).isNumber());
}

TEST(Value, NeverTurnsTextIntoANumber) {
    EXPECT_EQ(Value::ofText("12").toInteger(-1), -1);
    EXPECT_EQ(Value::ofText("12").toReal(-1), -1);
    EXPECT_EQ(Value::ofText("1").toInteger(-1), -1);
    EXPECT_FALSE(Value::ofText("12").isNumber());
}

TEST(Value, GivesTheCodeOfAOneByteWord) {
    EXPECT_EQ(Value::ofWord("T").toInteger(), 'T');
    EXPECT_EQ(Value::ofWord("\x01").toReal(), 1.0);
    EXPECT_EQ(Value::ofWord("\xFF").toInteger(), 255);
    EXPECT_EQ(Value::ofWord("True").toInteger(-1), -1);
    EXPECT_FALSE(Value::ofWord("T").isNumber());
}

TEST(Value, GivesTheLetterOfWordsAndTexts) {
    EXPECT_EQ(Value::ofWord("T").toLetter(), 'T');
    EXPECT_EQ(Value::ofText("T").toLetter(), 'T');
    EXPECT_EQ(Value::ofText("TT").toLetter(), '\0');
    EXPECT_EQ(Value::ofText("").toLetter(), '\0');
    EXPECT_EQ(Value::ofInteger('T').toLetter(), '\0');
}

TEST(Value, GivesTheTextOfTextsAndWords) {
    EXPECT_EQ(Value::ofText("abc").toText(), "abc");
    EXPECT_EQ(Value::ofWord("abc").toText(), "abc");
    EXPECT_EQ(Value::ofInteger(5).toText(), "");
}

TEST(RecordTree, IsBuiltByHandToo) {
    RecordTree tree;
    Record& parent = tree.newRecord("Parent");
    Record& child = tree.newRecord(tree.keepText(std::string("Chi") + "ld"));
    tree.root.firstChild = &parent;
    parent.firstChild = &child;
    parent.hasBlock = true;
    StoredArray& array = tree.newArray();
    array.element = StoredArray::Element::text;
    array.count = 2;
    const std::string_view kept = tree.keepText("1, 2.5");
    array.bytes = {kept.data(), kept.size()};
    const auto values = tree.newValues(2);
    values[0] = Value::ofArray(array);
    child.values = values;

    EXPECT_EQ(recordsText(tree.root), "Parent: { Child: [1 2.5], none }");
}

TEST(Record, FindsTheFirstChildOfAName) {
    RecordTree tree;
    Record& first = tree.newRecord("A");
    Record& second = tree.newRecord("B");
    Record& third = tree.newRecord("B");
    tree.root.firstChild = &first;
    first.nextSibling = &second;
    second.nextSibling = &third;
    second.values = [&] {
        const auto values = tree.newValues(1);
        values[0] = Value::ofInteger(7);
        return values;
    }();

    EXPECT_EQ(tree.root.child("B"), &second);
    EXPECT_EQ(tree.root.child("C"), nullptr);
    EXPECT_EQ(tree.root.child(""), nullptr);
    EXPECT_EQ(tree.root.childValue("B").toInteger(), 7);
    EXPECT_EQ(tree.root.childValue("A").type, Value::Type::none);
    EXPECT_EQ(tree.root.childValue("C").type, Value::Type::none);
    EXPECT_EQ(second.value(1).type, Value::Type::none);
}

TEST(Record, HasNoNumbersWithoutValues) {
    const Record record{};
    double number = 5;

    EXPECT_EQ(record.numberCount(), 0U);
    EXPECT_TRUE(record.readNumbers(std::span<double>()));
    EXPECT_FALSE(record.readNumbers(std::span(&number, 1)));
    EXPECT_EQ(number, 0.0);
}

} // namespace
