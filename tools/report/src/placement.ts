// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Where nodes are: a matrix from the channels of their transform, position · rotation · shear · scale.

import { Euler, Matrix4, Vector3 } from "three";
import type { EulerOrder } from "three";
import type { NodeData, Shot } from "./data.ts";

const RADIANS = Math.PI / 180;

/** Files name the axis first that turns first; three.js names its matrix first, which turns last. */
function orderOf(node: NodeData): EulerOrder {
  return [...node.order].reverse().join("") as EulerOrder;
}

function rotation(shot: Shot, node: NodeData, frame: number): Matrix4 {
  const angle = (axis: string) => shot.value(node, `rotation${axis}`, frame) * RADIANS;
  return new Matrix4().makeRotationFromEuler(new Euler(angle("X"), angle("Y"), angle("Z"), orderOf(node)));
}

export function positionOf(shot: Shot, node: NodeData, frame: number): Vector3 {
  const along = (axis: string) => shot.value(node, `position${axis}`, frame);
  return new Vector3(along("X"), along("Y"), along("Z"));
}

export function isPlace(matrix: Matrix4): boolean {
  return matrix.elements.every(Number.isFinite);
}

/** Place, direction, shear and scale in the world. */
export function matrixOf(shot: Shot, node: NodeData, frame: number): Matrix4 {
  const value = (name: string) => shot.value(node, name, frame);
  const shear = new Matrix4().set(1, value("skewX"), value("skewY"), 0, 0, 1, value("skewZ"), 0, 0, 0, 1, 0, 0, 0, 0, 1);
  const scale = new Matrix4().makeScale(value("scaleX"), value("scaleY"), value("scaleZ"));
  return rotation(shot, node, frame).setPosition(positionOf(shot, node, frame)).multiply(shear).multiply(scale);
}

/** Place and direction alone: scaling does not reach the optics of cameras, nor lights. */
export function rigidMatrixOf(shot: Shot, node: NodeData, frame: number): Matrix4 {
  return rotation(shot, node, frame).setPosition(positionOf(shot, node, frame));
}

/** Where a camera or light looks. */
export function directionOf(shot: Shot, node: NodeData, frame: number): Vector3 {
  return new Vector3(0, 0, -1).applyMatrix4(rotation(shot, node, frame));
}
