// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files of version 6.1: objects are identified by name and list all their properties, a Model holds its attribute, and
// the animation is in takes. The inverse of Generation6Reading.
#include <algorithm>
#include <map>
#include <utility>

#include "document/DocumentSections.h"
#include "document/PropertyNames.h"
#include "document/RecordWriting.h"
#include "document/WrittenLines.h"
#include "document/legacy/LegacyLayout.h"
#include "schema/OldNames.h"
#include "schema/PropertyFlags.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Settings that this generation does not have.
constexpr std::string_view kNewerSettings[] = {"TimeMarker", "CurrentTimeMarker"};

/// Properties of objects that this generation does not have, and their implied values.
constexpr struct {
    std::string_view name;
    double value;
} kNewerProperties[] = {{"Visibility Inheritance", 1}, {"AreaLightShape", 0}, {"LeftBarnDoor", 20},
                        {"RightBarnDoor", 20},         {"TopBarnDoor", 20},   {"BottomBarnDoor", 20},
                        {"EnableBarnDoor", 0}};

bool goesWithoutSaying(const DocumentProperty& property) {
    return property.values.size() == 1 && std::any_of(
                                              std::begin(kNewerProperties), std::end(kNewerProperties),
                                              [&](const auto& row) {
                                                  return row.name == property.name &&
                                                         row.value == property.values.front().toReal();
                                              });
}

/// The order of kinds within Objects, and that of their counts; others follow.
constexpr std::string_view kObjectOrder[] = {"Model",    "NodeAttribute", "Geometry", "SceneInfo", "Material",
                                             "Deformer", "Video",         "Texture",  "Cache"};
constexpr std::string_view kCountOrder[] = {"Model",          "Material",      "Texture",  "Video", "SceneInfo",
                                            "GlobalSettings", "NodeAttribute", "Geometry", "Cache", "Deformer"};

template <std::size_t size>
std::size_t rankIn(const std::string_view (&order)[size], std::string_view record) {
    return static_cast<std::size_t>(std::find(std::begin(order), std::end(order), record) - std::begin(order));
}

/// Lines of objects as records. Runs of them that many objects have are encoded once.
class LineWriter {
public:
    /// Properties of objects of that subclass; of attributes inside Models if so.
    LineWriter(std::string_view subClass, bool inModel) : mSubClass(subClass), mInModel(inModel) {}

    [[nodiscard]] bool isFor(std::string_view subClass, bool inModel) const {
        return mInModel == inModel && mSubClass == subClass;
    }

    /// Those with other names here are last.
    void write(std::span<const WrittenLine> lines, RecordSink& sink) {
        mRenamed.clear();
        while (!lines.empty()) {
            const std::size_t count = runLength(lines);
            if (lines.front().number == WrittenLine::kUnique)
                writeOne(*lines.front().property, sink, mRenamed);
            else
                writeShared(lines.first(count), sink);
            lines = lines.subspan(count);
        }
        for (const DocumentProperty* property : mRenamed)
            writeRecord(*property, sink);
    }

private:
    using Properties = std::vector<const DocumentProperty*>;

    /// Lines with consecutive numbers.
    struct Run {
        RecordSink::EncodedRecords records;
        Properties renamed;
    };

    /// Of further runs each line is one: objects may leave out any of a class's lines.
    static constexpr std::size_t kMostLongRuns = 64;

    static std::size_t runLength(std::span<const WrittenLine> lines) {
        std::size_t count = 1;
        while (count < lines.size() && lines[count].number == lines[count - 1].number + 1)
            ++count;
        return count;
    }

    void writeShared(std::span<const WrittenLine> lines, RecordSink& sink) {
        const auto known = mRuns.find({lines.front().number, lines.size()});
        if (known != mRuns.end()) {
            repeat(known->second, sink);
        } else if (lines.size() == 1 || mLongRuns < kMostLongRuns) {
            const std::pair key(lines.front().number, lines.size());
            repeat(mRuns.emplace(key, encoded(lines, sink)).first->second, sink);
            if (lines.size() > 1)
                ++mLongRuns;
        } else {
            for (std::size_t i = 0; i < lines.size(); ++i)
                writeShared(lines.subspan(i, 1), sink);
        }
    }

