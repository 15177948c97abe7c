import assert from "node:assert/strict";
import { test } from "node:test";
import { parseCsv } from "../src/csv.js";

test("parseCsv names the fields by the first line", () => {
    assert.deepEqual(parseCsv("id,name\n1,root\n2,os\n"), [{ id: "1", name: "root" }, { id: "2", name: "os" }]);
});

test("parseCsv keeps commas, quotes and line ends in quotes", () => {
    assert.deepEqual(parseCsv("a,b\n\"x,y\",\"say \"\"hi\"\"\nthere\"\n"), [{ a: "x,y", b: "say \"hi\"\nthere" }]);
});

test("parseCsv keeps empty fields, also at the end", () => {
    assert.deepEqual(parseCsv("a,b,c\n,,\n1,,"), [{ a: "", b: "", c: "" }, { a: "1", b: "", c: "" }]);
});

test("parseCsv has no rows for headings alone or nothing", () => {
    assert.deepEqual(parseCsv("a,b\n"), []);
    assert.deepEqual(parseCsv(""), []);
});

test("parseCsv leaves markup unchanged", () => {
    assert.deepEqual(parseCsv("a\n<b>x</b>\n"), [{ a: "<b>x</b>" }]);
});

test("parseCsv refuses a quote that is never closed", () => {
    assert.throws(() => parseCsv("a\n\"x\n"), /malformed/);
});
