import assert from "node:assert/strict";
import { test } from "node:test";
import { lineSplitter } from "../src/lines.js";

test("lineSplitter joins pieces and returns whole lines", () => {
    const lines = [];
    const feed = lineSplitter(line => lines.push(line));
    ["{\"a\"", ":1}\n{\"b\":2}\n\n{", "}"].forEach(feed);
    assert.deepEqual(lines, ["{\"a\":1}", "{\"b\":2}"]);
    feed("\n");
    assert.deepEqual(lines.slice(2), ["{}"]);
});
