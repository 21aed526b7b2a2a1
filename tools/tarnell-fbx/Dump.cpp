// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// tarnell-fbx dump: the library's value objects as JSON.
#include <algorithm>
#include <bit>
#include <cmath>
#include <cstdint>
#include <functional>
#include <iostream>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <tuple>
#include <type_traits>
#include <utility>
#include <vector>

#include "Commands.h"
#include "FileFacts.h"
#include "FloatText.h"
#include "JsonWriter.h"
#include "StandardInput.h"

#include "Fbx.h"
#include "FbxFaithful.h"
#include "FbxSdk.h"
#include "TnFbxCamera.h"
#include "TnFbxError.h"
#include "TnFbxLight.h"
#include "TnFbxMarker.h"
#include "TnFbxMesh.h"
#include "TnFbxNull.h"
#include "TnFbxReadInfo.h"

namespace tool {
namespace {

using namespace Tarnell::Fbx;

/// Prints the parts of objects.
class ObjectPrinter {
public:
    ObjectPrinter(JsonWriter& json, bool samples) : mJson(json), mSamples(samples) {}

    void enumerator(const char* key, std::initializer_list<const char*> names, int value) {
        mJson.key(key);
        const auto index = static_cast<std::size_t>(value);
        mJson.text(index < names.size() ? names.begin()[index] : "");
    }

    void number(const char* key, float value) {
        mJson.key(key);
        mJson.real(value);
    }

    void transform(TnFbxTransform& object) {
        static const JsonKey kName("name");
        mJson.key(kName);
        mJson.text(object.getName());
        enumerator("rotationOrder", {"XYZ", "XZY", "YXZ", "YZX", "ZXY", "ZYX"}, object.getTransformRotationOrder());
        print<TnFbxTransform::EFbxTransformChannelType>(
            "transform", TnFbxTransform::getTransformChannelName,
            [&](auto channel) -> const TnFbxChannel& { return *object.getTransformChannel(channel); });
    }

    /// All channels of a class with named channels of its own.
    template <class Object, class Channel, class Find>
    void channels(const Find& find) {
        print<Channel>(
            "channels", [](auto channel) { return Object::getChannelName(channel); }, find);
    }

    void details(TnFbxCamera& camera) {
        enumerator("projection", {"perspective", "orthographic"}, camera.getProjectionType());
        enumerator("apertureMode", {"horizontalAndVertical", "horizontal", "vertical", "focalLength"},
                   camera.getApertureMode());
        channels<TnFbxCamera, TnFbxCamera::EFbxCameraChannelType>(
            [&](auto channel) -> const TnFbxChannel& { return *camera.getCameraChannel(channel); });
    }
    void details(TnFbxLight& light) {
        enumerator("type", {"point", "directional", "spot"}, light.getLightType());
        enumerator("decay", {"none", "linear", "quadratic", "cubic"}, light.getDecayType());
        channels<TnFbxLight, TnFbxLight::EFbxLightChannelType>(
            [&](auto channel) -> const TnFbxChannel& { return *light.getLightChannel(channel); });
    }
    void details(TnFbxMarker& marker) {
        number("size", marker.getMarkerSize());
        enumerator("look", {"cube", "hardCross", "lightCross", "sphere"}, marker.getMarkerLookType());
        channels<TnFbxMarker, TnFbxMarker::EFbxMarkerChannelType>(
            [&](auto channel) { return copyOf(marker, channel); });
    }
    void details(TnFbxNull& null) {
        number("size", null.getNullSize());
        enumerator("look", {"none", "cross"}, null.getNullLookType());
    }
    void details(TnFbxTransform&) {}
    void details(TnFbxMesh& mesh) {
        const int corners = mesh.getNumberOfPolygonVertices();
        integers(
            "polygonVertexSizes", mesh.getNumberOfPolygons(), [&](int i) { return mesh.getPolygonVertexSize(i); });
        integers(
            "pointIndices", corners, [&](int i) { return mesh.getPointIndex(i); });
        reals(
            "controlPoints", true, mesh.getNumberOfControlPoints(), 3,
            [&](int i, float* v) { mesh.getControlPoint(i, v[0], v[1], v[2]); });
        reals(
            "normals", mesh.getValidNormals(), corners, 3,
            [&](int i, float* v) { mesh.getNormal(i, v[0], v[1], v[2]); });
        reals(
            "uvs", mesh.getValidUVs(), corners, 2, [&](int i, float* v) { mesh.getUV(i, v[0], v[1]); });
        reals("colours", mesh.getValidColours(), corners, 4,
              [&](int i, float* v) { mesh.getColour(i, v[0], v[1], v[2], v[3]); });
    }

private:
    /// All that determines the text of a channel whose value never changes.
    struct Constant {
        bool animated = false;
        std::uint32_t value = 0, sample = 0, rate = 0; // as bits: 0 and −0 are not the same text
        int start = 0, end = 0;

