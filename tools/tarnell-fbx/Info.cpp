// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx info: one screen per file, for people. These are facts of the file itself, before any conversion, so they
// come from the platform.
#include <cstdio>
#include <iostream>
#include <map>
#include <memory>
#include <sstream>

#include <sys/stat.h>

#include <fbxsdk.h>

#include "CacheCheck.h"
#include "Commands.h"

namespace tool {
namespace {

struct ManagerDeleter {
    void operator()(FbxManager* manager) const { manager->Destroy(); }
};

/// At most ten significant digits, none of them useless.
std::string number(double value) {
    char text[32];
    std::snprintf(text, sizeof text, "%.10g", value);
    return text;
}

std::string oneDecimal(double value) {
    char text[32];
    std::snprintf(text, sizeof text, "%.1f", value);
    return text;
}

std::string sizeOf(const std::string& file) {
    struct stat facts {};
    if (stat(file.c_str(), &facts) != 0)
        return "?";
    const double bytes = static_cast<double>(facts.st_size);
    if (bytes < 1024.0)
        return std::to_string(facts.st_size) + " bytes";
    if (bytes < 1024.0 * 1024.0)
        return oneDecimal(bytes / 1024.0) + " KiB";
    return oneDecimal(bytes / (1024.0 * 1024.0)) + " MiB";
}

std::string unitName(double centimetres) {
    constexpr struct {
        double scale;
        const char* name;
    } kUnits[] = {{0.1, "millimetre"}, {1.0, "centimetre"}, {10.0, "decimetre"}, {100.0, "metre"},  {1e5, "kilometre"},
                  {2.54, "inch"},      {30.48, "foot"},     {91.44, "yard"},     {160934.4, "mile"}};
    for (const auto& unit : kUnits) {
        if (unit.scale == centimetres)
            return unit.name;
    }
    return number(centimetres) + " cm";
}

std::string axesName(const FbxAxisSystem& system) {
    int upSign = 1, frontSign = 1;
    const int up = static_cast<int>(system.GetUpVector(upSign)) - 1;
    const bool even = system.GetFrontVector(frontSign) == FbxAxisSystem::eParityEven;
    const int others[2] = {up == 0 ? 1 : 0, up == 2 ? 1 : 2};
    const int front = even ? others[0] : others[1];
    std::string text;
    text += upSign < 0 ? '-' : '+';
    text += "XYZ"[up];
    text += " up, ";
    text += frontSign < 0 ? '-' : '+';
    text += "XYZ"[front];
    text += " to the viewer, ";
    text += system.GetCoorSystem() == FbxAxisSystem::eRightHanded ? "right-handed" : "left-handed";
    return text;
}

const char* kindOf(const FbxNode& node) {
    const FbxNodeAttribute* attribute = node.GetNodeAttribute();
    if (!attribute)
        return "node";
    constexpr struct {
        FbxNodeAttribute::EType type;
        const char* name;
    } kKinds[] = {{FbxNodeAttribute::eNull, "null"},
                  {FbxNodeAttribute::eMarker, "marker"},
                  {FbxNodeAttribute::eSkeleton, "bone"},
                  {FbxNodeAttribute::eMesh, "mesh"},
                  {FbxNodeAttribute::eNurbs, "NURBS"},
                  {FbxNodeAttribute::ePatch, "patch"},
                  {FbxNodeAttribute::eCamera, "camera"},
                  {FbxNodeAttribute::eCameraStereo, "stereo camera"},
                  {FbxNodeAttribute::eCameraSwitcher, "camera switcher"},
                  {FbxNodeAttribute::eLight, "light"},
                  {FbxNodeAttribute::eOpticalReference, "optical reference"},
                  {FbxNodeAttribute::eOpticalMarker, "optical marker"},
                  {FbxNodeAttribute::eNurbsCurve, "NURBS curve"},
                  {FbxNodeAttribute::eTrimNurbsSurface, "trimmed NURBS surface"},
                  {FbxNodeAttribute::eBoundary, "boundary"},
                  {FbxNodeAttribute::eNurbsSurface, "NURBS surface"},
                  {FbxNodeAttribute::eShape, "shape"},
                  {FbxNodeAttribute::eLODGroup, "level-of-detail group"},
                  {FbxNodeAttribute::eSubDiv, "subdivision surface"},
                  {FbxNodeAttribute::eCachedEffect, "cached effect"},
                  {FbxNodeAttribute::eLine, "line"}};
    for (const auto& kind : kKinds) {
        if (kind.type == attribute->GetAttributeType())
            return kind.name;
    }
    return "unknown attribute";
}

/// A node of the tree on its way to the screen.
struct TreeLine {
    FbxNode* node;
    std::string indent;
};

/// More nodes than this are counted, not listed.
constexpr int kMaximumTreeLines = 200;

void printTree(FbxNode& root, std::ostream& out) {
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
            out << "  " << line.indent << line.node->GetName() << "  [" << kindOf(*line.node) << "]\n";
            ++printed;
        } else {
            ++left;
        }
        constexpr std::size_t kMaximumIndent = 40;
        pushChildren(*line.node, line.indent.size() < kMaximumIndent ? line.indent + "  " : line.indent);
    }
    if (left > 0)
        out << "    … and " << left << " more\n";
}

