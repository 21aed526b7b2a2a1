// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Layer elements and layers: the inverse of LayerReading. Elements come first, numbered within their type, then the
// layers that name them.
#include <algorithm>
#include <map>
#include <stdexcept>
#include <string_view>
#include <utility>
#include <vector>

#include "document/RecordWriting.h"
#include "geometry/GeometryWriting.h"
#include "geometry/LayerElementAccess.h"
#include "schema/LayerElements.h"
#include "schema/Spellings.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

using Element = FbxLayerElement;
using Access = LayerElementAccess;

/// The element and the records that its arrays have.
struct ElementRecords {
    const Element& element;
    const LayerElementRow& row;
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

/// The numbers of each item from the first of these components to the one before the last, packed.
template <class Item>
std::vector<double> packed(DirectArray<Item> array, int begin, int end) {
    std::vector<double> numbers(static_cast<std::size_t>(array.GetCount()) * static_cast<std::size_t>(end - begin));
    const Item* const items = array.GetLocked();
    auto number = numbers.begin();
    for (int i = 0; i < array.GetCount(); ++i)
        for (int component = begin; component < end; ++component)
            *number++ = items[i][component];
    return numbers;
}

template <class Class>
void writeIndices(const ElementRecords& records) {
    if (records.element.GetReferenceMode() != Element::eDirect)
        writeArray<std::int32_t>(records.sink, records.row.index, spanOf(indicesOf<Class>(records.element)));
}

/// Three numbers, and where the version has it the fourth in a list of its own.
template <class Class>
void writeVectors(const ElementRecords& records) {
    DirectArray<FbxVector4> direct = directOf<Class>(records.element);
    writeArray<double>(records.sink, records.row.direct, packed<FbxVector4>(direct, 0, 3));
    if (records.traits.fourthNumbers)
        writeArray<double>(records.sink, records.row.fourth, packed<FbxVector4>(direct, 3, 4));
    writeIndices<Class>(records);
}

void writeColors(const ElementRecords& records) {
    DirectArray<FbxColor> direct = directOf<FbxLayerElementVertexColor>(records.element);
    std::vector<double> numbers;
    for (int i = 0; i < direct.GetCount(); ++i) {
        const FbxColor color = direct.GetAt(i);
        numbers.insert(numbers.end(), {color.mRed, color.mGreen, color.mBlue, color.mAlpha});
    }
    writeArray<double>(records.sink, records.row.direct, std::move(numbers));
    writeIndices<FbxLayerElementVertexColor>(records);
}

void writeUVs(const ElementRecords& records) {
    writeArray<double>(records.sink, records.row.direct,
                       packed<FbxVector2>(directOf<FbxLayerElementUV>(records.element), 0, 2));
    writeIndices<FbxLayerElementUV>(records);
}

void writeSmoothing(const ElementRecords& records) {
    writeArray<std::int32_t>(records.sink, records.row.direct,
                             spanOf(directOf<FbxLayerElementSmoothing>(records.element)));
}

void writeCreases(const ElementRecords& records) {
    DirectArray<double> direct = directOf<FbxLayerElementCrease>(records.element);
    writeArray<double>(records.sink, records.row.direct,
                       {direct.GetLocked(), static_cast<std::size_t>(direct.GetCount())});
}

template <class Class>
void writeFlags(const ElementRecords& records) {
    DirectArray<bool> direct = directOf<Class>(records.element);
    std::vector<std::uint8_t> flags;
    flags.reserve(static_cast<std::size_t>(direct.GetCount()));
    for (int i = 0; i < direct.GetCount(); ++i)
        flags.push_back(direct.GetAt(i) ? 1 : 0);
    writeArray<std::uint8_t>(records.sink, records.row.direct, flags);
}

void writePolygonGroups(const ElementRecords& records) {
    const bool direct = records.element.GetReferenceMode() == Element::eDirect;
    writeArray<std::int32_t>(records.sink, records.row.index,
                             spanOf(direct ? directOf<FbxLayerElementPolygonGroup>(records.element)
                                           : indicesOf<FbxLayerElementPolygonGroup>(records.element)));
}

/// One number for all when none is set: the first material or texture.
template <class Class>
void writeNumbers(const ElementRecords& records) {
    constexpr int kFirst[] = {0};
    std::span<const int> numbers = spanOf(indicesOf<Class>(records.element));
    if (numbers.empty() && records.element.GetMappingMode() == Element::eAllSame)
        numbers = kFirst;
    writeArray<std::int32_t>(records.sink, records.row.index, numbers);
}

void writeTextures(const ElementRecords& records) {
    writeText(records.sink, "BlendMode", "Translucent");
    writeReal(records.sink, "TextureAlpha", 1);
    writeNumbers<FbxLayerElementTexture>(records);
}

using WriteElement = void (*)(const ElementRecords& records);

/// The function that writes the arrays of each type. All texture channels have the same.
struct ElementWriter {
    int type;
    WriteElement write;
};

constexpr ElementWriter kWriters[] = {
    {Element::eNormal, writeVectors<FbxLayerElementNormal>},
    {Element::eBiNormal, writeVectors<FbxLayerElementBinormal>},
    {Element::eTangent, writeVectors<FbxLayerElementTangent>},
    {Element::ePolygonGroup, writePolygonGroups},
    {Element::eVertexColor, writeColors},
    {Element::eUV, writeUVs},
    {Element::eSmoothing, writeSmoothing},
    {Element::eEdgeCrease, writeCreases},
    {Element::eVisibility, writeFlags<FbxLayerElementVisibility>},
    {Element::eHole, writeFlags<FbxLayerElementHole>},
    {Element::eVertexCrease, writeCreases},
    {Element::eMaterial, writeNumbers<FbxLayerElementMaterial>},
};

WriteElement writerOf(int type) {
    for (const ElementWriter& row : kWriters)
        if (row.type == type)
            return row.write;
    return writeTextures;
}

struct ElementKind {
    LayerElementRow row;
    int slot;
};

/// In the order of files.
std::vector<ElementKind> allKinds() {
    std::vector<ElementKind> kinds;
    const auto add = [&](std::span<const LayerElementRow> rows) {
        for (const LayerElementRow& row : rows)
            kinds.push_back({row, row.type});
    };
    add(std::span(kLayerElements).first(kElementsBeforeCoordinates));
    for (const LayerChannelRow& channel : kLayerChannels) {
        const int textures = texturesRow(channel).type;
        kinds.push_back({coordinatesRow(channel), Access::uvSlot(static_cast<Element::EType>(textures))});
    }
    add(std::span(kLayerElements).subspan(kElementsBeforeCoordinates));
    for (const LayerChannelRow& channel : kLayerChannels)
        kinds.push_back({texturesRow(channel), texturesRow(channel).type});
    return kinds;
}

/// Files have no direct lists of numbers.
std::string_view referenceName(const Element& element, LayerElementStorage storage) {
    switch (storage) {
    case LayerElementStorage::groups:
        return kReferenceModes[Element::eIndex];
    case LayerElementStorage::numbers:
        return kReferenceModes[Element::eIndexToDirect];
    case LayerElementStorage::values:
        break;
    }
    const bool direct = element.GetReferenceMode() == Element::eDirect;
    return kReferenceModes[direct ? Element::eDirect : Element::eIndexToDirect];
}

class LayerWriter {
public:
    LayerWriter(const FbxLayerContainer& container, bool hasEdges, const VersionTraits& traits)
        : mContainer(container), mHasEdges(hasEdges), mTraits(traits), mKinds(allKinds()) {}

