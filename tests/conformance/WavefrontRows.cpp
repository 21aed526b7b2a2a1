// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes against the Wavefront file that the same application saved of the same scene: an independent reference.
#include "FaithfulRows.h"
#include "Tolerances.h"
#include "WavefrontFile.h"

#include <algorithm>
#include <set>

namespace conformance {
namespace {

using namespace fbxsdk;

/// The format has neither units nor axes. Applications save either what they see, or the file's unit, or unit and axes
/// of the file.
struct Space {
    bool inFileUnits, inFileAxes;
};

constexpr Space kSpaces[] = {{false, false}, {true, false}, {true, true}};

FbxAMatrix toScene(const Space& space, const Reference& reference) {
    FbxAMatrix matrix;
    constexpr double kCentimetresPerMetre = 100.0;
    if (space.inFileAxes && reference.axes == std::array{0, 4, 3})
        matrix.SetR(FbxVector4(-90, 0, 0));
    const double scale = space.inFileUnits ? reference.fileUnitMeters * kCentimetresPerMetre : 1.0;
    matrix.SetS(FbxVector4(scale, scale, scale));
    return matrix;
}

std::vector<Point> transformed(const FbxAMatrix& matrix, const std::vector<Point>& points) {
    std::vector<Point> result;
    result.reserve(points.size());
    for (const Point& point : points) {
        const FbxVector4 moved = matrix.MultT(FbxVector4(point[0], point[1], point[2]));
        result.push_back({moved[0], moved[1], moved[2]});
    }
    return result;
}

bool near(const Point& a, const Point& b, double tolerance) {
    for (std::size_t i = 0; i < a.size(); ++i)
        if (!closeTo(a[i], b[i], kEvaluatedTolerance) && !(std::abs(a[i] - b[i]) <= tolerance))
            return false;
    return true;
}

/// The first point of `from` that has no counterpart in `to`; `from.size()` when there is none.
std::size_t firstWithoutCounterpart(const std::vector<Point>& from, const std::vector<Point>& to, double tolerance) {
    for (std::size_t i = 0; i < from.size(); ++i)
        if (std::ranges::none_of(to, [&](const Point& point) { return near(from[i], point, tolerance); }))
            return i;
    return from.size();
}

/// Empty when the points agree, else the difference.
std::string compareInOrder(const std::vector<Point>& actual, const std::vector<Point>& expected, double tolerance) {
    if (actual.size() != expected.size())
        return std::to_string(actual.size()) + " points instead of " + std::to_string(expected.size());
    for (std::size_t i = 0; i < actual.size(); ++i) {
        if (near(actual[i], expected[i], tolerance))
            continue;
        return "point " + std::to_string(i) + ": " + printed(actual[i].data(), 3) + " instead of " +
               printed(expected[i].data(), 3);
    }
    return {};
}

std::string compareAsSets(const std::vector<Point>& actual, const std::vector<Point>& expected, double tolerance) {
    if (const std::size_t i = firstWithoutCounterpart(expected, actual, tolerance); i < expected.size())
        return "nothing at " + printed(expected[i].data(), 3);
    if (const std::size_t i = firstWithoutCounterpart(actual, expected, tolerance); i < actual.size())
        return "point " + std::to_string(i) + " at " + printed(actual[i].data(), 3) + ", where there is nothing";
    return {};
}

std::set<std::string> chainOf(const LoadedFile& file, std::size_t nodeIndex) {
    std::set<std::string> names;
    for (int i = static_cast<int>(nodeIndex); i >= 0; i = file.reference().nodes[static_cast<std::size_t>(i)].parent)
        names.insert(decodedName(file.reference().nodes[static_cast<std::size_t>(i)].name));
    return names;
}

/// How well a block's names match a node: groups list the node with its ancestors, in any order, or the node's name and
/// the mesh's joined by an underscore. 0 is no match.
std::size_t fit(const WavefrontBlock& block, const std::string& nodeName, const std::set<std::string>& chain) {
    const auto isNode = [&](const std::string& name) { return name == nodeName || name.starts_with(nodeName + "_"); };
    if (std::ranges::none_of(block.names, isNode))
        return 0;
    const auto inChain = [&](const std::string& name) { return isNode(name) || chain.contains(name); };
    const auto known = static_cast<std::size_t>(std::ranges::count_if(block.names, inChain));
    const std::size_t exact = std::ranges::find(block.names, nodeName) != block.names.end() ? 1 : 0;
    constexpr std::size_t kMoreThanUnknownNames = 100;
    return 2 * (kMoreThanUnknownNames + known - (block.names.size() - known)) + exact;
}

const WavefrontBlock* blockOf(const WavefrontFile& wavefront, const LoadedFile& file, std::size_t nodeIndex) {
    const std::set<std::string> chain = chainOf(file, nodeIndex);
    const std::string nodeName = decodedName(file.reference().nodes[nodeIndex].name);
    const WavefrontBlock* best = nullptr;
    std::size_t bestFit = 0;
    for (const WavefrontBlock& block : wavefront.blocks) {
        const std::size_t value = fit(block, nodeName, chain);
        if (value > bestFit)
            best = &block;
        bestFit = std::max(bestFit, value);
    }
    const bool unnamed = wavefront.blocks.size() == 1 && wavefront.blocks[0].names.empty();
    return unnamed ? &wavefront.blocks[0] : best;
}

bool isWanted(const ReferenceNode& node, bool deformed) {
    return node.mesh && node.mesh->blendShapes == 0 && (node.mesh->skins + node.mesh->caches > 0) == deformed;
}

/// A node's points here and in the Wavefront file, still in the latter's space.
struct Pair {
    const std::string* name;
    std::vector<Point> actual;
    const std::vector<Point>* wavefront;
};

FbxTime timeOf(const WavefrontSibling& sibling, const Reference& reference) {
    if (!sibling.frame)
        return FBXSDK_TIME_INFINITE; // the values as stored
    return timeOfSeconds(secondsOf(sibling, reference));
}

std::vector<Pair> pairsOf(LoadedFile& file, const WavefrontFile& wavefront, const FbxTime& time, bool deformed) {
    std::vector<Pair> pairs;
    const std::vector<ReferenceNode>& nodes = file.reference().nodes;
    for (std::size_t i = 0; i < nodes.size(); ++i) {
        if (!isWanted(nodes[i], deformed))
            continue;
        const WavefrontBlock* block = blockOf(wavefront, file, i);
        if (block == nullptr)
            continue; // the application omitted the node
        const SceneNode* entry = file.nodeOf(i);
        FbxMesh* mesh = entry ? entry->node->GetMesh() : nullptr;
        std::vector<Point> points;
        if (mesh)
            points = worldPoints(file, *entry->node, *mesh, time);
        pairs.push_back({&nodes[i].name, std::move(points), &block->points});
    }
    return pairs;
}

/// One text per pair, empty where they agree.
std::vector<std::string> differencesIn(const Space& space, const Reference& reference, const WavefrontFile& wavefront,
                                       const std::vector<Pair>& pairs) {
    const FbxAMatrix matrix = toScene(space, reference);
    const double tolerance = wavefront.tolerance * matrix.GetS()[0];
    const auto compare = wavefront.inOtherOrder ? compareAsSets : compareInOrder;
    std::vector<std::string> differences;
    for (const Pair& pair : pairs)
        differences.push_back(compare(pair.actual, transformed(matrix, *pair.wavefront), tolerance));
    return differences;
}

/// All meshes of a file are in one space: the one in which most of them agree.
void comparePairs(const Reference& reference, const WavefrontSibling& sibling, const WavefrontFile& wavefront,
                  const std::vector<Pair>& pairs, Findings& findings) {
    std::vector<std::string> best;
    for (const Space& space : kSpaces) {
        std::vector<std::string> differences = differencesIn(space, reference, wavefront, pairs);
        if (best.empty() || std::ranges::count(differences, "") > std::ranges::count(best, ""))
            best.swap(differences);
    }
    for (std::size_t i = 0; i < pairs.size(); ++i) {
        findings.compare(
            best[i].empty(),
            [&] { return sibling.path.filename().string() + " \"" + *pairs[i].name + "\" " + best[i]; });
    }
}

void compareSibling(LoadedFile& file, const WavefrontSibling& sibling, bool deformed, Findings& findings) {
    const WavefrontFile wavefront = readWavefront(sibling.path);
    const std::vector<Pair> pairs = pairsOf(file, wavefront, timeOf(sibling, file.reference()), deformed);
    comparePairs(file.reference(), sibling, wavefront, pairs, findings);
}

} // namespace

void checkWavefrontPoints(LoadedFile& file, Findings& findings) {
    for (const WavefrontSibling& sibling : file.file().wavefront)
        compareSibling(file, sibling, false, findings);
}

void checkDeformedWavefrontPoints(LoadedFile& file, Findings& findings) {
    if (!file.loaded())
        return;
    const OpenCaches open(file);
    for (const WavefrontSibling& sibling : file.file().wavefront)
        compareSibling(file, sibling, true, findings);
}

/// Frames of a clip that is not the scene's first count from the clip's start.
double secondsOf(const WavefrontSibling& sibling, const Reference& reference) {
    const double seconds = sibling.frame.value_or(0.0) / reference.fps;
    const double start = reference.stacks.empty() ? 0.0 : reference.stacks[0].begin;
    return seconds < start - kSecondsTolerance ? start + seconds : seconds;
}

void compareWithWavefront(LoadedFile& file, const WavefrontSibling& sibling, const PointSource& pointsOf,
                          Findings& findings) {
    const WavefrontFile wavefront = readWavefront(sibling.path);
    const std::vector<ReferenceNode>& nodes = file.reference().nodes;
    std::vector<Pair> pairs;
    for (std::size_t i = 0; i < nodes.size(); ++i) {
        const WavefrontBlock* block = nodes[i].mesh ? blockOf(wavefront, file, i) : nullptr;
        if (block != nullptr) // else the application omitted the node
            pairs.push_back({&nodes[i].name, pointsOf(i), &block->points});
    }
    comparePairs(file.reference(), sibling, wavefront, pairs, findings);
}

} // namespace conformance
