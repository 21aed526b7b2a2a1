// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files of the 6.x generation: objects are identified by name, a Model holds its node attribute as well, and the
// animation is in takes.
#include <algorithm>

#include "document/PropertyNames.h"
#include "document/SameRecords.h"
#include "document/legacy/LegacyObjects.h"
#include "document/legacy/LegacyRecords.h"
#include "document/legacy/LegacyTakes.h"
#include "schema/PropertyFlags.h"
#include "schema/PropertyTypes.h"
#include "schema/SubClasses.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr std::string_view kRootNames[] = {"Model::Scene", std::string_view("Scene\0\1Model", 12)};

bool isRoot(std::string_view fullName) {
    return std::find(std::begin(kRootNames), std::end(kRootNames), fullName) != std::end(kRootNames);
}

/// Records of a Model that are the geometry itself.
constexpr std::string_view kPointRecords[] = {"Vertices", "PolygonVertexIndex", "Points", "KnotVector", "KnotVectorU"};

bool hasPoints(const Record& model) {
    return std::any_of(
        std::begin(kPointRecords), std::end(kPointRecords),
        [&](std::string_view name) { return model.child(name) != nullptr; });
}

/// The properties of a Model record, separated: its own, and those of its attribute.
struct SplitProperties {
    std::vector<DocumentProperty> model, attribute;
    bool flagged = false; ///< whether the file flags any as the attribute's
};

DocumentProperty readProperty(DocumentBuilder& builder, const Record& line) {
    constexpr std::size_t kTexts = 3; // name, type, flags
    const std::string_view type = line.value(1).toText();
    DocumentProperty property = propertyOf(line.value(0).toText(), type, subTypeOf(type), line.value(2).toText(),
                                           line.values.subspan(std::min(kTexts, line.values.size())));
    builder.rescale(property);
    return property;
}

std::vector<DocumentProperty> readProperties(DocumentBuilder& builder, const Record& owner) {
    std::vector<DocumentProperty> properties;
    if (const Record* list = owner.child("Properties60"))
        for (const Record& line : list->children())
            if (line.name == "Property" && !line.value(0).toText().empty())
                properties.push_back(readProperty(builder, line));
    return properties;
}

/// Most writers flag the attribute's properties with N. Where they do not, whatever is neither a Model's nor a user's
/// property is the attribute's.
SplitProperties splitProperties(DocumentBuilder& builder, const Record& model) {
    SplitProperties split;
    for (DocumentProperty& property : readProperties(builder, model)) {
        const bool flagged = property.flags.find(kAttributeFlagLetter) != std::string_view::npos;
        const bool user = property.flags.find(kUserFlagLetter) != std::string_view::npos;
        if (!flagged && (user || isModelProperty(property.name))) {
            split.model.push_back(property);
            continue;
        }
        split.flagged = split.flagged || flagged;
        property.flags = attributeFlags(builder.tree(), property.flags);
        split.attribute.push_back(property);
    }
    return split;
}

/// Two Models with equal attributes of the same name are instances of it.
struct SharedAttribute {
    const Record* model = nullptr;
    std::int64_t attribute = 0;
    std::vector<DocumentProperty> properties; ///< as in the file
    std::vector<std::string_view> deformers;  ///< full names, in order of connection
};

bool sameProperties(std::span<const DocumentProperty> a, std::span<const DocumentProperty> b) {
    return std::equal(
        a.begin(), a.end(), b.begin(), b.end(),
        [](const DocumentProperty& left, const DocumentProperty& right) {
            return left.name == right.name && left.typeName == right.typeName && sameValues(left.values, right.values);
        });
}

/// Compares the attribute's records of two Models: all that are not about the Model itself.
bool sameAttributeRecords(const Record& a, const Record& b) {
    const auto next = [](const Record* record) {
        constexpr std::string_view kModelRecords[] = {"Properties60", "MultiLayer", "MultiTake", "Shading",
                                                      "Culling",      "Hidden",     "Version"};
        while (record &&
               std::find(std::begin(kModelRecords), std::end(kModelRecords), record->name) != std::end(kModelRecords))
            record = record->nextSibling;
        return record;
    };
    const Record* left = next(a.firstChild);
    const Record* right = next(b.firstChild);
    while (left && right && left->name == right->name && sameRecords(*left, *right)) {
        left = next(left->nextSibling);
        right = next(right->nextSibling);
    }
    return !left && !right;
}

