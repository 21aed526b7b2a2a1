// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reads every file of the corpus, compares it with its reference and prints a table. Fails when a row agrees less than
// expected.json states, or when the files that differ are not those listed there. With --through every file is
// rewritten as well, and its copies must agree with the reference as well as the file itself does.
#include "Converting.h"
#include "Corpus.h"
#include "Expectations.h"
#include "FaithfulRows.h"
#include "Rewriting.h"
#include "RoundTrip.h"
#include "Rows.h"

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstring>
#include <exception>
#include <memory>
#include <string_view>

namespace conformance {
namespace {

constexpr int kSkipped = 77; // ctest's SKIP_RETURN_CODE
constexpr int kUsage = 2;
constexpr std::size_t kDifferencesPerFile = 1;
constexpr std::size_t kAllDifferences = 1000;

constexpr const char* kUsageText =
    "usage: conformance [--faithful] [--file NAME] [--update] [--quiet] [--through VERSION:ENCODING]…\n"
    "                   [--converted YEAR:ENCODING]…\n"
    "  --faithful   the second table: what a host sees that asks for what the application shows\n"
    "  --file NAME  all differences of one file\n"
    "  --update     write the numbers of this run to expected.json, or faithful.json\n"
    "  --quiet      the table and the violations only\n"
    "  --through    check copies, written for example as FBX201400:binary; once for each form\n"
    "  --converted  check what the tool's convert makes of the files, for example of 2014:ascii; once for each form\n";

struct Options {
    std::string file;
    std::vector<std::string> through, converted;
    bool update = false;
    bool quiet = false;
    bool faithful = false;
};

std::span<const Row> rowsOf(const Options& options) { return options.faithful ? faithfulRows() : rows(); }

bool parse(int argc, char** argv, Options& options) {
    for (int i = 1; i < argc; ++i)
        if (std::strcmp(argv[i], "--update") == 0)
            options.update = true;
        else if (std::strcmp(argv[i], "--quiet") == 0)
            options.quiet = true;
        else if (std::strcmp(argv[i], "--faithful") == 0)
            options.faithful = true;
        else if (std::strcmp(argv[i], "--file") == 0 && i + 1 < argc)
            options.file = argv[++i];
        else if (std::strcmp(argv[i], "--through") == 0 && i + 1 < argc && parseWrittenForm(argv[i + 1]))
            options.through.emplace_back(argv[++i]);
        else if (std::strcmp(argv[i], "--converted") == 0 && i + 1 < argc && parseConvertedForm(argv[i + 1]))
            options.converted.emplace_back(argv[++i]);
        else
            return false;
    return true;
}

void record(const Row& row, const CorpusFile& file, const Findings& findings, Results& results) {
    RowResult& result = results[row.name];
    result.compared += findings.compared();
    result.agreeing += findings.agreeing();
    if (findings.compared() > 0)
        ++result.files;
    if (findings.differs())
        result.differingFiles.insert(file.name);
}

void printDifferences(const Row& row, const CorpusFile& file, const Findings& findings) {
    for (const std::string& difference : findings.differences())
        std::printf("%s: %s: %s\n", row.name, file.name.c_str(), difference.c_str());
    const auto untold =
        findings.compared() - findings.agreeing() - static_cast<std::int64_t>(findings.differences().size());
    if (untold > 0)
        std::printf("    and %lld more of %lld\n", static_cast<long long>(untold),
                    static_cast<long long>(findings.compared()));
}

/// Whether all samples of a clip take minutes: a few clips of the corpus last for days. The local ones, which are those
/// of the curves, are compared all the same.
bool takesMinutes(const Row& row, const Reference& reference) {
    constexpr double kMostFrames = 1e6;
    const std::string_view name = row.name;
    const bool isLong = std::any_of(reference.stacks.begin(), reference.stacks.end(), [&](const ReferenceStack& stack) {
        return (stack.end - stack.begin) * reference.fps > kMostFrames;
    });
    return isLong && name.starts_with("library") && name != "libraryLocalSamples";
}

void checkFile(const CorpusFile& file, const Options& options, Results& results) {
    const Reference reference = file.reference ? readReference(*file.reference) : Reference{};
    LoadedFile loaded(file, reference);
    if (!file.reference)
        return; // nothing to compare with; it has been read
    for (const Row& row : rowsOf(options)) {
        if (!reference.loads && row.name != std::string_view("loads"))
            continue;
        if (options.file.empty() && takesMinutes(row, reference)) {
            std::printf("%s: %s: left out, a clip of more than a million frames; --file compares it\n", row.name,
                        file.name.c_str());
            continue;
        }
        Findings findings(options.file.empty() ? kDifferencesPerFile : kAllDifferences);
        row.check(loaded, findings);
        record(row, file, findings, results);
        if (!options.quiet)
            printDifferences(row, file, findings);
    }
}

void printTable(const Options& options, const Results& results) {
    std::printf("\n%-20s %6s %9s %9s %9s %9s  %s\n", "row", "files", "differing", "compared", "agreeing", "percent",
                "");
    for (const Row& row : rowsOf(options)) {
        const auto found = results.find(row.name);
        const RowResult result = found == results.end() ? RowResult{} : found->second;
        const double percent =
            result.compared == 0 ? 100.0
                                 : 100.0 * static_cast<double>(result.agreeing) / static_cast<double>(result.compared);
        std::printf("%-20s %6d %9zu %9lld %9lld %8.3f%%  %s\n", row.name, result.files, result.differingFiles.size(),
                    static_cast<long long>(result.compared), static_cast<long long>(result.agreeing), percent,
                    row.meaning);
    }
}

/// Every differing file of every row, with the reason.
void printReasons(const Options& options, const Results& results, const Expectations& expectations) {
    for (const Row& row : rowsOf(options)) {
        const auto found = results.find(row.name);
        if (found == results.end() || found->second.differingFiles.empty())
            continue;
        std::printf("\n%s differs in\n", row.name);
        for (const std::string& file : found->second.differingFiles) {
            const std::string reason = expectations.reasonOf(row.name, file);
            std::printf("  %-48s %s\n", file.c_str(), reason.empty() ? "(no reason is known)" : reason.c_str());
        }
    }
    std::puts("");
}

int judge(const Options& options, const Results& results) {
    Expectations expectations(options.faithful ? TARNELL_CONFORMANCE_FAITHFUL : TARNELL_CONFORMANCE_EXPECTED);
    printReasons(options, results, expectations);
    if (options.update) {
        expectations.update(results);
        expectations.write();
    }
    const std::vector<std::string> violations = expectations.violations(results);
    for (const std::string& violation : violations)
        std::printf("FAILED %s\n", violation.c_str());
    return violations.empty() ? 0 : 1;
}

/// The copies of all files in one form, and how they compare.
struct CopiedCorpus {
    RewrittenCorpus files;
    RoundTrip comparison;

