// A cockpit library whose processes the tests control. Import it before the tested modules.
export const spawned = []; // each with its words, options, input, and ways to end it

function process(words, options) {
    const listeners = { done: [], fail: [], output: [] };
    const run = {
        words, options, input: null, closed: null,
        print: text => listeners.output.forEach(listener => listener(text)),
        succeed: (output, messages = "") => listeners.done.forEach(listener => listener(output, messages)),
        fail: (exception, output = "") => listeners.fail.forEach(listener => listener(exception, output)),
    };
    spawned.push(run);
    return {
        then: (done, fail) => { listeners.done.push(done); listeners.fail.push(fail); },
        stream: listener => { listeners.output.push(listener); },
        input: text => { run.input = text; },
        close: problem => { run.closed = problem; run.fail({ problem, message: problem }); },
    };
}

globalThis.window = {
    cockpit: {
        gettext: text => text,
        format: (text, ...values) => text.replace(/\$(\d)/g, (_, index) => values[index]),
        spawn: process,
    },
};

/** The last process that was started. */
export function last() {
    return spawned[spawned.length - 1];
}
