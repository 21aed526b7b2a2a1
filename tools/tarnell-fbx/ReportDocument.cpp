// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The document of one file in a report, described in docs/report.md.
#include <algorithm>
#include <array>

#include "Commands.h"
#include "Info.h"
#include "LintRules.h"
#include "ReportPage.h"
#include "SceneFacts.h"

namespace tool {

using namespace Tarnell::Fbx;

namespace {

/// Of a rule that finds more, the rest are counted.
constexpr int kMostFindings = 20;

class DocumentPrinter {
public:
    DocumentPrinter(const ReportScene& scene, ReportArrays* arrays, JsonWriter& json)
        : mScene(scene), mArrays(arrays), mJson(json) {}

    void frames() {
        const ReportFrames& frames = mScene.frames();
        mJson.key("frames");
        mJson.beginObject();
        mJson.real("rate", frames.rate);
        mJson.integer("first", frames.first);
        mJson.integer("step", frames.step);
        mJson.integer("count", frames.count);
        mJson.endObject();
        mJson.key("shapeFrames");
        mJson.beginArray();
        for (const int place : mScene.shapeFrames())
            mJson.integer(place);
        mJson.endArray();
    }

    void nodes() {
        mJson.key("nodes");
        mJson.beginArray();
        for (const ReportNode& node : mScene.nodes()) {
            mJson.beginObject();
            print(node);
            mJson.endObject();
        }
        mJson.endArray();
    }

    void shapes() {
        mJson.key("meshes");
        mJson.beginArray();
        for (const ReportShape& shape : mScene.shapes()) {
            mJson.beginObject();
            print(shape);
            mJson.endObject();
        }
        mJson.endArray();
    }

    /// The findings of `lint`, rule by rule.
    void findings(const LintFindings& found) {
        const std::vector<Finding>& findings = found.all;
        mJson.key("findings");
        mJson.beginArray();
        for (const LintRule& rule : lintRules()) {
            const auto isIts = [&rule](const Finding& finding) { return finding.rule == &rule; };
            if (std::none_of(findings.begin(), findings.end(), isIts))
                continue;
            mJson.beginObject();
            mJson.text("rule", rule.id);
            mJson.text("severity", severityName(rule.severity));
            mJson.text("reason", rule.reason);
            mJson.text("remedy", rule.remedy);
            mJson.integer("count", std::count_if(findings.begin(), findings.end(), isIts));
            printTexts(rule, found);
            mJson.endObject();
        }
        mJson.endArray();
    }

    void sentences(const char* key, const std::vector<std::string>& sentences) {
        mJson.key(key);
        mJson.beginArray();
        for (const std::string& sentence : sentences)
            mJson.text(sentence);
        mJson.endArray();
    }

private:
    void printTexts(const LintRule& rule, const LintFindings& findings) {
        mJson.key("found");
        mJson.beginArray();
        int left = kMostFindings;
        for (const Finding& finding : findings.all) {
            if (finding.rule != &rule || left-- <= 0)
                continue;
            mJson.beginObject();
            mJson.text("object", finding.object);
            mJson.text("text", finding.sentence(findings.takeCount));
            mJson.endObject();
        }
        mJson.endArray();
    }

    void print(const ReportNode& node) {
        mJson.text("name", node.tree.node->GetName());
        mJson.text("kind", kindOf(*node.tree.node));
        mJson.integer("parent", node.tree.parent);
        constexpr std::array<const char*, 6> kOrders = {"XYZ", "XZY", "YXZ", "YZX", "ZXY", "ZYX"};
        mJson.text("order", kOrders[static_cast<std::size_t>(node.transform->getTransformRotationOrder()) % 6]);
        if (node.mesh >= 0)
            mJson.integer("mesh", node.mesh);
        mJson.key("channels");
        mJson.beginObject();
        for (int i = 0; i <= TnFbxTransform::kFbxTransformSkewZ; ++i) {
            const auto type = static_cast<TnFbxTransform::EFbxTransformChannelType>(i);
            channel(TnFbxTransform::getTransformChannelName(type), *node.transform->getTransformChannel(type));
        }
        if (node.camera)
            channels(*node.camera);
        if (node.light)
            channels(*node.light);
        mJson.endObject();
        if (node.camera)
            print(*node.camera, *node.tree.node);
        if (node.light)
            print(*node.light);
        if (node.null) {
            mJson.real("size", static_cast<double>(node.null->getNullSize()));
            mJson.boolean("hasLook", node.null->getNullLookType() != TnFbxNull::kFbxNullLookNone);
        }
    }

