// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reports in a browser, without a network.
//   browser.mjs TOOL PROJECT_ROOT CHROMIUM PYTHON FOLDER
// FOLDER gets the scenes, their pages, and report.png, the picture that the README shows.
import assert from "node:assert/strict";
import { execFileSync } from "node:child_process";
import { readFileSync } from "node:fs";
import { createRequire } from "node:module";
import { join } from "node:path";
import { after, before, test } from "node:test";
import { pathToFileURL } from "node:url";
import puppeteer from "puppeteer-core";

const [tool, root, chromium, python, folder] = process.argv.slice(2);
const shot = join(root, "examples", "data", "shot_010.fbx");
const axe = readFileSync(createRequire(import.meta.url).resolve("axe-core/axe.min.js"), "utf8");

let browser;

before(async () => {
  execFileSync(python, ["-B", join(root, "tests", "report", "scenes.py"), folder, tool]);
  browser = await puppeteer.launch({
    executablePath: chromium,
    // Containers give the browser no sandbox of its own; the pages are ours. There may be no graphics card.
    args: ["--no-sandbox", "--use-angle=swiftshader", "--enable-unsafe-swiftshader", "--disable-dev-shm-usage"],
  });
});
after(() => browser?.close());

function write(name, ...files) {
  const page = join(folder, `${name}.html`);
  execFileSync(tool, ["report", ...files, "-o", page]);
  return page;
}

/** Opens a page, and returns its errors and requests. */
async function open(file, { theme = "light", width = 1280, height = 860 } = {}) {
  const page = await browser.newPage();
  const complaints = [];
  page.on("console", (message) => complaints.push(`${message.type()}: ${message.text()}`));
  page.on("pageerror", (error) => complaints.push(String(error)));
  page.on("request", (request) => {
    if (!/^(file|data|blob):/.test(request.url())) complaints.push(`asked for ${request.url()}`);
  });
  await page.setViewport({ width, height });
  await page.emulateMediaFeatures([{ name: "prefers-color-scheme", value: theme }]);
  await page.goto(pathToFileURL(file).href);
  await page.waitForFunction(() => performance.getEntriesByName("drawn").length > 0);
  return { page, complaints };
}

function faithful(file, kind) {
  const text = execFileSync(tool, ["dump", "--faithful", "--kind", kind, file], { encoding: "utf8", maxBuffer: 1 << 28 });
  return JSON.parse(text)[kind];
}

function at(channel, place) {
  return typeof channel === "object" ? channel.samples[place] : channel;
}

/** −Z, turned about one axis after the other in the order of the camera. */
function directionOf(camera, place) {
  let direction = [0, 0, -1];
  for (const axis of camera.rotationOrder) {
    const angle = (at(camera.transform[`rotation${axis}`], place) * Math.PI) / 180;
    const [u, v] = { X: [1, 2], Y: [2, 0], Z: [0, 1] }[axis];
    const turned = [...direction];
    turned[u] = direction[u] * Math.cos(angle) - direction[v] * Math.sin(angle);
    turned[v] = direction[u] * Math.sin(angle) + direction[v] * Math.cos(angle);
    direction = turned;
  }
  return direction;
}

/** The camera of the picture has the placement of the faithful one; returns its direction. */
async function assertDrawn(page, camera, place) {
  const drawn = await page.$eval(".status", (status) => [status.dataset.position, status.dataset.direction].map((text) => text.split(" ").map(Number)));
  const position = ["X", "Y", "Z"].map((axis) => at(camera.transform[`position${axis}`], place));
  const direction = directionOf(camera, place);
  drawn[0].forEach((value, i) => assert.ok(Math.abs(value - position[i]) < 1e-4, `at ${drawn[0]} instead of ${position}`));
  drawn[1].forEach((value, i) => assert.ok(Math.abs(value - direction[i]) < 1e-6, `looks ${drawn[1]} instead of ${direction}`));
  return drawn[1];
}

