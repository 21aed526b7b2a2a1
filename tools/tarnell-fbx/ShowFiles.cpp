// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files one after another, or several at the same time, each on a thread of its own; the pages come in order either
// way.
#include "ShowFiles.h"

#include <algorithm>
#include <condition_variable>
#include <iostream>
#include <mutex>
#include <sstream>
#include <thread>
#include <vector>

#include "FileList.h"
#include "Progress.h"
#include "StandardInput.h"
#include "TerminalText.h"

namespace tool {

std::ostream& Page::begin() {
    if (!mBegun)
        mBeforeBegin();
    mBegun = true;
    return mOut;
}

void Page::json(std::string_view command, const std::function<void(JsonWriter&)>& content) {
    JsonWriter json(begin(), mForm == Form::json);
    json.beginObject();
    json.key("format");
    json.text("tarnell-fbx " + std::string(command) + " 1");
    json.key("file");
    json.text(withoutKeptName(mFile));
    content(json);
    json.endObject();
    if (mForm == Form::jsonLines)
        mOut << '\n';
}

namespace {

/// The text before, after and between several pages.
struct Frame {
    std::string_view before, between, after;
};

Frame frameOf(Form form, bool several) {
    if (form == Form::json)
        return several ? Frame{"[\n", ",\n", "\n]\n"} : Frame{"", "", "\n"};
    return form == Form::text || form == Form::plot ? Frame{"", "\n", ""} : Frame{};
}

class Batch {
public:
    Batch(const LookOptions& options, std::string_view command, const Show& show)
        : mForm(options.form), mCommand(command), mShow(show), mTerminal(standardTerminal()) {
        const FileList list = expandFiles(options.files);
        mFiles = list.files;
        for (const std::string& pattern : list.unmatched) {
            printError(pattern, "no file matches the pattern");
            mStatus = kUnreadable;
        }
        mFrame = frameOf(mForm, options.files.size() > 1 || mFiles.size() != 1);
        mWorkers = std::min(static_cast<std::size_t>(std::max(options.jobs, 1)), mFiles.size());
    }

    int run() {
        if (mFiles.empty() && mForm != Form::json)
            return mStatus;
        std::cout << mFrame.before;
        if (mWorkers > 1)
            runTogether();
        else
            runInTurn();
        std::cout << mFrame.after;
        return mStatus;
    }

private:
    struct Result {
        int status = kSuccess;
        std::string text;
        bool done = false;
    };

    int showOne(const std::string& file, std::ostream& out, const std::function<void()>& beforeBegin) {
        Page page(file, mForm, mTerminal, out, beforeBegin);
        const Outcome outcome = attempt([&] { return mShow(page); });
        if (!outcome.reason.empty()) {
            mProgress.hide();
            printError(file, outcome.reason);
            if (page.isJson() && !page.begun()) {
                page.json(
                    mCommand,
                    [&](JsonWriter& json) {
                        json.key("error");
                        json.text(outcome.reason);
                    });
            }
        }
        return outcome.status;
    }

    void announce(std::size_t index) {
        mProgress.say(mFiles.size() > 1
                          ? std::to_string(index + 1) + " of " + std::to_string(mFiles.size()) + ": " + mFiles[index]
                          : "reading " + mFiles[index]);
    }

    /// Before a page: where pages and progress are on one terminal, the progress line is removed.
    void beginPage() {
        if (mOutputIsShown)
            mProgress.hide();
        std::cout << (mBegun ? mFrame.between : "");
        mBegun = true;
    }
    void endPage() const {
        if (mOutputIsShown)
            std::cout << std::flush;
    }

    void runInTurn() {
        for (std::size_t i = 0; i < mFiles.size(); ++i) {
            announce(i);
            mStatus = std::max(mStatus, showOne(mFiles[i], std::cout, [this] { beginPage(); }));
            endPage();
        }
    }

    void runTogether() {
        mResults.resize(mFiles.size());
        std::vector<std::jthread> threads;
        for (std::size_t i = 0; i < mWorkers; ++i)
            threads.emplace_back([this](const std::stop_token& stop) { work(stop); });
        for (std::size_t i = 0; i < mFiles.size(); ++i) {
            announce(i);
            const Result result = takeResult(i);
            mStatus = std::max(mStatus, result.status);
            if (result.text.empty())
                continue;
            beginPage();
            std::cout << result.text;
            endPage();
        }
    }

    Result takeResult(std::size_t index) {
        std::unique_lock lock(mMutex);
        mChanged.wait(lock, [&] { return mResults[index].done; });
        Result result = std::move(mResults[index]);
        mPrinted = index + 1;
        mChanged.notify_all();
        return result;
    }

    /// The next file, once all but a few of those before it have been printed: waiting pages take memory.
    bool takeFile(const std::stop_token& stop, std::size_t& index) {
        std::unique_lock lock(mMutex);
        index = mNext++;
        return mChanged.wait(lock, stop, [&] { return index >= mFiles.size() || index < mPrinted + mWorkers * 4; }) &&
               index < mFiles.size();
    }

    void work(const std::stop_token& stop) {
        std::size_t index = 0;
        while (takeFile(stop, index)) {
            std::ostringstream out;
            Result result{showOne(mFiles[index], out, [] {}), {}, true};
            result.text = std::move(out).str();
            const std::lock_guard lock(mMutex);
            mResults[index] = std::move(result);
            mChanged.notify_all();
        }
    }

    Form mForm;
    std::string_view mCommand;
    const Show& mShow;
    Terminal mTerminal;
    std::vector<std::string> mFiles;
    Frame mFrame;
    bool mOutputIsShown = isTerminal(stdout);
    Progress mProgress;
    bool mBegun = false;
    int mStatus = kSuccess;

    std::size_t mWorkers = 1;
    std::mutex mMutex;
    std::condition_variable_any mChanged;
    std::size_t mNext = 0, mPrinted = 0;
    std::vector<Result> mResults;
};

} // namespace

int showFiles(const LookOptions& options, std::string_view command, const Show& show) {
    return Batch(options, command, show).run();
}

} // namespace tool
