// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx props: the properties of an object as the file has them.
#include <algorithm>

#include <fbxsdk.h>
#include <fbxsdk/extensions/FileFacts.h>

#include "Commands.h"
#include "Curves.h"
#include "PropertyValues.h"
#include "SceneFacts.h"
#include "SceneFile.h"
#include "SceneQueries.h"
#include "ShowFiles.h"
#include "Table.h"
#include "TerminalText.h"

namespace tool {
namespace {

/// The objects of the name, each node followed by its attributes.
std::vector<FbxObject*> chosenObjects(FbxScene& scene, const std::string& name) {
    std::vector<FbxObject*> chosen;
    const auto add = [&](FbxObject* object) {
        if (std::find(chosen.begin(), chosen.end(), object) == chosen.end())
            chosen.push_back(object);
    };
    for (FbxObject* object : objectsNamed(scene, name)) {
        add(object);
        auto* node = FbxCast<FbxNode>(object);
        for (int i = 0; node && i < node->GetNodeAttributeCount(); ++i)
            add(node->GetNodeAttributeByIndex(i));
    }
    return chosen;
}

/// The property's connections other than the curves that drive it.
std::vector<std::string> sourcesOf(const FbxProperty& property) {
    std::vector<std::string> names;
    for (int i = 0; i < property.GetSrcObjectCount(); ++i) {
        const FbxObject* source = property.GetSrcObject(i);
        if (!source->Is<FbxAnimCurveNode>() && !source->Is<FbxAnimCurveBase>())
            names.emplace_back(source->GetName());
    }
    for (int i = 0; i < property.GetSrcPropertyCount(); ++i) {
        const FbxProperty source = property.GetSrcProperty(i);
        names.push_back(std::string(source.GetFbxObject()->GetName()) + '.' + source.GetHierarchicalName().Buffer());
    }
    return names;
}

std::vector<FbxProperty> chosenProperties(const FbxObject& object, bool all) {
    std::vector<FbxProperty> chosen;
    for (const FbxProperty& property : propertiesOf(object))
        if (all || extensions::isStated(property))
            chosen.push_back(property);
    return chosen;
}

std::string described(const FbxProperty& property) {
    std::string text = valueText(property);
    for (const std::string& source : sourcesOf(property))
        text += (text.empty() ? "← " : "  ← ") + inQuotes(source);
    return text;
}

void printObject(const FbxObject& object, const PropsOptions& options, FbxAnimStack* take, std::ostream& out,
                 const Terminal& terminal) {
    out << terminal.paint(Ink::name, inQuotes(spokenName(object))) << "  " << className(object) << '\n';
    Table table({{"Property"},
                 {"Type", Table::Align::left, Ink::faint},
                 {"Flags"},
                 {"Keys", Table::Align::right},
                 {"Value", Table::Align::left, Ink::number}});
    for (const FbxProperty& property : chosenProperties(object, options.all)) {
        const int keys = keyCount(property, take);
        table.addRow({terminalText(property.GetHierarchicalName().Buffer()), terminalText(typeName(property)),
                      flagLetters(property), keys > 0 ? std::to_string(keys) : "", described(property)});
    }
    if (table.empty())
        out << "  The file states no properties; --all shows those of the class.\n";
    else
        table.print(out, terminal, 2);
}

void printObject(const FbxObject& object, const PropsOptions& options, FbxAnimStack* take, bool hasIds,
                 JsonWriter& json) {
    json.beginObject();
    json.text("name", object.GetName());
    json.text("class", className(object));
    printId(object, hasIds, json);
    json.key("properties");
    json.beginArray();
    for (const FbxProperty& property : chosenProperties(object, options.all)) {
        json.beginObject();
        json.text("name", property.GetHierarchicalName().Buffer());
        json.text("type", typeName(property));
        json.text("flags", flagLetters(property));
        json.boolean("stated", extensions::isStated(property));
        json.integer("keys", keyCount(property, take));
        json.key("value");
        printValue(property, json);
        json.key("sources");
        json.beginArray();
        for (const std::string& source : sourcesOf(property))
            json.text(source);
        json.endArray();
        json.endObject();
    }
    json.endArray();
    json.endObject();
}

} // namespace

int props(const PropsOptions& options) {
    return showFiles(
        options, "props",
        [&options](Page& page) -> int {
            const SceneFile opened(page.file());
            FbxAnimStack* take = opened.chooseTake(options.take);
            const std::vector<FbxObject*> objects = chosenObjects(opened.scene(), options.object);
            if (objects.empty())
                throw Unreadable(unknownObject(opened.scene(), options.object));
            if (page.isJson()) {
                page.json(
                    "props",
                    [&](JsonWriter& json) {
                        json.key("objects");
                        json.beginArray();
                        for (const FbxObject* object : objects)
                            printObject(*object, options, take, opened.hasIds(), json);
                        json.endArray();
                    });
                return kSuccess;
            }
            std::ostream& out = page.begin();
            out << page.terminal().paint(Ink::heading, spoken(page.file()))
                << (take ? "  take " + inQuotes(take->GetName()) : "  no take") << '\n';
            for (const FbxObject* object : objects) {
                out << '\n';
                printObject(*object, options, take, out, page.terminal());
            }
            return kSuccess;
        });
}

} // namespace tool