    CopiedCorpus(const std::filesystem::path& corpus, const std::string& form)
        : files(corpus, *parseWrittenForm(form)), comparison(TARNELL_CONFORMANCE_REWRITTEN, form) {}
};

/// Checks one file, and its copies against it.
void checkCopies(const CorpusFile& file, const Options& options,
                 const std::vector<std::unique_ptr<CopiedCorpus>>& forms) {
    Options silent = options;
    silent.quiet = true;
    Results before;
    checkFile(file, silent, before);
    for (const std::unique_ptr<CopiedCorpus>& form : forms) {
        if (const std::optional<CorpusFile> copy = form->files.rewrite(file)) {
            Results after;
            checkFile(*copy, options, after);
            form->comparison.add(file.name, before, after);
        }
    }
}

/// Prints how the copies of one form compare; returns whether that fails the run.
bool judgeRoundTrip(const RoundTrip& comparison, const Options& options) {
    comparison.print();
    const std::vector<std::string> violations =
        options.file.empty() ? comparison.violations() : std::vector<std::string>();
    for (const std::string& violation : violations)
        std::printf("FAILED %s\n", violation.c_str());
    return !violations.empty();
}

/// Checks the copies of all files, in every form, against the files.
int runThrough(const Options& options, const std::filesystem::path& corpus) {
    std::vector<std::unique_ptr<CopiedCorpus>> forms;
    for (const std::string& form : options.through)
        forms.push_back(std::make_unique<CopiedCorpus>(corpus, form));
    for (const CorpusFile& file : listCorpus(corpus))
        if (options.file.empty() || file.name == options.file)
            checkCopies(file, options, forms);
    bool failed = false;
    for (const std::unique_ptr<CopiedCorpus>& form : forms)
        failed = judgeRoundTrip(form->comparison, options) || failed;
    return failed ? 1 : 0;
}

// ---- Through convert ----

/// The converted files of one form, and how they compare.
struct ConvertedForms {
    ConvertedCorpus files;
    RoundTrip comparison;

