// The newest lines of the system log, and new ones as they are written.
import { button } from "../button.js";
import { _, cockpit } from "../cockpit.js";
import { el, replace } from "../dom.js";
import { Live } from "../live.js";
import { Loader } from "../load.js";
import { lineMatches, logLines } from "../log-lines.js";
import * as mihost from "../mihost.js";
import { tasks } from "../tasks.js";

const atFirst = "50"; // lines
const atMost = 1000; // lines that the page keeps

export class LogView {
    constructor({ state, preview }) {
        this.times = new Intl.DateTimeFormat(cockpit.language?.replace("_", "-"), {
            dateStyle: "medium", timeStyle: "medium",
        });
        this.filter = el("input", {
            id: "log-filter", type: "search", placeholder: _("Filter"), "aria-label": _("Filter the log"),
            on: { input: () => this.applyFilter() },
        });
        this.follow = el("input", {
            id: "log-follow", type: "checkbox", role: "switch", class: "pf-v6-c-switch__input", checked: true,
            "aria-label": _("Show new lines as they arrive"), on: { change: () => this.show() },
        });
        this.lines = el("div", {
            id: "log-lines", class: "mi-log", role: "log", "aria-live": "off", tabindex: "0", "aria-label": _("Log"),
        });
        this.none = el("p", { class: "mi-note", role: "status" });
        this.message = el("div", {});
        this.loader = new Loader(this.message, state);
        this.element = el("section", { class: "mi-card mi-list", "aria-label": _("Log") },
            el("div", { class: "mi-toolbar" },
                el("span", { class: "pf-v6-c-form-control mi-grow" }, this.filter),
                el("label", { class: "pf-v6-c-switch" }, this.follow,
                    el("span", { class: "pf-v6-c-switch__toggle" }),
                    el("span", { class: "pf-v6-c-switch__label", "aria-hidden": "true" }, _("Follow"))),
                button(_("Clear log"), () => preview(tasks.clearLog), {
                    id: "log-clear", look: "danger", changes: true,
                })),
            this.message, this.none, this.lines);
    }

    show() {
        this.hide();
        replace(this.lines);
        replace(this.none);
        replace(this.message);
        if (this.follow.checked)
            this.live = new Live(["list", "log", "--follow", "-n", atFirst], {
                silent: true,
                onBegin: () => {
                    replace(this.lines);
                    replace(this.none, _("Waiting for lines…"));
                },
                onDocument: line => this.add([line]),
                onEnd: failure => {
                    replace(this.none);
                    if (failure)
                        this.loader.failed(failure, () => this.show());
                },
            });
        else
            this.loader.load(() => [mihost.json(["list", "log", "-n", atFirst])], nodes => {
                replace(this.message);
                this.add(logLines(nodes));
            });
    }

    hide() {
        this.loader.stop();
        this.live?.stop();
        this.live = null;
    }

    add(lines) {
        const { scrollTop, clientHeight, scrollHeight } = this.lines;
        const atEnd = scrollTop + clientHeight >= scrollHeight - 4;
        this.lines.append(...lines.map(line => this.line(line)));
        while (this.lines.childElementCount > atMost)
            this.lines.firstElementChild.remove();
        this.countMatches();
        if (atEnd)
            this.lines.scrollTop = this.lines.scrollHeight;
    }

    line({ time, message }) {
        const stamp = time === null || time === undefined ? "" : this.times.format(new Date(time * 1000));
        const line = el("div", { class: "mi-log__line" },
            el("time", { class: "mi-log__time" }, stamp), el("span", { class: "mi-log__message" }, message));
        line.hidden = !lineMatches(line.textContent, this.filter.value);
        return line;
    }

    applyFilter() {
        for (const line of this.lines.children)
            line.hidden = !lineMatches(line.textContent, this.filter.value);
        this.countMatches();
        this.lines.scrollTop = this.lines.scrollHeight;
    }

    countMatches() {
        const none = this.lines.querySelector(".mi-log__line:not([hidden])") === null;
        replace(this.none, none ? _("No line matches.") : null);
    }
}
