import assert from "node:assert/strict";
import { test } from "node:test";
import { failureOf, messageOf } from "../src/failure.js";

const cases = [
    ["a missing program", { problem: "not-found", message: "not-found" }, "missing"],
    ["a missing program in older versions", { exit_status: -1, problem: "not-found", message: "" }, "missing"],
    ["a shell that does not find it", { exit_status: 127, message: "sh: mihost: not found" }, "missing"],
    ["a refused program", { problem: "access-denied", message: "access-denied" }, "denied"],
    ["a signal", { exit_signal: "KILL", problem: "terminated", message: "" }, "killed"],
    ["a signal in newer versions", { exit_status: -9, message: "" }, "killed"],
    ["a lost connection", { problem: "disconnected", message: "" }, "disconnected"],
    ["a run that the page stopped", { problem: "cancelled", message: "" }, "cancelled"],
    ["an unknown problem", { problem: "who-knows", message: "" }, "failed"],
    ["exit status 3", { exit_status: 3, message: "mihost: cannot load" }, "no-plugin"],
];

for (const [what, exception, kind] of cases)
    test(`failureOf treats ${what} as ${kind}`, () => {
        assert.equal(failureOf({ exit_status: null, exit_signal: null, problem: null, ...exception }).kind, kind);
    });

test("failureOf leaves other exit statuses to the caller", () => {
    for (const exit_status of [1, 2, 4])
        assert.equal(failureOf({ exit_status, exit_signal: null, problem: null, message: "" }), null);
});

test("messageOf has the last message without the program's name", () => {
    assert.equal(messageOf("mihost: a warning\nmihost: get: no node 'x'\n"), "get: no node 'x'");
});
