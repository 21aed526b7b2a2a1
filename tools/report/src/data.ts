// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The documents that `tarnell-fbx report` puts into the page, and the arrays that they point into.

/** A number that never changes (null: it is not finite), or where the array of the frames' numbers begins. */
export type ChannelData = number | null | { at: number };

/** What `tarnell-fbx camera` says; all but the projection is missing where that could not be gathered. */
export interface CameraData {
  orthographic: boolean;
  drivenBy?: string;
  /** The name of the film back, if it has one. */
  gate?: string;
  gateFit?: string;
  resolution?: (number | null)[];
  /** Of the picture; 0 where the picture is the film. */
  pictureAspect?: number | null;
  squeeze?: number | null;
  /** Of the picture of an orthographic camera, centimetres. */
  orthoWidth?: number | null;
  target?: string;
  /** Where rotation 0 looks in the space of the parent. */
  restDirection?: string;
  curves?: string[];
  idle?: string[];
  origins?: string[];
}

/** What `tarnell-fbx lint` finds by one rule. */
export interface FindingData {
  rule: string;
  severity: "note" | "warning" | "error";
  reason: string;
  remedy: string;
  count: number;
  found: { object: string; text: string }[];
}

export interface NodeData {
  name: string;
  kind: string;
  parent: number;
  order: string;
  channels: Record<string, ChannelData>;
  mesh?: number;
  camera?: CameraData;
  light?: string;
  size?: number | null;
  hasLook?: boolean;
}

export interface MeshData {
  polygons: number;
  points: number;
  triangles: number;
  drawnPoints: number;
  drawnTriangles: number;
  indexBytes: 2 | 4;
  indices: number;
  sets: number[];
}

export interface InfoData {
  version: number;
  encoding: string;
  bytes: number | null;
  creator: string;
  unit: { centimetres: number; name: string };
  axes: { up: string; toViewer: string; handedness: string };
  frameRate: number;
  stacks: { name: string; firstFrame: number; lastFrame: number; start: number; end: number; layers: string[] }[];
  nodes: Record<string, number>;
  cacheFaults: { mesh: string; reason: string }[];
  repaired: string[];
}

export interface ShotData {
  format: string;
  file: string;
  take: string;
  info: InfoData;
  frames: { rate: number; first: number; step: number; count: number };
  shapeFrames: number[];
  nodes: NodeData[];
  meshes: MeshData[];
  findings: FindingData[];
  notes: string[];
  warnings: string[];
}

function bytesOf(base64: string): ArrayBuffer {
  const text = atob(base64);
  const bytes = new Uint8Array(text.length);
  for (let i = 0; i < text.length; ++i) bytes[i] = text.charCodeAt(i);
  return bytes.buffer;
}

/** One file of the report. Its frames are counted from 0; `frameAt` gives the numbers for display. */
export class Shot {
  readonly data: ShotData;
  private readonly bytes: ArrayBuffer;

  constructor(json: string, base64: string) {
    this.data = JSON.parse(json) as ShotData;
    this.bytes = bytesOf(base64);
  }

  get frameCount(): number {
    return this.data.frames.count;
  }

  frameAt(index: number): number {
    return this.data.frames.first + index * this.data.frames.step;
  }

  floats(at: number, count: number): Float32Array {
    return new Float32Array(this.bytes, at, count);
  }

  indices(mesh: MeshData): Uint16Array | Uint32Array {
    const count = mesh.drawnTriangles * 3;
    return mesh.indexBytes === 2
      ? new Uint16Array(this.bytes, mesh.indices, count)
      : new Uint32Array(this.bytes, mesh.indices, count);
  }

  isAnimated(node: NodeData, channel: string): boolean {
    return typeof node.channels[channel] === "object" && node.channels[channel] !== null;
  }

  /** All values of an animated channel, frame by frame. */
  samples(node: NodeData, channel: string): Float32Array | undefined {
    const data = node.channels[channel];
    return typeof data === "object" && data !== null ? this.floats(data.at, this.frameCount) : undefined;
  }

  /** NaN where the file has no number, or none that is finite. */
  value(node: NodeData, channel: string, index: number): number {
    const data = node.channels[channel];
    if (typeof data === "number") return data;
    return this.samples(node, channel)?.[index] ?? NaN;
  }
}

/** What the page carries: pairs of elements, a document and its arrays. */
export function shotsOf(page: Document): (() => Shot)[] {
  const arrays = [...page.querySelectorAll("script.arrays")];
  return [...page.querySelectorAll("script.shot")].map((element, i) => {
    let shot: Shot | undefined;
    return () => (shot ??= new Shot(element.textContent ?? "", arrays[i]?.textContent ?? ""));
  });
}
