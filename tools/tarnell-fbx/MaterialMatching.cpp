// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Materials by their names, then by their slots.
#include "MaterialMatching.h"

#include <algorithm>
#include <deque>
#include <string>
#include <unordered_map>

#include <fbxsdk/extensions/FileFacts.h>

namespace tool {
namespace {

std::vector<FbxSurfaceMaterial*> materialsOf(const FbxScene& scene) {
    std::vector<FbxSurfaceMaterial*> materials;
    for (FbxObject* object : extensions::objectsOf(scene))
        if (auto* material = FbxCast<FbxSurfaceMaterial>(object))
            materials.push_back(material);
    return materials;
}

class MaterialMatching {
public:
    MaterialMatching(const FbxScene& a, const FbxScene& b) : mA(materialsOf(a)), mB(materialsOf(b)) {}

    std::vector<MaterialPair> pairs(const std::vector<NodePair>& nodes) {
        matchNames();
        for (const NodePair& pair : nodes)
            if (pair.a && pair.b)
                matchPlaces(*pair.a, *pair.b);
        std::vector<MaterialPair> pairs;
        for (FbxSurfaceMaterial* material : mA) {
            const auto found = mOfA.find(material);
            pairs.push_back({material, found == mOfA.end() ? nullptr : found->second});
        }
        for (FbxSurfaceMaterial* material : mB)
            if (!mOfB.contains(material))
                pairs.push_back({nullptr, material});
        return pairs;
    }

private:
    void match(FbxSurfaceMaterial* a, FbxSurfaceMaterial* b) {
        mOfA[a] = b;
        mOfB[b] = a;
    }

    void matchNames() {
        std::unordered_map<std::string, std::deque<FbxSurfaceMaterial*>> waiting;
        for (FbxSurfaceMaterial* material : mB)
            waiting[material->GetName()].push_back(material);
        for (FbxSurfaceMaterial* material : mA) {
            const auto found = waiting.find(material->GetName());
            if (found == waiting.end() || found->second.empty())
                continue;
            match(material, found->second.front());
            found->second.pop_front();
        }
    }

    void matchPlaces(const FbxNode& a, const FbxNode& b) {
        for (int i = 0; i < std::min(a.GetMaterialCount(), b.GetMaterialCount()); ++i)
            if (!mOfA.contains(a.GetMaterial(i)) && !mOfB.contains(b.GetMaterial(i)))
                match(a.GetMaterial(i), b.GetMaterial(i));
    }

    std::vector<FbxSurfaceMaterial*> mA, mB;
    std::unordered_map<const FbxSurfaceMaterial*, FbxSurfaceMaterial*> mOfA, mOfB;
};

} // namespace

std::vector<MaterialPair> matchMaterials(FbxScene& a, FbxScene& b, const std::vector<NodePair>& nodes) {
    return MaterialMatching(a, b).pairs(nodes);
}

} // namespace tool
