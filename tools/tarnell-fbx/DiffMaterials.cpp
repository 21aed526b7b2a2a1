// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Materials: their assignments to nodes and polygons, their properties, and their textures.
#include <algorithm>
#include <cmath>
#include <map>

#include <fbxsdk/extensions/FileFacts.h>

#include "CameraOrigins.h"
#include "Curves.h"
#include "DiffSides.h"
#include "PropertyValues.h"
#include "SceneFacts.h"
#include "SceneQueries.h"

namespace tool {
namespace {

// ---- Properties ----

std::vector<double> numbersOf(const FbxProperty& property) {
    const int count = componentCount(property);
    if (count == 1)
        return {property.Get<FbxDouble>()};
    const FbxDouble4 all = count > 0 ? property.Get<FbxDouble4>() : FbxDouble4();
    return {&all[0], &all[0] + count};
}

std::string shortText(double number) { return significant(number + 0.0, 7); }

std::string textOf(const FbxProperty& property) {
    const std::vector<double> numbers = numbersOf(property);
    if (numbers.empty() || property.GetPropertyDataType().GetType() == eFbxBool)
        return valueText(property);
    std::string text;
    for (const double number : numbers)
        text += (text.empty() ? "" : ", ") + shortText(number);
    return numbers.size() == 1 ? text : '(' + text + ')';
}

/// Compares the properties of two objects that match.
class PropertyComparison {
public:
    PropertyComparison(Comparison& comparison, DiffKind kind, std::string object)
        : mComparison(comparison), mKind(kind), mObject(std::move(object)) {}

    void compare(const FbxProperty& a, const FbxProperty& b) {
        if (isKeyed(a, mComparison.a) || isKeyed(b, mComparison.b)) {
            compareMoments(a, b);
            return;
        }
        const std::vector<double> one = numbersOf(a), other = numbersOf(b);
        if (one.empty() || one.size() != other.size()) {
            if (textOf(a) != textOf(b))
                mComparison.add(mKind, mObject, nameOf(a), textOf(a), textOf(b));
            return;
        }
        bool differs = false;
        double most = 0.0;
        for (std::size_t i = 0; i < one.size(); ++i) {
            differs = differs || mComparison.differ(one[i], other[i]);
            most = std::max(most, std::abs(one[i] - other[i]));
        }
        if (differs)
            mComparison.found.push_back({mKind, mObject, nameOf(a), textOf(a), textOf(b), most, "", {}, 0});
    }

    /// A property that only one of the two has.
    void alone(const FbxProperty& property, bool isA) {
        const std::string text = extensions::isStated(property) ? textOf(property) : "";
        if (!text.empty())
            mComparison.add(mKind, mObject, nameOf(property), isA ? text : "", isA ? "" : text);
    }

private:
    static std::string nameOf(const FbxProperty& property) { return property.GetHierarchicalName().Buffer(); }

    static bool isKeyed(const FbxProperty& property, const DiffSide& side) {
        return keyCount(property, side.stack) > 0;
    }

    void compareMoments(const FbxProperty& a, const FbxProperty& b) {
        constexpr std::size_t kMostFrames = 1 << 24; // as channels of the library
        if (mComparison.moments.size() > kMostFrames)
            throw Unreadable("the animation has " + std::to_string(mComparison.moments.size()) +
                             " frames, but at most " + std::to_string(kMostFrames) + " are compared");
        std::vector<Channel> one = channelsOf(a, mComparison.a.stack), other = channelsOf(b, mComparison.b.stack);
        for (std::size_t i = 0; i < std::min(one.size(), other.size()); ++i) {
            const auto timeOf = [](double frame, const DiffSide& side) {
                FbxTime time;
                time.SetSecondDouble(frame / side.take.frameRate);
                return time;
            };
            mComparison.addWorst({mKind, mObject, one[i].fullName(), {}, {}, {}, "", {}, 0}, true,
                                 [&](DiffMoment moment) {
                                     return std::pair(one[i].valueAt(timeOf(moment.a, mComparison.a)),
                                                      other[i].valueAt(timeOf(moment.b, mComparison.b)));
                                 });
        }
    }

    Comparison& mComparison;
    DiffKind mKind;
    std::string mObject;
};

// ---- Polygons ----

/// The materials of the polygons of a node's mesh.
class PolygonMaterials {
public:
    explicit PolygonMaterials(FbxNode& node) : mNode(node), mMesh(node.GetMesh()) {
        FbxLayer* layer = mMesh ? mMesh->GetLayer(0) : nullptr;
        mElement = layer ? layer->GetMaterials() : nullptr;
    }

