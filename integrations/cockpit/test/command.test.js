import assert from "node:assert/strict";
import { test } from "node:test";
import "./fake-cockpit.js";

const { commandOf, faultsOf } = await import("../src/command.js");
const { tasks } = await import("../src/tasks.js");

test("commandOf gives filled-in options, then the arguments", () => {
    const values = { "user": "jdoe", "full-name": "-x J. Doe", "home": "", "max-days": "90" };
    const { words } = commandOf(tasks.userAdd, values);
    assert.deepEqual(words, ["user", "add", "--full-name=-x J. Doe", "--max-days=90", "--", "jdoe"]);
});

test("commandOf passes a password on standard input only", () => {
    for (const [task, words] of [
        [tasks.userAdd, ["user", "add", "--password", "--", "jdoe"]],
        [tasks.userSetPassword, ["user", "set-password", "--", "jdoe"]],
    ]) {
        const command = commandOf(task, { "user": "jdoe", "password": "Geheim", "password-again": "Geheim" });
        assert.deepEqual(command.words, words);
        assert.equal(command.input, "Geheim\n");
    }
});

test("commandOf sets no password if none is given", () => {
    assert.deepEqual(commandOf(tasks.userAdd, { user: "jdoe", password: "" }),
        { words: ["user", "add", "--", "jdoe"], input: "" });
});

test("commandOf lets an account without a day never expire", () => {
    assert.deepEqual(commandOf(tasks.userExpire, { user: "jdoe", expires: "" }).words,
        ["user", "expire", "--", "jdoe", "never"]);
});

test("commandOf keeps an empty argument in its place", () => {
    assert.deepEqual(commandOf(tasks.userSetName, { "user": "jdoe", "full-name": "" }).words,
        ["user", "set-name", "--", "jdoe", ""]);
});

test("commandOf names the group before its member", () => {
    assert.deepEqual(commandOf(tasks.groupAddMember, { user: "jdoe", group: "crew" }).words,
        ["group", "add-member", "--", "crew", "jdoe"]);
});

test("commandOf has only the task's words if it has no fields", () => {
    assert.deepEqual(commandOf(tasks.restart, {}), { words: ["power", "restart"], input: "" });
});

test("faultsOf requires necessary values and equal passwords", () => {
    const values = { "user": "", "max-days": "9o", "password": "a", "password-again": "b" };
    assert.deepEqual(faultsOf(tasks.userAdd, values), [
        { name: "user", reason: "missing" },
        { name: "password-again", reason: "different" },
        { name: "max-days", reason: "number" },
    ]);
    assert.deepEqual(faultsOf(tasks.userAdd, { user: "jdoe" }), []);
});

test("faultsOf requires a password if one is to be set", () => {
    assert.deepEqual(faultsOf(tasks.userSetPassword, { user: "jdoe", password: "" }),
        [{ name: "password", reason: "missing" }]);
});

test("faultsOf refuses a line end", () => {
    assert.deepEqual(faultsOf(tasks.userSetName, { "user": "jdoe", "full-name": "a\nb" }),
        [{ name: "full-name", reason: "line" }]);
});

test("every dangerous task requires a typed name", () => {
    const dangerous = Object.values(tasks).filter(task => /delete|power|clear-log/.test(task.words.join(" ")));
    assert.equal(dangerous.length, 5);
    for (const task of dangerous) {
        const name = task.danger.name;
        assert.ok(name === "machine" || name({ user: "x", group: "x" }) === "x", task.words.join(" "));
    }
});
