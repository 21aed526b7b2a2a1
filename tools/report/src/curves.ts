// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The curves of the node that is selected, one plot for each unit; a line marks the frame that is shown.

import uPlot from "uplot";
import type { Store } from "./store.ts";
import { make, number } from "./text.ts";

/** Plots in their order, and the channels of each. */
const PLOTS: { title: string; unit: string; channels: [channel: string, label: string][] }[] = [
  { title: "Focal length", unit: "mm", channels: [["focalLength", "focal length"]] },
  { title: "Field of view", unit: "°", channels: [["fieldOfViewX", "horizontal"], ["fieldOfViewY", "vertical"]] },
  {
    title: "Film",
    unit: "in",
    channels: [["apertureWidth", "width"], ["apertureHeight", "height"], ["filmOffsetX", "offset X"], ["filmOffsetY", "offset Y"]],
  },
  { title: "Clip planes", unit: "cm", channels: [["nearPlane", "near"], ["farPlane", "far"]] },
  { title: "Cone angle", unit: "°", channels: [["coneAngle", "cone"]] },
  { title: "Light", unit: "", channels: [["intensity", "intensity"], ["red", "red"], ["green", "green"], ["blue", "blue"]] },
  { title: "Position", unit: "cm", channels: [["positionX", "X"], ["positionY", "Y"], ["positionZ", "Z"]] },
  { title: "Rotation", unit: "°", channels: [["rotationX", "X"], ["rotationY", "Y"], ["rotationZ", "Z"], ["roll", "roll"]] },
  { title: "Scale", unit: "", channels: [["scaleX", "X"], ["scaleY", "Y"], ["scaleZ", "Z"]] },
  { title: "Shear", unit: "", channels: [["skewX", "X"], ["skewY", "Y"], ["skewZ", "Z"]] },
];
const HEIGHT = 150;

function style(name: string): string {
  return getComputedStyle(document.documentElement).getPropertyValue(name).trim();
}

/** "from 35 to 50 mm": what the plot shows, for those who do not see it. */
function rangeOf(values: Float32Array, unit: string): string {
  let least = Infinity;
  let most = -Infinity;
  for (const value of values) {
    if (value < least) least = value;
    if (value > most) most = value;
  }
  return `from ${number(least)} to ${number(most)} ${unit}`.trim();
}

export class Curves {
  readonly element = make("div", { class: "curves" });
  private readonly store: Store;
  private plots: uPlot[] = [];

  constructor(store: Store) {
    this.store = store;
    store.listen((change) => {
      if (change === "frame") for (const plot of this.plots) this.follow(plot);
      else if (change !== "view") this.draw();
    });
    new ResizeObserver(() => this.fit()).observe(this.element);
  }

  /** As wide as there is room; printers call it, too. */
  fit(): void {
    const width = this.element.clientWidth;
    if (width > 0) for (const plot of this.plots) if (plot.width !== width) plot.setSize({ width, height: HEIGHT });
  }

  /** Anew for another node, or for other colours. */
  draw(): void {
    for (const plot of this.plots) plot.destroy();
    this.plots = [];
    this.element.replaceChildren();
    const node = this.store.node(this.store.selected);
    if (!node) return;
    const shot = this.store.shot;
    for (const { title, unit, channels } of PLOTS) {
      const animated = channels.filter(([channel]) => shot.isAnimated(node, channel));
      if (animated.length === 0) continue;
      const samples = animated.map(([channel]) => shot.samples(node, channel)!);
      const summary = animated.map(([, label], i) => `${label} ${rangeOf(samples[i]!, unit)}`).join("; ");
      const heading = unit ? `${title}, ${unit}` : title;
      const figure = make("figure", {}, make("figcaption", {}, heading));
      const canvas = make("div", { role: "img", "aria-label": `${heading}: ${summary}`, "data-plot": title });
      figure.append(canvas);
      this.element.append(figure);
      this.plots.push(this.plot(canvas, animated.map(([, label]) => label), samples));
    }
    if (this.plots.length === 0) this.element.append(make("p", { class: "empty" }, "Nothing is animated."));
  }

  private plot(parent: HTMLElement, labels: string[], samples: Float32Array[]): uPlot {
    const { shot } = this.store;
    const frames = Array.from({ length: shot.frameCount }, (_, i) => shot.frameAt(i));
    const inks = ["--curve-1", "--curve-2", "--curve-3", "--curve-4"].map(style);
    const axis = { stroke: style("--quiet"), grid: { stroke: style("--line"), width: 1 }, ticks: { stroke: style("--line"), width: 1 }, font: "11px system-ui" };
    const options: uPlot.Options = {
      width: Math.max(this.element.clientWidth, 200),
      height: HEIGHT,
      scales: { x: { time: false } },
      cursor: { y: false, drag: { x: false, y: false }, sync: { key: "frames" } },
      legend: { live: true },
      axes: [{ ...axis, size: 28, values: (_, frames) => frames.map((frame) => number(frame)) }, { ...axis, size: 62 }],
      series: [
        { label: "frame", value: (_, frame: number | null) => number(frame) },
        ...labels.map((label, i) => ({
          label,
          stroke: inks[i % inks.length]!,
          width: 1.5,
          points: { show: false },
          value: (_: uPlot, value: number | null) => number(value, 4),
        })),
      ],
      hooks: { draw: [(plot) => this.drawFrame(plot)], ready: [(plot) => this.listenTo(plot)] },
    };
    const gaps = (values: Float32Array) => Array.from(values, (value) => (Number.isFinite(value) ? value : null));
    return new uPlot(options, [frames, ...samples.map(gaps)], parent);
  }

  private follow(plot: uPlot): void {
    plot.setLegend({ idx: this.store.frame });
    plot.redraw(false, false);
  }

  private drawFrame(plot: uPlot): void {
    const x = Math.round(plot.valToPos(this.store.shot.frameAt(this.store.frame), "x", true));
    plot.ctx.save();
    plot.ctx.strokeStyle = style("--chosen");
    plot.ctx.lineWidth = window.devicePixelRatio;
    plot.ctx.beginPath();
    plot.ctx.moveTo(x, plot.bbox.top);
    plot.ctx.lineTo(x, plot.bbox.top + plot.bbox.height);
    plot.ctx.stroke();
    plot.ctx.restore();
  }

  /** A click, or a drag, goes to the frame below it. */
  private listenTo(plot: uPlot): void {
    plot.setLegend({ idx: this.store.frame });
    const go = (event: PointerEvent) => {
      if (event.buttons !== 1) return;
      this.store.setFrame(plot.posToIdx(event.clientX - plot.over.getBoundingClientRect().left));
    };
    plot.over.addEventListener("pointerdown", go);
    plot.over.addEventListener("pointermove", go);
  }
}
