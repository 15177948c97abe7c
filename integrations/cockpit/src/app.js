// The page: its state, its tabs, and the view of the tab that the address names.
import { watchAccess } from "./access.js";
import { _, cockpit, format } from "./cockpit.js";
import { append, el, replace } from "./dom.js";
import * as mihost from "./mihost.js";
import { Monitor } from "./monitor.js";
import { Preview } from "./preview.js";
import { State, alert } from "./state.js";
import { isRecent, oldestMihost } from "./version.js";
import { DoctorView } from "./views/doctor.js";
import { DriversView } from "./views/drivers.js";
import { GroupsView } from "./views/groups.js";
import { HostView } from "./views/host.js";
import { LogView } from "./views/log.js";
import { TreeView } from "./views/tree.js";
import { UsersView } from "./views/users.js";

const tabs = [
    { name: "tree", title: () => _("Tree"), View: TreeView },
    { name: "users", title: () => _("Users"), View: UsersView },
    { name: "groups", title: () => _("Groups"), View: GroupsView },
    { name: "drivers", title: () => _("Drivers"), View: DriversView },
    { name: "log", title: () => _("Log"), View: LogView },
    { name: "host", title: () => _("Machine"), View: HostView },
    { name: "doctor", title: () => _("Checks"), View: DoctorView },
];

const monitorAfter = 5000; // milliseconds, so that the first view is read first

export class App {
    constructor(body) {
        document.title = _("Management tree");
        document.documentElement.lang = cockpit.language?.replace("_", "-") ?? "en";
        this.state = new State();
        this.monitor = new Monitor();
        this.notice = el("div", { id: "notice", "aria-live": "polite", tabindex: "-1" });
        this.views = new Map();
        this.panels = new Map(tabs.map(tab => [tab.name, el("div", {
            id: `panel-${tab.name}`, class: "mi-panel", role: "tabpanel", "aria-labelledby": `tab-${tab.name}`,
            hidden: true,
        })]));
        this.buttons = new Map(tabs.map(tab => [tab.name, el("button", {
            id: `tab-${tab.name}`, type: "button", class: "pf-v6-c-tabs__link", role: "tab",
            "aria-controls": `panel-${tab.name}`, on: { click: () => this.go([tab.name]) },
        }, el("span", { class: "pf-v6-c-tabs__item-text" }, tab.title()))]));
        append(body,
            el("header", { class: "mi-header" },
                el("h1", { class: "pf-v6-screen-reader" }, _("Management tree")),
                el("div", { class: "pf-v6-c-tabs" },
                    el("div", {
                        class: "pf-v6-c-tabs__list", role: "tablist", "aria-label": _("Views"),
                        on: { keydown: event => this.keydown(event) },
                    }, tabs.map(tab => el("div", {
                        class: "pf-v6-c-tabs__item", role: "presentation",
                    }, this.buttons.get(tab.name)))))),
            el("main", { class: "mi-main" }, this.state.element, this.notice, [...this.panels.values()]));

        watchAccess(allowed => {
            if (allowed)
                this.state.clear("no-privilege");
            else
                this.state.show("no-privilege");
            if (!this.tab)
                return;
            this.views.get("tree")?.forget(); // what could not be read may be known now
            this.show();
        });
        mihost.watchSlow(slow => slow.size > 0
            ? this.state.show("slow", { action: { label: _("Stop waiting"), run: mihost.stopSlow } })
            : this.state.clear("slow"));
        cockpit.addEventListener("locationchanged", () => this.show());
        this.checkVersion();
        this.show();
        setTimeout(() => this.monitor.start(), monitorAfter);
    }

    go(path) {
        replace(this.notice);
        cockpit.location.go(path);
    }

    show() {
        const [wanted, ...rest] = cockpit.location.path;
        const tab = tabs.find(({ name }) => name === wanted) ?? tabs[0];
        if (this.tab !== tab) {
            this.views.get(this.tab?.name)?.hide();
            this.tab = tab;
        }
        for (const { name } of tabs) {
            const chosen = name === tab.name;
            this.panels.get(name).hidden = !chosen;
            this.buttons.get(name).setAttribute("aria-selected", String(chosen));
            this.buttons.get(name).tabIndex = chosen ? 0 : -1;
            this.buttons.get(name).parentElement.classList.toggle("pf-m-current", chosen);
        }
        this.buttons.get(tab.name).scrollIntoView({ block: "nearest", inline: "nearest", behavior: "instant" });
        if (!this.views.has(tab.name)) {
            const view = new tab.View({
                state: this.state,
                monitor: this.monitor,
                go: path => this.go(path),
                preview: (task, options) => this.preview(task, options),
            });
            this.views.set(tab.name, view);
            append(this.panels.get(tab.name), view.element);
        }
        this.views.get(tab.name).show(rest);
    }

    keydown(event) {
        const step = { ArrowRight: 1, ArrowLeft: -1 }[event.key];
        if (!step)
            return;
        const index = (tabs.indexOf(this.tab) + step + tabs.length) % tabs.length;
        this.go([tabs[index].name]);
        this.buttons.get(tabs[index].name).focus();
    }

    /** Opens the dialog of a change. Afterwards the view is read again, or "then" opens another one. */
    preview(task, { fixed, values, then = () => this.show() } = {}) {
        new Preview(task, { fixed, values }, ({ title, answer }) => {
            this.views.get("tree")?.forget();
            then();
            replace(this.notice, alert("success", answer.changed ? format(_("Done: $0"), title)
                : format(_("Nothing changed: $0"), title), answer.warnings));
            this.notice.focus(); // the button that opened the dialog may be gone
        }).open();
    }

    checkVersion() {
        mihost.text(["--version"]).answer.then(version => {
            if (isRecent(version))
                this.state.clear("too-old");
            else
                this.state.show("too-old", {
                    detail: format(_("It is $0; this page needs $1 or newer."), version.trim(), oldestMihost),
                    action: {
                        label: _("Try again"),
                        run: () => {
                            this.checkVersion();
                            this.show();
                        },
                    },
                });
        }, () => {}); // the view's own run of mihost has the same problem, and shows it
    }
}
