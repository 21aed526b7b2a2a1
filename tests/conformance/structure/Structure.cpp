// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The kind of a record is its name, and where one name has many kinds, what distinguishes them: the class of an
// object, the name of a property, the part of a transform that a channel moves.
#include "Structure.h"

#include "ValueCodes.h"

#include <algorithm>
#include <array>

namespace conformance {
namespace {

using fbxsdk::detail::Record;
using fbxsdk::detail::RecordTree;

bool isProperty(const Record& record) { return record.name == "Property" || record.name == "P"; }

/// User properties have arbitrary names, and so have those that applications put into compounds of their
/// own. What a file states about its origin is a compound, too, but always the same one.
bool isFree(const Record& record) {
    const std::string_view flags = record.value(record.name == "P" ? 3 : 2).toText();
    const std::string_view name = record.value(0).toText();
    const bool ofOrigin = name.starts_with("Original") || name.starts_with("LastSaved");
    const bool inCompound = record.value(1).toText() == "Compound" || name.find('|') != std::string_view::npos;
    return flags.find('U') != std::string_view::npos || (inCompound && !ofOrigin);
}

std::string channelKind(const Record& record) {
    constexpr std::array<std::string_view, 9> kKnown{"Transform", "T", "R", "S", "X", "Y", "Z", "W", "Visibility"};
    const std::string_view name = record.value(0).toText();
    const bool known = std::find(kKnown.begin(), kKnown.end(), name) != kKnown.end();
    return "Channel " + std::string(known ? name : "of a property");
}

/// Empty for ignored records.
std::string kindOf(const std::string& path, const Record& record) {
    const std::string name(record.name);
    if (isProperty(record))
        return isFree(record) ? std::string() : "Property " + std::string(record.value(0).toText());
    if (name == "Channel")
        return channelKind(record);
    if (path == "Objects" && record.values.size() >= 2)
        return name + ' ' + std::string(record.values.back().toText());
    if (path == "Connections" || name == "ObjectType" || name == "PropertyTemplate")
        return name + ' ' + std::string(record.value(0).toText());
    return name;
}

/// The types of a property are part of how it is stored.
std::string storedAs(const RecordTree& tree, const Record& record) {
    std::string codes = valueCodes(tree, record);
    if (isProperty(record)) {
        const std::size_t types = record.name == "P" ? 2 : 1;
        std::string stated;
        for (std::size_t i = 1; i <= types; ++i)
            stated += std::string(record.value(i).toText()) + ',';
        codes = stated + codes;
    }
    return record.hasBlock ? codes + '{' : codes;
}

/// A place whose records differ in the number of values, some having many, holds lists. In a list only
/// which value follows which is compared.
bool holdsLists(const Place& place) {
    constexpr std::size_t kValuesOfAFixedRecord = 5;
    constexpr std::size_t kNumbersOfAMatrix = 16;
    const auto longest =
        std::max_element(place.codes.begin(), place.codes.end(),
                         [](const std::string& a, const std::string& b) { return a.size() < b.size(); });
    return longest != place.codes.end() &&
           (longest->size() > kNumbersOfAMatrix || (place.codes.size() > 1 && longest->size() > kValuesOfAFixedRecord));
}

std::set<std::string> neighbours(const Place& place) {
    std::set<std::string> pairs;
    for (const std::string& codes : place.codes) {
        for (std::size_t i = 0; i + 1 < codes.size(); ++i)
            pairs.insert(codes.substr(i, 2));
        pairs.insert(codes.substr(0, 1));
    }
    return pairs;
}

class Comparison {
public:
    Comparison(const Structure& ours, const Structure& theirs) : mOurs(ours), mTheirs(theirs) {}

    std::vector<std::string> run() {
        for (const auto& [path, place] : mOurs.places())
            if (const Place* their = mTheirs.find(path))
                compare(path, place, *their);
        return mFound;
    }

private:
    void compare(const std::string& path, const Place& our, const Place& their) {
        compareCodes(path, our, their);
        compareChildren(path, our, their);
        compareOrder(path, our, their);
    }

    void compareCodes(const std::string& path, const Place& our, const Place& their) {
        const bool lists = path.find("/Property ") == std::string::npos && (holdsLists(their) || holdsLists(our));
        const std::set<std::string> ourWays = lists ? neighbours(our) : our.codes;
        const std::set<std::string> theirWays = lists ? neighbours(their) : their.codes;
        for (const std::string& way : ourWays)
            if (!theirWays.contains(way))
                mFound.push_back("stored otherwise: " + path + " as '" + way + "', not '" + *theirWays.begin() + "'");
    }

    void compareChildren(const std::string& path, const Place& our, const Place& their) {
        for (const auto& [kind, count] : our.children)
            if (!their.children.contains(kind))
                mFound.push_back("nowhere else: " + path + '/' + kind);
        constexpr std::size_t kEnoughFiles = 2; // a single one may be an exception
        for (const auto& [kind, count] : their.children) {
            const auto written = our.children.find(kind);
            const int ourCount = written == our.children.end() ? 0 : written->second;
            if (count == their.records && their.files.size() >= kEnoughFiles && ourCount < our.records)
                mFound.push_back((ourCount == 0 ? "never written: " : "not always written: ") + path + '/' + kind);
        }
    }

    /// Objects of one kind of record are in the order of the scene.
    static bool areOfOneRecord(const std::string& first, const std::string& second) {
        const std::size_t space = first.find(' ');
        return space != std::string::npos && first.compare(0, space + 1, second, 0, space + 1) == 0;
    }

    void compareOrder(const std::string& path, const Place& our, const Place& their) {
        for (const auto& [first, second] : our.order) {
            if (path == "Objects" && areOfOneRecord(first, second))
                continue;
            if (!their.order.contains({first, second}) && their.order.contains({second, first}))
                mFound.push_back("out of order: " + path + ": '" + first + "' before '" + second + "'");
        }
    }

    const Structure& mOurs;
    const Structure& mTheirs;
    std::vector<std::string> mFound;
};

} // namespace

void Structure::add(const std::string& fileName, const RecordTree& tree) {
    mTree = &tree;
    mFile = fileName;
    Place& root = mPlaces[""];
    ++root.records;
    root.files.insert(fileName);
    addChildren("", tree.root);
}

const Place* Structure::find(const std::string& path) const {
    const auto found = mPlaces.find(path);
    return found == mPlaces.end() ? nullptr : &found->second;
}

void Structure::addChildren(const std::string& path, const Record& parent) {
    std::vector<std::string> kinds;
    for (const Record& child : parent.children()) {
        const std::string kind = kindOf(path, child);
        if (kind.empty())
            continue;
        if (std::find(kinds.begin(), kinds.end(), kind) == kinds.end())
            kinds.push_back(kind);
        addRecord(path.empty() ? kind : path + '/' + kind, child);
    }
    Place& place = mPlaces[path];
    for (std::size_t i = 0; i < kinds.size(); ++i) {
        ++place.children[kinds[i]];
        for (std::size_t j = i + 1; j < kinds.size(); ++j)
            place.order.emplace(kinds[i], kinds[j]);
    }
}

void Structure::addRecord(const std::string& path, const Record& record) {
    Place& place = mPlaces[path];
    ++place.records;
    place.files.insert(mFile);
    place.codes.insert(storedAs(*mTree, record));
    if (record.hasBlock)
        addChildren(path, record);
}

std::vector<std::string> deviations(const Structure& ours, const Structure& theirs) {
    return Comparison(ours, theirs).run();
}

} // namespace conformance
