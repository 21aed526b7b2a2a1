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

/// The bytes go to a file of another name in the same folder, which takes the name over in commit(). Until then, and
/// after any fault, what stood there before is as it was. Without commit() nothing is left behind.
///
/// A link is followed: the file that it leads to is replaced. A pipe or a device cannot be replaced; it gets the bytes
/// in commit(), all at once, and a pipe that nobody reads is given up soon. Never more than a small part of the bytes
/// is in memory.
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
    /// Says in the status which file failed, and why.
    void report(FbxStatus& status) const;
    /// Why it failed, without its name.
    [[nodiscard]] std::string reason() const;

    /// Puts all bytes on the medium, still under the other name. False when that or any write before it failed; the
    /// status says why. Nothing can be written afterwards.
    [[nodiscard]] bool complete(FbxStatus& status);
    /// Completes the file and gives it its name.
    [[nodiscard]] bool commit(FbxStatus& status);
    /// Completes files that belong together, which appear in this order: all of them, or none and what stood there
    /// before is there again. On a file system without hard links only the last of them can fail without a trace.
    /// Between the first name and the last nothing happens but that names change. Who is killed just then leaves some
    /// files new and some old, each of them complete, and the old ones under second names beside them.
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
    std::string mTarget;    ///< behind all links
    std::string mFolder;    ///< of the target
    std::string mTemporary; ///< empty when there is none
    std::string mOld;       ///< the second name of what stood there before; empty when there is none
    bool mDirect = false;   ///< a pipe or a device
    bool mComplete = false;
    bool mTookName = false;
    bool mStoodAlone = false; ///< nothing stood there before
    int mFile = -1;           ///< for a pipe or device that gets much: a nameless file until the end
    int mError = 0;
    std::string mBuffer;
    std::uint64_t mWritten = 0; ///< bytes before those in the buffer
};

} // namespace detail
FBXSDK_NAMESPACE_END
