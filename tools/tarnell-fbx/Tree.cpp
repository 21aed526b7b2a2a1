// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx tree: the hierarchy of a file's nodes, and what is attached to each.
#include <algorithm>
#include <iterator>

#include <fbxsdk.h>

#include "Commands.h"
#include "SceneFacts.h"
#include "SceneFile.h"
#include "SceneQueries.h"
#include "ShowFiles.h"
#include "TerminalText.h"

namespace tool {
namespace {

/// The data of a node besides its name and kind.
struct NodeFacts {
    bool animated = false; ///< itself, one of its attributes or blend shapes
    bool hidden = false;
    const char* rotationOrder = "XYZ"; ///< the effective one
    std::string target;
    bool instance = false; ///< shares its attribute with an earlier node
    std::string attribute; ///< the attribute's own name, where it is not the node's
    std::vector<std::string> deformers;
    std::vector<std::string> materials;
};

const char* rotationOrderOf(const FbxNode& node) {
    constexpr const char* kOrders[] = {"XYZ", "XZY", "YZX", "YXZ", "ZXY", "ZYX"};
    EFbxRotationOrder order = eEulerXYZ;
    node.GetRotationOrder(FbxNode::eSourcePivot, order);
    const auto index = static_cast<std::size_t>(order);
    return node.GetRotationActive() && index < std::size(kOrders) ? kOrders[index] : "XYZ";
}

bool anyAnimated(const FbxObject& object) {
    const std::vector<FbxProperty> properties = propertiesOf(object);
    return std::any_of(properties.begin(), properties.end(), isAnimated);
}

std::string counted(int count, const char* one, const char* many) {
    return std::to_string(count) + ' ' + (count == 1 ? one : many);
}

std::string deformerText(FbxDeformer& deformer) {
    if (const auto* skin = FbxCast<FbxSkin>(&deformer))
        return "skin of " + counted(skin->GetClusterCount(), "bone", "bones");
    if (const auto* shapes = FbxCast<FbxBlendShape>(&deformer))
        return "blend shape of " + counted(shapes->GetBlendShapeChannelCount(), "channel", "channels");
    return deformer.Is<FbxVertexCacheDeformer>() ? "point cache" : "deformer of an unknown kind";
}

NodeFacts factsOf(FbxNode& node) {
    NodeFacts facts;
    facts.animated = anyAnimated(node);
    const FbxProperty show = node.FindProperty("Show");
    facts.hidden = node.Visibility.Get() == 0.0 || (show.IsValid() && !show.Get<FbxBool>());
    facts.rotationOrder = rotationOrderOf(node);
    if (const FbxNode* target = node.GetTarget())
        facts.target = target->GetName();
    for (int i = 0; i < node.GetNodeAttributeCount(); ++i)
        facts.animated = facts.animated || anyAnimated(*node.GetNodeAttributeByIndex(i));
    for (const FbxBlendShapeChannel* channel : blendChannelsOf(node))
        facts.animated = facts.animated || anyAnimated(*channel);
    if (const FbxNodeAttribute* attribute = node.GetNodeAttribute()) {
        facts.instance = attribute->GetNode(0) != &node;
        const std::string name = attribute->GetName();
        facts.attribute = name == node.GetName() ? std::string() : name;
    }
    if (const FbxGeometry* geometry = node.GetGeometry())
        for (int i = 0; i < geometry->GetDeformerCount(); ++i)
            facts.deformers.push_back(deformerText(*geometry->GetDeformer(i)));
    for (int i = 0; i < node.GetMaterialCount(); ++i)
        facts.materials.emplace_back(node.GetMaterial(i)->GetName());
    return facts;
}

// ---- Text ----

std::string remarks(const NodeFacts& facts) {
    std::string text;
    const auto add = [&](const std::string& remark) { text += (text.empty() ? "" : ", ") + remark; };
    if (facts.animated)
        add("animated");
    if (facts.hidden)
        add("hidden");
    if (facts.instance)
        add("instance");
    if (facts.rotationOrder != std::string("XYZ"))
        add(std::string("rotation order ") + facts.rotationOrder);
    if (!facts.target.empty())
        add("aims at " + inQuotes(facts.target));
    for (const std::string& deformer : facts.deformers)
        add(deformer);
    if (!facts.materials.empty())
        add(counted(static_cast<int>(facts.materials.size()), "material", "materials"));
    return text;
}

/// The branches before a node; beyond some levels the number of the level instead.
class Branches {
public:
    std::string before(const TreeNode& node) {
        const auto depth = static_cast<std::size_t>(node.depth);
        mGoesOn.resize(depth + 1);
        mGoesOn[depth] = !node.isLast;
        constexpr std::size_t kMostLevels = 30;
        if (depth >= kMostLevels)
            return std::string(kMostLevels * 3, ' ') + '(' + std::to_string(depth + 1) + ") ";
        std::string text;
        for (std::size_t level = 0; level < depth; ++level)
            text += mGoesOn[level] ? "│  " : "   ";
        return text + (node.isLast ? "└─ " : "├─ ");
    }

private:
    std::vector<bool> mGoesOn; ///< per level: whether more nodes follow
};

int countBelow(const std::vector<TreeNode>& nodes, std::size_t index) {
    std::size_t end = index + 1;
    while (end < nodes.size() && nodes[end].depth > nodes[index].depth)
        ++end;
    return static_cast<int>(end - index - 1);
}

void printNode(const std::string& branch, FbxNode& node, int folded, std::ostream& out, const Terminal& terminal) {
    const std::string kind = std::string("  [") + kindOf(node) + ']';
    std::string rest = remarks(factsOf(node));
    if (folded > 0)
        rest += (rest.empty() ? "… " : ", … ") + counted(folded, "node", "nodes") + " below";
    out << terminal.paint(Ink::faint, branch) << terminal.paint(Ink::name, terminalText(node.GetName())) << kind
        << (rest.empty() ? "" : "  ") << terminal.paint(Ink::faint, rest) << '\n';
}

void printText(const std::vector<TreeNode>& nodes, int depth, Page& page) {
    std::ostream& out = page.begin();
    const Terminal& terminal = page.terminal();
    out << terminal.paint(Ink::heading, spoken(page.file())) << '\n';
    Branches branches;
    bool toldDetached = false;
    for (std::size_t i = 0; i < nodes.size(); ++i) {
        const TreeNode& node = nodes[i];
        if (depth > 0 && node.depth >= depth)
            continue;
        if (node.isDetached && !toldDetached)
            out << "Outside the hierarchy, such as the views of applications:\n";
        toldDetached = node.isDetached;
        const int folded = depth > 0 && node.depth + 1 == depth ? countBelow(nodes, i) : 0;
        printNode(branches.before(node), *node.node, folded, out, terminal);
    }
    if (nodes.empty())
        out << "  no nodes\n";
}

// ---- JSON ----

void printNames(const char* key, const std::vector<std::string>& names, JsonWriter& json) {
    json.key(key);
    json.beginArray();
    for (const std::string& name : names)
        json.text(name);
    json.endArray();
}

void printNode(const TreeNode& node, bool hasIds, JsonWriter& json) {
    const NodeFacts facts = factsOf(*node.node);
    const FbxNodeAttribute* attribute = node.node->GetNodeAttribute();
    json.beginObject();
    json.text("name", node.node->GetName());
    json.text("kind", kindOf(*node.node));
    printId(*node.node, hasIds, json);
    json.integer("parent", node.parent);
    json.integer("depth", node.depth);
    json.boolean("detached", node.isDetached);
    json.boolean("animated", facts.animated);
    json.boolean("hidden", facts.hidden);
    json.text("rotationOrder", facts.rotationOrder);
    json.key("target");
    if (facts.target.empty())
        json.null();
    else
        json.text(facts.target);
    json.key("attribute");
    if (attribute) {
        json.beginObject();
        json.text("name", attribute->GetName());
        json.text("class", className(*attribute));
        printId(*attribute, hasIds, json);
        json.boolean("shared", attribute->GetNodeCount() > 1);
        json.endObject();
    } else {
        json.null();
    }
    printNames("deformers", facts.deformers, json);
    printNames("materials", facts.materials, json);
    json.endObject();
}

} // namespace

int tree(const TreeOptions& options) {
    return showFiles(
        options, "tree",
        [&options](Page& page) -> int {
            const SceneFile opened(page.file());
            const std::vector<TreeNode> nodes = nodesInOrder(opened.scene());
            if (!page.isJson()) {
                printText(nodes, options.depth, page);
                return kSuccess;
            }
            page.json(
                "tree",
                [&](JsonWriter& json) {
                    json.key("nodes");
                    json.beginArray();
                    for (const TreeNode& node : nodes)
                        if (options.depth == 0 || node.depth < options.depth)
                            printNode(node, opened.hasIds(), json);
                    json.endArray();
                });
            return kSuccess;
        });
}

} // namespace tool
