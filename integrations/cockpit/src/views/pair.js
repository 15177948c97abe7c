// A table, or the page of the one row that the address names.
import { el } from "../dom.js";

export class Pair {
    constructor(list, page) {
        Object.assign(this, { list, page });
        this.element = el("div", { class: "mi-grows" }, list.element, page.element);
    }

    show([name]) {
        const [shown, hidden] = name ? [this.page, this.list] : [this.list, this.page];
        hidden.hide();
        hidden.element.hidden = true;
        shown.element.hidden = false;
        shown.show(name);
    }

    hide() {
        this.list.hide();
        this.page.hide();
    }
}
