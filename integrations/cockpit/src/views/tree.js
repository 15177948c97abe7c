// The tree on the left, the chosen node on the right.
import { _ } from "../cockpit.js";
import { el, replace } from "../dom.js";
import { Loader } from "../load.js";
import * as mihost from "../mihost.js";
import { buildTree, kindsOf, nameOf, visibleRows } from "../tree-rows.js";
import { VirtualRows } from "../virtual.js";
import { NodeDetail } from "./node.js";

const rowHeight = 32; // pixels, as in index.css

export class TreeView {
    constructor({ state, go }) {
        this.go = go;
        this.tree = { nodes: new Map(), roots: [] };
        this.expanded = new Set();
        this.rows = [];
        this.active = 0;
        this.detail = new NodeDetail({ state, go });
        this.search = el("input", {
            id: "tree-search", type: "search", placeholder: _("Search"), "aria-label": _("Search the tree"),
            on: { input: () => this.filter() },
        });
        this.kind = el("select", {
            id: "kind-filter", "aria-label": _("Kind of node"), on: { change: () => this.filter() },
        }, el("option", { value: "" }, _("All kinds")));
        this.found = el("p", { class: "mi-note", role: "status" });
        this.body = el("div", { class: "mi-tree__body", role: "presentation" });
        this.list = el("div", {
            id: "tree", class: "mi-tree", role: "tree", tabindex: "0", "aria-label": _("Nodes"),
            on: { keydown: event => this.keydown(event), click: event => this.click(event) },
        }, this.body);
        this.message = el("div", {});
        this.loader = new Loader(this.message, state);
        this.virtual = new VirtualRows({
            scroller: this.list,
            body: this.body,
            makeSpacer: () => el("div", { role: "presentation" }),
            render: index => this.row(index),
            rowHeight,
        });
        this.element = el("div", { class: "mi-columns" },
            el("section", { class: "mi-card mi-columns__side", "aria-label": _("Tree") },
                el("div", { class: "mi-toolbar" },
                    el("span", { class: "pf-v6-c-form-control mi-grow" }, this.search),
                    el("span", { class: "pf-v6-c-form-control mi-select" }, this.kind,
                        el("span", { class: "pf-v6-c-form-control__utilities", "aria-hidden": "true" },
                            el("span", { class: "pf-v6-c-form-control__toggle-icon" }, "▾")))),
                this.message, this.list, this.found),
            this.detail.element);
    }

    /** Shows the node with this address; the operating system if it does not exist. */
    show([address = "os"]) {
        this.address = address;
        if (this.tree.nodes.size === 0 || this.stale)
            this.reload();
        else
            this.select();
    }

    hide() {
        this.loader.stop();
        this.forget();
    }

    /** Everything is read again when the view is shown next. */
    forget() {
        this.stale = true;
        this.detail.hide();
    }

    reload() {
        this.loader.load(() => [mihost.rows(["tree"])], rows => {
            replace(this.message);
            this.stale = false;
            this.tree = buildTree(rows);
            if (this.expanded.size === 0)
                for (const node of this.tree.nodes.values())
                    if (["mi", "root", "computer", "os"].includes(node.kind))
                        this.expanded.add(node.address);
            const kind = this.kind.value;
            replace(this.kind, el("option", { value: "" }, _("All kinds")),
                kindsOf(this.tree.nodes).map(name => el("option", { value: name }, name)));
            this.kind.value = kind;
            this.filter();
            this.select();
        });
    }

    filter() {
        this.rows = visibleRows(this.tree.roots, {
            expanded: this.expanded, search: this.search.value, kind: this.kind.value,
        });
        this.active = Math.max(0, this.rows.findIndex(row => row.node.address === this.address));
        this.draw();
        const found = this.rows.length === 0 && this.tree.nodes.size > 0;
        replace(this.found, found ? _("No node matches.") : null);
    }

    select() {
        const index = this.rows.findIndex(row => row.node.address === this.address);
        if (index >= 0)
            this.activate(index);
        this.detail.show(this.address);
    }

    activate(index) {
        this.active = Math.max(0, Math.min(index, this.rows.length - 1));
        this.virtual.scrollTo(this.active);
        this.draw();
    }

    draw() {
        this.virtual.setCount(this.rows.length);
        const active = this.rows[this.active];
        if (active)
            this.list.setAttribute("aria-activedescendant", `node-${active.node.id}`);
        else
            this.list.removeAttribute("aria-activedescendant");
    }

    row(index) {
        const { node, level, position, siblings, open } = this.rows[index];
        const chosen = node.address === this.address;
        return el("div", {
            id: `node-${node.id}`,
            class: `mi-tree__row${chosen ? " mi-chosen" : ""}${index === this.active ? " mi-active" : ""}` +
                ` mi-level-${Math.min(level, 8)}`,
            role: "treeitem",
            "data-index": index,
            "data-address": node.address,
            "aria-level": level,
            "aria-posinset": position,
            "aria-setsize": siblings,
            "aria-selected": chosen,
            "aria-expanded": open,
        },
        el("span", { class: "mi-tree__toggle", "aria-hidden": "true" }, open === null ? "" : open ? "▾" : "▸"),
        el("span", { class: "mi-tree__name" }, nameOf(node)),
        node.headline && node.headline !== nameOf(node) && el("span", { class: "mi-tree__more" }, node.headline),
        el("span", { class: "mi-tree__kind" }, node.kind));
    }

    click(event) {
        const row = event.target.closest("[data-index]");
        if (!row)
            return;
        const index = Number(row.dataset.index);
        if (event.target.closest(".mi-tree__toggle"))
            this.toggle(index);
        else
            this.go(["tree", this.rows[index].node.address]);
    }

    toggle(index, open = !this.rows[index]?.open) {
        const row = this.rows[index];
        if (!row || row.open === null)
            return;
        if (open)
            this.expanded.add(row.node.address);
        else
            this.expanded.delete(row.node.address);
        this.filter();
        this.activate(index);
    }

    keydown(event) {
        const row = this.rows[this.active];
        if (!row || event.ctrlKey || event.altKey || event.metaKey)
            return;
        const page = Math.max(1, Math.floor(this.list.clientHeight / rowHeight) - 1);
        const parent = () => this.rows.slice(0, this.active).findLastIndex(other => other.level < row.level);
        const actions = {
            ArrowDown: () => this.activate(this.active + 1),
            ArrowUp: () => this.activate(this.active - 1),
            PageDown: () => this.activate(this.active + page),
            PageUp: () => this.activate(this.active - page),
            Home: () => this.activate(0),
            End: () => this.activate(this.rows.length - 1),
            ArrowRight: () => row.open ? this.activate(this.active + 1) : this.toggle(this.active, true),
            ArrowLeft: () => row.open ? this.toggle(this.active, false) : this.activate(parent()),
            Enter: () => this.go(["tree", row.node.address]),
            " ": () => this.go(["tree", row.node.address]),
        };
        if (!actions[event.key])
            return;
        event.preventDefault();
        actions[event.key]();
    }
}
