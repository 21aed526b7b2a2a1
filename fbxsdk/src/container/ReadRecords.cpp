// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The entry to the container layer: the container of a file is detected by its content, never by its name.
#include <algorithm>
#include <new>
#include <utility>

#include "container/AsciiPreamble.h"
#include "container/AsciiReader.h"
#include "container/BinaryReader.h"
#include "container/FileBytes.h"
#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

/// Reads no more of the file than the detection needs.
bool startsAsAscii(std::span<const char> bytes, ReadAhead& ahead) {
    constexpr std::size_t kFirstLook = std::size_t{1} << 12;
    for (std::size_t size = kFirstLook;; size *= 2) {
        const std::span<const char> start = bytes.first(std::min(size, bytes.size()));
        ahead.need(start);
        if (isAscii(start))
            return true;
        if (start.size() == bytes.size() || !mayBeginAscii(start))
            return false;
    }
}

Container containerOf(std::span<const char> bytes, ReadAhead& ahead) {
    constexpr std::size_t kEnoughForBinary = 32;
    const std::span<const char> start = bytes.first(std::min(kEnoughForBinary, bytes.size()));
    ahead.need(start);
    if (isBinary(start))
        return Container::binary;
    return startsAsAscii(bytes, ahead) ? Container::ascii : Container::unknown;
}

bool readAny(std::span<const char> bytes, RecordTree& tree, FbxStatus& status) {
    ReadAhead ahead(bytes, tree.file.get());
    switch (containerOf(bytes, ahead)) {
    case Container::binary:
        return readBinary(bytes, tree, status);
    case Container::ascii:
        ahead.need(bytes);
        tree.ascii = true;
        return readAscii(bytes, tree, status);
    case Container::unknown:
        break;
    }
    status.SetCode(FbxStatus::eInvalidFile, "%s: neither a binary nor an ASCII FBX file", tree.fileName.c_str());
    return false;
}

std::unique_ptr<RecordTree> readTree(std::span<const char> bytes, std::shared_ptr<const FileBytes> file,
                                     const std::string& fileName, FbxStatus& status) {
    try {
        auto tree = std::make_unique<RecordTree>();
        tree->fileName = fileName;
        tree->fileSize = bytes.size();
        tree->mapping = file;
        tree->file = std::move(file);
        if (!readAny(bytes, *tree, status))
            return nullptr;
        if (tree->file)
            tree->file->requireUnchanged();
        status.Clear();
        return tree;
    } catch (const std::bad_alloc&) {
        status.SetCode(FbxStatus::eInsufficientMemory, "%s: not enough memory", fileName.c_str());
    } catch (const FileFault& fault) {
        status.SetCode(FbxStatus::eFailure, "%s", fault.what());
    }
    return nullptr;
}

} // namespace

Container containerOf(const std::string& fileName, FbxStatus& status) {
    const std::shared_ptr<const FileBytes> file = FileBytes::open(fileName, status);
    if (!file)
        return Container::unknown;
    auto container = Container::unknown;
    const bool known = faultToStatus(status, [&] {
        ReadAhead ahead(file->bytes(), file.get());
        container = containerOf(file->bytes(), ahead);
        return true;
    });
    return known ? container : Container::unknown;
}

std::unique_ptr<RecordTree> readRecords(std::span<const char> bytes, const std::string& fileName, FbxStatus& status) {
    return readTree(bytes, nullptr, fileName, status);
}

std::unique_ptr<RecordTree> readRecords(const std::string& fileName, FbxStatus& status) {
    std::shared_ptr<const FileBytes> file = FileBytes::open(fileName, status);
    if (!file)
        return nullptr;
    const std::span<const char> bytes = file->bytes();
    return readTree(bytes, std::move(file), fileName, status);
}

} // namespace detail
FBXSDK_NAMESPACE_END