        bool operator==(const Constant&) const = default;
    };

    /// A channel of a class, and what it was in the last object if that was constant. Most channels of most objects are
    /// those of the object before, and their text is copied.
    struct Member {
        JsonKey key;
        std::optional<Constant> last{};
        std::string text{}; ///< with the key
    };
    /// Those of the class with that type of channels.
    template <class Channel>
    struct Members {
        std::vector<Member> all;
    };

    template <class Channel, class NameOf, class Find>
    void print(const char* key, const NameOf& nameOf, const Find& find) {
        std::vector<Member>& members = std::get<Members<Channel>>(mMembers).all;
        while (const char* name = nameOf(static_cast<Channel>(members.size())))
            members.push_back({JsonKey(name)});
        mJson.key(key);
        mJson.beginObject();
        for (std::size_t i = 0; i < members.size(); ++i)
            print(members[i], find(static_cast<Channel>(i)));
        mJson.endObject();
    }

    void print(Member& member, const TnFbxChannel& channel) {
        const std::optional<Constant> constant = constantOf(channel);
        if (constant && constant == member.last) {
            mJson.repeat(member.text);
            return;
        }
        const JsonWriter::Place place = mJson.place();
        mJson.key(member.key);
        print(channel);
        member.text = constant ? mJson.since(place) : std::string_view();
        member.last = member.text.empty() ? std::nullopt : constant;
    }

    static std::optional<Constant> constantOf(const TnFbxChannel& channel) {
        Constant constant;
        constant.value = std::bit_cast<std::uint32_t>(channel.getValue());
        if (!channel.getAnimated())
            return constant;
        const TnFbxTime time = channel.getTime();
        constant.start = time.getStartFrame();
        constant.end = time.getEndFrame();
        if (!channel.isConstant() || !areExact(constant.start, constant.end))
            return std::nullopt;
        constant.animated = true;
        constant.rate = std::bit_cast<std::uint32_t>(time.getFrameRate());
        constant.sample = std::bit_cast<std::uint32_t>(channel.getAnimatedValue(static_cast<float>(constant.start)));
        return constant;
    }

    /// Beyond, a frame as a float can be another one.
    static bool areExact(long long first, long long last) {
        constexpr long long kMostExact = 1 << 24;
        return first >= -kMostExact && last <= kMostExact;
    }

    /// Markers give no access to their channels.
    static TnFbxChannel copyOf(const TnFbxMarker& marker, TnFbxMarker::EFbxMarkerChannelType channel) {
        TnFbxChannel copy;
        copy.setValue(marker.getValue(channel));
        if (marker.getAnimated(channel)) {
            const TnFbxTime time = marker.getTime(channel);
            std::vector<float> samples;
            for (long long frame = time.getStartFrame(); frame <= time.getEndFrame(); ++frame)
                samples.push_back(marker.getValueAt(channel, static_cast<float>(frame)));
            copy.moveAnimatedValues(time, std::move(samples));
        }
        return copy;
    }

    void print(const TnFbxChannel& channel) {
        if (!channel.getAnimated()) {
            mJson.real(channel.getValue());
            return;
        }
        const TnFbxTime time = channel.getTime();
        static const JsonKey kValue("value"), kStart("start"), kEnd("end"), kRate("rate"), kSamples("samples");
        mJson.beginObject();
        mJson.key(kValue);
        mJson.real(channel.getValue());
        if (mSamples && !mJson.breaksLines() && std::isfinite(time.getFrameRate())) {
            mJson.key(samplesKey(time));
            printSamples(channel, time);
            mJson.endObject();
            return;
        }
        mJson.key(kStart);
        mJson.integer(time.getStartFrame());
        mJson.key(kEnd);
        mJson.integer(time.getEndFrame());
        mJson.key(kRate);
        mJson.real(time.getFrameRate());
        if (mSamples) {
            mJson.key(kSamples);
            printSamples(channel, time);
        }
        mJson.endObject();
    }