async function setSlider(page, value) {
  await page.$eval("#frame", (slider, wanted) => {
    slider.value = String(wanted);
    slider.dispatchEvent(new Event("input", { bubbles: true }));
  }, value);
}

const valueOf = (page, key) => page.$eval(`.values [data-key="${key}"]`, (cell) => cell.textContent.replaceAll("−", "-"));
const numbersOf = (text) => (text.match(/-?\d+(\.\d+)?/g) ?? []).map(Number);
const shownNumber = (value, digits) => Number(value.toFixed(digits)) + 0;

/** How many different colours a part of the page has: a view that shows nothing has one. */
async function coloursIn(page, selector) {
  return page.$eval(selector, (canvas) => {
    const copy = document.createElement("canvas");
    copy.width = 160;
    copy.height = 120;
    const context = copy.getContext("2d");
    context.drawImage(canvas, 0, 0, copy.width, copy.height);
    const pixels = new Uint32Array(context.getImageData(0, 0, copy.width, copy.height).data.buffer);
    return new Set(pixels).size;
  });
}

test("opens without a complaint, and shows the scene", async () => {
  const { page, complaints } = await open(write("shot", shot));
  assert.ok((await coloursIn(page, ".view canvas")) > 20);
  assert.equal(await page.title(), "shot_010.fbx — FBX report");
  assert.deepEqual(await page.$$eval("#camera option", (all) => all.map((option) => option.textContent)), ["Outside view", "Through shotCam"]);
  assert.deepEqual(complaints, []);
  await page.close();
});

/** What `camera` prints of the first camera, frame by frame. */
function printed(file, frames) {
  const text = execFileSync(tool, ["camera", "--json", "--frames", frames, file], { encoding: "utf8" });
  return JSON.parse(text).cameras[0].frames;
}

test("the slider moves the camera to the numbers that `camera` prints", async () => {
  const moments = printed(shot, "1001:1048");
  const [camera] = faithful(shot, "cameras");
  const { page, complaints } = await open(write("shot", shot));
  await page.select("#camera", await page.$eval("#camera option:last-child", (option) => option.value));
  for (const place of [0, 17, 47]) {
    await setSlider(page, place);
    const position = ["X", "Y", "Z"].map((axis) => at(camera.transform[`position${axis}`], place));
    assert.deepEqual(numbersOf(await valueOf(page, "position")), position.map((value) => shownNumber(value, 3)));
    assert.deepEqual(numbersOf(await valueOf(page, "focalLength")), [shownNumber(at(camera.channels.focalLength, place), 4)]);
    assert.equal(await page.$eval("#frame-number", (field) => field.value), String(1001 + place));

    const moment = moments[place];
    assert.equal(moment.frame, 1001 + place);
    assert.deepEqual(numbersOf(await valueOf(page, "position")), moment.position.map((value) => shownNumber(value, 3)));
    assert.deepEqual(numbersOf(await valueOf(page, "direction")), moment.direction.map((value) => shownNumber(value, 4)));
    assert.deepEqual(numbersOf(await valueOf(page, "filmAngles")), moment.fov.map((value) => shownNumber(value, 3)));
    assert.deepEqual(numbersOf(await valueOf(page, "pictureAngles")), moment.pictureFov.map((value) => shownNumber(value, 3)));
    assert.deepEqual(numbersOf(await valueOf(page, "focalLength")), [shownNumber(moment.focalLength, 4)]);
    await assertDrawn(page, camera, place);
  }
  assert.deepEqual(complaints, []);
  await page.close();
});

test("cameras look where their angles turn them, in each rotation order", async () => {
  const file = join(folder, "orders.fbx");
  const { page } = await open(write("orders", file));
  const directions = new Set();
  for (const camera of faithful(file, "cameras")) {
    await page.keyboard.press(String(directions.size + 1));
    directions.add(String(await assertDrawn(page, camera, 0)));
  }
  assert.equal(directions.size, 6);
  await page.close();
});

