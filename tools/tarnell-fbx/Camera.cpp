// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx camera: the cameras of a file, as text, as a table of frames, and as JSON.
#include <cmath>
#include <iostream>

#include "CameraFacts.h"
#include "CameraOrigins.h"
#include "Commands.h"
#include "Csv.h"
#include "Lines.h"
#include "SceneFacts.h"
#include "SceneQueries.h"
#include "ShowFiles.h"
#include "StandardInput.h"
#include "Table.h"
#include "TerminalText.h"

namespace tool {
namespace {

struct Range {
    long long first, last;
};

/// The requested frames, or those of the take. Throws Unreadable where the take does not have all of them, or where
/// there are too many to print.
Range rangeOf(const CameraList& list, const CameraOptions& options) {
    Range range{list.take.firstFrame, list.take.lastFrame};
    if (options.frames) {
        const Range asked{options.frames->first, options.frames->second};
        if (list.take.exists && (asked.first < range.first || asked.last > range.last))
            throw Unreadable("frames " + std::to_string(asked.first) + " to " + std::to_string(asked.last) +
                             " were requested, but the take has " + std::to_string(range.first) + " to " +
                             std::to_string(range.last));
        range = asked;
    }
    constexpr long long kMostFrames = 1 << 20;
    const bool printsAll = options.frames || options.form == Form::csv;
    if (printsAll && range.last - range.first >= kMostFrames)
        throw Unreadable("frames " + std::to_string(range.first) + " to " + std::to_string(range.last) +
                         " are too many to print; select some with --frames A:B");
    return range;
}

void keepNamed(CameraList& list, const std::string& name) {
    if (name.empty())
        return;
    std::string known;
    for (const CameraFacts& camera : list.cameras)
        known += (known.empty() ? "" : ", ") + inQuotes(camera.name);
    std::erase_if(list.cameras, [&](const CameraFacts& camera) { return camera.name != name; });
    if (list.cameras.empty())
        throw Unreadable("there is no camera " + inQuotes(name) + "; cameras: " + (known.empty() ? "none" : known));
}

// ---- Text ----

std::string degrees(double x, double y) { return inDecimals(x, 3) + "° × " + inDecimals(y, 3) + "°"; }

std::string filmBackText(const CameraFacts& camera, const CameraMoment& moment) {
    std::string text = filmText(moment.film) + " = " + inDecimals(moment.film.width * kMillimetresPerInch, 2) + " × " +
                       inDecimals(moment.film.height * kMillimetresPerInch, 2) + " mm, " +
                       rounded(moment.film.aspect(), 4) + ":1";
    if (camera.squeeze != 1.0)
        text += ", squeezed by " + rounded(camera.squeeze, 4) + " into " +
                significant(moment.film.width / camera.squeeze, 6) + " in";
    return camera.gate.empty() ? text : text + ", " + camera.gate;
}

std::string pictureText(const CameraFacts& camera, const CameraMoment& moment) {
    if (camera.pictureAspect <= 0.0)
        return "none: the picture is the film";
    std::string text = camera.resolutionStated ? "" : "not stated, the format assumes ";
    text += rounded(camera.resolution[0], 3) + " × " + rounded(camera.resolution[1], 3);
    if (camera.pixelAspect != 1.0)
        text += ", pixels " + rounded(camera.pixelAspect, 4) + ":1";
    if (camera.orthographic)
        return text;
    return text + "; gate fit " + gateFitName(camera.gateFit) + " → " + degrees(moment.pictureFovX, moment.pictureFovY);
}

void printTitle(const CameraFacts& camera, std::ostream& out, const Terminal& terminal) {
    out << terminal.paint(Ink::name, terminalText(camera.name)) << "  " << (camera.stereo ? "stereo, " : "")
        << (camera.orthographic ? "orthographic"
                                : std::string("perspective, lens driven by ") + driverText(camera.driver))
        << ", " << (camera.moves ? "moves" : "static") << (camera.lensChanges ? ", lens changes" : "") << '\n';
}

void printLens(const CameraFacts& camera, const CameraMoment& moment, Lines& lines) {
    if (camera.orthographic)
        lines.line("Ortho width", rounded(camera.ortho->width, 4) + " cm");
    else
        lines.line("Focal length", significant(moment.focalLength, 6) + " mm");
    lines.line("Film back", filmBackText(camera, moment));
    if (!camera.orthographic)
        lines.line("FOV of film", degrees(moment.fovX, moment.fovY));
    lines.line("Resolution", pictureText(camera, moment));
    if (moment.offsetX != 0.0 || moment.offsetY != 0.0)
        lines.line("Film offset", rounded(moment.offsetX, 6) + " × " + rounded(moment.offsetY, 6) +
                                      " in = " + rounded(moment.offsetX * kMillimetresPerInch, 3) + " × " +
                                      rounded(moment.offsetY * kMillimetresPerInch, 3) + " mm");
    lines.line("Clip planes", significant(moment.nearPlane, 6) + " to " + significant(moment.farPlane, 6) + " cm");
}

void printPlace(const CameraFacts& camera, const CameraMoment& moment, Lines& lines) {
    lines.line("World", vectorText(moment.position, 3) + " cm, looks " + vectorText(moment.direction, 3));
    const std::string there =
        vectorText(moment.interest, 3) + " cm, " + rounded(moment.interestDistance(), 3) + " cm away";
    if (camera.hasTarget) {
        lines.line("Target", inQuotes(camera.target) + " at " + there);
        lines.line("Roll", rounded(moment.roll, 4) + "°");
    } else {
        lines.line("Interest", there + (moment.looksAtInterest() ? "" : ", not in the viewing direction"));
    }
    constexpr double kTolerance = 1e-4;
    const Vector3& scale = camera.scale;
    if (std::abs(scale[0] - 1.0) > kTolerance || std::abs(scale[1] - 1.0) > kTolerance ||
        std::abs(scale[2] - 1.0) > kTolerance)
        lines.line("Scale", vectorText(scale, 4) + ", without effect on the view");
    if (camera.hasTarget)
        return;
    const auto turn = [&](const char* label, const Vector3& angles) {
        if (camera.rotationActive && angles != Vector3{})
            lines.line(label, vectorText(angles, 3) + ": rotation 0 looks along " + camera.restDirection);
    };
    turn("Pre-rotation", camera.preRotation);
    turn("Post-rotation", camera.postRotation);
    if (!camera.rotationActive || (camera.preRotation == Vector3{} && camera.postRotation == Vector3{}))
        lines.line("Post-rotation", "none: rotation 0 looks along " + camera.restDirection);
}

void printIdle(const CameraFacts& camera, std::ostream& out, const Terminal& terminal) {
    if (camera.idle.empty())
        return;
    std::string text;
    for (const IdleValue& idle : camera.idle)
        text += (text.empty() ? "" : ", ") + idle.property + ' ' + idle.shortValue;
    out << "  " << terminal.paint(Ink::faint, "In the file, not in force:") << ' ' << terminalText(text) << '\n';
}

void printChannels(const CameraFacts& camera, std::ostream& out, const Terminal& terminal) {
    if (camera.movedBy)
        out << "  " << terminal.paint(Ink::faint, "Animated ancestor") << ' ' << inQuotes(*camera.movedBy) << '\n';
    Table table({{"Keys, as in the file"},
                 {"Count", Table::Align::right},
                 {"First frame", Table::Align::right},
                 {"Last frame", Table::Align::right},
                 {"Minimum", Table::Align::right, Ink::number},
                 {"Maximum", Table::Align::right, Ink::number},
                 {"Remarks"}});
    for (const CameraChannel& channel : camera.channels)
        table.addRow({terminalText(channel.property), std::to_string(channel.keys), rounded(channel.firstFrame, 3),
                      rounded(channel.lastFrame, 3), rounded(channel.low, 6), rounded(channel.high, 6),
                      channel.inForce ? "" : "not in force"});
    if (!table.empty())
        table.print(out, terminal, 2);
}

void printFrames(const CameraFacts& camera, const Range& range, std::ostream& out, const Terminal& terminal) {
    std::vector<Table::Column> columns;
    for (const char* title : {"Frame", "Lens mm", "FOV of picture", "X cm", "Y cm", "Z cm", "Looks X", "Y", "Z"})
        columns.push_back({title, Table::Align::right, columns.empty() ? Ink::plain : Ink::number});
    Table table(columns);
    for (long long frame = range.first; frame <= range.last; ++frame) {
        const CameraMoment moment = camera.at(static_cast<double>(frame));
        table.addRow({std::to_string(frame), significant(moment.focalLength, 6),
                      degrees(moment.pictureFovX, moment.pictureFovY), rounded(moment.position[0], 3),
                      rounded(moment.position[1], 3), rounded(moment.position[2], 3), rounded(moment.direction[0], 4),
                      rounded(moment.direction[1], 4), rounded(moment.direction[2], 4)});
    }
    table.print(out, terminal, 2);
}

void printOrigins(const CameraFacts& camera, std::ostream& out, const Terminal& terminal) {
    out << "  Derivation\n";
    const auto line = [&](const std::string& what, const std::string& text) {
        out << "    " << terminal.paint(Ink::faint, terminalText(what)) << ": " << terminalText(text) << '\n';
    };
    for (const Origin& origin : camera.origins)
        line(origin.what, origin.text);
    for (const IdleValue& idle : camera.idle)
        line(idle.property + ' ' + idle.shortValue, "not in force, " + idle.reason);
}

void printCamera(const CameraFacts& camera, const CameraOptions& options, const Range& range, std::ostream& out,
                 const Terminal& terminal) {
    const CameraMoment moment = camera.at(static_cast<double>(range.first));
    printTitle(camera, out, terminal);
    Lines lines(out, terminal);
    printLens(camera, moment, lines);
    printPlace(camera, moment, lines);
    printIdle(camera, out, terminal);
    printChannels(camera, out, terminal);
    if (options.explain)
        printOrigins(camera, out, terminal);
    if (options.frames)
        printFrames(camera, range, out, terminal);
}

std::string takeText(const TakeFacts& take) {
    const std::string rate = rateText(take.frameRate);
    if (!take.exists)
        return "no take, " + rate;
    return "take " + inQuotes(take.name) + ", frames " + std::to_string(take.firstFrame) + " to " +
           std::to_string(take.lastFrame) + ", " + rate;
}

void printText(const CameraList& list, const CameraOptions& options, const Range& range, Page& page) {
    std::ostream& out = page.begin();
    out << page.terminal().paint(Ink::heading, spoken(page.file())) << "  " << takeText(list.take) << '\n';
    if (list.cameras.empty()) {
        out << "No cameras.\n";
        return;
    }
    out << "Faithful values at frame " << range.first
        << ", in centimetres and Y up. The file's unit: " << unitName(list.unit) << "; its axes: " << list.axes
        << ".\n";
    for (const CameraFacts& camera : list.cameras) {
        out << '\n';
        printCamera(camera, options, range, out, page.terminal());
    }
    for (const std::string& warning : list.warnings)
        out << "\n" << page.terminal().paint(Ink::warning, "Warning: " + terminalText(warning)) << '\n';
}

// ---- JSON ----

/// Values are floats of the library, printed with the digits of floats.
void number(JsonWriter& json, std::string_view key, double value) {
    json.key(key);
    json.real(static_cast<float>(value));
}

void numbers(JsonWriter& json, std::string_view key, std::initializer_list<double> values) {
    json.key(key);
    json.beginArray();
    for (const double value : values)
        json.real(static_cast<float>(value));
    json.endArray();
}

void vector(JsonWriter& json, std::string_view key, const Vector3& values) {
    numbers(json, key, {values[0], values[1], values[2]});
}

void printMoment(const CameraMoment& moment, JsonWriter& json) {
    json.beginObject();
    json.real("frame", moment.frame);
    json.real("seconds", moment.seconds);
    number(json, "focalLength", moment.focalLength);
    numbers(json, "film", {moment.film.width, moment.film.height});
    numbers(json, "fov", {moment.fovX, moment.fovY});
    numbers(json, "picture", {moment.picture.width, moment.picture.height});
    numbers(json, "pictureFov", {moment.pictureFovX, moment.pictureFovY});
    numbers(json, "filmOffset", {moment.offsetX, moment.offsetY});
    numbers(json, "planes", {moment.nearPlane, moment.farPlane});
    number(json, "roll", moment.roll);
    vector(json, "position", moment.position);
    vector(json, "direction", moment.direction);
    vector(json, "up", moment.up);
    vector(json, "interest", moment.interest);
    json.endObject();
}

void textOrNull(JsonWriter& json, std::string_view key, const std::string& text, bool isThere) {
    json.key(key);
    if (isThere)
        json.text(text);
    else
        json.null();
}

const char* driverKey(LensDriver driver) {
    constexpr const char* kKeys[] = {"focalLength", "horizontalAngle", "verticalAngle", "twoAngles"};
    return kKeys[static_cast<std::size_t>(driver)];
}

void printOptics(const CameraFacts& camera, JsonWriter& json) {
    json.text("projection", camera.orthographic ? "orthographic" : "perspective");
    json.boolean("stereo", camera.stereo);
    json.text("drivenBy", driverKey(camera.driver));
    json.boolean("moves", camera.moves);
    json.boolean("lensChanges", camera.lensChanges);
    textOrNull(json, "gate", camera.gate, !camera.gate.empty());
    json.real("squeeze", camera.squeeze);
    json.key("ortho");
    if (camera.ortho) {
        json.beginObject();
        json.real("zoom", camera.ortho->zoom);
        json.real("width", camera.ortho->width);
        json.endObject();
    } else {
        json.null();
    }
    json.key("resolution");
    json.beginObject();
    json.real("width", camera.resolution[0]);
    json.real("height", camera.resolution[1]);
    json.boolean("stated", camera.resolutionStated);
    json.real("pixelAspect", camera.pixelAspect);
    json.integer("mode", camera.aspectMode);
    json.real("aspect", camera.pictureAspect);
    json.endObject();
    json.text("gateFit", gateFitName(camera.gateFit));
}

void printSpace(const CameraFacts& camera, JsonWriter& json) {
    vector(json, "scale", camera.scale);
    textOrNull(json, "target", camera.target, camera.hasTarget);
    vector(json, "preRotation", camera.preRotation);
    vector(json, "postRotation", camera.postRotation);
    json.boolean("rotationActive", camera.rotationActive);
    json.text("restDirection", camera.restDirection);
    textOrNull(json, "movedBy", camera.movedBy.value_or(""), camera.movedBy.has_value());
}

void printChannels(const CameraFacts& camera, JsonWriter& json) {
    json.key("channels");
    json.beginArray();
    for (const CameraChannel& channel : camera.channels) {
        json.beginObject();
        json.text("property", channel.property);
        json.boolean("inForce", channel.inForce);
        json.integer("keys", channel.keys);
        json.real("firstFrame", channel.firstFrame);
        json.real("lastFrame", channel.lastFrame);
        json.real("least", channel.low);
        json.real("most", channel.high);
        json.endObject();
    }
    json.endArray();
}

void printReasons(const CameraFacts& camera, bool explain, JsonWriter& json) {
    json.key("notInForce");
    json.beginArray();
    for (const IdleValue& idle : camera.idle) {
        json.beginObject();
        json.text("property", idle.property);
        json.text("value", idle.value);
        json.text("reason", idle.reason);
        json.endObject();
    }
    json.endArray();
    json.key("origins");
    if (!explain) {
        json.null();
        return;
    }
    json.beginArray();
    for (const Origin& origin : camera.origins) {
        json.beginObject();
        json.text("what", origin.what);
        json.text("text", origin.text);
        json.endObject();
    }
    json.endArray();
}

void printCamera(const CameraFacts& camera, const CameraOptions& options, const Range& range, bool hasIds,
                 JsonWriter& json) {
    json.beginObject();
    json.text("name", camera.name);
    printId(*camera.node, hasIds, json);
    printOptics(camera, json);
    printSpace(camera, json);
    printChannels(camera, json);
    printReasons(camera, options.explain, json);
    json.key("at");
    printMoment(camera.at(static_cast<double>(range.first)), json);
    json.key("frames");
    if (options.frames) {
        json.beginArray();
        for (long long frame = range.first; frame <= range.last; ++frame)
            printMoment(camera.at(static_cast<double>(frame)), json);
        json.endArray();
    } else {
        json.null();
    }
    json.endObject();
}

void printJson(const CameraList& list, const CameraOptions& options, const Range& range, bool hasIds,
               JsonWriter& json) {
    json.text("values", "faithful");
    textOrNull(json, "take", list.take.name, list.take.exists);
    json.real("frameRate", list.take.frameRate);
    json.integer("firstFrame", list.take.firstFrame);
    json.integer("lastFrame", list.take.lastFrame);
    json.real("unit", list.unit);
    json.text("axes", list.axes);
    json.key("cameras");
    json.beginArray();
    for (const CameraFacts& camera : list.cameras)
        printCamera(camera, options, range, hasIds, json);
    json.endArray();
    json.key("warnings");
    json.beginArray();
    for (const std::string& warning : list.warnings)
        json.text(warning);
    json.endArray();
}

constexpr const char* kCsvTitle =
    "file,camera,frame,seconds,focalLength,filmWidth,filmHeight,fovX,fovY,pictureFovX,pictureFovY,filmOffsetX,"
    "filmOffsetY,near,far,roll,positionX,positionY,positionZ,directionX,directionY,directionZ,upX,upY,upZ,interestX,"
    "interestY,interestZ\n";

void printCsv(const CameraList& list, const Range& range, Page& page) {
    std::ostream& out = page.begin();
    for (const CameraFacts& camera : list.cameras) {
        const std::string begin = csvField(withoutKeptName(page.file())) + ',' + csvField(camera.name) + ',';
        for (long long frame = range.first; frame <= range.last; ++frame) {
            const CameraMoment moment = camera.at(static_cast<double>(frame));
            out << begin << frame << ',' << exactText(moment.seconds);
            for (const double value : {moment.focalLength, moment.film.width, moment.film.height, moment.fovX,
                                       moment.fovY, moment.pictureFovX, moment.pictureFovY, moment.offsetX,
                                       moment.offsetY, moment.nearPlane, moment.farPlane, moment.roll})
                out << ',' << exactText(static_cast<float>(value));
            for (const Vector3& each : {moment.position, moment.direction, moment.up, moment.interest})
                out << ',' << exactText(static_cast<float>(each[0])) << ',' << exactText(static_cast<float>(each[1]))
                    << ',' << exactText(static_cast<float>(each[2]));
            out << '\n';
        }
    }
}

} // namespace

int camera(const CameraOptions& options) {
    if (options.form == Form::csv)
        std::cout << kCsvTitle;
    return showFiles(options, "camera", [&options](Page& page) -> int {
        const SceneFile opened(page.file());
        CameraList list = camerasOf(page.file(), opened, options.take);
        keepNamed(list, options.name);
        const Range range = rangeOf(list, options);
        if (page.isJson())
            page.json("camera", [&](JsonWriter& json) { printJson(list, options, range, opened.hasIds(), json); });
        else if (page.form() == Form::csv)
            printCsv(list, range, page);
        else
            printText(list, options, range, page);
        return kSuccess;
    });
}

} // namespace tool
