// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Whether files load, and the values that they store: curves, cameras, lights.
#include "Rows.h"
#include "Tolerances.h"

#include <Fbx.h>
#include <TnFbxError.h>

namespace conformance {
namespace {

bool same(const std::vector<double>& actual, const std::vector<double>& expected, double tolerance) {
    if (actual.size() != expected.size())
        return false;
    for (std::size_t i = 0; i < actual.size(); ++i)
        if (!closeTo(actual[i], expected[i], tolerance))
            return false;
    return true;
}

std::string text(const std::vector<double>& values) {
    return values.empty() ? "nothing" : printed(values.data(), values.size());
}

bool isUnknown(const std::vector<double>& values) { return values.size() == 1 && std::isnan(values[0]); }

/// Values by name of one node. A name that only this side has is ignored: the reference omits what the file
/// does not state, this side has the default of the class.
void compareStated(const ReferenceNode& node, const NamedNumbers* actual, const NamedNumbers& expected,
                   Findings& findings) {
    for (const auto& [name, values] : expected) {
        if (isUnknown(values))
            continue;
        const auto found = actual ? actual->find(name) : NamedNumbers::const_iterator{};
        const std::vector<double> read = actual && found != actual->end() ? found->second : std::vector<double>{};
        findings.compare(same(read, values, kStoredTolerance), [&, &name = name, &values = values] {
            return "\"" + node.name + "\" " + name + ": " + text(read) + " instead of " + text(values);
        });
    }
}

} // namespace

void checkLoads(LoadedFile& file, Findings& findings) {
    Tarnell::Fbx::FbxSdk sdk;
    const bool loads = Tarnell::Fbx::Fbx().loadScene(file.file().path.string(), sdk);
    findings.compare(loads == file.reference().loads,
                     [&] { return loads ? "loads, but must be refused" : Tarnell::Fbx::lastError(); });
}

void checkCurves(LoadedFile& file, Findings& findings) {
    for (std::size_t i = 0; i < file.reference().nodes.size(); ++i) {
        const ReferenceNode& node = file.reference().nodes[i];
        const SceneNode* entry = file.nodeOf(i);
        NamedNumbers expected = node.curves;
        if (entry)
            for (const auto& [name, values] : entry->curves)
                expected.try_emplace(name);
        for (const auto& [name, values] : expected) {
            const bool has = entry && entry->curves.contains(name);
            const std::vector<double> actual = has ? entry->curves.at(name) : std::vector<double>{};
            findings.compare(same(actual, values, kEvaluatedTolerance), [&, &name = name, &values = values] {
                return "\"" + node.name + "\" " + name + ": " + text(actual) + " instead of " + text(values);
            });
        }
    }
}

void checkCameras(LoadedFile& file, Findings& findings) {
    for (std::size_t i = 0; i < file.reference().nodes.size(); ++i) {
        const SceneNode* entry = file.nodeOf(i);
        const ReferenceNode& node = file.reference().nodes[i];
        compareStated(node, entry ? &entry->camera : nullptr, node.camera, findings);
    }
}

void checkLights(LoadedFile& file, Findings& findings) {
    for (std::size_t i = 0; i < file.reference().nodes.size(); ++i) {
        const SceneNode* entry = file.nodeOf(i);
        const ReferenceNode& node = file.reference().nodes[i];
        compareStated(node, entry ? &entry->light : nullptr, node.light, findings);
    }
}

} // namespace conformance
