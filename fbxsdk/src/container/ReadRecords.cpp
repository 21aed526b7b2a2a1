// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The way into the container layer: which container a file is, its content decides, never its name.
#include <new>

#include "container/AsciiPreamble.h"
#include "container/AsciiReader.h"
#include "container/BinaryReader.h"
#include "container/MappedFile.h"
#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

bool readEither(std::span<const char> bytes, RecordTree& tree, FbxStatus& status) {
    if (isBinary(bytes)) {
        return readBinary(bytes, tree, status);
    }
    if (isAscii(bytes)) {
        tree.ascii = true;
        return readAscii(bytes, tree, status);
    }
    status.SetCode(FbxStatus::eInvalidFile, "%s: neither a binary nor an ASCII FBX file", tree.fileName.c_str());
    return false;
}

} // namespace

std::unique_ptr<RecordTree> readRecords(std::span<const char> bytes, const std::string& fileName, FbxStatus& status) {
    try {
        auto tree = std::make_unique<RecordTree>();
        tree->fileName = fileName;
        tree->fileSize = bytes.size();
        if (!readEither(bytes, *tree, status)) {
            return nullptr;
        }
        status.Clear();
        return tree;
    } catch (const std::bad_alloc&) {
        status.SetCode(FbxStatus::eInsufficientMemory, "%s: not enough memory", fileName.c_str());
        return nullptr;
    }
}

std::unique_ptr<RecordTree> readRecords(const std::string& fileName, FbxStatus& status) {
    const std::shared_ptr<const MappedFile> file = MappedFile::open(fileName, status);
    if (!file) {
        return nullptr;
    }
    std::unique_ptr<RecordTree> tree = readRecords(file->bytes(), fileName, status);
    if (tree) {
        tree->mapping = file;
        tree->file = file;
    }
    return tree;
}

} // namespace detail
FBXSDK_NAMESPACE_END
