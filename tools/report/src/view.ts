// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The scene in three dimensions, from outside or through one of its cameras.

import {
  AmbientLight,
  Box3,
  Color,
  DirectionalLight,
  GridHelper,
  Matrix4,
  PerspectiveCamera,
  Scene,
  Vector3,
  WebGLRenderer,
} from "three";
import { OrbitControls } from "three/addons/controls/OrbitControls.js";
import type { NodeData } from "./data.ts";
import { cameraFigure, lightFigure } from "./figures.ts";
import { Lines, cross } from "./lines.ts";
import type { Triple } from "./lines.ts";
import { opticsOf, sidesOf } from "./optics.ts";
import type { Size } from "./optics.ts";
import { Overlay } from "./overlay.ts";
import { isPlace, positionOf, rigidMatrixOf } from "./placement.ts";
import type { Store } from "./store.ts";
import { Surfaces } from "./surfaces.ts";
import { make, number, shown } from "./text.ts";

/** How much of the canvas is left around film and picture. */
const MARGIN = 1.08;

function round(length: number): number {
  const power = 10 ** Math.floor(Math.log10(length));
  return power * (length / power >= 5 ? 5 : length / power >= 2 ? 2 : 1);
}

export class View {
  readonly element = make("div", { class: "view" });
  readonly status = make("output", { class: "status", for: "frame" });
  private readonly store: Store;
  private readonly canvas = make("canvas", { tabindex: "0", role: "img" });
  private readonly overlay = new Overlay();
  private readonly scene = new Scene();
  private readonly surfaces = new Surfaces();
  private readonly lines = new Lines();
  private readonly outside = new PerspectiveCamera(45, 1, 0.1, 1000);
  private readonly inside = new PerspectiveCamera();
  private renderer: WebGLRenderer | undefined;
  private controls: OrbitControls | undefined;
  private grid: GridHelper | undefined;
  private readonly head = new DirectionalLight(0xffffff, 2.2);
  private bounds = new Box3();
  private radius = 100;
  private waiting = false;

  constructor(store: Store) {
    this.store = store;
    this.element.append(this.canvas, this.overlay.element);
    try {
      this.renderer = new WebGLRenderer({ canvas: this.canvas, antialias: true, preserveDrawingBuffer: true, logarithmicDepthBuffer: true });
    } catch {
      this.element.replaceChildren(make("p", { class: "empty" }, "This browser has no WebGL: the scene cannot be drawn. All values are listed."));
    }
    this.scene.add(this.surfaces.group, this.lines.object, new AmbientLight(0xffffff, 1.4), this.head, this.head.target);
    if (this.renderer) {
      this.controls = new OrbitControls(this.outside, this.canvas);
      this.controls.addEventListener("change", () => this.renderSoon());
      this.controls.addEventListener("start", () => this.leaveCamera());
      new ResizeObserver(() => this.renderSoon()).observe(this.element);
    }
    store.listen((change) => {
      if (change === "shot") this.open();
      else this.update();
    });
  }

  /** Everything at once, seen from above and aside. */
  frameAll(): void {
    const centre = this.bounds.getCenter(new Vector3());
    this.outside.position.copy(centre).add(new Vector3(0.9, 0.6, 1.2).normalize().multiplyScalar(this.radius * 2.6 * Math.max(1, 1 / this.aspect())));
    this.outside.near = this.radius / 1000;
    this.outside.far = this.radius * 1000;
    if (this.controls) {
      this.controls.target.copy(centre);
      this.controls.update();
    }
    this.store.lookThrough(-1);
  }

  /** Turns the viewer about the target, for keyboards; angles in radians. */
  orbit(sideways: number, upwards: number, closer = 1): void {
    if (!this.controls) return;
    this.leaveCamera();
    const target = this.controls.target;
    const away = this.outside.position.clone().sub(target);
    const side = new Vector3(0, 1, 0).cross(away).normalize();
    away.applyAxisAngle(new Vector3(0, 1, 0), sideways);
    const turned = away.clone().applyAxisAngle(side, -upwards);
    if (Math.abs(turned.clone().normalize().y) < 0.99) away.copy(turned);
    this.outside.position.copy(target).add(away.multiplyScalar(closer));
    this.controls.update();
    this.renderSoon();
  }

  private aspect(): number {
    return this.element.clientWidth / this.element.clientHeight || 1;
  }

  /** At once, for printers. */
  render(): void {
    this.waiting = false;
    const { clientWidth: width, clientHeight: height } = this.element;
    if (!this.renderer || width === 0 || height === 0) return;
    this.renderer.setPixelRatio(Math.min(window.devicePixelRatio, 2));
    this.renderer.setSize(width, height, false);
    const camera = this.aim(width / height);
    this.head.position.setFromMatrixPosition(camera.matrixWorld).add(new Vector3(0, this.radius * 0.5, 0));
    this.head.target.position.copy(this.bounds.getCenter(new Vector3()));
    this.renderer.render(this.scene, camera);
    this.overlay.drawNames(this.nameTags(camera), width, height);
    if (performance.getEntriesByName("drawn").length === 0) performance.mark("drawn");
  }

