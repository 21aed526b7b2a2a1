// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Safe saving: written beside, flushed, renamed.
#include "container/OutputFile.h"

#include <algorithm>
#include <cerrno>
#include <filesystem>
#include <system_error>
#include <utility>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr std::size_t kBufferBytes = std::size_t{1} << 18;
/// Names that are tried for the file beside the target before giving up.
constexpr int kMostNames = 1000;
/// Links that are followed, as many as the system follows.
constexpr int kMostLinks = 40;

/// The file that a name means. The last of its links may lead to nothing yet.
std::string behindLinks(const std::string& name, int& error) {
    namespace fs = std::filesystem;
    std::error_code failure;
    fs::path path(name);
    for (int i = 0; i < kMostLinks; ++i) {
        if (!fs::is_symlink(fs::symlink_status(path, failure))) {
            return path.string();
        }
        const fs::path next = fs::read_symlink(path, failure);
        path = next.is_absolute() ? next : path.parent_path() / next;
    }
    error = ELOOP;
    return {};
}

std::string folderOf(const std::string& path) {
    const std::size_t slash = path.rfind('/');
    return slash == std::string::npos ? "./" : path.substr(0, slash + 1);
}

} // namespace

OutputFile::OutputFile(std::string fileName) : mOperations(mSystem), mName(std::move(fileName)) {}

OutputFile::OutputFile(std::string fileName, FileOperations& operations)
    : mOperations(operations), mName(std::move(fileName)) {}

OutputFile::~OutputFile() { discard(); }

void OutputFile::note(int error) {
    if (mError == 0) {
        mError = error;
    }
}

bool OutputFile::fail(int error, FbxStatus& status) {
    note(error);
    discard();
    status.SetCode(FbxStatus::eFailure, "%s: cannot be written: %s", mName.c_str(),
                   std::generic_category().message(mError).c_str());
    return false;
}

bool OutputFile::open(FbxStatus& status) {
    int error = 0;
    mTarget = behindLinks(mName, error);
    if (error != 0) {
        return fail(error, status);
    }
    struct stat existing {};
    const bool exists = ::stat(mTarget.c_str(), &existing) == 0;
    if (exists && S_ISDIR(existing.st_mode)) {
        return fail(EISDIR, status);
    }
    // Renaming would replace a file that its owner has locked.
    if (exists && ::faccessat(AT_FDCWD, mTarget.c_str(), W_OK, AT_EACCESS) != 0) {
        return fail(errno, status);
    }
    mDirect = exists && !S_ISREG(existing.st_mode);
    if (mDirect) {
        return true;
    }
    constexpr mode_t kPermissions = 07777;
    error = openBeside(exists ? existing.st_mode & kPermissions : 0U);
    return error == 0 || fail(error, status);
}

int OutputFile::openBeside(unsigned permissions) {
    // Not derived from the target's name, which may be as long as a name can be.
    const std::string prefix = folderOf(mTarget) + ".fbx-" + std::to_string(::getpid()) + "-";
    for (int i = 0; i < kMostNames; ++i) {
        const std::string path = prefix + std::to_string(i) + ".part";
        const int error = mOperations.create(path, permissions, mFile);
        if (error == 0) {
            mTemporary = path;
        }
        if (error != EEXIST) {
            return error;
        }
    }
    return EEXIST;
}

void OutputFile::write(std::span<const char> bytes) {
    if (failed()) {
        return;
    }
    const bool large = !mDirect && bytes.size() >= kBufferBytes;
    if (large) {
        flushBuffer();
        note(failed() ? 0 : mOperations.write(mFile, bytes));
        mWritten += bytes.size();
        return;
    }
    mBuffer.append(bytes.data(), bytes.size());
    if (!mDirect && mBuffer.size() >= kBufferBytes) {
        flushBuffer();
    }
}

void OutputFile::flushBuffer() {
    if (failed() || mBuffer.empty()) {
        return;
    }
    note(mOperations.write(mFile, mBuffer));
    mWritten += mBuffer.size();
    mBuffer.clear();
}

void OutputFile::overwrite(std::uint64_t offset, std::span<const char> bytes) {
    if (failed()) {
        return;
    }
    assert(offset + bytes.size() <= size());
    const auto before =
        static_cast<std::size_t>(offset < mWritten ? std::min<std::uint64_t>(mWritten - offset, bytes.size()) : 0);
    if (before > 0) {
        note(mOperations.writeAt(mFile, offset, bytes.first(before)));
    }
    const std::span<const char> rest = bytes.subspan(before);
    std::copy(rest.begin(), rest.end(),
              mBuffer.begin() + static_cast<std::ptrdiff_t>(std::max(offset, mWritten) - mWritten));
}

bool OutputFile::commit(FbxStatus& status) {
    if (mDirect) {
        sendDirectly();
    } else {
        flushBuffer();
        note(failed() ? 0 : mOperations.flush(mFile));
        closeFile();
        note(failed() ? 0 : mOperations.rename(mTemporary, mTarget));
    }
    if (failed()) {
        return fail(mError, status);
    }
    if (!mDirect) {
        mTemporary.clear();
        mOperations.flushFolder(folderOf(mTarget));
    }
    return true;
}

void OutputFile::sendDirectly() {
    note(failed() ? 0 : mOperations.openExisting(mTarget, mFile));
    note(failed() ? 0 : mOperations.write(mFile, mBuffer));
    closeFile();
}

void OutputFile::closeFile() {
    if (mFile >= 0) {
        note(mOperations.close(mFile));
        mFile = -1;
    }
}

void OutputFile::discard() {
    closeFile();
    if (!mTemporary.empty()) {
        mOperations.remove(mTemporary);
        mTemporary.clear();
    }
    mBuffer.clear();
}

} // namespace detail
FBXSDK_NAMESPACE_END
