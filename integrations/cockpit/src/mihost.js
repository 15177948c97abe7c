// Runs mihost. Nothing else in the page runs anything on the machine.
import { cockpit } from "./cockpit.js";
import { parseCsv } from "./csv.js";
import { Failure, failureOf, messageOf } from "./failure.js";
import { lineSplitter } from "./lines.js";

const slowAfter = 4000; // milliseconds

const slow = new Set(); // runs that have printed nothing for that long
let onSlowChanged = () => {};

/** Calls back with the slow runs whenever there are more or fewer of them. */
export function watchSlow(listener) {
    onSlowChanged = listener;
}

export function stopSlow() {
    for (const run of [...slow])
        run.stop();
}

/**
 * Starts mihost with these arguments. The answer is its output, messages and exit status, whatever that
 * is; it fails with a Failure if mihost could not be run or did not end by itself. A silent run may print
 * nothing for a long time without being slow.
 */
function start(words, { input = "", onOutput = null, silent = false } = {}) {
    const process = cockpit.spawn(["mihost", ...words], { superuser: "try", err: "message" });
    const run = { stop: () => process.close("cancelled") };
    const timer = silent ? null : setTimeout(() => {
        slow.add(run);
        onSlowChanged(slow);
    }, slowAfter);
    const notSlow = () => {
        clearTimeout(timer);
        if (slow.delete(run))
            onSlowChanged(slow);
    };
    run.answer = new Promise((resolve, reject) => {
        process.then((output, messages) => {
            notSlow();
            resolve({ output, messages: messages ?? "", exit: 0 });
        }, (exception, output) => {
            notSlow();
            const failure = failureOf(exception);
            if (failure)
                reject(failure);
            else
                resolve({ output: output ?? "", messages: String(exception.message), exit: exception.exit_status });
        });
    });
    if (onOutput)
        process.stream(piece => {
            notSlow();
            onOutput(piece);
        });
    process.input(input);
    return run;
}

function checked(answer, accepted) {
    if (!accepted.includes(answer.exit))
        throw new Failure("failed", messageOf(answer.messages), answer.exit);
    return answer.output;
}

function parsed(output, parse) {
    try {
        return parse(output);
    } catch (error) {
        throw new Failure("garbled", error.message);
    }
}

/** Starts a run; its answer is what mihost prints. */
export function text(words) {
    const run = start(words);
    return { stop: run.stop, answer: run.answer.then(answer => checked(answer, [0])) };
}

/** Starts a run; its answer is the rows that mihost prints. */
export function rows(words) {
    const run = start(["-o", "csv", ...words]);
    return { stop: run.stop, answer: run.answer.then(answer => parsed(checked(answer, [0]), parseCsv)) };
}

/** Starts a run; its answer is the document that mihost prints. */
export function json(words, { accepted = [0] } = {}) {
    const run = start(["--json", ...words]);
    return { stop: run.stop, answer: run.answer.then(answer => parsed(checked(answer, accepted), JSON.parse)) };
}

/** Starts a run that calls back with a document for each line that mihost prints, until it ends. */
export function stream(words, onDocument, { silent = false } = {}) {
    let garbled = null;
    const onLine = line => {
        if (garbled)
            return;
        try {
            onDocument(parsed(line, JSON.parse));
        } catch (failure) {
            garbled = failure;
            run.stop();
        }
    };
    const run = start(["--json", ...words], { onOutput: lineSplitter(onLine), silent });
    return {
        stop: run.stop,
        answer: run.answer.then(answer => checked(answer, [0]), failure => Promise.reject(garbled ?? failure)),
    };
}

/**
 * Changes the machine, or with preview a sandbox copy of it. Input is what mihost reads, such as a
 * password. The answer is mihost's document about the change; if it was refused, error is the message.
 */
export function change(words, { preview, input = "" }) {
    const run = start([...(preview ? ["--sandbox"] : []), "--json", "--yes", ...words], { input });
    return {
        stop: run.stop,
        answer: run.answer.then(({ output, messages, exit }) => {
            if (output.trim() !== "")
                return { exit, ...parsed(output, JSON.parse) };
            return { exit, status: 1, changed: false, changes: [], warnings: [], error: messageOf(messages) };
        }),
    };
}
