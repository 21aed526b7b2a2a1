// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// JSON as it is spelled: separators, escapes, and texts at the end of a block and larger than one.
#include "JsonWriter.h"

#include <gtest/gtest.h>

#include <limits>
#include <sstream>
#include <string>

namespace {

using tool::JsonKey;
using tool::JsonWriter;

TEST(JsonWriter, SeparatesValuesOfAllLevels) {
    for (const bool pretty : {false, true}) {
        std::ostringstream out;
        JsonWriter json(out, pretty);
        json.beginObject();
        json.key("a");
        json.beginArray();
        json.endArray();
        json.key(JsonKey("b"));
        json.beginArray();
        json.integer(1);
        json.beginObject();
        json.endObject();
        json.reals(0.5F, 2);
        json.endArray();
        json.text("c", "d");
        EXPECT_EQ(out.str(), "");
        json.endObject();
        EXPECT_EQ(out.str(),
                  pretty ? "{\n  \"a\": [],\n  \"b\": [\n    1,\n    {},\n    0.5,\n    0.5\n  ],\n  \"c\": \"d\"\n}"
                         : R"({"a":[],"b":[1,{},0.5,0.5],"c":"d"})");
    }
}

TEST(JsonWriter, EscapesKeysAndTexts) {
    std::ostringstream out;
    JsonWriter json(out, false);
    json.beginObject();
    json.key(JsonKey("a\"b"));
    json.text("\x7F\n\xC2\x85\\");
    json.key("\xFF");
    json.real(std::numeric_limits<float>::infinity());
    json.endObject();
    EXPECT_EQ(out.str(), "{\"a\\\"b\":\"\\u007f\\n\\u0085\\\\\",\"\xEF\xBF\xBD\":null}");
}

TEST(JsonWriter, WritesMembersInFrontOfAKey) {
    std::ostringstream out;
    JsonWriter json(out, false);
    const JsonKey key("c", "\"a\":1,\"b\":2,");
    json.beginArray();
    for (int i = 0; i < 2; ++i) {
        json.beginObject();
        json.key("v");
        json.integer(i);
        json.key(key);
        json.integer(3);
        json.endObject();
    }
    json.endArray();
    EXPECT_EQ(out.str(), "[{\"v\":0,\"a\":1,\"b\":2,\"c\":3},{\"v\":1,\"a\":1,\"b\":2,\"c\":3}]");
}

TEST(JsonWriter, RepeatsMembersOfTheObjectBefore) {
    for (const bool pretty : {false, true}) {
        std::ostringstream repeated, again;
        const auto write = [pretty](std::ostream& out, bool repeats) {
            JsonWriter json(out, pretty);
            std::string first, second;
            json.beginArray();
            for (int i = 0; i < 3; ++i) {
                const auto member = [&](const char* name, std::string& text) {
                    if (repeats && i > 0)
                        return json.repeat(text);
                    const JsonWriter::Place place = json.place();
                    json.key(name);
                    json.beginArray();
                    json.real(0.5F);
                    json.endArray();
                    text = json.since(place);
                };
                json.beginObject();
                member("a", first);
                member("b", second);
                json.integer("c", i);
                json.endObject();
            }
            json.endArray();
        };
        write(repeated, true);
        write(again, false);
        EXPECT_EQ(repeated.str(), again.str());
    }
}

TEST(JsonWriter, GivesNothingBackOnceItIsInTheStream) {
    std::ostringstream out;
    JsonWriter json(out, false);
    json.beginArray();
    JsonWriter::Place place = json.place();
    json.text("a");
    EXPECT_EQ(json.since(place), "\"a\"");
    json.text(std::string(65'530, 'x'));
    EXPECT_EQ(json.since(place), "");
    place = json.place();
    json.text(std::string(1'000'000, 'y'));
    EXPECT_EQ(json.since(place), "");
    json.endArray();
}

TEST(JsonWriter, WritesTextsOfAnySizeAcrossItsBlocks) {
    std::string expected = "[";
    std::ostringstream out;
    {
        JsonWriter json(out, false);
        json.beginArray();
        for (std::size_t size = 65'520; size < 65'560; ++size) {
            json.text(std::string(size, 'x'));
            json.real(-12345.678F);
            expected += '"' + std::string(size, 'x') + "\",-12345.678,";
        }
        json.text(std::string(1'000'000, 'y'));
        expected += '"' + std::string(1'000'000, 'y') + "\"]";
        json.endArray();
    }
    EXPECT_EQ(out.str(), expected);
}

} // namespace