class Generation6 {
public:
    explicit Generation6(DocumentBuilder& builder) : mBuilder(builder), mObjects(builder) {}

    void read() {
        findDeformers();
        eachRecord("Objects", &Generation6::readObject);
        numberPoses();
        eachRecord("Connections", &Generation6::adoptGeometry);
        eachRecord("Connections", &Generation6::readConnection);
        for (const Record& record : mBuilder.root().children())
            if (record.name == "Version5")
                readLegacySettings(mBuilder, record);
        readTakes(mObjects);
    }

private:
    static constexpr std::int64_t kNobody = -1;

    void eachRecord(std::string_view section, void (Generation6::*readOne)(const Record&)) {
        for (const Record& list : mBuilder.root().children())
            if (list.name == section)
                for (const Record& record : list.children())
                    (this->*readOne)(record);
    }

    /// The deformers of each Model must be known before its attribute is created.
    void findDeformers() {
        std::unordered_map<std::string_view, bool> isDeformer;
        for (const Record& list : mBuilder.root().children())
            if (list.name == "Objects")
                for (const Record& record : list.children())
                    if (record.name == "Deformer")
                        isDeformer.emplace(record.value(0).toText(), true);
        for (const Record& list : mBuilder.root().children())
            if (list.name == "Connections")
                for (const Record& record : list.children())
                    if (const ConnectionEnds ends = connectionEnds(record);
                        ends.source && isDeformer.contains(ends.source->toText()))
                        mDeformers[ends.destination->toText()].push_back(ends.source->toText());
    }

    void readObject(const Record& record) {
        if (record.name == "GlobalSettings") {
            mBuilder.document().globalSettings = readProperties(mBuilder, record);
            return;
        }
        const std::string_view fullName = record.value(0).toText();
        if (record.name == "SceneInfo" || fullName.empty())
            return;
        if (mObjects.find(fullName) != 0) {
            mBuilder.warn(record, "an object " + quotedName(fullName) + " already exists; this one is left out");
            return;
        }
        if (record.name == "Model") {
            readModel(record, fullName);
            return;
        }
        const std::string_view subClass = record.value(1).toText();
        const std::int64_t id = mObjects.add(fullName, record.name, subClass, &record);
        DocumentObject& object = mObjects.at(id);
        object.properties = readProperties(mBuilder, record);
        for (DocumentProperty& property : object.properties)
            property.flags = attributeFlags(mBuilder.tree(), property.flags);
        modernizePropertyNames(object.record, object.subClass, object.properties);
        if (const std::string_view alias = record.childValue("NodeAttributeName").toText(); !alias.empty())
            mObjects.addAlias(alias, id);
    }

    void readModel(const Record& record, std::string_view fullName) {
        std::string_view kind = record.value(1).toText();
        const std::int64_t model = mObjects.add(fullName, "Model", kind, &record);
        SplitProperties split = splitProperties(mBuilder, record);
        if (kind.empty())
            kind = record.childValue("TypeFlags").toText();
        if (!hasAttribute(record, kind, split)) {
            split.model.insert(split.model.end(), split.attribute.begin(), split.attribute.end());
            mObjects.at(model).properties = std::move(split.model);
            return;
        }
        mObjects.at(model).properties = std::move(split.model);
        addAttribute(record, fullName, model, kind, split.attribute);
    }

    [[nodiscard]] static bool hasAttribute(const Record& record, std::string_view kind, const SplitProperties& split) {
        if (kind.empty())
            return false;
        if (kind == SubClass::kNull)
            return split.flagged || record.child("TypeFlags") || record.child("NodeAttributeName");
        // Geometry that is not a mesh has a record of its own in newer files, and a connection.
        return kind == SubClass::kMesh || attributeRecordOf(kind) != "Geometry" || hasPoints(record);
    }

