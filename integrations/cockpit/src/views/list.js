// A table of one kind of node: what users, groups and drivers have in common.
import { el, replace } from "../dom.js";
import { Loader } from "../load.js";
import * as mihost from "../mihost.js";
import { Table } from "../table.js";

export class ListView {
    /** The list is named as in 'mihost list'; the buttons are next to the filter. */
    constructor({ state, go, list, table, buttons = [] }) {
        this.table = new Table({ go, ...table });
        this.list = list;
        this.message = el("div", {});
        this.loader = new Loader(this.message, state);
        this.element = el("section", { class: "mi-card mi-list", "aria-label": table.label },
            el("div", { class: "mi-toolbar" }, this.table.search, this.table.count, buttons),
            this.message, this.table.scroller);
    }

    show() {
        const columns = this.table.columns.map(column => column.property).join(",");
        this.loader.load(() => [mihost.rows(["list", this.list, "--columns", columns])], rows => {
            replace(this.message);
            this.table.setRows(rows);
        });
    }

    hide() {
        this.loader.stop();
    }
}
