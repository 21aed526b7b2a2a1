// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx diff: the differences between two files, as text, as a page for a browser, and as JSON.
#include <cmath>
#include <iostream>

#include "CameraOrigins.h"
#include "Commands.h"
#include "DiffFacts.h"
#include "DiffPage.h"
#include "JsonWriter.h"
#include "Progress.h"
#include "SceneFacts.h"
#include "StandardInput.h"
#include "Terminal.h"
#include "TerminalText.h"

namespace tool {
namespace {

// ---- Text ----

std::string countsText(const std::vector<Difference>& found) {
    return found.empty() ? "no difference"
                         : std::to_string(found.size()) + (found.size() == 1 ? " difference" : " differences");
}

/// Merges curves of one object with the same difference into one line.
std::vector<Difference> withoutRepetition(const std::vector<Difference>& found) {
    std::vector<Difference> lines;
    for (const Difference& each : found) {
        Difference* last = lines.empty() ? nullptr : &lines.back();
        const bool isSame = last && each.kind == DiffKind::curve && last->kind == each.kind &&
                            last->object == each.object && last->a == each.a && last->b == each.b && !each.amount &&
                            !last->amount;
        if (isSame)
            last->what += ", " + each.what;
        else
            lines.push_back(each);
    }
    return lines;
}

void printText(const DiffPage& page, std::ostream& out) {
    const Terminal terminal = standardTerminal();
    out << terminal.paint(Ink::heading, terminalText(page.a)) << " → "
        << terminal.paint(Ink::heading, terminalText(page.b)) << "  " << countsText(page.found) << " beyond "
        << numberText(page.tolerance) << '\n';
    const char* last = "";
    for (const Difference& each : withoutRepetition(page.found)) {
        constexpr std::size_t kColumn = 10;
        const std::string kind = diffKindName(each.kind);
        const bool isSame = kind == last;
        last = diffKindName(each.kind);
        out << "  " << (isSame ? std::string(kind.size(), ' ') : terminal.paint(Ink::faint, kind))
            << std::string(kColumn - std::min(kColumn, kind.size()), ' ') << ' '
            << (each.object.empty() ? "" : terminal.paint(Ink::name, inQuotes(each.object)) + "  ")
            << terminalText(sentenceOf(each)) << '\n';
    }
}

// ---- JSON ----

void textOrNull(JsonWriter& json, std::string_view key, const std::string& text) {
    json.key(key);
    if (text.empty())
        json.null();
    else
        json.text(text);
}

void numberOrNull(JsonWriter& json, std::string_view key, const std::optional<double>& number) {
    json.key(key);
    if (number)
        json.real(*number);
    else
        json.null();
}

void printDifference(const Difference& difference, JsonWriter& json) {
    json.beginObject();
    json.text("kind", diffKindName(difference.kind));
    textOrNull(json, "object", difference.object);
    json.text("what", difference.what);
    textOrNull(json, "a", difference.a);
    textOrNull(json, "b", difference.b);
    numberOrNull(json, "amount", difference.amount);
    json.text("unit", difference.unit);
    numberOrNull(json, "frame", difference.frame);
    json.integer("carried", difference.carried);
    json.endObject();
}

void beginJson(JsonWriter& json, const std::string& a, const std::string& b) {
    json.beginObject();
    json.text("format", "tarnell-fbx diff 1");
    json.text("a", a);
    json.text("b", b);
}

void printJson(const DiffPage& page, Form form, std::ostream& out) {
    JsonWriter json(out, form == Form::json);
    beginJson(json, page.a, page.b);
    json.text("values", "faithful");
    json.real("tolerance", page.tolerance);
    json.boolean("equal", page.found.empty());
    json.key("differences");
    json.beginArray();
    for (const Difference& each : page.found)
        printDifference(each, json);
    json.endArray();
    json.endObject();
    out << '\n';
}

/// Why one of the two cannot be read: with its name, since there are two.
std::string reasonOf(const std::string& file, const std::function<void()>& read) {
    const Outcome outcome = attempt([&]() -> int {
        read();
        return kSuccess;
    });
    return outcome.reason.empty() || outcome.reason.rfind(file, 0) == 0 ? outcome.reason : file + ": " + outcome.reason;
}

int fail(const DiffOptions& options, const std::string& reason) {
    const std::string a = withoutKeptName(options.a), b = withoutKeptName(options.b);
    std::cerr << "tarnell-fbx: " + spoken(reason) + '\n';
    if (options.form == Form::json || options.form == Form::jsonLines) {
        JsonWriter json(std::cout, options.form == Form::json);
        beginJson(json, a, b);
        json.text("error", withoutKeptName(reason));
        json.endObject();
        std::cout << '\n';
    }
    return kUnreadable;
}

void print(const DiffPage& page, Form form) {
    if (form == Form::json || form == Form::jsonLines)
        printJson(page, form, std::cout);
    else if (form == Form::html)
        writeDiffPage(page, std::cout);
    else
        printText(page, std::cout);
}

} // namespace

std::string sentenceOf(const Difference& difference) {
    // "unit: centimetre → metre", not "unit unit: …".
    std::string text = difference.what == diffKindName(difference.kind) ? "" : difference.what;
    if (difference.kind == DiffKind::added || difference.kind == DiffKind::removed)
        return text + ", " + difference.a + difference.b;
    const auto orNothing = [](const std::string& said) { return said.empty() ? "nothing" : said; };
    if (!difference.a.empty() || !difference.b.empty())
        text += (text.empty() ? "" : ": ") + orNothing(difference.a) + " → " + orNothing(difference.b);
    if (difference.amount)
        text += ", " + significant(*difference.amount, 4) +
                (difference.unit.empty() || difference.unit == "°" ? difference.unit : ' ' + difference.unit) +
                " apart";
    if (difference.frame)
        text += " at frame " + rounded(*difference.frame, 3);
    if (difference.carried > 0)
        text += ", with " + std::to_string(difference.carried) + (difference.carried == 1 ? " node" : " nodes") +
                " below it";
    return text;
}

int diff(const DiffOptions& given) {
    DiffOptions options = given;
    if (options.a == "-" || options.b == "-")
        (options.a == "-" ? options.a : options.b) = keepStandardInput();
    std::optional<SceneFile> a, b;
    Progress progress;
    progress.say("reading " + withoutKeptName(options.a));
    std::string reason = reasonOf(options.a, [&] { a.emplace(options.a); });
    if (reason.empty())
        reason = reasonOf(options.b, [&] { b.emplace(options.b); });
    progress.say("comparing");
    DiffPage page{withoutKeptName(options.a), withoutKeptName(options.b), options.tolerance, {}};
    if (reason.empty())
        reason = reasonOf("", [&] {
            page.found =
                differencesOf({options.a, *a}, {options.b, *b}, {options.take, options.tolerance, options.frames});
        });
    progress.hide();
    if (!reason.empty())
        return fail(options, reason);
    print(page, options.form);
    return page.found.empty() ? kSuccess : kUnreadable;
}

} // namespace tool