    [[nodiscard]] int count() const { return mMesh ? mMesh->GetPolygonCount() : 0; }
    [[nodiscard]] const FbxSurfaceMaterial* of(int polygon) const {
        const bool perPolygon = mElement && mElement->GetMappingMode() == FbxLayerElement::eByPolygon;
        const int place = perPolygon ? polygon : 0;
        const bool isSaid = mElement && place < mElement->GetIndexArray().GetCount();
        return mNode.GetMaterial(isSaid ? mElement->GetIndexArray().GetAt(place) : 0);
    }

private:
    FbxNode& mNode;
    FbxMesh* mMesh;
    FbxLayerElementMaterial* mElement = nullptr;
};

// ---- Textures ----

/// The relative file name if there is one, else the absolute one; the name of the texture where it has no file.
std::string fileOf(const FbxTexture& texture) {
    const auto* file = FbxCast<FbxFileTexture>(&texture);
    std::string name = file ? file->GetRelativeFileName() : "";
    if (name.empty() && file)
        name = file->GetFileName();
    std::replace(name.begin(), name.end(), '\\', '/');
    return name.empty() ? className(texture) + ' ' + inQuotes(texture.GetName()) : name;
}

/// The textures of properties: those connected to them, and those that files before 7.0 assign to polygons.
class TextureTable {
public:
    using Textures = std::vector<FbxTexture*>;
    using ByProperty = std::map<std::string, Textures>;

    explicit TextureTable(FbxScene& scene) {
        for (FbxNode* node : nodesOfTree(scene))
            if (FbxMesh* mesh = node->GetMesh())
                addLayers(*node, *mesh);
    }

    /// Of a material, or of a node without one.
    [[nodiscard]] ByProperty of(const FbxObject& owner) const {
        ByProperty textures;
        for (const FbxProperty& property : propertiesOf(owner))
            for (int i = 0; i < property.GetSrcObjectCount<FbxTexture>(); ++i)
                addFlat(*property.GetSrcObject<FbxTexture>(i), textures[property.GetHierarchicalName().Buffer()]);
        const auto found = mOfPolygons.find(&owner);
        if (found == mOfPolygons.end())
            return textures;
        for (const auto& [property, ofPolygons] : found->second)
            for (FbxTexture* texture : ofPolygons)
                addOnce(texture, textures[property]);
        return textures;
    }

private:
    /// Adds the textures of a layered texture one by one.
    static void addFlat(FbxTexture& texture, Textures& textures) {
        if (!texture.Is<FbxLayeredTexture>())
            return addOnce(&texture, textures);
        for (int i = 0; i < texture.GetSrcObjectCount<FbxTexture>(); ++i)
            addOnce(texture.GetSrcObject<FbxTexture>(i), textures);
    }

    static void addOnce(FbxTexture* texture, Textures& textures) {
        if (std::find(textures.begin(), textures.end(), texture) == textures.end())
            textures.push_back(texture);
    }

    void addLayers(FbxNode& node, FbxMesh& mesh) {
        using Element = FbxLayerElement;
        constexpr struct {
            Element::EType type;
            const char* property;
        } kChannels[] = {{Element::eTextureDiffuse, "DiffuseColor"},
                         {Element::eTextureDiffuseFactor, "DiffuseFactor"},
                         {Element::eTextureEmissive, "EmissiveColor"},
                         {Element::eTextureEmissiveFactor, "EmissiveFactor"},
                         {Element::eTextureAmbient, "AmbientColor"},
                         {Element::eTextureAmbientFactor, "AmbientFactor"},
                         {Element::eTextureSpecular, "SpecularColor"},
                         {Element::eTextureSpecularFactor, "SpecularFactor"},
                         {Element::eTextureShininess, "ShininessExponent"},
                         {Element::eTextureNormalMap, "NormalMap"},
                         {Element::eTextureBump, "Bump"},
                         {Element::eTextureTransparency, "TransparentColor"},
                         {Element::eTextureTransparencyFactor, "TransparencyFactor"},
                         {Element::eTextureReflection, "ReflectionColor"},
                         {Element::eTextureReflectionFactor, "ReflectionFactor"},
                         {Element::eTextureDisplacement, "DisplacementColor"},
                         {Element::eTextureDisplacementVector, "VectorDisplacementColor"}};
        if (node.GetSrcObjectCount<FbxTexture>() == 0)
            return;
        const PolygonMaterials materials(node);
        for (int i = 0; i < mesh.GetLayerCount(); ++i) {
            for (const auto& channel : kChannels)
                if (const FbxLayerElementTexture* element = mesh.GetLayer(i)->GetTextures(channel.type))
                    addElement(node, materials, *element, channel.property);
        }
    }