    /// The key of the samples, with the span and the rate in front of it: nearly all channels have the same ones.
    const JsonKey& samplesKey(const TnFbxTime& time) {
        const auto isSame = [&](const TnFbxTime& other) {
            return time.getStartFrame() == other.getStartFrame() && time.getEndFrame() == other.getEndFrame() &&
                   std::equal_to<float>()(time.getFrameRate(), other.getFrameRate());
        };
        if (!mSamplesKey || !isSame(mSamplesTime)) {
            char rate[kFloatRoom];
            const std::string_view rateText(rate, writeShortest(rate, time.getFrameRate()));
            mSamplesKey.emplace("samples", "\"start\":" + std::to_string(time.getStartFrame()) +
                                               ",\"end\":" + std::to_string(time.getEndFrame()) +
                                               ",\"rate\":" + std::string(rateText) + ',');
            mSamplesTime = time;
        }
        return *mSamplesKey;
    }

    void printSamples(const TnFbxChannel& channel, const TnFbxTime& time) {
        mJson.beginArray();
        samples(channel, time.getStartFrame(), time.getEndFrame());
        mJson.endArray();
    }

    void samples(const TnFbxChannel& channel, long long first, long long last) {
        if (channel.isConstant() && areExact(first, last)) {
            mJson.reals(channel.getAnimatedValue(static_cast<float>(first)),
                        static_cast<std::size_t>(last - first + 1));
            return;
        }
        for (long long frame = first; frame <= last; ++frame)
            mJson.real(channel.getAnimatedValue(static_cast<float>(frame)));
    }

    template <class At>
    void integers(const char* key, int count, const At& at) {
        mJson.key(key);
        mJson.beginArray();
        for (int i = 0; i < count; ++i)
            mJson.integer(at(i));
        mJson.endArray();
    }

    template <class Fill>
    void reals(const char* key, bool valid, int count, int components, const Fill& fill) {
        mJson.key(key);
        if (!valid) {
            mJson.null();
            return;
        }
        mJson.beginArray();
        for (int i = 0; i < count; ++i) {
            float values[4] = {};
            fill(i, values);
            for (int c = 0; c < components; ++c)
                mJson.real(values[c]);
        }
        mJson.endArray();
    }

    JsonWriter& mJson;
    bool mSamples;
    std::optional<JsonKey> mSamplesKey;
    TnFbxTime mSamplesTime; ///< of the key
    std::tuple<Members<TnFbxTransform::EFbxTransformChannelType>, Members<TnFbxCamera::EFbxCameraChannelType>,
               Members<TnFbxLight::EFbxLightChannelType>, Members<TnFbxMarker::EFbxMarkerChannelType>>
        mMembers;
};

/// One file, loaded once, and all queries to it.
class Dump {
public:
    Dump(const DumpOptions& options, std::ostream& out)
        : mOptions(options), mJson(out, options.pretty), mPrinter(mJson, options.samples) {
        mInfo.setFileName(options.file);
        if (options.faithful) {
            mInfo.setFidelity(kFbxFidelityFaithful);
            mInfo.setAnimationStackName(options.stack);
        } else {
            mInfo.setAnimationStackName("*"); // any name is accepted: the first stack is read
        }
        mInfo.setGlobalTransform(!options.local);
        mInfo.setTransformPoints(options.transformPoints);
        mInfo.setFrame(options.frame);
        mInfo.setComputeCameraRotation(options.computeCameraRotation);
        mInfo.setUseSampleFPS(options.sampleFps.has_value());
        if (options.sampleFps)
            mInfo.setSampleFPS(*options.sampleFps);
        mInfo.setAllObjects(!options.name.has_value());
        if (options.name)
            mInfo.setObjectName(*options.name);
    }

    /// Empty when the file was read, else the reason.
    std::string load() {
        if (mOptions.faithful) {
            const std::string fault = mFacts.load(mOptions.file);
            return fault.empty() && !mReader.load(mInfo) ? lastError() : fault;
        }
        return mFbx.loadScene(mOptions.file, mSdk) ? std::string() : lastError();
    }

