// Conditions of the whole page, shown as alerts above all views in #state.
import { _ } from "./cockpit.js";
import { el, replace } from "./dom.js";

const conditions = { // the most severe first
    "missing": {
        look: "danger",
        title: () => _("mihost is not installed on this machine"),
        text: () => _("This page shows what mihost reads. Install it, then try again."),
    },
    "too-old": {
        look: "danger",
        title: () => _("The mihost of this machine is too old for this page"),
    },
    "no-plugin": {
        look: "danger",
        title: () => _("mihost cannot load its plug-in"),
    },
    "disconnected": {
        look: "danger",
        title: () => _("The connection to the machine is lost"),
    },
    "denied": {
        look: "danger",
        title: () => _("This account may not run mihost"),
    },
    "killed": {
        look: "danger",
        title: () => _("mihost was stopped before it had answered"),
    },
    "garbled": {
        look: "danger",
        title: () => _("This page cannot read the answer of mihost"),
    },
    "slow": {
        look: "warning",
        title: () => _("mihost is taking long to answer"),
        text: () => _("A machine with many accounts or under load needs more time."),
    },
    "no-privilege": {
        look: "info",
        title: () => _("Limited access"),
        text: () => _("Passwords and ageing of accounts are unknown, and nothing can be previewed or changed. " +
            "Turn on administrative access to see and change everything."),
    },
};

const looks = { // of alerts: the icon, and the word that screen readers say
    danger: { mark: "!", word: () => _("Danger") },
    warning: { mark: "!", word: () => _("Warning") },
    success: { mark: "✓", word: () => _("Success") },
    info: { mark: "i", word: () => _("Info") },
};

export class State {
    constructor() {
        this.holding = new Map();
        this.element = el("section", { id: "state", "aria-live": "polite", "aria-label": _("State of this page") });
        this.draw();
    }

    /**
     * Shows a condition. The detail is a text of mihost. The action is what ends the condition; each
     * owner, such as a view that must be read again, may have one. A click runs them all.
     */
    show(name, { detail = "", owner = null, action = null } = {}) {
        const actions = this.holding.get(name)?.actions ?? new Map();
        if (action)
            actions.set(owner, action);
        this.holding.set(name, { detail, actions });
        this.draw();
    }

    clear(...names) {
        if (names.filter(name => this.holding.delete(name)).length > 0)
            this.draw();
    }

    /** Returns whether a failure concerns the whole page. */
    static knows(failure) {
        return failure.kind in conditions;
    }

    draw() {
        const names = Object.keys(conditions).filter(name => this.holding.has(name));
        this.element.dataset.state = names[0] ?? "ok";
        replace(this.element, names.map(name => this.alert(name)));
    }

    alert(name) {
        const { look, title, text } = conditions[name];
        const { detail, actions } = this.holding.get(name);
        const [first] = actions.values();
        const action = first && {
            label: first.label,
            run: () => {
                this.clear(name);
                actions.forEach(({ run }) => run());
            },
        };
        return alert(look, title(), [text?.(), detail], action, { "data-state": name });
    }
}

/** PatternFly's inline alert. */
export function alert(look, title, texts = [], action = null, properties = {}) {
    return el("div", { class: `pf-v6-c-alert pf-m-inline pf-m-${look}`, ...properties },
        el("div", { class: "pf-v6-c-alert__icon mi-mark", "aria-hidden": "true" }, looks[look].mark),
        el("p", { class: "pf-v6-c-alert__title" },
            el("span", { class: "pf-v6-screen-reader" }, `${looks[look].word()}: `), title),
        el("div", { class: "pf-v6-c-alert__description" },
            texts.filter(Boolean).map(text => el("p", {}, text))),
        action && el("div", { class: "pf-v6-c-alert__action-group" },
            el("button", { type: "button", class: "pf-v6-c-button pf-m-link pf-m-inline", on: { click: action.run } },
                action.label)));
}