test("film and picture meet as the gate fit says", async () => {
  const [camera] = faithful(shot, "cameras");
  const { page } = await open(write("shot", shot));
  const focal = at(camera.channels.focalLength, 0);
  const film = camera.channels.apertureWidth * 25.4;
  const angle = (side) => (2 * Math.atan(side / 2 / focal) * 180) / Math.PI;
  // 1920 × 1080 with a horizontal fit: the picture is as wide as the film
  const expected = [angle(film), angle((film * 1080) / 1920)].map((value) => shownNumber(value, 3));
  assert.deepEqual(numbersOf(await valueOf(page, "pictureAngles")), expected);
  assert.match(await valueOf(page, "aspect"), /^1920 × 1080 = 1\.778; gate fit horizontal$/);
  await page.keyboard.press("1");
  const boxes = await page.$$eval(".overlay rect", (all) =>
    Object.fromEntries(all.map((box) => [box.getAttribute("class"), ["width", "height"].map((side) => Number(box.getAttribute(side)))])),
  );
  const close = (a, b) => assert.ok(Math.abs(a - b) < 0.01, `${a} is not ${b}`);
  close(boxes.picture[0], boxes.film[0]);
  close(boxes.picture[1] / boxes.film[1], (film * 1080) / 1920 / (camera.channels.apertureHeight * 25.4));
  close(boxes.safe[1] / boxes.picture[1], 0.9);
  await page.close();
});

test("names stay names", async () => {
  const { page, complaints } = await open(write("names", join(folder, "names.fbx")));
  const texts = await page.$$eval("#objects option", (all) => all.map((option) => option.textContent));
  assert.deepEqual(texts.slice(0, 9), [
    "<script>window.hacked=1</script>  [node]",
    "</script><img src=x onerror=window.hacked=1>  [node]",
    "<!-- <script>  [node]",
    "a&b &amp;  [node]",
    "it's \\ `${1}`  [node]",
    "tab\\tbell\\x07  [node]",
    "\\u202egnp.exe  [node]",
    "]]> --> \\u2028  [node]",
    "Größe 東京  [node]",
  ]);
  await page.keyboard.press("1"); // the camera of that name, in every place that names it
  assert.equal(await page.evaluate(() => window.hacked), undefined);
  assert.equal((await page.$$("#page script, #page img")).length, 0);
  assert.match(await page.$eval(".status", (status) => status.textContent), /^<script>window\.hacked=1<\/script>: at/);
  assert.deepEqual(complaints, []);
  await page.close();
});

test("keys step, look through cameras, play and help", async () => {
  const { page, complaints } = await open(write("shot", shot));
  const frame = () => page.$eval("#frame-number", (field) => Number(field.value));
  const press = async (key) => {
    await page.keyboard.press(key);
    return frame();
  };
  assert.equal(await press("ArrowRight"), 1002);
  assert.equal(await press("End"), 1048);
  assert.equal(await press("ArrowLeft"), 1047);
  assert.equal(await press("Home"), 1001);
  await page.keyboard.down("Shift");
  assert.equal(await press("ArrowRight"), 1011);
  await page.keyboard.up("Shift");
  await press("1");
  assert.match(await page.$eval(".status", (status) => status.textContent), /^shotCam: at/);
  await press("a"); // turning leaves the camera
  assert.equal(await page.$eval("#camera", (picker) => picker.value), "-1");
  await press("Space");
  await page.waitForFunction(() => Number(document.getElementById("frame-number").value) !== 1011);
  await press("Space");
  const stopped = await frame();
  await new Promise((resolve) => setTimeout(resolve, 150));
  assert.equal(await frame(), stopped);
  await press("?");
  assert.ok(await page.$eval("dialog", (dialog) => dialog.open));
  await press("Escape");
  const theme = () => page.evaluate(() => document.documentElement.dataset.theme);
  assert.equal(await theme(), "light");
  await press("t");
  assert.equal(await theme(), "dark");
  assert.deepEqual(complaints, []);
  await page.close();
});

