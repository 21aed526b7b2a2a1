// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How cameras, lights and nulls are drawn: pairs of points in the space of the node, which looks along −Z.

import { circle, cross, loop } from "./lines.ts";
import type { Triple } from "./lines.ts";
import { sidesOf } from "./optics.ts";
import type { Optics, Size } from "./optics.ts";

/** The rectangle that a gate sees at a distance. */
function gateAt(optics: Optics, gate: Size, distance: number): Triple[] {
  const sides = sidesOf(optics, gate);
  const scale = optics.orthographic ? 1 : distance;
  return [
    [sides.left * scale, sides.bottom * scale, -distance],
    [sides.right * scale, sides.bottom * scale, -distance],
    [sides.right * scale, sides.top * scale, -distance],
    [sides.left * scale, sides.top * scale, -distance],
  ];
}

/** The frustum of the picture up to a distance, the film's gate where it is another one, and a mark at the upper side. */
export function cameraFigure(optics: Optics, distance: number): Triple[] {
  const far = gateAt(optics, optics.gate, distance);
  const near: Triple[] = optics.orthographic ? gateAt(optics, optics.gate, 0) : far.map((): Triple => [0, 0, 0]);
  const film = gateAt(optics, optics.film, distance);
  const [, , right, left] = film as [Triple, Triple, Triple, Triple];
  const middle = (right[0] + left[0]) / 2;
  const half = Math.abs(right[0] - left[0]) / 6;
  const mark = loop([
    [middle - half, right[1] * 1.03, -distance],
    [middle + half, right[1] * 1.03, -distance],
    [middle, right[1] * 1.03 + half, -distance],
  ]);
  return [...far.flatMap((corner, i) => [near[i]!, corner]), ...loop(far), ...loop(near), ...loop(film), ...mark];
}

export function lightFigure(type: string, coneAngle: number, size: number): Triple[] {
  const bulb = [...circle(size * 0.2, 0, 12), ...cross(size * 0.3)];
  if (type === "directional") {
    return [[0.3, 0], [-0.3, 0], [0, 0.3], [0, -0.3], [0, 0]].flatMap(([x, y]): Triple[] => [
      [x! * size, y! * size, 0],
      [x! * size, y! * size, -size],
    ]).concat(circle(size * 0.3, 0));
  }
  if (type === "spot" && coneAngle > 0 && coneAngle < 180) {
    const radius = size * Math.tan((coneAngle * Math.PI) / 360);
    const rim: Triple[] = [[radius, 0, -size], [-radius, 0, -size], [0, radius, -size], [0, -radius, -size]];
    return [...circle(radius, -size), ...rim.flatMap((end): Triple[] => [[0, 0, 0], end])];
  }
  return bulb;
}
