// The page: its state, its tabs, and the view of the tab that the address names.
import { _, cockpit } from "./cockpit.js";
import { append, el } from "./dom.js";
import * as mihost from "./mihost.js";
import { State } from "./state.js";
import { isRecent, oldestMihost } from "./version.js";
import { TreeView } from "./views/tree.js";

const tabs = [
    { name: "tree", title: () => _("Tree"), View: TreeView },
];

export class App {
    constructor(body) {
        document.title = _("Management tree");
        document.documentElement.lang = cockpit.language ?? "en";
        this.state = new State();
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
            el("main", { class: "mi-main" }, this.state.element, [...this.panels.values()]));

        this.watchPrivilege();
        mihost.watchSlow(slow => slow.size > 0
            ? this.state.show("slow", { action: { label: _("Stop waiting"), run: mihost.stopSlow } })
            : this.state.clear("slow"));
        cockpit.addEventListener("locationchanged", () => this.show());
        this.checkVersion();
        this.show();
    }

    go(path) {
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
        if (!this.views.has(tab.name)) {
            const view = new tab.View({ state: this.state, go: path => this.go(path) });
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

    watchPrivilege() {
        const permission = cockpit.permission({ admin: true });
        const changed = () => {
            if (permission.allowed === false)
                this.state.show("no-privilege");
            else
                this.state.clear("no-privilege");
        };
        permission.addEventListener("changed", changed);
        changed();
    }

    checkVersion() {
        mihost.text(["--version"]).answer.then(version => {
            if (isRecent(version))
                this.state.clear("too-old");
            else
                this.state.show("too-old", {
                    detail: cockpit.format(_("It is $0; this page needs $1 or newer."), version.trim(), oldestMihost),
                });
        }, () => {}); // the view's own run of mihost meets the same trouble, and shows it
    }
}
