// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Compares two files: their settings, their nodes, and the data of these.
#include "DiffFacts.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <map>

#include "CameraOrigins.h"
#include "Curves.h"
#include "DiffSides.h"
#include "SceneFacts.h"
#include "SceneQueries.h"

namespace tool {

using namespace Tarnell::Fbx;

namespace {

/// Assigns each node its object: both are in the order of the tree, and some nodes have none.
template <class Object, class Kept>
void assign(const std::vector<FbxNode*>& nodes, const FaithfulObjects<Object>& read,
            std::unordered_map<const FbxNode*, Kept>& objects) {
    std::size_t next = 0;
    for (FbxNode* node : nodes)
        if (next < read.count && read.objects.get()[next].getName() == node->GetName())
            objects[node] = read.objects.get() + next++;
    if (next != read.count)
        throw Unreadable("the file was changed while it was read");
}

std::vector<FbxNode*> nodesWithLights(FbxScene& scene) {
    std::vector<FbxNode*> nodes = nodesOfTree(scene);
    std::erase_if(nodes, [](FbxNode* node) { return !node->GetLight(); });
    return nodes;
}

std::string spanText(const TakeFacts& take) {
    const auto seconds = [&take](long long frame) { return rounded(static_cast<double>(frame) / take.frameRate, 4); };
    return "frames " + std::to_string(take.firstFrame) + " to " + std::to_string(take.lastFrame) + " (" +
           seconds(take.firstFrame) + " to " + seconds(take.lastFrame) + " s)";
}

std::string takeNames(FbxScene& scene) {
    std::string names;
    for (int i = 0; i < scene.GetSrcObjectCount<FbxAnimStack>(); ++i)
        names += (names.empty() ? "" : ", ") + inQuotes(scene.GetSrcObject<FbxAnimStack>(i)->GetName());
    return names.empty() ? "none" : names;
}

const char* parentName(const FbxNode& node) {
    return node.GetParent() && node.GetParent()->GetParent() ? node.GetParent()->GetName() : nullptr;
}

std::string placeInTree(const FbxNode& node) {
    const char* parent = parentName(node);
    return parent ? "below " + inQuotes(parent) : "below the root";
}

// ---- Keys ----

struct Key {
    double seconds, value;
};

std::vector<Key> keysOf(const Channel& channel) {
    std::vector<Key> keys;
    for (const LayerCurve& each : channel.curves) {
        for (int i = 0; i < each.curve->KeyGetCount(); ++i)
            keys.push_back(
                {each.curve->KeyGetTime(i).GetSecondDouble(), static_cast<double>(each.curve->KeyGetValue(i))});
    }
    return keys;
}

using KeysByName = std::map<std::string, std::vector<Key>>;

/// Adds the keys of an object's properties. A name that occurs before gets a prefix.
void addKeys(const FbxObject& object, FbxAnimStack* take, KeysByName& keys, const std::string& prefix = {}) {
    for (const FbxProperty& property : propertiesOf(object)) {
        for (const Channel& channel : channelsOf(property, take)) {
            if (channel.curves.empty())
                continue;
            const std::string name = prefix + channel.fullName();
            keys[keys.count(name) ? className(object) + '.' + name : name] = keysOf(channel);
        }
    }
}

/// Without the name of the blend shape, which some versions write before that of the channel.
std::string shapeName(FbxBlendShapeChannel& channel) {
    const FbxBlendShape* shapes = channel.GetBlendShapeDeformer();
    const std::string name = channel.GetName(), prefix = std::string(shapes ? shapes->GetName() : "") + '.';
    return prefix.size() > 1 && name.starts_with(prefix) ? name.substr(prefix.size()) : name;
}

/// Those of a node, its attributes and its blend shape channels.
KeysByName keysByName(FbxNode& node, FbxAnimStack* take) {
    KeysByName keys;
    addKeys(node, take, keys);
    for (int i = 0; i < node.GetNodeAttributeCount(); ++i)
        addKeys(*node.GetNodeAttributeByIndex(i), take, keys);
    for (FbxBlendShapeChannel* channel : blendChannelsOf(node))
        addKeys(*channel, take, keys, shapeName(*channel) + '.');
    return keys;
}

KeysByName keysByName(FbxSurfaceMaterial& material, FbxAnimStack* take) {
    KeysByName keys;
    addKeys(material, take, keys);
    return keys;
}

std::string keyCountText(std::size_t count) {
    return count == 0 ? "not keyed" : std::to_string(count) + (count == 1 ? " key" : " keys");
}

class CurveComparison {
public:
    CurveComparison(Comparison& comparison, std::string object) : mComparison(comparison), mObject(std::move(object)) {}