    void addElement(FbxNode& node, const PolygonMaterials& materials, const FbxLayerElementTexture& element,
                    const char* property) {
        const auto& indices = element.GetIndexArray();
        const bool perPolygon = element.GetMappingMode() == FbxLayerElement::eByPolygon;
        const FbxObject* lastOwner = nullptr;
        int last = -1;
        for (int polygon = 0; polygon < materials.count(); ++polygon) {
            const int place = perPolygon ? polygon : 0;
            const int index = place < indices.GetCount() ? indices.GetAt(place) : -1;
            const FbxObject* material = materials.of(polygon);
            const FbxObject* owner = material ? material : &node;
            if (index < 0 || (owner == lastOwner && index == last))
                continue; // most polygons are as the one before
            lastOwner = owner;
            last = index;
            if (auto* texture = node.GetSrcObject<FbxTexture>(index))
                addFlat(*texture, mOfPolygons[owner][property]);
        }
    }

    std::unordered_map<const FbxObject*, ByProperty> mOfPolygons;
};

std::string filesText(const TextureTable::Textures& textures) {
    std::string text;
    for (const FbxTexture* texture : textures)
        text += (text.empty() ? "" : ", ") + fileOf(*texture);
    return text;
}

void compareTextures(Comparison& comparison, FbxTexture& a, FbxTexture& b) {
    PropertyComparison properties(comparison, DiffKind::texture, a.GetName());
    const std::pair<FbxProperty, FbxProperty> rows[] = {
        {a.Alpha, b.Alpha}, {a.WrapModeU, b.WrapModeU},     {a.WrapModeV, b.WrapModeV}, {a.UVSwap, b.UVSwap},
        {a.UVSet, b.UVSet}, {a.Translation, b.Translation}, {a.Rotation, b.Rotation},   {a.Scaling, b.Scaling}};
    for (const auto& [one, other] : rows)
        properties.compare(one, other);
}

void compareTextures(Comparison& comparison, const std::string& object, const TextureTable::ByProperty& a,
                     const TextureTable::ByProperty& b) {
    TextureTable::ByProperty all = a;
    all.insert(b.begin(), b.end());
    for (const auto& [property, ignored] : all) {
        const auto one = a.find(property), other = b.find(property);
        const TextureTable::Textures ofA = one == a.end() ? TextureTable::Textures() : one->second;
        const TextureTable::Textures ofB = other == b.end() ? TextureTable::Textures() : other->second;
        if (filesText(ofA) != filesText(ofB)) {
            comparison.add(DiffKind::texture, object, property, filesText(ofA), filesText(ofB));
            continue;
        }
        for (std::size_t i = 0; i < std::min(ofA.size(), ofB.size()); ++i)
            compareTextures(comparison, *ofA[i], *ofB[i]);
    }
}

// ---- Materials ----

using PropertiesByName = std::map<std::string, FbxProperty>;

PropertiesByName propertiesByName(const FbxObject& object) {
    PropertiesByName properties;
    for (const FbxProperty& property : propertiesOf(object))
        properties.emplace(property.GetHierarchicalName().Buffer(), property);
    return properties;
}

/// Compares the properties that both have and, if both are of the same class, those that only one states.
void compareProperties(Comparison& comparison, const FbxSurfaceMaterial& a, const FbxSurfaceMaterial& b) {
    const bool sameClass = a.GetClassId() == b.GetClassId();
    if (!sameClass)
        comparison.add(DiffKind::material, a.GetName(), "class", className(a), className(b));
    PropertyComparison properties(comparison, DiffKind::material, a.GetName());
    const PropertiesByName ofA = propertiesByName(a), ofB = propertiesByName(b);
    for (const FbxProperty& property : propertiesOf(a)) {
        const auto found = ofB.find(property.GetHierarchicalName().Buffer());
        if (found != ofB.end() && (sameClass || found->first != "ShadingModel"))
            properties.compare(property, found->second);
        else if (sameClass)
            properties.alone(property, /*isA=*/true);
    }
    for (const FbxProperty& property : propertiesOf(b))
        if (sameClass && !ofA.contains(property.GetHierarchicalName().Buffer()))
            properties.alone(property, /*isA=*/false);
}

std::string holdersText(const FbxSurfaceMaterial& material) {
    const int count = material.GetDstObjectCount<FbxNode>();
    if (count == 0)
        return "not assigned";
    return "assigned to " + inQuotes(material.GetDstObject<FbxNode>(0)->GetName()) +
           (count == 1 ? "" : " and " + std::to_string(count - 1) + " more");
}

// ---- Which nodes and polygons have which ----

std::string nameInQuotes(const FbxSurfaceMaterial* material) {
    return material ? inQuotes(material->GetName()) : "none";
}

std::string materialsText(const FbxNode& node) {
    std::string text;
    for (int i = 0; i < node.GetMaterialCount(); ++i)
        text += (text.empty() ? "" : ", ") + nameInQuotes(node.GetMaterial(i));
    return text.empty() ? "none" : text;
}

class AssignmentComparison {
public:
    explicit AssignmentComparison(Comparison& comparison) : mComparison(comparison) {
        for (const MaterialPair& pair : comparison.materials)
            if (pair.a)
                mCounterpart[pair.a] = pair.b;
    }