    [[nodiscard]] Run encoded(std::span<const WrittenLine> lines, const RecordSink& sink) {
        Run run;
        run.records = sink.encoded([&](RecordSink& target) {
            for (const WrittenLine& line : lines)
                writeOne(*line.property, target, run.renamed);
        });
        return run;
    }

    void repeat(const Run& run, RecordSink& sink) {
        if (!run.records.bytes.empty())
            sink.repeat(run.records);
        mRenamed.insert(mRenamed.end(), run.renamed.begin(), run.renamed.end());
    }

    void writeOne(const DocumentProperty& property, RecordSink& sink, Properties& renamed) {
        if (goesWithoutSaying(property))
            return;
        if (mInModel && legacyPropertyName(mSubClass, property.name) != property.name)
            renamed.push_back(&property);
        else
            writeRecord(property, sink);
    }

    /// Properties of an attribute inside a Model are marked by a letter.
    void writeRecord(DocumentProperty property, RecordSink& sink) {
        property.name = legacyPropertyName(mSubClass, property.name);
        mFlags = property.flags;
        if (mInModel)
            mFlags += kAttributeFlagLetter;
        writeProperty60(sink, property, mFlags);
    }

    std::string_view mSubClass;
    bool mInModel;
    std::map<std::pair<int, std::size_t>, Run> mRuns; ///< by the number of the first line and their count
    std::size_t mLongRuns = 0;                        ///< of these the ones with several lines
    Properties mRenamed;
    std::string mFlags;
};

class Generation6Writer {
public:
    Generation6Writer(const Document& document, const VersionTraits& traits, RecordSink& sink)
        : mDocument(document), mTraits(traits), mSink(sink), mLayout(document) {}

    void write() {
        writeHeader(mDocument, mTraits, mSink);
        writeDocumentSection();
        writeDefinitions();
        writeObjects();
        writeConnections();
        writeLegacyTakes(mLayout, mTraits, mSink);
        writeSettings();
    }

private:
    void writeDocumentSection() {
        mSink.heading("Document Description");
        {
            const BlockScope block(mSink, "Document");
            writeText(mSink, "Name", "");
        }
        mSink.heading("Document References");
        const BlockScope block(mSink, "References");
    }

    void writeDefinitions() {
        std::vector<ObjectCount> kinds;
        for (const DocumentObject& object : mDocument.objects)
            if (mLayout.standsAlone(object))
                count(kinds, object.record);
        count(kinds, "SceneInfo");
        count(kinds, "GlobalSettings");
        std::stable_sort(kinds.begin(), kinds.end(), [](const ObjectCount& a, const ObjectCount& b) {
            return rankIn(kCountOrder, a.record) < rankIn(kCountOrder, b.record);
        });
        std::int32_t total = 0;
        for (const ObjectCount& kind : kinds)
            total += kind.count;

        mSink.heading("Object definitions");
        const BlockScope block(mSink, "Definitions");
        writeInteger(mSink, "Version", 100);
        writeInteger(mSink, "Count", total);
        for (const ObjectCount& kind : kinds) {
            const BlockScope type(mSink, "ObjectType", kind.record);
            writeInteger(mSink, "Count", kind.count);
        }
    }

    static void count(std::vector<ObjectCount>& kinds, std::string_view record) {
        const auto found =
            std::find_if(kinds.begin(), kinds.end(), [&](const ObjectCount& kind) { return kind.record == record; });
        if (found == kinds.end())
            kinds.push_back({record, 1, nullptr});
        else
            ++found->count;
    }

    void writeObjects() {
        mSink.heading("Object properties");
        const BlockScope block(mSink, "Objects");
        const std::vector<const DocumentObject*> objects = objectsInOrder();
        const auto behindSceneInfo = std::find_if(
            objects.begin(), objects.end(),
            [](const DocumentObject* object) {
                return rankIn(kObjectOrder, object->record) > rankIn(kObjectOrder, "SceneInfo");
            });
        std::for_each(objects.begin(), behindSceneInfo, [this](const DocumentObject* object) { writeObject(*object); });
        writeSceneInfo(mDocument, mTraits, mSink);
        std::for_each(behindSceneInfo, objects.end(), [this](const DocumentObject* object) { writeObject(*object); });
        writeGlobalSettings();
    }