  private renderSoon(): void {
    if (this.waiting) return;
    this.waiting = true;
    requestAnimationFrame(() => this.render());
  }

  private leaveCamera(): void {
    if (this.store.camera < 0) return;
    this.store.lookThrough(-1);
  }

  private open(): void {
    const shot = this.store.shot;
    this.surfaces.open(shot);
    this.measure();
    this.scene.remove(...(this.grid ? [this.grid] : []));
    const cell = round(this.radius / 4);
    this.grid = new GridHelper(cell * 40, 40);
    this.scene.add(this.grid);
    this.frameAll();
  }

  /** The box around all meshes and what is near them; without meshes, around all nodes. */
  private measure(): void {
    const shot = this.store.shot;
    this.bounds.makeEmpty();
    const last = shot.frameCount - 1;
    for (const frame of new Set([last, Math.floor(last / 2), 0])) {
      this.surfaces.place(shot, frame);
      this.scene.updateMatrixWorld(true);
      for (const mesh of this.surfaces.group.children) if (mesh.visible) this.bounds.expandByObject(mesh);
    }
    const meshes = this.bounds.clone();
    const reach = meshes.isEmpty() ? Infinity : meshes.getSize(new Vector3()).length() * 8;
    const middle = meshes.isEmpty() ? new Vector3() : meshes.getCenter(new Vector3());
    for (const node of shot.data.nodes) {
      const position = positionOf(shot, node, 0);
      const counts = meshes.isEmpty() || node.camera !== undefined || node.light !== undefined;
      if (counts && position.toArray().every(Number.isFinite) && position.distanceTo(middle) < reach) this.bounds.expandByPoint(position);
    }
    if (this.bounds.isEmpty()) this.bounds.set(new Vector3(-50, -50, -50), new Vector3(50, 50, 50));
    this.radius = Math.max(this.bounds.getSize(new Vector3()).length() / 2, 1e-3);
    if (this.radius <= 1e-3) this.radius = 50;
  }

  private update(): void {
    const { shot, frame, visible } = this.store;
    this.surfaces.place(shot, frame);
    this.surfaces.group.visible = visible.meshes;
    const base = this.colour("--mesh");
    this.surfaces.paint(base, base.clone().lerp(this.colour("--chosen"), 0.4), this.store.selected, visible.wires);
    if (this.grid) {
      this.grid.visible = visible.grid;
      const colour = this.colour("--grid");
      const colours = this.grid.geometry.getAttribute("color");
      for (let i = 0; i < colours.count; ++i) colours.setXYZ(i, colour.r, colour.g, colour.b);
      colours.needsUpdate = true;
    }
    this.drawLines();
    this.scene.background = this.colour("--scene");
    this.canvas.setAttribute("aria-label", `The scene at frame ${shot.frameAt(frame)}`);
    this.renderSoon();
    this.tellStatus();
  }

  private colour(name: string): Color {
    return new Color(getComputedStyle(document.documentElement).getPropertyValue(name).trim() || "#888");
  }

  private drawLines(): void {
    const { shot, frame, selected, camera: lookedThrough, visible } = this.store;
    const size = this.radius * 0.12;
    const chosen = this.colour("--chosen");
    const colours = { camera: this.colour("--camera"), light: this.colour("--light"), null: this.colour("--null") };
    this.lines.begin();
    if (visible.grid) this.drawAxes();
    shot.data.nodes.forEach((node, i) => {
      if (i === lookedThrough) return;
      const add = (matrix: Matrix4, pairs: Triple[], colour: Color) => {
        if (isPlace(matrix) && pairs.every((pair) => pair.every(Number.isFinite)))
          this.lines.add(matrix, pairs, i === selected ? chosen : colour);
      };
      if (node.camera) {
        if (visible.cameras) add(rigidMatrixOf(shot, node, frame), cameraFigure(opticsOf(shot, node, frame), size * 1.5), colours.camera);
      } else if (node.light) {
        if (visible.lights) add(rigidMatrixOf(shot, node, frame), lightFigure(node.light, shot.value(node, "coneAngle", frame), size), colours.light);
      } else if (node.mesh === undefined && visible.nulls) {
        this.drawJoint(node.kind === "bone" ? node.parent : -1, positionOf(shot, node, frame), frame, add);
        add(rigidMatrixOf(shot, node, frame), cross(node.hasLook ? this.crossSize(node, frame) : size / 12), colours.null);
      }
    });
    this.lines.end();
  }

  /** Half of a null's size in the world, as long as it does not hide the scene. */
  private crossSize(node: NodeData, frame: number): number {
    const scale = Math.abs(this.store.shot.value(node, "scaleX", frame));
    return Math.min(((node.size ?? 1) * scale) / 2, this.radius * 0.06);
  }

