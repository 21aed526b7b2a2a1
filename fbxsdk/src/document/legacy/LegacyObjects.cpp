// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "document/legacy/LegacyObjects.h"
#include "schema/SubClasses.h"

#include <algorithm>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr std::string_view kGeometryKinds[] = {
    SubClass::kMesh,  SubClass::kNurb, SubClass::kNurbsSurface,     SubClass::kNurbsCurve,
    SubClass::kPatch, SubClass::kLine, SubClass::kTrimNurbsSurface, SubClass::kBoundary,
    SubClass::kShape,
};

} // namespace

std::string_view attributeRecordOf(std::string_view kind) {
    const bool geometry =
        std::find(std::begin(kGeometryKinds), std::end(kGeometryKinds), kind) != std::end(kGeometryKinds);
    return geometry ? "Geometry" : "NodeAttribute";
}

std::int64_t LegacyObjects::add(std::string_view fullName, std::string_view record, std::string_view subClass,
                                const Record* body) {
    const std::int64_t id = mBuilder.newId();
    mBuilder.addObject(id, record, subClass, nameWithoutClass(fullName, mBuilder.tree().ascii), body);
    mIds.emplace(fullName, id);
    return id;
}

std::int64_t LegacyObjects::find(std::string_view fullName) const {
    const auto found = mIds.find(fullName);
    return found == mIds.end() ? 0 : found->second;
}

DocumentObject& LegacyObjects::at(std::int64_t id) {
    return mBuilder.document().objects[static_cast<std::size_t>(id - 1)];
}

DocumentProperty* LegacyObjects::property(std::int64_t id, std::string_view name) {
    std::vector<DocumentProperty>& properties = at(id).properties;
    PropertyIndex& index = mProperties[id];
    for (; index.indexed < properties.size(); ++index.indexed)
        index.positions.insert_or_assign(properties[index.indexed].name, index.indexed);
    const auto found = index.positions.find(name);
    return found == index.positions.end() ? nullptr : &properties[found->second];
}

void LegacyObjects::setProperty(std::int64_t id, const DocumentProperty& wanted) {
    if (DocumentProperty* present = property(id, wanted.name))
        present->values = wanted.values;
    else
        at(id).properties.push_back(wanted);
}

const LegacyModel* LegacyObjects::findModel(std::int64_t id) const {
    const auto found = mModels.find(id);
    return found == mModels.end() ? nullptr : &found->second;
}

std::int64_t LegacyObjects::addAttribute(std::int64_t model, std::string_view kind, std::string_view fullName,
                                         std::vector<DocumentProperty> properties, const Record* body) {
    const std::int64_t id = mBuilder.newId();
    DocumentObject& object =
        mBuilder.addObject(id, attributeRecordOf(kind), kind, nameWithoutClass(fullName, mBuilder.tree().ascii), body);
    object.properties = std::move(properties);
    const bool hasShapes = object.body->child("Shape") != nullptr;
    if (!fullName.empty())
        addAlias(fullName, id);
    mBuilder.connect(id, model);
    LegacyModel& parts = mModels[model];
    parts.attribute = id;
    if (hasShapes)
        for (const InlineShape& shape : addInlineShapes(mBuilder, static_cast<std::size_t>(id - 1)))
            parts.shapeChannels.emplace(shape.name, shape.channel);
    return id;
}

std::int64_t LegacyObjects::deformedBy(std::int64_t source, std::int64_t destination) {
    if (source == 0 || at(source).record != "Deformer")
        return destination;
    const LegacyModel* parts = findModel(destination);
    const bool geometry = parts && parts->attribute != 0 && at(parts->attribute).record == "Geometry";
    return geometry ? parts->attribute : destination;
}

const Record& LegacyObjects::numberedPose(const Record& pose) {
    Record& numbered = mBuilder.aliasOf(pose, "Pose");
    ChildAppender children(numbered);
    numbered.firstChild = nullptr;
    for (const Record& child : pose.children()) {
        Record& copy = mBuilder.aliasOf(child, child.name);
        children.add(copy);
        if (child.name != "PoseNode")
            continue;
        copy.firstChild = nullptr;
        ChildAppender nodes(copy);
        for (const Record& entry : child.children()) {
            Record& entryCopy = mBuilder.aliasOf(entry, entry.name);
            if (entry.name == "Node")
                entryCopy.values = mBuilder.keep({Value::ofInteger(find(entry.value(0).toText()))});
            nodes.add(entryCopy);
        }
    }
    return numbered;
}

} // namespace detail
FBXSDK_NAMESPACE_END
