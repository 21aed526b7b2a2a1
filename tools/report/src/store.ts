// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The current selection and frame. The parts of the page change it, and are notified when another part did.

import type { NodeData, Shot } from "./data.ts";

export type Change = "shot" | "frame" | "selection" | "view" | "theme";

export interface Visible {
  meshes: boolean;
  cameras: boolean;
  lights: boolean;
  nulls: boolean;
  grid: boolean;
  names: boolean;
  safe: boolean;
  wires: boolean;
}

export class Store {
  shot: Shot;
  /** Index of the frame, from 0. */
  frame = 0;
  /** Index of the node whose values and curves are shown; −1: none. */
  selected = -1;
  /** Index of the camera that is looked through; −1: the viewer's own. */
  camera = -1;
  playing = false;
  readonly visible: Visible = {
    meshes: true,
    cameras: true,
    lights: true,
    nulls: true,
    grid: true,
    names: true,
    safe: true,
    wires: false,
  };
  private readonly listeners: ((change: Change) => void)[] = [];

  constructor(shot: Shot) {
    this.shot = shot;
  }

  listen(listener: (change: Change) => void): void {
    this.listeners.push(listener);
  }

  tell(change: Change): void {
    for (const listener of this.listeners) listener(change);
  }

  node(index: number): NodeData | undefined {
    return this.shot.data.nodes[index];
  }

  /** Indices of all cameras. */
  cameras(): number[] {
    return this.shot.data.nodes.flatMap((node, i) => (node.camera ? [i] : []));
  }

  open(shot: Shot): void {
    this.shot = shot;
    this.frame = 0;
    this.camera = -1;
    const moving = shot.data.nodes.findIndex((node) => Object.values(node.channels).some((c) => typeof c === "object" && c !== null));
    this.selected = this.cameras()[0] ?? (moving >= 0 ? moving : shot.data.nodes.length > 0 ? 0 : -1);
    this.tell("shot");
  }

  setFrame(index: number): void {
    const frame = Math.min(Math.max(Math.round(index) || 0, 0), this.shot.frameCount - 1);
    if (frame === this.frame) return;
    this.frame = frame;
    this.tell("frame");
  }

  select(index: number): void {
    if (index === this.selected) return;
    this.selected = index;
    this.tell("selection");
  }

  lookThrough(index: number): void {
    this.camera = index;
    if (index >= 0) this.select(index);
    this.tell("view");
  }

  show(what: keyof Visible, visible: boolean): void {
    this.visible[what] = visible;
    this.tell("view");
  }
}
