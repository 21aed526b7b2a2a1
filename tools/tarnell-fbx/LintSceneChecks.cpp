// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Checks of the file as a whole, of placement and of names.
#include <algorithm>
#include <cmath>
#include <map>
#include <set>

#include <fbxsdk/extensions/FileFacts.h>

#include "CameraOrigins.h"
#include "LintChecks.h"
#include "Placing.h"
#include "PropertyValues.h"
#include "SceneFacts.h"
#include "Utf8.h"

namespace tool {
namespace {

const FbxIOFileHeaderInfo& headerOf(const LintContext& context) { return *context.file.importer().GetFileHeaderInfo(); }

bool hasOptics(const LintContext& context) {
    return !context.cameras->cameras.empty() ||
           std::any_of(
               context.nodes.begin(), context.nodes.end(),
               [](const TreeNode& each) { return each.node->GetLight() != nullptr; });
}

double dotProduct(const FbxVector4& a, const FbxVector4& b) { return a[0] * b[0] + a[1] * b[1] + a[2] * b[2]; }

double determinant(const FbxAMatrix& matrix) {
    const FbxVector4 x = matrix.GetRow(0), y = matrix.GetRow(1), z = matrix.GetRow(2);
    return x[0] * (y[1] * z[2] - y[2] * z[1]) - x[1] * (y[0] * z[2] - y[2] * z[0]) + x[2] * (y[0] * z[1] - y[1] * z[0]);
}

bool isUneven(const FbxDouble3& scale) { return scale[0] != scale[1] || scale[1] != scale[2]; }

/// Whether the take has keys of different values.
bool changes(const FbxProperty& property, FbxAnimStack* take) {
    for (const Channel& channel : channelsOf(property, take)) {
        for (const LayerCurve& each : channel.curves) {
            for (int i = 1; i < each.curve->KeyGetCount(); ++i)
                if (each.curve->KeyGetValue(i) != each.curve->KeyGetValue(0))
                    return true;
        }
    }
    return false;
}

bool isOnlyScaled(const FbxAMatrix& matrix) {
    for (int row = 0; row < 3; ++row) {
        for (int column = 0; column < 3; ++column)
            if (row == column ? matrix.Get(row, column) < 0.0 : matrix.Get(row, column) != 0.0)
                return false;
    }
    return true;
}

bool isOdd(const std::string& name) {
    for (std::size_t at = 0; at < name.size();) {
        const Utf8Character character = utf8At(name, at);
        if (!character.valid || character.code < 0x20 || character.code == 0x7f)
            return true;
        at += character.size;
    }
    return false;
}

bool isFinite(const FbxProperty& property) {
    const int components = componentCount(property);
    if (components < 2)
        return components == 0 || std::isfinite(property.Get<FbxDouble>());
    const auto numbers = property.Get<FbxDouble4>();
    for (int i = 0; i < components; ++i)
        if (!std::isfinite(numbers[i]))
            return false;
    return true;
}

/// Cameras of views are outside of the tree on purpose.
bool isOfViews(const FbxNode& node) {
    const FbxNodeAttribute* attribute = node.GetNodeAttribute();
    return isProducer(node) || (attribute && attribute->GetAttributeType() == FbxNodeAttribute::eCameraSwitcher);
}

bool isText(const extensions::RecordValue& value) { return value.type == extensions::RecordValue::eText; }

/// How connections refer to an object: by its number, before 7.0 by its name.
std::string spellingOf(const extensions::RecordValue& value) {
    return isText(value) ? plainName(value.text) : std::to_string(value.integer);
}
std::string spellingOf(const FbxNode& node, bool hasIds) {
    return hasIds ? std::to_string(extensions::fileIdOf(node)) : std::string(node.GetName());
}

/// The nodes that the file connects to the root or to another node.
std::set<std::string> heldModels(const extensions::RecordFile& file) {
    std::set<std::string> models{"0"};
    forEachObjectRecord(
        file,
        [&models](const extensions::FileRecord& record) {
            if (record.name() == "Model")
                models.insert(spellingOf(record.value(0)));
        });
    const auto isModel = [&models](const extensions::RecordValue& value) {
        return isText(value) ? value.text.starts_with("Model::") || value.text.ends_with("\x01Model")
                             : models.contains(spellingOf(value));
    };
    std::set<std::string> held;
    for (extensions::FileRecord top = file.first(); top; top = top.nextSibling()) {
        for (extensions::FileRecord each = top.firstChild(); top.name() == "Connections" && each;
             each = each.nextSibling())
            if (each.valueCount() == 3 && each.value(0).text == "OO" && isModel(each.value(2)))
                held.insert(spellingOf(each.value(1)));
    }
    return held;
}

int badKeys(const Channel& channel) {
    int bad = 0;
    for (const LayerCurve& each : channel.curves)
        for (int i = 0; i < each.curve->KeyGetCount(); ++i)
            bad += std::isfinite(each.curve->KeyGetValue(i)) ? 0 : 1;
    return bad;
}

int badPoints(const FbxMesh& mesh) {
    int bad = 0;
    const FbxVector4* points = mesh.GetControlPoints();
    for (int i = 0; points && i < mesh.GetControlPointsCount(); ++i)
        bad += std::isfinite(points[i][0]) && std::isfinite(points[i][1]) && std::isfinite(points[i][2]) ? 0 : 1;
    return bad;
}

} // namespace

void notReadable(const LintContext& context, LintReport& report) {
    if (!context.unreadable.empty())
        report.add("", context.unreadable);
}

void repaired(const LintContext& context, LintReport& report) {
    for (const FbxString& warning : headerOf(context).mWarnings)
        report.add("", warning.Buffer());
}

void oldVersion(const LintContext& context, LintReport& report) {
    constexpr int kOldestOfPeers = 7100;
    if (headerOf(context).mFileVersion < kOldestOfPeers)
        report.add("", "the file has version " + std::to_string(headerOf(context).mFileVersion));
}

void asciiEncoding(const LintContext& context, LintReport& report) {
    if (headerOf(context).mASCII)
        report.add("", "the file is ASCII");
}

void unitShiftsOptics(const LintContext& context, LintReport& report) {
    if (context.unit() != 1.0 && hasOptics(context))
        report.add("", "the unit is " + unitName(context.unit()) + ", and there are cameras or lights");
}

void axesShiftOptics(const LintContext& context, LintReport& report) {
    const Axes axes = axesOf(context.scene().GetGlobalSettings().GetAxisSystem());
    if ((axes.up != "+Y" || axes.toViewer != "+Z") && hasOptics(context))
        report.add("", axes.up + " is up and " + axes.toViewer + " to the viewer, and there are cameras or lights");
}

void leftHanded(const LintContext& context, LintReport& report) {
    if (!axesOf(context.scene().GetGlobalSettings().GetAxisSystem()).rightHanded)
        report.add("", "the axes are left-handed");
}

void farFromOrigin(const LintContext& context, LintReport& report) {
    // From here on adjacent floats are further apart than a tenth of a millimetre.
    constexpr double kFar = 131072.0;
    for (const TreeNode& each : context.nodes) {
        const double away = lengthOf(context.worldOf(*each.node).GetT()) * context.unit();
        if (away >= kFar)
            report.add(each.node->GetName(),
                       "it is " + significant(away, 4) + " cm from the origin, where adjacent floats are " +
                           significant(std::exp2(std::floor(std::log2(away)) - 23.0), 3) + " cm apart");
    }
}

void meshAtOrigin(const LintContext& context, LintReport& report) {
    for (const TreeNode& each : context.nodes) {
        const FbxAMatrix world = context.worldOf(*each.node);
        if (each.node->GetMesh() && lengthOf(world.GetT()) == 0.0 && !isOnlyScaled(world))
            report.add(each.node->GetName(), "it is rotated or mirrored, and is exactly at the origin");
    }
}

void zeroScale(const LintContext& context, LintReport& report) {
    for (const TreeNode& each : context.nodes) {
        const FbxDouble3 scale = each.node->LclScaling.EvaluateValue(context.firstMoment());
        if (scale[0] == 0.0 || scale[1] == 0.0 || scale[2] == 0.0)
            report.add(each.node->GetName(), "its scale is " + vectorText({scale[0], scale[1], scale[2]}, 6));
    }
}

void mirroredNode(const LintContext& context, LintReport& report) {
    for (const TreeNode& each : context.nodes)
        if (each.node->GetMesh() && determinant(context.worldOf(*each.node)) < 0.0)
            report.add(each.node->GetName(), "it is mirrored in the world");
}

void shearedNode(const LintContext& context, LintReport& report) {
    constexpr double kTolerance = 1e-4;
    for (const TreeNode& each : context.nodes) {
        const FbxAMatrix world = context.worldOf(*each.node);
        double most = 0.0;
        for (int a = 0; a < 3; ++a) {
            const FbxVector4 one = world.GetRow(a), other = world.GetRow((a + 1) % 3);
            const double lengths = lengthOf(one) * lengthOf(other);
            most = std::max(most, lengths > 0.0 ? std::abs(dotProduct(one, other)) / lengths : 0.0);
        }
        if (most > kTolerance)
            report.add(each.node->GetName(), "its axes are not perpendicular in the world: " +
                                                 rounded(std::acos(std::min(most, 1.0)) * 57.29577951308232, 2) + "°");
    }
}

void inheritedScale(const LintContext& context, LintReport& report) {
    for (const TreeNode& each : context.nodes) {
        FbxNode* parent = each.node->GetParent();
        FbxTransform::EInheritType type = FbxTransform::eInheritRSrs;
        each.node->GetTransformationInheritType(type);
        if (!parent || !parent->GetParent() || type == FbxTransform::eInheritRSrs)
            continue;
        const FbxDouble3 scale = parent->LclScaling.EvaluateValue(context.firstMoment());
        const bool isKeyed = changes(parent->LclScaling, context.scene().GetCurrentAnimationStack());
        const bool leavesOut = type == FbxTransform::eInheritRrs;
        if (isKeyed || (leavesOut ? scale != FbxDouble3(1.0, 1.0, 1.0) : isUneven(scale)))
            report.add(each.node->GetName(),
                       std::string(leavesOut ? "it does not inherit" : "it inherits along its own axes") +
                           " the scale of its parent " + inQuotes(parent->GetName()) + ", " +
                           (isKeyed ? "which is keyed" : vectorText({scale[0], scale[1], scale[2]}, 4)));
    }
}

void valuesNotFinite(const LintContext& context, LintReport& report) {
    for (const FbxObject* object : context.objects) {
        for (const FbxProperty& property : propertiesOf(*object)) {
            if (extensions::isStated(property) && !isFinite(property))
                report.add(nameOf(*object),
                           std::string(property.GetHierarchicalName().Buffer()) + " is " + valueText(property));
        }
    }
    for (FbxMesh* mesh : context.meshes) {
        const int bad = badPoints(*mesh);
        if (bad > 0)
            report.add(nameOf(*mesh), countOf(bad, "point is", "points are") + " not finite");
    }
}

void keysNotFinite(const LintContext& context, LintReport& report) {
    for (const KeyedChannel& keyed : *context.channels) {
        const int bad = badKeys(keyed.channel);
        if (bad > 0)
            report.add(nameOf(*keyed.object),
                       keyed.fullName() + ": " + countOf(bad, "key is", "keys are") + " not finite");
    }
}

void duplicateNames(const LintContext& context, LintReport& report) {
    std::map<std::string, std::size_t> counts;
    for (const TreeNode& each : context.nodes)
        ++counts[each.node->GetName()];
    for (const auto& [name, count] : counts)
        if (count > 1 && !name.empty())
            report.add(name, std::to_string(count) + " nodes have this name");
}

void unnamedNodes(const LintContext& context, LintReport& report) {
    const auto count =
        static_cast<std::size_t>(std::count_if(context.nodes.begin(), context.nodes.end(), [](const TreeNode& each) {
            return std::string(each.node->GetName()).empty();
        }));
    if (count > 0)
        report.add("", countOf(count, "node has", "nodes have") + " no name");
}

void oddNames(const LintContext& context, LintReport& report) {
    for (const TreeNode& each : context.nodes)
        if (isOdd(each.node->GetName()))
            report.add(each.node->GetName(), "the name has control characters or invalid UTF-8");
}

void unparentedNodes(const LintContext& context, LintReport& report) {
    constexpr int kOldestWithConnections = 6000; // older files list children in their parents
    if (headerOf(context).mFileVersion < kOldestWithConnections)
        return;
    const std::set<std::string> held = heldModels(context.records());
    for (const TreeNode& each : context.nodes) {
        // The platform places nodes without a parent below the root.
        if (each.depth == 0 && !isOfViews(*each.node) && !held.contains(spellingOf(*each.node, context.file.hasIds())))
            report.add(each.node->GetName(),
                       each.node->GetChildCount() == 0 ? "it has no parent" : "it has descendants, but no parent");
    }
}

void constraints(const LintContext& context, LintReport& report) {
    std::map<std::string, std::size_t> kinds;
    forEachObjectRecord(context.records(), [&kinds](const extensions::FileRecord& record) {
        if (record.name().rfind("Constraint", 0) == 0 && record.valueCount() > 0)
            ++kinds[std::string(record.value(record.valueCount() - 1).text)];
    });
    for (const auto& [kind, count] : kinds)
        report.add("", countOf(count, "constraint", "constraints") + " of type " + inQuotes(kind));
}

void curveThatStopsThreeJs(const LintContext& context, LintReport& report) {
    for (const KeyedChannel& keyed : *context.channels) {
        const std::string property = keyed.channel.property.GetName().Buffer();
        const bool stops = (keyed.object->Is<FbxLight>() && property == "Color") ||
                           (keyed.object->Is<FbxCamera>() && (property == "FilmOffsetX" || property == "FilmOffsetY"));
        if (stops)
            report.add(nameOf(*keyed.object), keyed.fullName() + " is keyed");
    }
}

} // namespace tool
