// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The hierarchy of all nodes; the values and curves of the selected one are shown.

import type { Store } from "./store.ts";
import { make, shown } from "./text.ts";

export class ObjectList {
  readonly element: HTMLElement;
  private readonly store: Store;
  private readonly search = make("input", { type: "search", id: "search", placeholder: "Find", "aria-label": "Find objects by name" });
  private readonly list = make("select", { size: "5", id: "objects", "aria-label": "Objects" });

  constructor(store: Store) {
    this.store = store;
    this.element = make("div", { class: "objects" }, this.search, this.list);
    this.search.addEventListener("input", () => this.fill());
    this.list.addEventListener("change", () => store.select(Number(this.list.value)));
    store.listen((change) => {
      if (change === "shot") {
        this.search.value = "";
        this.fill();
      } else if (change !== "frame") {
        this.list.value = String(store.selected);
      }
    });
  }

  private fill(): void {
    const { nodes } = this.store.shot.data;
    const wanted = this.search.value.toLowerCase();
    const depths: number[] = [];
    const options = nodes.flatMap((node, i) => {
      depths[i] = node.parent < 0 ? 0 : depths[node.parent]! + 1;
      const name = shown(node.name);
      if (wanted && !name.toLowerCase().includes(wanted)) return [];
      const indent = wanted ? "" : "\u2003".repeat(Math.min(depths[i]!, 12));
      return [make("option", { value: String(i) }, `${indent}${name || "(no name)"}  [${node.kind}]`)];
    });
    this.list.replaceChildren(...options);
    this.list.value = String(this.store.selected);
  }
}
