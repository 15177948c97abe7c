import assert from "node:assert/strict";
import { test } from "node:test";
import { lineMatches, logLines } from "../src/log-lines.js";

test("logLines has the oldest first, without asterisks", () => {
    assert.deepEqual(logLines([
        { properties: { message: { value: "*a * b*" }, time: { value: 2 } } },
        { properties: { message: { value: "*no stamp*" } } },
        { properties: {} },
    ]), [{ time: null, message: "" }, { time: null, message: "no stamp" }, { time: 2, message: "a * b" }]);
});

test("lineMatches requires every word in any case", () => {
    assert.ok(lineMatches("sshd: Failed password", "failed SSHD"));
    assert.ok(!lineMatches("sshd: Failed password", "failed cron"));
    assert.ok(lineMatches("anything", ""));
});
