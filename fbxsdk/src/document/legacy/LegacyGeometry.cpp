// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Converts plain arrays next to the vertices to layer elements.
#include "document/legacy/LegacyRecords.h"

#include <algorithm>

#include "schema/LayerElements.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Records of the Model that become layer elements, and those that are not part of the geometry.
constexpr std::string_view kReplacedRecords[] = {
    "Normals",          "MaterialAssignation",
    "Materials",        "GeometryUVInfo",
    "Channel",          "Link",
    "Material",         "Texture",
    "Limits",           "Children",
    "AnimatedProperty", "Animated",
};

/// Files of this version have a normal per control point even where the counts do not include them.
constexpr std::uint32_t kPointNormalsVersion = 5000;

// Of the tables of layer elements: the rows, mappings and references that older geometry has.
constexpr const LayerElementRow& kNormalElements = kLayerElements[0];
constexpr const LayerElementRow& kMaterialElements = kLayerElements[std::size(kLayerElements) - 1];
static_assert(kNormalElements.type == LayerElementType::normal && kMaterialElements.type == LayerElementType::material);
constexpr std::string_view kByControlPoint = kMappingModes[1], kByPolygonVertex = kMappingModes[2],
                           kByPolygon = kMappingModes[3];
constexpr std::string_view kDirect = kReferenceModes[0], kIndexToDirect = kReferenceModes[2];

class GeometryBuilder {
public:
    GeometryBuilder(DocumentBuilder& builder, const Record& model)
        : mBuilder(builder), mModel(model), mGeometry(builder.newRecord("Geometry")), mChildren(mGeometry) {}

    const Record& build() {
        for (const Record& record : mModel.children())
            if (std::find(std::begin(kReplacedRecords), std::end(kReplacedRecords), record.name) ==
                std::end(kReplacedRecords))
                mChildren.add(mBuilder.aliasOf(record, record.name));
        addNormals();
        addMaterials();
        std::int64_t layer = 0;
        for (const Record& record : mModel.children())
            if (record.name == "GeometryUVInfo")
                addUvs(record, layer++);
        addLayers();
        return mGeometry;
    }

private:
    struct Element {
        std::string_view type;
        std::int64_t index;
    };

    [[nodiscard]] std::size_t countOf(std::string_view name) const {
        const Record* record = mModel.child(name);
        return record ? record->numberCount() : 0;
    }
    Record& text(std::string_view name, std::string_view value) {
        return mBuilder.newRecord(name, mBuilder.keep({Value::ofText(value)}));
    }
    Record& number(std::string_view name, std::int64_t value) {
        return mBuilder.newRecord(name, mBuilder.keep({Value::ofInteger(value)}));
    }

    /// An element of the type; its data records are still to be added.
    ChildAppender element(std::string_view type, std::int64_t index, std::string_view mapping,
                          std::string_view reference) {
        Record& record = number(type, index);
        mChildren.add(record);
        mElements.push_back({type, index});
        ChildAppender children(record);
        children.add(number("Version", 101));
        children.add(text("Name", ""));
        children.add(text("MappingInformationType", mapping));
        children.add(text("ReferenceInformationType", reference));
        return children;
    }

    void addNormals() {
        const Record* normals = mModel.child("Normals");
        if (!normals || normals->numberCount() == 0)
            return;
        const std::size_t points = countOf("Vertices") / 3;
        const std::size_t corners = countOf("PolygonVertexIndex");
        const bool ambiguous = points == corners && mBuilder.document().version != kPointNormalsVersion;
        const bool perPoint = normals->numberCount() / 3 == points && !ambiguous;
        element(kNormalElements.record, 0, perPoint ? kByControlPoint : kByPolygonVertex, kDirect)
            .add(mBuilder.aliasOf(*normals, kNormalElements.direct));
    }

    void addMaterials() {
        const Record* materials = mModel.child("Materials");
        const std::string_view assignation = mModel.childValue("MaterialAssignation").toText();
        if (!materials || materials->numberCount() == 0 || assignation.empty())
            return;
        element(kMaterialElements.record, 0, assignation, kIndexToDirect)
            .add(mBuilder.aliasOf(*materials, kMaterialElements.index));
    }

    void addUvs(const Record& info, std::int64_t index) {
        const Record* uvs = info.child("TextureUV");
        const Record* indices = info.child("TextureUVVerticeIndex");
        if (!uvs || uvs->numberCount() == 0)
            return;
        const std::string_view mapping = info.childValue("MappingInformationType").toText();
        constexpr LayerElementRow kRow = coordinatesRow(kLayerChannels[0]);
        ChildAppender children = element(kRow.record, index, mapping == kByPolygon ? kByPolygonVertex : mapping,
                                         indices ? kIndexToDirect : kDirect);
        children.add(mBuilder.aliasOf(*uvs, kRow.direct));
        if (indices)
            children.add(mBuilder.aliasOf(*indices, kRow.index));
    }

    /// One layer per element index; the first has all the others as well.
    void addLayers() {
        std::stable_sort(mElements.begin(), mElements.end(),
                         [](const Element& a, const Element& b) { return a.index < b.index; });
        for (auto first = mElements.begin(); first != mElements.end();) {
            const auto last = std::find_if(first, mElements.end(),
                                           [&](const Element& element) { return element.index != first->index; });
            Record& layer = number("Layer", first->index);
            mChildren.add(layer);
            ChildAppender children(layer);
            children.add(number("Version", 100));
            for (; first != last; ++first) {
                Record& entry = mBuilder.newRecord("LayerElement");
                children.add(entry);
                ChildAppender fields(entry);
                fields.add(text("Type", first->type));
                fields.add(number("TypedIndex", first->index));
            }
        }
    }

    DocumentBuilder& mBuilder;
    const Record& mModel;
    Record& mGeometry;
    ChildAppender mChildren;
    std::vector<Element> mElements;
};

} // namespace

const Record& layeredGeometry(DocumentBuilder& builder, const Record& model) {
    return GeometryBuilder(builder, model).build();
}

} // namespace detail
FBXSDK_NAMESPACE_END
