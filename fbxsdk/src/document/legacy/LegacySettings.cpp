// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Tables of the settings records.
#include "document/legacy/LegacyRecords.h"

#include <algorithm>
#include <charconv>
#include <cmath>

#include "schema/OldNames.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

bool hasSetting(const Document& document, std::string_view name) {
    return std::any_of(
        document.globalSettings.begin(), document.globalSettings.end(),
        [&](const DocumentProperty& property) { return property.name == name; });
}

void addSetting(DocumentBuilder& builder, const DocumentProperty& setting) {
    if (!hasSetting(builder.document(), setting.name))
        builder.document().globalSettings.push_back(setting);
}

void readReals(const Record& parent, std::string_view name, std::span<double> numbers) {
    const Record* record = parent.child(name);
    if (!record)
        return;
    std::vector<double> found(std::min(record->numberCount(), numbers.size()));
    if (record->readNumbers(found))
        std::copy(found.begin(), found.end(), numbers.begin());
}

void readAmbient(DocumentBuilder& builder, const Record& record) {
    DocumentLightSettings& settings = builder.document().lightSettings;
    settings.hasAmbient = record.child("AmbientLightColor") != nullptr;
    readReals(record, "AmbientLightColor", settings.ambientColor);
}

void readFog(DocumentBuilder& builder, const Record& record) {
    DocumentLightSettings& settings = builder.document().lightSettings;
    settings.hasFog = true;
    // Most writers misspell the name.
    const bool misspelt = record.child("FlogEnable") != nullptr;
    settings.fogEnable = record.childValue(misspelt ? "FlogEnable" : "FogEnable").toInteger() != 0;
    settings.fogMode = static_cast<int>(std::clamp<std::int64_t>(record.childValue("FogMode").toInteger(), 0, 2));
    settings.fogDensity = record.childValue("FogDensity").toReal(settings.fogDensity);
    settings.fogStart = record.childValue("FogStart").toReal(settings.fogStart);
    settings.fogEnd = record.childValue("FogEnd").toReal(settings.fogEnd);
    readReals(record, "FogColor", settings.fogColor);
}

void readRenderer(DocumentBuilder& builder, const Record& record) {
    if (!record.childValue("DefaultCamera").toText().empty())
        addSetting(builder, propertyOf("DefaultCamera", "KString", "", "", record.child("DefaultCamera")->values));
}

/// Frames per second; 0 when the text is no number.
double rateOf(std::string_view text) {
    double rate = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), rate);
    return result.ec == std::errc() ? rate : 0;
}

std::int64_t timeModeOf(double rate) {
    constexpr double kTolerance = 0.005;
    for (const LegacyRateRow& row : kLegacyRates)
        if (row.read && std::abs(rateOf(row.framesPerSecond) - rate) < kTolerance)
            return row.timeMode;
    return kCustomTimeMode;
}

void addFrameRate(DocumentBuilder& builder, double rate) {
    // Each file of these generations has a time mode as well, but in another numbering.
    if (!(rate > 0) || !std::isfinite(rate) || hasSetting(builder.document(), "TimeMode"))
        return;
    const std::int64_t mode = timeModeOf(rate);
    addSetting(builder, propertyOf("TimeMode", "enum", "", "", builder.keep({Value::ofInteger(mode)})));
    if (mode == kCustomTimeMode)
        addSetting(builder, propertyOf("CustomFrameRate", "double", "Number", "", builder.keep({Value::ofReal(rate)})));
}

void readSettings(DocumentBuilder& builder, const Record& record) {
    const Value& rate = record.childValue("FrameRate");
    addFrameRate(builder, rate.isNumber() ? rate.toReal() : rateOf(rate.toText()));
    constexpr std::pair<std::string_view, std::string_view> kTimes[] = {{"TimeLineStartTime", "TimeSpanStart"},
                                                                        {"TimeLineStopTime", "TimeSpanStop"}};
    for (const auto& [recordName, property] : kTimes)
        if (const Value& time = record.childValue(recordName); time.isNumber())
            addSetting(builder, propertyOf(property, "KTime", "Time", "",
                                           builder.keep({Value::ofInteger(builder.ticks(time.toInteger()))})));
}

struct SettingsRow {
    std::string_view name;
    void (*read)(DocumentBuilder&, const Record&);
};
constexpr SettingsRow kSettings[] = {
    {"AmbientRenderSettings", readAmbient},
    {"FogOptions", readFog},
    {"RendererSetting", readRenderer},
    {"Settings", readSettings},
};

} // namespace

void readLegacySettings(DocumentBuilder& builder, const Record& parent) {
    for (const Record& record : parent.children())
        for (const SettingsRow& row : kSettings)
            if (row.name == record.name)
                row.read(builder, record);
}

} // namespace detail
FBXSDK_NAMESPACE_END
