// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What three.js's FBXLoader sees in the files: node three_peer.mjs SAMPLES OUT
// Writes one JSON object per file into OUT.
import { mkdirSync, readFileSync, writeFileSync } from 'node:fs';
import { join } from 'node:path';

import { AnimationMixer, LoopOnce, Vector3 } from 'three';
import { FBXLoader } from 'three/examples/jsm/loaders/FBXLoader.js';

// The loader requests images as in a browser; our files have none.
globalThis.window = globalThis;
globalThis.self = globalThis;

const [samples, out] = process.argv.slice(2);
const expected = JSON.parse(readFileSync(join(samples, 'expected.json'), 'utf8'));

function kindOf(object) {
  if (object.isCamera) return 'camera';
  if (object.isLight) return 'light';
  if (object.isMesh) return 'mesh';
  return 'null';
}

/** The points of a mesh, one per polygon corner as the loader has them, without those that are the same. */
function points(object) {
  const attribute = object.geometry.getAttribute('position');
  const seen = new Map();
  for (let i = 0; i < attribute.count; ++i) {
    const point = new Vector3().fromBufferAttribute(attribute, i).applyMatrix4(object.matrixWorld).toArray();
    seen.set(point.join(), point);
  }
  return [...seen.values()];
}

function describe(object) {
  const seen = { name: object.userData.originalName ?? object.name, kind: kindOf(object) };
  if (seen.kind === 'mesh') {
    seen.points = points(object);
    seen.placed = {};
    return seen;
  }
  seen.positions = {};
  seen.directions = {};
  if (object.isLight) {
    seen.type = object.isSpotLight ? 'spot' : object.isDirectionalLight ? 'directional' : 'point';
    seen.colour = object.color.clone().convertLinearToSRGB().toArray();
    seen.intensity = object.intensity;
  }
  return seen;
}

// The loader leaves nodes as the file has them, where cameras look along X and lights shine down.
const FORWARD = { camera: new Vector3(1, 0, 0), light: new Vector3(0, -1, 0), null: new Vector3(0, 0, -1) };

function look(path) {
  const bytes = readFileSync(path);
  const group = new FBXLoader().parse(bytes.buffer.slice(bytes.byteOffset, bytes.byteOffset + bytes.length), '');
  const mixer = new AnimationMixer(group);
  for (const clip of group.animations) {
    const action = mixer.clipAction(clip);
    action.loop = LoopOnce;
    action.clampWhenFinished = true;
    action.play();
  }
  group.updateMatrixWorld(true);
  // The ambient colour of the global settings becomes a light that has no node.
  const nodes = group.children.filter((object) => !object.isAmbientLight);
  const objects = new Map(nodes.map((object) => [object, describe(object)]));
  for (let frame = expected.frames[0]; frame <= expected.frames[1]; ++frame) {
    mixer.setTime(frame / expected.rate);
    group.updateMatrixWorld(true);
    for (const [object, seen] of objects) {
      if (seen.placed) {
        seen.placed[frame] = points(object);
        continue;
      }
      seen.positions[frame] = new Vector3().setFromMatrixPosition(object.matrixWorld).toArray();
      seen.directions[frame] = FORWARD[seen.kind].clone().transformDirection(object.matrixWorld).toArray();
    }
  }
  return { objects: [...objects.values()] };
}

mkdirSync(out, { recursive: true });
for (const { file, version } of expected.files) {
  if (version < 7000) continue; // the loader refuses these
  writeFileSync(join(out, `${file}.json`), JSON.stringify(look(join(samples, file)), null, 1));
}
