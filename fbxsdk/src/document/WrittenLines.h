// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The properties of the object that is being written.
#pragma once

#include <array>
#include <memory>
#include <span>
#include <string_view>
#include <vector>

#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// One line to be written.
struct WrittenLine {
    static constexpr int kUnique = -1;

    const DocumentProperty* property;
    int number = kUnique; ///< the same for lines of one document that are the same throughout; small

    /// The first value; of type none when there is none.
    [[nodiscard]] const Value& value() const {
        return property->values.empty() ? Record::kNoValue : property->values.front();
    }
};

/// The lines of one object in file order. Their memory serves the next object.
class WrittenLines {
public:
    void clear();
    /// Replaces the lines by those of the object.
    void fill(const DocumentObject& object);

    [[nodiscard]] std::span<const WrittenLine> all() const { return mLines; }
    /// Null when there is none of that name.
    [[nodiscard]] const WrittenLine* find(std::string_view name) const;

    /// A line with views that are valid as long as the document, or into values that were stored here.
    void add(const DocumentProperty& line) { mLines.push_back({&(mOwn.next() = line)}); }
    /// A line that exists as long as the document. Those of one number are the same.
    void refer(const DocumentProperty& line, int number = WrittenLine::kUnique) { mLines.push_back({&line, number}); }
    /// Replaces the values of the line of that name, or appends the line.
    void set(const DocumentProperty& line);
    void remove(std::string_view name);

    /// Stores the values of a line, four at most, until the next object.
    [[nodiscard]] std::span<const Value> keep(const Value& value);
    [[nodiscard]] std::span<const Value> keepReals(std::span<const double> numbers);

    /// The lines with their values stored in the tree.
    [[nodiscard]] std::vector<DocumentProperty> kept(RecordTree& tree) const;

private:
    static constexpr std::size_t kMostValues = 4;

    /// Elements that stay in place and are used again.
    template <class T>
    class Pool {
    public:
        [[nodiscard]] T& next() {
            if (mUsed == kBlock * mBlocks.size())
                mBlocks.push_back(std::make_unique<T[]>(kBlock));
            T& element = mBlocks[mUsed / kBlock][mUsed % kBlock];
            ++mUsed;
            return element;
        }
        void reuse() { mUsed = 0; }

    private:
        static constexpr std::size_t kBlock = 64;
        std::vector<std::unique_ptr<T[]>> mBlocks;
        std::size_t mUsed = 0;
    };

    std::vector<WrittenLine> mLines;
    Pool<DocumentProperty> mOwn;
    Pool<std::array<Value, kMostValues>> mValues;
};

} // namespace detail
FBXSDK_NAMESPACE_END
