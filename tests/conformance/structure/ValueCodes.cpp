// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A second, small reading of the heads of binary records: end, number and size of the values, name, values.
#include "ValueCodes.h"

#include "container/FileBytes.h"

#include <cstring>
#include <span>
#include <stdexcept>

namespace conformance {
namespace {

using fbxsdk::detail::Record;
using fbxsdk::detail::RecordTree;
using fbxsdk::detail::Value;

constexpr std::string_view kClassSeparator("\0\1", 2);
constexpr std::uint32_t kFirstVersionWithLongHeads = 7500;

class ByteReader {
public:
    ByteReader(std::span<const char> bytes, std::uint64_t position, bool bigEndian)
        : mBytes(bytes), mPosition(position), mBigEndian(bigEndian) {}

    std::uint64_t whole(std::size_t size) {
        const std::string_view bytes = take(size);
        std::uint64_t number = 0;
        for (std::size_t i = 0; i < size; ++i) {
            const std::size_t place = mBigEndian ? i : size - 1 - i;
            number = number << 8U | static_cast<unsigned char>(bytes[place]);
        }
        return number;
    }

    std::string_view take(std::uint64_t size) {
        if (mPosition > mBytes.size() || size > mBytes.size() - mPosition)
            throw std::runtime_error("a record reaches beyond its file");
        const std::string_view bytes(mBytes.data() + mPosition, size);
        mPosition += size;
        return bytes;
    }

private:
    std::span<const char> mBytes;
    std::uint64_t mPosition;
    bool mBigEndian;
};

char textCode(char code, std::string_view text) {
    return text.find(kClassSeparator) != std::string_view::npos ? 'N' : code;
}

char readValue(ByteReader& reader) {
    const char code = reader.take(1)[0];
    switch (code) {
    case 'C':
    case 'B':
        reader.take(1);
        return code;
    case 'Y':
        reader.take(2);
        return code;
    case 'I':
    case 'F':
        reader.take(4);
        return code;
    case 'L':
    case 'D':
        reader.take(8);
        return code;
    case 'S':
    case 'R':
        return textCode(code, reader.take(reader.whole(4)));
    default: {
        reader.take(8); // elements and encoding of an array
        reader.take(reader.whole(4));
        return code;
    }
    }
}

std::string binaryCodes(const RecordTree& tree, const Record& record) {
    const std::size_t width = tree.version >= kFirstVersionWithLongHeads ? 8 : 4;
    ByteReader reader(tree.file->bytes(), record.location, tree.bigEndian);
    reader.take(width); // end
    const std::uint64_t count = reader.whole(width);
    reader.take(width); // size of the values
    reader.take(reader.whole(1));
    std::string codes;
    for (std::uint64_t i = 0; i < count; ++i)
        codes += readValue(reader);
    return codes;
}

std::string asciiCodes(const Record& record) {
    std::string codes;
    for (const Value& value : record.values) {
        switch (value.type) {
        case Value::Type::integer:
        case Value::Type::real:
            codes += 'n';
            break;
        case Value::Type::array:
            codes.append(record.numberCount(), 'n');
            break;
        case Value::Type::word:
            codes += 'C';
            break;
        default:
            codes += value.toText().find("::") != std::string_view::npos ? 'N' : 'S';
        }
    }
    return codes;
}

} // namespace

std::string valueCodes(const RecordTree& tree, const Record& record) {
    return tree.ascii ? asciiCodes(record) : binaryCodes(tree, record);
}

} // namespace conformance
