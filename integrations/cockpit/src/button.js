import { allowed } from "./access.js";
import { el } from "./dom.js";

const looks = {
    primary: "pf-m-primary",
    secondary: "pf-m-secondary",
    danger: "pf-m-danger",
    link: "pf-m-link pf-m-inline",
};

/**
 * Returns PatternFly's button. If it changes the machine, it is disabled while the page lacks the
 * privilege; if it submits a form, given by its id, it runs nothing itself.
 */
export function button(label, run, options = {}) {
    const { look = "secondary", changes = false, id = null, name = null, submits = null } = options;
    return el("button", {
        id,
        type: submits ? "submit" : "button",
        form: submits,
        class: `pf-v6-c-button ${looks[look]}`,
        "aria-label": name,
        "data-changes": changes,
        disabled: changes && !allowed(),
        on: run ? { click: run } : {},
    }, label);
}
