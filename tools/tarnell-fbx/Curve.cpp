// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx curve: the keys of an object's channels as the file has them, and samples between them.
#include <algorithm>
#include <cmath>
#include <map>

#include <strings.h>

#include <fbxsdk.h>

#include "Commands.h"
#include "Csv.h"
#include "CurveKeysText.h"
#include "Curves.h"
#include "Plot.h"
#include "PropertyValues.h"
#include "SceneFacts.h"
#include "SceneFile.h"
#include "SceneQueries.h"
#include "ShowFiles.h"
#include "Table.h"
#include "TerminalText.h"

namespace tool {
namespace {

/// A requested channel and its owner.
struct ChosenChannel {
    const FbxObject* object;
    Channel channel;

    [[nodiscard]] std::string fullName() const { return spokenName(*object) + '.' + channel.fullName(); }
};

struct FrameRange {
    long long first = 0, last = 0;
    [[nodiscard]] long long count() const { return last - first + 1; }
};

/// The object and its parts: a node includes its attributes, blend shape channels and materials.
std::vector<FbxObject*> withAttributes(FbxObject& object) {
    std::vector<FbxObject*> objects{&object};
    auto* node = FbxCast<FbxNode>(&object);
    if (!node)
        return objects;
    for (int i = 0; i < node->GetNodeAttributeCount(); ++i)
        objects.push_back(node->GetNodeAttributeByIndex(i));
    for (FbxBlendShapeChannel* channel : blendChannelsOf(*node))
        objects.push_back(channel);
    for (int i = 0; i < node->GetMaterialCount(); ++i)
        objects.push_back(node->GetMaterial(i));
    return objects;
}

/// "Lcl Translation", "lcl translation" and "translation" all select the first.
FbxProperty findProperty(const FbxObject& object, const std::string& name) {
    for (const std::string& spelling : {name, "Lcl " + name}) {
        for (const bool exactly : {true, false}) {
            const FbxProperty property = object.FindProperty(spelling.c_str(), exactly);
            if (property.IsValid())
                return property;
        }
    }
    return {};
}

/// Parses "NODE", "NODE.PROPERTY" or "NODE.PROPERTY.X" against a scene. Names may contain dots, so every dot is tried.
class Target {
public:
    Target(FbxScene& scene, const std::string& text, FbxAnimStack* take) : mTake(take) {
        for (FbxObject* object : objectsNamed(scene, text))
            addAnimated(*object);
        if (mFound)
            return;
        for (std::size_t dot = text.rfind('.'); dot != std::string::npos && dot > 0; dot = text.rfind('.', dot - 1)) {
            const std::vector<FbxObject*> objects = objectsNamed(scene, text.substr(0, dot));
            for (FbxObject* object : objects)
                addNamed(*object, text.substr(dot + 1));
            if (!objects.empty() && !mFound)
                throw Unreadable("\"" + text.substr(0, dot) + "\" has no numeric property \"" + text.substr(dot + 1) +
                                 '"');
            if (mFound)
                return;
        }
        throw Unreadable(unknownObject(scene, text));
    }

    [[nodiscard]] std::vector<ChosenChannel>& channels() { return mChannels; }

private:
    void addAnimated(FbxObject& object) {
        mFound = true;
        for (FbxObject* part : withAttributes(object)) {
            for (const FbxProperty& property : propertiesOf(*part)) {
                for (const Channel& channel : channelsOf(property, mTake))
                    if (!channel.curves.empty())
                        add(*part, {channel}, "");
            }
        }
    }

    void addNamed(FbxObject& object, const std::string& name) {
        const std::size_t dot = name.rfind('.');
        for (FbxObject* part : withAttributes(object)) {
            const FbxProperty whole = findProperty(*part, name);
            if (whole.IsValid() && componentCount(whole) > 0) {
                add(*part, channelsOf(whole, mTake), "");
                return;
            }
            const FbxProperty vector =
                dot == std::string::npos ? FbxProperty() : findProperty(*part, name.substr(0, dot));
            if (vector.IsValid() && add(*part, channelsOf(vector, mTake), name.substr(dot + 1)))
                return;
        }
    }

    bool add(const FbxObject& object, const std::vector<Channel>& channels, const std::string& only) {
        bool added = false;
        for (const Channel& channel : channels) {
            if (!only.empty() && strcasecmp(channel.name.c_str(), only.c_str()) != 0)
                continue;
            added = true;
            // A node includes its attribute, which may have the same name.
            const bool isKnown = std::any_of(mChannels.begin(), mChannels.end(), [&](const ChosenChannel& each) {
                return each.channel.property == channel.property && each.channel.component == channel.component;
            });
            if (!isKnown)
                mChannels.push_back({&object, channel});
        }
        mFound = mFound || added;
        return added;
    }

