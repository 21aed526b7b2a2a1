// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The frames of the shot: a slider, a number, and playing at the file's rate.

import type { Store } from "./store.ts";
import { make, number } from "./text.ts";

/** Drawn, since few fonts have all of these signs. */
const SIGNS = {
  first: "M2 2h2v12H2Z M14 2L5 8l9 6Z",
  back: "M12 2L6 8l6 6Z M3 2h2v12H3Z",
  play: "M4 2l9 6l-9 6Z",
  pause: "M3 2h3v12H3Z M10 2h3v12h-3Z",
  on: "M4 2l6 6l-6 6Z M11 2h2v12h-2Z",
  last: "M2 2l9 6l-9 6Z M12 2h2v12h-2Z",
};
const SVG = "http://www.w3.org/2000/svg";

function drawn(sign: keyof typeof SIGNS): SVGElement {
  const svg = document.createElementNS(SVG, "svg");
  svg.setAttribute("viewBox", "0 0 16 16");
  svg.setAttribute("aria-hidden", "true");
  const path = document.createElementNS(SVG, "path");
  path.setAttribute("d", SIGNS[sign]);
  svg.append(path);
  return svg;
}

function button(label: string, sign: keyof typeof SIGNS, press: () => void): HTMLButtonElement {
  const element = make("button", { type: "button", "aria-label": label, title: label }, drawn(sign));
  element.addEventListener("click", press);
  return element;
}

export class TimeBar {
  readonly element: HTMLElement;
  private readonly store: Store;
  private readonly slider = make("input", { type: "range", id: "frame", min: "0", step: "1", "aria-label": "Frame" });
  private readonly field = make("input", { type: "number", id: "frame-number", "aria-label": "Frame number" });
  private readonly rate = make("span", { class: "quiet" });
  private readonly playButton: HTMLButtonElement;
  private playedFrom = 0;
  private playedSince = 0;

  constructor(store: Store) {
    this.store = store;
    this.playButton = button("Play (space)", "play", () => this.togglePlay());
    this.element = make(
      "div",
      { class: "timebar", role: "group", "aria-label": "Time" },
      button("First frame (Home)", "first", () => this.go(0)),
      button("Previous frame (←)", "back", () => this.step(-1)),
      this.playButton,
      button("Next frame (→)", "on", () => this.step(1)),
      button("Last frame (End)", "last", () => this.go(Infinity)),
      this.slider,
      this.field,
      this.rate,
    );
    this.slider.addEventListener("input", () => this.go(this.slider.valueAsNumber));
    this.field.addEventListener("change", () => this.goToNumber(this.field.valueAsNumber));
    store.listen((change) => {
      if (change === "shot") this.open();
      else if (change === "frame") this.show();
    });
  }

  step(frames: number): void {
    this.go(this.store.frame + frames);
  }

  go(index: number): void {
    this.stop();
    this.store.setFrame(Math.min(index, this.store.shot.frameCount - 1));
  }

  togglePlay(): void {
    if (this.store.playing) {
      this.stop();
      return;
    }
    if (this.store.shot.frameCount < 2) return;
    this.store.playing = true;
    this.playedFrom = this.store.frame;
    this.playedSince = performance.now();
    this.showPlaying();
    requestAnimationFrame((now) => this.play(now));
  }

  private stop(): void {
    this.store.playing = false;
    this.showPlaying();
  }

  private play(now: number): void {
    if (!this.store.playing) return;
    const { rate, step } = this.store.shot.data.frames;
    const passed = Math.floor((Math.max(0, now - this.playedSince) / 1000) * (rate / step));
    this.store.setFrame((this.playedFrom + passed) % this.store.shot.frameCount);
    requestAnimationFrame((next) => this.play(next));
  }

  /** The nearest frame that there is. */
  private goToNumber(frame: number): void {
    const { first, step } = this.store.shot.data.frames;
    if (Number.isFinite(frame)) this.go(Math.round((frame - first) / step));
    this.show();
  }

  private open(): void {
    this.stop();
    const { shot } = this.store;
    const { rate, step } = shot.data.frames;
    this.slider.max = String(shot.frameCount - 1);
    this.slider.disabled = shot.frameCount < 2;
    this.field.min = String(shot.frameAt(0));
    this.field.max = String(shot.frameAt(shot.frameCount - 1));
    this.rate.textContent =
      `${shot.frameAt(0)} to ${shot.frameAt(shot.frameCount - 1)}` +
      `${step > 1 ? `, every ${step}th` : ""} at ${number(rate, 3)} frames per second`;
    this.show();
  }

  private show(): void {
    const frame = this.store.shot.frameAt(this.store.frame);
    this.slider.value = String(this.store.frame);
    this.slider.setAttribute("aria-valuetext", `frame ${frame}`);
    this.field.value = String(frame);
  }

  private showPlaying(): void {
    this.playButton.replaceChildren(drawn(this.store.playing ? "pause" : "play"));
    const label = this.store.playing ? "Pause (space)" : "Play (space)";
    this.playButton.setAttribute("aria-label", label);
    this.playButton.title = label;
  }
}