    bool print() {
        mJson.beginObject();
        mJson.key("file");
        const std::string file = withoutKeptName(mOptions.file);
        mJson.text(file.substr(file.find_last_of('/') + 1));
        if (mOptions.faithful)
            printFacts();
        printStacks();
        printRange();
        bool complete = true;
        for (const Kind& kind : kinds())
            if (wanted(kind.name))
                complete = kind.print(*this, kind) && complete;
        mJson.endObject();
        return complete;
    }

    /// Whether there is anything of the requested name, of the requested kinds.
    bool finds() {
        const auto isFound = [this](const Kind& kind) {
            const bool isThere = mOptions.faithful ? mFacts.has(kind.name, *mOptions.name) : count(kind) > 0;
            return wanted(kind.name) && isThere;
        };
        return !mOptions.name || std::any_of(kinds().begin(), kinds().end(), isFound);
    }

    struct Kind {
        const char* name;
        int (FbxSdk::*candidates)() const;
        int mask;
        std::function<bool(Dump&, const Kind&)> print;
    };
    static const std::vector<Kind>& kinds();

private:
    [[nodiscard]] bool wanted(const std::string& kind) const {
        const auto& asked = mOptions.kinds;
        return asked.empty() || std::find(asked.begin(), asked.end(), kind) != asked.end();
    }

    void printFacts() {
        mJson.key("unitInCentimetres");
        mJson.real(static_cast<float>(mFacts.unitInCentimetres()));
        mJson.key("axes");
        mJson.text(mFacts.axes());
    }

    /// The additional keys of an object when its values are faithful.
    template <class Object>
    void printSurroundings(const Object& object) {
        const char* const space = mOptions.local ? "parent" : "world";
        mJson.key("parent");
        const std::optional<std::string> parent = mFacts.parentOfNext(object.getName());
        if (parent)
            mJson.text(*parent);
        else
            mJson.null();
        mJson.key("space");
        mJson.text(space);
        if constexpr (std::is_same_v<Object, TnFbxMesh>) {
            mJson.key("pointSpace");
            mJson.text(mOptions.transformPoints ? space : "object");
        }
        if constexpr (std::is_same_v<Object, TnFbxCamera>) {
            mJson.key("producer");
            mJson.boolean(false); // they are not accessible
        }
    }

    void printStacks() {
        std::vector<std::string> names;
        if (mOptions.faithful)
            names = mFacts.stackNames();
        else
            mSdk.getAnimationStackNames(names);
        mJson.key("stacks");
        mJson.beginArray();
        for (const std::string& name : names)
            mJson.text(name);
        mJson.endArray();
    }

    void printRange() {
        float start = 0.0F, end = 0.0F;
        bool animated = false;
        if (!mOptions.faithful) {
            animated = mSdk.getAnimationFrameRange(start, end);
        } else if (const auto range = mFacts.keyedRange(mOptions.stack)) {
            animated = true;
            start = static_cast<float>(range->first);
            end = static_cast<float>(range->second);
        }
        mJson.key("range");
        if (!animated) {
            mJson.null();
            return;
        }
        mJson.beginObject();
        mPrinter.number("start", start);
        mPrinter.number("end", end);
        mJson.endObject();
    }

    int count(const Kind& kind) {
        return mFbx.getNumberOfObjects((mSdk.*kind.candidates)(), mInfo.getAllObjects(), kind.mask,
                                       mInfo.getObjectName(), mSdk);
    }

    /// How the objects of a kind are read when their values are compatible.
    template <class Object>
    using Fill = bool (FbxSdk::*)(TnFbxReadInfo&, Object*, int);

    /// Reads all objects of one kind, or the named one, and passes each to `each`.
    template <class Object, class Each>
    bool read(const Kind& kind, Fill<Object> fill, const Each& each) {
        Object* made = nullptr;
        int number = 0;
        bool complete = true;
        if (mOptions.faithful) {
            complete = mReader.readAll(&made, number);
            mFacts.beginNodes(kind.name);
        } else {
            number = count(kind);
            if (number < 1)
                return true;
            made = new Object[static_cast<std::size_t>(number)];
        }
        const std::unique_ptr<Object[]> objects(made);
        if (!mOptions.faithful)
            complete = (mSdk.*fill)(mInfo, made, number);
        for (int i = 0; i < number; ++i)
            each(objects[static_cast<std::size_t>(i)]);
        return complete;
    }

