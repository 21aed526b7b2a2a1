// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files that are inconsistent, truncated, or crafted: a reason or a valid tree, and memory in proportion to the
// file's size.
#include <algorithm>
#include <memory_resource>
#include <random>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "container/Record.h"
#include "support/BinaryRecordBuilder.h"
#include "support/RecordText.h"

using fbxsdk::FbxStatus;
using namespace fbxsdk::detail;

namespace {

/// A record of every type.
std::string binaryFile(std::uint32_t version, ByteOrder order) {
    BinaryRecordBuilder file(version, order);
    file.begin("FBXHeaderExtension").block();
    file.begin("FBXVersion").int32(static_cast<std::int32_t>(version)).end();
    file.begin("Creator").text("hand").raw("raw").letter('T').uint8(1).int16(2).int64(3).float32(4).float64(5).end();
    file.end();
    file.begin("Objects").block();
    file.begin("Geometry").int64(17).text("Cube").block();
    file.begin("Vertices").array<double>('d', {1, 2, 3}).end();
    file.begin("Edges").compressedArray<std::int32_t>('i', {1, 2, 3, 4, 5, 6, 7, 8}).end();
    file.begin("Points");
    for (int i = 0; i < 18; ++i)
        file.float64(i);
    file.end();
    file.begin("Lost").int32(1).loseEnd().end();
    file.end();
    file.end();
    return file.nullRecord().soFar();
}

const std::string kAsciiFile = R"(; FBX 7.5.0 project file
FBXHeaderExtension:  {
	FBXVersion: 7500
	Creator: "hand &quot;made&quot;", T
}
Objects:  {
	Geometry: 17, "Geometry::Cube", "Mesh" { ; comment
		Vertices: *3 {
			a: 1,2.5, ; comment
			-3e-008
		} 
		"Old List": 1,2,3,4,5,6,7,8,9,10,
		11,12,13,14,15,16,nan,1.#INF
		Key: 0,1.5,U,s,0,0,n
		KeyAttrDataFloat: *2 { a: 218434821,0.5 }
	}
}
)";

std::vector<std::string> smallFiles() {
    return {binaryFile(6100, ByteOrder::little), binaryFile(7400, ByteOrder::big), binaryFile(7500, ByteOrder::little),
            kAsciiFile};
}

TEST(HostileInput, ReadsTheUndamagedFiles) {
    for (const std::string& file : smallFiles())
        EXPECT_TRUE(readText(file).starts_with("FBXHeaderExtension: {")) << readText(file);
}

TEST(HostileInput, RefusesEveryPrefixOfABinaryFile) {
    for (const std::string& file : {binaryFile(7400, ByteOrder::little), binaryFile(7700, ByteOrder::big)}) {
        for (std::size_t size = 0; size < file.size(); ++size) {
            const std::string sentence = readText(std::string_view(file).substr(0, size));
            ASSERT_TRUE(sentence.starts_with("test.fbx: ")) << size << " bytes: " << sentence;
        }
    }
}

TEST(HostileInput, SurvivesEveryPrefixOfAnAsciiFile) {
    const std::size_t objects = kAsciiFile.find("Objects:");
    const std::size_t lastBrace = kAsciiFile.rfind('}');
    for (std::size_t size = 0; size < kAsciiFile.size(); ++size) {
        const std::string text = readText(std::string_view(kAsciiFile).substr(0, size));
        // Only between its top-level records can a file end.
        const bool canEnd = size <= objects + std::string_view("Objects:  ").size() || size > lastBrace;
        ASSERT_TRUE(canEnd || text.starts_with("test.fbx: ")) << size << " bytes: " << text;
    }
}

TEST(HostileInput, SurvivesFlippedBytes) {
    std::mt19937 random(7);
    for (const std::string& file : smallFiles()) {
        for (int i = 0; i < 20'000; ++i) {
            std::string damaged = file;
            for (std::uint_fast32_t flips = 1 + random() % 3; flips > 0; --flips)
                damaged[random() % damaged.size()] = static_cast<char>(random());
            ASSERT_EQ(readText(damaged), readText(damaged));
        }
    }
}