test("curves stand for what is animated, and follow the frame both ways", async () => {
  const { page } = await open(write("shot", shot), { height: 2600 });
  const plots = await page.$$eval("[data-plot]", (all) => all.map((plot) => plot.getAttribute("aria-label")));
  assert.match(plots[0], /^Focal length, mm: focal length from 35 to 50 mm$/);
  assert.ok(plots.some((label) => label.startsWith("Position, cm: X from 0 to 150")), plots.join("; "));
  const legend = () => page.$eval("[data-plot='Focal length'] .u-legend", (element) => element.textContent);
  await setSlider(page, 47);
  assert.match(await legend(), /1048.*50/);
  const over = await page.$("[data-plot='Focal length'] .u-over");
  const box = await over.boundingBox();
  await page.mouse.click(box.x + box.width / 2, box.y + box.height / 2);
  const frame = await page.$eval("#frame-number", (field) => Number(field.value));
  assert.ok(frame > 1015 && frame < 1035, `frame ${frame}`);
  await page.close();
});

test("axe finds nothing serious, dark and light", async () => {
  for (const theme of ["light", "dark"]) {
    const { page } = await open(write("shot", shot), { theme });
    await page.evaluate(axe);
    const found = await page.evaluate(() => window.axe.run());
    const serious = found.violations.filter((each) => ["serious", "critical"].includes(each.impact));
    assert.deepEqual(serious.map((each) => `${theme}: ${each.id}: ${each.nodes.map((node) => node.html).join(" ")}`), []);
    assert.ok(found.passes.length > 15);
    await page.close();
  }
});

test("prints all of it on light paper", async () => {
  const { page } = await open(write("shot", shot), { theme: "dark" });
  const pdf = await page.pdf({ format: "a4" });
  assert.equal(Buffer.from(pdf.subarray(0, 5)).toString(), "%PDF-");
  await page.emulateMediaType("print");
  assert.equal(await page.$eval(".toolbar", (bar) => getComputedStyle(bar).display), "none");
  assert.notEqual(await page.$eval(".values", (values) => getComputedStyle(values).display), "none");
  await page.close();
});

test("several files share a page", async () => {
  const { page, complaints } = await open(write("two", shot, join(folder, "names.fbx")));
  await page.select("#file", "1");
  assert.equal(await page.title(), "names.fbx — FBX report");
  await page.select("#file", "0");
  assert.equal(await page.$eval("#frame-number", (field) => field.value), "1001");
  assert.deepEqual(complaints, []);
  await page.close();
});

test("a file of 20 MB opens in two seconds", async (context) => {
  const file = write("large", join(folder, "large.fbx"));
  let best = Infinity;
  for (let i = 0; i < 3; ++i) { // other work on the machine can only make it slower
    const { page, complaints } = await open(file);
    best = Math.min(best, await page.evaluate(() => performance.getEntriesByName("drawn")[0].startTime));
    assert.deepEqual(complaints, []);
    assert.match(await page.$eval(".sections", (all) => all.textContent), /1 mesh is simplified/);
    await page.close();
  }
  context.diagnostic(`drawn after ${Math.round(best)} ms`);
  assert.ok(best < 2000, `${best} ms`);
});

test("the picture that the README shows", async () => {
  const { page } = await open(write("shot", shot), { width: 1200, height: 720 });
  await page.keyboard.press("1");
  await setSlider(page, 12);
  await new Promise((resolve) => setTimeout(resolve, 300));
  const picture = await page.screenshot({ path: join(folder, "report.png") });
  assert.ok(picture.length > 10000 && picture.length < 150000, `${picture.length} bytes`);
  await page.close();
});
