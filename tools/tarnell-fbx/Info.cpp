// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx info: a summary per file, as text or JSON. These are facts of the file itself, before any
// conversion, so they come from the platform.
#include <cmath>
#include <filesystem>
#include <map>
#include <system_error>

#include <fbxsdk.h>
#include <fbxsdk/extensions/FileFacts.h>

#include "CacheCheck.h"
#include "Commands.h"
#include "Info.h"
#include "Lines.h"
#include "SceneFacts.h"
#include "SceneFile.h"
#include "ShowFiles.h"
#include "TerminalText.h"

namespace tool {
namespace {

/// A stack of the file, its span in frames of the file's rate.
struct Stack {
    std::string name;
    long long firstFrame, lastFrame;
    double start, end; ///< seconds
    std::vector<std::string> layers;
};

struct CacheFault {
    std::string mesh, reason;
};

/// The data of `info` for one file.
struct Facts {
    int version = 0;
    bool ascii = false;
    std::optional<std::uintmax_t> bytes;
    std::string creator;
    double unit = 1.0; ///< centimetres
    Axes axes;
    double frameRate = 0.0;
    std::vector<Stack> stacks;
    std::map<std::string, int> kinds;
    std::vector<CacheFault> cacheFaults;
    std::vector<std::string> repairs;
};

Stack stackFacts(const FbxAnimStack& stack, FbxTime::EMode mode) {
    const FbxTimeSpan span = stack.GetLocalTimeSpan();
    Stack facts{stack.GetName(),
                span.GetStart().GetFrameCount(mode),
                span.GetStop().GetFrameCount(mode),
                span.GetStart().GetSecondDouble(),
                span.GetStop().GetSecondDouble(),
                {}};
    for (int layer = 0; layer < stack.GetMemberCount<FbxAnimLayer>(); ++layer)
        facts.layers.emplace_back(stack.GetMember<FbxAnimLayer>(layer)->GetName());
    return facts;
}

std::map<std::string, int> countKinds(FbxNode& root) {
    std::map<std::string, int> counts;
    std::vector<FbxNode*> pending{&root};
    while (!pending.empty()) {
        FbxNode* node = pending.back();
        pending.pop_back();
        for (int i = 0; i < node->GetChildCount(); ++i)
            pending.push_back(node->GetChild(i));
        if (node != &root)
            ++counts[kindOf(*node)];
    }
    return counts;
}

const char* nameOf(const FbxMesh& mesh) {
    return mesh.GetNodeCount() > 0 ? mesh.GetNode(0)->GetName() : mesh.GetName();
}

/// Meshes that show without their point cache, or with a damaged one, and why.
std::vector<CacheFault> cacheFaults(FbxScene& scene) {
    std::vector<CacheFault> faults;
    for (FbxObject* object : extensions::objectsOf(scene)) {
        auto* mesh = FbxCast<FbxMesh>(object);
        const std::string fault = mesh ? cacheFault(*mesh) : std::string();
        if (!fault.empty())
            faults.push_back({nameOf(*mesh), fault});
    }
    return faults;
}

Facts factsOf(const std::string& file, const SceneFile& opened) {
    FbxScene& scene = opened.scene();
    FbxGlobalSettings& settings = scene.GetGlobalSettings();
    const FbxIOFileHeaderInfo& header = *opened.importer().GetFileHeaderInfo();
    Facts facts;
    facts.version = header.mFileVersion;
    facts.ascii = header.mASCII;
    std::error_code error;
    const std::uintmax_t bytes = std::filesystem::file_size(file, error);
    if (!error)
        facts.bytes = bytes;
    facts.creator = header.mCreator.Buffer();
    facts.unit = settings.GetSystemUnit().GetScaleFactor();
    facts.axes = axesOf(settings.GetAxisSystem());
    facts.frameRate = opened.frameRate();
    for (int i = 0; i < scene.GetSrcObjectCount<FbxAnimStack>(); ++i)
        facts.stacks.push_back(stackFacts(*scene.GetSrcObject<FbxAnimStack>(i), opened.timeMode()));
    facts.kinds = countKinds(*scene.GetRootNode());
    facts.cacheFaults = cacheFaults(scene);
    for (const FbxString& warning : header.mWarnings)
        facts.repairs.emplace_back(warning.Buffer());
    return facts;
}

// ---- Text ----

std::string versionText(int version) {
    const std::string text = std::to_string(version / 1000) + '.' + std::to_string(version / 100 % 10);
    return version % 100 == 0 ? text : text + '.' + std::to_string(version % 100);
}

/// To a fraction of any frame.
std::string secondsText(double seconds) { return numberText(std::round(seconds * 1e4) / 1e4); }

std::string stackText(const Stack& stack) {
    std::string text = inQuotes(stack.name) + "  frames " + std::to_string(stack.firstFrame) + " to " +
                       std::to_string(stack.lastFrame) + "  (" + secondsText(stack.start) + " to " +
                       secondsText(stack.end) + " s)  layers:";
    for (std::size_t i = 0; i < stack.layers.size(); ++i)
        text += (i == 0 ? " " : ", ") + terminalText(stack.layers[i]);
    return text;
}

std::string kindsText(const std::map<std::string, int>& kinds) {
    std::string text;
    for (const auto& [kind, count] : kinds)
        text += (text.empty() ? "" : ", ") + std::to_string(count) + " × " + kind;
    return text.empty() ? "none" : text;
}

/// A node of the tree as displayed.
struct TreeLine {
    FbxNode* node;
    std::string indent;
};

/// More nodes than this are counted, not listed: the page fits one screen.
constexpr int kMaximumTreeLines = 40;

void printTree(FbxNode& root, std::ostream& out, const Terminal& terminal) {
    std::vector<TreeLine> pending;
    const auto pushChildren = [&](FbxNode& node, const std::string& indent) {
        for (int i = node.GetChildCount() - 1; i >= 0; --i)
            pending.push_back({node.GetChild(i), indent});
    };
    pushChildren(root, "  ");
    int printed = 0, left = 0;
    while (!pending.empty()) {
        const TreeLine line = pending.back();
        pending.pop_back();
        if (printed < kMaximumTreeLines) {
            out << "  " << line.indent << terminal.paint(Ink::name, terminalText(line.node->GetName())) << "  ["
                << kindOf(*line.node) << "]\n";
            ++printed;
        } else {
            ++left;
        }
        constexpr std::size_t kMaximumIndent = 40;
        pushChildren(*line.node, line.indent.size() < kMaximumIndent ? line.indent + "  " : line.indent);
    }
    if (left > 0)
        out << "    … and " << left << " more; tarnell-fbx tree lists all\n";
}

void printText(const Facts& facts, FbxNode& root, Page& page) {
    std::ostream& out = page.begin();
    Lines lines(out, page.terminal());
    out << page.terminal().paint(Ink::heading, spoken(page.file())) << '\n';
    lines.line("File version", versionText(facts.version) + (facts.ascii ? ", ASCII" : ", binary") +
                                   (facts.bytes ? ", " + sizeText(*facts.bytes) : ""));
    lines.line("Creator", facts.creator.empty() ? "not stated" : terminalText(facts.creator));
    lines.line("Unit", unitName(facts.unit));
    lines.line("Axes", facts.axes.up + " up, " + facts.axes.toViewer + " to the viewer, " +
                           (facts.axes.rightHanded ? "right-handed" : "left-handed"));
    lines.line("Frame rate", rateText(facts.frameRate));
    if (facts.stacks.empty())
        lines.line("Stacks", "none");
    for (std::size_t i = 0; i < facts.stacks.size(); ++i)
        lines.line(i == 0 ? "Stacks" : "", stackText(facts.stacks[i]));
    lines.line("Nodes", kindsText(facts.kinds));
    printTree(root, out, page.terminal());
    for (const CacheFault& fault : facts.cacheFaults)
        lines.line("Cache", inQuotes(fault.mesh) + " cannot use its point cache: " + terminalText(fault.reason));
    for (const std::string& repair : facts.repairs)
        lines.line("Repaired", terminalText(repair));
}

// ---- JSON ----

void printStacks(const std::vector<Stack>& stacks, JsonWriter& json) {
    json.key("stacks");
    json.beginArray();
    for (const Stack& stack : stacks) {
        json.beginObject();
        json.text("name", stack.name);
        json.integer("firstFrame", stack.firstFrame);
        json.integer("lastFrame", stack.lastFrame);
        json.real("start", stack.start);
        json.real("end", stack.end);
        json.key("layers");
        json.beginArray();
        for (const std::string& layer : stack.layers)
            json.text(layer);
        json.endArray();
        json.endObject();
    }
    json.endArray();
}

void printSettings(const Facts& facts, JsonWriter& json) {
    json.key("unit");
    json.beginObject();
    json.real("centimetres", facts.unit);
    json.text("name", unitName(facts.unit));
    json.endObject();
    json.key("axes");
    json.beginObject();
    json.text("up", facts.axes.up);
    json.text("toViewer", facts.axes.toViewer);
    json.text("handedness", facts.axes.rightHanded ? "right" : "left");
    json.endObject();
    json.real("frameRate", facts.frameRate);
}

void printJson(const Facts& facts, JsonWriter& json) {
    json.integer("version", facts.version);
    json.text("encoding", facts.ascii ? "ascii" : "binary");
    json.key("bytes");
    if (facts.bytes)
        json.integer(static_cast<long long>(*facts.bytes));
    else
        json.null();
    json.text("creator", facts.creator);
    printSettings(facts, json);
    printStacks(facts.stacks, json);
    json.key("nodes");
    json.beginObject();
    for (const auto& [kind, count] : facts.kinds)
        json.integer(kind, count);
    json.endObject();
    json.key("cacheFaults");
    json.beginArray();
    for (const CacheFault& fault : facts.cacheFaults) {
        json.beginObject();
        json.text("mesh", fault.mesh);
        json.text("reason", fault.reason);
        json.endObject();
    }
    json.endArray();
    json.key("repaired");
    json.beginArray();
    for (const std::string& repair : facts.repairs)
        json.text(repair);
    json.endArray();
}

} // namespace

void printInfo(const std::string& file, const SceneFile& opened, JsonWriter& json) {
    printJson(factsOf(file, opened), json);
}

int info(const LookOptions& options) {
    return showFiles(
        options, "info",
        [](Page& page) -> int {
            const SceneFile opened(page.file());
            const Facts facts = factsOf(page.file(), opened);
            if (page.isJson())
                page.json(
                    "info", [&](JsonWriter& json) { printJson(facts, json); });
            else
                printText(facts, *opened.scene().GetRootNode(), page);
            return kSuccess;
        });
}

} // namespace tool
