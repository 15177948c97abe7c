// All accounts as a table; one account's page when the address names it.
import { dayText, daysText, expiryText } from "../account-rows.js";
import { button } from "../button.js";
import { _ } from "../cockpit.js";
import { tasks } from "../tasks.js";
import { AccountPage } from "./account.js";
import { ListView } from "./list.js";
import { Pair } from "./pair.js";

function columns() {
    const days = property => row => daysText(row[property], _("no limit"));
    return [
        {
            property: "user-name", title: _("Name"), text: row => row["user-name"],
            link: row => ["users", row["user-name"]],
        },
        { property: "user-id", title: _("UID"), text: row => row["user-id"], order: "number", width: "narrow" },
        { property: "full-name", title: _("Full name"), text: row => row["full-name"], width: "large" },
        { property: "login-shell", title: _("Shell"), text: row => row["login-shell"], width: "wide" },
        {
            property: "last-password-change", title: _("Password set"), width: "wide",
            text: row => dayText(row["last-password-change"]),
        },
        {
            property: "password-max-days", title: _("Valid days"), order: "number", width: "wide",
            text: days("password-max-days"),
        },
        {
            property: "password-warn-days", title: _("Warned days"), order: "number", width: "wide",
            text: row => row["password-warn-days"],
        },
        {
            property: "password-expiry-days", title: _("Inactive after"), order: "number", width: "wide",
            text: days("password-expiry-days"),
        },
        {
            property: "password-expiration", title: _("Account expires"),
            text: row => expiryText(row["password-expiration"], _("never")),
        },
    ];
}

export class UsersView extends Pair {
    constructor(page) {
        super(new ListView({
            ...page,
            list: "users",
            table: {
                id: "users-table", filterId: "users-filter", label: _("Users"), none: _("No users."),
                columns: columns(),
            },
            buttons: [button(_("Add user"), () => page.preview(tasks.userAdd), {
                id: "user-add", look: "primary", changes: true,
            })],
        }), new AccountPage(page));
    }
}