    void addAttribute(const Record& record, std::string_view fullName, std::int64_t model, std::string_view kind,
                      std::vector<DocumentProperty>& properties) {
        const std::string_view attributeName = record.childValue("NodeAttributeName").toText();
        std::vector<std::string_view> deformers;
        if (const auto found = mDeformers.find(fullName); found != mDeformers.end())
            deformers = found->second;
        if (!attributeName.empty() && connectToShared(record, attributeName, model, properties, deformers))
            return;
        SharedAttribute made{&record, 0, properties, std::move(deformers)};
        modernizePropertyNames(attributeRecordOf(kind), kind, properties);
        const Record& body = mBuilder.aliasOf(record, attributeRecordOf(kind));
        made.attribute = mObjects.addAttribute(model, kind, attributeName, std::move(properties), &body);
        if (!attributeName.empty())
            mShared.emplace(attributeName, std::move(made));
    }

    bool connectToShared(const Record& record, std::string_view attributeName, std::int64_t model,
                         const std::vector<DocumentProperty>& properties,
                         const std::vector<std::string_view>& deformers) {
        const auto found = mShared.find(attributeName);
        if (found == mShared.end())
            return false;
        const SharedAttribute& first = found->second;
        if (first.deformers != deformers || !sameProperties(first.properties, properties) ||
            !sameAttributeRecords(*first.model, record))
            return false;
        mBuilder.connect(first.attribute, model);
        const LegacyModel* firstModel = mObjects.findModel(mObjects.find(first.model->value(0).toText()));
        LegacyModel parts = firstModel ? *firstModel : LegacyModel{};
        mObjects.model(model) = std::move(parts);
        return true;
    }

    void numberPoses() {
        for (DocumentObject& object : mBuilder.document().objects)
            if (object.record == "Pose")
                object.body = &mObjects.numberedPose(*object.body);
    }

    /// A geometry with a record of its own is the attribute of the Model it is connected to.
    void adoptGeometry(const Record& record) {
        const ConnectionEnds ends = connectionEnds(record);
        if (!ends.source || !ends.destinationProperty.empty() || !ends.sourceProperty.empty())
            return;
        const std::int64_t geometry = mObjects.find(ends.source->toText());
        const std::int64_t model = mObjects.find(ends.destination->toText());
        if (geometry == 0 || model == 0 || mObjects.at(geometry).record != "Geometry" ||
            mObjects.at(model).record != "Model")
            return;
        if (LegacyModel& parts = mObjects.model(model); parts.attribute == 0)
            parts.attribute = geometry;
    }

    void readConnection(const Record& record) {
        const ConnectionEnds ends = connectionEnds(record);
        if (!ends.source) {
            mBuilder.warn(record, "not a connection between two objects; it is left out");
            return;
        }
        const std::int64_t source = mObjects.find(ends.source->toText());
        const std::string_view destinationName = ends.destination->toText();
        std::int64_t destination = isRoot(destinationName) ? 0 : mObjects.find(destinationName);
        if (source == 0 || (destination == 0 && !isRoot(destinationName))) {
            mBuilder.connect(0, kNobody); // counted with all others of its kind
            return;
        }
        if (ends.destinationProperty.empty())
            destination = mObjects.deformedBy(source, destination);
        else
            destination = ownerOf(destination, ends.destinationProperty);
        mBuilder.connect(source, destination, ends.destinationProperty, ends.sourceProperty);
    }

    /// The attribute when the property is its own, else the object itself.
    [[nodiscard]] std::int64_t ownerOf(std::int64_t object, std::string_view property) {
        const LegacyModel* parts = mObjects.findModel(object);
        const bool itsAttributes = parts && parts->attribute != 0 && !mObjects.property(object, property) &&
                                   mObjects.property(parts->attribute, property);
        return itsAttributes ? parts->attribute : object;
    }

    DocumentBuilder& mBuilder;
    LegacyObjects mObjects;
    std::unordered_map<std::string_view, std::vector<std::string_view>> mDeformers; ///< of a Model
    std::unordered_map<std::string_view, SharedAttribute> mShared;                  ///< by attribute name
};

} // namespace

void readGeneration6(DocumentBuilder& builder) {
    Generation6(builder).read();
    builder.indexObjects();
}

} // namespace detail
FBXSDK_NAMESPACE_END
