// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A file that appears under its name only when it is complete.
#pragma once

#include <memory>
#include <string>

#include <fbxsdk/FbxStatus.h>

#include "container/ByteOutput.h"
#include "container/FileOperations.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The bytes go to a file of another name in the same folder, which is renamed in commit(). Until then, and
/// after any fault, the previous file is unchanged. Without commit() nothing is left behind.
///
/// A symbolic link is followed: its target is replaced. A pipe or a device cannot be replaced; it gets the bytes
/// in commit(), all at once, and a pipe without a reader fails after a short time. Never more than a small part of the
/// bytes is in memory.
class OutputFile final : public ByteOutput {
public:
    /// The operations must outlive the file.
    explicit OutputFile(std::string fileName, FileOperations& operations = systemFileOperations());
    ~OutputFile() override;

    /// False when the file could not be written anyway; the status says why.
    [[nodiscard]] bool open(FbxStatus& status);

    void write(std::span<const char> bytes) override;
    void overwrite(std::uint64_t offset, std::span<const char> bytes) override;
    /// Appends zeros until that size is reached.
    void extend(std::uint64_t size);
    [[nodiscard]] std::uint64_t size() const override { return mWritten + mBuffer.size(); }
    [[nodiscard]] bool failed() const override { return mError != 0; }
    /// Sets the status: which file failed, and why.
    void report(FbxStatus& status) const;
    /// Why it failed, without its name.
    [[nodiscard]] std::string reason() const;

    /// Puts all bytes on the medium, still under the other name. False when that or any write before it failed; the
    /// status says why. Nothing can be written afterwards.
    [[nodiscard]] bool complete(FbxStatus& status);
    /// Completes the file and renames it.
    [[nodiscard]] bool commit(FbxStatus& status);
    /// Completes files that belong together, which appear in this order: all of them, or none and the previous
    /// files are restored. On a file system without hard links only the last of them can fail without a trace.
    /// Between the first and the last rename there are only renames. A process that is killed then leaves some
    /// files new and some old, each of them complete, and the old ones under second names next to them.
    [[nodiscard]] static bool commitTogether(std::span<OutputFile* const> files, FbxStatus& status);

private:
    bool fail(int error, FbxStatus& status);
    void note(int error);
    void flushBuffer();
    void sendBuffer(std::span<const char> bytes);
    int openBeside(unsigned permissions);
    int openSpool();
    bool openStream(FbxStatus& status);
    bool keepOld(FbxStatus& status);
    bool takeName(FbxStatus& status);
    void forgetOld();
    void closeFile();
    void discard();
    void putBack();
    void sendDirectly();
    int sendTo(int file);

    FileOperations& mOperations;
    std::string mName;      ///< as given, for messages
    std::string mTarget;    ///< after all links are followed
    std::string mFolder;    ///< of the target
    std::string mTemporary; ///< empty when there is none
    std::string mOld;       ///< the second name of the previous file; empty when there is none
    bool mDirect = false;   ///< a pipe or a device
    bool mComplete = false;
    bool mTookName = false;
    bool mStoodAlone = false; ///< there was no previous file
    int mFile = -1;           ///< for large output to a pipe or device: an unnamed file until the end
    int mError = 0;
    std::string mBuffer;
    std::uint64_t mWritten = 0; ///< bytes before those in the buffer
};

} // namespace detail
FBXSDK_NAMESPACE_END
