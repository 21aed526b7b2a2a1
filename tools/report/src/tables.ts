// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What the page says in words and numbers.

import type { FindingData, NodeData } from "./data.ts";
import { MILLIMETRES_PER_INCH, opticsOf } from "./optics.ts";
import { directionOf, positionOf } from "./placement.ts";
import type { Store } from "./store.ts";
import { counted, make, nameText, number, shown, size } from "./text.ts";

type Cell = Node | string;
interface Row {
  key: string;
  label: string;
  value: string;
}

/** Tables may be wider than their place: those who use a keyboard can scroll them. */
function scrolled(label: string, table: HTMLTableElement): HTMLElement {
  return make("div", { class: "scroll", tabindex: "0", role: "region", "aria-label": label }, table);
}

function table(label: string, heads: string[], rows: Cell[][]): HTMLElement {
  const head = make("tr", {}, ...heads.map((each) => make("th", { scope: "col" }, each)));
  const body = rows.map((row) =>
    make("tr", {}, ...row.map((cell, i) => (i === 0 ? make("th", { scope: "row" }, cell) : make("td", {}, cell)))),
  );
  return scrolled(label, make("table", {}, make("thead", {}, head), make("tbody", {}, ...body)));
}

function facts(rows: [label: string, ...cells: Cell[]][]): HTMLElement {
  const body = rows.map(([label, ...cells]) => make("tr", {}, make("th", { scope: "row" }, label), make("td", {}, ...cells)));
  return make("table", { class: "facts" }, make("tbody", {}, ...body));
}

function triple(values: readonly number[], digits = 3): string {
  return `(${values.map((value) => number(value, digits)).join(", ")})`;
}

function degrees(width: number, height: number): string {
  return `${number(width)}° × ${number(height)}°`;
}

function drivesWhat(node: NodeData): string {
  const driver = node.camera?.drivenBy;
  return node.camera?.orthographic ? "orthographic" : `perspective${driver ? `, lens driven by ${driver}` : ""}`;
}

/** "960 × 540 = ", if the file has a resolution. */
function resolutionOf(node: NodeData): string {
  const [width, height] = node.camera?.resolution ?? [];
  return width && height && node.camera?.pictureAspect ? `${number(width)} × ${number(height)} = ` : "";
}

function cameraRows(store: Store, node: NodeData): Row[] {
  const optics = opticsOf(store.shot, node, store.frame);
  const mm = { width: optics.film.width * MILLIMETRES_PER_INCH, height: optics.film.height * MILLIMETRES_PER_INCH };
  const { camera } = node;
  const lens: Row[] = optics.orthographic
    ? [{ key: "orthoWidth", label: "Picture width", value: `${number(optics.orthoWidth)} cm` }]
    : [
        { key: "focalLength", label: "Focal length", value: `${number(optics.focalLength, 4)} mm` },
        { key: "filmAngles", label: "FOV of film", value: degrees(optics.filmAngles.width, optics.filmAngles.height) },
        { key: "pictureAngles", label: "FOV of picture", value: degrees(optics.pictureAngles.width, optics.pictureAngles.height) },
      ];
  return [
    { key: "projection", label: "Projection", value: drivesWhat(node) },
    ...lens,
    {
      key: "film",
      label: "Film back",
      value: `${camera?.gate ? `${camera.gate}: ` : ""}${number(mm.width)} × ${number(mm.height)} mm = ${number(optics.film.width, 5)} × ${number(optics.film.height, 5)} in`,
    },
    { key: "offset", label: "Film offset", value: `${number(optics.offset.x, 5)}, ${number(optics.offset.y, 5)} in` },
    { key: "aspect", label: "Picture aspect", value: `${resolutionOf(node)}${number(optics.pictureAspect)}; gate fit ${camera?.gateFit ?? "none"}` },
    { key: "squeeze", label: "Squeeze", value: number(camera?.squeeze) },
    { key: "planes", label: "Clip planes", value: `${number(optics.near)} and ${number(optics.far)} cm` },
    ...(camera?.target !== undefined ? [{ key: "target", label: "Aims at", value: shown(camera.target) }] : []),
    ...(camera?.restDirection ? [{ key: "rest", label: "Rotation 0", value: `looks along ${camera.restDirection}` }] : []),
  ];
}