    [[nodiscard]] std::vector<const DocumentObject*> objectsInOrder() const {
        std::vector<const DocumentObject*> objects;
        for (const DocumentObject& object : mDocument.objects)
            if (mLayout.standsAlone(object))
                objects.push_back(&object);
        std::stable_sort(objects.begin(), objects.end(), [](const DocumentObject* a, const DocumentObject* b) {
            return rankIn(kObjectOrder, a->record) < rankIn(kObjectOrder, b->record);
        });
        return objects;
    }

    void writeObject(const DocumentObject& object) {
        if (mSink.failed())
            return;
        const DocumentObject* attribute = mLayout.attributeOf(object.id);
        writeFullName(object.record, object.id);
        mSink.text(object.subClass);
        mSink.beginBlock();
        if (object.content->before)
            object.content->before(mSink, mTraits);
        writeProperties(object, attribute);
        // An attribute of its own states its kind in its subclass, and has no further records.
        if (object.content->after && object.record != "NodeAttribute")
            object.content->after(mSink, mTraits);
        if (attribute)
            writeAttribute(*attribute);
        else if (object.record == "NodeAttribute" || object.record == "Geometry")
            writeAttributeName(object.id);
        mSink.endRecord();
    }

    void writeAttribute(const DocumentObject& attribute) {
        if (attribute.content->before)
            attribute.content->before(mSink, mTraits);
        if (attribute.content->after)
            attribute.content->after(mSink, mTraits);
        writeAttributeName(attribute.id);
    }

    void writeAttributeName(std::int64_t attribute) {
        writeFullName("NodeAttributeName", attribute);
        mSink.endRecord();
    }

    /// Begins a record whose first value is an object's name.
    void writeFullName(std::string_view record, std::int64_t id) {
        const LegacyName name = mLayout.nameOf(id);
        mSink.beginRecord(record);
        mSink.objectName(name.nameClass, name.name);
    }

    /// The attribute's properties follow the Model's own.
    void writeProperties(const DocumentObject& object, const DocumentObject* attribute) {
        const BlockScope block(mSink, "Properties60");
        writeLines(object, /*inModel*/ false);
        if (attribute)
            writeLines(*attribute, /*inModel*/ true);
    }

    void writeLines(const DocumentObject& object, bool inModel) {
        auto writer = std::find_if(mLineWriters.begin(), mLineWriters.end(),
                                   [&](const LineWriter& each) { return each.isFor(object.subClass, inModel); });
        if (writer == mLineWriters.end())
            writer = mLineWriters.emplace(writer, object.subClass, inModel);
        mLines.fill(object);
        writer->write(mLines.all(), mSink);
    }

    void writeGlobalSettings() {
        const BlockScope block(mSink, "GlobalSettings");
        writeInteger(mSink, "Version", 1000);
        const BlockScope properties(mSink, "Properties60");
        for (const DocumentProperty& property : mDocument.globalSettings)
            if (std::find(std::begin(kNewerSettings), std::end(kNewerSettings), property.name) ==
                std::end(kNewerSettings))
                writeProperty60(mSink, property, property.flags);
    }

    void writeConnections() {
        mSink.heading("Object connections");
        const BlockScope block(mSink, "Connections");
        for (const DocumentConnection& connection : mDocument.connections)
            writeConnection(connection);
    }

    [[nodiscard]] bool isConnectable(std::int64_t id) const {
        const DocumentObject* object = mLayout.find(id);
        return id == 0 || (object && (mLayout.standsAlone(*object) || !mLayout.holdersOf(id).empty()));
    }