    FbxAnimStack* mTake;
    std::vector<ChosenChannel> mChannels;
    bool mFound = false;
};

/// The content of one page.
struct Curves {
    const SceneFile& file;
    FbxAnimStack* take;
    std::vector<ChosenChannel>& channels;
    std::optional<FrameRange> range; ///< to be sampled

    [[nodiscard]] FbxTime timeOf(double frame) const {
        FbxTime time;
        time.SetSecondDouble(frame / file.frameRate());
        return time;
    }
    [[nodiscard]] double frameOf(FbxTime time) const { return time.GetSecondDouble() * file.frameRate(); }
};

FbxTimeSpan spanOfKeys(const std::vector<ChosenChannel>& channels) {
    FbxTimeSpan all;
    bool any = false;
    for (const ChosenChannel& chosen : channels) {
        for (const LayerCurve& each : chosen.channel.curves) {
            FbxTimeSpan span;
            if (!each.curve->GetTimeInterval(span))
                continue;
            all = any ? FbxTimeSpan(std::min(all.GetStart(), span.GetStart()), std::max(all.GetStop(), span.GetStop()))
                      : span;
            any = true;
        }
    }
    return all;
}

/// The default frames: those of the take, or those of the keys where it has no span.
FrameRange defaultRange(const SceneFile& file, FbxAnimStack* take, const std::vector<ChosenChannel>& channels) {
    FbxTimeSpan span = take ? take->GetLocalTimeSpan() : FbxTimeSpan();
    if (span.GetStop() <= span.GetStart())
        span = spanOfKeys(channels);
    const FrameRange range{span.GetStart().GetFrameCount(file.timeMode()),
                           span.GetStop().GetFrameCount(file.timeMode())};
    constexpr long long kMostFrames = 1 << 20;
    if (range.last - range.first >= kMostFrames || range.last < range.first)
        throw Unreadable("the take has frames " + std::to_string(range.first) + " to " + std::to_string(range.last) +
                         "; select some with --frames A:B");
    return range;
}

// ---- Text ----

std::string shortNumber(double number) { return numberText(std::round(number * 1e6) / 1e6); }

/// Files round the ticks of rates like 23.976, which leaves fractions of some 1e-5 frames.
std::string frameText(double frame) { return numberText(std::round(frame * 1e3) / 1e3); }

std::string extrapolationText(const Extrapolation& extrapolation) {
    if (!extrapolation.repeats)
        return extrapolation.type;
    const std::string times = !extrapolation.count        ? "endless"
                              : *extrapolation.count == 1 ? "once"
                                                          : std::to_string(*extrapolation.count) + " times";
    return std::string(extrapolation.type) + " (" + times + ')';
}

const char* blendName(const FbxAnimLayer& layer) {
    switch (layer.BlendMode.Get()) {
    case FbxAnimLayer::eBlendOverride:
        return "override";
    case FbxAnimLayer::eBlendOverridePassthrough:
        return "override, passes through";
    default:
        return "additive";
    }
}

/// The settings that keep a layer from full effect.
std::string layerRemarks(const FbxAnimLayer& layer) {
    std::string text;
    if (layer.BlendMode.Get() != FbxAnimLayer::eBlendAdditive)
        text += std::string(", ") + blendName(layer);
    if (layer.Weight.Get() != 100.0)
        text += ", weight " + numberText(layer.Weight.Get()) + " %";
    if (layer.Mute.Get())
        text += ", muted";
    return layer.Solo.Get() ? text + ", solo" : text;
}

void printCurve(const Curves& curves, const LayerCurve& each, std::ostream& out, const Terminal& terminal) {
    const std::vector<KeyFacts> keys = keyFacts(*each.curve);
    const auto [low, high] = std::minmax_element(
        keys.begin(), keys.end(), [](const KeyFacts& a, const KeyFacts& b) { return a.value < b.value; });
    out << "  " << keys.size() << (keys.size() == 1 ? " key" : " keys") << " on layer "
        << inQuotes(each.layer->GetName()) << layerRemarks(*each.layer) << ", values "
        << (low->value == high->value ? "all " + exactText(low->value)
                                      : "from " + exactText(low->value) + " to " + exactText(high->value))
        << "; before " << extrapolationText(extrapolationBefore(*each.curve)) << ", after "
        << extrapolationText(extrapolationAfter(*each.curve)) << '\n';
    Table table({{"Frame", Table::Align::right},
                 {"Seconds", Table::Align::right},
                 {"Value", Table::Align::right, Ink::number},
                 {"Interpolation"},
                 {"Tangents"},
                 {"Left slope", Table::Align::right},
                 {"Right slope", Table::Align::right},
                 {"Remarks"}});
    for (const KeyFacts& key : keys) {
        table.addRow({frameText(curves.frameOf(key.time)), shortNumber(key.time.GetSecondDouble()),
                      exactText(key.value), key.interpolation, key.tangent,
                      key.leftSlope ? floatText(*key.leftSlope) : "", key.rightSlope ? floatText(*key.rightSlope) : "",
                      key.remarks()});
    }
    table.print(out, terminal, 4);
}

void printSamples(const Curves& curves, const Terminal& terminal, std::ostream& out) {
    out << "\nSamples of all layers combined\n";
    std::vector<Table::Column> columns{{"Frame", Table::Align::right}, {"Seconds", Table::Align::right}};
    std::map<std::string, int> titles;
    for (const ChosenChannel& chosen : curves.channels)
        ++titles[chosen.channel.fullName()];
    for (const ChosenChannel& chosen : curves.channels) {
        const std::string title = chosen.channel.fullName();
        columns.push_back(
            {terminalText(titles[title] == 1 ? title : chosen.fullName()), Table::Align::right, Ink::number});
    }
    Table table(columns);
    for (long long frame = curves.range->first; frame <= curves.range->last; ++frame) {
        const FbxTime time = curves.timeOf(static_cast<double>(frame));
        std::vector<std::string> cells{std::to_string(frame), shortNumber(time.GetSecondDouble())};
        for (ChosenChannel& chosen : curves.channels)
            cells.push_back(floatText(chosen.channel.valueAt(time)));
        table.addRow(std::move(cells));
    }
    table.print(out, terminal, 2);
}

void printTitle(const Curves& curves, Page& page, std::ostream& out) {
    out << page.terminal().paint(Ink::heading, spoken(page.file()))
        << (curves.take ? "  take " + inQuotes(curves.take->GetName()) : "  no take") << ", "
        << rateText(curves.file.frameRate()) << ", unit "
        << unitName(curves.file.scene().GetGlobalSettings().GetSystemUnit().GetScaleFactor()) << '\n'
        << "Values as stored in the file, slopes per second.\n";
    if (curves.channels.empty())
        out << "Nothing is animated" << (curves.take ? " in this take" : "") << ".\n";
}

void printText(const Curves& curves, Page& page) {
    std::ostream& out = page.begin();
    printTitle(curves, page, out);
    for (const ChosenChannel& chosen : curves.channels) {
        out << '\n'
            << page.terminal().paint(Ink::name, terminalText(chosen.fullName())) << "  [" << className(*chosen.object)
            << "]\n";
        if (chosen.channel.curves.empty())
            out << "  not animated, " << exactText(chosen.channel.staticValue()) << '\n';
        for (const LayerCurve& each : chosen.channel.curves)
            printCurve(curves, each, out, page.terminal());
    }
    if (curves.range && !curves.channels.empty())
        printSamples(curves, page.terminal(), out);
}

void plotChannel(const Curves& curves, ChosenChannel& chosen, Page& page, std::ostream& out) {
    constexpr std::size_t kRows = 10, kUsualWidth = 80, kMostColumns = 160;
    const std::size_t width = page.terminal().width == 0 ? kUsualWidth : page.terminal().width;
    const std::size_t columns = std::min(width - 2, kMostColumns);
    const auto first = static_cast<double>(curves.range->first), last = static_cast<double>(curves.range->last);
    std::vector<double> values;
    for (std::size_t i = 0; i < columns * 2; ++i) {
        const double part = static_cast<double>(i) / static_cast<double>(columns * 2 - 1);
        values.push_back(chosen.channel.valueAt(curves.timeOf(first + (last - first) * part)));
    }
    const auto [low, high] = std::minmax_element(values.begin(), values.end());
    const std::string from = std::to_string(curves.range->first), to = std::to_string(curves.range->last);
    out << '\n' << page.terminal().paint(Ink::name, terminalText(chosen.fullName()));
    if (*low == *high) {
        out << "  " << floatText(*low) << " constant, from frame " << from << " to " << to << '\n';
        return;
    }
    out << "\n  ┌ " << floatText(*high) << '\n';
    for (const std::string& line : brailleLines(values, columns, kRows))
        out << "  " << page.terminal().paint(Ink::number, line) << '\n';
    out << "  └ " << floatText(*low) << '\n';
    out << "  frame " << from
        << std::string(columns > from.size() + to.size() + 6 ? columns - from.size() - to.size() - 6 : 1, ' ') << to
        << '\n';
}

void plot(const Curves& curves, Page& page) {
    std::ostream& out = page.begin();
    printTitle(curves, page, out);
    for (ChosenChannel& chosen : curves.channels)
        plotChannel(curves, chosen, page, out);
}

// ---- JSON ----

void printCsv(const Curves& curves, Page& page) {
    std::ostream& out = page.begin();
    out << "frame,seconds";
    for (const ChosenChannel& chosen : curves.channels)
        out << ',' << csvField(chosen.fullName());
    out << '\n';
    for (long long frame = curves.range->first; frame <= curves.range->last; ++frame) {
        const FbxTime time = curves.timeOf(static_cast<double>(frame));
        out << frame << ',' << exactText(static_cast<double>(frame) / curves.file.frameRate());
        for (ChosenChannel& chosen : curves.channels)
            out << ',' << exactText(chosen.channel.valueAt(time));
        out << '\n';
    }
}

void printExtrapolation(const char* key, const Extrapolation& extrapolation, JsonWriter& json) {
    json.key(key);
    json.beginObject();
    json.text("type", extrapolation.type);
    json.key("count");
    if (extrapolation.count)
        json.integer(*extrapolation.count);
    else
        json.null();
    json.endObject();
}

void printCurve(const Curves& curves, const LayerCurve& each, JsonWriter& json) {
    json.beginObject();
    json.text("layer", each.layer->GetName());
    json.text("blend", blendName(*each.layer));
    json.real("weight", each.layer->Weight.Get());
    json.boolean("muted", each.layer->Mute.Get());
    json.boolean("solo", each.layer->Solo.Get());
    printExtrapolation("before", extrapolationBefore(*each.curve), json);
    printExtrapolation("after", extrapolationAfter(*each.curve), json);
    json.key("keys");
    json.beginArray();
    for (const KeyFacts& key : keyFacts(*each.curve)) {
        json.beginObject();
        json.integer("ticks", key.time.Get());
        json.real("seconds", key.time.GetSecondDouble());
        json.real("frame", curves.frameOf(key.time));
        json.key("value");
        json.real(key.value);
        printShape(key, json);
        json.endObject();
    }
    json.endArray();
    json.endObject();
}

void printTake(FbxAnimStack* take, JsonWriter& json) {
    json.key("take");
    if (!take) {
        json.null();
        return;
    }
    const FbxTimeSpan span = take->GetLocalTimeSpan();
    json.beginObject();
    json.text("name", take->GetName());
    json.real("start", span.GetStart().GetSecondDouble());
    json.real("end", span.GetStop().GetSecondDouble());
    json.endObject();
}

void printSamples(const Curves& curves, ChosenChannel& chosen, JsonWriter& json) {
    json.key("samples");
    if (!curves.range) {
        json.null();
        return;
    }
    json.beginObject();
    json.integer("firstFrame", curves.range->first);
    json.key("values");
    json.beginArray();
    for (long long frame = curves.range->first; frame <= curves.range->last; ++frame)
        json.real(chosen.channel.valueAt(curves.timeOf(static_cast<double>(frame))));
    json.endArray();
    json.endObject();
}

void printJson(const Curves& curves, JsonWriter& json) {
    printTake(curves.take, json);
    json.real("frameRate", curves.file.frameRate());
    json.key("channels");
    json.beginArray();
    for (ChosenChannel& chosen : curves.channels) {
        json.beginObject();
        json.text("object", chosen.object->GetName());
        json.text("class", className(*chosen.object));
        json.text("property", chosen.channel.property.GetHierarchicalName().Buffer());
        json.text("component", chosen.channel.name);
        json.real("value", chosen.channel.staticValue());
        json.key("curves");
        json.beginArray();
        for (const LayerCurve& each : chosen.channel.curves)
            printCurve(curves, each, json);
        json.endArray();
        printSamples(curves, chosen, json);
        json.endObject();
    }
    json.endArray();
}

} // namespace

int curve(const CurveOptions& options) {
    return showFiles(
        options, "curve",
        [&options](Page& page) -> int {
            const SceneFile opened(page.file());
            FbxAnimStack* take = opened.chooseTake(options.take);
            Target target(opened.scene(), options.target, take);
            Curves curves{opened, take, target.channels(), {}};
            if (options.frames)
                curves.range = FrameRange{options.frames->first, options.frames->second};
            else if (options.form == Form::csv || options.form == Form::plot)
                curves.range = defaultRange(opened, take, curves.channels);
            switch (options.form) {
            case Form::json:
            case Form::jsonLines:
                page.json(
                    "curve", [&](JsonWriter& json) { printJson(curves, json); });
                break;
            case Form::csv:
                printCsv(curves, page);
                break;
            case Form::plot:
                plot(curves, page);
                break;
            case Form::text:
            case Form::html: // not offered here
                printText(curves, page);
                break;
            }
            return kSuccess;
        });
}

} // namespace tool