function lightRows(store: Store, node: NodeData): Row[] {
  const value = (name: string) => store.shot.value(node, name, store.frame);
  return [
    { key: "light", label: "Light", value: node.light ?? "" },
    { key: "intensity", label: "Intensity", value: number(value("intensity")) },
    { key: "colour", label: "Colour", value: triple([value("red"), value("green"), value("blue")]) },
    ...(node.light === "spot" ? [{ key: "coneAngle", label: "Cone angle", value: `${number(value("coneAngle"))}°` }] : []),
  ];
}

function placeRows(store: Store, node: NodeData): Row[] {
  const { shot, frame } = store;
  const along = (name: string) => ["X", "Y", "Z"].map((axis) => shot.value(node, name + axis, frame));
  const looks = node.camera || node.light;
  return [
    { key: "position", label: "World", value: `${triple(positionOf(shot, node, frame).toArray())} cm` },
    ...(looks ? [{ key: "direction", label: "Looks", value: triple(directionOf(shot, node, frame).toArray(), 4) }] : []),
    { key: "rotation", label: `Rotation (${node.order})`, value: `${triple(along("rotation"))}°` },
    { key: "scale", label: "Scale", value: triple(along("scale")) },
  ];
}

/** The values of the selected node at the frame that is shown. */
export class ValueTable {
  readonly element = make("div", { class: "values" });

  constructor(private readonly store: Store) {
    store.listen(() => this.draw());
  }

  private draw(): void {
    const node = this.store.node(this.store.selected);
    if (!node) {
      this.element.replaceChildren(make("p", { class: "empty" }, "The file has no objects."));
      return;
    }
    const rows = [
      ...(node.camera ? cameraRows(this.store, node) : []),
      ...(node.light ? lightRows(this.store, node) : []),
      ...placeRows(this.store, node),
    ];
    const body = rows.map((row) => make("tr", {}, make("th", { scope: "row" }, row.label), make("td", { "data-key": row.key }, row.value)));
    const caption = make("caption", {}, nameText(node.name), ` — ${node.kind}, frame ${this.store.shot.frameAt(this.store.frame)}`);
    this.element.replaceChildren(make("table", { class: "facts" }, caption, make("tbody", {}, ...body)));
  }
}

export function cameraTable(store: Store): HTMLElement {
  const { shot } = store;
  const rows = store.cameras().map((index): Cell[] => {
    const node = store.node(index)!;
    const optics = opticsOf(shot, node, 0);
    const curves = node.camera?.curves ?? [];
    const look = make("button", { type: "button", class: "link" }, nameText(node.name));
    look.addEventListener("click", () => store.lookThrough(index));
    return [
      look,
      optics.orthographic ? `${number(optics.orthoWidth)} cm wide` : `${number(optics.focalLength)} mm`,
      `${number(optics.film.width * MILLIMETRES_PER_INCH, 2)} × ${number(optics.film.height * MILLIMETRES_PER_INCH, 2)} mm`,
      optics.orthographic ? "—" : degrees(optics.pictureAngles.width, optics.pictureAngles.height),
      number(optics.pictureAspect),
      curves.length > 0 ? list(curves.map(shown)) : "static",
    ];
  });
  if (rows.length === 0) return make("p", { class: "empty" }, "The file has no cameras.");
  return table("Cameras", ["Camera", "Lens", "Film back", "FOV of picture", "Aspect", "Curves in the file"], rows);
}

