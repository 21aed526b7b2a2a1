// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Layer elements and layers: the mirror of LayerReading. Elements come first, numbered within their type, then the
// layers that name them.
#include <algorithm>
#include <map>
#include <set>
#include <stdexcept>
#include <string_view>
#include <vector>

#include "document/RecordWriting.h"
#include "geometry/GeometryWriting.h"
#include "geometry/LayerChannels.h"
#include "geometry/LayerElementAccess.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

using Element = FbxLayerElement;
using Access = LayerElementAccess;

/// The element and the records that its arrays have.
struct ElementRecords {
    const Element& element;
    const VersionTraits& traits;
    RecordSink& sink;
};

template <class Item>
using DirectArray = const FbxLayerElementArrayTemplate<Item>&;

template <class Class>
DirectArray<typename Class::ArrayElementType> directOf(const Element& element) {
    return static_cast<const Class&>(element).GetDirectArray();
}
template <class Class>
const FbxLayerElementArrayTemplate<int>& indicesOf(const Element& element) {
    return static_cast<const Class&>(element).GetIndexArray();
}

std::span<const int> spanOf(const FbxLayerElementArrayTemplate<int>& array) {
    return {array.GetLocked(), static_cast<std::size_t>(array.GetCount())};
}

/// The numbers of each item from the first of these components up to before the last one, packed.
template <class Item>
std::vector<double> packed(DirectArray<Item> array, int begin, int end) {
    std::vector<double> numbers(static_cast<std::size_t>(array.GetCount()) * static_cast<std::size_t>(end - begin));
    const Item* const items = array.GetLocked();
    auto number = numbers.begin();
    for (int i = 0; i < array.GetCount(); ++i) {
        for (int component = begin; component < end; ++component)
            *number++ = items[i][component];
    }
    return numbers;
}

template <class Class>
void writeIndices(const ElementRecords& records, std::string_view name) {
    if (records.element.GetReferenceMode() != Element::eDirect)
        writeArray<std::int32_t>(records.sink, name, spanOf(indicesOf<Class>(records.element)));
}

/// Three numbers, and from 7.4 on the fourth in a list of its own.
template <class Class>
void writeVectors(const ElementRecords& records, std::string_view name, std::string_view fourthName,
                  std::string_view indexName) {
    DirectArray<FbxVector4> direct = directOf<Class>(records.element);
    writeArray<double>(records.sink, name, packed<FbxVector4>(direct, 0, 3));
    if (records.traits.fourthNumbers)
        writeArray<double>(records.sink, fourthName, packed<FbxVector4>(direct, 3, 4));
    writeIndices<Class>(records, indexName);
}

void writeNormals(const ElementRecords& records) {
    writeVectors<FbxLayerElementNormal>(records, "Normals", "NormalsW", "NormalsIndex");
}
void writeBinormals(const ElementRecords& records) {
    writeVectors<FbxLayerElementBinormal>(records, "Binormals", "BinormalsW", "BinormalsIndex");
}
void writeTangents(const ElementRecords& records) {
    writeVectors<FbxLayerElementTangent>(records, "Tangents", "TangentsW", "TangentsIndex");
}

void writeColors(const ElementRecords& records) {
    DirectArray<FbxColor> direct = directOf<FbxLayerElementVertexColor>(records.element);
    std::vector<double> numbers;
    for (int i = 0; i < direct.GetCount(); ++i) {
        const FbxColor color = direct.GetAt(i);
        numbers.insert(numbers.end(), {color.mRed, color.mGreen, color.mBlue, color.mAlpha});
    }
    writeArray<double>(records.sink, "Colors", numbers);
    writeIndices<FbxLayerElementVertexColor>(records, "ColorIndex");
}

void writeUVs(const ElementRecords& records) {
    writeArray<double>(records.sink, "UV", packed<FbxVector2>(directOf<FbxLayerElementUV>(records.element), 0, 2));
    writeIndices<FbxLayerElementUV>(records, "UVIndex");
}

void writeSmoothing(const ElementRecords& records) {
    writeArray<std::int32_t>(records.sink, "Smoothing", spanOf(directOf<FbxLayerElementSmoothing>(records.element)));
}

void writeCreases(const ElementRecords& records, std::string_view name) {
    DirectArray<double> direct = directOf<FbxLayerElementCrease>(records.element);
    writeArray<double>(records.sink, name, {direct.GetLocked(), static_cast<std::size_t>(direct.GetCount())});
}
void writeEdgeCreases(const ElementRecords& records) { writeCreases(records, "EdgeCrease"); }
void writeVertexCreases(const ElementRecords& records) { writeCreases(records, "VertexCrease"); }

