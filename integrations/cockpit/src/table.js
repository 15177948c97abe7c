// A table that sorts and filters. Only the visible rows are in the page.
import { _, format } from "./cockpit.js";
import { el, replace } from "./dom.js";
import { filterRows, sortRows } from "./table-rows.js";
import { VirtualRows } from "./virtual.js";

const rowHeight = 40; // pixels, as in index.css

export class Table {
    /**
     * A column has the property that it sorts by, a title, the text of a row, and its order: "text" or
     * "number". A column's link returns the path that a click on a row opens. Columns with the width
     * "wide" are left out in a narrow window.
     */
    constructor({ id, filterId, label, columns, none, go }) {
        Object.assign(this, { columns, none, go, all: [], rows: [], sorted: columns[0], descending: false });
        this.filter = el("input", {
            id: filterId, type: "search", placeholder: _("Filter"), "aria-label": format(_("Filter: $0"), label),
            on: { input: () => this.arrange() },
        });
        this.count = el("span", { class: "mi-note mi-count", role: "status" });
        this.heads = columns.map(column => el("th", {
            class: `pf-v6-c-table__th ${classOf(column)}`, scope: "col", "aria-sort": "none",
        }, el("button", {
            type: "button", class: "mi-sort", on: { click: () => this.sortBy(column) },
        }, column.title, el("span", { class: "mi-sort__mark", "aria-hidden": "true" }))));
        this.body = el("tbody", { class: "pf-v6-c-table__tbody" });
        this.table = el("table", { id, class: "pf-v6-c-table mi-table", "aria-label": label },
            el("thead", { class: "pf-v6-c-table__thead" },
                el("tr", { class: "pf-v6-c-table__tr" }, this.heads)), this.body);
        this.scroller = el("div", {
            class: "mi-scroller", tabindex: "0", role: "group", "aria-label": label,
        }, this.table);
        this.virtual = new VirtualRows({
            scroller: this.scroller,
            body: this.body,
            makeSpacer: () => el("tr", { "aria-hidden": "true" }),
            render: index => this.row(index),
            rowHeight,
        });
        this.search = el("span", { class: "pf-v6-c-form-control mi-grow" }, this.filter);
    }

    setRows(rows) {
        this.all = rows;
        this.arrange();
    }

    sortBy(column) {
        this.descending = this.sorted === column && !this.descending;
        this.sorted = column;
        this.arrange();
    }

    arrange() {
        this.rows = sortRows(filterRows(this.all, this.columns, this.filter.value), this.sorted, this.descending);
        this.columns.forEach((column, i) => {
            const direction = column !== this.sorted ? "none" : this.descending ? "descending" : "ascending";
            this.heads[i].setAttribute("aria-sort", direction);
            replace(this.heads[i].querySelector(".mi-sort__mark"), { ascending: "▲", descending: "▼" }[direction]);
        });
        this.table.setAttribute("aria-rowcount", this.rows.length + 1);
        replace(this.count, this.all.length === 0 ? this.none
            : this.rows.length === this.all.length ? format(_("$0 in total"), this.all.length)
                : format(_("$0 of $1"), this.rows.length, this.all.length));
        this.virtual.setCount(this.rows.length);
    }

    row(index) {
        const row = this.rows[index];
        const name = row[this.columns[0].property];
        return el("tr", { class: "pf-v6-c-table__tr", "aria-rowindex": index + 2, "data-name": name },
            this.columns.map(column => {
                const text = column.text(row);
                const properties = { class: `pf-v6-c-table__td ${classOf(column)}`, title: text };
                return column.link
                    ? el("th", { ...properties, scope: "row" }, el("button", {
                        type: "button", class: "pf-v6-c-button pf-m-link pf-m-inline",
                        on: { click: () => this.go(column.link(row)) },
                    }, text))
                    : el("td", properties, text);
            }));
    }
}

function classOf({ width = "", order }) {
    return `${width && `mi-${width}`} ${order === "number" ? "mi-number" : ""}`.trim();
}
