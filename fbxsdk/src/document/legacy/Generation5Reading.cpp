// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files before 6.0: Models are at the top level and hold everything that belongs to them.
#include <algorithm>
#include <set>
#include <unordered_map>

#include "document/SameRecords.h"
#include "document/legacy/LegacyObjects.h"
#include "document/legacy/LegacyRecords.h"
#include "document/legacy/LegacyTakes.h"
#include "schema/SubClasses.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

class Generation5 {
public:
    explicit Generation5(DocumentBuilder& builder) : mBuilder(builder), mObjects(builder) {}

    bool read(FbxStatus& status) {
        for (const Record& record : mBuilder.root().children())
            if (record.name == "Model")
                readModel(record, record.value(0).toText());
        for (const auto& [record, id] : mModels) {
            if (!connectChildren(*record, id, status))
                return false;
            addClusters(*record, id);
        }
        readPoses();
        readLegacySettings(mBuilder, mBuilder.root());
        readCameras();
        setStaticValues();
        readTakes(mObjects);
        return true;
    }

private:
    void readModel(const Record& record, std::string_view fullName) {
        const std::string_view kind = legacyKindOf(record);
        const std::int64_t model = mObjects.add(fullName, "Model", kind, &record);
        mObjects.at(model).properties = legacyModelProperties(mBuilder, record);
        // Elsewhere the file may refer to it with or without its class.
        mObjects.addAlias(mObjects.at(model).name, model);
        mModels.emplace_back(&record, model);
        if (!kind.empty()) {
            const std::string_view attributeRecord = attributeRecordOf(kind);
            const Record& body = attributeRecord == "Geometry" ? layeredGeometry(mBuilder, record)
                                                               : mBuilder.aliasOf(record, attributeRecord);
            const std::int64_t attribute =
                mObjects.addAttribute(model, kind, {}, legacyAttributeProperties(mBuilder, kind, record), &body);
            mObjects.at(attribute).name = mObjects.at(model).name;
        }
        for (const Record& child : record.children())
            if (child.name == "Material")
                addMaterial(child, model);
            else if (child.name == "Texture")
                mBuilder.connect(mObjects.add(child.value(0).toText(), "Texture", "", &child), model);
    }

    /// Every Model holds a copy of its materials; equal ones of the same name are merged.
    void addMaterial(const Record& record, std::int64_t model) {
        const auto [entry, isNew] = mMaterials.try_emplace(record.value(0).toText(), &record, 0);
        if (isNew || !sameRecords(*entry->second.first, record)) {
            const std::int64_t material = mObjects.add(record.value(0).toText(), "Material", "", &record);
            mObjects.at(material).properties = legacyMaterialProperties(mBuilder, record);
            entry->second = {&record, material};
        }
        mBuilder.connect(entry->second.second, model);
    }

    bool connectChildren(const Record& record, std::int64_t model, FbxStatus& status) {
        const Record* children = record.child("Children");
        if (!children)
            return true;
        for (const Value& name : children->values) {
            // A bare word here is a sign of damage: its meaning cannot be recovered.
            if (name.type == Value::Type::word) {
                status.SetCode(FbxStatus::eInvalidFile, "%s: %s: a name in the list of children is not quoted",
                               mBuilder.tree().fileName.c_str(), mBuilder.tree().placeOf(*children).c_str());
                return false;
            }
            if (const std::int64_t child = mObjects.find(name.toText()); child != 0)
                mBuilder.connect(child, model);
            else
                mBuilder.warn(*children, "the child Model " + quotedName(name.toText()) + " does not exist");
        }
        return true;
    }