    void writeConnection(const DocumentConnection& connection) {
        if (!isConnectable(connection.source) || !isConnectable(connection.destination))
            return;
        const bool betweenObjects = connection.sourceProperty.empty() && connection.destinationProperty.empty();
        // The attribute is inside.
        const DocumentObject* held = mLayout.attributeOf(connection.destination);
        if (betweenObjects && held && held->id == connection.source)
            return;
        const std::span<const std::int64_t> holders = mLayout.holdersOf(connection.destination);
        if (!betweenObjects || holders.empty()) {
            writeEnds(connection, connection.destination);
            return;
        }
        // What deforms an attribute deforms the Models that hold it.
        for (const std::int64_t holder : holders)
            writeEnds(connection, holder);
    }

    void writeEnds(const DocumentConnection& connection, std::int64_t destination) {
        const bool fromProperty = !connection.sourceProperty.empty();
        const bool toProperty = !connection.destinationProperty.empty();
        const LegacyName from = mLayout.nameOf(connection.source);
        const LegacyName to = mLayout.nameOf(destination);
        mSink.beginRecord("Connect");
        mSink.text(fromProperty ? (toProperty ? "PP" : "PO") : (toProperty ? "OP" : "OO"));
        mSink.objectName(from.nameClass, from.name);
        if (fromProperty)
            mSink.text(connection.sourceProperty);
        mSink.objectName(to.nameClass, to.name);
        if (toProperty)
            mSink.text(connection.destinationProperty);
        mSink.endRecord();
    }

    void writeSettings() {
        mSink.heading("Version 5 settings");
        const BlockScope block(mSink, "Version5");
        writeAmbient();
        writeFog();
        writeTimeSettings();
        const BlockScope renderer(mSink, "RendererSetting");
        writeText(mSink, "DefaultCamera", setting("DefaultCamera").toText());
        writeInteger(mSink, "DefaultViewingMode", 0);
    }

    void writeAmbient() {
        const BlockScope block(mSink, "AmbientRenderSettings");
        writeInteger(mSink, "Version", 101);
        writeColor("AmbientLightColor", mDocument.lightSettings.ambientColor);
    }

    void writeFog() {
        const DocumentLightSettings& settings = mDocument.lightSettings;
        const BlockScope block(mSink, "FogOptions");
        writeInteger(mSink, "FlogEnable", settings.fogEnable ? 1 : 0); // kept: the applications spell it so
        writeInteger(mSink, "FogMode", settings.fogMode);
        writeReal(mSink, "FogDensity", settings.fogDensity);
        writeReal(mSink, "FogStart", settings.fogStart);
        writeReal(mSink, "FogEnd", settings.fogEnd);
        writeColor("FogColor", settings.fogColor);
    }

    void writeColor(std::string_view name, const double (&color)[4]) {
        writeReals(mSink, name, {color[0], color[1], color[2], color[3]});
    }

    void writeTimeSettings() {
        const BlockScope block(mSink, "Settings");
        writeText(mSink, "FrameRate", frameRate());
        writeInteger(mSink, "TimeFormat", 1);
        writeInteger(mSink, "SnapOnFrames", 0);
        writeInteger(mSink, "ReferenceTimeIndex", -1);
        writeLong(mSink, "TimeLineStartTime", setting("TimeSpanStart").toInteger());
        writeLong(mSink, "TimeLineStopTime", setting("TimeSpanStop").toInteger());
    }

    /// The second way in which files state it.
    [[nodiscard]] std::string frameRate() const {
        const std::int64_t mode = setting("TimeMode").toInteger();
        for (const LegacyRateRow& rate : kLegacyRates)
            if (rate.timeMode == mode)
                return std::string(rate.framesPerSecond);
        return std::to_string(setting("CustomFrameRate").toReal());
    }

    [[nodiscard]] Value setting(std::string_view name) const {
        const DocumentProperty* property = findProperty(mDocument.globalSettings, name);
        return property && !property->values.empty() ? property->values.front() : Value();
    }

    const Document& mDocument;
    const VersionTraits& mTraits;
    RecordSink& mSink;
    LegacyLayout mLayout;
    WrittenLines mLines;                  ///< of the object that is being written
    std::vector<LineWriter> mLineWriters; ///< one for each subclass
};

} // namespace

void writeGeneration6(const Document& document, const VersionTraits& traits, RecordSink& sink) {
    Generation6Writer(document, traits, sink).write();
}

} // namespace detail
FBXSDK_NAMESPACE_END
