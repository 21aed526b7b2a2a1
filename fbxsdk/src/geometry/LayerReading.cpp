// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A geometry lists its elements, each with a number of its own type, and then says for each layer which of them stand
// in it:
//
//     LayerElementNormal: 0 { MappingInformationType, ReferenceInformationType, Normals, … }
//     LayerElementUV: 0 { … }
//     Layer: 0 { LayerElement: { Type: "LayerElementNormal" TypedIndex: 0 } … }
//
// Elements that no layer names go to the layer of their number. Elements that say nothing sound about their mapping,
// and such without data, are left out.
#include "geometry/LayerReading.h"

#include <algorithm>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

#include "geometry/LayerChannels.h"
#include "geometry/LayerElementAccess.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

using Element = FbxLayerElement;
using Access = LayerElementAccess;

/// How an element stores its values.
enum class Storage {
    values,  ///< values, and perhaps indices to them
    numbers, ///< indices into something else: the materials or textures of a node
    groups,  ///< indices that are the values
};

struct ElementKind {
    std::string_view record;
    int slot;
    Element* (*create)(FbxLayerContainer& container, const char* name);
    Storage storage;
    std::string_view direct, index; ///< records with the arrays
    std::string_view fourth = {};   ///< … and with the fourth numbers of vectors
};

template <class Class>
Element* create(FbxLayerContainer& container, const char* name) {
    return Class::Create(&container, name);
}

const ElementKind kKinds[] = {
    {"LayerElementNormal", Element::eNormal, create<FbxLayerElementNormal>, Storage::values, "Normals", "NormalsIndex",
     "NormalsW"},
    {"LayerElementBinormal", Element::eBiNormal, create<FbxLayerElementBinormal>, Storage::values, "Binormals",
     "BinormalsIndex", "BinormalsW"},
    {"LayerElementTangent", Element::eTangent, create<FbxLayerElementTangent>, Storage::values, "Tangents",
     "TangentsIndex", "TangentsW"},
    {"LayerElementColor", Element::eVertexColor, create<FbxLayerElementVertexColor>, Storage::values, "Colors",
     "ColorIndex"},
    {"LayerElementMaterial", Element::eMaterial, create<FbxLayerElementMaterial>, Storage::numbers, "", "Materials"},
    {"LayerElementSmoothing", Element::eSmoothing, create<FbxLayerElementSmoothing>, Storage::values, "Smoothing", ""},
    {"LayerElementEdgeCrease", Element::eEdgeCrease, create<FbxLayerElementCrease>, Storage::values, "EdgeCrease", ""},
    {"LayerElementVertexCrease", Element::eVertexCrease, create<FbxLayerElementCrease>, Storage::values, "VertexCrease",
     ""},
    {"LayerElementHole", Element::eHole, create<FbxLayerElementHole>, Storage::values, "Hole", ""},
    {"LayerElementVisibility", Element::eVisibility, create<FbxLayerElementVisibility>, Storage::values, "Visibility",
     ""},
    {"LayerElementPolygonGroup", Element::ePolygonGroup, create<FbxLayerElementPolygonGroup>, Storage::groups, "",
     "PolygonGroup"},
};

struct MappingRow {
    std::string_view spelling;
    Element::EMappingMode mode;
};

constexpr MappingRow kMappings[] = {
    {"ByVertice", Element::eByControlPoint},
    {"ByVertex", Element::eByControlPoint},
    {"ByControlPoint", Element::eByControlPoint},
    {"ByPolygonVertex", Element::eByPolygonVertex},
    {"ByPolygon", Element::eByPolygon},
    {"ByEdge", Element::eByEdge},
    {"AllSame", Element::eAllSame},
};

std::optional<ElementKind> kindOf(std::string_view record) {
    for (const ElementKind& kind : kKinds) {
        if (kind.record == record)
            return kind;
    }
    for (const LayerChannelRow& row : kLayerChannels) {
        if (row.uvs == record)
            return ElementKind{row.uvs,  Access::uvSlot(row.channel), create<FbxLayerElementUV>, Storage::values, "UV",
                               "UVIndex"};
        if (row.textures == record)
            return ElementKind{row.textures,     row.channel, create<FbxLayerElementTexture>,
                               Storage::numbers, "",          "TextureId"};
    }
    return std::nullopt;
}

std::optional<Element::EMappingMode> mappingOf(const Record& element) {
    const std::string_view text = element.childValue("MappingInformationType").toText();
    for (const MappingRow& row : kMappings) {
        if (row.spelling == text)
            return row.mode;
    }
    return std::nullopt;
}