    void compare(const std::string& name, const std::vector<Key>& a, const std::vector<Key>& b) {
        if (a.size() != b.size())
            return mComparison.add(DiffKind::curve, mObject, name, keyCountText(a.size()), keyCountText(b.size()));
        const double rate = mComparison.a.take.frameRate;
        std::size_t late = 0, worst = 0;
        for (std::size_t i = 0; i < a.size(); ++i) {
            late = std::abs(a[i].seconds - b[i].seconds) > std::abs(a[late].seconds - b[late].seconds) ? i : late;
            worst = std::abs(a[i].value - b[i].value) > std::abs(a[worst].value - b[worst].value) ? i : worst;
        }
        constexpr double kSameFrame = 1e-3;
        const double frames = std::abs(a[late].seconds - b[late].seconds) * rate;
        if (frames > kSameFrame) {
            mComparison.found.push_back({DiffKind::curve, mObject, name + " (times)",
                                         rounded(a[late].seconds * rate, 4), rounded(b[late].seconds * rate, 4), frames,
                                         "frames", a[late].seconds * rate, 0});
        } else if (mComparison.differ(a[worst].value, b[worst].value)) {
            mComparison.found.push_back({DiffKind::curve, mObject, name, rounded(a[worst].value, 6),
                                         rounded(b[worst].value, 6), std::abs(a[worst].value - b[worst].value), "",
                                         a[worst].seconds * rate, 0});
        }
    }

private:
    Comparison& mComparison;
    std::string mObject;
};

} // namespace

// ---- The comparisons ----

DiffSide::DiffSide(const DiffFile& side, const std::string& chosenTake)
    : file(side), takeName(chosenTake), stack(side.opened.chooseTake(chosenTake)), take(takeFacts(side.opened, stack)),
      unit(side.opened.scene().GetGlobalSettings().GetSystemUnit().GetScaleFactor()),
      cameras(camerasOf(side.name, side.opened, chosenTake)) {
    TnFbxReadInfo info = faithfulInfo(side.name, chosenTake);
    info.setFrame(static_cast<float>(take.firstFrame));
    transforms = readFaithfully<TnFbxTransform>(info, &Fbx::getTransforms);
    lights = readFaithfully<TnFbxLight>(info, &Fbx::getLights);
    assign(nodesOfTree(side.opened.scene()), transforms, transformOf);
    assign(nodesWithLights(side.opened.scene()), lights, lightOf);
    for (const CameraFacts& camera : cameras.cameras)
        cameraOf[camera.node] = &camera;
}

DiffMoments::DiffMoments(const TakeFacts& a, const TakeFacts& b)
    : mFirst{static_cast<double>(a.firstFrame), static_cast<double>(b.firstFrame)}, mStep(b.frameRate / a.frameRate) {
    const auto seconds = [](long long frame, double rate) { return static_cast<double>(frame) / rate; };
    const double start = std::max(seconds(a.firstFrame, a.frameRate), seconds(b.firstFrame, b.frameRate));
    const double end = std::min(seconds(a.lastFrame, a.frameRate), seconds(b.lastFrame, b.frameRate));
    constexpr double kTolerance = 1e-3;
    const double first = std::ceil(start * a.frameRate - kTolerance) + 0.0; // avoids negative zero
    const double last = std::floor(end * a.frameRate + kTolerance);
    if (last < first)
        return;
    mFirst = {first, first * mStep};
    mCount = static_cast<std::size_t>(last - first) + 1;
}

Comparison::Comparison(const DiffFile& fileA, const DiffFile& fileB, const DiffSettings& given)
    : a(fileA, given.take), b(fileB, given.take), settings(given),
      pairs(matchNodes(fileA.opened.scene(), fileB.opened.scene())),
      materials(matchMaterials(fileA.opened.scene(), fileB.opened.scene(), pairs)), moments(a.take, b.take) {}

bool Comparison::differ(double one, double other) const {
    if (!std::isfinite(one) || !std::isfinite(other))
        return !(one == other || (std::isnan(one) && std::isnan(other)));
    return std::abs(one - other) > settings.tolerance * std::max({1.0, std::abs(one), std::abs(other)});
}

void Comparison::addWorst(Difference difference, bool changes,
                          const std::function<std::pair<double, double>(DiffMoment)>& at) {
    bool differs = false;
    for (std::size_t i = 0; i < (changes ? moments.size() : 1); ++i) {
        const auto [one, other] = at(moments[i]);
        const double amount = std::abs(one - other);
        if (!differ(one, other) || (differs && !(amount > difference.amount.value_or(0.0))))
            continue;
        differs = true;
        difference.amount = amount;
        difference.frame = moments[i].a;
        difference.a = significant(one, 7);
        difference.b = significant(other, 7);
    }
    if (differs)
        found.push_back(std::move(difference));
}

void compareFiles(Comparison& comparison) {
    const DiffSide &a = comparison.a, &b = comparison.b;
    if (comparison.differ(a.take.frameRate, b.take.frameRate))
        comparison.add(DiffKind::rate, "", "frames per second", rounded(a.take.frameRate, 4),
                       rounded(b.take.frameRate, 4));
    if (a.unit != b.unit)
        comparison.add(DiffKind::unit, "", "unit", unitName(a.unit), unitName(b.unit));
    if (a.cameras.axes != b.cameras.axes)
        comparison.add(DiffKind::axes, "", "axes", a.cameras.axes, b.cameras.axes);
    const std::string takesA = takeNames(a.file.opened.scene()), takesB = takeNames(b.file.opened.scene());
    if (takesA != takesB)
        comparison.add(DiffKind::take, "", "takes", takesA, takesB);
    const double rate = a.take.frameRate / b.take.frameRate;
    if (a.take.exists && b.take.exists &&
        (comparison.differ(static_cast<double>(a.take.firstFrame), static_cast<double>(b.take.firstFrame) * rate) ||
         comparison.differ(static_cast<double>(a.take.lastFrame), static_cast<double>(b.take.lastFrame) * rate)))
        comparison.add(DiffKind::take, "", "span", spanText(a.take), spanText(b.take));
}

void compareTrees(Comparison& comparison) {
    std::unordered_map<const FbxNode*, const FbxNode*> counterparts;
    counterparts[comparison.a.file.opened.scene().GetRootNode()] = comparison.b.file.opened.scene().GetRootNode();
    for (const NodePair& pair : comparison.pairs)
        if (pair.a)
            counterparts[pair.a] = pair.b;
    for (const auto& [a, b] : comparison.pairs) {
        if (!a) {
            comparison.add(DiffKind::added, b->GetName(), kindOf(*b), "", placeInTree(*b));
            continue;
        }
        if (!b) {
            comparison.add(DiffKind::removed, a->GetName(), kindOf(*a), placeInTree(*a), "");
            continue;
        }
        if (std::string(a->GetName()) != b->GetName())
            comparison.add(DiffKind::renamed, a->GetName(), kindOf(*a), a->GetName(), b->GetName());
        if (counterparts[a->GetParent()] != b->GetParent())
            comparison.add(DiffKind::moved, a->GetName(), kindOf(*a), placeInTree(*a), placeInTree(*b));
        if (std::string(kindOf(*a)) != kindOf(*b))
            comparison.add(DiffKind::kind, a->GetName(), "kind", kindOf(*a), kindOf(*b));
    }
}

void compareLights(Comparison& comparison) {
    constexpr std::array<const char*, 3> kTypes = {"point", "directional", "spot"};
    constexpr std::array<const char*, 4> kDecays = {"none", "linear", "quadratic", "cubic"};
    for (const auto& [nodeA, nodeB] : comparison.pairs) {
        const auto foundA = comparison.a.lightOf.find(nodeA), foundB = comparison.b.lightOf.find(nodeB);
        if (foundA == comparison.a.lightOf.end() || foundB == comparison.b.lightOf.end())
            continue;
        TnFbxLight &a = *foundA->second, &b = *foundB->second;
        if (a.getLightType() != b.getLightType())
            comparison.add(DiffKind::light, nodeA->GetName(), "type",
                           kTypes[static_cast<std::size_t>(a.getLightType())],
                           kTypes[static_cast<std::size_t>(b.getLightType())]);
        if (a.getDecayType() != b.getDecayType())
            comparison.add(DiffKind::light, nodeA->GetName(), "decay",
                           kDecays[static_cast<std::size_t>(a.getDecayType())],
                           kDecays[static_cast<std::size_t>(b.getDecayType())]);
        for (int i = TnFbxLight::kFbxLightRed; i <= TnFbxLight::kFbxLightConeAngle; ++i) {
            const auto channel = static_cast<TnFbxLight::EFbxLightChannelType>(i);
            comparison.addWorst(
                {DiffKind::light, nodeA->GetName(), TnFbxLight::getChannelName(channel), {}, {}, {}, "", {}, 0},
                a.getAnimated(channel) || b.getAnimated(channel), [&](DiffMoment moment) {
                    return std::pair(static_cast<double>(a.getValueAt(channel, static_cast<float>(moment.a))),
                                     static_cast<double>(b.getValueAt(channel, static_cast<float>(moment.b))));
                });
        }
    }
}

void compareCurves(Comparison& comparison) {
    // Keys of a node's transform are in its file's unit and axes.
    const bool sameSpace =
        comparison.a.unit == comparison.b.unit && comparison.a.cameras.axes == comparison.b.cameras.axes;
    const std::vector<Key> none;
    const auto comparePair = [&](auto* objectA, auto* objectB) {
        if (!objectA || !objectB)
            return;
        const KeysByName a = keysByName(*objectA, comparison.a.stack), b = keysByName(*objectB, comparison.b.stack);
        CurveComparison curves(comparison, objectA->GetName());
        for (const auto& [name, keys] : a) {
            const auto found = b.find(name);
            if (sameSpace || name.rfind("Lcl ", 0) != 0)
                curves.compare(name, keys, found == b.end() ? none : found->second);
        }
        for (const auto& [name, keys] : b)
            if (!a.count(name) && (sameSpace || name.rfind("Lcl ", 0) != 0))
                curves.compare(name, none, keys);
    };
    for (const auto& [nodeA, nodeB] : comparison.pairs)
        comparePair(nodeA, nodeB);
    for (const auto& [materialA, materialB] : comparison.materials)
        comparePair(materialA, materialB);
}

const char* diffKindName(DiffKind kind) {
    constexpr std::array<const char*, 17> kNames = {"rate",    "unit",   "axes",     "take",      "added",  "removed",
                                                    "renamed", "moved",  "kind",     "transform", "optics", "light",
                                                    "curve",   "points", "topology", "material",  "texture"};
    return kNames[static_cast<std::size_t>(kind)];
}

std::vector<Difference> differencesOf(const DiffFile& a, const DiffFile& b, const DiffSettings& settings) {
    Comparison comparison(a, b, settings);
    for (const auto compare : {compareFiles, compareTrees, compareTransforms, compareCameras, compareLights,
                               compareCurves, compareMeshes, compareMaterials})
        compare(comparison);
    return std::move(comparison.found);
}

} // namespace tool