std::string countKinds(FbxNode& root) {
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
    std::string text;
    for (const auto& [kind, count] : counts) {
        text += (text.empty() ? "" : ", ") + std::to_string(count) + " × " + kind;
    }
    return text.empty() ? "none" : text;
}

void printStacks(FbxScene& scene, std::ostream& out) {
    const FbxTime::EMode mode = scene.GetGlobalSettings().GetTimeMode();
    const int count = scene.GetSrcObjectCount<FbxAnimStack>();
    if (count == 0)
        out << "  Stacks        none\n";
    for (int i = 0; i < count; ++i) {
        FbxAnimStack& stack = *scene.GetSrcObject<FbxAnimStack>(i);
        const FbxTimeSpan span = stack.GetLocalTimeSpan();
        out << (i == 0 ? "  Stacks        " : "                ") << '"' << stack.GetName() << "\"  frames "
            << span.GetStart().GetFrameCount(mode) << " to " << span.GetStop().GetFrameCount(mode) << "  ("
            << number(span.GetStart().GetSecondDouble()) << " to " << number(span.GetStop().GetSecondDouble()) << " s"
            << ")  layers:";
        for (int layer = 0; layer < stack.GetMemberCount<FbxAnimLayer>(); ++layer) {
            out << (layer == 0 ? " " : ", ") << stack.GetMember<FbxAnimLayer>(layer)->GetName();
        }
        out << '\n';
    }
}

const char* nameOf(const FbxMesh& mesh) {
    return mesh.GetNodeCount() > 0 ? mesh.GetNode(0)->GetName() : mesh.GetName();
}

/// Meshes that show without their point cache, or with a damaged one, and why.
void printCacheFaults(FbxScene& scene, std::ostream& out) {
    for (int i = 0; i < scene.GetSrcObjectCount<FbxMesh>(); ++i) {
        FbxMesh& mesh = *scene.GetSrcObject<FbxMesh>(i);
        const std::string fault = cacheFault(mesh);
        if (!fault.empty())
            out << "  Cache         \"" << nameOf(mesh) << "\" cannot use its point cache: " << fault << '\n';
    }
}

void printFile(const std::string& file, FbxImporter& importer, FbxScene& scene, std::ostream& out) {
    int major = 0, minor = 0, revision = 0;
    importer.GetFileVersion(major, minor, revision);
    const FbxIOFileHeaderInfo* header = importer.GetFileHeaderInfo();
    FbxGlobalSettings& settings = scene.GetGlobalSettings();
    const double rate = FbxTime::GetFrameRate(settings.GetTimeMode());

    out << file << '\n';
    out << "  File version  " << major << '.' << minor << (revision ? "." + std::to_string(revision) : std::string())
        << (header && header->mASCII ? ", ASCII" : ", binary") << ", " << sizeOf(file) << '\n';
    out << "  Creator       " << (header && !header->mCreator.IsEmpty() ? header->mCreator.Buffer() : "not stated")
        << '\n';
    out << "  Unit          " << unitName(settings.GetSystemUnit().GetScaleFactor()) << '\n';
    out << "  Axes          " << axesName(settings.GetAxisSystem()) << '\n';
    out << "  Frame rate    " << number(rate) << " frames per second\n";
    printStacks(scene, out);
    out << "  Nodes         " << countKinds(*scene.GetRootNode()) << '\n';
    printTree(*scene.GetRootNode(), out);
    printCacheFaults(scene, out);
    if (!header)
        return;
    for (const FbxString& warning : header->mWarnings)
        out << "  Repaired      " << warning.Buffer() << '\n';
}

bool showFile(const std::string& file) {
    const std::unique_ptr<FbxManager, ManagerDeleter> manager(FbxManager::Create());
    FbxImporter* importer = FbxImporter::Create(manager.get(), "");
    FbxScene* scene = FbxScene::Create(manager.get(), "");
    if (!importer->Initialize(file.c_str(), -1, nullptr) || !importer->Import(scene, false)) {
        printError(file, importer->GetStatus().GetErrorString());
        return false;
    }
    std::ostringstream page;
    printFile(file, *importer, *scene, page);
    std::cout << page.str();
    return true;
}

} // namespace

int info(const std::vector<std::string>& files) {
    bool allRead = true;
    for (std::size_t i = 0; i < files.size(); ++i) {
        if (i > 0)
            std::cout << '\n';
        const int status = guarded(files[i], [&]() -> int { return showFile(files[i]) ? kSuccess : kUnreadable; });
        allRead = status == kSuccess && allRead;
    }
    std::cout << std::flush;
    return allRead ? kSuccess : kUnreadable;
}

} // namespace tool
