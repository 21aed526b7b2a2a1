// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Safe saving: written next to the target, flushed, renamed.
#include "container/OutputFile.h"

#include <algorithm>
#include <atomic>
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
/// Pieces from this size on are written as they are.
constexpr std::size_t kDirectBytes = std::size_t{1} << 15;
/// Names that are tried for a file of our own before giving up.
constexpr int kMostNames = 1000;
/// Follows the last name that was used, so that thousands of files next to each other do not try each other's names.
std::atomic<unsigned> nextName{0};
/// Links that are followed, as many as the system follows.
constexpr int kMostLinks = 40;

/// The file that a name refers to. The last of its links may be dangling.
std::string behindLinks(const std::string& name, int& error) {
    namespace fs = std::filesystem;
    std::error_code failure;
    fs::path path(name);
    for (int i = 0; i < kMostLinks; ++i) {
        if (!fs::is_symlink(fs::symlink_status(path, failure)))
            return path.string();
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

/// Tries names in the folder until `make` returns another error than that the name exists. `path` is the last one.
template <class Make>
int tryNames(const std::string& folder, std::string& path, const Make& make) {
    // Not derived from the target's name, which may be as long as a name can be.
    const std::string prefix = folder + ".fbx-" + std::to_string(::getpid()) + "-";
    for (int i = 0; i < kMostNames; ++i) {
        path = prefix + std::to_string(nextName++) + ".part";
        const int error = make();
        if (error != EEXIST)
            return error;
    }
    return EEXIST;
}

/// A target that can be written but not replaced.
bool isStream(const struct stat& file) { return !S_ISREG(file.st_mode) && !S_ISDIR(file.st_mode); }

/// Whether the file system, or its rules, does not allow hard links.
bool isWithoutLinks(int error) { return error == EPERM || error == ENOTSUP || error == ENOSYS || error == EMLINK; }

} // namespace

OutputFile::OutputFile(std::string fileName, FileOperations& operations)
    : mOperations(operations), mName(std::move(fileName)) {}

OutputFile::~OutputFile() { discard(); }

void OutputFile::note(int error) {
    if (mError == 0)
        mError = error;
}

void OutputFile::report(FbxStatus& status) const {
    status.SetCode(FbxStatus::eFailure, "%s: %s", mName.c_str(), reason().c_str());
}

std::string OutputFile::reason() const {
    const bool isUnread = mDirect && mError == ENXIO;
    return "cannot be written: " + (isUnread ? "no process reads the pipe" : std::generic_category().message(mError));
}

bool OutputFile::fail(int error, FbxStatus& status) {
    note(error);
    discard();
    report(status);
    return false;
}

bool OutputFile::open(FbxStatus& status) {
    if (mName.empty())
        return fail(ENOENT, status);
    struct stat existing {};
    // Before links are followed: that of a standard stream does not lead to the name of a file.
    if (::stat(mName.c_str(), &existing) == 0 && isStream(existing))
        return openStream(status);
    int error = 0;
    mTarget = behindLinks(mName, error);
    if (error != 0)
        return fail(error, status);
    mFolder = folderOf(mTarget);
    const bool exists = ::stat(mTarget.c_str(), &existing) == 0;
    if (exists && S_ISDIR(existing.st_mode))
        return fail(EISDIR, status);
    // Renaming would replace a file that its owner has locked.
    if (exists && ::faccessat(AT_FDCWD, mTarget.c_str(), W_OK, AT_EACCESS) != 0)
        return fail(errno, status);
    constexpr mode_t kPermissions = 07777;
    error = openBeside(exists ? existing.st_mode & kPermissions : 0U);
    return error == 0 || fail(error, status);
}

bool OutputFile::openStream(FbxStatus& status) {
    mDirect = true;
    mTarget = mName;
    return ::faccessat(AT_FDCWD, mTarget.c_str(), W_OK, AT_EACCESS) == 0 || fail(errno, status);
}

int OutputFile::openBeside(unsigned permissions) {
    std::string path;
    const int error = tryNames(mFolder, path, [&] { return mOperations.create(path, permissions, mFile); });
    if (error == 0)
        mTemporary = std::move(path);
    return error;
}

int OutputFile::openSpool() {
    std::error_code failure;
    const std::string folder = (std::filesystem::temp_directory_path(failure) / "").string();
    if (failure)
        return failure.value();
    constexpr unsigned kOnlyForUs = 0600;
    std::string path;
    const int error = tryNames(folder, path, [&] { return mOperations.create(path, kOnlyForUs, mFile); });
    if (error == 0)
        mOperations.remove(path); // the file itself exists until it is closed
    return error;
}

void OutputFile::write(std::span<const char> bytes) {
    if (failed())
        return;
    if (bytes.size() >= kDirectBytes) {
        flushBuffer();
        sendBuffer(bytes);
        return;
    }
    mBuffer.append(bytes.data(), bytes.size());
    if (mBuffer.size() >= kBufferBytes)
        flushBuffer();
}

void OutputFile::flushBuffer() {
    sendBuffer(mBuffer);
    mBuffer.clear();
}

void OutputFile::sendBuffer(std::span<const char> bytes) {
    if (!failed() && mFile < 0)
        note(openSpool());
    if (!failed() && !bytes.empty())
        note(mOperations.writeAt(mFile, mWritten, bytes));
    mWritten += bytes.size();
}

void OutputFile::overwrite(std::uint64_t offset, std::span<const char> bytes) {
    if (failed())
        return;
    assert(offset + bytes.size() <= size());
    const auto before =
        static_cast<std::size_t>(offset < mWritten ? std::min<std::uint64_t>(mWritten - offset, bytes.size()) : 0);
    if (before > 0)
        note(mOperations.writeAt(mFile, offset, bytes.first(before)));
    const std::span<const char> rest = bytes.subspan(before);
    std::copy(rest.begin(), rest.end(),
              mBuffer.begin() + static_cast<std::ptrdiff_t>(std::max(offset, mWritten) - mWritten));
}

void OutputFile::extend(std::uint64_t newSize) {
    if (failed() || newSize <= size())
        return;
    const std::uint64_t gap = newSize - size();
    if (gap < kBufferBytes) {
        mBuffer.append(static_cast<std::size_t>(gap), '\0');
        return;
    }
    // The gap between the end and a later byte is zero, and takes no space where the file system supports it.
    flushBuffer();
    mWritten = newSize - 1;
    mBuffer.push_back('\0');
}

bool OutputFile::commit(FbxStatus& status) {
    OutputFile* const only = this;
    return commitTogether({&only, 1}, status);
}

bool OutputFile::commitTogether(std::span<OutputFile* const> files, FbxStatus& status) {
    const auto all = [&](std::span<OutputFile* const> some, bool (OutputFile::*step)(FbxStatus&)) {
        return std::all_of(some.begin(), some.end(), [&](OutputFile* file) { return (file->*step)(status); });
    };
    // After the last rename nothing can fail and make its old file necessary.
    const bool done = all(files, &OutputFile::complete) && all(files.first(files.size() - 1), &OutputFile::keepOld) &&
                      all(files, &OutputFile::takeName);
    for (OutputFile* file : files)
        if (done)
            file->forgetOld();
        else
            file->discard();
    for (std::size_t i = 0; done && i < files.size(); ++i) {
        const bool again = i + 1 < files.size() && files[i + 1]->mFolder == files[i]->mFolder;
        if (!again && !files[i]->mDirect)
            files[i]->mOperations.flushFolder(files[i]->mFolder);
    }
    return done;
}

bool OutputFile::complete(FbxStatus& status) {
    if (!mDirect && !mComplete && !failed()) {
        flushBuffer();
        note(failed() ? 0 : mOperations.flush(mFile));
        closeFile();
        mComplete = true;
    }
    return !failed() || fail(mError, status);
}

bool OutputFile::keepOld(FbxStatus& status) {
    if (mDirect)
        return true;
    std::string path;
    const int error = tryNames(mFolder, path, [&] { return mOperations.link(mTarget, path); });
    if (error == 0)
        mOld = std::move(path);
    mStoodAlone = error == ENOENT;
    return error == 0 || mStoodAlone || isWithoutLinks(error) || fail(error, status);
}

bool OutputFile::takeName(FbxStatus& status) {
    if (mDirect) {
        sendDirectly();
        return !failed() || fail(mError, status);
    }
    const int error = mOperations.rename(mTemporary, mTarget);
    if (error != 0)
        return fail(error, status);
    mTemporary.clear();
    mTookName = true;
    return true;
}

void OutputFile::forgetOld() {
    mTookName = false;
    discard();
}

void OutputFile::sendDirectly() {
    if (mFile >= 0)
        flushBuffer();
    int target = -1;
    note(failed() ? 0 : mOperations.openExisting(mTarget, target));
    if (failed())
        return;
    note(sendTo(target));
    note(mOperations.close(target));
}

int OutputFile::sendTo(int target) {
    std::string piece;
    for (std::uint64_t offset = 0; offset < mWritten; offset += piece.size()) {
        piece.resize(static_cast<std::size_t>(std::min<std::uint64_t>(mWritten - offset, kBufferBytes)));
        int error = mOperations.readAt(mFile, offset, piece);
        error = error == 0 ? mOperations.write(target, piece) : error;
        if (error != 0)
            return error;
    }
    return mOperations.write(target, mBuffer);
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
    putBack();
    mBuffer.clear();
}

void OutputFile::putBack() {
    if (mTookName && !mOld.empty()) {
        // Where another file of the same name has been restored already, both names stay.
        if (mOperations.rename(mOld, mTarget) == 0)
            mOperations.remove(mOld);
    } else if (mTookName && mStoodAlone) {
        mOperations.remove(mTarget);
    } else if (!mOld.empty()) {
        mOperations.remove(mOld);
    }
    mTookName = false;
    mOld.clear();
}

} // namespace detail
FBXSDK_NAMESPACE_END
