// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The table of rules.
#include "LintRules.h"

#include "LintChecks.h"

namespace tool {
namespace {

constexpr Severity kNote = Severity::note, kWarning = Severity::warning, kError = Severity::error;

const std::vector<LintRule> kRules = {
    // The file.
    {"not-readable", kError, "The library cannot hand out faithful values of this file, so that no host gets them.",
     "Correct what the message names; often a key or a span is absurdly far out.", nullptr, notReadable},
    {"repaired", kWarning,
     "The file breaks a rule of the format; other readers may repair it differently, or refuse it.",
     "Save it again in the application it comes from, or with tarnell-fbx convert.", repaired, nullptr},
    {"old-version", kWarning, "Many programs refuse files before 7.1: assimp, Blender and three.js are among them.",
     "Save it as FBX 2011 or later, or use tarnell-fbx convert --version 2014.", oldVersion, nullptr},
    {"ascii-encoding", kNote, "Some programs read binary files only: Blender does.",
     "Save it as binary, or use tarnell-fbx convert, where such programs are to read it.", asciiEncoding, nullptr},
    {"unit-shifts-optics", kWarning,
     "Unit conversion moves places, and programs do not agree on what else: clip planes, ortho widths, focus "
     "distances, "
     "points of interest and light falloff stay behind in some.",
     "Save the file in centimetres, or compare clip planes and ortho width after reading.", unitShiftsOptics, nullptr},
    {"axes-shift-optics", kWarning,
     "Readers turn cameras and lights into their own axes in different ways, on the node or above it; a turn may be "
     "lost or come twice.",
     "Save the file with Y up, or compare where cameras look after reading.", axesShiftOptics, nullptr},
    {"left-handed", kWarning,
     "Left-handed scenes are mirrored by some readers and only turned by others, us among them.",
     "Save the file with right-handed axes.", leftHanded, nullptr},
    {"not-finite", kError, "NaN and infinities spread: one such number makes whatever is computed with it one, too.",
     "Set the value or key again in the application the file comes from.", valuesNotFinite, keysNotFinite},
    // Time.
    {"rate-unstated", kWarning,
     "The file does not say how many frames a second has: each program takes its own default, and keys fall between "
     "its frames.",
     "Set the frame rate of the scene and save again.", rateUnstated, nullptr},
    {"keys-between-frames", kWarning, "Programs that sample at whole frames miss what such keys say, or move them.",
     "Snap the keys to frames, or bake the animation at the rate of the file.", nullptr, keysBetweenFrames},
    {"span-differs-from-keys", kWarning,
     "Some programs play the span of the take and cut off keys outside it; others go by the keys.",
     "Set the playback range to the range of the keys, or key the ends of the range.", spanDiffersFromKeys, nullptr},
    {"take-without-span", kNote, "Programs that go by the span of a take play nothing, or a default of theirs.",
     "Set the playback range and save again.", takeWithoutSpan, nullptr},
    {"take-without-keys", kNote,
     "A take in which nothing is keyed takes the place of another in programs that read one.",
     "Remove the take, unless its span is wanted.", takeWithoutKeys, nullptr},
    {"several-takes", kNote, "Many programs read the first take only, or the one that was current.",
     "Pick one where you read (--take), or save each take into a file of its own.", severalTakes, nullptr},
    {"several-layers", kNote, "Programs that read the base layer only show another animation.",
     "Bake the layers into one.", severalLayers, nullptr},
    {"rotation-flips", kWarning,
     "An angle that jumps by half a turn or more within a frame turns the long way round wherever something is sampled "
     "between the two: motion blur, other rates, retiming.",
     "Filter the Euler curves, so that each key goes on from the one before.", nullptr, rotationFlips},
    // Cameras.
    {"lens-out-of-range", kError, "A lens or film of no size gives no angle; readers divide by it.",
     "Set focal length and film back to sizes above zero.", nullptr, lensOutOfRange},
    {"lens-values-disagree", kWarning,
     "The file states focal length and angles that do not belong together. Who reads the one that is not in force gets "
     "another lens.",
     "Set the values in step, or read what the aperture mode names (tarnell-fbx camera).", nullptr, lensValuesDisagree},
    {"film-shape-differs", kWarning,
     "Film and picture have different shapes, and the gate fit decides which angle is kept: programs without gate fit "
     "show another cut.",
     "Set the film back to the shape of the picture, or carry the angles of the picture over, not those of the film.",
     nullptr, filmShapeDiffers},
    {"film-format-disagrees", kNote, "A named film format or a film aspect says something else than the film's size.",
     "Set the format to custom, and the film aspect to width by height.", filmFormatDisagrees, nullptr},
    {"squeezed-film", kNote, "Anamorphic squeeze enters the horizontal angle in some programs and not in others.",
     "Compare the horizontal angle after reading, or save with a wider film and a squeeze of 1.", squeezedFilm,
     nullptr},
    {"film-offset", kNote, "Some programs drop the offset of the film, and the picture shifts: assimp does.",
     "Look at the picture after reading; the shift is the offset by the film width.", nullptr, filmOffset},
    {"clip-planes", kError, "The near plane is not before the far one, or not before the camera: nothing is seen.",
     "Set the near plane above zero and the far plane beyond it.", nullptr, clipPlanes},
    {"clip-planes-far-apart", kNote, "With planes this far apart a depth buffer of floats cannot resolve distances.",
     "Move the near plane away from the camera.", nullptr, clipPlanesFarApart},
    {"camera-scale", kWarning,
     "An uneven or negative scale means nothing to a lens, but mirrors or bends the view where a program inverts the "
     "camera's matrix.",
     "Freeze the scale of the camera and of the groups above it.", nullptr, cameraScale},
    {"roll-without-target", kNote, "The roll counts for cameras that look at a target; some programs add it to any.",
     "Set the roll to zero, or turn the node.", rollWithoutTarget, nullptr},
    {"interest-elsewhere", kNote, "Programs that aim cameras at their point of interest will look elsewhere.",
     "Read the rotation of the node, or save a point of interest ahead of the camera.", nullptr, interestElsewhere},
    {"image-shift-not-read", kWarning,
     "Optical centre, film translation, film roll and pre-scale move or scale the image in the program that wrote "
     "them; most readers, this library among them, leave them out.",
     "Bake them into film offset and film size.", imageShiftNotRead, nullptr},
    {"no-resolution", kNote,
     "Without a resolution the shape of the picture, and so the gate fit, is the reader's guess.",
     "Set the resolution of the render and save again.", noResolution, nullptr},
    // Placement.
    {"far-from-origin", kWarning,
     "Floats this far out are so coarse that things jitter and seams open; hosts keep places as floats.",
     "Move the scene to the origin, and keep the offset apart.", nullptr, farFromOrigin},
    {"mesh-at-origin", kWarning,
     "Compatible reading takes the matrix of a node at the origin apart in another order, and bakes its mesh turned "
     "otherwise.",
     "Read faithfully (kFbxFidelityFaithful, dump --faithful), or move the mesh by a tiny distance.", nullptr,
     meshAtOrigin},
    {"zero-scale", kError, "A scale of zero has no inverse: objects below the node lose their own placement.",
     "Hide the node by its visibility.", nullptr, zeroScale},
    {"mirrored-node", kNote, "A mirrored mesh turns inside out in programs that do not turn its polygons round.",
     "Freeze the negative scale, with normals reversed.", nullptr, mirroredNode},
    {"sheared-node", kWarning, "Position, rotation and scale cannot express a shear: many programs lose it.",
     "Freeze the scale of the groups above.", nullptr, shearedNode},
    {"inherited-scale", kWarning, "How the parent's scale is inherited is a setting that most programs do not read.",
     "Freeze the parent's scale.", nullptr, inheritedScale},
    // Names and structure.
    {"duplicate-names", kWarning, "Hosts find nodes by name, and always find the first one.",
     "Give each node a name of its own.", duplicateNames, nullptr},
    {"unnamed-nodes", kNote, "A node without a name cannot be found by name.", "Name it.", unnamedNodes, nullptr},
    {"odd-names", kWarning, "Control characters and broken UTF-8 in names get lost or stop other readers.",
     "Rename the node.", oddNames, nullptr},
    {"unparented-nodes", kWarning,
     "The file connects the node neither to the root nor to another node: assimp and Blender drop it with all its "
     "descendants, others, this library among them, place it below the root.",
     "Parent it and save again, or use tarnell-fbx convert, which connects it to the root.", unparentedNodes, nullptr},
    {"constraints", kWarning, "Constraints are not evaluated: what they drive reads as it was keyed or left.",
     "Bake the constrained nodes before saving.", constraints, nullptr},
    {"curve-that-stops-three-js", kWarning,
     "three.js fails on a whole file because of one curve on a light's colour or a camera's film offset.",
     "Remove the curve from the copy for three.js.", nullptr, curveThatStopsThreeJs},
    // Meshes.
    {"polygons-out-of-range", kError,
     "Polygons refer to points that do not exist: readers drop them, or the mesh, or crash.",
     "Clean the mesh up and save again.", polygonsOutOfRange, nullptr},
    {"small-polygons", kNote, "Polygons of one or two corners have no area and no normal.", "Clean the mesh up.",
     smallPolygons, nullptr},
    {"mesh-without-polygons", kNote, "Points alone show in few programs.", "Delete the mesh, or use a null.",
     meshWithoutPolygons, nullptr},
    {"mesh-without-normals", kNote, "Each program makes normals of its own, smooth or faceted.",
     "Save with normals (smoothing groups alone are not enough).", meshWithoutNormals, nullptr},
    {"cache-missing", kError, "The mesh shows undeformed: the files of its point cache are not there.",
     "Copy the folder with the cache along, beside the FBX file.", cacheMissing, nullptr},
    {"cache-foreign-path", kWarning,
     "The path of the point cache is that of another machine; programs that go by it miss it.",
     "Keep the cache in the folder beside the FBX file, with a relative path.", cacheForeignPath, nullptr},
    {"cache-unusable", kError,
     "The mesh shows undeformed: its point cache does not fit it, is corrupt, or is switched off.",
     "Write the cache again from this mesh; tarnell-fbx cache --verify says where it breaks.", cacheUnusable, nullptr},
    {"cache-range", kWarning, "Outside of the cache's samples the mesh stands still while the rest moves.",
     "Write the cache over the whole take.", nullptr, cacheRange},
    {"cache-rate", kWarning, "Cache and file have different rates: samples fall between frames.",
     "Write the cache at the rate of the file.", cacheRate, nullptr}};

} // namespace

const char* severityName(Severity severity) {
    constexpr const char* kNames[] = {"note", "warning", "error"};
    return kNames[static_cast<std::size_t>(severity)];
}

const std::vector<LintRule>& lintRules() { return kRules; }

} // namespace tool
