// One account: its names and ids, its groups, its password's dates, and the changes to it.
import { factText } from "../account-rows.js";
import { button } from "../button.js";
import { _, format } from "../cockpit.js";
import { el, replace } from "../dom.js";
import { Loader } from "../load.js";
import * as mihost from "../mihost.js";
import { tasks } from "../tasks.js";
import { facts } from "./facts.js";

// An edit is the task that changes the fact, and the first values of its form.
const edits = {
    name: account => [tasks.userSetName, { "full-name": account["full-name"] }],
    home: account => [tasks.userSetHome, { home: account["home-directory"] }],
    shell: account => [tasks.userSetShell, { shell: account["login-shell"] }],
    password: () => [tasks.userSetPassword, {}],
    ageing: account => [tasks.userAge, account],
    expiry: account => [tasks.userExpire, { expires: account["account-expires"] ?? "" }],
};

const identity = [
    { label: () => _("User name"), text: account => account.user },
    { label: () => _("Full name"), text: account => account["full-name"], edit: "name" },
    { label: () => _("UID"), text: account => account.uid },
    { label: () => _("Home directory"), text: account => account["home-directory"], edit: "home" },
    { label: () => _("Login shell"), text: account => account["login-shell"], edit: "shell" },
    { label: () => _("State"), text: account => known(account, "state", _("in use")) },
    {
        label: () => _("Account expires"), text: account => known(account, "account-expires", _("never")),
        edit: "expiry",
    },
];

const passwordFacts = [
    { label: () => _("Password"), text: account => known(account, "password", _("set")), edit: "password" },
    { label: () => _("Set on"), text: account => known(account, "password-changed") },
    {
        label: () => _("Must be changed at next login"),
        text: account => known(account, "must-change-password"),
    },
    { label: () => _("May be changed from"), text: account => known(account, "change-allowed-from", _("at any time")) },
    { label: () => _("Warned from"), text: account => known(account, "warned-from") },
    {
        label: () => _("Valid until"), text: account => known(account, "password-valid-until", _("no limit")),
        edit: "ageing",
    },
    { label: () => _("Days left"), text: account => known(account, "password-days-left") },
    { label: () => _("Account active until"), text: account => known(account, "active-until", _("no limit")) },
    { label: () => _("Failed logins allowed"), text: account => account["login-failures-allowed"] ?? _("not limited") },
];

function known(account, fact, absent = "") {
    return factText(account, fact, absent, { yes: _("yes"), no: _("no"), unknown: _("unknown") });
}

export class AccountPage {
    constructor({ state, go, preview }) {
        Object.assign(this, { go, preview });
        this.element = el("section", { class: "mi-card", id: "account", "aria-label": _("Account") });
        this.loader = new Loader(this.element, state);
    }

    show(name) {
        if (name !== this.name)
            replace(this.element);
        this.name = name;
        this.loader.load(() => [mihost.json(["user", "--", name])], account => this.draw(account));
    }

    hide() {
        this.loader.stop();
        this.name = null;
    }

    draw(account) {
        const user = account.user;
        const edit = (name, label) => button(_("Edit"), () => {
            const [task, values] = edits[name](account);
            this.preview(task, { fixed: { user }, values });
        }, { id: `user-${name}`, look: "link", changes: true, name: format(_("Edit: $0"), label) });
        replace(this.element,
            button(_("All users"), () => this.go(["users"]), { look: "link" }),
            el("div", { class: "mi-toolbar mi-heading" },
                el("h2", { class: "pf-v6-c-title pf-m-xl mi-grow" }, user),
                account.node && button(_("Show in tree"), () => this.go(["tree", account.node])),
                button(_("Delete user"), () => this.preview(tasks.userDelete, {
                    fixed: { user }, then: () => this.go(["users"]),
                }), { id: "user-delete", look: "danger", changes: true })),
            account["no-node"] && el("p", { class: "mi-note" },
                format(_("This account is not in the tree: $0"), account["no-node"])),
            account.unknown && el("p", { class: "mi-note" }, account.unknown),
            el("div", { class: "mi-facts" },
                facts(_("Account"), identity, account, edit),
                facts(_("Password and ageing"), passwordFacts, account, edit),
                this.groups(account)));
    }

    groups(account) {
        const user = account.user;
        return el("div", {},
            el("h3", { class: "pf-v6-c-title pf-m-md" }, _("Groups")),
            el("ul", { class: "mi-names" },
                el("li", {}, this.group(account["primary-group"]), el("span", { class: "mi-note" }, _("primary"))),
                account["other-groups"].map(({ name }) => el("li", {}, this.group({ name }),
                    button(_("Remove"), () => this.preview(tasks.groupRemoveMember, { fixed: { group: name, user } }), {
                        look: "link", changes: true, name: format(_("Remove from group $0"), name),
                    })))),
            button(_("Add to group"), () => this.preview(tasks.groupAddMember, { fixed: { user } }), {
                id: "user-groups-add", changes: true,
            }));
    }

    /** A group that no longer exists has no page. */
    group({ name, gid }) {
        return name === null ? `${gid}` : button(name, () => this.go(["groups", name]), { look: "link" });
    }
}
