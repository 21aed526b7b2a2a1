// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What assimp reads from the files.
#include <assimp/Importer.hpp>
#include <assimp/config.h>
#include <assimp/scene.h>

#include "PeerProgram.h"

#include <algorithm>
#include <cstdio>
#include <filesystem>
#include <map>
#include <string>

using nlohmann::json;

namespace {

json listed(const aiVector3D& v) { return {v.x, v.y, v.z}; }

/// The key at the time, or the interpolation of those around it.
aiVector3D valueAt(const aiVectorKey* keys, unsigned count, double time) {
    const auto* const next =
        std::lower_bound(keys, keys + count, time, [](const aiVectorKey& key, double t) { return key.mTime < t; });
    if (next == keys)
        return keys->mValue;
    if (next == keys + count)
        return (next - 1)->mValue;
    const aiVectorKey& before = *(next - 1);
    const double part = (time - before.mTime) / (next->mTime - before.mTime);
    return before.mValue + (next->mValue - before.mValue) * static_cast<ai_real>(part);
}

class Seen {
public:
    Seen(const aiScene& scene, const json& expected) : mScene(scene), mExpected(expected) { visit(*scene.mRootNode); }

    [[nodiscard]] json result() const {
        json objects = json::array();
        for (const auto& entry : mObjects)
            objects.push_back(entry.second);
        return {{"objects", objects}};
    }

private:
    // Nodes that assimp inserts between a node and its parent are named after the node, with this in between.
    static constexpr const char* kHelper = "_$AssimpFbx$_";

    void visit(const aiNode& node) {
        const std::string name = node.mName.C_Str();
        if (node.mParent && name.find(kHelper) == std::string::npos)
            describe(node, name);
        for (unsigned i = 0; i < node.mNumChildren; ++i)
            visit(*node.mChildren[i]);
    }

    void describe(const aiNode& node, const std::string& name) {
        json& object = mObjects[name];
        object = {{"name", name}, {"kind", "null"}};
        if (node.mNumMeshes > 0)
            describeMesh(node, object);
        else
            describePath(name, object);
        for (unsigned i = 0; i < mScene.mNumCameras; ++i)
            if (name == mScene.mCameras[i]->mName.C_Str())
                object["kind"] = "camera";
        for (unsigned i = 0; i < mScene.mNumLights; ++i)
            if (name == mScene.mLights[i]->mName.C_Str())
                describeLight(*mScene.mLights[i], object);
    }

    void describeMesh(const aiNode& node, json& object) const {
        aiMatrix4x4 world = node.mTransformation;
        for (const aiNode* parent = node.mParent; parent; parent = parent->mParent)
            world = parent->mTransformation * world;
        object["kind"] = "mesh";
        std::map<std::string, json> points;
        unsigned polygons = 0;
        for (unsigned i = 0; i < node.mNumMeshes; ++i) {
            const aiMesh& mesh = *mScene.mMeshes[node.mMeshes[i]];
            polygons += mesh.mNumFaces;
            for (unsigned k = 0; k < mesh.mNumVertices; ++k) {
                const json point = listed(world * mesh.mVertices[k]);
                points[point.dump()] = point;
            }
        }
        object["polygons"] = polygons;
        for (const auto& entry : points)
            object["points"].push_back(entry.second);
    }

    static void describeLight(const aiLight& light, json& object) {
        object["kind"] = "light";
        switch (light.mType) {
        case aiLightSource_POINT:
            object["type"] = "point";
            break;
        case aiLightSource_DIRECTIONAL:
            object["type"] = "directional";
            break;
        case aiLightSource_SPOT:
            object["type"] = "spot";
            object["coneAngle"] = static_cast<double>(light.mAngleOuterCone) * 180 / std::acos(-1.0);
            break;
        default:
            object["type"] = "other";
        }
        // assimp multiplies colour by intensity.
        object["radiance"] = {light.mColorDiffuse.r, light.mColorDiffuse.g, light.mColorDiffuse.b};
    }

    /// Positions are keyed on the node itself or on its helper for translations.
    void describePath(const std::string& name, json& object) const {
        for (unsigned a = 0; a < mScene.mNumAnimations; ++a) {
            const aiAnimation& animation = *mScene.mAnimations[a];
            for (unsigned c = 0; c < animation.mNumChannels; ++c) {
                const aiNodeAnim& channel = *animation.mChannels[c];
                const std::string target = channel.mNodeName.C_Str();
                if (target == name + kHelper + "Translation" || (target == name && !object.contains("positions")))
                    object["positions"] = positions(channel, animation.mTicksPerSecond);
            }
        }
    }

    [[nodiscard]] json positions(const aiNodeAnim& channel, double ticksPerSecond) const {
        json result;
        for (int frame = mExpected["frames"][0]; frame <= mExpected["frames"][1].get<int>(); ++frame) {
            // assimp lets every clip begin at 0.
            const double seconds = (frame - mExpected["frames"][0].get<int>()) / mExpected["rate"].get<double>();
            result[std::to_string(frame)] =
                listed(valueAt(channel.mPositionKeys, channel.mNumPositionKeys, seconds * ticksPerSecond));
        }
        return result;
    }

    const aiScene& mScene;
    const json& mExpected;
    std::map<std::string, json> mObjects;
};

json look(const std::filesystem::path& path, const json& expected) {
    Assimp::Importer importer;
    const aiScene* const scene = importer.ReadFile(path.string(), 0);
    if (!scene) {
        std::fprintf(stderr, "%s: %s\n", path.filename().c_str(), importer.GetErrorString());
        return {};
    }
    return Seen(*scene, expected).result();
}

constexpr int kOldestVersion = 7100; // assimp refuses older ones

} // namespace

int main(int argumentCount, char** arguments) { return runPeer(argumentCount, arguments, look, kOldestVersion); }