template <class Class>
void writeFlags(const ElementRecords& records, std::string_view name) {
    DirectArray<bool> direct = directOf<Class>(records.element);
    std::vector<std::uint8_t> flags;
    flags.reserve(static_cast<std::size_t>(direct.GetCount()));
    for (int i = 0; i < direct.GetCount(); ++i)
        flags.push_back(direct.GetAt(i) ? 1 : 0);
    writeArray<std::uint8_t>(records.sink, name, flags);
}
void writeHoles(const ElementRecords& records) { writeFlags<FbxLayerElementHole>(records, "Hole"); }
void writeVisibility(const ElementRecords& records) { writeFlags<FbxLayerElementVisibility>(records, "Visibility"); }

void writePolygonGroups(const ElementRecords& records) {
    const bool direct = records.element.GetReferenceMode() == Element::eDirect;
    writeArray<std::int32_t>(records.sink, "PolygonGroup",
                             spanOf(direct ? directOf<FbxLayerElementPolygonGroup>(records.element)
                                           : indicesOf<FbxLayerElementPolygonGroup>(records.element)));
}

/// One number for all when nobody gave any: the first material or texture.
template <class Class>
void writeNumbers(const ElementRecords& records, std::string_view name) {
    constexpr int kFirst[] = {0};
    std::span<const int> numbers = spanOf(indicesOf<Class>(records.element));
    if (numbers.empty() && records.element.GetMappingMode() == Element::eAllSame)
        numbers = kFirst;
    writeArray<std::int32_t>(records.sink, name, numbers);
}
void writeMaterials(const ElementRecords& records) { writeNumbers<FbxLayerElementMaterial>(records, "Materials"); }

void writeTextures(const ElementRecords& records) {
    writeText(records.sink, "BlendMode", "Translucent");
    writeReal(records.sink, "TextureAlpha", 1);
    writeNumbers<FbxLayerElementTexture>(records, "TextureId");
}

/// What "by reference" an element is called. Lists of numbers are never direct in files.
enum class Reference { asSet, indexToDirect, index };

struct ElementKind {
    std::string_view record;
    int slot;
    int version;       ///< 0: that of normals
    int legacyVersion; ///< in files before 7.0
    Reference reference;
    void (*write)(const ElementRecords& records);
};

/// The elements in the order of files, where texture coordinates stand between the two halves and textures behind both.
const ElementKind kKinds[] = {
    {"LayerElementNormal", Element::eNormal, 0, 101, Reference::asSet, writeNormals},
    {"LayerElementBinormal", Element::eBiNormal, 0, 101, Reference::asSet, writeBinormals},
    {"LayerElementTangent", Element::eTangent, 0, 101, Reference::asSet, writeTangents},
    {"LayerElementPolygonGroup", Element::ePolygonGroup, 101, 101, Reference::index, writePolygonGroups},
    {"LayerElementColor", Element::eVertexColor, 101, 101, Reference::asSet, writeColors},
};
const ElementKind kKindsBehindUVs[] = {
    {"LayerElementSmoothing", Element::eSmoothing, 102, 102, Reference::asSet, writeSmoothing},
    {"LayerElementEdgeCrease", Element::eEdgeCrease, 101, 100, Reference::asSet, writeEdgeCreases},
    {"LayerElementVisibility", Element::eVisibility, 101, 101, Reference::asSet, writeVisibility},
    {"LayerElementHole", Element::eHole, 101, 100, Reference::asSet, writeHoles},
    {"LayerElementVertexCrease", Element::eVertexCrease, 101, 100, Reference::asSet, writeVertexCreases},
    {"LayerElementMaterial", Element::eMaterial, 101, 101, Reference::indexToDirect, writeMaterials},
};

std::vector<ElementKind> allKinds() {
    std::vector<ElementKind> kinds(std::begin(kKinds), std::end(kKinds));
    for (const LayerChannelRow& row : kLayerChannels)
        kinds.push_back({row.uvs, Access::uvSlot(row.channel), 101, 101, Reference::asSet, writeUVs});
    kinds.insert(kinds.end(), std::begin(kKindsBehindUVs), std::end(kKindsBehindUVs));
    for (const LayerChannelRow& row : kLayerChannels)
        kinds.push_back({row.textures, row.channel, 101, 101, Reference::indexToDirect, writeTextures});
    return kinds;
}

