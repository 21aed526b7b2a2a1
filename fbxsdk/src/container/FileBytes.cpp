// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files by positioned reads into memory that is reserved at once and committed page by page.
#include "container/FileBytes.h"

#include <algorithm>
#include <cerrno>
#include <cstdint>
#include <cstring>
#include <functional>
#include <system_error>
#include <utility>

#include <fcntl.h>
#include <poll.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include <fbxsdk/extensions/Threads.h>

#include "container/FileOperations.h"
#include "container/PageMemory.h"
#include "container/ReadLimits.h"
#include "core/Parallel.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

class FileDescriptor {
public:
    // Opening a pipe must not block until it has a writer.
    explicit FileDescriptor(const std::string& fileName)
        : mNumber(::open(fileName.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK)) {}
    FileDescriptor(const FileDescriptor&) = delete;
    FileDescriptor& operator=(const FileDescriptor&) = delete;
    ~FileDescriptor() {
        if (mNumber >= 0)
            ::close(mNumber);
    }
    [[nodiscard]] int number() const { return mNumber; }
    [[nodiscard]] int release() { return std::exchange(mNumber, -1); }

private:
    int mNumber;
};

std::nullptr_t refuse(const std::string& fileName, const std::string& reason, FbxStatus& status) {
    status.SetCode(FbxStatus::eFailure, "%s: cannot be opened: %s", fileName.c_str(), reason.c_str());
    return nullptr;
}

std::nullptr_t refuse(const std::string& fileName, int error, FbxStatus& status) {
    return refuse(fileName, std::generic_category().message(error), status);
}

bool isBefore(const timespec& a, const timespec& b) {
    return a.tv_sec != b.tv_sec ? a.tv_sec < b.tv_sec : a.tv_nsec < b.tv_nsec;
}

/// Files are stamped with a clock that advances in steps of some milliseconds. One that was written in the very tick
/// in which it is opened could be rewritten without another stamp: such a file is checked a moment later.
bool settledFacts(int file, struct stat& facts) {
    constexpr int kMostTries = 20;
    constexpr timespec kMoment{0, 1'000'000};
    for (int i = 0; i < kMostTries; ++i) {
        timespec now{};
        ::clock_gettime(CLOCK_REALTIME_COARSE, &now);
        if (::fstat(file, &facts) != 0)
            return false;
        if (!S_ISREG(facts.st_mode) || isBefore(facts.st_mtim, now))
            break;
        ::nanosleep(&kMoment, nullptr);
    }
    return true;
}

/// Memory of files up to this size comes from the heap, which takes less time than mapping pages.
constexpr std::size_t kSmallFile = std::size_t{1} << 16;

/// Memory that takes no pages until it is written to.
std::span<char> reserve(std::size_t size) {
    void* const memory =
        ::mmap(nullptr, size, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS | MAP_NORESERVE, -1, 0);
    return memory == MAP_FAILED ? std::span<char>() : std::span(static_cast<char*>(memory), size);
}

/// The error number, or 0 when there is something to read, be it the end.
int waitForBytes(int pipe) {
    pollfd waiting{pipe, POLLIN, 0};
    const int ready = ::poll(&waiting, 1, kMostPipeSilence);
    if (ready < 0)
        return errno == EINTR ? 0 : errno;
    return ready == 0 ? ETIMEDOUT : 0;
}

/// Appends the content of a pipe to the memory. The error number, EFBIG when it is more than that.
int readPipe(int pipe, std::span<char> memory, std::size_t& size) {
    for (size = 0; size < memory.size();) {
        const ssize_t count = ::read(pipe, memory.data() + size, std::min(memory.size() - size, std::size_t{1} << 20));
        if (count > 0)
            size += static_cast<std::size_t>(count);
        else if (count == 0)
            return 0;
        else if (const int error = errno == EAGAIN ? waitForBytes(pipe) : errno; error != 0 && error != EINTR)
            return error;
    }
    return EFBIG;
}

} // namespace

FileBytes::~FileBytes() {
    if (mFile >= 0)
        ::close(mFile);
    if (!mMemory.empty()) {
        allow(mMemory); // the next owner of the memory
        if (!mHeap)
            ::munmap(mMemory.data(), mMemory.size());
    }
}

