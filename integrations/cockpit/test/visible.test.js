import assert from "node:assert/strict";
import { test } from "node:test";
import { visible } from "../src/visible.js";

test("visible escapes control characters", () => {
    assert.equal(visible("\u001b[31mred\u0007\u0000\u009b"), "\\x1b[31mred\\x07\\x00\\x9b");
});

test("visible escapes characters that reorder or hide text", () => {
    assert.equal(visible("a\u202eb\u200bc\u2066d\ufeff"), "a\\u202eb\\u200bc\\u2066d\\ufeff");
});

test("visible escapes the same characters as mihost", () => {
    assert.equal(visible("a\u206fb\ufff9c\u{e0041}d"), "a\\u206fb\\ufff9c\\U000e0041d");
});

test("visible keeps text, markup, tabs and line ends", () => {
    const text = "<b>Zoë</b>\tpäth\nline — 日本";
    assert.equal(visible(text), text);
});
