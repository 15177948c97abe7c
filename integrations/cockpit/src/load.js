// Fills a view with what mihost answers; shows that it is waited for, and what went wrong.
import { _ } from "./cockpit.js";
import { el, replace } from "./dom.js";
import { State, alert } from "./state.js";

const spinnerAfter = 300; // milliseconds

export function spinner() {
    return el("div", { class: "mi-waiting", role: "status" },
        el("span", { class: "mi-spinner", "aria-hidden": "true" }), el("span", {}, _("Reading…")));
}

export class Loader {
    /** Failures of the page as a whole go to its state, others into the element. */
    constructor(element, state) {
        Object.assign(this, { element, state, runs: [], turn: 0 });
    }

    /** Stops what is being read. */
    stop() {
        this.turn++;
        this.runs.forEach(run => run.stop());
        this.runs = [];
    }

    /**
     * Starts runs of mihost by calling begin, which returns a list of them, and renders their answers.
     * A load that another one has overtaken renders nothing.
     */
    async load(begin, render) {
        this.stop();
        const turn = this.turn;
        const current = () => turn === this.turn;
        const timer = setTimeout(() => {
            if (current() && this.element.childElementCount === 0)
                replace(this.element, spinner());
        }, spinnerAfter);
        this.element.setAttribute("aria-busy", "true");
        try {
            this.runs = begin();
            const answers = await Promise.all(this.runs.map(run => run.answer));
            if (!current())
                return;
            this.state.clear("missing", "no-plugin", "disconnected", "denied", "killed", "garbled");
            render(...answers);
        } catch (failure) {
            if (!current())
                return;
            this.failed(failure, () => this.load(begin, render));
        } finally {
            clearTimeout(timer);
            if (current())
                this.element.setAttribute("aria-busy", "false");
        }
    }

    failed(failure, again) {
        if (!failure.kind)
            throw failure;
        const action = { label: _("Try again"), run: again };
        replace(this.element);
        if (failure.kind === "cancelled")
            replace(this.element, alert("info", _("Reading was stopped"), [], action));
        else if (State.knows(failure))
            this.state.show(failure.kind, { detail: failure.message, owner: this, action });
        else
            replace(this.element, alert("danger", _("mihost could not read this"), [failure.message], action));
    }
}
