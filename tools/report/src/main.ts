// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The page: its layout, and the keys.

import { Curves } from "./curves.ts";
import { shotsOf } from "./data.ts";
import type { Shot } from "./data.ts";
import { ObjectList } from "./objects.ts";
import { Store } from "./store.ts";
import type { Visible } from "./store.ts";
import { ValueTable, cameraTable, explanation, fileFacts, findings, meshTable, notes } from "./tables.ts";
import { make, shown } from "./text.ts";
import { TimeBar } from "./timebar.ts";
import { View } from "./view.ts";

const SWITCHES: [what: keyof Visible, label: string][] = [
  ["meshes", "Meshes"],
  ["cameras", "Cameras"],
  ["lights", "Lights"],
  ["nulls", "Nulls and bones"],
  ["grid", "Grid and axes"],
  ["names", "Names"],
  ["safe", "Safe areas"],
  ["wires", "Wireframe"],
];
const KEYS: [keys: string, what: string][] = [
  ["Space", "play and pause"],
  ["← →", "previous or next frame; with Shift, ten frames"],
  ["Home End", "first and last frame"],
  ["0, F", "outside view, framing the whole scene"],
  ["1 … 9", "look through a camera"],
  ["W A S D", "orbit"],
  ["+ −", "zoom in or out"],
  ["G", "grid and axes"],
  ["T", "dark or light theme"],
  ["?", "this list"],
];

function section(title: string, ...children: Node[]): HTMLElement {
  return make("section", {}, make("h2", {}, title), ...children);
}

function pressed(label: string, press: () => void): HTMLButtonElement {
  const element = make("button", { type: "button" }, label);
  element.addEventListener("click", press);
  return element;
}

function keyHelp(): HTMLDialogElement {
  const rows = KEYS.map(([keys, what]) => make("tr", {}, make("th", { scope: "row" }, keys), make("td", {}, what)));
  const dialog = make("dialog", { "aria-label": "Keys" }, make("h2", {}, "Keys"), make("table", { class: "facts" }, make("tbody", {}, ...rows)));
  dialog.append(pressed("Close", () => dialog.close()));
  return dialog;
}

class Page {
  private readonly store: Store;
  private readonly view: View;
  private readonly time: TimeBar;
  private readonly curves: Curves;
  private readonly help = keyHelp();
  private readonly title = make("h1");
  private readonly cameraPicker = make("select", { id: "camera", "aria-label": "Look through" });
  private readonly origins = make("div");
  private readonly sections = make("div", { class: "sections" });

  constructor(root: HTMLElement, private readonly shots: (() => Shot)[], first: Shot) {
    this.store = new Store(first);
    this.view = new View(this.store);
    this.time = new TimeBar(this.store);
    this.curves = new Curves(this.store);
    const values = new ValueTable(this.store);
    const objects = new ObjectList(this.store);
    root.replaceChildren(
      this.header(),
      make(
        "main",
        {},
        make("div", { class: "stage" }, this.toolbar(), this.view.element, this.time.element, this.view.status),
        make(
          "div",
          { class: "panels" },
          section("Objects", objects.element),
          section("Values", values.element, this.origins),
          section("Curves", this.curves.element),
          this.sections,
        ),
      ),
      this.help,
    );
    this.store.listen((change) => {
      if (change === "shot") this.open();
      if (change !== "frame") this.explain();
      if (change === "view" || change === "shot") this.cameraPicker.value = String(this.store.camera);
    });
    this.cameraPicker.addEventListener("change", () => this.store.lookThrough(Number(this.cameraPicker.value)));
    document.addEventListener("keydown", (event) => this.key(event));
    this.followTheme();
    this.printWell();
    this.store.open(first);
  }

  private header(): HTMLElement {
    const header = make("header", {}, this.title);
    if (this.shots.length > 1) {
      const picker = make("select", { id: "file", "aria-label": "File" });
      this.shots.forEach((_, i) => picker.append(make("option", { value: String(i) }, `${i + 1} of ${this.shots.length}`)));
      picker.addEventListener("change", () => this.store.open(this.shots[Number(picker.value)]!()));
      header.append(picker);
    }
    header.append(
      pressed("Dark or light theme", () => this.switchTheme()),
      pressed("Print", () => window.print()),
      pressed("Keys", () => this.help.showModal()),
    );
    return header;
  }

