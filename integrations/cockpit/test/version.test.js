import assert from "node:assert/strict";
import { readFileSync } from "node:fs";
import { test } from "node:test";
import { isRecent, oldestMihost } from "../src/version.js";

test("isRecent accepts the version itself and newer ones", () => {
    for (const version of ["1.2.3", "1.2.4", "1.3.0", "2.0.0", "1.10.0"])
        assert.ok(isRecent(`mihost ${version}\n`, "1.2.3"), version);
});

test("isRecent refuses older versions and other texts", () => {
    for (const output of ["mihost 1.2.2", "mihost 1.1.9", "mihost 0.9.9", "", "usage: mihost"])
        assert.ok(!isRecent(output, "1.2.3"), output);
});

test("the oldest mihost is not newer than this page", () => {
    const manifest = JSON.parse(readFileSync(new URL("../manifest.json", import.meta.url), "utf8"));
    assert.ok(isRecent(manifest.version, oldestMihost));
});
