// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A file as read-only memory.
#include "container/MappedFile.h"

#include <cerrno>
#include <functional>
#include <system_error>

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include "container/PageMemory.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

class FileDescriptor {
public:
    // Opening a pipe must not wait for somebody to write into it.
    explicit FileDescriptor(const std::string& fileName)
        : mNumber(::open(fileName.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK)) {}
    FileDescriptor(const FileDescriptor&) = delete;
    FileDescriptor& operator=(const FileDescriptor&) = delete;
    ~FileDescriptor() {
        if (mNumber >= 0) {
            ::close(mNumber);
        }
    }
    [[nodiscard]] int number() const { return mNumber; }

private:
    int mNumber;
};

std::shared_ptr<const MappedFile> refuse(const std::string& fileName, const std::string& reason, FbxStatus& status) {
    status.SetCode(FbxStatus::eFailure, "%s: cannot be opened: %s", fileName.c_str(), reason.c_str());
    return nullptr;
}

std::shared_ptr<const MappedFile> refuse(const std::string& fileName, int error, FbxStatus& status) {
    return refuse(fileName, std::generic_category().message(error), status);
}

} // namespace

MappedFile::~MappedFile() {
    // munmap takes memory that was never written to as writable; the interface knows no other.
    ::munmap(const_cast<char*>(mBytes.data()), mBytes.size());
}

bool MappedFile::contains(std::span<const char> bytes) const {
    const std::less_equal<const char*> inOrder; // also for pointers that do not belong together
    return inOrder(mBytes.data(), bytes.data()) && inOrder(bytes.data() + bytes.size(), mBytes.data() + mBytes.size());
}

void MappedFile::release(std::span<const char> bytes) const {
    if (contains(bytes)) {
        releasePages(bytes); // nothing was ever written to them, so nothing is lost with them
    }
}

std::shared_ptr<const MappedFile> MappedFile::open(const std::string& fileName, FbxStatus& status) {
    const FileDescriptor file(fileName);
    struct stat facts = {};
    if (file.number() < 0 || ::fstat(file.number(), &facts) != 0) {
        return refuse(fileName, errno, status);
    }
    if (S_ISDIR(facts.st_mode)) {
        return refuse(fileName, EISDIR, status);
    }
    if (!S_ISREG(facts.st_mode)) {
        return refuse(fileName, "not a regular file", status);
    }
    if (facts.st_size == 0) {
        status.SetCode(FbxStatus::eInvalidFile, "%s: the file is empty", fileName.c_str());
        return nullptr;
    }
    const auto size = static_cast<std::size_t>(facts.st_size);
    const std::shared_ptr<MappedFile> mapped(new MappedFile); // first, so that nothing can fail behind the mapping
    void* const memory = ::mmap(nullptr, size, PROT_READ, MAP_PRIVATE, file.number(), 0);
    if (memory == MAP_FAILED) {
        return refuse(fileName, errno, status);
    }
    mapped->mBytes = {static_cast<const char*>(memory), size};
    return mapped;
}

} // namespace detail
FBXSDK_NAMESPACE_END
