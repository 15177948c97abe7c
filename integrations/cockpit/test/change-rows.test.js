import assert from "node:assert/strict";
import { test } from "node:test";
import { differenceOf, sortChanges } from "../src/change-rows.js";

test("sortChanges separates the account tools' backups", () => {
    const sorted = sortChanges([
        { file: "/etc/passwd" }, { file: "/etc/passwd-", backup: true }, { file: "/home/x-" },
    ]);
    assert.deepEqual(sorted.files.map(change => change.file), ["/etc/passwd", "/home/x-"]);
    assert.deepEqual(sorted.backups.map(change => change.file), ["/etc/passwd-"]);
});

test("differenceOf shows attributes, then removed and added lines", () => {
    assert.deepEqual(differenceOf({
        removed: ["a"], added: ["b", "c"],
        mode: { before: "0644", after: "0600" }, owner: { before: null, after: "0:0" },
    }).map(({ sign, text }) => `${sign}${text}`), [" mode: 0644 → 0600", " owner: - → 0:0", "-a", "+b", "+c"]);
    assert.deepEqual(differenceOf({}), []);
});