    void write(RecordSink& sink) {
        for (const ElementKind& kind : mKinds)
            writeElements(kind, sink);
        for (int i = 0; i < mContainer.GetLayerCount(); ++i)
            writeLayer(i, sink);
    }

private:
    /// Null for elements that cannot be written either.
    [[nodiscard]] const Element* elementAt(const FbxLayer& layer, int slot) const {
        const Element* element = Access::elementAt(layer, slot);
        return element && (mHasEdges || element->GetMappingMode() != Element::eByEdge) ? element : nullptr;
    }

    /// An element in several layers is written once.
    void writeElements(const ElementKind& kind, RecordSink& sink) {
        std::int32_t count = 0;
        for (int i = 0; i < mContainer.GetLayerCount(); ++i) {
            const Element* element = elementAt(*mContainer.GetLayer(i), kind.slot);
            if (!element || !mNumbers.try_emplace({element, kind.slot}, count).second)
                continue;
            writeElement(kind, *element, count, sink);
            ++count;
        }
    }

    void writeElement(const ElementKind& kind, const Element& element, std::int32_t number, RecordSink& sink) const {
        const int version = kind.row.version == 0 ? mTraits.normalVersion : kind.row.version;
        const BlockScope block(sink, kind.row.record, number);
        writeInteger(sink, "Version", mTraits.generation == 7 ? version : kind.row.legacyVersion);
        writeText(sink, "Name", element.GetName());
        writeText(sink, "MappingInformationType", spellingOf(kMappingModes, element.GetMappingMode(), Element::eNone));
        writeText(sink, "ReferenceInformationType", referenceName(element, kind.row.storage));
        try {
            writerOf(kind.row.type)({element, kind.row, mTraits, sink});
        } catch (const std::runtime_error&) {
            // A damaged element has no array; it is written without, and ignored on reading.
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
            writeText(sink, "Type", kind.row.record);
            writeInteger(sink, "TypedIndex", mNumbers.at({element, kind.slot}));
        }
    }

    const FbxLayerContainer& mContainer;
    bool mHasEdges;
    const VersionTraits& mTraits;
    std::vector<ElementKind> mKinds;
    std::map<std::pair<const Element*, int>, std::int32_t> mNumbers; ///< index of elements within their type
};

} // namespace

void writeLayers(const FbxLayerContainer& container, bool hasEdges, const VersionTraits& traits, RecordSink& sink) {
    LayerWriter(container, hasEdges, traits).write(sink);
}

} // namespace detail
FBXSDK_NAMESPACE_END
