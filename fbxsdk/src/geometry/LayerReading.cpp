// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A geometry lists its elements, each with a number of its own type, and then for each layer the elements
// in it:
//
//     LayerElementNormal: 0 { MappingInformationType, ReferenceInformationType, Normals, … }
//     LayerElementUV: 0 { … }
//     Layer: 0 { LayerElement: { Type: "LayerElementNormal" TypedIndex: 0 } … }
//
// Elements that no layer names go to the layer of their number. Elements with an invalid mapping,
// and those without data, are omitted.
#include "geometry/GeometryReading.h"

#include <algorithm>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>

#include "geometry/GeometrySource.h"
#include "geometry/ItemReading.h"
#include "geometry/LayerElementAccess.h"
#include "schema/LayerElements.h"
#include "schema/Spellings.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

using Element = FbxLayerElement;
using Access = LayerElementAccess;
using Storage = LayerElementStorage;

/// The arrays of one element; null for an absent array. The fourth numbers are those of vectors.
struct ArrayRecords {
    const std::shared_ptr<const Document>& document;
    const Record* direct;
    const Record* fourth;
    const Record* index;
    const std::shared_ptr<ArraysAhead>& ahead;
};

using CreateElement = Element* (*)(FbxLayerContainer& container, const char* name, const ArrayRecords& records);

template <class Class>
Element* create(FbxLayerContainer& container, const char* name, const ArrayRecords& records) {
    using Item = typename Class::ArrayElementType;
    Class* element = Class::Create(&container, name);
    // Pointers are not stored in files.
    if constexpr (!std::is_pointer_v<Item>) {
        if (records.direct)
            readLate(records.document, *records.direct, element->GetDirectArray().items(), LateReading::shown,
                     records.fourth, records.ahead);
    }
    if (records.index)
        readLate(records.document, *records.index, element->GetIndexArray().items(), LateReading::shown, nullptr,
                 records.ahead);
    return element;
}

/// The class of each type. All texture channels have the same.
struct ElementClass {
    int type;
    CreateElement create;
};

constexpr ElementClass kClasses[] = {
    {Element::eNormal, create<FbxLayerElementNormal>},
    {Element::eBiNormal, create<FbxLayerElementBinormal>},
    {Element::eTangent, create<FbxLayerElementTangent>},
    {Element::eVertexColor, create<FbxLayerElementVertexColor>},
    {Element::eMaterial, create<FbxLayerElementMaterial>},
    {Element::eSmoothing, create<FbxLayerElementSmoothing>},
    {Element::eEdgeCrease, create<FbxLayerElementCrease>},
    {Element::eVertexCrease, create<FbxLayerElementCrease>},
    {Element::eHole, create<FbxLayerElementHole>},
    {Element::eVisibility, create<FbxLayerElementVisibility>},
    {Element::ePolygonGroup, create<FbxLayerElementPolygonGroup>},
    {Element::eUV, create<FbxLayerElementUV>},
};

CreateElement creatorOf(int type) {
    for (const ElementClass& row : kClasses)
        if (row.type == type)
            return row.create;
    return create<FbxLayerElementTexture>;
}

struct ElementKind {
    LayerElementRow row;
    int slot;
};

std::optional<ElementKind> kindOf(std::string_view record) {
    for (const LayerElementRow& row : kLayerElements)
        if (row.record == record)
            return ElementKind{row, row.type};
    for (const LayerChannelRow& channel : kLayerChannels) {
        const LayerElementRow textures = texturesRow(channel);
        if (channel.coordinates == record)
            return ElementKind{coordinatesRow(channel), Access::uvSlot(static_cast<Element::EType>(textures.type))};
        if (channel.textures == record)
            return ElementKind{textures, textures.type};
    }
    return std::nullopt;
}

std::optional<Element::EMappingMode> mappingOf(const Record& element) {
    const std::string_view text = element.childValue("MappingInformationType").toText();
    const bool byPoint = numberOf(kControlPointMappings, text, -1) >= 0;
    const int mode = byPoint ? Element::eByControlPoint : numberOf(kMappingModes, text, Element::eNone);
    return mode == Element::eNone ? std::nullopt : std::optional(static_cast<Element::EMappingMode>(mode));
}

const Record* childWithNumbers(const Record& record, std::string_view name) {
    const Record* child = name.empty() ? nullptr : record.child(name);
    return child && child->numberCount() > 0 ? child : nullptr;
}

/// The reference mode that follows from an element's records and arrays.
Element::EReferenceMode referenceOf(const Record& element, Storage storage, bool hasIndices) {
    if (storage == Storage::groups)
        return Element::eIndex;
    const std::string_view stated = element.childValue("ReferenceInformationType").toText();
    const bool direct = storage == Storage::values && (!hasIndices || stated == kReferenceModes[Element::eDirect]);
    return direct ? Element::eDirect : Element::eIndexToDirect;
}

class LayerReader {
public:
    LayerReader(FbxLayerContainer& container, const GeometrySource& source) : mContainer(container), mSource(source) {}

    void read() {
        for (const Record& record : mSource.body->children())
            if (record.name == "Layer")
                ++mLayerLimit;
            else if (record.name.starts_with("LayerElement"))
                readElement(record);
        mLayerLimit += static_cast<std::int64_t>(mElements.size());
        for (const Record& record : mSource.body->children())
            if (record.name == "Layer")
                readLayer(record);
        for (auto& [key, element] : mElements)
            if (!element.placed)
                placeUnnamed(element, key.second);
    }

private:
    struct ReadElement {
        Element* element = nullptr;
        int slot = 0;
        bool placed = false;
    };

    /// Of several elements of one type and number the first one is used.
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
        const Record* direct = childWithNumbers(record, kind.row.direct);
        const Record* index = childWithNumbers(record, kind.row.index);
        if (!mapping || !(kind.row.storage == Storage::values ? direct : index))
            return nullptr;
        if (*mapping == Element::eByEdge && !childWithNumbers(*mSource.body, "Edges"))
            return nullptr;
        const Element::EReferenceMode reference = referenceOf(record, kind.row.storage, index != nullptr);
        const ArrayRecords arrays{mSource.document, direct, childWithNumbers(record, kind.row.fourth),
                                  reference == Element::eDirect ? nullptr : index, mSource.ahead};
        const std::string name(record.childValue("Name").toText());
        Element* element = creatorOf(kind.row.type)(mContainer, name.c_str(), arrays);
        element->SetMappingMode(*mapping);
        element->SetReferenceMode(reference);
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

    /// An element may be in several layers; of two elements of one type in a layer the first one is used.
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

    /// The layer of that number, created with all before it. Null for numbers that no valid file has: a geometry does
    /// not have more layers than it names layers and elements.
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
