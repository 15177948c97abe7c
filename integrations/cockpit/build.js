// Builds the page into the directory that is given, or into dist/.
import { copyFile, mkdir, readFile, readdir, rm, writeFile } from "node:fs/promises";
import { dirname, join, resolve } from "node:path";
import { fileURLToPath } from "node:url";
import { build } from "esbuild";
import { compile } from "./translation.js";

const here = dirname(fileURLToPath(import.meta.url));
const out = resolve(process.argv[2] ?? join(here, "dist"));

for (const file of await readdir(out).catch(() => []))
    await rm(join(out, file), { recursive: true });
await mkdir(out, { recursive: true });
await build({
    absWorkingDir: here,
    entryPoints: ["src/index.js", "src/index.css"],
    bundle: true,
    minify: true,
    format: "esm",
    target: ["chrome111", "firefox115", "safari16.4"],
    external: ["../../static/*", "*.jpg", "*.png", "*.svg"], // Cockpit serves its fonts; nothing uses the images
    legalComments: "eof",
    logLevel: "warning",
    outdir: out,
});
await copyFile(join(here, "src/index.html"), join(out, "index.html"));
await copyFile(join(here, "manifest.json"), join(out, "manifest.json"));
// Browsers whose language there is no translation for get an empty one.
await writeFile(join(out, "po.js"), "");
for (const file of await readdir(join(here, "po")))
    if (file.endsWith(".po"))
        await writeFile(join(out, `po.${file.slice(0, -3)}.js`), compile(await readFile(join(here, "po", file), "utf8")));
