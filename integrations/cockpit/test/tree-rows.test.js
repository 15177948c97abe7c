import assert from "node:assert/strict";
import { test } from "node:test";
import { buildTree, kindOf, kindsOf, nameOf, visibleRows } from "../src/tree-rows.js";

const rows = [
    { id: "1", parent: "0", kind: "mi", address: "mi", headline: "" },
    { id: "2", parent: "1", kind: "os", address: "os", headline: "Linux" },
    { id: "3", parent: "2", kind: "user", address: "user:anna", headline: "Anna <b>B</b>" },
    { id: "4", parent: "2", kind: "group", address: "group:anna", headline: "anna" },
    { id: "5", parent: "2", kind: "log", address: "log", headline: "" },
    { id: "6", parent: "5", kind: "log-entry", address: "log:1", headline: "first" },
];
const { nodes, roots } = buildTree(rows);
const shown = options => visibleRows(roots, { expanded: new Set(), ...options })
    .map(({ node, level, open }) => `${level} ${node.address} ${open}`);

test("buildTree puts nodes below their parents", () => {
    assert.deepEqual(roots.map(node => node.id), ["1"]);
    assert.deepEqual(nodes.get("2").children.map(node => node.id), ["3", "4", "5"]);
});

test("visibleRows shows the children of expanded nodes", () => {
    assert.deepEqual(shown({}), ["1 mi false"]);
    assert.deepEqual(shown({ expanded: new Set(["mi", "os"]) }),
        ["1 mi true", "2 os true", "3 user:anna null", "3 group:anna null", "3 log false"]);
});

test("visibleRows shows matches of a search and their parents", () => {
    assert.deepEqual(shown({ search: " ANNA b " }), []);
    assert.deepEqual(shown({ search: "first" }), ["1 mi true", "2 os true", "3 log true", "4 log:1 null"]);
    assert.deepEqual(shown({ search: "<b>" }), ["1 mi true", "2 os true", "3 user:anna null"]);
});

test("visibleRows shows only one kind and its parents", () => {
    assert.deepEqual(shown({ kind: "group" }), ["1 mi true", "2 os true", "3 group:anna null"]);
    assert.deepEqual(shown({ kind: "group", search: "first" }), []);
});

test("visibleRows says where a row is among its siblings", () => {
    const [, , row] = visibleRows(roots, { expanded: new Set(["mi", "os"]) });
    assert.deepEqual([row.position, row.siblings], [1, 3]);
});

test("nameOf leaves out only the kind", () => {
    assert.equal(nameOf({ address: "user:a:b" }), "a:b");
    assert.equal(nameOf({ address: "os" }), "os");
});

test("kindOf distinguishes the log from its entries", () => {
    assert.deepEqual(["os", "user:a:b", "log", "log:1"].map(kindOf), ["os", "user", "log", "log-entry"]);
});

test("kindsOf has each kind once", () => {
    assert.deepEqual(kindsOf(nodes), ["mi", "os", "user", "group", "log", "log-entry"]);
});
