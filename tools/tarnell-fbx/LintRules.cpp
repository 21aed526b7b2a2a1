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
    {"not-readable", kError, "The library, and with it every host, cannot read this file faithfully.",
     "Correct what the message reports; often a key or the span of a take is at an extreme time.", nullptr,
     notReadable},
    {"repaired", kWarning, "The file violates the format; other readers may repair it differently or reject it.",
     "Save it again in the application that wrote it, or use tarnell-fbx convert.", repaired, nullptr},
    {"old-version", kWarning, "Many programs reject files older than 7.1, among them assimp, Blender and three.js.",
     "Save it as FBX 2011 or later, or use tarnell-fbx convert --version 2014.", oldVersion, nullptr},
    {"ascii-encoding", kNote, "Some programs, such as Blender, read binary files only.",
     "Save it as binary, or use tarnell-fbx convert, if it is meant for such programs.", asciiEncoding, nullptr},
    {"unit-shifts-optics", kWarning,
     "Programs convert the unit of positions, but some do not convert clip planes, ortho widths, focus distances, "
     "points of interest or light falloff.",
     "Save the file in centimetres, or compare clip planes and ortho width after reading.", unitShiftsOptics, nullptr},
    {"axes-shift-optics", kWarning,
     "Programs convert cameras and lights to their own axes in different ways, on the node or on a parent; a rotation "
     "may be lost or applied twice.",
     "Save the file with Y up, or compare the directions of cameras after reading.", axesShiftOptics, nullptr},
    {"left-handed", kWarning,
     "Some programs mirror left-handed scenes; others, this library among them, only rotate them.",
     "Save the file with right-handed axes.", leftHanded, nullptr},
    {"not-finite", kError, "NaN and infinite values propagate to everything that is computed from them.",
     "Correct the value or key in the application that wrote the file.", valuesNotFinite, keysNotFinite},
    // Time.
    {"rate-unstated", kWarning,
     "The file does not state its frame rate: each program uses its own default, and keys fall between frames.",
     "Set the frame rate of the scene and save again.", rateUnstated, nullptr},
    {"keys-between-frames", kWarning, "Programs that sample at whole frames lose such keys or move them.",
     "Snap the keys to frames, or bake the animation at the rate of the file.", nullptr, keysBetweenFrames},
    {"span-differs-from-keys", kWarning,
     "Some programs use the span of the take and ignore keys outside it; others use the range of the keys.",
     "Set the playback range to the range of the keys, or key the ends of the range.", spanDiffersFromKeys, nullptr},
    {"take-without-span", kNote, "Programs that use the span of a take play nothing, or a default range.",
     "Set the playback range and save again.", takeWithoutSpan, nullptr},
    {"take-without-keys", kNote, "Programs that read only one take may read this one, in which nothing is keyed.",
     "Remove the take, unless its span is needed.", takeWithoutKeys, nullptr},
    {"several-takes", kNote, "Many programs read only the first take or the current one.",
     "Select a take when reading (--take), or save each take to a separate file.", severalTakes, nullptr},
    {"several-layers", kNote, "Programs that read only the base layer show a different animation.",
     "Bake the layers into one.", severalLayers, nullptr},
    {"rotation-flips", kWarning,
     "An angle that changes by 180° or more within a frame is interpolated the long way round where it is sampled "
     "between frames: for motion blur, other frame rates or retiming.",
     "Apply an Euler filter to the rotation curves, so that each key continues the one before.", nullptr,
     rotationFlips},
    // Cameras.
    {"lens-out-of-range", kError,
     "Without a positive focal length and film size there is no field of view; readers divide by them.",
     "Set focal length and film back to values above zero.", nullptr, lensOutOfRange},
    {"lens-values-disagree", kWarning,
     "The file states a focal length and angles that do not match. Programs that read the value that is not in force "
     "get a different lens.",
     "Make the values match, or read the one that the aperture mode selects (tarnell-fbx camera).", nullptr,
     lensValuesDisagree},
    {"film-shape-differs", kWarning,
     "Film and picture have different aspect ratios, and the gate fit determines which angle is kept: programs without "
     "gate fit show a different crop.",
     "Give the film back the aspect ratio of the picture, or transfer the angles of the picture, not those of the "
     "film.",
     nullptr, filmShapeDiffers},
    {"film-format-disagrees", kNote, "The film format or the film aspect ratio contradicts the film size.",
     "Set the format to custom, and the film aspect ratio to width / height.", filmFormatDisagrees, nullptr},
    {"squeezed-film", kNote, "Some programs include the anamorphic squeeze in the horizontal angle, others do not.",
     "Compare the horizontal angle after reading, or save with a wider film and a squeeze of 1.", squeezedFilm,
     nullptr},
    {"film-offset", kNote, "Some programs, such as assimp, ignore the film offset, which shifts the picture.",
     "Check the picture after reading; the shift is the offset divided by the film width.", nullptr, filmOffset},
    {"clip-planes", kError,
     "The near plane is not in front of the camera or not in front of the far plane: nothing is visible.",
     "Set the near plane above zero and the far plane beyond it.", nullptr, clipPlanes},
    {"clip-planes-far-apart", kNote,
     "With planes this far apart, a floating-point depth buffer cannot resolve distances.",
     "Move the near plane away from the camera.", nullptr, clipPlanesFarApart},
    {"camera-scale", kWarning,
     "A non-uniform or negative scale has no meaning for a lens, but mirrors or distorts the view in programs that "
     "invert the matrix of the camera.",
     "Freeze the scale of the camera and of its ancestors.", nullptr, cameraScale},
    {"roll-without-target", kNote, "The roll applies to cameras with a target; some programs apply it to all cameras.",
     "Set the roll to zero, and rotate the node instead.", rollWithoutTarget, nullptr},
    {"interest-elsewhere", kNote, "Programs that aim cameras at their point of interest show a different direction.",
     "Read the rotation of the node, or save a point of interest in the viewing direction.", nullptr,
     interestElsewhere},
    {"image-shift-not-read", kWarning,
     "Optical centre, film translation, film roll and pre-scale shift or scale the image in the application that wrote "
     "the file; most readers, this library among them, ignore them.",
     "Bake them into film offset and film size.", imageShiftNotRead, nullptr},
    {"no-resolution", kNote,
     "Without a resolution, readers have to assume the aspect ratio of the picture, on which the gate fit depends.",
     "Set the render resolution and save again.", noResolution, nullptr},
    // Placement.
    {"far-from-origin", kWarning,
     "Hosts store positions as floats, which are so coarse at this distance that objects jitter and seams open.",
     "Move the scene to the origin, and store the offset separately.", nullptr, farFromOrigin},
    {"mesh-at-origin", kWarning,
     "A compatible read decomposes the matrix of a node at the origin in a different order, so that its mesh is baked "
     "with a different rotation.",
     "Read faithfully (kFbxFidelityFaithful, dump --faithful), or move the mesh by a tiny distance.", nullptr,
     meshAtOrigin},
    {"zero-scale", kError, "A scale of zero has no inverse: descendants of the node lose their placement.",
     "Hide the node with its visibility instead.", nullptr, zeroScale},
    {"mirrored-node", kNote, "A mirrored mesh is inside out in programs that do not reverse its polygons.",
     "Freeze the negative scale, and reverse the normals.", nullptr, mirroredNode},
    {"sheared-node", kWarning, "Position, rotation and scale cannot represent shear: many programs lose it.",
     "Freeze the scale of the ancestors.", nullptr, shearedNode},
    {"inherited-scale", kWarning,
     "Most programs ignore the setting that determines how a node inherits the scale of its parent.",
     "Freeze the scale of the parent.", nullptr, inheritedScale},
    // Names and structure.
    {"duplicate-names", kWarning, "Hosts look nodes up by name and find only the first one.",
     "Give each node a unique name.", duplicateNames, nullptr},
    {"unnamed-nodes", kNote, "A node without a name cannot be found by name.", "Name the node.", unnamedNodes, nullptr},
    {"odd-names", kWarning, "Other readers drop control characters and invalid UTF-8 in names, or reject the file.",
     "Rename the node.", oddNames, nullptr},
    {"unparented-nodes", kWarning,
     "The file connects the node neither to the root nor to another node: assimp and Blender drop it with all its "
     "descendants; others, this library among them, place it below the root.",
     "Parent it and save again, or use tarnell-fbx convert, which connects it to the root.", unparentedNodes, nullptr},
    {"constraints", kWarning, "Constraints are not evaluated: constrained nodes have their keyed or static values.",
     "Bake the constrained nodes before saving.", constraints, nullptr},
    {"curve-that-stops-three-js", kWarning,
     "three.js cannot read files with a curve on the colour of a light or on the film offset of a camera.",
     "Remove the curve from the copy for three.js.", nullptr, curveThatStopsThreeJs},
    // Meshes.
    {"polygons-out-of-range", kError,
     "Polygons refer to points that do not exist: readers drop the polygons or the mesh, or crash.",
     "Clean the mesh up and save again.", polygonsOutOfRange, nullptr},
    {"small-polygons", kNote, "Polygons with fewer than three vertices have no area and no normal.",
     "Clean the mesh up.", smallPolygons, nullptr},
    {"mesh-without-polygons", kNote, "Few programs show points without polygons.", "Delete the mesh, or use a null.",
     meshWithoutPolygons, nullptr},
    {"mesh-without-normals", kNote, "Each program computes its own normals, smooth or faceted.",
     "Save with normals (smoothing groups alone are not enough).", meshWithoutNormals, nullptr},
    {"cache-missing", kError, "The mesh is shown undeformed: the files of its point cache do not exist.",
     "Copy the folder of the cache together with the FBX file.", cacheMissing, nullptr},
    {"cache-foreign-path", kWarning,
     "The path of the point cache is that of another machine; programs that use it do not find the cache.",
     "Keep the cache in a folder next to the FBX file, with a relative path.", cacheForeignPath, nullptr},
    {"cache-unusable", kError,
     "The mesh is shown undeformed: its point cache does not match it, is damaged, or is switched off.",
     "Write the cache again from this mesh; tarnell-fbx cache --verify reports where it is damaged.", cacheUnusable,
     nullptr},
    {"cache-range", kWarning,
     "Outside the range of the cache the mesh does not move, while the rest of the scene does.",
     "Write the cache for the whole take.", nullptr, cacheRange},
    {"cache-rate", kWarning, "Cache and file have different frame rates: samples fall between frames.",
     "Write the cache at the frame rate of the file.", cacheRate, nullptr}};

} // namespace

const char* severityName(Severity severity) {
    constexpr const char* kNames[] = {"note", "warning", "error"};
    return kNames[static_cast<std::size_t>(severity)];
}

const std::vector<LintRule>& lintRules() { return kRules; }

} // namespace tool
