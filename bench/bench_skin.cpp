// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Deforms a skinned mesh frame by frame as a host does, and compares the time with the minimum memory traffic of the
// work. The points are verified before a time counts.
#include "Measurement.h"

#include <FbxSdk.h>
#include <fbxsdk.h>

#include <algorithm>
#include <array>
#include <bit>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <memory>
#include <numbers>
#include <numeric>
#include <random>
#include <string_view>
#include <vector>

namespace {

constexpr int kVertices = 100'000;
constexpr int kBones = 60; // one cluster each
constexpr int kInfluences = 4;
constexpr int kFrames = 100;
constexpr double kTolerance = 1e-9; // of coordinates that stay below 1000

using Place = std::array<double, 3>;

/// The influences of the bones on one vertex. The weights do not add up to 1: normalising is part of the work.
struct Binding {
    std::array<int, kInfluences> bones;
    std::array<double, kInfluences> weights;
};

struct Skin {
    std::vector<Place> points;
    std::vector<Binding> bindings;
};

Skin makeSkin() {
    std::mt19937 random(20'240'229); // its numbers are the same everywhere, those of the distributions are not
    const auto fraction = [&random] { return static_cast<double>(random()) / 4'294'967'296.0; };
    Skin skin;
    for (int i = 0; i < kVertices; ++i) {
        skin.points.push_back({fraction() * 100.0, fraction() * 100.0, fraction() * 100.0});
        Binding binding{};
        for (std::size_t n = 0; n < binding.bones.size();) {
            const int bone = static_cast<int>(random() % kBones);
            if (std::find(binding.bones.begin(), binding.bones.begin() + n, bone) == binding.bones.begin() + n) {
                binding.bones[n] = bone;
                binding.weights[n++] = 0.05 + fraction();
            }
        }
        skin.bindings.push_back(binding);
    }
    return skin;
}

// ---- The bones, as numbers ----

/// The bind position of a bone.
Place boneOrigin(int bone) {
    return {static_cast<double>(bone % 10) * 10.0, static_cast<double>(bone / 10) * 16.0, 50.0};
}

// Both are exact in single precision, which is what curves hold.
float boneTurn(int bone, int frame) { return static_cast<float>(frame) * (0.25f + static_cast<float>(bone) / 64.0f); }
float boneRise(int bone, int frame) { return static_cast<float>(frame * (bone % 5)) / 32.0f; }

/// The closed form: the rotation about the bone's Z and its rise, averaged by weight.
Place expectedPlace(const Place& point, const Binding& binding, int frame) {
    Place sum{};
    double total = 0.0;
    for (std::size_t n = 0; n < binding.bones.size(); ++n) {
        const int bone = binding.bones[n];
        const Place origin = boneOrigin(bone);
        const double angle = static_cast<double>(boneTurn(bone, frame)) * std::numbers::pi / 180.0;
        const double x = point[0] - origin[0], y = point[1] - origin[1];
        const Place moved = {origin[0] + x * std::cos(angle) - y * std::sin(angle),
                             origin[1] + x * std::sin(angle) + y * std::cos(angle),
                             point[2] + static_cast<double>(boneRise(bone, frame))};
        for (std::size_t axis = 0; axis < sum.size(); ++axis)
            sum[axis] += moved[axis] * binding.weights[n];
        total += binding.weights[n];
    }
    return {sum[0] / total, sum[1] / total, sum[2] / total};
}

// ---- The bones, as a scene ----

fbxsdk::FbxTime timeOfFrame(int frame) {
    fbxsdk::FbxTime time;
    time.SetFrame(frame, fbxsdk::FbxTime::eFrames24);
    return time;
}

template <class ValueAt>
void keyEveryFrame(fbxsdk::FbxProperty property, const char* component, fbxsdk::FbxAnimLayer* layer, ValueAt valueAt) {
    fbxsdk::FbxAnimCurve* curve = property.GetCurve(layer, property.GetName(), component, true);
    for (int frame = 0; frame < kFrames; ++frame) {
        const fbxsdk::FbxTime time = timeOfFrame(frame);
        curve->KeySet(curve->KeyAdd(time), time, valueAt(frame), fbxsdk::FbxAnimCurveDef::eInterpolationLinear);
    }
}

fbxsdk::FbxNode* addBone(fbxsdk::FbxScene* scene, fbxsdk::FbxAnimLayer* layer, int bone) {
    fbxsdk::FbxNode* node = fbxsdk::FbxNode::Create(scene, "bone");
    scene->GetRootNode()->AddChild(node);
    const Place origin = boneOrigin(bone);
    node->LclTranslation.Set({origin[0], origin[1], origin[2]});
    keyEveryFrame(
        node->LclRotation, "Z", layer, [bone](int frame) { return boneTurn(bone, frame); });
    keyEveryFrame(node->LclTranslation, "Z", layer,
                  [bone, z = static_cast<float>(origin[2])](int frame) { return z + boneRise(bone, frame); });
    return node;
}

/// One bound cluster per bone; `order` is the order in which the vertices are given to them.
void addSkin(fbxsdk::FbxScene* scene, fbxsdk::FbxMesh* mesh, fbxsdk::FbxAnimLayer* layer, const Skin& skin,
             const std::vector<int>& order) {
    fbxsdk::FbxSkin* deformer = fbxsdk::FbxSkin::Create(scene, "skin");
    std::vector<fbxsdk::FbxCluster*> clusters;
    for (int bone = 0; bone < kBones; ++bone) {
        const Place origin = boneOrigin(bone);
        fbxsdk::FbxAMatrix bound;
        bound.SetT({origin[0], origin[1], origin[2]});
        fbxsdk::FbxCluster* cluster = fbxsdk::FbxCluster::Create(scene, "cluster");
        cluster->SetLink(addBone(scene, layer, bone));
        cluster->SetLinkMode(fbxsdk::FbxCluster::eNormalize);
        cluster->SetTransformLinkMatrix(bound);
        deformer->AddCluster(cluster);
        clusters.push_back(cluster);
    }
    for (const int vertex : order) {
        const Binding& binding = skin.bindings[static_cast<std::size_t>(vertex)];
        for (std::size_t n = 0; n < binding.bones.size(); ++n)
            clusters[static_cast<std::size_t>(binding.bones[n])]->AddControlPointIndex(vertex, binding.weights[n]);
    }
    mesh->AddDeformer(deformer);
}

/// The node with the skinned mesh; null when the context cannot be initialised.
fbxsdk::FbxNode* buildScene(Tarnell::Fbx::FbxSdk& sdk, const Skin& skin, const std::vector<int>& order) {
    if (!sdk.initFbxSdkManager())
        return nullptr;
    fbxsdk::FbxScene* scene = sdk.getScene();
    scene->GetGlobalSettings().SetTimeMode(fbxsdk::FbxTime::eFrames24);
    sdk.initCreateAnimationStack();
    auto* stack = scene->GetSrcObject<fbxsdk::FbxAnimStack>(0);
    fbxsdk::FbxMesh* mesh = fbxsdk::FbxMesh::Create(scene, "mesh");
    mesh->InitControlPoints(kVertices);
    for (int i = 0; i < kVertices; ++i) {
        const Place& point = skin.points[static_cast<std::size_t>(i)];
        mesh->SetControlPointAt({point[0], point[1], point[2]}, i);
    }
    addSkin(scene, mesh, stack->GetSrcObject<fbxsdk::FbxAnimLayer>(0), skin, order);
    fbxsdk::FbxNode* node = fbxsdk::FbxNode::Create(scene, "mesh");
    node->SetNodeAttribute(mesh);
    scene->GetRootNode()->AddChild(node);
    return node;
}

// ---- Running ----

class Run {
public:
    Run(const Skin& skin, const std::vector<int>& order) : mSkin(skin), mNode(buildScene(mSdk, skin, order)) {}
    ~Run() { delete[] mPoints; }
    Run(const Run&) = delete;
    Run& operator=(const Run&) = delete;

    [[nodiscard]] bool built() const { return mNode != nullptr; }

    /// Seconds for one frame.
    double deform(int frame) {
        fbxsdk::FbxTime time = timeOfFrame(frame);
        fbxsdk::FbxAMatrix place;
        const bench::Stopwatch watch;
        mSdk.getDeformedControlPoints(mNode, mNode->GetMesh(), time, place, &mPoints);
        return watch.seconds();
    }

    /// Whether every vertex of the frame deformed last is where the closed form has it.
    [[nodiscard]] bool isRight(int frame) const {
        for (std::size_t i = 0; mPoints != nullptr && i < mSkin.points.size(); ++i) {
            const Place expected = expectedPlace(mSkin.points[i], mSkin.bindings[i], frame);
            for (std::size_t axis = 0; axis < expected.size(); ++axis) {
                const double found = mPoints[i][static_cast<int>(axis)];
                if (!(std::fabs(found - expected[axis]) <= kTolerance)) {
                    std::fprintf(stderr, "bench_skin: frame %d, vertex %zu, axis %zu: %.17g instead of %.17g\n", frame,
                                 i, axis, found, expected[axis]);
                    return false;
                }
            }
        }
        return mPoints != nullptr;
    }

    /// Adds the bits of the frame deformed last to a hash (FNV-1a).
    [[nodiscard]] std::uint64_t digest(std::uint64_t value) const {
        for (int i = 0; i < kVertices; ++i)
            for (int axis = 0; axis < 4; ++axis)
                value = (value ^ std::bit_cast<std::uint64_t>(mPoints[i][axis])) * 1'099'511'628'211u;
        return value;
    }

private:
    const Skin& mSkin;
    Tarnell::Fbx::FbxSdk mSdk;
    fbxsdk::FbxNode* mNode;
    fbxsdk::FbxVector4* mPoints = nullptr;
};

/// Bytes per second, read and written together, of the best of some copies of an array larger than the caches.
double copyBandwidth() {
    constexpr std::size_t kSize = std::size_t{256} << 20;
    constexpr int kRounds = 6; // the first one only maps the pages
    std::vector<unsigned char> from(kSize, 1), to(kSize, 2);
    double best = std::numeric_limits<double>::max();
    for (int round = 0; round < kRounds; ++round) {
        from[static_cast<std::size_t>(round)] = 3; // the copies are not all the same
        const bench::Stopwatch watch;
        std::memcpy(to.data(), from.data(), kSize);
        best = std::min(best, watch.seconds());
    }
    return to[0] == 3 ? 2.0 * static_cast<double>(kSize) / best : 0.0;
}

/// The minimum traffic of one frame in bytes: each control point (4 doubles) is read once,
/// each influence is read once (an index of 4 bytes, a weight of 8), each deformed point is written once. Matrices,
/// sums of weights and points in progress are assumed to stay in the cache, and so are the bones.
constexpr double leastTraffic() {
    constexpr double kPoint = sizeof(fbxsdk::FbxVector4);
    constexpr double kInfluence = sizeof(int) + sizeof(double);
    return kVertices * (kPoint + kInfluences * kInfluence + kPoint);
}

/// The same when the sums cannot stay in the cache: a matrix (16 doubles) and a sum of weights per point are written as
/// zeros, read and written for each influence, and read at the end.
constexpr double trafficWithSums() {
    constexpr double kSum = sizeof(fbxsdk::FbxAMatrix) + sizeof(double);
    return leastTraffic() + kVertices * kSum * (1 + 2 * kInfluences + 1);
}

void print(std::vector<double> seconds, double bandwidth, std::uint64_t digest) {
    std::sort(seconds.begin(), seconds.end());
    const double mean = std::accumulate(seconds.begin(), seconds.end(), 0.0) / static_cast<double>(seconds.size());
    const double median = seconds[seconds.size() / 2];
    std::printf("{\"vertices\": %d, \"clusters\": %d, \"influences\": %d, \"frames\": %d, \"digest\": \"%016llx\",\n"
                " \"mean_ms_per_frame\": %.3f, \"median_ms_per_frame\": %.3f, \"best_ms_per_frame\": %.3f,\n"
                " \"vertices_per_second\": %.0f, \"copy_gigabytes_per_second\": %.2f,\n"
                " \"least_megabytes_per_frame\": %.2f, \"ratio_to_least_traffic\": %.2f,\n"
                " \"megabytes_per_frame_with_sums\": %.2f, \"ratio_to_traffic_with_sums\": %.2f}\n",
                kVertices, kBones, kVertices * kInfluences, kFrames, static_cast<unsigned long long>(digest),
                mean * 1e3, median * 1e3, seconds.front() * 1e3, kVertices / median, bandwidth / 1e9,
                leastTraffic() / 1e6, median / (leastTraffic() / bandwidth), trafficWithSums() / 1e6,
                median / (trafficWithSums() / bandwidth));
}

/// The vertices in the order of their numbers, as in most files, or thoroughly mixed.
std::vector<int> vertexOrder(bool mixed) {
    std::vector<int> order(kVertices);
    std::iota(order.begin(), order.end(), 0);
    std::mt19937 random(7);
    for (std::size_t i = order.size(); mixed && i > 1; --i)
        std::swap(order[i - 1], order[random() % i]);
    return order;
}

} // namespace

int main(int argc, char** argv) {
    const std::string_view mode = argc == 2 ? argv[1] : "ordered";
    if (argc > 2 || (mode != "ordered" && mode != "mixed")) {
        std::fputs("usage: bench_skin [ordered|mixed]\n", stderr);
        return 2;
    }
    const Skin skin = makeSkin();
    Run run(skin, vertexOrder(mode == "mixed"));
    if (!run.built()) {
        std::fputs("bench_skin: no context\n", stderr);
        return 1;
    }
    std::uint64_t digest = 14'695'981'039'346'656'037u;
    for (int frame = 0; frame < kFrames; ++frame) {
        run.deform(frame);
        if (!run.isRight(frame))
            return 1;
        digest = run.digest(digest);
    }
    std::vector<double> seconds;
    for (int frame = 0; frame < kFrames; ++frame)
        seconds.push_back(run.deform(frame));
    print(std::move(seconds), copyBandwidth(), digest);
    return 0;
}