    void compare(FbxNode& a, FbxNode& b) {
        if (!haveTheSame(a, b))
            return mComparison.add(DiffKind::material, a.GetName(), "materials", materialsText(a), materialsText(b));
        const PolygonMaterials one(a), other(b);
        if (a.GetMaterialCount() < 2 || one.count() != other.count())
            return;
        int differing = 0, first = 0;
        for (int i = 0; i < one.count(); ++i)
            if (counterpartOf(one.of(i)) != other.of(i))
                first = differing++ == 0 ? i : first;
        if (differing > 0)
            mComparison.add(DiffKind::material, a.GetName(),
                            std::to_string(differing) + " of " + std::to_string(one.count()) +
                                " polygons, the first at polygon " + std::to_string(first),
                            nameInQuotes(one.of(first)), nameInQuotes(other.of(first)));
    }

private:
    [[nodiscard]] const FbxSurfaceMaterial* counterpartOf(const FbxSurfaceMaterial* material) const {
        const auto found = mCounterpart.find(material);
        return found == mCounterpart.end() ? nullptr : found->second;
    }

    /// In any order: the polygons refer to them by index.
    [[nodiscard]] bool haveTheSame(const FbxNode& a, const FbxNode& b) const {
        std::vector<const FbxSurfaceMaterial*> one, other;
        for (int i = 0; i < a.GetMaterialCount(); ++i)
            one.push_back(counterpartOf(a.GetMaterial(i)));
        for (int i = 0; i < b.GetMaterialCount(); ++i)
            other.push_back(b.GetMaterial(i));
        return std::is_permutation(one.begin(), one.end(), other.begin(), other.end());
    }

    Comparison& mComparison;
    std::unordered_map<const FbxSurfaceMaterial*, const FbxSurfaceMaterial*> mCounterpart;
};

} // namespace

void compareMaterials(Comparison& comparison) {
    const TextureTable texturesA(comparison.a.file.opened.scene()), texturesB(comparison.b.file.opened.scene());
    for (const auto& [a, b] : comparison.materials) {
        if (!a) {
            comparison.add(DiffKind::added, b->GetName(), "material", "", holdersText(*b));
            continue;
        }
        if (!b) {
            comparison.add(DiffKind::removed, a->GetName(), "material", holdersText(*a), "");
            continue;
        }
        if (std::string(a->GetName()) != b->GetName())
            comparison.add(DiffKind::renamed, a->GetName(), "material", a->GetName(), b->GetName());
        compareProperties(comparison, *a, *b);
        compareTextures(comparison, a->GetName(), texturesA.of(*a), texturesB.of(*b));
    }
    AssignmentComparison assignments(comparison);
    for (const auto& [a, b] : comparison.pairs) {
        if (!a || !b)
            continue;
        assignments.compare(*a, *b);
        compareTextures(comparison, a->GetName(), texturesA.of(*a), texturesB.of(*b));
    }
}

} // namespace tool
