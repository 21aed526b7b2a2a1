// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// One command, many files: the common part of all commands that inspect files.
#pragma once

#include <functional>
#include <ostream>
#include <string>
#include <string_view>

#include "Commands.h"
#include "JsonWriter.h"
#include "Terminal.h"

namespace tool {

/// The output for one file.
class Page {
public:
    /// `beforeBegin` is called before anything is printed.
    Page(const std::string& file, Form form, const Terminal& terminal, std::ostream& out,
         std::function<void()> beforeBegin)
        : mFile(file), mForm(form), mTerminal(terminal), mOut(out), mBeforeBegin(std::move(beforeBegin)) {}

    [[nodiscard]] const std::string& file() const { return mFile; }
    [[nodiscard]] Form form() const { return mForm; }
    [[nodiscard]] bool isJson() const { return mForm == Form::json || mForm == Form::jsonLines; }
    [[nodiscard]] const Terminal& terminal() const { return mTerminal; }

    /// The stream, once it is certain that the file can be read. From here on nothing should fail.
    std::ostream& begin();
    /// Prints a JSON object that begins with the common keys: the format's name, the file's name, and then those
    /// that `content` adds.
    void json(std::string_view command, const std::function<void(JsonWriter&)>& content);
    [[nodiscard]] bool begun() const { return mBegun; }

private:
    const std::string& mFile;
    Form mForm;
    const Terminal& mTerminal;
    std::ostream& mOut;
    std::function<void()> mBeforeBegin;
    bool mBegun = false;
};

/// Prints a page; throws Unreadable, before it begins, when there is none. Returns an exit status. Several run at the
/// same time when the user requests it.
using Show = std::function<int(Page&)>;

/// Shows all files in their order. A file that fails does not keep the others from being shown; the status is that of
/// the worst. As JSON, several files are an array, or a line each, and a file that failed has an entry with the reason.
int showFiles(const LookOptions& options, std::string_view command, const Show& show);

} // namespace tool