    void channels(TnFbxCamera& camera) {
        // The library's names are misspelt deliberately.
        constexpr struct {
            const char* name;
            TnFbxCamera::EFbxCameraChannelType type;
        } kChannels[] = {{"lookAtX", TnFbxCamera::kFbxCameraLookAtPositionX},
                         {"lookAtY", TnFbxCamera::kFbxCameraLookAtPositionY},
                         {"lookAtZ", TnFbxCamera::kFbxCameraLookAtPositionZ},
                         {"roll", TnFbxCamera::kFbxCameraRoll},
                         {"focalLength", TnFbxCamera::kFbxCameraFocalLength},
                         {"apertureWidth", TnFbxCamera::kFbxCameraApertureWidth},
                         {"apertureHeight", TnFbxCamera::kFbxCameraApertureHeight},
                         {"nearPlane", TnFbxCamera::kFbxCameraNearPlane},
                         {"farPlane", TnFbxCamera::kFbxCameraFarPlane},
                         {"fieldOfViewX", TnFbxCamera::kFbxCameraFieldOfViewX},
                         {"fieldOfViewY", TnFbxCamera::kFbxCameraFieldOfViewY},
                         {"filmOffsetX", TnFbxCamera::kFbxCameraFilmOffsetX},
                         {"filmOffsetY", TnFbxCamera::kFbxCameraFilmOffsetY}};
        for (const auto& each : kChannels)
            channel(each.name, *camera.getCameraChannel(each.type));
    }

    void channels(TnFbxLight& light) {
        constexpr std::array<const char*, 6> kNames = {"red", "green", "blue", "alpha", "intensity", "coneAngle"};
        for (std::size_t i = 0; i < kNames.size(); ++i)
            channel(kNames[i], *light.getLightChannel(static_cast<TnFbxLight::EFbxLightChannelType>(i)));
    }

    /// A number, or the offset of the array of the frames' numbers.
    void channel(const char* name, const TnFbxChannel& channel) {
        mJson.key(name);
        if (!channel.getAnimated()) {
            mJson.real(channel.getValue());
            return;
        }
        const ReportFrames& frames = mScene.frames();
        std::vector<float> samples(static_cast<std::size_t>(frames.count));
        for (std::size_t i = 0; i < samples.size(); ++i)
            samples[i] = channel.getAnimatedValue(static_cast<float>(frames.at(static_cast<int>(i))) /
                                                  static_cast<float>(mScene.sampleStep()));
        if (!mArrays)
            return reals(samples);
        mJson.beginObject();
        mJson.integer("at", static_cast<long long>(mArrays->add(samples)));
        mJson.endObject();
    }

    void reals(const std::vector<float>& numbers) {
        mJson.beginArray();
        for (const float number : numbers)
            mJson.real(number);
        mJson.endArray();
    }

    /// The data of `camera` besides the channels.
    void print(const TnFbxCamera& camera, const FbxNode& node) {
        mJson.key("camera");
        mJson.beginObject();
        mJson.boolean("orthographic", camera.getProjectionType() == TnFbxCamera::kFbxCameraOrthographic);
        if (const CameraFacts* facts = mScene.factsOf(node))
            print(*facts);
        mJson.endObject();
    }

