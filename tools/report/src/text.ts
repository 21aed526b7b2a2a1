// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Words and numbers for display. Names may contain anything: they only ever become the text of elements, and what
// cannot be seen, or turns the direction of writing, is spelt out.

const UNSEEN = /[\u0000-\u001f\u007f-\u009f\u200b-\u200f\u2028-\u202e\u2060-\u2069\ufeff]/gu;

export function shown(name: string): string {
  return name.replace(UNSEEN, (c) => {
    const code = c.charCodeAt(0);
    const simple = { 9: "\\t", 10: "\\n", 13: "\\r" }[code];
    return simple ?? (code < 256 ? `\\x${code.toString(16).padStart(2, "0")}` : `\\u${code.toString(16).padStart(4, "0")}`);
  });
}

/** At most so many digits behind the point, none of them useless; "—" for what is no number. */
export function number(value: number | null | undefined, digits = 3): string {
  if (value === null || value === undefined || !Number.isFinite(value)) return "—";
  const text = value.toFixed(digits);
  const short = text.includes(".") ? text.replace(/0+$/, "").replace(/\.$/, "") : text;
  return short === "-0" ? "0" : short.replace("-", "−");
}

export function size(bytes: number): string {
  if (bytes < 1024) return `${bytes} bytes`;
  return bytes < 1024 * 1024 ? `${number(bytes / 1024, 1)} KiB` : `${number(bytes / 1024 / 1024, 1)} MiB`;
}

export function counted(count: number, one: string, many: string): string {
  return `${count.toLocaleString("en")} ${count === 1 ? one : many}`;
}

type Child = Node | string;

/** An element with attributes and children; text stays text. */
export function make<Name extends keyof HTMLElementTagNameMap>(
  name: Name,
  attributes: Record<string, string> = {},
  ...children: Child[]
): HTMLElementTagNameMap[Name] {
  const element = document.createElement(name);
  for (const [key, value] of Object.entries(attributes)) element.setAttribute(key, value);
  element.append(...children);
  return element;
}

/** A name, set apart from the direction of the text around it. */
export function nameText(name: string): HTMLElement {
  return make("bdi", { class: "name" }, shown(name) || "(no name)");
}
