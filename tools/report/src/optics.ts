// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Lenses and film: what of the film plane a picture shows, and the angles of it.

import type { NodeData, Shot } from "./data.ts";

export const MILLIMETRES_PER_INCH = 25.4;
export interface Size {
  width: number;
  height: number;
}

/** Everything about a camera's optics at one frame. Film in inches, angles in degrees, planes in centimetres. */
export interface Optics {
  orthographic: boolean;
  focalLength: number;
  film: Size;
  offset: { x: number; y: number };
  /** The part of the film plane that the picture shows. */
  gate: Size;
  pictureAspect: number;
  filmAngles: Size;
  pictureAngles: Size;
  near: number;
  far: number;
  /** Of orthographic cameras, centimetres in the picture's width. */
  orthoWidth: number;
}

export function angleOver(inches: number, focalLength: number): number {
  return (2 * Math.atan2((inches * MILLIMETRES_PER_INCH) / 2, focalLength) * 180) / Math.PI;
}

/** One side of the picture is the film's and the other follows; all of the film without a fit, or where it is stretched. */
export function pictureGate(film: Size, pictureAspect: number, fit: string): Size {
  const keepsWidth = { width: film.width, height: film.width / pictureAspect };
  const keepsHeight = { width: film.height * pictureAspect, height: film.height };
  const isWider = pictureAspect > film.width / film.height;
  switch (fit) {
    case "vertical":
      return keepsHeight;
    case "horizontal":
      return keepsWidth;
    case "fill":
      return isWider ? keepsWidth : keepsHeight;
    case "overscan":
      return isWider ? keepsHeight : keepsWidth;
    default:
      return film;
  }
}

export function opticsOf(shot: Shot, node: NodeData, frame: number): Optics {
  const value = (name: string) => shot.value(node, name, frame);
  const film = { width: value("apertureWidth"), height: value("apertureHeight") };
  const focalLength = value("focalLength");
  const filmAspect = film.width / film.height;
  const stated = node.camera?.pictureAspect ?? 0;
  const pictureAspect = stated > 0 ? stated : filmAspect;
  const gate = pictureGate(film, pictureAspect, node.camera?.gateFit ?? "none");
  return {
    orthographic: node.camera?.orthographic ?? false,
    focalLength,
    film,
    offset: { x: value("filmOffsetX"), y: value("filmOffsetY") },
    gate,
    pictureAspect,
    filmAngles: { width: value("fieldOfViewX"), height: value("fieldOfViewY") },
    pictureAngles: { width: angleOver(gate.width, focalLength), height: angleOver(gate.height, focalLength) },
    near: value("nearPlane"),
    far: value("farPlane"),
    orthoWidth: node.camera?.orthoWidth ?? NaN,
  };
}

/** A frustum's sides at distance 1 before the camera, or, of an orthographic one, anywhere; as wide as `gate`. */
export function sidesOf(optics: Optics, gate: Size): { left: number; right: number; bottom: number; top: number } {
  const scale = optics.orthographic
    ? optics.orthoWidth / optics.gate.width
    : MILLIMETRES_PER_INCH / optics.focalLength;
  return {
    left: (optics.offset.x - gate.width / 2) * scale,
    right: (optics.offset.x + gate.width / 2) * scale,
    bottom: (optics.offset.y - gate.height / 2) * scale,
    top: (optics.offset.y + gate.height / 2) * scale,
  };
}
