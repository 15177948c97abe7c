import assert from "node:assert/strict";
import { test } from "node:test";
import { filterRows, sortRows } from "../src/table-rows.js";

const rows = [
    { name: "carl", uid: "9" },
    { name: "anna", uid: "10" },
    { name: "ben", uid: "-" },
    { name: "dora", uid: "9" },
];
const columns = [{ text: row => row.name }, { text: row => row.uid }];
const names = list => list.map(row => row.name);

test("filterRows requires every word, in any column and case", () => {
    assert.deepEqual(names(filterRows(rows, columns, "9 CARL")), ["carl"]);
    assert.deepEqual(names(filterRows(rows, columns, "zoe")), []);
    assert.deepEqual(filterRows(rows, columns, "  "), rows);
});

test("filterRows never matches across two columns", () => {
    assert.deepEqual(filterRows(rows, columns, "carl9"), []);
});

test("sortRows sorts numbers by size, unknown ones last", () => {
    assert.deepEqual(names(sortRows(rows, { property: "uid", order: "number" }, false)),
        ["carl", "dora", "anna", "ben"]);
});

test("sortRows keeps the order of equal rows when descending", () => {
    assert.deepEqual(names(sortRows(rows, { property: "uid", order: "number" }, true)).slice(2), ["carl", "dora"]);
});

test("sortRows sorts text without changing its input", () => {
    const before = names(rows);
    assert.deepEqual(names(sortRows(rows, { property: "name" }, true)), ["dora", "carl", "ben", "anna"]);
    assert.deepEqual(names(rows), before);
});
