// One node: its properties by name, with unit and meaning; live ones are read repeatedly.
import { button } from "../button.js";
import * as catalogue from "../catalogue.js";
import { _, format } from "../cockpit.js";
import { el, replace } from "../dom.js";
import { Live } from "../live.js";
import { Loader } from "../load.js";
import * as mihost from "../mihost.js";
import { liveText, propertyRows } from "../property-rows.js";
import { kindOf, nameOf } from "../tree-rows.js";

const interval = "2"; // seconds between live readings

const marks = [
    { flag: "live", text: () => _("live"), look: "pf-m-blue" },
    { flag: "acts", text: () => _("changes the machine"), look: "pf-m-orange" },
    { flag: "secret", text: () => _("secret"), look: "pf-m-purple" },
];

// The views that show and change more than this one.
const places = {
    user: { label: () => _("Open the account"), path: name => ["users", name] },
    group: { label: () => _("Open the group"), path: name => ["groups", name] },
    log: { label: () => _("Open the log"), path: () => ["log"] },
    os: { label: () => _("Open the machine"), path: () => ["host"] },
};

export class NodeDetail {
    constructor({ state, go }) {
        this.go = go;
        this.body = el("div", {});
        this.element = el("section", { id: "detail", class: "mi-card", "aria-label": _("Selected node") }, this.body);
        this.loader = new Loader(this.body, state);
        this.live = null;
    }

    show(address) {
        if (address === this.address)
            return;
        this.hide();
        this.address = address;
        replace(this.body);
        this.read();
    }

    hide() {
        this.loader.stop();
        this.live?.stop();
        this.live = null;
        this.address = null;
    }

    read() {
        const address = this.address;
        this.loader.load(
            () => [mihost.rows(["get", "--", address]), { answer: catalogue.properties(), stop() {} }],
            (rows, kinds) => {
                const known = kinds.get(kindOf(address));
                this.draw(address, known, propertyRows(rows, known));
            });
    }

    draw(address, known, rows) {
        this.values = new Map();
        replace(this.body,
            el("div", { class: "mi-toolbar mi-heading" },
                el("h2", { class: "pf-v6-c-title pf-m-xl mi-grow" }, address), this.place(address)),
            el("p", { class: "mi-note" }, known?.meaning),
            rows.length === 0
                ? el("p", {}, _("This node has no properties."))
                : el("table", { class: "pf-v6-c-table pf-m-compact mi-properties" },
                    el("caption", { class: "pf-v6-screen-reader" }, format(_("Properties of $0"), address)),
                    el("thead", { class: "pf-v6-c-table__thead" },
                        el("tr", { class: "pf-v6-c-table__tr" },
                            [_("Property"), _("Value"), _("Meaning")].map(title =>
                                el("th", { class: "pf-v6-c-table__th", scope: "col" }, title)))),
                    el("tbody", { class: "pf-v6-c-table__tbody" }, rows.map(row => this.row(row)))));
        this.follow(address, rows.filter(row => row.live));
    }

    place(address) {
        const place = places[kindOf(address)];
        return place && button(place.label(), () => this.go(place.path(nameOf({ address }))));
    }

    row(row) {
        const value = el("span", { class: "mi-value" }, row.value);
        this.values.set(row.name, value);
        return el("tr", { class: "pf-v6-c-table__tr", "data-property": row.name },
            el("th", { class: "pf-v6-c-table__td", scope: "row" },
                row.name, " ", el("span", { class: "mi-id" }, row.id)),
            el("td", { class: "pf-v6-c-table__td" },
                value, row.unit && ` ${row.unit}`),
            el("td", { class: "pf-v6-c-table__td" },
                row.meaning,
                marks.filter(mark => row[mark.flag]).map(mark =>
                    el("span", { class: `pf-v6-c-label pf-m-compact ${mark.look}` },
                        el("span", { class: "pf-v6-c-label__content" },
                            el("span", { class: "pf-v6-c-label__text" }, mark.text()))))));
    }

    follow(address, rows) {
        this.live?.stop();
        this.live = null;
        if (rows.length === 0)
            return;
        let first = true;
        this.live = new Live(["watch", "--interval", interval, "--", address, ...rows.map(row => row.name)], {
            onDocument: ({ properties }) => {
                if (!first && Object.values(properties).some(property => liveText(property) === null))
                    this.read();
                else
                    this.update(properties);
                first = false;
            },
            onEnd: failure => failure && failure.kind !== "cancelled" &&
                this.loader.failed(failure, () => this.read()),
        });
    }

    update(properties) {
        for (const [name, property] of Object.entries(properties)) {
            const value = this.values.get(name);
            const text = liveText(property);
            if (!value || text === null || value.textContent === text)
                continue;
            replace(value, text);
            value.classList.remove("mi-changed");
            void value.offsetWidth; // starts the animation again
            value.classList.add("mi-changed");
        }
    }
}
