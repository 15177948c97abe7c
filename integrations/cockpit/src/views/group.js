// One group and its members.
import { button } from "../button.js";
import { _, format } from "../cockpit.js";
import { append, el, replace } from "../dom.js";
import { Loader } from "../load.js";
import * as mihost from "../mihost.js";
import { tasks } from "../tasks.js";

const shownAtFirst = 200; // members

export class GroupPage {
    constructor({ state, go, preview }) {
        Object.assign(this, { go, preview });
        this.element = el("section", { class: "mi-card", id: "group", "aria-label": _("Group") });
        this.loader = new Loader(this.element, state);
    }

    show(name) {
        if (name !== this.name)
            replace(this.element);
        this.name = name;
        this.loader.load(() => [mihost.json(["group", "--", name])], group => this.draw(group));
    }

    hide() {
        this.loader.stop();
        this.name = null;
    }

    draw(group) {
        const fixed = { group: group.group };
        const remove = user => button(_("Remove"),
            () => this.preview(tasks.groupRemoveMember, { fixed: { ...fixed, user } }),
            { look: "link", changes: true, name: format(_("Remove user $0"), user) });
        replace(this.element,
            button(_("All groups"), () => this.go(["groups"]), { look: "link" }),
            el("div", { class: "mi-toolbar mi-heading" },
                el("h2", { class: "pf-v6-c-title pf-m-xl mi-grow" }, group.group),
                group.node && button(_("Show in tree"), () => this.go(["tree", group.node])),
                button(_("Add member"), () => this.preview(tasks.groupAddMember, { fixed }), {
                    id: "group-members-add", changes: true,
                }),
                button(_("Delete group"), () => this.preview(tasks.groupDelete, {
                    fixed, then: () => this.go(["groups"]),
                }), { id: "group-delete", look: "danger", changes: true })),
            el("p", { class: "mi-note" }, format(_("GID $0"), group.gid)),
            group["no-node"] && el("p", { class: "mi-note" },
                format(_("This group is not in the tree: $0"), group["no-node"])),
            el("div", { class: "mi-facts" },
                this.names(_("Primary group of"), group["primary-group-of"].map(user => ({ user, account: true }))),
                this.names(_("Other members"), group["other-members"], remove)));
    }

    /** Members by name; a group may list some that have no account. */
    names(heading, members, action = () => null) {
        const names = el("ul", { class: "mi-names" });
        const add = some => append(names, some.map(({ user, account }) => el("li", {},
            account ? button(user, () => this.go(["users", user]), { look: "link" }) : user,
            !account && el("span", { class: "mi-note" }, _("no such account")), action(user))));
        add(members.slice(0, shownAtFirst));
        const more = members.length > shownAtFirst &&
            button(format(_("Show all $0"), members.length), () => {
                more.remove();
                add(members.slice(shownAtFirst));
            }, { look: "link" });
        return el("div", {},
            el("h3", { class: "pf-v6-c-title pf-m-md" }, heading),
            members.length === 0 ? el("p", { class: "mi-note" }, _("none")) : [names, more]);
    }
}
