// What the machine has and lacks for a full tree, as a checklist.
import { _ } from "../cockpit.js";
import { el, replace } from "../dom.js";
import { Loader } from "../load.js";
import * as mihost from "../mihost.js";

const foundSomething = 1; // an exit status of 'mihost doctor'

const outcomes = {
    ok: { look: "pf-m-green", text: () => _("OK") },
    fixable: { look: "pf-m-orange", text: () => _("Missing") },
    hopeless: { look: "pf-m-grey", text: () => _("Not available") },
};

const fixes = [
    { field: "debian", label: () => _("On Debian") },
    { field: "red-hat", label: () => _("On Red Hat") },
    { field: "opensuse", label: () => _("On openSUSE") },
];

function outcomeOf({ ok, fixable }) {
    return ok ? "ok" : fixable === false ? "hopeless" : "fixable";
}

export class DoctorView {
    constructor({ state }) {
        this.element = el("section", { class: "mi-card", "aria-label": _("What this machine lacks") });
        this.loader = new Loader(this.element, state);
    }

    show() {
        this.loader.load(() => [mihost.json(["doctor"], { accepted: [0, foundSomething] })], findings => {
            const missing = findings.filter(finding => !finding.ok);
            replace(this.element,
                el("h2", { class: "pf-v6-c-title pf-m-xl" },
                    missing.length === 0 ? _("This machine has everything that a full tree needs")
                        : _("What this machine lacks for a full tree")),
                el("ul", { id: "doctor-findings", class: "mi-checklist" },
                    [...missing, ...findings.filter(finding => finding.ok)].map(item)));
        });
    }

    hide() {
        this.loader.stop();
    }
}

function item(finding) {
    const name = outcomeOf(finding);
    const { look, text } = outcomes[name];
    return el("li", { "data-outcome": name },
        el("span", { class: `pf-v6-c-label pf-m-compact ${look}` },
            el("span", { class: "pf-v6-c-label__content" }, el("span", { class: "pf-v6-c-label__text" }, text()))),
        el("div", {},
            el("strong", {}, finding.need),
            !finding.ok && finding.problem && `: ${finding.problem}`,
            el("p", { class: "mi-note" }, finding.effect),
            !finding.ok && fixes.filter(({ field }) => finding[field]).map(({ field, label }) =>
                el("p", {}, `${label()}: `, el("code", {}, finding[field]))),
            !finding.ok && finding["no-fix"] && el("p", {}, finding["no-fix"])));
}
