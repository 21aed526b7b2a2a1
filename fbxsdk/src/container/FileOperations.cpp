// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The system calls of writing, handling interruptions and short counts.
#include "container/FileOperations.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <ctime>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

int outcome(int result) { return result < 0 ? errno : 0; }

/// Opens for writing. A pipe without a reader would block: it is retried for a limited time.
int openUnlessUnread(const std::string& path) {
    constexpr int kTries = 200;
    constexpr timespec kPause{0, 10'000'000}; // both together two seconds
    int file = -1;
    for (int i = 0; i < kTries; ++i) {
        file = ::open(path.c_str(), O_WRONLY | O_NONBLOCK | O_CLOEXEC);
        struct stat existing {};
        const bool waits = file < 0 && errno == ENXIO && ::stat(path.c_str(), &existing) == 0;
        if (!waits || !S_ISFIFO(existing.st_mode))
            return file;
        ::nanosleep(&kPause, nullptr);
    }
    errno = ENXIO;
    return -1;
}

/// Repeats a system call until all bytes are processed. `step` gets the rest and the number of bytes before it.
template <class Byte, class Step>
int transferAll(std::span<Byte> bytes, const Step& step) {
    std::size_t done = 0;
    while (done < bytes.size()) {
        const ssize_t count = step(bytes.subspan(done), done);
        if (count < 0) {
            if (errno == EINTR)
                continue;
            return errno;
        }
        if (count == 0)
            return EIO;
        done += static_cast<std::size_t>(count);
    }
    return 0;
}

/// Blocks the signal of a broken pipe on this thread, and discards one that arrived meanwhile.
class PipeSignalGuard {
public:
    PipeSignalGuard() {
        sigemptyset(&mSignal);
        sigaddset(&mSignal, SIGPIPE);
        sigset_t pending;
        sigpending(&pending);
        mWasPending = sigismember(&pending, SIGPIPE) == 1;
        pthread_sigmask(SIG_BLOCK, &mSignal, &mBefore);
    }
    PipeSignalGuard(const PipeSignalGuard&) = delete;
    PipeSignalGuard& operator=(const PipeSignalGuard&) = delete;
    ~PipeSignalGuard() {
        if (!mWasPending) {
            constexpr timespec kNow{};
            while (sigtimedwait(&mSignal, nullptr, &kNow) == -1 && errno == EINTR) {
            }
        }
        pthread_sigmask(SIG_SETMASK, &mBefore, nullptr);
    }

private:
    sigset_t mSignal, mBefore;
    bool mWasPending = false;
};

} // namespace

int FileOperations::create(const std::string& path, unsigned permissions, int& file) {
    constexpr mode_t kUsual = 0666; // less the process's mask
    file = ::open(path.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, kUsual);
    if (file < 0)
        return errno;
    // Where the file system has no permissions, the file is written all the same.
    if (permissions != 0 && ::fchmod(file, static_cast<mode_t>(permissions)) != 0 && errno != EPERM &&
        errno != ENOTSUP) {
        const int error = errno;
        ::close(file);
        ::unlink(path.c_str());
        file = -1;
        return error;
    }
    return 0;
}

int FileOperations::openExisting(const std::string& path, int& file) {
    file = openUnlessUnread(path);
    if (file < 0)
        return errno;
    const int error = outcome(::fcntl(file, F_SETFL, ::fcntl(file, F_GETFL) & ~O_NONBLOCK));
    if (error != 0) {
        ::close(file);
        file = -1;
    }
    return error;
}

int FileOperations::write(int file, std::span<const char> bytes) {
    const PipeSignalGuard guard;
    return transferAll(bytes, [file](auto rest, std::size_t) { return ::write(file, rest.data(), rest.size()); });
}

int FileOperations::writeAt(int file, std::uint64_t offset, std::span<const char> bytes) {
    return transferAll(
        bytes,
        [=](auto rest, std::size_t done) {
            return ::pwrite(file, rest.data(), rest.size(), static_cast<off_t>(offset + done));
        });
}

int FileOperations::readAt(int file, std::uint64_t offset, std::span<char> bytes) {
    return transferAll(
        bytes,
        [=](auto rest, std::size_t done) {
            return ::pread(file, rest.data(), rest.size(), static_cast<off_t>(offset + done));
        });
}

int FileOperations::flush(int file) {
    const int error = outcome(::fsync(file));
    // What cannot be flushed at all, such as a device, cannot lose data.
    return error == EINVAL || error == ENOTSUP ? 0 : error;
}

int FileOperations::close(int file) {
    const int error = outcome(::close(file));
    return error == EINTR ? 0 : error; // the descriptor is closed nevertheless
}

int FileOperations::rename(const std::string& from, const std::string& to) {
    return outcome(std::rename(from.c_str(), to.c_str()));
}

int FileOperations::link(const std::string& file, const std::string& secondName) {
    return outcome(::link(file.c_str(), secondName.c_str()));
}

int FileOperations::remove(const std::string& path) { return outcome(::unlink(path.c_str())); }

void FileOperations::flushFolder(const std::string& path) {
    const int folder = ::open(path.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (folder >= 0) {
        ::fsync(folder);
        ::close(folder);
    }
}

FileOperations& systemFileOperations() {
    static FileOperations operations;
    return operations;
}

} // namespace detail
FBXSDK_NAMESPACE_END
