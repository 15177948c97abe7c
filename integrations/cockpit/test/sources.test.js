import assert from "node:assert/strict";
import { readFileSync, readdirSync } from "node:fs";
import { test } from "node:test";

const source = new URL("../src/", import.meta.url);
const modules = readdirSync(source, { recursive: true }).map(String).filter(name => name.endsWith(".js"));
const texts = new Map(modules.map(name => [name, readFileSync(new URL(name, source), "utf8")]));

test("no module turns text into markup or code", () => {
    assert.ok(texts.size > 20);
    const traps = /innerHTML|outerHTML|insertAdjacentHTML|document\.write|DOMParser|\beval\(|new Function/;
    for (const [name, text] of texts)
        assert.doesNotMatch(text, traps, name);
});

test("no module sets a style as text", () => {
    for (const [name, text] of texts)
        assert.doesNotMatch(text, /\bstyle: |cssText|setAttribute\("style"/, name);
});

test("no line is longer than 120 characters", () => {
    for (const [name, text] of texts)
        assert.deepEqual(text.split("\n").filter(line => line.length > 120), [], name);
});

test("only mihost.js starts programs, and only mihost", () => {
    for (const [name, text] of texts) {
        const calls = text.match(/cockpit\.(spawn|script|file|http|dbus|channel)\(.*/g) ?? [];
        assert.deepEqual(calls.length, name === "mihost.js" ? 1 : 0, name);
        assert.ok(calls.every(call => call.startsWith("cockpit.spawn([\"mihost\", ")), name);
    }
});

test("the content security policy has no exceptions", () => {
    const manifest = JSON.parse(readFileSync(new URL("../manifest.json", import.meta.url), "utf8"));
    const policy = manifest["content-security-policy"];
    assert.match(policy, /default-src 'none'/);
    assert.doesNotMatch(policy, /unsafe|data:|\*/);
});

test("the lock file names no registry", () => {
    const lock = readFileSync(new URL("../package-lock.json", import.meta.url), "utf8");
    assert.doesNotMatch(lock, /"resolved"/);
});