std::string_view mappingName(Element::EMappingMode mode) {
    switch (mode) {
    case Element::eByControlPoint:
        return "ByVertice";
    case Element::eByPolygonVertex:
        return "ByPolygonVertex";
    case Element::eByPolygon:
        return "ByPolygon";
    case Element::eByEdge:
        return "ByEdge";
    case Element::eAllSame:
        return "AllSame";
    case Element::eNone:
        break;
    }
    return "NoMappingInformation";
}

std::string_view referenceName(const Element& element, Reference reference) {
    switch (reference) {
    case Reference::index:
        return "Index";
    case Reference::indexToDirect:
        return "IndexToDirect";
    case Reference::asSet:
        break;
    }
    return element.GetReferenceMode() == Element::eDirect ? "Direct" : "IndexToDirect";
}

class LayerWriter {
public:
    LayerWriter(const FbxLayerContainer& container, bool hasEdges, const VersionTraits& traits)
        : mContainer(container), mHasEdges(hasEdges), mTraits(traits), mKinds(allKinds()) {}

    /// A part for each element, and one for the layers.
    std::vector<RecordSink::Part> parts() {
        std::vector<RecordSink::Part> list;
        for (const ElementKind& kind : mKinds)
            addElements(kind, list);
        list.emplace_back([this](RecordSink& sink) {
            for (int i = 0; i < mContainer.GetLayerCount(); ++i)
                writeLayer(i, sink);
        });
        return list;
    }

    /// Whether an element stands in two slots, so that two parts read it.
    [[nodiscard]] bool hasSharedElements() const {
        std::set<const Element*> elements;
        for (const auto& [elementAndSlot, number] : mNumbers)
            elements.insert(elementAndSlot.first);
        return elements.size() < mNumbers.size();
    }

private:
    /// Null for what cannot be written either.
    [[nodiscard]] const Element* elementAt(const FbxLayer& layer, int slot) const {
        const Element* element = Access::elementAt(layer, slot);
        return element && (mHasEdges || element->GetMappingMode() != Element::eByEdge) ? element : nullptr;
    }

    /// An element that stands in several layers is written once.
    void addElements(const ElementKind& kind, std::vector<RecordSink::Part>& list) {
        std::int32_t count = 0;
        for (int i = 0; i < mContainer.GetLayerCount(); ++i) {
            const Element* element = elementAt(*mContainer.GetLayer(i), kind.slot);
            if (!element || mNumbers.count({element, kind.slot}) > 0)
                continue;
            mNumbers[{element, kind.slot}] = count;
            list.emplace_back(
                [this, &kind, element, count](RecordSink& sink) { writeElement(kind, *element, count, sink); });
            ++count;
        }
    }

    void writeElement(const ElementKind& kind, const Element& element, std::int32_t number, RecordSink& sink) const {
        const int version = kind.version == 0 ? mTraits.normalVersion : kind.version;
        const BlockScope block(sink, kind.record, number);
        writeInteger(sink, "Version", mTraits.generation == 7 ? version : kind.legacyVersion);
        writeText(sink, "Name", element.GetName());
        writeText(sink, "MappingInformationType", mappingName(element.GetMappingMode()));
        writeText(sink, "ReferenceInformationType", referenceName(element, kind.reference));
        try {
            kind.write({element, mTraits, sink});
        } catch (const std::runtime_error&) {
            // A damaged element has no array; it is written without, and read as if it were not there.
        }
    }

    void writeLayer(int index, RecordSink& sink) const {
        const FbxLayer& layer = *mContainer.GetLayer(index);
        const BlockScope block(sink, "Layer", index);
        writeInteger(sink, "Version", 100);
        for (const ElementKind& kind : mKinds) {
            const Element* element = elementAt(layer, kind.slot);
            if (!element)
                continue;
            const BlockScope entry(sink, "LayerElement");
            writeText(sink, "Type", kind.record);
            writeInteger(sink, "TypedIndex", mNumbers.at({element, kind.slot}));
        }
    }

    const FbxLayerContainer& mContainer;
    bool mHasEdges;
    const VersionTraits& mTraits;
    std::vector<ElementKind> mKinds;
    std::map<std::pair<const Element*, int>, std::int32_t> mNumbers; ///< of elements within their kind
};

} // namespace

void writeWithLayers(std::vector<RecordSink::Part> parts, const FbxLayerContainer& container, bool hasEdges,
                     const VersionTraits& traits, RecordSink& sink, bool atOnce) {
    LayerWriter layers(container, hasEdges, traits);
    for (RecordSink::Part& part : layers.parts())
        parts.push_back(std::move(part));
    if (atOnce && !layers.hasSharedElements())
        sink.parts(parts);
    else
        for (const RecordSink::Part& part : parts)
            part(sink);
}

} // namespace detail
FBXSDK_NAMESPACE_END
