import { el } from "../dom.js";

/** Returns a heading and facts as pairs of label and text; one that can be edited has a button. */
export function facts(heading, rows, subject, edit) {
    return el("div", {},
        el("h3", { class: "pf-v6-c-title pf-m-md" }, heading),
        el("dl", { class: "pf-v6-c-description-list pf-m-horizontal" }, rows.map(row => {
            const text = row.text(subject);
            return el("div", { class: "pf-v6-c-description-list__group" },
                el("dt", { class: "pf-v6-c-description-list__term" },
                    el("span", { class: "pf-v6-c-description-list__text" }, row.label())),
                el("dd", { class: "pf-v6-c-description-list__description" },
                    el("div", { class: "pf-v6-c-description-list__text" },
                        text === "" || text === null ? "-" : text, row.edit && " ",
                        row.edit && edit(row.edit, row.label()))));
        })));
}
