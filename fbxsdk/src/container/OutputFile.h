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
/// in commit(), all at once.
class OutputFile final : public ByteOutput {
public:
    explicit OutputFile(std::string fileName);
    /// The operations must outlive the file.
    OutputFile(std::string fileName, FileOperations& operations);
    ~OutputFile() override;

    /// False when the file could not be written anyway; the status says why.
    [[nodiscard]] bool open(FbxStatus& status);

    void write(std::span<const char> bytes) override;
    void overwrite(std::uint64_t offset, std::span<const char> bytes) override;
    [[nodiscard]] std::uint64_t size() const override { return mWritten + mBuffer.size(); }
    [[nodiscard]] bool failed() const override { return mError != 0; }

    /// Completes the file. False when that or any write before it failed; the status says why.
    [[nodiscard]] bool commit(FbxStatus& status);

private:
    bool fail(int error, FbxStatus& status);
    void note(int error);
    void flushBuffer();
    int openBeside(unsigned permissions);
    void closeFile();
    void discard();
    void sendDirectly();

    FileOperations mSystem;
    FileOperations& mOperations;
    std::string mName;      ///< as given, for messages
    std::string mTarget;    ///< behind all links
    std::string mTemporary; ///< empty when there is none
    bool mDirect = false;   ///< a pipe or a device: everything stays in the buffer until the end
    int mFile = -1;
    int mError = 0;
    std::string mBuffer;
    std::uint64_t mWritten = 0; ///< bytes before those in the buffer
};

} // namespace detail
FBXSDK_NAMESPACE_END