const Record* childWithNumbers(const Record& record, std::string_view name) {
    const Record* child = name.empty() ? nullptr : record.child(name);
    return child && child->numberCount() > 0 ? child : nullptr;
}

/// The reference mode that follows from what an element says and which arrays it has. "Index" is what old files say for
/// "IndexToDirect".
Element::EReferenceMode referenceOf(const Record& element, Storage storage, bool hasIndices) {
    if (storage == Storage::groups)
        return Element::eIndex;
    const bool direct = storage == Storage::values &&
                        (!hasIndices || element.childValue("ReferenceInformationType").toText() == "Direct");
    return direct ? Element::eDirect : Element::eIndexToDirect;
}

class LayerReader {
public:
    LayerReader(FbxLayerContainer& container, const GeometrySource& source) : mContainer(container), mSource(source) {}

    void read() {
        for (const Record& record : mSource.body->children()) {
            if (record.name == "Layer")
                ++mLayerLimit;
            else if (record.name.starts_with("LayerElement"))
                readElement(record);
        }
        mLayerLimit += static_cast<std::int64_t>(mElements.size());
        for (const Record& record : mSource.body->children()) {
            if (record.name == "Layer")
                readLayer(record);
        }
        for (auto& [key, element] : mElements) {
            if (!element.placed)
                placeUnnamed(element, key.second);
        }
    }

private:
    struct ReadElement {
        Element* element = nullptr;
        int slot = 0;
        bool placed = false;
    };

    /// Of several elements of one type and number the first one counts.
    void readElement(const Record& record) {
        const std::optional<ElementKind> kind = kindOf(record.name);
        if (!kind)
            return;
        const std::pair key(record.name, record.value(0).toInteger());
        if (mElements.count(key) > 0)
            return;
        if (Element* element = makeElement(record, *kind))
            mElements[key] = {element, kind->slot};
    }

    Element* makeElement(const Record& record, const ElementKind& kind) {
        const std::optional<Element::EMappingMode> mapping = mappingOf(record);
        const Record* direct = childWithNumbers(record, kind.direct);
        const Record* index = childWithNumbers(record, kind.index);
        if (!mapping || !(kind.storage == Storage::values ? direct : index))
            return nullptr;
        if (*mapping == Element::eByEdge && !childWithNumbers(*mSource.body, "Edges"))
            return nullptr;
        Element* element = kind.create(mContainer, std::string(record.childValue("Name").toText()).c_str());
        element->SetMappingMode(*mapping);
        element->SetReferenceMode(referenceOf(record, kind.storage, index != nullptr));
        if (element->GetReferenceMode() == Element::eDirect)
            index = nullptr;
        const Record* fourth = childWithNumbers(record, kind.fourth);
        Access::setSource(*element,
                          std::make_unique<ElementSource>(ElementSource{mSource.document, direct, index, fourth}));
        return element;
    }

    void readLayer(const Record& record) {
        FbxLayer* layer = layerAt(record.value(0).toInteger());
        if (!layer)
            return;
        for (const Record& entry : record.children()) {
            if (entry.name != "LayerElement")
                continue;
            const auto found =
                mElements.find({entry.childValue("Type").toText(), entry.childValue("TypedIndex").toInteger()});
            if (found != mElements.end())
                place(found->second, *layer);
        }
    }

    /// An element may stand in several layers; of two elements of one type in a layer the first one counts.
    static void place(ReadElement& element, FbxLayer& layer) {
        if (Access::elementAt(layer, element.slot))
            return;
        Access::setElement(layer, element.slot, *element.element);
        element.placed = true;
    }

    void placeUnnamed(ReadElement& element, std::int64_t number) {
        if (FbxLayer* layer = layerAt(number))
            place(element, *layer);
        if (!element.placed)
            place(element, *mContainer.GetLayer(mContainer.CreateLayer()));
    }

    /// The layer of that number, made with all before it. Null for numbers that no sound file has: a geometry has not
    /// more layers than it names layers and elements.
    FbxLayer* layerAt(std::int64_t number) {
        if (number < 0 || number >= mLayerLimit)
            return nullptr;
        while (mContainer.GetLayerCount() <= number)
            mContainer.CreateLayer();
        return mContainer.GetLayer(static_cast<int>(number));
    }

    FbxLayerContainer& mContainer;
    const GeometrySource& mSource;
    std::map<std::pair<std::string_view, std::int64_t>, ReadElement> mElements; ///< by record name and number
    std::int64_t mLayerLimit = 0;
};

} // namespace

void readLayers(FbxLayerContainer& container, const GeometrySource& source) { LayerReader(container, source).read(); }

} // namespace detail
FBXSDK_NAMESPACE_END
