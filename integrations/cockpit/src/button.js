import { allowed } from "./access.js";
import { el } from "./dom.js";

const looks = {
    primary: "pf-m-primary",
    secondary: "pf-m-secondary",
    danger: "pf-m-danger",
    link: "pf-m-link pf-m-inline",
};

/**
 * PatternFly's button. One that changes the machine is off while the page has no privilege for that;
 * one that submits the form of that id runs nothing itself.
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