  /** The line from a bone to its parent. */
  private drawJoint(parent: number, to: Vector3, frame: number, add: (m: Matrix4, p: Triple[], c: Color) => void): void {
    const above = this.store.node(parent);
    if (!above) return;
    const from = positionOf(this.store.shot, above, frame);
    add(new Matrix4(), [from.toArray(), to.toArray()], this.colour("--null"));
  }

  private drawAxes(): void {
    const length = this.radius * 0.25;
    const axes: [Triple, string][] = [[[length, 0, 0], "#e5484d"], [[0, length, 0], "#30a46c"], [[0, 0, length], "#3b82f6"]];
    for (const [end, colour] of axes) this.lines.add(new Matrix4(), [[0, 0, 0], end], new Color(colour));
  }

  /** The camera to render with; the overlay follows it. */
  private aim(aspect: number): PerspectiveCamera {
    const { shot, frame, visible } = this.store;
    const node = this.store.node(this.store.camera);
    if (!node?.camera) {
      this.overlay.hideGate();
      this.outside.aspect = aspect;
      this.outside.updateProjectionMatrix();
      this.outside.updateMatrixWorld();
      return this.outside;
    }
    const optics = opticsOf(shot, node, frame);
    const seen = { width: Math.max(optics.film.width, optics.gate.width) * MARGIN, height: Math.max(optics.film.height, optics.gate.height) * MARGIN };
    const view: Size = seen.width / seen.height < aspect ? { width: seen.height * aspect, height: seen.height } : { width: seen.width, height: seen.width / aspect };
    const matrix = rigidMatrixOf(shot, node, frame);
    const sides = sidesOf(optics, view);
    if (!isPlace(matrix) || !Object.values(sides).every(Number.isFinite)) return this.outside;
    // The camera's own planes would hide what its file shows elsewhere: only what is behind it is left out.
    const reach = this.bounds.getCenter(new Vector3()).distanceTo(new Vector3().setFromMatrixPosition(matrix)) + this.radius * 20;
    const near = Math.max(Math.min(optics.near > 0 ? optics.near : 0.1, reach / 100), reach * 1e-6);
    const projection = this.inside.projectionMatrix;
    this.inside.near = near;
    this.inside.far = reach;
    if (optics.orthographic) projection.makeOrthographic(sides.left, sides.right, sides.top, sides.bottom, -reach, reach);
    else projection.makePerspective(sides.left * near, sides.right * near, sides.top * near, sides.bottom * near, near, reach);
    this.inside.projectionMatrixInverse.copy(projection).invert();
    this.inside.matrixAutoUpdate = false;
    this.inside.matrix.copy(matrix);
    this.inside.updateMatrixWorld(true);
    this.overlay.drawGate(optics.gate, optics.film, view, visible.safe);
    return this.inside;
  }

  /** Where the names of cameras and lights go, in parts of the canvas. */
  private nameTags(camera: PerspectiveCamera): { name: string; x: number; y: number }[] {
    const { shot, frame, visible } = this.store;
    if (!visible.names) return [];
    const tags: { name: string; x: number; y: number }[] = [];
    shot.data.nodes.forEach((node, i) => {
      const isShown = (node.camera && visible.cameras) || (node.light && visible.lights) || i === this.store.selected;
      if (!isShown || i === this.store.camera || tags.length >= 40) return;
      const place = positionOf(shot, node, frame).applyMatrix4(camera.matrixWorldInverse);
      if (!(place.z < 0)) return;
      place.applyMatrix4(camera.projectionMatrix);
      if (Math.abs(place.x) < 1 && Math.abs(place.y) < 1) tags.push({ name: shown(node.name), x: (place.x + 1) / 2, y: (1 - place.y) / 2 });
    });
    return tags;
  }

  /** What the camera that renders has, in words: numbers come from the matrices that are drawn with. */
  private tellStatus(): void {
    const node = this.store.node(this.store.camera);
    if (!node?.camera) {
      this.status.textContent = "Drag to orbit, right button to pan, wheel to zoom.";
      delete this.status.dataset["position"];
      delete this.status.dataset["direction"];
      return;
    }
    this.aim(1);
    const matrix = this.inside.matrixWorld;
    const at = new Vector3().setFromMatrixPosition(matrix);
    const looks = new Vector3(0, 0, -1).transformDirection(matrix);
    const triple = (v: Vector3, digits: number) => `(${v.toArray().map((c) => number(c, digits)).join(", ")})`;
    const optics = opticsOf(this.store.shot, node, this.store.frame);
    const sees = optics.orthographic
      ? `${number(optics.orthoWidth)} cm wide`
      : `${number(optics.pictureAngles.width)}° × ${number(optics.pictureAngles.height)}°`;
    this.status.textContent = `${shown(node.name)}: at ${triple(at, 3)} cm, looks ${triple(looks, 4)}, picture ${sees}`;
    this.status.dataset["position"] = at.toArray().join(" ");
    this.status.dataset["direction"] = looks.toArray().join(" ");
  }
}
