// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// One scene in several versions: files that differ only in version and encoding must read the same. Every file
// is compared with the newest one of its scene: the nodes by their paths, their placement, and the points of their
// meshes as the library deforms them, at the beginning, in the middle and at the end of the first stack.
#include "../Corpus.h"

#include "Fbx.h"
#include "FbxSdk.h"
#include "TnFbxError.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <map>
#include <optional>
#include <regex>
#include <string>
#include <vector>

namespace conformance {
namespace {

using namespace fbxsdk;
using Tarnell::Fbx::FbxSdk;
using Numbers = std::vector<double>;

/// Texts hold seven digits in newer files, and curves are floats.
constexpr double kTolerance = 2e-5;
constexpr int kSkipped = 77;

/// A node at the times of the scene.
struct NodeFacts {
    std::vector<Numbers> matrices; ///< one per time
    int points = -1, polygons = -1;
    std::vector<Numbers> corners; ///< the centre and the extent of the deformed points in the world, per time
};

struct SceneFacts {
    Numbers span; ///< of the first stack, in seconds
    std::map<std::string, NodeFacts> nodes;
};

void appendMatrix(const FbxAMatrix& matrix, Numbers& numbers) {
    for (int row = 0; row < 4; ++row)
        for (int column = 0; column < 3; ++column)
            numbers.push_back(matrix.Get(row, column));
}

/// The mean, the minimum and the maximum coordinate of the deformed points; programs may renumber points.
Numbers extentOf(FbxSdk& sdk, FbxNode& node, FbxMesh& mesh, FbxTime time) {
    FbxAMatrix global = node.EvaluateGlobalTransform(time);
    const FbxAMatrix geometric(node.GetGeometricTranslation(FbxNode::eSourcePivot),
                               node.GetGeometricRotation(FbxNode::eSourcePivot),
                               node.GetGeometricScaling(FbxNode::eSourcePivot));
    FbxAMatrix place = global * geometric;
    FbxVector4* made = nullptr;
    sdk.getDeformedControlPoints(&node, &mesh, time, place, &made);
    const std::unique_ptr<FbxVector4[]> points(made);
    const int count = made ? mesh.GetControlPointsCount() : 0;
    Numbers sum(3, 0.0), least(3, HUGE_VAL), most(3, -HUGE_VAL);
    const bool inWorld = mesh.GetDeformerCount(FbxDeformer::eSkin) > 0; // skins move their points there themselves
    for (int i = 0; i < count; ++i) {
        const FbxVector4 point =
            inWorld ? points[static_cast<std::size_t>(i)] : place.MultT(points[static_cast<std::size_t>(i)]);
        for (int axis = 0; axis < 3; ++axis) {
            const auto a = static_cast<std::size_t>(axis);
            sum[a] += point[axis] / count;
            least[a] = std::min(least[a], point[axis]);
            most[a] = std::max(most[a], point[axis]);
        }
    }
    sum.insert(sum.end(), least.begin(), least.end());
    sum.insert(sum.end(), most.begin(), most.end());
    return sum;
}

class SceneReader {
public:
    std::optional<SceneFacts> read(const CorpusFile& file) {
        if (!Tarnell::Fbx::Fbx().loadScene(file.path.string(), mSdk))
            return std::nullopt;
        FbxScene& scene = *mSdk.getScene();
        if (auto* stack = scene.GetSrcObject<FbxAnimStack>(0)) {
            const FbxTimeSpan span = stack->GetLocalTimeSpan();
            mFacts.span = {span.GetStart().GetSecondDouble(), span.GetStop().GetSecondDouble()};
        }
        mSdk.openClosePointCacheData(&scene, true);
        visit(*scene.GetRootNode(), "");
        mSdk.openClosePointCacheData(&scene, false);
        return std::move(mFacts);
    }

private:
    void visit(FbxNode& parent, const std::string& path) {
        for (int i = 0; i < parent.GetChildCount(); ++i) {
            FbxNode& node = *parent.GetChild(i);
            std::string name = path + "/" + node.GetName();
            while (mFacts.nodes.count(name) > 0)
                name += "'"; // of one name below one parent
            mFacts.nodes[name] = factsOf(node);
            visit(node, name);
        }
    }

    NodeFacts factsOf(FbxNode& node) {
        NodeFacts facts;
        FbxMesh* mesh = node.GetMesh();
        if (mesh) {
            facts.points = mesh->GetControlPointsCount();
            facts.polygons = mesh->GetPolygonCount();
        }
        for (const double part : {0.0, 0.5, 1.0}) {
            const double seconds =
                mFacts.span.empty() ? 0.0 : mFacts.span[0] + part * (mFacts.span[1] - mFacts.span[0]);
            FbxTime time;
            time.SetSecondDouble(seconds);
            appendMatrix(node.EvaluateGlobalTransform(time), facts.matrices.emplace_back());
            if (mesh && facts.points > 0)
                facts.corners.push_back(extentOf(mSdk, node, *mesh, time));
        }
        return facts;
    }

