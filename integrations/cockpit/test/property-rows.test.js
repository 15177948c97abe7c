import assert from "node:assert/strict";
import { test } from "node:test";
import { liveText, propertyRows } from "../src/property-rows.js";

test("propertyRows adds what the catalogue knows", () => {
    const facts = { meaning: "accounts", live: true, acts: false, secret: false };
    const known = { properties: new Map([["user-count", facts]]) };
    const [row, other] = propertyRows([{ name: "user-count", value: "2" }, { name: "999", value: "x" }], known);
    assert.deepEqual(row, { name: "user-count", value: "2", ...facts });
    assert.deepEqual(other, { name: "999", value: "x", meaning: "", live: false, acts: false, secret: false });
    assert.equal(propertyRows([{ name: "a" }], undefined)[0].meaning, "");
});

test("liveText leaves dates to mihost", () => {
    assert.equal(liveText({ kind: "number", value: 7 }), "7");
    assert.equal(liveText({ kind: "texts", value: ["a", "b"] }), "a,b");
    assert.equal(liveText({ kind: "date", value: 7 }), null);
    assert.equal(liveText({ kind: "text", value: null }), null);
});