    void print(const CameraFacts& facts) {
        mJson.text("drivenBy", driverText(facts.driver));
        mJson.text("gate", facts.gate);
        mJson.text("gateFit", gateFitName(facts.gateFit));
        mJson.key("resolution");
        mJson.beginArray();
        for (const double side : facts.resolution)
            mJson.real(side);
        mJson.endArray();
        mJson.real("pictureAspect", facts.pictureAspect);
        mJson.real("squeeze", facts.squeeze);
        if (facts.ortho)
            mJson.real("orthoWidth", facts.ortho->width);
        if (facts.hasTarget)
            mJson.text("target", facts.target);
        mJson.text("restDirection", facts.restDirection);
        mJson.key("curves");
        mJson.beginArray();
        for (const CameraChannel& channel : facts.channels)
            mJson.text(channel.property + ": " + std::to_string(channel.keys) + (channel.keys == 1 ? " key" : " keys") +
                       ", frames " + numberText(channel.firstFrame) + " to " + numberText(channel.lastFrame) +
                       (channel.inForce ? "" : ", not in force"));
        mJson.endArray();
        mJson.key("idle");
        mJson.beginArray();
        for (const IdleValue& value : facts.idle)
            mJson.text(value.property + ' ' + value.shortValue + ": " + value.reason);
        mJson.endArray();
        mJson.key("origins");
        mJson.beginArray();
        for (const Origin& origin : facts.origins)
            mJson.text(origin.what + ": " + origin.text);
        mJson.endArray();
    }

    void print(const TnFbxLight& light) {
        constexpr std::array<const char*, 3> kTypes = {"point", "directional", "spot"};
        mJson.text("light", kTypes[static_cast<std::size_t>(light.getLightType()) % kTypes.size()]);
    }

    void print(const ReportShape& shape) {
        mJson.integer("polygons", static_cast<long long>(shape.mesh.polygonCount));
        mJson.integer("points", static_cast<long long>(shape.mesh.pointCount));
        mJson.integer("triangles", static_cast<long long>(shape.mesh.triangleCount));
        mJson.integer("drawnPoints", static_cast<long long>(shape.mesh.kept.size()));
        mJson.integer("drawnTriangles", static_cast<long long>(shape.mesh.triangles.size()));
        if (!mArrays)
            return printArrays(shape);
        const bool isSmall = shape.mesh.kept.size() <= 1U << 16U;
        mJson.integer("indexBytes", isSmall ? 2 : 4);
        mJson.integer("indices", static_cast<long long>(isSmall ? indices<std::uint16_t>(shape.mesh)
                                                                : indices<std::uint32_t>(shape.mesh)));
        mJson.key("sets");
        mJson.beginArray();
        for (const std::vector<Point>& set : shape.sets)
            mJson.integer(static_cast<long long>(mArrays->add(set)));
        mJson.endArray();
    }

    /// Three corners for each triangle, three numbers for each point.
    void printArrays(const ReportShape& shape) {
        mJson.key("corners");
        mJson.beginArray();
        for (const auto& triangle : shape.mesh.triangles)
            for (const auto corner : triangle)
                mJson.integer(static_cast<long long>(corner));
        mJson.endArray();
        mJson.key("sets");
        mJson.beginArray();
        for (const std::vector<Point>& set : shape.sets) {
            mJson.beginArray();
            for (const Point& point : set)
                for (const float coordinate : point)
                    mJson.real(coordinate);
            mJson.endArray();
        }
        mJson.endArray();
    }

    template <class Index>
    std::size_t indices(const ReportMesh& mesh) {
        std::vector<std::array<Index, 3>> narrow;
        narrow.reserve(mesh.triangles.size());
        for (const auto& triangle : mesh.triangles)
            narrow.push_back(
                {static_cast<Index>(triangle[0]), static_cast<Index>(triangle[1]), static_cast<Index>(triangle[2])});
        return mArrays->add(narrow);
    }

    const ReportScene& mScene;
    ReportArrays* mArrays; ///< null: arrays are inline
    JsonWriter& mJson;
};

} // namespace

void printReport(const std::string& file, const ReportScene& scene, ReportArrays* arrays, JsonWriter& json) {
    DocumentPrinter printer(scene, arrays, json);
    json.text("take", scene.take());
    json.key("info");
    json.beginObject();
    printInfo(file, scene.opened(), json);
    json.endObject();
    printer.frames();
    printer.nodes();
    printer.shapes();
    printer.findings(lintFindings(file, scene.opened()));
    printer.sentences("notes", scene.notes());
    printer.sentences("warnings", scene.warnings());
}

} // namespace tool