    FbxSdk mSdk;
    SceneFacts mFacts;
};

bool same(const Numbers& a, const Numbers& b) {
    double largest = 1.0;
    for (const double number : b)
        largest = std::max(largest, std::isfinite(number) ? std::abs(number) : 0.0);
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), [&](double x, double y) {
        return x == y || std::abs(x - y) <= kTolerance * largest || (std::isnan(x) && std::isnan(y));
    });
}

bool same(const std::vector<Numbers>& a, const std::vector<Numbers>& b) {
    return std::equal(
        a.begin(), a.end(), b.begin(), b.end(), [](const auto& x, const auto& y) { return same(x, y); });
}

/// The first difference; empty when the scenes agree.
std::string difference(const SceneFacts& facts, const SceneFacts& newest) {
    if (!same(facts.span, newest.span))
        return "the spans of the first stacks differ";
    for (const auto& [name, node] : newest.nodes)
        if (facts.nodes.count(name) == 0)
            return "has no node " + name;
    for (const auto& [name, node] : facts.nodes) {
        const auto found = newest.nodes.find(name);
        if (found == newest.nodes.end())
            return "has one more node, " + name;
        const NodeFacts& other = found->second;
        if (node.points != other.points || node.polygons != other.polygons)
            return name + " has another mesh";
        if (!same(node.matrices, other.matrices))
            return name + " is at another place";
        if (!same(node.corners, other.corners))
            return name + " has its points at other places";
    }
    return {};
}

/// The scene's name, the version and the encoding: "maya_cube", "7500ascii".
std::optional<std::pair<std::string, std::string>> partsOf(const std::string& name) {
    static const std::regex kName("(.*)_([0-9]{4})_(ascii|binary)(_.*)?");
    std::smatch parts;
    if (!std::regex_match(name, parts, kName))
        return std::nullopt;
    return std::pair(parts[1].str() + parts[4].str(), parts[2].str() + parts[3].str());
}

class Comparison {
public:
    explicit Comparison(const char* reasonsFile) {
        nlohmann::json reasons;
        std::ifstream(reasonsFile) >> reasons;
        for (const auto& entry : reasons)
            for (const auto& file : entry.at("files"))
                mReasons[file.get<std::string>()] = entry.at("reason").get<std::string>();
    }

    void compareScene(const std::map<std::string, const CorpusFile*>& versions) {
        const CorpusFile& newest = *versions.rbegin()->second;
        const std::optional<SceneFacts> expected = SceneReader().read(newest);
        for (const auto& [version, file] : versions) {
            if (file == &newest)
                continue;
            const std::optional<SceneFacts> actual = SceneReader().read(*file);
            if (expected.has_value() != actual.has_value())
                judge(file->name, "only one of the two loads");
            else
                judge(file->name, actual ? difference(*actual, *expected) : "");
        }
    }

    int finish() const {
        std::cout << mCompared << " files compared with the newest version of their scene, " << mExplained
                  << " differ for a known reason, " << mFaults << " faults\n";
        return mFaults == 0 ? EXIT_SUCCESS : EXIT_FAILURE;
    }

private:
    void judge(const std::string& file, const std::string& found) {
        ++mCompared;
        const bool known = mReasons.count(file) > 0;
        if (found.empty() == !known) {
            mExplained += known ? 1 : 0;
            return;
        }
        ++mFaults;
        std::cout << file << ": " << (known ? "agrees, but is listed as different" : found) << '\n';
    }

    std::map<std::string, std::string> mReasons;
    int mCompared = 0, mExplained = 0, mFaults = 0;
};

int run() {
    const auto folder = findCorpus();
    if (!folder) {
        std::cout << "there is no corpus; set TARNELL_CORPUS\n";
        return kSkipped;
    }
    const std::vector<CorpusFile> files = listCorpus(*folder);
    std::map<std::string, std::map<std::string, const CorpusFile*>> scenes;
    for (const CorpusFile& file : files)
        if (const auto parts = partsOf(file.name))
            scenes[parts->first][parts->second] = &file;
    Comparison comparison(TARNELL_CONFORMANCE_VERSIONS);
    for (const auto& [scene, versions] : scenes)
        if (versions.size() > 1)
            comparison.compareScene(versions);
    return comparison.finish();
}

} // namespace
} // namespace conformance

int main() {
    try {
        return conformance::run();
    } catch (const std::exception& error) {
        std::cerr << error.what() << '\n';
        return EXIT_FAILURE;
    }
}
