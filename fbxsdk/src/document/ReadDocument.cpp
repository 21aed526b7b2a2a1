// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The generation of a file, and the common part of reading all of them.
#include <limits>

#include "container/FileFormat.h"
#include "document/DocumentBuilder.h"
#include "document/FileTicks.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr std::uint32_t kFirstVersionOfGeneration6 = 6000;
constexpr std::uint32_t kFirstVersionOfGeneration7 = 7000;
/// The version that binary files before 6.0 state, whatever their document's version.
constexpr std::uint32_t kOldContainerVersion = kOldestVersion;

std::uint32_t statedVersion(const Record& root) {
    const Record* header = root.child("FBXHeaderExtension");
    const std::int64_t version = header ? header->childValue("FBXVersion").toInteger() : 0;
    return version > 0 && version <= std::numeric_limits<std::uint32_t>::max() ? static_cast<std::uint32_t>(version)
                                                                               : 0;
}

/// Whether any object of the file is identified by a number (from 7.0 on) or by its name (6.x).
bool hasObjects(const Record& root, bool numbered) {
    for (const Record& section : root.children())
        if (section.name == "Objects")
            for (const Record& object : section.children())
                if (!object.values.empty() && object.value(0).isNumber() == numbered)
                    return true;
    return false;
}

/// For files that state no version at all.
std::uint32_t likelyVersion(const Record& root) {
    if (hasObjects(root, /*numbered*/ false) && !hasObjects(root, /*numbered*/ true))
        return 6100;
    return root.child("Model") && !root.child("Objects") ? 5000 : 7000;
}

std::uint32_t versionOf(const RecordTree& tree) {
    const bool containerDecides = tree.version != 0 && (tree.ascii || tree.version != kOldContainerVersion);
    if (containerDecides)
        return tree.version;
    if (const std::uint32_t stated = statedVersion(tree.root); stated != 0)
        return stated;
    return tree.version != 0 ? tree.version : likelyVersion(tree.root);
}

/// Newer headers may select the short time unit.
std::int64_t ticksPerSecondOf(const Record& root) {
    constexpr std::int64_t kFirstHeaderVersion = 1004;
    constexpr std::int64_t kUsualUnit = 127;
    const Record* header = root.child("FBXHeaderExtension");
    const Record* flags = header ? header->child("OtherFlags") : nullptr;
    if (!flags || !flags->child("TCDefinition") ||
        header->childValue("FBXHeaderVersion").toInteger() < kFirstHeaderVersion)
        return kTicksPerSecond;
    return flags->childValue("TCDefinition").toInteger() == kUsualUnit ? kTicksPerSecond : kShortTicksPerSecond;
}

std::string creatorOf(const Record& root) {
    const Record* header = root.child("FBXHeaderExtension");
    const std::string_view creator = root.childValue("Creator").toText();
    return std::string(creator.empty() && header ? header->childValue("Creator").toText() : creator);
}

/// The version decides, except in a file whose objects are all in the other form.
bool isGeneration7(std::uint32_t version, const Record& root) {
    const bool stated = version >= kFirstVersionOfGeneration7;
    const bool fits = hasObjects(root, /*numbered*/ stated) || !hasObjects(root, /*numbered*/ !stated);
    return fits ? stated : !stated;
}

/// Whether the counts in the head of the file state objects of this kind; without a kind, any.
bool promises(const Record& root, std::string_view kind = {}) {
    const Record* definitions = root.child("Definitions");
    if (!definitions)
        return false;
    for (const Record& type : definitions->children()) {
        const std::string_view name = type.value(0).toText();
        if (type.name == "ObjectType" && name != "GlobalSettings" && (kind.empty() || name == kind) &&
            type.childValue("Count").toInteger() > 0)
            return true;
    }
    return false;
}

/// Whether a section is missing although its content is stated, or has a name and nothing else.
bool lacks(const Record& root, std::string_view section, bool promised) {
    const Record* record = root.child(section);
    return record ? !record->hasBlock : promised;
}

/// A text has no end mark: a file truncated between two sections looks complete, and would be an empty scene.
bool checkSections(const RecordTree& tree, FbxStatus& status) {
    const char* missing = nullptr;
    if (tree.ascii && lacks(tree.root, "Objects", promises(tree.root)))
        missing = "objects";
    else if (tree.ascii && lacks(tree.root, "Connections", promises(tree.root, "Model")))
        missing = "connections";
    if (missing)
        status.SetCode(FbxStatus::eInvalidFile, "%s: the file ends before its %s", tree.fileName.c_str(), missing);
    return missing == nullptr;
}

bool readByGeneration(DocumentBuilder& builder, FbxStatus& status) {
    const std::uint32_t version = builder.document().version;
    if (version < kFirstVersionOfGeneration6)
        return readGeneration5(builder, status);
    if (isGeneration7(version, builder.root()))
        readGeneration7(builder);
    else
        readGeneration6(builder);
    return true;
}

} // namespace

std::unique_ptr<Document> readDocument(std::unique_ptr<RecordTree> tree, FbxStatus& status) {
    const std::uint32_t version = versionOf(*tree);
    if (!isSupportedVersion(version)) {
        status.SetCode(FbxStatus::eInvalidFileVersion,
                       "%s: file version %u is not supported; supported versions are %u to %u", tree->fileName.c_str(),
                       version, kOldestVersion, kFirstUnknownVersion - 1);
        return nullptr;
    }
    if (!checkSections(*tree, status) || !checkValueCounts(*tree, status))
        return nullptr;
    DocumentBuilder builder(std::move(tree), version);
    builder.document().fileTicksPerSecond = ticksPerSecondOf(builder.root());
    builder.document().creator = creatorOf(builder.root());
    if (!readByGeneration(builder, status))
        return nullptr;
    cleanConnections(builder);
    return builder.release();
}

std::unique_ptr<Document> readDocument(const std::string& fileName, FbxStatus& status) {
    std::unique_ptr<RecordTree> tree = readRecords(fileName, status);
    return tree ? readDocument(std::move(tree), status) : nullptr;
}

} // namespace detail
FBXSDK_NAMESPACE_END