TEST(HostileInput, SurvivesPiecesInTheWrongPlace) {
    std::mt19937 random(8);
    for (const std::string& file : smallFiles()) {
        for (int i = 0; i < 5'000; ++i) {
            const std::size_t from = random() % file.size();
            const std::size_t size = random() % (file.size() - from);
            std::string damaged = file;
            damaged.insert(random() % file.size(), file.substr(from, size % 64));
            damaged.erase(random() % damaged.size(), random() % 16);
            ASSERT_EQ(readText(damaged), readText(damaged));
        }
    }
}

/// A file of one record "List", with one 32-bit field of its head replaced.
std::string lie(std::size_t field, std::uint32_t number) {
    BinaryRecordBuilder file(7400);
    std::string bytes = file.begin("List").int32(1).int32(2).end().finish();
    const std::string encoded = file.encode(std::vector<std::uint32_t>{number});
    return bytes.replace(27 + field * 4, 4, encoded);
}

TEST(HostileInput, RefusesEndsThatCannotBe) {
    for (const std::uint32_t end : {1U, 26U, 27U, 40U, 53U, 1'000U, 0xFFFFFFFFU}) {
        const std::string sentence = readText(lie(0, end));
        EXPECT_TRUE(sentence.starts_with("test.fbx: offset 27: end offset " + std::to_string(end))) << sentence;
    }
}

TEST(HostileInput, RefusesCountsOfValuesThatCannotBe) {
    for (const std::uint32_t count : {3U, 6U, 0xFFFFFFFFU}) {
        const std::string sentence = readText(lie(1, count));
        EXPECT_TRUE(sentence.starts_with("test.fbx: offset ")) << sentence;
    }
    EXPECT_EQ(readText(lie(1, 1)), "List: 1");
}

TEST(HostileInput, RefusesSizesOfValuesThatCannotBe) {
    for (const std::uint32_t size : {0U, 1U, 6U, 9U, 11U, 1'000U, 0xFFFFFFFFU}) {
        const std::string sentence = readText(lie(2, size));
        EXPECT_TRUE(sentence.starts_with("test.fbx: offset ")) << size << ": " << sentence;
    }
}

TEST(HostileInput, Refuses64BitSizesThatOverflow) {
    for (const std::uint64_t number : {~std::uint64_t{0}, std::uint64_t{1} << 63, ~std::uint64_t{0} - 30}) {
        for (std::size_t field = 0; field < 3; ++field) {
            BinaryRecordBuilder file(7500);
            std::string bytes = file.begin("List").int32(1).end().finish();
            bytes.replace(27 + field * 8, 8, file.encode(std::vector<std::uint64_t>{number}));

            EXPECT_TRUE(readText(bytes).starts_with("test.fbx: offset ")) << field;
        }
    }
}

TEST(HostileInput, RefusesAChildThatReachesBeyondItsParent) {
    BinaryRecordBuilder file(7400);
    file.begin("Parent").block();
    const std::size_t child = file.soFar().size();
    file.begin("Child").int32(1).end().end().begin("Next").end();
    std::string bytes = file.finish();
    bytes[child] = static_cast<char>(bytes[child] + 20);

    const std::string sentence = readText(bytes);
    EXPECT_TRUE(sentence.starts_with("test.fbx: offset " + std::to_string(child) + ": end offset")) << sentence;
}

TEST(HostileInput, RefusesValuesThatExceedTheirRecord) {
    for (const char code : std::string_view("CBZYILFDSRilfdbc")) {
        // A value that is truncated by the end of its record, before bytes that could be mistaken for it.
        const std::string bytes = BinaryRecordBuilder(7400)
                                      .begin("List")
                                      .letter('x')
                                      .value(code)
                                      .end()
                                      .begin("Behind")
                                      .text(std::string(100, '\0'))
                                      .end()
                                      .finish();
        const std::string sentence = readText(bytes);
        EXPECT_TRUE(sentence.starts_with("test.fbx: offset ")) << code << ": " << sentence;
    }
}

TEST(HostileInput, RefusesUnknownValueTypes) {
    for (const char code : {'\0', 'x', 'A', '\xFF'}) {
        const std::string sentence =
            readText(BinaryRecordBuilder(7400).begin("List").value(code).number(1).end().finish());
        EXPECT_EQ(sentence,
                  "test.fbx: offset 44: unknown value type " + std::to_string(static_cast<unsigned char>(code)));
    }
}

std::string arrayFile(std::size_t count, std::uint32_t encoding, std::string_view payload, char code = 'd') {
    return BinaryRecordBuilder(7400).begin("List").arrayOf(code, count, encoding, payload).end().finish();
}

TEST(HostileInput, RefusesArraysThatDisagreeWithTheirBytes) {
    const std::string sixteen(16, '\0');
    EXPECT_EQ(readText(arrayFile(2, 0, sixteen)), "List: [0 0]");
    for (const std::size_t count : {0U, 1U, 3U, 0xFFFFFFFFU}) {
        const std::string sentence = readText(arrayFile(count, 0, sixteen));
        EXPECT_EQ(sentence,
                  "test.fbx: offset 45: array of " + std::to_string(count) + " elements does not match its 16 bytes");
    }
    EXPECT_EQ(readText(arrayFile(2, 2, sixteen)), "test.fbx: offset 45: unknown array encoding 2");
}

TEST(HostileInput, RefusesCompressedArraysThatNoStreamCanHold) {
    const std::string stream(100, '\0');
    // 1,032 bytes for each, and a little more for the stream's head.
    EXPECT_EQ(readText(arrayFile((1032 * 100 + 1024) / 8, 1, stream)), "List: [corrupt]");
    EXPECT_TRUE(
        readText(arrayFile((1032 * 100 + 1024) / 8 + 1, 1, stream)).starts_with("test.fbx: offset 45: array of"));
    EXPECT_TRUE(readText(arrayFile(0xFFFFFFFFU, 1, stream)).starts_with("test.fbx: offset 45: array of"));
}

TEST(HostileInput, RefusesArraysThatTogetherExpandBeyondReason) {
    // Each is a valid stream of a megabyte and more of zeros in a few hundred bytes.
    const std::vector<double> zeros(150'000);
    BinaryRecordBuilder file(7400);
    const std::string stream = BinaryRecordBuilder::deflated(file.encode(zeros));
    ASSERT_LT(stream.size(), 2000U);
    for (int i = 0; i < 28; ++i)
        file.begin("List").arrayOf('d', zeros.size(), 1, stream).end();
    EXPECT_TRUE(readText(BinaryRecordBuilder(file).finish()).starts_with("List: ["));
    for (int i = 0; i < 42; ++i)
        file.begin("List").arrayOf('d', zeros.size(), 1, stream).end();

    EXPECT_NE(readText(file.finish()).find(": the arrays expand to more than 512 times the size of the file"),
              std::string::npos);
}

std::string nestedBinary(int levels) {
    BinaryRecordBuilder file(7400);
    for (int i = 0; i < levels; ++i)
        file.begin("N").block();
    for (int i = 0; i < levels; ++i)
        file.end();
    return file.finish();
}

std::string nestedAscii(int levels) {
    std::string text = "; FBX 7.5.0\n";
    for (int i = 0; i < levels; ++i)
        text += "N: {";
    return text + std::string(static_cast<std::size_t>(levels), '}');
}

TEST(HostileInput, ReadsDeepFilesAndRefusesBottomlessOnes) {
    EXPECT_TRUE(readText(nestedBinary(64)).starts_with("N: { N: {"));
    EXPECT_TRUE(readText(nestedAscii(64)).starts_with("N: { N: {"));
    for (const int levels : {65, 1'000, 100'000}) {
        const std::string binary = readText(nestedBinary(levels));
        EXPECT_TRUE(binary.ends_with(": records are nested deeper than 64 levels")) << binary;
        EXPECT_EQ(readText(nestedAscii(levels)), "test.fbx: line 2: records are nested deeper than 64 levels");
    }
}

TEST(HostileInput, RefusesAnEndlessCycleOfRecords) {
    // Records that end where they began would be read endlessly.
    std::string bytes = BinaryRecordBuilder(7400).begin("A").block().end().finish();
    bytes[27] = 27;

    EXPECT_TRUE(readText(bytes).starts_with("test.fbx: offset 27: end offset 27"));
}

/// Counts the bytes that pass through it.
class CountingResource : public std::pmr::memory_resource {
public:
    [[nodiscard]] std::size_t taken() const { return mTaken; }

private:
    void* do_allocate(std::size_t size, std::size_t alignment) override {
        mTaken += size;
        return std::pmr::new_delete_resource()->allocate(size, alignment);
    }
    void do_deallocate(void* memory, std::size_t size, std::size_t alignment) override {
        std::pmr::new_delete_resource()->deallocate(memory, size, alignment);
    }
    [[nodiscard]] bool do_is_equal(const memory_resource& other) const noexcept override { return this == &other; }

    std::size_t mTaken = 0;
};

/// Refuses to give more than a fixed number of bytes.
class MeagreResource : public std::pmr::memory_resource {
public:
    explicit MeagreResource(std::size_t limit) : mLeft(limit) {}

private:
    void* do_allocate(std::size_t size, std::size_t alignment) override {
        if (size > mLeft)
            throw std::bad_alloc();
        mLeft -= size;
        return std::pmr::new_delete_resource()->allocate(size, alignment);
    }
    void do_deallocate(void* memory, std::size_t size, std::size_t alignment) override {
        std::pmr::new_delete_resource()->deallocate(memory, size, alignment);
    }
    [[nodiscard]] bool do_is_equal(const memory_resource& other) const noexcept override { return this == &other; }

    std::size_t mLeft;
};

class DefaultResource {
public:
    explicit DefaultResource(std::pmr::memory_resource& resource)
        : mPrevious(std::pmr::set_default_resource(&resource)) {}
    DefaultResource(const DefaultResource&) = delete;
    DefaultResource& operator=(const DefaultResource&) = delete;
    ~DefaultResource() { std::pmr::set_default_resource(mPrevious); }

private:
    std::pmr::memory_resource* mPrevious;
};

/// Files that consist of the smallest records that take memory.
std::vector<std::string> dustFiles() {
    constexpr int kCount = 300'000;
    std::vector<std::string> files;
    BinaryRecordBuilder records(7400);
    for (int i = 0; i < kCount; ++i)
        records.bytes(std::string_view("\0\0\0\0\0\0\0\0\0\0\0\0\1x", 14));
    files.push_back(records.finish());
    BinaryRecordBuilder letters(7400);
    letters.begin("A");
    for (int i = 0; i < kCount; ++i)
        letters.letter('x');
    files.push_back(letters.end().finish());
    BinaryRecordBuilder arrays(7400);
    arrays.begin("A");
    for (int i = 0; i < kCount; ++i)
        arrays.array<double>('d', {});
    files.push_back(arrays.end().finish());
    for (const std::string_view piece : {"a:", "1,", "T,", "\"\",", "*0{},", "\"&lf;\",", "a:*0{}"}) {
        std::string ascii = piece == "a:" || piece == "a:*0{}" ? "; FBX 7.5.0\n" : "; FBX 7.5.0\nA: T,";
        for (int i = 0; i < kCount; ++i)
            ascii += piece;
        files.push_back(ascii);
    }
    return files;
}

TEST(HostileInput, NeedsMemoryInProportionToTheFile) {
    for (const std::string& file : dustFiles()) {
        CountingResource memory;
        {
            const DefaultResource use(memory);
            FbxStatus status;
            (void)readRecords(std::span(file.data(), file.size()), "test.fbx", status);
        }
        EXPECT_LE(memory.taken(), 100 * file.size() + (1 << 20)) << file.substr(0, 40);
    }
}

TEST(HostileInput, SaysSoWhenMemoryRunsOut) {
    int refused = 0;
    for (const std::string& file : dustFiles()) {
        MeagreResource memory(200'000);
        const DefaultResource use(memory);
        FbxStatus status;

        if (readRecords(std::span(file.data(), file.size()), "test.fbx", status))
            continue; // one that needs little, like a single list of numbers
        EXPECT_EQ(status.GetCode(), FbxStatus::eInsufficientMemory);
        EXPECT_STREQ(status.GetErrorString(), "test.fbx: not enough memory");
        ++refused;
    }
    EXPECT_GE(refused, 8);
}

} // namespace
