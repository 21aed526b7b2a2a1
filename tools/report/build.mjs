// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Makes one page of src/, with scripts and styles inside, and writes it as a C++ source in two parts: the text before
// the data of files, and the text after it.
//   node build.mjs OUTPUT.cpp
import { createHash } from "node:crypto";
import { readFileSync, writeFileSync } from "node:fs";
import { fileURLToPath } from "node:url";
import { build } from "esbuild";

const folder = fileURLToPath(new URL(".", import.meta.url));

async function bundle(entry) {
  const result = await build({
    absWorkingDir: folder,
    entryPoints: [entry],
    bundle: true,
    minify: true,
    write: false,
    format: "iife",
    target: "es2022",
    charset: "ascii",
    legalComments: "inline",
    logLevel: "warning",
  });
  return result.outputFiles[0].text;
}

/** What a content security policy calls the text of an element. */
function hash(text) {
  return `'sha256-${createHash("sha256").update(text).digest("base64")}'`;
}

/** C++ takes literals of a moderate length only, so texts go in pieces. */
function literals(text) {
  const pieces = [];
  for (let at = 0; at < text.length; at += 8000) pieces.push(text.slice(at, at + 8000));
  return pieces.map((piece) => `    R"page(${piece})page"sv,`).join("\n");
}

/** The licences of the bundled packages, as their terms require. */
function licences() {
  return ["three", "uplot"]
    .map((name) => `${name}\n\n${readFileSync(new URL(`node_modules/${name}/LICENSE`, import.meta.url), "utf8")}`)
    .join("\n")
    .replaceAll("--", "- -");
}

const script = (await bundle("src/main.ts")).replaceAll("</script", "<\\/script");
const style = await bundle("src/page.css");
const policy = `default-src 'none'; img-src data: blob:; script-src ${hash(script)}; style-src ${hash(style)}`;
const page = readFileSync(new URL("src/page.html", import.meta.url), "utf8")
  .replace("{licences}", () => licences())
  .replace("{policy}", () => policy)
  .replace("{style}", () => style)
  .replace("{script}", () => script);
const [head, tail] = page.split("{data}\n");

writeFileSync(
  process.argv[2],
  `// Made by tools/report/build.mjs.
#include "ReportTemplate.h"

#include <array>

namespace tool {
namespace {

using namespace std::string_view_literals;

constexpr auto kHead = std::to_array<std::string_view>({
${literals(head)}
});
constexpr auto kTail = std::to_array<std::string_view>({
${literals(tail)}
});

} // namespace

const std::span<const std::string_view> kReportHead = kHead;
const std::span<const std::string_view> kReportTail = kTail;

} // namespace tool
`,
);
