// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The table of rules, and the traversal for their checks.
#include "LintRules.h"

#include <algorithm>

#include <fbxsdk/extensions/FileFacts.h>

#include "LintChecks.h"

namespace tool {
namespace {

constexpr Severity kNote = Severity::note, kWarning = Severity::warning, kError = Severity::error;

const std::vector<LintRule> kRules = {
    // The file.
    {"not-readable", kError, "The library cannot hand out faithful values of this file, so that no host gets them.",
     "Correct what the message names; often a key or a span is absurdly far out.", notReadable},
    {"repaired", kWarning,
     "The file breaks a rule of the format; other readers may repair it differently, or refuse it.",
     "Save it again in the application it comes from, or with tarnell-fbx convert.", repaired},
    {"old-version", kWarning, "Many programs refuse files before 7.1: assimp, Blender and three.js are among them.",
     "Save it as FBX 2011 or later, or use tarnell-fbx convert --version 2014.", oldVersion},
    {"ascii-encoding", kNote, "Some programs read binary files only: Blender does.",
     "Save it as binary, or use tarnell-fbx convert, where such programs are to read it.", asciiEncoding},
    {"unit-shifts-optics", kWarning,
     "Unit conversion moves places, and programs do not agree on what else: clip planes, ortho widths, focus "
     "distances, "
     "points of interest and light falloff stay behind in some.",
     "Save the file in centimetres, or compare clip planes and ortho width after reading.", unitShiftsOptics},
    {"axes-shift-optics", kWarning,
     "Readers turn cameras and lights into their own axes in different ways, on the node or above it; a turn may be "
     "lost or come twice.",
     "Save the file with Y up, or compare where cameras look after reading.", axesShiftOptics},
    {"left-handed", kWarning,
     "Left-handed scenes are mirrored by some readers and only turned by others, us among them.",
     "Save the file with right-handed axes.", leftHanded},
    {"not-finite", kError, "NaN and infinities spread: one such number makes whatever is computed with it one, too.",
     "Set the value or key again in the application the file comes from.", notFinite},
    // Time.
    {"rate-unstated", kWarning,
     "The file does not say how many frames a second has: each program takes its own default, and keys fall between "
     "its frames.",
     "Set the frame rate of the scene and save again.", rateUnstated},
    {"keys-between-frames", kWarning, "Programs that sample at whole frames miss what such keys say, or move them.",
     "Snap the keys to frames, or bake the animation at the rate of the file.", keysBetweenFrames},
    {"span-differs-from-keys", kWarning,
     "Some programs play the span of the take and cut off keys outside it; others go by the keys.",
     "Set the playback range to the range of the keys, or key the ends of the range.", spanDiffersFromKeys},
    {"take-without-span", kNote, "Programs that go by the span of a take play nothing, or a default of theirs.",
     "Set the playback range and save again.", takeWithoutSpan},
    {"take-without-keys", kNote,
     "A take in which nothing is keyed takes the place of another in programs that read one.",
     "Remove the take, unless its span is wanted.", takeWithoutKeys},
    {"several-takes", kNote, "Many programs read the first take only, or the one that was current.",
     "Pick one where you read (--take), or save each take into a file of its own.", severalTakes},
    {"several-layers", kNote, "Programs that read the base layer only show another animation.",
     "Bake the layers into one.", severalLayers},
    {"rotation-flips", kWarning,
     "An angle that jumps by half a turn or more within a frame turns the long way round wherever something is sampled "
     "between the two: motion blur, other rates, retiming.",
     "Filter the Euler curves, so that each key goes on from the one before.", rotationFlips},
    // Cameras.
    {"lens-out-of-range", kError, "A lens or film of no size gives no angle; readers divide by it.",
     "Set focal length and film back to sizes above zero.", lensOutOfRange},
    {"lens-values-disagree", kWarning,
     "The file states focal length and angles that do not belong together. Who reads the one that is not in force gets "
     "another lens.",
     "Set the values in step, or read what the aperture mode names (tarnell-fbx camera).", lensValuesDisagree},
    {"film-shape-differs", kWarning,
     "Film and picture have different shapes, and the gate fit decides which angle is kept: programs without gate fit "
     "show another cut.",
     "Set the film back to the shape of the picture, or carry the angles of the picture over, not those of the film.",
     filmShapeDiffers},
    {"film-format-disagrees", kNote, "A named film format or a film aspect says something else than the film's size.",
     "Set the format to custom, and the film aspect to width by height.", filmFormatDisagrees},
    {"squeezed-film", kNote, "Anamorphic squeeze enters the horizontal angle in some programs and not in others.",
     "Compare the horizontal angle after reading, or save with a wider film and a squeeze of 1.", squeezedFilm},
    {"film-offset", kNote, "Some programs drop the offset of the film, and the picture shifts: assimp does.",
     "Look at the picture after reading; the shift is the offset by the film width.", filmOffset},
    {"clip-planes", kError, "The near plane is not before the far one, or not before the camera: nothing is seen.",
     "Set the near plane above zero and the far plane beyond it.", clipPlanes},
    {"clip-planes-far-apart", kNote, "With planes this far apart a depth buffer of floats cannot resolve distances.",
     "Move the near plane away from the camera.", clipPlanesFarApart},
    {"camera-scale", kWarning,
     "An uneven or negative scale means nothing to a lens, but mirrors or bends the view where a program inverts the "
     "camera's matrix.",
     "Freeze the scale of the camera and of the groups above it.", cameraScale},
    {"roll-without-target", kNote, "The roll counts for cameras that look at a target; some programs add it to any.",
     "Set the roll to zero, or turn the node.", rollWithoutTarget},
    {"interest-elsewhere", kNote, "Programs that aim cameras at their point of interest will look elsewhere.",
     "Read the rotation of the node, or save a point of interest ahead of the camera.", interestElsewhere},
    {"image-shift-not-read", kWarning,
     "Optical centre, film translation, film roll and pre-scale move or scale the image in the program that wrote "
     "them; most readers, this library among them, leave them out.",
     "Bake them into film offset and film size.", imageShiftNotRead},
    {"no-resolution", kNote,
     "Without a resolution the shape of the picture, and so the gate fit, is the reader's guess.",
     "Set the resolution of the render and save again.", noResolution},
    // Placement.
    {"far-from-origin", kWarning,
     "Floats this far out are so coarse that things jitter and seams open; hosts keep places as floats.",
     "Move the scene to the origin, and keep the offset apart.", farFromOrigin},
    {"mesh-at-origin", kWarning,
     "Compatible reading takes the matrix of a node at the origin apart in another order, and bakes its mesh turned "
     "otherwise.",
     "Read faithfully (kFbxFidelityFaithful, dump --faithful), or move the mesh by a tiny distance.", meshAtOrigin},
    {"zero-scale", kError, "A scale of zero has no inverse: objects below the node lose their own placement.",
     "Hide the node by its visibility.", zeroScale},
    {"mirrored-node", kNote, "A mirrored mesh turns inside out in programs that do not turn its polygons round.",
     "Freeze the negative scale, with normals reversed.", mirroredNode},
    {"sheared-node", kWarning, "Position, rotation and scale cannot express a shear: many programs lose it.",
     "Freeze the scale of the groups above.", shearedNode},
    {"inherited-scale", kWarning, "How the parent's scale is inherited is a setting that most programs do not read.",
     "Freeze the parent's scale.", inheritedScale},
    // Names and structure.
    {"duplicate-names", kWarning, "Hosts find nodes by name, and always find the first one.",
     "Give each node a name of its own.", duplicateNames},
    {"unnamed-nodes", kNote, "A node without a name cannot be found by name.", "Name it.", unnamedNodes},
    {"odd-names", kWarning, "Control characters and broken UTF-8 in names get lost or stop other readers.",
     "Rename the node.", oddNames},
    {"constraints", kWarning, "Constraints are not evaluated: what they drive reads as it was keyed or left.",
     "Bake the constrained nodes before saving.", constraints},
    {"curve-that-stops-three-js", kWarning,
     "three.js fails on a whole file because of one curve on a light's colour or a camera's film offset.",
     "Remove the curve from the copy for three.js.", curveThatStopsThreeJs},
    // Meshes.
    {"polygons-out-of-range", kError,
     "Polygons refer to points that do not exist: readers drop them, or the mesh, or crash.",
     "Clean the mesh up and save again.", polygonsOutOfRange},
    {"small-polygons", kNote, "Polygons of one or two corners have no area and no normal.", "Clean the mesh up.",
     smallPolygons},
    {"mesh-without-polygons", kNote, "Points alone show in few programs.", "Delete the mesh, or use a null.",
     meshWithoutPolygons},
    {"mesh-without-normals", kNote, "Each program makes normals of its own, smooth or faceted.",
     "Save with normals (smoothing groups alone are not enough).", meshWithoutNormals},
    {"cache-missing", kError, "The mesh shows undeformed: the files of its point cache are not there.",
     "Copy the folder with the cache along, beside the FBX file.", cacheMissing},
    {"cache-foreign-path", kWarning,
     "The path of the point cache is that of another machine; programs that go by it miss it.",
     "Keep the cache in the folder beside the FBX file, with a relative path.", cacheForeignPath},
    {"cache-unusable", kError,
     "The mesh shows undeformed: its point cache does not fit it, is corrupt, or is switched off.",
     "Write the cache again from this mesh; tarnell-fbx cache --verify says where it breaks.", cacheUnusable},
    {"cache-range", kWarning, "Outside of the cache's samples the mesh stands still while the rest moves.",
     "Write the cache over the whole take.", cacheRange},
    {"cache-rate", kWarning, "Cache and file have different rates: samples fall between frames.",
     "Write the cache at the rate of the file.", cacheRate}};

void addChannels(LintContext& context, FbxAnimStack* take) {
    for (const FbxObject* object : context.objects) {
        for (const FbxProperty& property : propertiesOf(*object)) {
            for (Channel& channel : channelsOf(property, take)) {
                if (!channel.curves.empty())
                    context.channels.push_back({object, std::move(channel)});
            }
        }
    }
}

LintContext contextOf(const std::string& file, const SceneFile& opened) {
    LintContext context{file, opened, {}, {}, {}, {}, {}, {}, {}, {}, {}};
    FbxScene& scene = opened.scene();
    for (int i = 0; i < scene.GetSrcObjectCount<FbxAnimStack>(); ++i) {
        context.stacks.push_back(scene.GetSrcObject<FbxAnimStack>(i));
        context.takes.push_back(takeFacts(opened, context.stacks.back()));
    }
    FbxAnimStack* take = context.stacks.empty() ? nullptr : context.stacks.front();
    context.first = takeFacts(opened, take);
    context.nodes = nodesInOrder(scene);
    context.objects = extensions::objectsOf(scene);
    for (FbxObject* object : context.objects) {
        if (auto* mesh = FbxCast<FbxMesh>(object))
            context.meshes.push_back(mesh);
    }
    addChannels(context, take);
    try {
        context.cameras = camerasOf(file, opened, "");
    } catch (const Unreadable& reason) {
        context.unreadable = reason.what();
    }
    return context;
}

} // namespace

const char* severityName(Severity severity) {
    constexpr const char* kNames[] = {"note", "warning", "error"};
    return kNames[static_cast<std::size_t>(severity)];
}

const std::vector<LintRule>& lintRules() { return kRules; }

std::string nameOf(const FbxObject& object) {
    const auto* attribute = FbxCast<FbxNodeAttribute>(&object);
    return attribute && attribute->GetNodeCount() > 0 ? attribute->GetNode(0)->GetName() : object.GetName();
}

void forEachObjectRecord(const std::string& file, const std::function<void(const extensions::FileRecord&)>& work) {
    FbxStatus status;
    const auto records = extensions::RecordFile::open(file.c_str(), status);
    if (!records)
        throw Unreadable(status.GetErrorString());
    for (extensions::FileRecord top = records->first(); top; top = top.nextSibling()) {
        work(top); // before 6.0 objects are at the top level
        for (extensions::FileRecord record = top.firstChild(); top.name() == "Objects" && record;
             record = record.nextSibling())
            work(record);
    }
}

FbxAMatrix LintContext::worldOf(FbxNode& node) const {
    FbxTime time;
    time.SetSecondDouble(static_cast<double>(first.firstFrame) / first.frameRate);
    return node.EvaluateGlobalTransform(time);
}

std::vector<Finding> lintFindings(const std::string& file, const SceneFile& opened,
                                  const std::vector<std::string>& ids) {
    const LintContext context = contextOf(file, opened);
    LintReport report;
    for (const LintRule& rule : kRules) {
        if (!ids.empty() && std::find(ids.begin(), ids.end(), rule.id) == ids.end())
            continue;
        report.rule = &rule;
        rule.check(context, report);
    }
    return std::move(report.findings);
}

} // namespace tool
