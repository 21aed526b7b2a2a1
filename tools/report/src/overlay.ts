// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What lies over the scene: gates and safe areas of the camera that is looked through, and names.

import type { Size } from "./optics.ts";
import { make } from "./text.ts";

/** Of the picture: where action and titles are safe on screens of today (SMPTE ST 2046-1). */
export const SAFE_AREAS = { action: 0.93, title: 0.9 };

const SVG = "http://www.w3.org/2000/svg";

interface Box {
  x: number;
  y: number;
  width: number;
  height: number;
}

/** A rectangle of the film plane in the middle of a view of 1000 × 1000. */
function boxOf(gate: Size, view: Size): Box {
  const width = (1000 * gate.width) / view.width;
  const height = (1000 * gate.height) / view.height;
  return { x: 500 - width / 2, y: 500 - height / 2, width, height };
}

export class Overlay {
  readonly element = make("div", { class: "overlay", "aria-hidden": "true" });
  private readonly svg = document.createElementNS(SVG, "svg");
  private readonly names = make("div", { class: "tags" });

  constructor() {
    this.svg.setAttribute("viewBox", "0 0 1000 1000");
    this.svg.setAttribute("preserveAspectRatio", "none");
    this.element.append(this.svg, this.names);
  }

  hideGate(): void {
    this.svg.replaceChildren();
  }

  drawGate(picture: Size, film: Size, view: Size, safe: boolean): void {
    const box = boxOf(picture, view);
    const mask = document.createElementNS(SVG, "path");
    mask.setAttribute("class", "mask");
    mask.setAttribute("d", `M0 0H1000V1000H0Z M${box.x} ${box.y}v${box.height}h${box.width}v${-box.height}Z`);
    const areas = safe ? Object.values(SAFE_AREAS) : [];
    this.svg.replaceChildren(
      mask,
      this.rectangle(boxOf(film, view), "film"),
      ...areas.map((part) => this.rectangle(boxOf({ width: picture.width * part, height: picture.height * part }, view), "safe")),
      this.rectangle(box, "picture"),
    );
  }

  drawNames(tags: { name: string; x: number; y: number }[], width: number, height: number): void {
    this.names.replaceChildren(
      ...tags.map(({ name, x, y }) => {
        const tag = make("bdi", { class: "tag" }, name);
        tag.style.transform = `translate(${x * width}px, ${y * height}px)`;
        return tag;
      }),
    );
  }

  private rectangle(box: Box, name: string): SVGElement {
    const element = document.createElementNS(SVG, "rect");
    element.setAttribute("class", name);
    for (const [key, value] of Object.entries(box)) element.setAttribute(key, String(value));
    return element;
  }
}