std::shared_ptr<const FileBytes> FileBytes::open(const std::string& fileName, FbxStatus& status) {
    FileDescriptor file(fileName);
    struct stat facts = {};
    if (file.number() < 0 || !settledFacts(file.number(), facts))
        return refuse(fileName, errno, status);
    if (S_ISDIR(facts.st_mode))
        return refuse(fileName, EISDIR, status);
    const bool isPipe = S_ISFIFO(facts.st_mode);
    if (!S_ISREG(facts.st_mode) && !isPipe)
        return refuse(fileName, "neither a regular file nor a pipe", status);
    const std::shared_ptr<FileBytes> opened(new FileBytes); // first, so that nothing can fail after the reservation
    opened->mName = fileName;
    std::size_t size = isPipe ? kMostPipeBytes : static_cast<std::size_t>(facts.st_size);
    if (size != 0 && !opened->reserveMemory(size))
        return refuse(fileName, errno, status);
    if (isPipe) {
        if (const int error = readPipe(file.number(), opened->mMemory, size); error != 0)
            return refuse(fileName, error, status);
    } else {
        opened->mFile = file.release();
        opened->mModified = facts.st_mtim;
    }
    if (size == 0) {
        status.SetCode(FbxStatus::eInvalidFile, "%s: the %s is empty", fileName.c_str(), isPipe ? "pipe" : "file");
        return nullptr;
    }
    opened->mSize = size;
    forbid(isPipe ? opened->tail() : opened->mMemory);
    const bool isRead = isPipe || size > kSmallFile || faultToStatus(status, [&] {
                            opened->fetchAll();
                            return true;
                        });
    return isRead ? opened : nullptr;
}

bool FileBytes::reserveMemory(std::size_t size) {
    if (size <= kSmallFile) {
        mHeap = std::make_unique_for_overwrite<char[]>(size);
        mMemory = {mHeap.get(), size};
    } else {
        mMemory = reserve(size);
    }
    return !mMemory.empty();
}

void FileBytes::fetchAll() {
    fetch(bytes());
    requireUnchanged();
    ::close(std::exchange(mFile, -1));
}

std::span<const char> FileBytes::tail() const {
    constexpr std::size_t kEnough = std::size_t{1} << 16; // of the gigabytes that are reserved for a pipe
    return mMemory.subspan(mSize, std::min(kEnough, mMemory.size() - mSize));
}

bool FileBytes::contains(std::span<const char> part) const {
    const std::less_equal<const char*> inOrder; // also for pointers into different objects
    const std::span<const char> all = bytes();
    return inOrder(all.data(), part.data()) && inOrder(part.data() + part.size(), all.data() + all.size());
}

void FileBytes::copy(std::span<const char> part, char* destination) const {
    const auto offset = static_cast<std::uint64_t>(part.data() - mMemory.data());
    const int error = systemFileOperations().readAt(mFile, offset, {destination, part.size()});
    if (error == 0)
        return;
    requireUnchanged();
    throw FileFault(mName + ": offset " + std::to_string(offset) +
                    ": cannot be read: " + std::generic_category().message(error));
}

void FileBytes::fetch(std::span<const char> part) const {
    if (mFile < 0)
        return;
    const std::span<char> place = mMemory.subspan(static_cast<std::size_t>(part.data() - mMemory.data()), part.size());
    preferLargePages(place);
    allow(place);
    if (!copyInPieces(part, place.data()))
        copy(part, place.data());
}

bool FileBytes::copyInPieces(std::span<const char> part, char* destination) const {
    constexpr std::size_t kPiece = std::size_t{1} << 23;
    if (part.size() < 2 * kPiece || extensions::maximumThreads() == 1)
        return false;
    try {
        forEachInParallel((part.size() + kPiece - 1) / kPiece,
                          [&](std::size_t i) {
                              const std::size_t from = i * kPiece;
                              copy(part.subspan(from, std::min(kPiece, part.size() - from)), destination + from);
                          });
    } catch (const FileFault&) {
        return false; // of several faults nobody knows which was the first one
    }
    return true;
}

void FileBytes::read(std::span<const char> part, char* destination) const {
    if (mFile < 0) {
        std::memcpy(destination, part.data(), part.size());
        return;
    }
    copy(part, destination);
    requireUnchanged();
}

void FileBytes::requireUnchanged() const {
    struct stat facts = {};
    if (mFile < 0 || ::fstat(mFile, &facts) != 0)
        return;
    if (static_cast<std::size_t>(facts.st_size) != mSize || isBefore(facts.st_mtim, mModified) ||
        isBefore(mModified, facts.st_mtim))
        throw FileFault(mName + ": the file was changed while it was read");
}

void ReadAhead::fetchUpTo(std::size_t offset, std::size_t end) {
    // Bytes are placed from the beginning of a page on, and getting a page takes longer than filling it.
    constexpr std::size_t kSmallestStep = std::size_t{1} << 9, kLargestStep = std::size_t{1} << 18, kPage = 1 << 12;
    mStep = offset > mEnd ? kSmallestStep : std::clamp(2 * mStep, kSmallestStep, kLargestStep);
    const std::size_t start = std::max(offset, mEnd);
    mEnd = std::min((std::max(end, start + mStep) + kPage - 1) / kPage * kPage, mBytes.size());
    mFile->fetch(mBytes.subspan(start, mEnd - start));
}

} // namespace detail
FBXSDK_NAMESPACE_END
