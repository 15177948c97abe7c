// Fills a view with what mihost prints; shows that the page is waiting, and what failed.
import { _ } from "./cockpit.js";
import { el, replace } from "./dom.js";
import { State, alert } from "./state.js";

const spinnerAfter = 300; // milliseconds

export function spinner() {
    return el("div", { class: "mi-waiting", role: "status" },
        el("span", { class: "mi-spinner", "aria-hidden": "true" }), el("span", {}, _("Reading…")));
}

export class Loader {
    /** Failures that concern the whole page are shown in its state, others in the element. */
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
     * Starts runs of mihost by calling begin, which returns a list of them, and renders their results.
     * If another load begins before they end, this one renders nothing.
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