    explicit ConvertedForms(const std::string& form)
        : files(*parseConvertedForm(form)), comparison(TARNELL_CONFORMANCE_REWRITTEN, "convert " + form) {}
};

void checkConvertible(LoadedFile& loaded, const CorpusFile& file, const Options& options, Results& results) {
    for (const Row& row : faithfulRows()) {
        if (!survivesConversion(row))
            continue;
        Findings findings(options.file.empty() ? kDifferencesPerFile : kAllDifferences);
        row.check(loaded, findings);
        record(row, file, findings, results);
        if (!options.quiet)
            printDifferences(row, file, findings);
    }
}

/// Checks the conversion of one file against the file itself.
void checkConversions(const CorpusFile& file, const Options& options,
                      const std::vector<std::unique_ptr<ConvertedForms>>& forms) {
    if (!file.reference)
        return;
    const Reference reference = readReference(*file.reference);
    if (!reference.loads || isLongClip(reference))
        return; // nothing to convert, and clips of days
    Options silent = options;
    silent.quiet = true;
    Results before;
    LoadedFile loaded(file, reference);
    loaded.compareWholeFrames();
    const FlatPlaces places = flatPlacesOf(loaded);
    checkConvertible(loaded, file, silent, before);
    for (const std::unique_ptr<ConvertedForms>& form : forms) {
        const CorpusFile copy = form->files.convert(file, reference, deforms(file));
        LoadedFile converted(copy, reference, places);
        Results after;
        checkConvertible(converted, copy, options, after);
        form->comparison.add(file.name, before, after);
    }
}

int runConverted(const Options& options, const std::filesystem::path& corpus) {
    std::vector<std::unique_ptr<ConvertedForms>> forms;
    for (const std::string& form : options.converted)
        forms.push_back(std::make_unique<ConvertedForms>(form));
    for (const CorpusFile& file : listCorpus(corpus))
        if (options.file.empty() || file.name == options.file)
            checkConversions(file, options, forms);
    bool failed = false;
    for (const std::unique_ptr<ConvertedForms>& form : forms)
        failed = judgeRoundTrip(form->comparison, options) || failed;
    return failed ? 1 : 0;
}

int run(const Options& options) {
    const auto corpus = findCorpus();
    if (!corpus) {
        std::puts("corpus not found: conformance tests skipped");
        return kSkipped;
    }
    if (!options.through.empty())
        return runThrough(options, *corpus);
    if (!options.converted.empty())
        return runConverted(options, *corpus);
    const auto start = std::chrono::steady_clock::now();
    Results results;
    int files = 0;
    for (const CorpusFile& file : listCorpus(*corpus)) {
        if (!options.file.empty() && file.name != options.file)
            continue;
        checkFile(file, options, results);
        ++files;
    }
    printTable(options, results);
    const std::chrono::duration<double> seconds = std::chrono::steady_clock::now() - start;
    std::printf("%d files in %.1f s\n", files, seconds.count());
    if (files == 0)
        return kUsage;
    return options.file.empty() ? judge(options, results) : 0;
}

} // namespace
} // namespace conformance

int main(int argc, char** argv) {
    conformance::Options options;
    if (!conformance::parse(argc, argv, options)) {
        std::fputs(conformance::kUsageText, stderr);
        return conformance::kUsage;
    }
    try {
        return conformance::run(options);
    } catch (const std::exception& error) {
        std::fprintf(stderr, "conformance: %s\n", error.what());
        return 1;
    }
}