    template <class Object>
    bool printKind(const Kind& kind, Fill<Object> fill) {
        mJson.key(kind.name);
        mJson.beginArray();
        const bool complete = read<Object>(kind, fill, [&](Object& object) {
            mJson.beginObject();
            mPrinter.transform(object);
            if (mOptions.faithful)
                printSurroundings(object);
            mPrinter.details(object);
            mJson.endObject();
        });
        mJson.endArray();
        return complete;
    }

    bool printMeshes(const Kind& kind) {
        mJson.key(kind.name);
        mJson.beginArray();
        bool complete = true;
        const bool ranged = mOptions.frames.has_value();
        const int first = ranged ? mOptions.frames->first : 0;
        const int last = ranged ? mOptions.frames->second : 0;
        for (long long frame = first; frame <= last; ++frame) {
            const float at = ranged ? static_cast<float>(frame) : mOptions.frame;
            mInfo.setFrame(at);
            if (mOptions.faithful)
                mReader.setFrame(at);
            const auto print = [&](TnFbxMesh& mesh) {
                mJson.beginObject();
                mPrinter.transform(mesh);
                if (mOptions.faithful)
                    printSurroundings(mesh);
                mPrinter.number("frame", at);
                mPrinter.details(mesh);
                mJson.endObject();
            };
            complete = read<TnFbxMesh>(kind, &FbxSdk::getMeshes, print) && complete;
        }
        mInfo.setFrame(mOptions.frame);
        mJson.endArray();
        return complete;
    }

    const DumpOptions& mOptions;
    JsonWriter mJson;
    ObjectPrinter mPrinter;
    TnFbxReadInfo mInfo;
    Tarnell::Fbx::Fbx mFbx;
    FbxSdk mSdk;         // of compatible values
    FileFacts mFacts;    // of faithful ones
    FbxFaithful mReader; // of their values
};

const std::vector<Dump::Kind>& Dump::kinds() {
    static const std::vector<Kind> kKinds = {
        {"cameras", &FbxSdk::getNumberOfCameras, 32,
         [](Dump& d, const Kind& kind) { return d.printKind<TnFbxCamera>(kind, &FbxSdk::getCameras); }},
        {"lights", &FbxSdk::getNumberOfLights, 64,
         [](Dump& d, const Kind& kind) { return d.printKind<TnFbxLight>(kind, &FbxSdk::getLights); }},
        {"markers", &FbxSdk::getNumberOfMarkers, 1,
         [](Dump& d, const Kind& kind) { return d.printKind<TnFbxMarker>(kind, &FbxSdk::getMarkers); }},
        {"nulls", &FbxSdk::getNumberOfNulls, 0x4000,
         [](Dump& d, const Kind& kind) { return d.printKind<TnFbxNull>(kind, &FbxSdk::getNulls); }},
        {"transforms", &FbxSdk::getNumberOfTransforms, 0x4005,
         [](Dump& d, const Kind& kind) { return d.printKind<TnFbxTransform>(kind, &FbxSdk::getTransforms); }},
        {"meshes", &FbxSdk::getNumberOfMeshes, 4, [](Dump& d, const Kind& kind) { return d.printMeshes(kind); }},
    };
    return kKinds;
}

} // namespace

const std::vector<std::string>& dumpKinds() {
    static const std::vector<std::string> kNames = [] {
        std::vector<std::string> names;
        for (const Dump::Kind& kind : Dump::kinds())
            names.emplace_back(kind.name);
        return names;
    }();
    return kNames;
}

int dump(const DumpOptions& options) {
    Dump dump(options, std::cout);
    const std::string fault = dump.load();
    if (!fault.empty()) {
        printError(options.file, fault);
        return kUnreadable;
    }
    if (!dump.finds()) {
        printError(options.file, "there is no object \"" + *options.name + "\" of the requested kinds");
        return kUnreadable;
    }
    const bool complete = dump.print();
    std::cout << '\n' << std::flush;
    if (!complete || !std::cout) {
        printError(options.file, complete ? "the output could not be written" : lastError());
        return kUnreadable;
    }
    return kSuccess;
}

} // namespace tool