  private toolbar(): HTMLElement {
    const switches = SWITCHES.map(([what, label]) => {
      const box = make("input", { type: "checkbox", "data-switch": what });
      box.checked = this.store.visible[what];
      box.addEventListener("change", () => this.store.show(what, box.checked));
      return make("label", {}, box, ` ${label}`);
    });
    return make("div", { class: "toolbar", role: "group", "aria-label": "View" }, this.cameraPicker, pressed("Frame all", () => this.view.frameAll()), ...switches);
  }

  private open(): void {
    const { data } = this.store.shot;
    const name = shown(data.file.split("/").pop() ?? "");
    document.title = `${name} — FBX report`;
    this.title.replaceChildren(make("bdi", {}, name), ...(data.take ? [make("span", { class: "quiet" }, " ", make("bdi", {}, shown(data.take)))] : []));
    const cameras = this.store.cameras().map((i) => make("option", { value: String(i) }, `Through ${shown(this.store.node(i)!.name)}`));
    this.cameraPicker.replaceChildren(make("option", { value: "-1" }, "Outside view"), ...cameras);
    const left = notes(this.store);
    this.sections.replaceChildren(
      section("Cameras", cameraTable(this.store)),
      section("Findings", findings(this.store)),
      ...(left ? [section("Limits of this page", left)] : []),
      section("Meshes", meshTable(this.store)),
      section("File", fileFacts(this.store)),
    );
  }

  private explain(): void {
    const text = explanation(this.store.node(this.store.selected));
    this.origins.replaceChildren(...(text ? [text] : []));
  }

  private key(event: KeyboardEvent): void {
    const target = event.target as HTMLElement;
    const types = target.matches("select, input:not([type=checkbox]):not([type=range])");
    if (event.ctrlKey || event.altKey || event.metaKey || types || this.help.open) return;
    if (event.key === " " && target.matches("button, input")) return; // they have a use for it
    const act = this.actionOf(event);
    if (!act) return;
    event.preventDefault();
    act();
  }

  private actionOf(event: KeyboardEvent): (() => void) | undefined {
    const { time, view, store } = this;
    const step = event.shiftKey ? 10 : 1;
    const turn = Math.PI / 24;
    const actions: Record<string, () => void> = {
      " ": () => time.togglePlay(),
      ArrowLeft: () => time.step(-step),
      ArrowRight: () => time.step(step),
      Home: () => time.go(0),
      End: () => time.go(Infinity),
      "0": () => view.frameAll(),
      f: () => view.frameAll(),
      a: () => view.orbit(-turn, 0),
      d: () => view.orbit(turn, 0),
      w: () => view.orbit(0, turn),
      s: () => view.orbit(0, -turn),
      "+": () => view.orbit(0, 0, 0.85),
      "-": () => view.orbit(0, 0, 1 / 0.85),
      g: () => store.show("grid", !store.visible.grid),
      t: () => this.switchTheme(),
      "?": () => this.help.showModal(),
    };
    const camera = /^[1-9]$/.test(event.key) ? store.cameras()[Number(event.key) - 1] : undefined;
    return camera === undefined ? actions[event.key.length === 1 ? event.key.toLowerCase() : event.key] : () => store.lookThrough(camera);
  }

  private setTheme(theme: string): void {
    document.documentElement.dataset["theme"] = theme;
    this.store.tell("theme");
  }

  private switchTheme(): void {
    this.setTheme(document.documentElement.dataset["theme"] === "dark" ? "light" : "dark");
  }

  private followTheme(): void {
    const dark = window.matchMedia("(prefers-color-scheme: dark)");
    document.documentElement.dataset["theme"] = dark.matches ? "dark" : "light";
    dark.addEventListener("change", () => this.setTheme(dark.matches ? "dark" : "light"));
  }

  /** Paper is light, and as wide as it is. */
  private printWell(): void {
    let before = "light";
    window.addEventListener("beforeprint", () => {
      before = document.documentElement.dataset["theme"] ?? "light";
      this.setTheme("light");
      this.curves.fit();
      this.view.render();
    });
    window.addEventListener("afterprint", () => this.setTheme(before));
  }
}

const root = document.getElementById("page")!;
const shots = shotsOf(document);
const first = shots[0];
if (first) new Page(root, shots, first());
