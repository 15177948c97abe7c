// What mihost prints of a change: warnings, commands with their output, and the lines that change.
import { differenceOf, sortChanges } from "./change-rows.js";
import { _, format } from "./cockpit.js";
import { el } from "./dom.js";
import { alert } from "./state.js";

const signs = { "-": "mi-removed", "+": "mi-added", " ": "" };
const kinds = {
    changed: () => _("changed"),
    created: () => _("created"),
    removed: () => _("removed"),
};

/** Shows what happened, or in a preview what would happen. */
export function outcome(answer, { preview }) {
    const { files, backups } = sortChanges(answer.changes ?? []);
    const say = (would, did) => preview ? would : did;
    return [
        answer.error && alert("danger", say(_("This would fail"), _("This failed")), [answer.error]),
        !answer.error && !answer.changed && alert("info", say(_("Nothing would change"), _("Nothing changed"))),
        (answer.warnings ?? []).map(warning => alert("warning", warning)),
        (answer.commands ?? []).length > 0 && el("div", { class: "mi-commands" },
            heading(say(_("Commands that would run"), _("Commands that ran"))),
            answer.commands.map(command)),
        files.length > 0 && el("div", { class: "mi-changes" },
            heading(say(_("Files that would change"), _("Files that changed"))),
            files.map(change)),
        backups.length > 0 && el("details", {},
            el("summary", {}, format(_("Backup copies: $0"), backups.length)), backups.map(change)),
    ];
}

function heading(text) {
    return el("h3", { class: "pf-v6-c-title pf-m-md" }, text);
}

function command({ command: line, output }) {
    return el("pre", { class: "mi-lines", tabindex: "0" },
        el("span", { class: "mi-command" }, `$ ${line}\n`), output);
}

function change(file) {
    return el("div", {},
        el("p", {}, el("code", {}, file.file), " ",
            el("span", { class: "mi-note" }, kinds[file.change]?.() ?? file.change)),
        el("pre", { class: "mi-lines", tabindex: "0" }, differenceOf(file).map(({ sign, text }) =>
            el("span", { class: signs[sign] }, `${sign} ${text}\n`))));
}
