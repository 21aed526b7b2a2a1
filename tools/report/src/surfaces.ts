// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes: one object for each node that carries one.

import { BufferAttribute, BufferGeometry, Color, DoubleSide, DynamicDrawUsage, Group, Mesh, MeshStandardMaterial } from "three";
import type { Shot } from "./data.ts";
import { isPlace, matrixOf } from "./placement.ts";

interface Surface {
  node: number;
  mesh: Mesh<BufferGeometry, MeshStandardMaterial>;
  /** Where the points move: their sets, one for each of the shape frames. */
  sets: Float32Array[];
}

/** The sets around a frame, and how far it is from the one to the other. */
function between(shapeFrames: number[], frame: number): { from: number; to: number; part: number } {
  const to = Math.max(0, shapeFrames.findIndex((each) => each >= frame));
  const from = shapeFrames[to] === frame ? to : Math.max(0, to - 1);
  const length = shapeFrames[to]! - shapeFrames[from]!;
  return { from, to, part: length > 0 ? (frame - shapeFrames[from]!) / length : 0 };
}

export class Surfaces {
  readonly group = new Group();
  private surfaces: Surface[] = [];

  open(shot: Shot): void {
    for (const surface of this.surfaces) {
      surface.mesh.geometry.dispose();
      surface.mesh.material.dispose();
    }
    this.group.clear();
    this.surfaces = shot.data.nodes.flatMap((node, i) => {
      const data = node.mesh === undefined ? undefined : shot.data.meshes[node.mesh];
      if (!data || data.drawnTriangles === 0) return [];
      const sets = data.sets.map((at) => shot.floats(at, data.drawnPoints * 3));
      const geometry = new BufferGeometry();
      const points = sets.length > 1 ? new Float32Array(sets[0]!) : sets[0]!;
      const attribute = new BufferAttribute(points, 3);
      geometry.setAttribute("position", sets.length > 1 ? attribute.setUsage(DynamicDrawUsage) : attribute);
      geometry.setIndex(new BufferAttribute(shot.indices(data), 1));
      // Facets need no normals, and show what the polygons are.
      const material = new MeshStandardMaterial({ flatShading: true, side: DoubleSide, roughness: 0.85, metalness: 0 });
      const mesh = new Mesh(geometry, material);
      mesh.matrixAutoUpdate = false;
      mesh.frustumCulled = sets.length === 1;
      this.group.add(mesh);
      return [{ node: i, mesh, sets }];
    });
  }

  /** Colours for the theme; the selected one is highlighted. */
  paint(base: Color, selectedColour: Color, selected: number, wires: boolean): void {
    for (const { node, mesh } of this.surfaces) {
      mesh.material.color.copy(node === selected ? selectedColour : base);
      mesh.material.wireframe = wires;
    }
  }

  place(shot: Shot, frame: number): void {
    const { from, to, part } = between(shot.data.shapeFrames, frame);
    for (const { node, mesh, sets } of this.surfaces) {
      mesh.matrix.copy(matrixOf(shot, shot.data.nodes[node]!, frame));
      mesh.visible = isPlace(mesh.matrix);
      mesh.matrixWorldNeedsUpdate = true;
      if (sets.length < 2) continue;
      const attribute = mesh.geometry.getAttribute("position");
      const points = attribute.array as Float32Array;
      const a = sets[from]!;
      const b = sets[to]!;
      for (let i = 0; i < points.length; ++i) points[i] = a[i]! + (b[i]! - a[i]!) * part;
      attribute.needsUpdate = true;
      mesh.geometry.boundingBox = mesh.geometry.boundingSphere = null;
    }
  }
}
