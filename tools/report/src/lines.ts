// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// All lines of the scene in one object that is refilled for each frame: files have thousands of nulls and bones.

import { BufferGeometry, Color, DynamicDrawUsage, Float32BufferAttribute, LineBasicMaterial, LineSegments, Vector3 } from "three";
import type { Matrix4 } from "three";

export type Triple = readonly [number, number, number];

export class Lines {
  readonly object = new LineSegments(new BufferGeometry(), new LineBasicMaterial({ vertexColors: true }));
  private points: number[] = [];
  private colours: number[] = [];

  constructor() {
    this.object.frustumCulled = false;
  }

  begin(): void {
    this.points = [];
    this.colours = [];
  }

  /** Pairs of points, in the space of the matrix. */
  add(matrix: Matrix4, pairs: readonly Triple[], colour: Color): void {
    const point = new Vector3();
    for (const pair of pairs) {
      point.set(...pair).applyMatrix4(matrix);
      this.points.push(point.x, point.y, point.z);
      this.colours.push(colour.r, colour.g, colour.b);
    }
  }

  end(): void {
    const geometry = this.object.geometry;
    const old = geometry.getAttribute("position");
    if (old && old.count * 3 === this.points.length) {
      (old.array as Float32Array).set(this.points);
      (geometry.getAttribute("color").array as Float32Array).set(this.colours);
      old.needsUpdate = geometry.getAttribute("color").needsUpdate = true;
      return;
    }
    geometry.dispose();
    geometry.setAttribute("position", new Float32BufferAttribute(this.points, 3).setUsage(DynamicDrawUsage));
    geometry.setAttribute("color", new Float32BufferAttribute(this.colours, 3).setUsage(DynamicDrawUsage));
  }
}

/** The lines of a closed way through points. */
export function loop(points: readonly Triple[]): Triple[] {
  return points.flatMap((point, i) => [point, points[(i + 1) % points.length]!]);
}

export function circle(radius: number, z: number, corners = 24): Triple[] {
  const points = Array.from({ length: corners }, (_, i): Triple => {
    const angle = (2 * Math.PI * i) / corners;
    return [radius * Math.cos(angle), radius * Math.sin(angle), z];
  });
  return loop(points);
}

export function cross(size: number): Triple[] {
  return [
    [-size, 0, 0], [size, 0, 0],
    [0, -size, 0], [0, size, 0],
    [0, 0, -size], [0, 0, size],
  ];
}