    void addClusters(const Record& record, std::int64_t model) {
        const LegacyModel* parts = mObjects.findModel(model);
        std::int64_t skin = 0;
        for (const Record& link : record.children()) {
            if (link.name != "Link" || !link.hasBlock || !parts || parts->attribute == 0)
                continue;
            if (skin == 0) {
                skin = mBuilder.newId();
                mBuilder.addObject(skin, "Deformer", SubClass::kSkin, "");
                mBuilder.connect(skin, parts->attribute);
            }
            const std::int64_t cluster = mBuilder.newId();
            const std::string_view bone = link.value(0).toText();
            mBuilder.addObject(cluster, "Deformer", SubClass::kCluster, nameWithoutClass(bone, mBuilder.tree().ascii),
                               &link);
            mBuilder.connect(cluster, skin);
            mBuilder.connect(mObjects.find(bone), cluster);
        }
    }

    void readPoses() {
        for (const Record& section : mBuilder.root().children())
            if (section.name == "SceneGenericPersistence")
                for (const Record& record : section.children())
                    if (record.name == "Pose")
                        mObjects.add(record.value(0).toText(), "Pose", record.childValue("Type").toText(),
                                     &mObjects.numberedPose(record));
    }

    /// The application's own views.
    void readCameras() {
        const Record* settings = mBuilder.root().child("Settings");
        if (!settings)
            return;
        for (const Record& record : settings->children())
            if (record.name == "Camera" && record.hasBlock)
                readModel(record, record.value(0).toText());
    }

    /// A Model's own channels are its static pose; what they omit is in the current take.
    void setStaticValues() {
        for (const auto& [record, id] : mModels)
            setStaticValues(id, *record);
        if (const Record* take = currentTake())
            for (const Record& record : take->children())
                if (const std::int64_t id = mObjects.find(record.value(0).toText());
                    id != 0 && record.name == "Model" && mObjects.at(id).record == "Model")
                    setStaticValues(id, record);
    }

    [[nodiscard]] const Record* currentTake() const {
        const Record* takes = mBuilder.root().child("Takes");
        if (!takes)
            return nullptr;
        const std::string_view current = takes->childValue("Current").toText();
        for (const Record& record : takes->children())
            if (record.name == "Take" && record.value(0).toText() == current)
                return &record;
        return takes->child("Take");
    }

    void setStaticValues(std::int64_t object, const Record& record) {
        for (const LegacyChannel& channel : readChannels(mObjects, object, record))
            if (!channel.components.empty() && mSet.emplace(channel.owner, channel.property).second)
                setStaticValue(channel);
    }

    void setStaticValue(const LegacyChannel& channel) {
        const bool scaling = channel.property == "Lcl Scaling";
        std::vector<double> numbers;
        for (const ChannelComponent& component : channel.components) {
            numbers.resize(std::max(numbers.size(), component.axis + 1), scaling ? 1.0 : 0.0);
            numbers[component.axis] = componentDefault(channel, component);
        }
        const bool vector = numbers.size() > 1 || channel.components.front().label == "d|X";
        numbers.resize(vector ? 3 : 1, scaling ? 1.0 : 0.0);
        const std::span<const Value> values = mBuilder.keepReals(numbers);
        if (mObjects.at(channel.owner).record == "Deformer") {
            setShapeWeight(mBuilder, mObjects.at(channel.owner), values);
            return;
        }
        // The three parts of the transform and a visibility have types named after them.
        const bool named = vector || channel.property == "Visibility";
        mObjects.setProperty(channel.owner,
                             propertyOf(channel.property, named ? channel.property : "Number", "", "A", values));
    }

    DocumentBuilder& mBuilder;
    LegacyObjects mObjects;
    std::vector<std::pair<const Record*, std::int64_t>> mModels;                             ///< in file order
    std::unordered_map<std::string_view, std::pair<const Record*, std::int64_t>> mMaterials; ///< the last of each name
    std::set<std::pair<std::int64_t, std::string_view>> mSet; ///< static values that are final
};

} // namespace

bool readGeneration5(DocumentBuilder& builder, FbxStatus& status) {
    const bool read = Generation5(builder).read(status);
    builder.indexObjects();
    return read;
}

} // namespace detail
FBXSDK_NAMESPACE_END
