import assert from "node:assert/strict";
import { mock, test } from "node:test";
import { last } from "./fake-cockpit.js";

const mihost = await import("../src/mihost.js");
const needsTimers = { skip: !mock.timers && "this Node cannot mock timers" };

test("mihost runs without a shell, with superuser try", () => {
    mihost.text(["--version"]);
    assert.deepEqual(last().words, ["mihost", "--version"]);
    assert.equal(last().options.superuser, "try");
});

test("rows returns the rows that mihost prints", async () => {
    const { answer } = mihost.rows(["tree"]);
    last().succeed("id,kind\n1,mi\n");
    assert.deepEqual(last().words, ["mihost", "-o", "csv", "tree"]);
    assert.deepEqual(await answer, [{ id: "1", kind: "mi" }]);
});

test("json accepts exit statuses that the caller allows", async () => {
    const { answer } = mihost.json(["doctor"], { accepted: [0, 1] });
    last().fail({ exit_status: 1, message: "" }, "[1]");
    assert.deepEqual(await answer, [1]);
});

test("json fails with mihost's message for any other exit status", async () => {
    const { answer } = mihost.json(["user", "--", "x"]);
    last().fail({ exit_status: 4, message: "mihost: user: no account 'x'\n" });
    await assert.rejects(answer, { kind: "failed", message: "user: no account 'x'", exit: 4 });
});

test("json fails for output that is not a document", async () => {
    const { answer } = mihost.json(["tree"]);
    last().succeed("[{\"id\":");
    await assert.rejects(answer, { kind: "garbled" });
});

test("a run that is stopped is cancelled", async () => {
    const run = mihost.rows(["tree"]);
    run.stop();
    assert.equal(last().closed, "cancelled");
    await assert.rejects(run.answer, { kind: "cancelled" });
});

test("stream calls back with each line's document", async () => {
    const documents = [];
    const { answer } = mihost.stream(["watch", "os", "x"], document => documents.push(document));
    last().print("{\"a\":1}\n{\"a\"");
    last().print(":2}\n");
    last().fail({ problem: "terminated", exit_signal: "KILL", message: "" });
    assert.deepEqual(documents, [{ a: 1 }, { a: 2 }]);
    await assert.rejects(answer, { kind: "killed" });
});

test("stream stops at a line that is not a document", async () => {
    const documents = [];
    const { answer } = mihost.stream(["watch", "os", "x"], document => documents.push(document));
    last().print("{\"a\":1}\nUsage: mihost\n{\"a\":2}\n");
    assert.equal(last().closed, "cancelled");
    assert.deepEqual(documents, [{ a: 1 }]);
    await assert.rejects(answer, { kind: "garbled" });
});

test("change runs only a preview in the sandbox", () => {
    mihost.change(["user", "add", "--", "x"], { preview: true });
    assert.deepEqual(last().words, ["mihost", "--sandbox", "--json", "--yes", "user", "add", "--", "x"]);
    mihost.change(["user", "add", "--", "x"], { preview: false });
    assert.deepEqual(last().words, ["mihost", "--json", "--yes", "user", "add", "--", "x"]);
});

test("change passes its input to mihost's standard input", () => {
    mihost.change(["user", "set-password", "--", "x"], { preview: true, input: "Geheim\n" });
    assert.equal(last().input, "Geheim\n");
    assert.ok(!last().words.join(" ").includes("Geheim"));
});

test("change returns the message of a refusal", async () => {
    const { answer } = mihost.change(["user", "add", "--", "x;y"], { preview: true });
    last().fail({ exit_status: 2, message: "mihost: user add: NAME contains ';'" });
    assert.deepEqual(await answer, {
        exit: 2, status: 1, changed: false, changes: [], warnings: [], error: "user add: NAME contains ';'",
    });
});

test("change returns mihost's document of a failure", async () => {
    const { answer } = mihost.change(["group", "add", "--", "x"], { preview: true });
    last().fail({ exit_status: 1, message: "mihost: ..." }, "{\"status\":1,\"error\":\"no\",\"changes\":[]}");
    assert.deepEqual(await answer, { exit: 1, status: 1, error: "no", changes: [] });
});

test("a run that prints nothing for long is slow until it ends", needsTimers, async () => {
    mock.timers.enable({ apis: ["setTimeout"] });
    const counts = [];
    mihost.watchSlow(slow => counts.push(slow.size));
    mihost.stream(["list", "log", "--follow"], () => {}, { silent: true });
    const { answer } = mihost.text(["tree"]);
    mock.timers.tick(60000);
    last().succeed("done");
    await answer;
    assert.deepEqual(counts, [1, 0]);
    mock.timers.reset();
});

test("stopSlow stops slow runs and no others", needsTimers, async () => {
    mock.timers.enable({ apis: ["setTimeout"] });
    const slow = mihost.text(["tree"]);
    const slowProcess = last();
    mock.timers.tick(60000);
    mihost.text(["--version"]);
    mihost.stopSlow();
    assert.equal(slowProcess.closed, "cancelled");
    assert.equal(last().closed, null);
    await assert.rejects(slow.answer, { kind: "cancelled" });
    mock.timers.reset();
});