export function fileFacts(store: Store): HTMLElement {
  const { info, take, frames } = store.shot.data;
  const version = `${Math.floor(info.version / 1000)}.${Math.floor(info.version / 100) % 10}`;
  const stacks = info.stacks.map((stack) =>
    make("div", {}, nameText(stack.name), ` frames ${stack.firstFrame} to ${stack.lastFrame}${stack.name === take ? " (shown)" : ""}`),
  );
  return facts([
    ["Version", `${version}, ${info.encoding === "ascii" ? "ASCII" : "binary"}${info.bytes === null ? "" : `, ${size(info.bytes)}`}`],
    ["Creator", shown(info.creator) || "not stated"],
    ["Unit", `${shown(info.unit.name)}; shown in centimetres`],
    ["Axes", `${info.axes.up} up, ${info.axes.toViewer} to the viewer, ${info.axes.handedness}-handed; shown with +Y up`],
    ["Rate", `${number(info.frameRate)} frames per second`],
    ["Takes", ...(stacks.length > 0 ? stacks : ["none"])],
    ["Nodes", Object.entries(info.nodes).map(([kind, count]) => `${count} × ${kind}`).join(", ") || "none"],
    ["Frames shown", counted(frames.count, "frame", "frames") + (frames.step > 1 ? `, every ${frames.step}th` : "")],
  ]);
}

export function meshTable(store: Store): HTMLElement {
  const { nodes, meshes } = store.shot.data;
  const LIMIT = 200;
  const rows = nodes.flatMap((node): Cell[][] => {
    const mesh = node.mesh === undefined ? undefined : meshes[node.mesh];
    if (!mesh) return [];
    const drawn = mesh.drawnTriangles < mesh.triangles ? `${number((100 * mesh.drawnTriangles) / mesh.triangles, 1)} % (simplified)` : "all";
    return [[nameText(node.name), mesh.points.toLocaleString("en"), mesh.polygons.toLocaleString("en"), mesh.polygons > 0 ? drawn : "no polygons"]];
  });
  if (rows.length === 0) return make("p", { class: "empty" }, "The file has no meshes.");
  const element = table("Meshes", ["Mesh", "Points", "Polygons", "Drawn"], rows.slice(0, LIMIT));
  return rows.length > LIMIT ? make("div", {}, element, make("p", { class: "quiet" }, `… and ${rows.length - LIMIT} more`)) : element;
}

function list(sentences: Cell[]): HTMLElement {
  return make("ul", {}, ...sentences.map((sentence) => make("li", {}, sentence)));
}

function finding(rule: FindingData): HTMLElement {
  const more = rule.count - rule.found.length;
  const objects = rule.found.map(({ object, text }) => make("li", {}, ...(object ? [nameText(object), ": "] : []), shown(text)));
  return make(
    "li",
    { class: `finding ${rule.severity}` },
    make("strong", {}, rule.severity),
    ` ${rule.rule} `,
    make("ul", {}, ...objects, ...(more > 0 ? [make("li", {}, `… and ${more} more; lint --json lists all`)] : [])),
    make("p", { class: "quiet" }, `${rule.reason} → ${rule.remedy}`),
  );
}

/** What the rules of `lint` find, the worst first, and what reading noticed. */
export function findings(store: Store): HTMLElement {
  const { findings: all, warnings } = store.shot.data;
  const worst = ["error", "warning", "note"];
  const ordered = [...all].sort((a, b) => worst.indexOf(a.severity) - worst.indexOf(b.severity));
  if (all.length + warnings.length === 0) return make("p", { class: "empty" }, "No findings.");
  return make("ul", { class: "findings" }, ...ordered.map(finding), ...warnings.map((warning) => make("li", {}, shown(warning))));
}

/** Where the numbers of the selected camera come from, and what the file says that has no say. */
export function explanation(node: NodeData | undefined): HTMLElement | undefined {
  const { origins = [], idle = [] } = node?.camera ?? {};
  if (origins.length + idle.length === 0) return undefined;
  const idleList = idle.length > 0 ? [make("p", {}, "In the file, not in force:"), list(idle.map(shown))] : [];
  return make("details", {}, make("summary", {}, "Derivation of these values"), list(origins.map(shown)), ...idleList);
}

export function notes(store: Store): HTMLElement | undefined {
  const sentences = store.shot.data.notes;
  return sentences.length > 0 ? list(sentences.map(shown)) : undefined;
}
