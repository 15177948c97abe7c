// Why a run of mihost gave no answer.

const kinds = { // Cockpit's name of a problem
    "not-found": "missing",
    "access-denied": "denied",
    "terminated": "killed",
    "cancelled": "cancelled",
    "disconnected": "disconnected",
    "no-session": "disconnected",
    "internal-error": "failed",
};

export class Failure extends Error {
    /** The kind is one of those above, "no-plugin" or "garbled". */
    constructor(kind, message, exit = null) {
        super(message);
        this.kind = kind;
        this.exit = exit;
    }
}

/** Returns mihost's message without the program's name; only the error if warnings come before it. */
export function messageOf(stderr) {
    const lines = stderr.trim().split("\n");
    return lines[lines.length - 1].replace(/^mihost: /, "");
}

/** Returns the failure that Cockpit's exception means, or null if mihost ran and ended by itself. */
export function failureOf(exception) {
    const message = String(exception.message ?? "");
    if (exception.problem && exception.problem !== "")
        return new Failure(kinds[exception.problem] ?? "failed", message);
    // Newer versions of Cockpit report a signal as a negative exit status; older ones have -1 beside a problem.
    if (exception.exit_signal || exception.exit_status < 0)
        return new Failure("killed", message);
    if (exception.exit_status === 3)
        return new Failure("no-plugin", messageOf(message), 3);
    if (exception.exit_status === 127) // a shell between Cockpit and mihost
        return new Failure("missing", message, 127);
    return null;
}
