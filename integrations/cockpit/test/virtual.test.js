import assert from "node:assert/strict";
import { test } from "node:test";
import { windowOf } from "../src/virtual.js";

const view = { height: 400, rowHeight: 40, count: 10000, margin: 2 };

test("windowOf has the visible rows and a margin", () => {
    assert.deepEqual(windowOf({ ...view, scrollTop: 0 }), { first: 0, last: 12 });
    assert.deepEqual(windowOf({ ...view, scrollTop: 4010 }), { first: 98, last: 113 });
});

test("windowOf stays within the list", () => {
    assert.deepEqual(windowOf({ ...view, scrollTop: 399600 }), { first: 9988, last: 10000 });
    assert.deepEqual(windowOf({ ...view, scrollTop: 9e9 }), { first: 9998, last: 10000 });
    assert.deepEqual(windowOf({ ...view, scrollTop: 4000, count: 3 }), { first: 1, last: 3 });
    assert.deepEqual(windowOf({ ...view, scrollTop: 0, count: 0 }), { first: 0, last: 0 });
});
