// Builds the page into dist/.
import { copyFile, mkdir, readFile, readdir, rm, writeFile } from "node:fs/promises";
import { dirname, join } from "node:path";
import { fileURLToPath } from "node:url";
import { gzipSync } from "node:zlib";
import { build } from "esbuild";
import { compile } from "./translation.js";

const here = dirname(fileURLToPath(import.meta.url));
const out = join(here, "dist");

await rm(out, { recursive: true, force: true });
await mkdir(out, { recursive: true });
const { outputFiles } = await build({
    write: false,
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
// Cockpit serves a file that exists only compressed under its uncompressed name.
for (const { path, contents } of outputFiles)
    await writeFile(`${path}.gz`, gzipSync(contents, { level: 9 }));
await copyFile(join(here, "src/index.html"), join(out, "index.html"));
await copyFile(join(here, "manifest.json"), join(out, "manifest.json"));
// Browsers in a language without a translation get an empty one.
await writeFile(join(out, "po.js"), "");
for (const file of await readdir(join(here, "po")))
    if (file.endsWith(".po"))
        await writeFile(join(out, `po.${file.slice(0, -3)}.js`),
            compile(await readFile(join(here, "po", file), "utf8")));
